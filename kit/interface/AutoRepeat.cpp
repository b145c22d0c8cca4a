#include "AutoRepeat.h"

#include <chrono>

namespace BPrivate {

AutoRepeat::AutoRepeat(BMessenger target, uint32 what, bigtime_t delay, bigtime_t interval)
	: fThread(&AutoRepeat::_Run, this, target, what, delay, interval)
{
}

AutoRepeat::~AutoRepeat()
{
	{
		std::lock_guard<std::mutex> guard(fLock);
		fStop = true;
	}
	fStopped.notify_all();
	fThread.join();
}

void AutoRepeat::_Run(BMessenger target, uint32 what, bigtime_t delay, bigtime_t interval)
{
	std::unique_lock<std::mutex> lock(fLock);
	bigtime_t wait = delay;
	while (!fStopped.wait_for(lock, std::chrono::microseconds(wait), [this] { return fStop; })) {
		// A target that went away ends the repeat.
		if (target.SendMessage(what) != B_OK)
			return;
		wait = interval;
	}
}

}
