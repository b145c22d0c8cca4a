// The typed accessors of BMessage, all on top of the raw field store.

#include <Message.h>

#include <cstring>
#include <vector>

#include <Entry.h>
#include <Flattenable.h>

#include "MessageData.h"
#include "MessengerAccess.h"
#include "RefFlattening.h"

using BPrivate::MessageData;

namespace {

template<typename T>
status_t AddFixed(MessageData& data, const char* name, type_code type, const T& value)
{
	return data.Add(name, type, &value, sizeof(T), true);
}

template<typename T>
status_t FindFixed(const MessageData& data, const char* name, type_code type,
	int32 index, T* value)
{
	if (value == nullptr)
		return B_BAD_VALUE;
	const void* bytes;
	ssize_t size;
	status_t status = data.Find(name, type, index, &bytes, &size);
	if (status != B_OK)
		return status;
	// Raw data added under this type with another size is not a T.
	if (size != static_cast<ssize_t>(sizeof(T)))
		return B_BAD_DATA;
	*value = BPrivate::ReadFixed<T>(bytes);
	return B_OK;
}

std::vector<char> FlattenedRef(const entry_ref& ref)
{
	std::vector<char> buffer(BPrivate::FlattenedRefSize(ref));
	BPrivate::FlattenRef(ref, buffer.data(), buffer.size());
	return buffer;
}

std::vector<char> FlattenedMessage(const BMessage& message)
{
	std::vector<char> buffer(message.FlattenedSize());
	message.Flatten(buffer.data(), buffer.size());
	return buffer;
}

}

#define FIXED_ADD_FIND(Name, Type, Code) \
	status_t BMessage::Add##Name(const char* name, Type value) \
	{ \
		return AddFixed(*fData, name, Code, value); \
	} \
	status_t BMessage::Find##Name(const char* name, Type* value) const \
	{ \
		return FindFixed(*fData, name, Code, 0, value); \
	} \
	status_t BMessage::Find##Name(const char* name, int32 index, Type* value) const \
	{ \
		return FindFixed(*fData, name, Code, index, value); \
	}

#define FIXED_REPLACE(Name, Type, Code) \
	status_t BMessage::Replace##Name(const char* name, Type value) \
	{ \
		return Replace##Name(name, 0, value); \
	} \
	status_t BMessage::Replace##Name(const char* name, int32 index, Type value) \
	{ \
		return fData->Replace(name, Code, index, &value, sizeof(Type)); \
	}

#define HAS(Name, Code) \
	bool BMessage::Has##Name(const char* name, int32 index) const \
	{ \
		return HasData(name, Code, index); \
	}

FIXED_ADD_FIND(Rect, BRect, B_RECT_TYPE)
FIXED_ADD_FIND(Point, BPoint, B_POINT_TYPE)
FIXED_ADD_FIND(Int8, int8, B_INT8_TYPE)
FIXED_ADD_FIND(UInt8, uint8, B_UINT8_TYPE)
FIXED_ADD_FIND(Int16, int16, B_INT16_TYPE)
FIXED_ADD_FIND(UInt16, uint16, B_UINT16_TYPE)
FIXED_ADD_FIND(Int32, int32, B_INT32_TYPE)
FIXED_ADD_FIND(UInt32, uint32, B_UINT32_TYPE)
FIXED_ADD_FIND(Int64, int64, B_INT64_TYPE)
FIXED_ADD_FIND(UInt64, uint64, B_UINT64_TYPE)
FIXED_ADD_FIND(Bool, bool, B_BOOL_TYPE)
FIXED_ADD_FIND(Float, float, B_FLOAT_TYPE)
FIXED_ADD_FIND(Double, double, B_DOUBLE_TYPE)

FIXED_REPLACE(Rect, BRect, B_RECT_TYPE)
FIXED_REPLACE(Point, BPoint, B_POINT_TYPE)
FIXED_REPLACE(Int8, int8, B_INT8_TYPE)
FIXED_REPLACE(Int16, int16, B_INT16_TYPE)
FIXED_REPLACE(Int32, int32, B_INT32_TYPE)
FIXED_REPLACE(Int64, int64, B_INT64_TYPE)
FIXED_REPLACE(Bool, bool, B_BOOL_TYPE)
FIXED_REPLACE(Float, float, B_FLOAT_TYPE)
FIXED_REPLACE(Double, double, B_DOUBLE_TYPE)
FIXED_REPLACE(Pointer, const void*, B_POINTER_TYPE)

HAS(Rect, B_RECT_TYPE)
HAS(Point, B_POINT_TYPE)
HAS(String, B_STRING_TYPE)
HAS(Int8, B_INT8_TYPE)
HAS(Int16, B_INT16_TYPE)
HAS(Int32, B_INT32_TYPE)
HAS(Int64, B_INT64_TYPE)
HAS(Bool, B_BOOL_TYPE)
HAS(Float, B_FLOAT_TYPE)
HAS(Double, B_DOUBLE_TYPE)
HAS(Pointer, B_POINTER_TYPE)
HAS(Messenger, B_MESSENGER_TYPE)
HAS(Ref, B_REF_TYPE)
HAS(Message, B_MESSAGE_TYPE)

#undef FIXED_ADD_FIND
#undef FIXED_REPLACE
#undef HAS

// Pointers

status_t BMessage::AddPointer(const char* name, const void* pointer)
{
	return AddFixed(*fData, name, B_POINTER_TYPE, pointer);
}

status_t BMessage::FindPointer(const char* name, void** pointer) const
{
	return FindPointer(name, 0, pointer);
}

status_t BMessage::FindPointer(const char* name, int32 index, void** pointer) const
{
	return FindFixed(*fData, name, B_POINTER_TYPE, index, pointer);
}

// Strings, stored with their terminating NUL

status_t BMessage::AddString(const char* name, const char* string)
{
	if (string == nullptr)
		return B_BAD_VALUE;
	return fData->Add(name, B_STRING_TYPE, string, std::strlen(string) + 1, false);
}

status_t BMessage::FindString(const char* name, const char** string) const
{
	return FindString(name, 0, string);
}

status_t BMessage::FindString(const char* name, int32 index,
	const char** string) const
{
	if (string == nullptr)
		return B_BAD_VALUE;
	const void* bytes;
	ssize_t size;
	status_t status = fData->Find(name, B_STRING_TYPE, index, &bytes, &size);
	if (status != B_OK)
		return status;
	if (static_cast<const char*>(bytes)[size - 1] != '\0')
		return B_BAD_DATA;
	*string = static_cast<const char*>(bytes);
	return B_OK;
}

status_t BMessage::ReplaceString(const char* name, const char* string)
{
	return ReplaceString(name, 0, string);
}

status_t BMessage::ReplaceString(const char* name, int32 index, const char* string)
{
	if (string == nullptr)
		return B_BAD_VALUE;
	return fData->Replace(name, B_STRING_TYPE, index, string, std::strlen(string) + 1);
}

// Refs, in their one flat form

status_t BMessage::AddRef(const char* name, const entry_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	std::vector<char> flat = FlattenedRef(*ref);
	return fData->Add(name, B_REF_TYPE, flat.data(), flat.size(), false);
}

status_t BMessage::FindRef(const char* name, entry_ref* ref) const
{
	return FindRef(name, 0, ref);
}

status_t BMessage::FindRef(const char* name, int32 index, entry_ref* ref) const
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	const void* bytes;
	ssize_t size;
	status_t status = fData->Find(name, B_REF_TYPE, index, &bytes, &size);
	if (status != B_OK)
		return status;
	return BPrivate::UnflattenRef(ref, bytes, size);
}

status_t BMessage::ReplaceRef(const char* name, const entry_ref* ref)
{
	return ReplaceRef(name, 0, ref);
}

status_t BMessage::ReplaceRef(const char* name, int32 index, const entry_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	std::vector<char> flat = FlattenedRef(*ref);
	return fData->Replace(name, B_REF_TYPE, index, flat.data(), flat.size());
}

// Messages, flattened

status_t BMessage::AddMessage(const char* name, const BMessage* message)
{
	if (message == nullptr)
		return B_BAD_VALUE;
	std::vector<char> flat = FlattenedMessage(*message);
	return fData->Add(name, B_MESSAGE_TYPE, flat.data(), flat.size(), false);
}

status_t BMessage::FindMessage(const char* name, BMessage* message) const
{
	return FindMessage(name, 0, message);
}

status_t BMessage::FindMessage(const char* name, int32 index,
	BMessage* message) const
{
	if (message == nullptr)
		return B_BAD_VALUE;
	const void* bytes;
	ssize_t size;
	status_t status = fData->Find(name, B_MESSAGE_TYPE, index, &bytes, &size);
	if (status != B_OK)
		return status;
	return BPrivate::UnflattenMessage(message, static_cast<const char*>(bytes), size);
}

status_t BMessage::ReplaceMessage(const char* name, const BMessage* message)
{
	return ReplaceMessage(name, 0, message);
}

status_t BMessage::ReplaceMessage(const char* name, int32 index,
	const BMessage* message)
{
	if (message == nullptr)
		return B_BAD_VALUE;
	std::vector<char> flat = FlattenedMessage(*message);
	return fData->Replace(name, B_MESSAGE_TYPE, index, flat.data(), flat.size());
}

// Messengers

status_t BMessage::AddMessenger(const char* name, BMessenger messenger)
{
	return AddFixed(*fData, name, B_MESSENGER_TYPE,
		BPrivate::MessengerAccess::Flatten(messenger));
}

status_t BMessage::FindMessenger(const char* name, BMessenger* messenger) const
{
	return FindMessenger(name, 0, messenger);
}

status_t BMessage::FindMessenger(const char* name, int32 index,
	BMessenger* messenger) const
{
	if (messenger == nullptr)
		return B_BAD_VALUE;
	BPrivate::FlatMessenger flat;
	status_t status = FindFixed(*fData, name, B_MESSENGER_TYPE, index, &flat);
	if (status == B_OK)
		*messenger = BPrivate::MessengerAccess::Unflatten(flat);
	return status;
}

status_t BMessage::ReplaceMessenger(const char* name, BMessenger messenger)
{
	return ReplaceMessenger(name, 0, messenger);
}

status_t BMessage::ReplaceMessenger(const char* name, int32 index,
	BMessenger messenger)
{
	BPrivate::FlatMessenger flat = BPrivate::MessengerAccess::Flatten(messenger);
	return fData->Replace(name, B_MESSENGER_TYPE, index, &flat, sizeof(flat));
}

// Flattenable objects, stored under their own type code

namespace {

std::vector<char> FlattenedObject(const BFlattenable& object, status_t* status)
{
	ssize_t size = object.FlattenedSize();
	std::vector<char> buffer(size > 0 ? size : 0);
	*status = size > 0 ? object.Flatten(buffer.data(), size) : B_BAD_VALUE;
	return buffer;
}

}

status_t BMessage::AddFlat(const char* name, BFlattenable* object,
	int32 /*count: a size hint only*/)
{
	if (object == nullptr)
		return B_BAD_VALUE;
	status_t status;
	std::vector<char> flat = FlattenedObject(*object, &status);
	if (status != B_OK)
		return status;
	return fData->Add(name, object->TypeCode(), flat.data(), flat.size(),
		object->IsFixedSize());
}

status_t BMessage::FindFlat(const char* name, BFlattenable* object) const
{
	return FindFlat(name, 0, object);
}

status_t BMessage::FindFlat(const char* name, int32 index,
	BFlattenable* object) const
{
	if (object == nullptr)
		return B_BAD_VALUE;
	const void* bytes;
	ssize_t size;
	status_t status = fData->Find(name, B_ANY_TYPE, index, &bytes, &size);
	if (status != B_OK)
		return status;
	const type_code type = fData->FindField(name)->type;
	if (!object->AllowsTypeCode(type))
		return B_BAD_TYPE;
	return object->Unflatten(type, bytes, size);
}

status_t BMessage::ReplaceFlat(const char* name, BFlattenable* object)
{
	return ReplaceFlat(name, 0, object);
}

status_t BMessage::ReplaceFlat(const char* name, int32 index, BFlattenable* object)
{
	if (object == nullptr)
		return B_BAD_VALUE;
	status_t status;
	std::vector<char> flat = FlattenedObject(*object, &status);
	if (status != B_OK)
		return status;
	return fData->Replace(name, object->TypeCode(), index, flat.data(), flat.size());
}

bool BMessage::HasFlat(const char* name, const BFlattenable* object) const
{
	return HasFlat(name, 0, object);
}

bool BMessage::HasFlat(const char* name, int32 index,
	const BFlattenable* object) const
{
	if (object == nullptr || !HasData(name, B_ANY_TYPE, index))
		return false;
	return object->AllowsTypeCode(fData->FindField(name)->type);
}

// Values with defaults

bool BMessage::GetBool(const char* name, bool defaultValue) const
{
	bool value;
	return FindBool(name, &value) == B_OK ? value : defaultValue;
}

int32 BMessage::GetInt32(const char* name, int32 defaultValue) const
{
	int32 value;
	return FindInt32(name, &value) == B_OK ? value : defaultValue;
}

float BMessage::GetFloat(const char* name, float defaultValue) const
{
	float value;
	return FindFloat(name, &value) == B_OK ? value : defaultValue;
}

const char* BMessage::GetString(const char* name, const char* defaultValue) const
{
	const char* value;
	return FindString(name, &value) == B_OK ? value : defaultValue;
}
