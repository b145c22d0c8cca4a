#ifndef KIT_APP_LOOPER_ACCESS_H
#define KIT_APP_LOOPER_ACCESS_H

#include <memory>

#include <Looper.h>

namespace BPrivate {

class LooperPort;

class HandlerAccess {
public:
	static int32 Token(const BHandler* handler);
	// Records in the handler and in the token space which looper it is in.
	static void SetLooper(BHandler* handler, BLooper* looper);
};

class LooperAccess {
public:
	static const std::shared_ptr<LooperPort>& Port(const BLooper* looper);
	// Delivers message to the handler it is addressed to, with the looper
	// locked by the caller, then deletes it unless it was detached. The
	// caller then ends the dispatch (LooperPort::DoneDispatching).
	// Quit was called in the looper's own thread.
	static bool IsQuitting(const BLooper* looper);
	static void Dispatch(BLooper* looper, std::unique_ptr<BMessage> message);
	// Dispatches the messages queued now, waiting at most timeout for the
	// first; false once the loop must end.
	static bool DispatchQueued(BLooper* looper, bigtime_t timeout);
};

}

#endif
