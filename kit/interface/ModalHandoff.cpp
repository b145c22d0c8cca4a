#include "ModalHandoff.h"

#include "MainLoop.h"

namespace BPrivate {

void ModalHandoff::Wait()
{
	{
		ModalWaitScope modal;
		std::unique_lock<std::mutex> lock(fLock);
		fChanged.wait(lock, [this] { return fSignaled; });
	}
	std::lock_guard<std::mutex> guard(fLock);
	fAwake = true;
	fChanged.notify_all();
}

void ModalHandoff::Signal()
{
	std::unique_lock<std::mutex> lock(fLock);
	fSignaled = true;
	fChanged.notify_all();
	fChanged.wait(lock, [this] { return fAwake; });
}

}
