#include <Messenger.h>

#include <strings.h>
#include <unistd.h>

#include <Application.h>
#include <Handler.h>
#include <Looper.h>
#include <Message.h>

#include "LooperAccess.h"
#include "LooperPort.h"
#include "MessageData.h"
#include "MessagePrivate.h"
#include "MessengerAccess.h"
#include "TokenSpace.h"

namespace BPrivate {

FlatMessenger MessengerAccess::Flatten(const BMessenger& messenger)
{
	return FlatMessenger{messenger.fLooperToken, messenger.fHandlerToken,
		messenger.fPreferredTarget ? 1 : 0, messenger.fTeam};
}

BMessenger MessengerAccess::Unflatten(const FlatMessenger& flat)
{
	BMessenger messenger;
	messenger.fLooperToken = flat.looperToken;
	messenger.fHandlerToken = flat.handlerToken;
	messenger.fPreferredTarget = flat.preferredTarget != 0;
	messenger.fTeam = flat.team;
	return messenger;
}

status_t MessengerAccess::Deliver(const BMessenger& target, const BMessage& message,
	const BMessenger& replyTo, std::shared_ptr<ReplyTicket> ticket)
{
	TokenSpace& tokens = TokenSpace::Default();
	std::shared_ptr<LooperPort> port = tokens.PortFor(target.fLooperToken);
	if (port == nullptr)
		return B_BAD_PORT_ID;
	// A quitting looper lets its handlers go after closing its port: a
	// handler missing from a closed port means the looper is gone.
	if (!target.fPreferredTarget
		&& tokens.HandlerIn(target.fHandlerToken, target.fLooperToken) == nullptr) {
		if (port->IsClosed())
			return B_BAD_PORT_ID;
		return B_BAD_HANDLER;
	}

	auto copy = std::make_unique<BMessage>(message);
	MessageData& data = MessageAccess::Data(*copy);
	data.delivered = false;
	data.target = target.fHandlerToken;
	data.preferredTarget = target.fPreferredTarget;
	if (replyTo.fLooperToken >= 0)
		data.returnAddress = replyTo;
	data.ticket = std::move(ticket);
	return port->Post(std::move(copy));
}

}

using BPrivate::MessengerAccess;
using BPrivate::TokenSpace;

BMessenger::BMessenger()
	: fLooperToken(-1), fHandlerToken(-1), fPreferredTarget(false), fTeam(-1)
{
}

BMessenger::BMessenger(const char* signature, team_id team, status_t* result)
	: BMessenger()
{
	// Only this program can be reached: it is the one team known here.
	status_t status = B_OK;
	if (signature == nullptr)
		status = B_BAD_VALUE;
	else if (team >= 0 && team != getpid())
		status = B_BAD_TEAM_ID;
	else if (be_app == nullptr || strcasecmp(signature, be_app->Signature()) != 0)
		status = B_BAD_VALUE;
	else
		*this = BMessenger(be_app);
	if (result != nullptr)
		*result = status;
}

BMessenger::BMessenger(const BHandler* handler, const BLooper* looper,
	status_t* result)
	: BMessenger()
{
	using BPrivate::HandlerAccess;
	status_t status = B_OK;
	if (handler != nullptr) {
		const int32 handlerToken = HandlerAccess::Token(handler);
		const int32 looperToken = TokenSpace::Default().LooperOf(handlerToken);
		if (looperToken < 0)
			status = B_BAD_HANDLER;
		else if (looper != nullptr && HandlerAccess::Token(looper) != looperToken)
			status = B_MISMATCHED_VALUES;
		else {
			fLooperToken = looperToken;
			fHandlerToken = handlerToken;
		}
	} else if (looper != nullptr) {
		fLooperToken = HandlerAccess::Token(looper);
		fPreferredTarget = true;
	} else {
		status = B_BAD_VALUE;
	}
	if (status == B_OK)
		fTeam = getpid();
	if (result != nullptr)
		*result = status;
}

BMessenger::BMessenger(const BMessenger& other) = default;

BMessenger::~BMessenger() = default;

BMessenger& BMessenger::operator=(const BMessenger& other) = default;

bool BMessenger::operator==(const BMessenger& other) const
{
	return fLooperToken == other.fLooperToken
		&& fHandlerToken == other.fHandlerToken
		&& fPreferredTarget == other.fPreferredTarget;
}

bool BMessenger::IsTargetLocal() const
{
	return fTeam >= 0 && fTeam == getpid();
}

BHandler* BMessenger::Target(BLooper** looper) const
{
	std::shared_ptr<BPrivate::LooperPort> port
		= TokenSpace::Default().PortFor(fLooperToken);
	BLooper* targetLooper = port != nullptr ? port->Looper() : nullptr;
	if (looper != nullptr)
		*looper = targetLooper;
	if (targetLooper == nullptr || fPreferredTarget)
		return nullptr;
	return TokenSpace::Default().HandlerIn(fHandlerToken, fLooperToken);
}

bool BMessenger::LockTarget() const
{
	return LockTargetWithTimeout(B_INFINITE_TIMEOUT) == B_OK;
}

status_t BMessenger::LockTargetWithTimeout(bigtime_t timeout) const
{
	std::shared_ptr<BPrivate::LooperPort> port
		= TokenSpace::Default().PortFor(fLooperToken);
	if (port == nullptr)
		return B_BAD_PORT_ID;
	status_t status = port->Lock(timeout);
	return status == B_BAD_VALUE ? B_BAD_PORT_ID : status;
}

status_t BMessenger::SendMessage(uint32 command, BHandler* replyTo) const
{
	BMessage message(command);
	return SendMessage(&message, replyTo);
}

status_t BMessenger::SendMessage(BMessage* message, BHandler* replyTo,
	bigtime_t timeout) const
{
	return SendMessage(message, replyTo != nullptr ? BMessenger(replyTo) : BMessenger(),
		timeout);
}

status_t BMessenger::SendMessage(BMessage* message, BMessenger replyTo,
	bigtime_t /*timeout: queues never fill up*/) const
{
	if (message == nullptr)
		return B_BAD_VALUE;
	return MessengerAccess::Deliver(*this, *message, replyTo, nullptr);
}

status_t BMessenger::SendMessage(uint32 command, BMessage* reply) const
{
	BMessage message(command);
	return SendMessage(&message, reply);
}

status_t BMessenger::SendMessage(BMessage* message, BMessage* reply,
	bigtime_t /*deliveryTimeout: queues never fill up*/, bigtime_t replyTimeout) const
{
	if (message == nullptr || reply == nullptr)
		return B_BAD_VALUE;
	// The looper's own thread would wait for itself forever.
	std::shared_ptr<BPrivate::LooperPort> port
		= TokenSpace::Default().PortFor(fLooperToken);
	if (port != nullptr && port->Thread() == find_thread(NULL))
		return B_MESSAGE_TO_SELF;
	auto slot = std::make_shared<BPrivate::ReplySlot>();
	status_t status = MessengerAccess::Deliver(*this, *message, BMessenger(),
		std::make_shared<BPrivate::ReplyTicket>(slot));
	if (status != B_OK)
		return status;
	return slot->Wait(replyTimeout, reply);
}

bool BMessenger::IsValid() const
{
	std::shared_ptr<BPrivate::LooperPort> port
		= TokenSpace::Default().PortFor(fLooperToken);
	return port != nullptr && !port->IsClosed();
}

team_id BMessenger::Team() const
{
	return fTeam;
}
