#include <Invoker.h>

#include <Handler.h>
#include <Looper.h>
#include <Message.h>
#include <OS.h>

#include "InvokerPrivate.h"

namespace BPrivate {

struct InvokerData {
	std::unique_ptr<BMessage> message;
	BMessenger target;
	BHandler* replyTo = nullptr;
	bigtime_t timeout = B_INFINITE_TIMEOUT;
};

}

namespace BPrivate {

std::unique_ptr<BMessage> StampedCopy(const BInvoker* invoker, const BMessage* message,
	const void* source)
{
	if (message == nullptr)
		message = invoker->Message();
	if (message == nullptr)
		return nullptr;
	auto copy = std::make_unique<BMessage>(*message);
	copy->AddInt64("when", system_time());
	copy->AddPointer("source", source);
	return copy;
}

}

BInvoker::BInvoker()
	: fInvokerData(std::make_unique<BPrivate::InvokerData>())
{
}

BInvoker::BInvoker(BMessage* message, const BHandler* handler, const BLooper* looper)
	: BInvoker()
{
	SetMessage(message);
	SetTarget(handler, looper);
}

BInvoker::BInvoker(BMessage* message, BMessenger target)
	: BInvoker()
{
	SetMessage(message);
	SetTarget(target);
}

BInvoker::~BInvoker() = default;

status_t BInvoker::SetMessage(BMessage* message)
{
	if (message != fInvokerData->message.get())
		fInvokerData->message.reset(message);
	return B_OK;
}

BMessage* BInvoker::Message() const
{
	return fInvokerData->message.get();
}

uint32 BInvoker::Command() const
{
	return fInvokerData->message != nullptr ? fInvokerData->message->what : 0;
}

status_t BInvoker::SetTarget(const BHandler* handler, const BLooper* looper)
{
	status_t status = B_OK;
	fInvokerData->target = handler != nullptr || looper != nullptr
		? BMessenger(handler, looper, &status) : BMessenger();
	return status;
}

status_t BInvoker::SetTarget(BMessenger messenger)
{
	fInvokerData->target = messenger;
	return B_OK;
}

bool BInvoker::IsTargetLocal() const
{
	return fInvokerData->target.IsTargetLocal();
}

BHandler* BInvoker::Target(BLooper** looper) const
{
	BLooper* found = nullptr;
	BHandler* handler = fInvokerData->target.Target(&found);
	if (looper != nullptr)
		*looper = found;
	return handler;
}

BMessenger BInvoker::Messenger() const
{
	return fInvokerData->target;
}

status_t BInvoker::SetHandlerForReply(BHandler* handler)
{
	fInvokerData->replyTo = handler;
	return B_OK;
}

BHandler* BInvoker::HandlerForReply() const
{
	return fInvokerData->replyTo;
}

status_t BInvoker::Invoke(BMessage* message)
{
	if (message == nullptr)
		message = Message();
	if (message == nullptr)
		return B_BAD_VALUE;
	const BPrivate::InvokerData& data = *fInvokerData;
	BMessenger replyTo = data.replyTo != nullptr ? BMessenger(data.replyTo) : BMessenger();
	return data.target.SendMessage(message, replyTo, data.timeout);
}

status_t BInvoker::SetTimeout(bigtime_t timeout)
{
	fInvokerData->timeout = timeout;
	return B_OK;
}

bigtime_t BInvoker::Timeout() const
{
	return fInvokerData->timeout;
}
