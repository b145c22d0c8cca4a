#ifndef _INVOKER_H
#define _INVOKER_H

#include <memory>

#include <AppDefs.h>
#include <Messenger.h>

class BHandler;
class BLooper;
class BMessage;

namespace BPrivate {
struct InvokerData;
}

// Something that sends a model message to a target when it is invoked: the
// mix-in of controls and menu items. The invoker owns its message.
class BInvoker {
public:
	BInvoker();
	BInvoker(BMessage* message, const BHandler* handler, const BLooper* looper = NULL);
	BInvoker(BMessage* message, BMessenger target);
	virtual ~BInvoker();

	// Takes ownership of message and deletes the previous one; NULL leaves
	// the invoker without a message.
	virtual status_t SetMessage(BMessage* message);
	BMessage* Message() const;
	uint32 Command() const;

	// A handler that belongs to no looper yet fails with B_BAD_HANDLER.
	virtual status_t SetTarget(const BHandler* handler, const BLooper* looper = NULL);
	virtual status_t SetTarget(BMessenger messenger);
	bool IsTargetLocal() const;
	BHandler* Target(BLooper** looper = NULL) const;
	BMessenger Messenger() const;

	// Where the target's replies go.
	virtual status_t SetHandlerForReply(BHandler* handler);
	BHandler* HandlerForReply() const;

	// Sends a copy of message, or of the model message when it is NULL.
	// B_BAD_VALUE without either; B_BAD_PORT_ID without a valid target.
	virtual status_t Invoke(BMessage* message = NULL);

	status_t SetTimeout(bigtime_t timeout);
	bigtime_t Timeout() const;

private:
	BInvoker(const BInvoker&) = delete;
	BInvoker& operator=(const BInvoker&) = delete;

	std::unique_ptr<BPrivate::InvokerData> fInvokerData;
};

#endif
