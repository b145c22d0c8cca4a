#include <Handler.h>

#include <atomic>
#include <string>

#include <Looper.h>

#include "LooperAccess.h"
#include "LooperPort.h"
#include "TokenSpace.h"

namespace BPrivate {

struct HandlerData {
	std::string name;
	int32 token = -1;
	// Read by other threads (LockLooper) while the looper's thread changes it.
	std::atomic<BLooper*> looper{nullptr};
	BHandler* next = nullptr;
};

int32 HandlerAccess::Token(const BHandler* handler)
{
	return handler->fHandlerData->token;
}

void HandlerAccess::SetLooper(BHandler* handler, BLooper* looper)
{
	handler->fHandlerData->looper = looper;
	TokenSpace::Default().SetHandlerLooper(Token(handler),
		looper != nullptr ? Token(looper) : -1);
}

}

using BPrivate::TokenSpace;

BHandler::BHandler(const char* name)
	: fHandlerData(std::make_unique<BPrivate::HandlerData>())
{
	SetName(name);
	fHandlerData->token = TokenSpace::Default().AddHandler(this);
}

BHandler::~BHandler()
{
	if (BLooper* looper = Looper())
		looper->RemoveHandler(this);
	TokenSpace::Default().RemoveHandler(fHandlerData->token);
}

void BHandler::MessageReceived(BMessage* message)
{
	if (fHandlerData->next != nullptr)
		fHandlerData->next->MessageReceived(message);
}

BLooper* BHandler::Looper() const
{
	return fHandlerData->looper;
}

void BHandler::SetName(const char* name)
{
	fHandlerData->name = name != nullptr ? name : "";
}

const char* BHandler::Name() const
{
	return fHandlerData->name.c_str();
}

void BHandler::SetNextHandler(BHandler* handler)
{
	fHandlerData->next = handler;
}

BHandler* BHandler::NextHandler() const
{
	return fHandlerData->next;
}

bool BHandler::LockLooper()
{
	return LockLooperWithTimeout(B_INFINITE_TIMEOUT) == B_OK;
}

status_t BHandler::LockLooperWithTimeout(bigtime_t timeout)
{
	// Go through the token space: the looper may be deleted meanwhile.
	TokenSpace& tokens = TokenSpace::Default();
	const int32 looperToken = tokens.LooperOf(fHandlerData->token);
	std::shared_ptr<BPrivate::LooperPort> port = tokens.PortFor(looperToken);
	if (port == nullptr)
		return B_BAD_VALUE;
	status_t status = port->Lock(timeout);
	if (status != B_OK)
		return status;
	if (tokens.LooperOf(fHandlerData->token) != looperToken) {
		port->Unlock();
		return B_MISMATCHED_VALUES;
	}
	return B_OK;
}

void BHandler::UnlockLooper()
{
	if (BLooper* looper = Looper())
		looper->Unlock();
}
