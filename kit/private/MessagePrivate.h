#ifndef KIT_PRIVATE_MESSAGE_PRIVATE_H
#define KIT_PRIVATE_MESSAGE_PRIVATE_H

#include <Message.h>

class BMessenger;

namespace BPrivate {

struct MessageData;

// What the kit sets on a message besides its fields.
class MessageAccess {
public:
	// Marks message as dropped by the user at screenPoint (screen
	// coordinates); offset is the point of the drag image that was under the
	// pointer. Copies of the message keep this; it is not a field.
	static void SetDropped(BMessage* message, BPoint screenPoint, BPoint offset);

	// Where replies to message go once it is delivered (a drag's reply
	// handler, for instance). Sending it with a reply handler overrides this.
	static void SetReturnAddress(BMessage* message, const BMessenger& replyTo);

	static MessageData& Data(BMessage& message) { return *message.fData; }
	static const MessageData& Data(const BMessage& message) { return *message.fData; }
};

}

#endif
