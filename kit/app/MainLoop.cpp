#include "MainLoop.h"

#include <mutex>

#include <Application.h>

#include "AppMainLoop.h"
#include "LooperAccess.h"
#include "LooperPort.h"
#include "TokenSpace.h"

namespace BPrivate {

namespace {

struct InstalledLoop {
	std::mutex mutex;
	std::shared_ptr<MainLoop> loop;
};

InstalledLoop& Installed()
{
	// Never destroyed: looper threads may still post while the program exits.
	static InstalledLoop* installed = new InstalledLoop;
	return *installed;
}

bool AllLoopersIdle()
{
	for (const auto& port : TokenSpace::Default().Ports()) {
		if (!port->IsIdle())
			return false;
	}
	return true;
}

}

void SetMainLoop(MainLoop* loop)
{
	std::shared_ptr<MainLoop> replaced;
	InstalledLoop& installed = Installed();
	std::lock_guard<std::mutex> lock(installed.mutex);
	replaced = std::move(installed.loop);
	installed.loop.reset(loop);
}

MainLoop* CurrentMainLoop()
{
	InstalledLoop& installed = Installed();
	std::lock_guard<std::mutex> lock(installed.mutex);
	return installed.loop.get();
}

std::shared_ptr<MainLoop> ActiveMainLoop()
{
	InstalledLoop& installed = Installed();
	std::lock_guard<std::mutex> lock(installed.mutex);
	return installed.loop;
}

void WakeMainLoop()
{
	if (std::shared_ptr<MainLoop> loop = ActiveMainLoop())
		loop->Wake();
}

bool DispatchApplicationMessages(BApplication* app, bigtime_t timeout)
{
	return app != nullptr && LooperAccess::DispatchQueued(app, timeout);
}

bool WaitForIdleLoopers(bigtime_t timeout)
{
	const bigtime_t start = system_time();
	for (;;) {
		const uint64 idleSeen = IdleCount();
		const uint64 busySeen = BusyCount();
		// Idle only if nothing may have turned busy while looking: a looper
		// seen idle could otherwise have been posted to by one seen later.
		const bool idle = AllLoopersIdle();
		if (idle && BusyCount() == busySeen)
			return true;
		const bigtime_t left = timeout - (system_time() - start);
		if (left <= 0)
			return false;
		if (!idle)
			WaitForIdleChange(idleSeen, left);
	}
}

ModalWaitScope::ModalWaitScope()
{
	if (BLooper* looper = BLooper::LooperForThread(find_thread(NULL)))
		LooperAccess::Port(looper)->EnterModal();
}

ModalWaitScope::~ModalWaitScope()
{
	if (BLooper* looper = BLooper::LooperForThread(find_thread(NULL)))
		LooperAccess::Port(looper)->LeaveModal();
}

}
