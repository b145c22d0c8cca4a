#include <Application.h>
#include <Window.h>

#include <algorithm>
#include <mutex>
#include <vector>

#include "WindowData.h"

namespace {

std::mutex sLock;
std::vector<BWindow*> sWindows;

}

namespace BPrivate {

void RegisterWindow(BWindow* window)
{
	std::lock_guard<std::mutex> guard(sLock);
	sWindows.push_back(window);
}

void UnregisterWindow(BWindow* window)
{
	std::lock_guard<std::mutex> guard(sLock);
	std::erase(sWindows, window);
}

}

int32 BApplication::CountWindows() const
{
	std::lock_guard<std::mutex> guard(sLock);
	return int32(sWindows.size());
}

BWindow* BApplication::WindowAt(int32 index) const
{
	std::lock_guard<std::mutex> guard(sLock);
	return index >= 0 && index < int32(sWindows.size()) ? sWindows[index] : nullptr;
}
