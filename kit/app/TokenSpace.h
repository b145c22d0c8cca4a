#ifndef KIT_APP_TOKEN_SPACE_H
#define KIT_APP_TOKEN_SPACE_H

#include <map>
#include <memory>
#include <mutex>
#include <vector>

#include <OS.h>

class BHandler;
class BLooper;

namespace BPrivate {

class LooperPort;

// The kit's registry of handlers and loopers by token. Messengers hold
// tokens, never pointers: a token of a deleted object never resolves again,
// since tokens are not reused. A looper's token is its handler token.
class TokenSpace {
public:
	static TokenSpace& Default();

	int32 AddHandler(BHandler* handler);
	void RemoveHandler(int32 token);
	// looperToken -1: the handler belongs to no looper.
	void SetHandlerLooper(int32 handlerToken, int32 looperToken);
	// The handler, if it still exists and belongs to that looper.
	BHandler* HandlerIn(int32 handlerToken, int32 looperToken) const;
	// The token of the handler's looper, -1 if none.
	int32 LooperOf(int32 handlerToken) const;

	void AddLooper(const std::shared_ptr<LooperPort>& port);
	void RemoveLooper(int32 token);
	std::shared_ptr<LooperPort> PortFor(int32 looperToken) const;
	// The port of a looper that still exists; NULL once it is deleted.
	std::shared_ptr<LooperPort> PortOf(const BLooper* looper) const;
	std::vector<std::shared_ptr<LooperPort>> Ports() const;

private:
	struct HandlerEntry {
		BHandler* handler;
		int32 looperToken;
	};

	mutable std::mutex fMutex;
	int32 fNextToken = 1;
	std::map<int32, HandlerEntry> fHandlers;
	std::map<int32, std::shared_ptr<LooperPort>> fLoopers;
	std::map<const BLooper*, int32> fLooperTokens;
};

}

#endif
