#include "HeadlessDriver.h"

namespace BPrivate {

void HeadlessDriver::ActivateWindow(const std::shared_ptr<DisplayWindow>& window)
{
	Display::Default().SetActiveWindow(window);
}

BRect HeadlessDriver::ScreenFrame()
{
	return BRect(0, 0, fWidth - 1, fHeight - 1);
}

void HeadlessDriver::SetScreenSize(int32 width, int32 height)
{
	fWidth = max_c(width, int32(1));
	fHeight = max_c(height, int32(1));
}

std::unique_ptr<DisplayDriver> CreateHeadlessDriver()
{
	return std::make_unique<HeadlessDriver>();
}

}
