#include "LooperPort.h"

#include <Message.h>

#include "AppMainLoop.h"
#include "Waiting.h"

namespace BPrivate {

namespace {

std::atomic<uint64> sBusyCount{0};

struct IdleSignal {
	std::mutex mutex;
	std::condition_variable changed;
	uint64 count = 0;
};

IdleSignal& Idle()
{
	// Never destroyed: looper threads may still run while the program exits.
	static IdleSignal* signal = new IdleSignal;
	return *signal;
}

void NotifyBusy()
{
	sBusyCount.fetch_add(1);
}

void NotifyIdle()
{
	IdleSignal& idle = Idle();
	{
		std::lock_guard<std::mutex> lock(idle.mutex);
		idle.count++;
	}
	idle.changed.notify_all();
}

}

uint64 BusyCount()
{
	return sBusyCount.load();
}

uint64 IdleCount()
{
	IdleSignal& idle = Idle();
	std::lock_guard<std::mutex> lock(idle.mutex);
	return idle.count;
}

void WaitForIdleChange(uint64 seen, bigtime_t timeout)
{
	IdleSignal& idle = Idle();
	std::unique_lock<std::mutex> lock(idle.mutex);
	WaitWithTimeout(idle.changed, lock, timeout, [&] { return idle.count != seen; });
}

LooperPort::LooperPort(BLooper* looper, int32 token)
	: fToken(token), fLooper(looper)
{
}

BLooper* LooperPort::Looper() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fLooper;
}

void LooperPort::ForgetLooper()
{
	std::lock_guard<std::mutex> lock(fMutex);
	fLooper = nullptr;
}

status_t LooperPort::Post(std::unique_ptr<BMessage> message)
{
	{
		std::lock_guard<std::mutex> lock(fMutex);
		if (fClosed)
			return B_BAD_PORT_ID;
		fQueue.push_back(std::move(message));
	}
	NotifyBusy();
	fQueueChanged.notify_one();
	if (fWakesMainLoop)
		WakeMainLoop();
	return B_OK;
}

std::unique_ptr<BMessage> LooperPort::Next(bigtime_t timeout)
{
	std::unique_lock<std::mutex> lock(fMutex);
	WaitWithTimeout(fQueueChanged, lock, timeout,
		[this] { return !fQueue.empty() || fClosed || fStopRequested; });
	if (fQueue.empty() || fClosed || fStopRequested)
		return nullptr;
	std::unique_ptr<BMessage> message = std::move(fQueue.front());
	fQueue.pop_front();
	fDispatching = true;
	return message;
}

void LooperPort::DoneDispatching()
{
	{
		std::lock_guard<std::mutex> lock(fMutex);
		fDispatching = false;
	}
	NotifyIdle();
}

int32 LooperPort::CountMessages() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return static_cast<int32>(fQueue.size());
}

void LooperPort::Close()
{
	std::deque<std::unique_ptr<BMessage>> dropped;
	{
		std::lock_guard<std::mutex> lock(fMutex);
		if (fClosed)
			return;
		fClosed = true;
		dropped.swap(fQueue);
	}
	fQueueChanged.notify_all();
	fLockFree.notify_all();
	NotifyIdle();
	// The dropped messages die here, outside the mutex: a waiting sender
	// learns that no reply will come.
}

bool LooperPort::IsClosed() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fClosed;
}

void LooperPort::RequestStop()
{
	{
		std::lock_guard<std::mutex> lock(fMutex);
		fStopRequested = true;
	}
	fQueueChanged.notify_all();
	if (fWakesMainLoop)
		WakeMainLoop();
}

bool LooperPort::IsStopRequested() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fStopRequested;
}

status_t LooperPort::Lock(bigtime_t timeout)
{
	const thread_id self = find_thread(NULL);
	std::unique_lock<std::mutex> lock(fMutex);
	if (fOwner == self) {
		fLockCount++;
		return B_OK;
	}
	const bool free = WaitWithTimeout(fLockFree, lock, timeout,
		[this] { return fOwner < 0 || fClosed; });
	if (fClosed)
		return B_BAD_VALUE;
	if (!free)
		return B_TIMED_OUT;
	fOwner = self;
	fLockCount = 1;
	return B_OK;
}

void LooperPort::Unlock()
{
	std::lock_guard<std::mutex> lock(fMutex);
	if (fOwner != find_thread(NULL) || --fLockCount > 0)
		return;
	fOwner = -1;
	fLockFree.notify_one();
}

void LooperPort::ReleaseConstructionLock()
{
	std::lock_guard<std::mutex> lock(fMutex);
	if (fLockCount == 0 || --fLockCount > 0)
		return;
	fOwner = -1;
	fLockFree.notify_one();
}

bool LooperPort::IsLockedByCaller() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fOwner == find_thread(NULL);
}

thread_id LooperPort::LockingThread() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fOwner;
}

int32 LooperPort::CountLocks() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fLockCount;
}

void LooperPort::SetThread(thread_id thread)
{
	std::lock_guard<std::mutex> lock(fMutex);
	fThread = thread;
}

thread_id LooperPort::Thread() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fThread;
}

void LooperPort::SetRunning(bool running)
{
	{
		std::lock_guard<std::mutex> lock(fMutex);
		fRunning = running;
	}
	running ? NotifyBusy() : NotifyIdle();
}

bool LooperPort::IsIdle() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	if (fModalDepth > 0)
		return true;
	return !fDispatching && (fClosed || !fRunning || fQueue.empty());
}

void LooperPort::EnterModal()
{
	{
		std::lock_guard<std::mutex> lock(fMutex);
		fModalDepth++;
	}
	NotifyIdle();
}

void LooperPort::LeaveModal()
{
	{
		std::lock_guard<std::mutex> lock(fMutex);
		fModalDepth--;
	}
	NotifyBusy();
}

}
