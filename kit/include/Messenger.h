#ifndef _MESSENGER_H
#define _MESSENGER_H

#include <OS.h>

class BHandler;
class BLooper;
class BMessage;

namespace BPrivate {
class MessengerAccess;
}

// A safe address of a handler in a looper. Sending to a target that has gone
// away fails with B_BAD_PORT_ID or B_BAD_HANDLER instead of crashing.
class BMessenger {
public:
	BMessenger();
	BMessenger(const char* signature, team_id team = -1, status_t* result = NULL);
	BMessenger(const BHandler* handler, const BLooper* looper = NULL,
		status_t* result = NULL);
	BMessenger(const BMessenger& other);
	~BMessenger();
	BMessenger& operator=(const BMessenger& other);
	bool operator==(const BMessenger& other) const;
	bool operator!=(const BMessenger& other) const { return !(*this == other); }

	bool IsTargetLocal() const;
	// The target handler (NULL for the looper's preferred handler) and its
	// looper; only safe to use while the looper is locked.
	BHandler* Target(BLooper** looper) const;
	bool LockTarget() const;
	status_t LockTargetWithTimeout(bigtime_t timeout) const;

	// Queues a copy of the message and returns.
	status_t SendMessage(uint32 command, BHandler* replyTo = NULL) const;
	status_t SendMessage(BMessage* message, BHandler* replyTo = NULL,
		bigtime_t timeout = B_INFINITE_TIMEOUT) const;
	status_t SendMessage(BMessage* message, BMessenger replyTo,
		bigtime_t timeout = B_INFINITE_TIMEOUT) const;
	// Sends and waits for the reply; a target that does not answer produces
	// a B_NO_REPLY reply.
	status_t SendMessage(uint32 command, BMessage* reply) const;
	status_t SendMessage(BMessage* message, BMessage* reply,
		bigtime_t deliveryTimeout = B_INFINITE_TIMEOUT,
		bigtime_t replyTimeout = B_INFINITE_TIMEOUT) const;

	bool IsValid() const;
	team_id Team() const;

private:
	friend class BPrivate::MessengerAccess;

	// Tokens into the kit's registries of loopers and handlers; a token of a
	// deleted object never resolves again.
	int32 fLooperToken;
	int32 fHandlerToken;
	bool fPreferredTarget;
	team_id fTeam;
};

#endif
