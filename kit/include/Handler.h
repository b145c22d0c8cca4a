#ifndef _HANDLER_H
#define _HANDLER_H

#include <memory>

#include <SupportDefs.h>

class BLooper;
class BMessage;

namespace BPrivate {
struct HandlerData;
class HandlerAccess;
}

// An object that receives messages in its looper's thread.
class BHandler {
public:
	BHandler(const char* name = NULL);
	virtual ~BHandler();

	// The default passes the message to the next handler, if there is one.
	virtual void MessageReceived(BMessage* message);

	BLooper* Looper() const;
	void SetName(const char* name);
	const char* Name() const;
	virtual void SetNextHandler(BHandler* handler);
	BHandler* NextHandler() const;

	// Locks the looper this handler belongs to, if any; false when it has none
	// or it went away.
	bool LockLooper();
	status_t LockLooperWithTimeout(bigtime_t timeout);
	void UnlockLooper();

private:
	friend class BPrivate::HandlerAccess;

	std::unique_ptr<BPrivate::HandlerData> fHandlerData;
};

#endif
