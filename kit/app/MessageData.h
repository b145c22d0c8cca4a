#ifndef KIT_APP_MESSAGE_DATA_H
#define KIT_APP_MESSAGE_DATA_H

#include <condition_variable>
#include <cstring>
#include <memory>
#include <mutex>
#include <string>
#include <type_traits>
#include <vector>

#include <Message.h>
#include <Messenger.h>

namespace BPrivate {

// One value of a field. Each value has its own heap block, so pointers
// handed out by FindString and FindData survive additions to the message.
struct MessageValue {
	std::unique_ptr<char[]> bytes;
	ssize_t size = 0;
};

// Reads a fixed-size value out of a field; a bool is any non-zero byte.
template<typename T>
T ReadFixed(const void* bytes)
{
	if constexpr (std::is_same_v<T, bool>) {
		return *static_cast<const uint8*>(bytes) != 0;
	} else {
		T value;
		std::memcpy(&value, bytes, sizeof(T));
		return value;
	}
}

struct MessageField {
	std::string name;
	type_code type = 0;
	bool fixedSize = true;
	std::vector<MessageValue> values;
};

// Where the answer to a synchronous send goes. The first answer wins.
class ReplySlot {
public:
	status_t Answer(std::unique_ptr<BMessage> reply);
	bool IsAnswered();
	// Copies the answer into reply; B_TIMED_OUT when none came in time.
	status_t Wait(bigtime_t timeout, BMessage* reply);

private:
	std::mutex fMutex;
	std::condition_variable fAnswered;
	std::unique_ptr<BMessage> fReply;
};

// Held by the one delivered message whose sender waits for an answer (copies
// do not take it along). When that message goes away unanswered, the sender
// gets B_NO_REPLY.
struct ReplyTicket {
	explicit ReplyTicket(std::shared_ptr<ReplySlot> replySlot)
		: slot(std::move(replySlot)) {}
	~ReplyTicket();
	ReplyTicket(const ReplyTicket&) = delete;
	ReplyTicket& operator=(const ReplyTicket&) = delete;

	std::shared_ptr<ReplySlot> slot;
};

struct MessageData {
	MessageData() = default;
	MessageData(const MessageData& other);
	MessageData& operator=(const MessageData& other);

	MessageField* FindField(const char* name);
	const MessageField* FindField(const char* name) const;

	status_t Add(const char* name, type_code type, const void* data,
		ssize_t size, bool fixedSize);
	// B_ANY_TYPE matches a field of any type.
	status_t Find(const char* name, type_code type, int32 index,
		const void** data, ssize_t* size) const;
	status_t Replace(const char* name, type_code type, int32 index,
		const void* data, ssize_t size);
	status_t Remove(const char* name, int32 index);
	status_t RemoveField(const char* name);

	// Everything except the fields and "what": how the message travels.
	void ClearDelivery();

	std::vector<std::unique_ptr<MessageField>> fields;

	bool dropped = false;
	BPoint dropPoint;
	BPoint dropOffset;

	bool delivered = false;
	bool isReply = false;
	// The handler token the message is addressed to, or the looper's
	// preferred handler.
	int32 target = -1;
	bool preferredTarget = false;
	BMessenger returnAddress;
	std::shared_ptr<ReplyTicket> ticket;
	std::shared_ptr<const BMessage> previous;
};

// Unflattens size bytes of a flattened message into message.
status_t UnflattenMessage(BMessage* message, const char* buffer, ssize_t size);

}

#endif
