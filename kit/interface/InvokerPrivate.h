#ifndef KIT_INTERFACE_INVOKER_PRIVATE_H
#define KIT_INTERFACE_INVOKER_PRIVATE_H

#include <memory>

#include <Invoker.h>
#include <Message.h>

namespace BPrivate {

// What a control or a menu item sends: a copy of message, or of the
// invoker's model message, with "when" (int64) and "source" (a pointer)
// added; NULL without either message.
std::unique_ptr<BMessage> StampedCopy(const BInvoker* invoker, const BMessage* message,
	const void* source);

}

#endif
