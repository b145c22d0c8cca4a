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

// Store's index for a value added at the end.
constexpr int32 kAppend = -1;

status_t Store(MessageData& data, const char* name, type_code type, int32 index,
	const void* bytes, ssize_t size, bool fixedSize)
{
	if (index == kAppend)
		return data.Add(name, type, bytes, size, fixedSize);
	return data.Replace(name, type, index, bytes, size);
}

// Hands the bytes of a value to read, after the checks every Find makes.
template<typename Target, typename Read>
status_t FindValue(const MessageData& data, const char* name, type_code type,
	int32 index, Target* target, Read read)
{
	if (target == nullptr)
		return B_BAD_VALUE;
	const void* bytes;
	ssize_t size;
	status_t status = data.Find(name, type, index, &bytes, &size);
	return status == B_OK ? read(bytes, size) : status;
}

template<typename T>
status_t StoreFixed(MessageData& data, const char* name, type_code type,
	int32 index, const T& value)
{
	return Store(data, name, type, index, &value, sizeof(T), true);
}

template<typename T>
status_t FindFixed(const MessageData& data, const char* name, type_code type,
	int32 index, T* value)
{
	return FindValue(data, name, type, index, value,
		[value](const void* bytes, ssize_t size) -> status_t {
			// Raw data added under this type with another size is not a T.
			if (size != static_cast<ssize_t>(sizeof(T)))
				return B_BAD_DATA;
			*value = BPrivate::ReadFixed<T>(bytes);
			return B_OK;
		});
}

status_t StoreString(MessageData& data, const char* name, int32 index,
	const char* string)
{
	if (string == nullptr)
		return B_BAD_VALUE;
	return Store(data, name, B_STRING_TYPE, index, string, std::strlen(string) + 1,
		false);
}

// Refs are kept in their one flat form.
status_t StoreRef(MessageData& data, const char* name, int32 index,
	const entry_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	std::vector<char> flat(BPrivate::FlattenedRefSize(*ref));
	BPrivate::FlattenRef(*ref, flat.data(), flat.size());
	return Store(data, name, B_REF_TYPE, index, flat.data(), flat.size(), false);
}

status_t StoreMessage(MessageData& data, const char* name, int32 index,
	const BMessage* message)
{
	if (message == nullptr)
		return B_BAD_VALUE;
	std::vector<char> flat(message->FlattenedSize());
	message->Flatten(flat.data(), flat.size());
	return Store(data, name, B_MESSAGE_TYPE, index, flat.data(), flat.size(), false);
}

// A flattenable object is kept under its own type code.
status_t StoreFlat(MessageData& data, const char* name, int32 index,
	const BFlattenable* object)
{
	if (object == nullptr)
		return B_BAD_VALUE;
	const ssize_t size = object->FlattenedSize();
	if (size <= 0)
		return B_BAD_VALUE;
	std::vector<char> flat(size);
	status_t status = object->Flatten(flat.data(), size);
	if (status != B_OK)
		return status;
	return Store(data, name, object->TypeCode(), index, flat.data(), size,
		object->IsFixedSize());
}

}

#define FIXED_ADD_FIND(Name, Type, Code) \
	status_t BMessage::Add##Name(const char* name, Type value) \
	{ \
		return StoreFixed(*fData, name, Code, kAppend, value); \
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
		return StoreFixed(*fData, name, Code, index, value); \
	}

// The forms without an index address the first value.
#define FIRST_VALUE_FORMS(Name, FindType, ReplaceType) \
	status_t BMessage::Find##Name(const char* name, FindType value) const \
	{ \
		return Find##Name(name, 0, value); \
	} \
	status_t BMessage::Replace##Name(const char* name, ReplaceType value) \
	{ \
		return Replace##Name(name, 0, value); \
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

FIRST_VALUE_FORMS(String, const char**, const char*)
FIRST_VALUE_FORMS(Messenger, BMessenger*, BMessenger)
FIRST_VALUE_FORMS(Ref, entry_ref*, const entry_ref*)
FIRST_VALUE_FORMS(Message, BMessage*, const BMessage*)
FIRST_VALUE_FORMS(Flat, BFlattenable*, BFlattenable*)

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
#undef FIRST_VALUE_FORMS
#undef HAS

status_t BMessage::AddPointer(const char* name, const void* pointer)
{
	return StoreFixed(*fData, name, B_POINTER_TYPE, kAppend, pointer);
}

status_t BMessage::FindPointer(const char* name, void** pointer) const
{
	return FindPointer(name, 0, pointer);
}

status_t BMessage::FindPointer(const char* name, int32 index, void** pointer) const
{
	return FindFixed(*fData, name, B_POINTER_TYPE, index, pointer);
}

status_t BMessage::AddString(const char* name, const char* string)
{
	return StoreString(*fData, name, kAppend, string);
}

status_t BMessage::ReplaceString(const char* name, int32 index, const char* string)
{
	return StoreString(*fData, name, index, string);
}

status_t BMessage::FindString(const char* name, int32 index,
	const char** string) const
{
	return FindValue(*fData, name, B_STRING_TYPE, index, string,
		[string](const void* bytes, ssize_t size) -> status_t {
			const char* text = static_cast<const char*>(bytes);
			if (text[size - 1] != '\0')
				return B_BAD_DATA;
			*string = text;
			return B_OK;
		});
}

status_t BMessage::AddRef(const char* name, const entry_ref* ref)
{
	return StoreRef(*fData, name, kAppend, ref);
}

status_t BMessage::ReplaceRef(const char* name, int32 index, const entry_ref* ref)
{
	return StoreRef(*fData, name, index, ref);
}

status_t BMessage::FindRef(const char* name, int32 index, entry_ref* ref) const
{
	return FindValue(*fData, name, B_REF_TYPE, index, ref,
		[ref](const void* bytes, ssize_t size) {
			return BPrivate::UnflattenRef(ref, bytes, size);
		});
}

status_t BMessage::AddMessage(const char* name, const BMessage* message)
{
	return StoreMessage(*fData, name, kAppend, message);
}

status_t BMessage::ReplaceMessage(const char* name, int32 index,
	const BMessage* message)
{
	return StoreMessage(*fData, name, index, message);
}

status_t BMessage::FindMessage(const char* name, int32 index,
	BMessage* message) const
{
	return FindValue(*fData, name, B_MESSAGE_TYPE, index, message,
		[message](const void* bytes, ssize_t size) {
			return BPrivate::UnflattenMessage(message, static_cast<const char*>(bytes),
				size);
		});
}

status_t BMessage::AddMessenger(const char* name, BMessenger messenger)
{
	return StoreFixed(*fData, name, B_MESSENGER_TYPE, kAppend,
		BPrivate::MessengerAccess::Flatten(messenger));
}

status_t BMessage::ReplaceMessenger(const char* name, int32 index,
	BMessenger messenger)
{
	return StoreFixed(*fData, name, B_MESSENGER_TYPE, index,
		BPrivate::MessengerAccess::Flatten(messenger));
}

status_t BMessage::FindMessenger(const char* name, int32 index,
	BMessenger* messenger) const
{
	BPrivate::FlatMessenger flat;
	status_t status = FindFixed(*fData, name, B_MESSENGER_TYPE, index,
		messenger != nullptr ? &flat : nullptr);
	if (status == B_OK)
		*messenger = BPrivate::MessengerAccess::Unflatten(flat);
	return status;
}

status_t BMessage::AddFlat(const char* name, BFlattenable* object,
	int32 /*count: a size hint only*/)
{
	return StoreFlat(*fData, name, kAppend, object);
}

status_t BMessage::ReplaceFlat(const char* name, int32 index, BFlattenable* object)
{
	return StoreFlat(*fData, name, index, object);
}

status_t BMessage::FindFlat(const char* name, int32 index,
	BFlattenable* object) const
{
	// Any field whose type the object accepts will do.
	return FindValue(*fData, name, B_ANY_TYPE, index, object,
		[this, name, object](const void* bytes, ssize_t size) -> status_t {
			const type_code type = fData->FindField(name)->type;
			if (!object->AllowsTypeCode(type))
				return B_BAD_TYPE;
			return object->Unflatten(type, bytes, size);
		});
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

// Values with defaults for missing or mistyped fields

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
