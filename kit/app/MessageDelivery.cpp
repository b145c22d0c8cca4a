// What a message knows about its journey, and replies.

#include <Message.h>

#include <Application.h>

#include "MessageData.h"
#include "MessagePrivate.h"
#include "MessengerAccess.h"
#include "Waiting.h"

using BPrivate::MessageAccess;
using BPrivate::MessageData;

namespace BPrivate {

status_t ReplySlot::Answer(std::unique_ptr<BMessage> reply)
{
	{
		std::lock_guard<std::mutex> lock(fMutex);
		if (fReply != nullptr)
			return B_DUPLICATE_REPLY;
		fReply = std::move(reply);
	}
	fAnswered.notify_all();
	return B_OK;
}

bool ReplySlot::IsAnswered()
{
	std::lock_guard<std::mutex> lock(fMutex);
	return fReply != nullptr;
}

status_t ReplySlot::Wait(bigtime_t timeout, BMessage* reply)
{
	std::unique_lock<std::mutex> lock(fMutex);
	if (!WaitWithTimeout(fAnswered, lock, timeout, [this] { return fReply != nullptr; }))
		return B_TIMED_OUT;
	*reply = *fReply;
	// The replier may wait for an answer to its reply.
	MessageAccess::Data(*reply).ticket = std::move(MessageAccess::Data(*fReply).ticket);
	return B_OK;
}

ReplyTicket::~ReplyTicket()
{
	auto noReply = std::make_unique<BMessage>(B_NO_REPLY);
	MessageAccess::Data(*noReply).isReply = true;
	slot->Answer(std::move(noReply));
}

}

namespace {

// Sends reply as the answer to original: to the waiting sender if there is
// one, else to the return address, else to the application. With a ticket,
// the replier waits for an answer to its reply.
status_t DeliverReply(const BMessage& original, const BMessage* reply,
	const BMessenger& replyTo, std::shared_ptr<BPrivate::ReplyTicket> ticket)
{
	if (reply == nullptr)
		return B_BAD_VALUE;
	const MessageData& data = MessageAccess::Data(original);
	if (!data.delivered)
		return B_BAD_REPLY;

	auto answer = std::make_unique<BMessage>(*reply);
	MessageData& answerData = MessageAccess::Data(*answer);
	answerData.ClearDelivery();
	answerData.isReply = true;
	auto previous = std::make_shared<BMessage>(original);
	MessageAccess::Data(*previous).ClearDelivery();
	answerData.previous = std::move(previous);

	if (data.ticket != nullptr) {
		answerData.delivered = true;
		answerData.returnAddress = replyTo;
		answerData.ticket = std::move(ticket);
		return data.ticket->slot->Answer(std::move(answer));
	}
	const BMessenger target = data.returnAddress.IsValid()
		? data.returnAddress : be_app_messenger;
	if (!target.IsValid())
		return B_BAD_REPLY;
	return BPrivate::MessengerAccess::Deliver(target, *answer, replyTo, std::move(ticket));
}

}

bool BMessage::WasDelivered() const
{
	return fData->delivered;
}

bool BMessage::IsSourceWaiting() const
{
	return fData->ticket != nullptr && !fData->ticket->slot->IsAnswered();
}

bool BMessage::IsSourceRemote() const
{
	// Every sender is in this program.
	return false;
}

BMessenger BMessage::ReturnAddress() const
{
	return fData->returnAddress;
}

const BMessage* BMessage::Previous() const
{
	return fData->previous.get();
}

bool BMessage::WasDropped() const
{
	return fData->dropped;
}

BPoint BMessage::DropPoint(BPoint* offset) const
{
	if (offset != nullptr)
		*offset = fData->dropOffset;
	return fData->dropPoint;
}

status_t BMessage::SendReply(uint32 command, BHandler* replyTo)
{
	BMessage reply(command);
	return SendReply(&reply, replyTo);
}

status_t BMessage::SendReply(BMessage* reply, BHandler* replyTo,
	bigtime_t /*timeout: queues never fill up*/)
{
	return DeliverReply(*this, reply,
		replyTo != nullptr ? BMessenger(replyTo) : BMessenger(), nullptr);
}

status_t BMessage::SendReply(BMessage* reply, BMessage* replyToReply,
	bigtime_t /*sendTimeout: queues never fill up*/, bigtime_t replyTimeout)
{
	if (replyToReply == nullptr)
		return B_BAD_VALUE;
	auto slot = std::make_shared<BPrivate::ReplySlot>();
	status_t status = DeliverReply(*this, reply, BMessenger(),
		std::make_shared<BPrivate::ReplyTicket>(slot));
	if (status != B_OK)
		return status;
	return slot->Wait(replyTimeout, replyToReply);
}
