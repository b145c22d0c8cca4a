#include <InterfaceDefs.h>

#include "Display.h"

rgb_color ui_color(color_which which)
{
	switch (which) {
		case B_PANEL_BACKGROUND_COLOR:
		case B_MENU_BACKGROUND_COLOR:
			return make_color(216, 216, 216);
		case B_WINDOW_TAB_COLOR:
			return make_color(255, 203, 0);
		case B_KEYBOARD_NAVIGATION_COLOR:
			return make_color(0, 0, 229);
		case B_DESKTOP_COLOR:
			return make_color(51, 102, 152);
		case B_MENU_SELECTION_BACKGROUND_COLOR:
			return make_color(152, 152, 152);
		case B_MENU_SELECTED_BORDER_COLOR:
			return make_color(96, 96, 96);
		case B_SUCCESS_COLOR:
			return make_color(0, 255, 0);
		case B_FAILURE_COLOR:
			return make_color(255, 0, 0);
		default:
			return make_color(0, 0, 0);
	}
}

uint32 modifiers()
{
	return BPrivate::Display::Default().Modifiers();
}
