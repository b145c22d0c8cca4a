#ifndef TESTS_KIT_APP_RECORDER_H
#define TESTS_KIT_APP_RECORDER_H

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <vector>

#include <Handler.h>
#include <Message.h>

// Keeps a copy of every message it handles, in order.
class MessageLog {
public:
	void Add(const BMessage& message)
	{
		{
			std::lock_guard<std::mutex> lock(fMutex);
			fMessages.push_back(message);
		}
		fChanged.notify_all();
	}

	std::vector<BMessage> Messages() const
	{
		std::lock_guard<std::mutex> lock(fMutex);
		return fMessages;
	}

	size_t Count() const
	{
		std::lock_guard<std::mutex> lock(fMutex);
		return fMessages.size();
	}

	// False if fewer came within a generous bound: a hang, not a slow machine.
	bool WaitForCount(size_t count) const
	{
		std::unique_lock<std::mutex> lock(fMutex);
		return fChanged.wait_for(lock, std::chrono::seconds(30),
			[&] { return fMessages.size() >= count; });
	}

private:
	mutable std::mutex fMutex;
	mutable std::condition_variable fChanged;
	std::vector<BMessage> fMessages;
};

class Recorder : public BHandler {
public:
	explicit Recorder(const char* name = "recorder") : BHandler(name) {}
	void MessageReceived(BMessage* message) override { log.Add(*message); }

	MessageLog log;
};

#endif
