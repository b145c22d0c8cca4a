#include <Looper.h>

#include <algorithm>
#include <future>
#include <string>
#include <system_error>
#include <thread>
#include <vector>

#include <pthread.h>
#include <unistd.h>

#include <AppDefs.h>
#include <Message.h>
#include <Messenger.h>

#include "LooperAccess.h"
#include "LooperPort.h"
#include "MessageData.h"
#include "MessagePrivate.h"
#include "TokenSpace.h"

namespace BPrivate {

struct LooperData {
	std::shared_ptr<LooperPort> port;
	std::thread thread;
	bool ran = false;
	// Quit was called in the looper's thread: delete after this message.
	bool quitting = false;
	std::vector<BHandler*> handlers;
	BHandler* preferred = nullptr;
	BMessage* current = nullptr;
};

namespace {

void LooperThread(std::shared_ptr<LooperPort> port, BLooper* looper,
	std::promise<thread_id>* started)
{
	port->SetThread(find_thread(NULL));
	port->SetRunning(true);
	started->set_value(find_thread(NULL));

	// Once the port is closed, nothing here touches the looper again.
	while (std::unique_ptr<BMessage> message = port->Next(B_INFINITE_TIMEOUT)) {
		if (port->Lock(B_INFINITE_TIMEOUT) != B_OK) {
			port->DoneDispatching();
			return;
		}
		LooperAccess::Dispatch(looper, std::move(message));
		const bool quitting = LooperAccess::IsQuitting(looper);
		if (quitting)
			delete looper;
		// Idle only now: the looper's windows and views are gone with it.
		port->DoneDispatching();
		if (quitting)
			return;
		port->Unlock();
	}
}

}

const std::shared_ptr<LooperPort>& LooperAccess::Port(const BLooper* looper)
{
	return looper->fLooperData->port;
}

bool LooperAccess::IsQuitting(const BLooper* looper)
{
	return looper->fLooperData->quitting;
}

void LooperAccess::Dispatch(BLooper* looper, std::unique_ptr<BMessage> message)
{
	LooperData& data = *looper->fLooperData;
	MessageData& delivery = MessageAccess::Data(*message);
	delivery.delivered = true;
	BHandler* handler;
	if (delivery.preferredTarget) {
		handler = data.preferred != nullptr ? data.preferred : looper;
	} else {
		// A handler deleted or moved since the message was sent gets nothing.
		handler = TokenSpace::Default().HandlerIn(delivery.target, data.port->Token());
	}
	if (handler != nullptr) {
		data.current = message.get();
		looper->DispatchMessage(message.get(), handler);
		if (data.current == nullptr)
			message.release();
		data.current = nullptr;
	}
	message.reset();
}

bool LooperAccess::DispatchQueued(BLooper* looper, bigtime_t timeout)
{
	const std::shared_ptr<LooperPort>& port = Port(looper);
	std::unique_ptr<BMessage> message = port->Next(timeout);
	// Only what is queued now: a handler that keeps posting to its own
	// looper must not starve the caller's other work.
	int32 left = message != nullptr ? port->CountMessages() : 0;
	while (message != nullptr) {
		if (port->Lock(B_INFINITE_TIMEOUT) != B_OK)
			return false;
		Dispatch(looper, std::move(message));
		port->DoneDispatching();
		port->Unlock();
		if (left-- == 0)
			break;
		message = port->Next(0);
	}
	return !port->IsStopRequested() && !port->IsClosed();
}

}

using BPrivate::HandlerAccess;
using BPrivate::LooperPort;
using BPrivate::TokenSpace;

BLooper::BLooper(const char* name, int32 /*priority*/, int32 /*portCapacity*/)
	: BHandler(name), fLooperData(std::make_unique<BPrivate::LooperData>())
{
	BPrivate::LooperData& data = *fLooperData;
	data.port = std::make_shared<LooperPort>(this, HandlerAccess::Token(this));
	// As on the platform, a new looper is locked by its creator until Run.
	data.port->Lock(B_INFINITE_TIMEOUT);
	TokenSpace::Default().AddLooper(data.port);
	AddHandler(this);
}

BLooper::~BLooper()
{
	BPrivate::LooperData& data = *fLooperData;
	data.port->Close();
	if (data.thread.joinable()) {
		if (data.thread.get_id() == std::this_thread::get_id())
			data.thread.detach();
		else
			data.thread.join();
	}
	for (BHandler* handler : data.handlers) {
		HandlerAccess::SetLooper(handler, nullptr);
		if (handler != this)
			handler->SetNextHandler(nullptr);
	}
	data.handlers.clear();
	TokenSpace::Default().RemoveLooper(data.port->Token());
	data.port->ForgetLooper();
}

status_t BLooper::PostMessage(uint32 command)
{
	BMessage message(command);
	return PostMessage(&message);
}

status_t BLooper::PostMessage(BMessage* message)
{
	return PostMessage(message, this);
}

status_t BLooper::PostMessage(uint32 command, BHandler* handler, BHandler* replyTo)
{
	BMessage message(command);
	return PostMessage(&message, handler, replyTo);
}

status_t BLooper::PostMessage(BMessage* message, BHandler* handler,
	BHandler* replyTo)
{
	if (message == nullptr)
		return B_BAD_VALUE;
	if (handler != nullptr && handler->Looper() != this)
		return B_MISMATCHED_VALUES;
	BMessenger target(handler, this);
	return target.SendMessage(message, replyTo);
}

void BLooper::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (message->what == B_QUIT_REQUESTED && handler == this) {
		const bool quit = QuitRequested();
		if (message->IsSourceWaiting()) {
			BMessage reply(B_REPLY);
			reply.AddBool("result", quit);
			message->SendReply(&reply);
		}
		if (quit)
			Quit();
		return;
	}
	handler->MessageReceived(message);
}

void BLooper::MessageReceived(BMessage* message)
{
	BHandler::MessageReceived(message);
}

BMessage* BLooper::CurrentMessage() const
{
	return fLooperData->current;
}

BMessage* BLooper::DetachCurrentMessage()
{
	BMessage* message = fLooperData->current;
	fLooperData->current = nullptr;
	return message;
}

bool BLooper::IsMessageWaiting() const
{
	return fLooperData->port->CountMessages() > 0;
}

void BLooper::AddHandler(BHandler* handler)
{
	// A handler belongs to one looper at a time.
	if (handler == nullptr || handler->Looper() != nullptr)
		return;
	HandlerAccess::SetLooper(handler, this);
	if (handler != this)
		handler->SetNextHandler(this);
	fLooperData->handlers.push_back(handler);
}

bool BLooper::RemoveHandler(BHandler* handler)
{
	if (handler == nullptr || handler == this || handler->Looper() != this)
		return false;
	BPrivate::LooperData& data = *fLooperData;
	std::erase(data.handlers, handler);
	if (data.preferred == handler)
		data.preferred = nullptr;
	HandlerAccess::SetLooper(handler, nullptr);
	handler->SetNextHandler(nullptr);
	return true;
}

int32 BLooper::CountHandlers() const
{
	return static_cast<int32>(fLooperData->handlers.size());
}

BHandler* BLooper::HandlerAt(int32 index) const
{
	if (index < 0 || index >= CountHandlers())
		return nullptr;
	return fLooperData->handlers[index];
}

int32 BLooper::IndexOf(BHandler* handler) const
{
	const auto& handlers = fLooperData->handlers;
	auto found = std::find(handlers.begin(), handlers.end(), handler);
	return found != handlers.end() ? static_cast<int32>(found - handlers.begin()) : -1;
}

BHandler* BLooper::PreferredHandler() const
{
	return fLooperData->preferred;
}

void BLooper::SetPreferredHandler(BHandler* handler)
{
	if (handler != nullptr && handler->Looper() != this)
		return;
	fLooperData->preferred = handler;
}

thread_id BLooper::Run()
{
	BPrivate::LooperData& data = *fLooperData;
	if (data.ran)
		return B_ALREADY_RUNNING;
	std::promise<thread_id> started;
	std::future<thread_id> thread = started.get_future();
	try {
		data.thread = std::thread(BPrivate::LooperThread, data.port, this, &started);
	} catch (const std::system_error&) {
		return B_NO_MORE_THREADS;
	}
	data.ran = true;
	// Threads show the looper's name in debuggers (at most 15 bytes).
	pthread_setname_np(data.thread.native_handle(), std::string(Name()).substr(0, 15).c_str());
	const thread_id id = thread.get();
	data.port->ReleaseConstructionLock();
	return id;
}

void BLooper::Quit()
{
	BPrivate::LooperData& data = *fLooperData;
	if (!data.ran) {
		delete this;
		return;
	}
	if (find_thread(NULL) == data.port->Thread()) {
		// Ends after the current message; later ones are refused.
		data.quitting = true;
		data.port->Close();
		return;
	}
	// From another thread the caller should hold the lock; take it if not.
	// It fails only when the looper is already quitting by itself.
	if (!data.port->IsLockedByCaller() && data.port->Lock(B_INFINITE_TIMEOUT) != B_OK)
		return;
	data.port->Close();
	data.thread.join();
	delete this;
}

bool BLooper::QuitRequested()
{
	return true;
}

bool BLooper::Lock()
{
	return LockWithTimeout(B_INFINITE_TIMEOUT) == B_OK;
}

void BLooper::Unlock()
{
	fLooperData->port->Unlock();
}

status_t BLooper::LockWithTimeout(bigtime_t timeout)
{
	// As on the platform, locking a looper that is gone fails instead of
	// touching it; the port is held while waiting, since the looper may be
	// deleted meanwhile.
	std::shared_ptr<BPrivate::LooperPort> port = TokenSpace::Default().PortOf(this);
	if (port == nullptr)
		return B_BAD_VALUE;
	return port->Lock(timeout);
}

bool BLooper::IsLocked() const
{
	return fLooperData->port->IsLockedByCaller();
}

thread_id BLooper::LockingThread() const
{
	return fLooperData->port->LockingThread();
}

int32 BLooper::CountLocks() const
{
	return fLooperData->port->CountLocks();
}

thread_id BLooper::Thread() const
{
	return fLooperData->port->Thread();
}

team_id BLooper::Team() const
{
	return getpid();
}

BLooper* BLooper::LooperForThread(thread_id thread)
{
	// Loopers that never ran have no thread (-1).
	if (thread < 0)
		return nullptr;
	for (const auto& port : TokenSpace::Default().Ports()) {
		if (port->Thread() == thread)
			return port->Looper();
	}
	return nullptr;
}
