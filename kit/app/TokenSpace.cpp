#include "TokenSpace.h"

#include "LooperPort.h"

namespace BPrivate {

TokenSpace& TokenSpace::Default()
{
	// Never destroyed: looper threads may still run while the program exits.
	static TokenSpace* space = new TokenSpace;
	return *space;
}

int32 TokenSpace::AddHandler(BHandler* handler)
{
	std::lock_guard<std::mutex> lock(fMutex);
	const int32 token = fNextToken++;
	fHandlers[token] = HandlerEntry{handler, -1};
	return token;
}

void TokenSpace::RemoveHandler(int32 token)
{
	std::lock_guard<std::mutex> lock(fMutex);
	fHandlers.erase(token);
}

void TokenSpace::SetHandlerLooper(int32 handlerToken, int32 looperToken)
{
	std::lock_guard<std::mutex> lock(fMutex);
	auto found = fHandlers.find(handlerToken);
	if (found != fHandlers.end())
		found->second.looperToken = looperToken;
}

BHandler* TokenSpace::HandlerIn(int32 handlerToken, int32 looperToken) const
{
	std::lock_guard<std::mutex> lock(fMutex);
	auto found = fHandlers.find(handlerToken);
	if (found == fHandlers.end() || found->second.looperToken != looperToken)
		return nullptr;
	return found->second.handler;
}

int32 TokenSpace::LooperOf(int32 handlerToken) const
{
	std::lock_guard<std::mutex> lock(fMutex);
	auto found = fHandlers.find(handlerToken);
	return found != fHandlers.end() ? found->second.looperToken : -1;
}

void TokenSpace::AddLooper(const std::shared_ptr<LooperPort>& port)
{
	const BLooper* looper = port->Looper();
	std::lock_guard<std::mutex> lock(fMutex);
	fLoopers[port->Token()] = port;
	fLooperTokens[looper] = port->Token();
}

void TokenSpace::RemoveLooper(int32 token)
{
	std::shared_ptr<LooperPort> removed;
	std::lock_guard<std::mutex> lock(fMutex);
	auto found = fLoopers.find(token);
	if (found == fLoopers.end())
		return;
	removed = std::move(found->second);
	fLoopers.erase(found);
	std::erase_if(fLooperTokens, [token](const auto& entry) { return entry.second == token; });
}

std::shared_ptr<LooperPort> TokenSpace::PortFor(int32 looperToken) const
{
	std::lock_guard<std::mutex> lock(fMutex);
	auto found = fLoopers.find(looperToken);
	return found != fLoopers.end() ? found->second : nullptr;
}

std::shared_ptr<LooperPort> TokenSpace::PortOf(const BLooper* looper) const
{
	std::lock_guard<std::mutex> lock(fMutex);
	auto found = fLooperTokens.find(looper);
	if (found == fLooperTokens.end())
		return nullptr;
	return fLoopers.at(found->second);
}

std::vector<std::shared_ptr<LooperPort>> TokenSpace::Ports() const
{
	std::lock_guard<std::mutex> lock(fMutex);
	std::vector<std::shared_ptr<LooperPort>> ports;
	ports.reserve(fLoopers.size());
	for (const auto& entry : fLoopers)
		ports.push_back(entry.second);
	return ports;
}

}
