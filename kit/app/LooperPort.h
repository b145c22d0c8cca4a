#ifndef KIT_APP_LOOPER_PORT_H
#define KIT_APP_LOOPER_PORT_H

#include <atomic>
#include <condition_variable>
#include <deque>
#include <memory>
#include <mutex>

#include <OS.h>

class BLooper;
class BMessage;

namespace BPrivate {

// The part of a looper that other threads reach: its message queue, its
// lock and its run state. Senders hold it through a shared_ptr, so it
// outlives the looper; once closed, it refuses messages and locks.
class LooperPort {
public:
	LooperPort(BLooper* looper, int32 token);
	LooperPort(const LooperPort&) = delete;
	LooperPort& operator=(const LooperPort&) = delete;

	int32 Token() const { return fToken; }
	// NULL once the looper is gone.
	BLooper* Looper() const;
	void ForgetLooper();

	// The queue. Post fails with B_BAD_PORT_ID once closed.
	status_t Post(std::unique_ptr<BMessage> message);
	// The next message, waiting at most timeout; NULL on timeout, once closed
	// or once a stop is requested. The port then counts as dispatching until
	// DoneDispatching, also once closed: a looper quitting in its own thread
	// is busy until it is deleted.
	std::unique_ptr<BMessage> Next(bigtime_t timeout);
	void DoneDispatching();
	int32 CountMessages() const;
	// Refuses further messages, frees those queued and makes every waiter
	// for the lock fail. The lock owner keeps its lock.
	void Close();
	bool IsClosed() const;
	// Makes Next return NULL from now on (the application's quit).
	void RequestStop();
	bool IsStopRequested() const;
	// Posting wakes the display's main loop too (the application's port).
	void SetWakesMainLoop() { fWakesMainLoop = true; }

	// The looper's recursive lock. Lock fails with B_BAD_VALUE once closed
	// and with B_TIMED_OUT after timeout.
	status_t Lock(bigtime_t timeout);
	void Unlock();
	// Drops one level of the lock whoever holds it: the lock a looper is
	// constructed with, released by Run.
	void ReleaseConstructionLock();
	bool IsLockedByCaller() const;
	thread_id LockingThread() const;
	int32 CountLocks() const;

	void SetThread(thread_id thread);
	thread_id Thread() const;
	// Only a running looper can be busy; see WaitForIdleLoopers.
	void SetRunning(bool running);
	bool IsIdle() const;
	void EnterModal();
	void LeaveModal();

private:
	const int32 fToken;
	std::atomic<bool> fWakesMainLoop{false};

	mutable std::mutex fMutex;
	std::condition_variable fQueueChanged;
	std::condition_variable fLockFree;
	BLooper* fLooper;
	std::deque<std::unique_ptr<BMessage>> fQueue;
	bool fClosed = false;
	bool fStopRequested = false;
	bool fDispatching = false;
	bool fRunning = false;
	int32 fModalDepth = 0;
	thread_id fOwner = -1;
	int32 fLockCount = 0;
	thread_id fThread = -1;
};

// Activity of all loopers, for WaitForIdleLoopers. The busy count grows
// whenever a looper may have turned busy (a message posted, a looper started
// or back from a modal wait); the idle count whenever one may have turned
// idle.
uint64 BusyCount();
uint64 IdleCount();
// Waits until the idle count differs from seen or timeout passes.
void WaitForIdleChange(uint64 seen, bigtime_t timeout);

}

#endif
