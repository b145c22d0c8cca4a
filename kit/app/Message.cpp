#include <Message.h>

#include <cctype>
#include <cstring>

#include "MessageData.h"
#include "MessagePrivate.h"

namespace BPrivate {

namespace {

MessageValue CopyValue(const void* data, ssize_t size)
{
	MessageValue value;
	value.bytes = std::make_unique<char[]>(size);
	std::memcpy(value.bytes.get(), data, size);
	value.size = size;
	return value;
}

std::unique_ptr<MessageField> CopyField(const MessageField& field)
{
	auto copy = std::make_unique<MessageField>();
	copy->name = field.name;
	copy->type = field.type;
	copy->fixedSize = field.fixedSize;
	copy->values.reserve(field.values.size());
	for (const MessageValue& value : field.values)
		copy->values.push_back(CopyValue(value.bytes.get(), value.size));
	return copy;
}

}

MessageData::MessageData(const MessageData& other)
{
	*this = other;
}

MessageData& MessageData::operator=(const MessageData& other)
{
	if (this == &other)
		return *this;
	std::vector<std::unique_ptr<MessageField>> copies;
	copies.reserve(other.fields.size());
	for (const auto& field : other.fields)
		copies.push_back(CopyField(*field));
	fields = std::move(copies);
	dropped = other.dropped;
	dropPoint = other.dropPoint;
	dropOffset = other.dropOffset;
	delivered = other.delivered;
	isReply = other.isReply;
	target = other.target;
	preferredTarget = other.preferredTarget;
	returnAddress = other.returnAddress;
	// The sender waits on the delivered message only, never on copies.
	ticket.reset();
	previous = other.previous;
	return *this;
}

MessageField* MessageData::FindField(const char* name)
{
	for (const auto& field : fields) {
		if (field->name == name)
			return field.get();
	}
	return nullptr;
}

const MessageField* MessageData::FindField(const char* name) const
{
	return const_cast<MessageData*>(this)->FindField(name);
}

status_t MessageData::Add(const char* name, type_code type, const void* data,
	ssize_t size, bool fixedSize)
{
	if (name == nullptr || data == nullptr || size <= 0 || type == B_ANY_TYPE)
		return B_BAD_VALUE;
	MessageField* field = FindField(name);
	if (field == nullptr) {
		auto created = std::make_unique<MessageField>();
		created->name = name;
		created->type = type;
		created->fixedSize = fixedSize;
		field = created.get();
		fields.push_back(std::move(created));
	} else if (field->type != type) {
		return B_BAD_TYPE;
	} else if (field->fixedSize && field->values.front().size != size) {
		return B_BAD_VALUE;
	}
	field->values.push_back(CopyValue(data, size));
	return B_OK;
}

status_t MessageData::Find(const char* name, type_code type, int32 index,
	const void** data, ssize_t* size) const
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const MessageField* field = FindField(name);
	if (field == nullptr)
		return B_NAME_NOT_FOUND;
	if (type != B_ANY_TYPE && field->type != type)
		return B_BAD_TYPE;
	if (index < 0 || index >= static_cast<int32>(field->values.size()))
		return B_BAD_INDEX;
	const MessageValue& value = field->values[index];
	if (data != nullptr)
		*data = value.bytes.get();
	if (size != nullptr)
		*size = value.size;
	return B_OK;
}

status_t MessageData::Replace(const char* name, type_code type, int32 index,
	const void* data, ssize_t size)
{
	if (data == nullptr || size <= 0)
		return B_BAD_VALUE;
	status_t status = Find(name, type, index, nullptr, nullptr);
	if (status != B_OK)
		return status;
	MessageField* field = FindField(name);
	if (field->fixedSize && field->values[index].size != size)
		return B_BAD_VALUE;
	field->values[index] = CopyValue(data, size);
	return B_OK;
}

status_t MessageData::Remove(const char* name, int32 index)
{
	status_t status = Find(name, B_ANY_TYPE, index, nullptr, nullptr);
	if (status != B_OK)
		return status;
	MessageField* field = FindField(name);
	field->values.erase(field->values.begin() + index);
	if (field->values.empty())
		RemoveField(name);
	return B_OK;
}

status_t MessageData::RemoveField(const char* name)
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const size_t count = std::erase_if(fields,
		[name](const auto& field) { return field->name == name; });
	return count > 0 ? B_OK : B_NAME_NOT_FOUND;
}

void MessageData::ClearDelivery()
{
	delivered = false;
	isReply = false;
	target = -1;
	preferredTarget = false;
	returnAddress = BMessenger();
	ticket.reset();
	previous.reset();
}

void MessageAccess::SetDropped(BMessage* message, BPoint screenPoint,
	BPoint offset)
{
	MessageData& data = Data(*message);
	data.dropped = true;
	data.dropPoint = screenPoint;
	data.dropOffset = offset;
}

void MessageAccess::SetReturnAddress(BMessage* message, const BMessenger& replyTo)
{
	Data(*message).returnAddress = replyTo;
}

}

using BPrivate::MessageData;
using BPrivate::MessageField;

BMessage::BMessage()
	: what(0), fData(std::make_unique<MessageData>())
{
}

BMessage::BMessage(uint32 command)
	: what(command), fData(std::make_unique<MessageData>())
{
}

BMessage::BMessage(const BMessage& other)
	: what(other.what), fData(std::make_unique<MessageData>(*other.fData))
{
}

BMessage::~BMessage() = default;

BMessage& BMessage::operator=(const BMessage& other)
{
	what = other.what;
	*fData = *other.fData;
	return *this;
}

status_t BMessage::GetInfo(type_code typeRequested, int32 index,
	char** nameFound, type_code* typeFound, int32* countFound) const
{
	if (index < 0)
		return B_BAD_INDEX;
	int32 matching = 0;
	for (const auto& field : fData->fields) {
		if (typeRequested != B_ANY_TYPE && field->type != typeRequested)
			continue;
		if (matching++ != index)
			continue;
		if (nameFound != nullptr)
			*nameFound = const_cast<char*>(field->name.c_str());
		if (typeFound != nullptr)
			*typeFound = field->type;
		if (countFound != nullptr)
			*countFound = static_cast<int32>(field->values.size());
		return B_OK;
	}
	return matching == 0 ? B_BAD_TYPE : B_BAD_INDEX;
}

status_t BMessage::GetInfo(const char* name, type_code* typeFound,
	int32* countFound) const
{
	if (name == nullptr)
		return B_BAD_VALUE;
	const MessageField* field = fData->FindField(name);
	if (typeFound != nullptr)
		*typeFound = field != nullptr ? field->type : static_cast<type_code>(B_ANY_TYPE);
	if (countFound != nullptr)
		*countFound = field != nullptr ? static_cast<int32>(field->values.size()) : 0;
	return field != nullptr ? B_OK : B_NAME_NOT_FOUND;
}

status_t BMessage::GetInfo(const char* name, type_code* typeFound,
	bool* fixedSize) const
{
	status_t status = GetInfo(name, typeFound, static_cast<int32*>(nullptr));
	if (status == B_OK && fixedSize != nullptr)
		*fixedSize = fData->FindField(name)->fixedSize;
	return status;
}

int32 BMessage::CountNames(type_code type) const
{
	int32 count = 0;
	for (const auto& field : fData->fields) {
		if (type == B_ANY_TYPE || field->type == type)
			count++;
	}
	return count;
}

bool BMessage::IsEmpty() const
{
	return fData->fields.empty();
}

bool BMessage::IsSystem() const
{
	// System codes are an underscore and three capitals ('_QRQ').
	const char first = static_cast<char>(what >> 24);
	for (int shift = 16; shift >= 0; shift -= 8) {
		if (!std::isupper(static_cast<unsigned char>(what >> shift)))
			return false;
	}
	return first == '_';
}

bool BMessage::IsReply() const
{
	return fData->isReply;
}

status_t BMessage::Rename(const char* oldEntry, const char* newEntry)
{
	if (oldEntry == nullptr || newEntry == nullptr)
		return B_BAD_VALUE;
	MessageField* field = fData->FindField(oldEntry);
	if (field == nullptr)
		return B_NAME_NOT_FOUND;
	if (field->name == newEntry)
		return B_OK;
	// Merging two fields could drop values of another type; refuse instead.
	if (fData->FindField(newEntry) != nullptr)
		return B_NAME_IN_USE;
	field->name = newEntry;
	return B_OK;
}

status_t BMessage::AddData(const char* name, type_code type, const void* data,
	ssize_t numBytes, bool isFixedSize, int32 /*count: a size hint only*/)
{
	return fData->Add(name, type, data, numBytes, isFixedSize);
}

status_t BMessage::RemoveData(const char* name, int32 index)
{
	return fData->Remove(name, index);
}

status_t BMessage::RemoveName(const char* name)
{
	return fData->RemoveField(name);
}

status_t BMessage::MakeEmpty()
{
	fData->fields.clear();
	return B_OK;
}

status_t BMessage::FindData(const char* name, type_code type, const void** data,
	ssize_t* numBytes) const
{
	return FindData(name, type, 0, data, numBytes);
}

status_t BMessage::FindData(const char* name, type_code type, int32 index,
	const void** data, ssize_t* numBytes) const
{
	if (data == nullptr || numBytes == nullptr)
		return B_BAD_VALUE;
	return fData->Find(name, type, index, data, numBytes);
}

status_t BMessage::ReplaceData(const char* name, type_code type,
	const void* data, ssize_t numBytes)
{
	return ReplaceData(name, type, 0, data, numBytes);
}

status_t BMessage::ReplaceData(const char* name, type_code type, int32 index,
	const void* data, ssize_t numBytes)
{
	return fData->Replace(name, type, index, data, numBytes);
}

bool BMessage::HasData(const char* name, type_code type, int32 index) const
{
	return fData->Find(name, type, index, nullptr, nullptr) == B_OK;
}
