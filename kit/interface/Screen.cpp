#include <Screen.h>

#include "Display.h"

BScreen::BScreen(screen_id id)
	:
	fID(id)
{
}

BScreen::BScreen(BWindow*)
	:
	fID(B_MAIN_SCREEN_ID)
{
}

bool BScreen::IsValid() const
{
	return fID.id == B_MAIN_SCREEN_ID.id;
}

screen_id BScreen::ID() const
{
	return fID;
}

BRect BScreen::Frame() const
{
	return IsValid() ? BPrivate::Display::Default().Driver().ScreenFrame() : BRect();
}

color_space BScreen::ColorSpace() const
{
	return IsValid() ? B_RGB32 : B_NO_COLOR_SPACE;
}
