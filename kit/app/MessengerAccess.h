#ifndef KIT_APP_MESSENGER_ACCESS_H
#define KIT_APP_MESSENGER_ACCESS_H

#include <memory>

#include <Messenger.h>

class BMessage;

namespace BPrivate {

struct ReplyTicket;

// A messenger as it travels inside a message (B_MESSENGER_TYPE).
struct FlatMessenger {
	int32 looperToken;
	int32 handlerToken;
	int32 preferredTarget;
	int32 team;
};

class MessengerAccess {
public:
	static FlatMessenger Flatten(const BMessenger& messenger);
	static BMessenger Unflatten(const FlatMessenger& flat);
	static int32 LooperToken(const BMessenger& messenger)
		{ return messenger.fLooperToken; }

	// Queues a copy of message for the messenger's target, with replyTo as
	// its return address (when valid). With a ticket, the sender waits for
	// an answer through it.
	static status_t Deliver(const BMessenger& target, const BMessage& message,
		const BMessenger& replyTo, std::shared_ptr<ReplyTicket> ticket);
};

}

#endif
