#ifndef _LOOPER_H
#define _LOOPER_H

#include <memory>

#include <Handler.h>
#include <OS.h>

class BMessage;

namespace BPrivate {
struct LooperData;
class LooperAccess;
}

#define B_LOOPER_PORT_DEFAULT_CAPACITY 200
#define B_NORMAL_PRIORITY 10
#define B_DISPLAY_PRIORITY 15

// A handler with a thread and a message queue. Messages are dispatched one by
// one, in the order they were posted, to their target handler; the looper's
// lock is held during each dispatch. As on the platform, a new looper is
// locked by the thread that constructs it until Run. The queue has no fixed
// capacity here: portCapacity and priority are accepted and not used.
class BLooper : public BHandler {
public:
	BLooper(const char* name = NULL, int32 priority = B_NORMAL_PRIORITY,
		int32 portCapacity = B_LOOPER_PORT_DEFAULT_CAPACITY);
	virtual ~BLooper();

	// Posting queues a copy of message; the caller keeps its message. The
	// forms without a handler address the looper itself; a NULL handler
	// means the preferred handler, else the looper. A handler of another
	// looper gives B_MISMATCHED_VALUES, a looper that quit B_BAD_PORT_ID.
	status_t PostMessage(uint32 command);
	status_t PostMessage(BMessage* message);
	status_t PostMessage(uint32 command, BHandler* handler, BHandler* replyTo = NULL);
	status_t PostMessage(BMessage* message, BHandler* handler,
		BHandler* replyTo = NULL);

	virtual void DispatchMessage(BMessage* message, BHandler* handler);
	virtual void MessageReceived(BMessage* message);
	BMessage* CurrentMessage() const;
	// Takes the current message away from the looper, which then does not
	// delete it; the caller owns it.
	BMessage* DetachCurrentMessage();
	bool IsMessageWaiting() const;

	// Handlers.
	void AddHandler(BHandler* handler);
	bool RemoveHandler(BHandler* handler);
	int32 CountHandlers() const;
	BHandler* HandlerAt(int32 index) const;
	int32 IndexOf(BHandler* handler) const;
	BHandler* PreferredHandler() const;
	void SetPreferredHandler(BHandler* handler);

	// Life. Run starts the thread. Quit from the looper's own thread ends it
	// after the current message and deletes the looper; messages still queued
	// are dropped and later ones refused. From another thread the caller must
	// hold the lock, and Quit waits for the thread to end, then deletes the
	// looper. A looper that never ran is deleted at once. B_QUIT_REQUESTED
	// addressed to the looper calls QuitRequested, then Quit if it agrees.
	virtual thread_id Run();
	virtual void Quit();
	virtual bool QuitRequested();

	// A recursive lock; any thread may take it to act on the looper's objects.
	bool Lock();
	void Unlock();
	status_t LockWithTimeout(bigtime_t timeout);
	bool IsLocked() const;
	thread_id LockingThread() const;
	int32 CountLocks() const;

	thread_id Thread() const;
	team_id Team() const;
	static BLooper* LooperForThread(thread_id thread);

private:
	friend class BPrivate::LooperAccess;

	std::unique_ptr<BPrivate::LooperData> fLooperData;
};

#endif
