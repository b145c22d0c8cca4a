// The flat form of a message and its printout.
//
// Layout (host byte order; the flat form never leaves this machine):
//   uint32 magic, uint32 total size, uint32 what, uint32 flags,
//   float drop point x, y, float drop offset x, y, uint32 field count,
//   then per field: uint32 type, uint8 fixed size, uint32 name length,
//   the name (no NUL), uint32 value count, and per value uint32 size + bytes.
// The drop information travels in the header, never as a field.

#include <Message.h>

#include <cctype>
#include <cinttypes>
#include <cstdio>
#include <cstring>

#include <Entry.h>

#include "MessageData.h"
#include "MessagePrivate.h"
#include "RefFlattening.h"

using BPrivate::MessageAccess;
using BPrivate::MessageData;
using BPrivate::MessageField;

namespace {

constexpr uint32 kFlatMagic = 'VMsg';
constexpr uint32 kDroppedFlag = 1;
constexpr size_t kHeaderSize = 4 * sizeof(uint32) + 4 * sizeof(float) + sizeof(uint32);

// Writes the flat form, or only counts its bytes when out is NULL.
class Writer {
public:
	explicit Writer(char* out) : fOut(out) {}

	void Bytes(const void* data, size_t size)
	{
		if (fOut != nullptr)
			std::memcpy(fOut + fSize, data, size);
		fSize += size;
	}

	template<typename T>
	void Put(T value) { Bytes(&value, sizeof(T)); }

	size_t Size() const { return fSize; }

private:
	char* fOut;
	size_t fSize = 0;
};

class Reader {
public:
	Reader(const char* data, size_t size) : fData(data), fLeft(size) {}

	const char* Bytes(size_t size)
	{
		if (size > fLeft) {
			fFailed = true;
			return nullptr;
		}
		const char* bytes = fData;
		fData += size;
		fLeft -= size;
		return bytes;
	}

	template<typename T>
	T Get()
	{
		T value{};
		if (const char* bytes = Bytes(sizeof(T)))
			std::memcpy(&value, bytes, sizeof(T));
		return value;
	}

	bool Failed() const { return fFailed; }

private:
	const char* fData;
	size_t fLeft;
	bool fFailed = false;
};

void WriteMessage(const BMessage& message, Writer& writer, uint32 totalSize)
{
	const MessageData& data = MessageAccess::Data(message);
	writer.Put(kFlatMagic);
	writer.Put(totalSize);
	writer.Put(message.what);
	writer.Put(data.dropped ? kDroppedFlag : 0u);
	writer.Put(data.dropPoint.x);
	writer.Put(data.dropPoint.y);
	writer.Put(data.dropOffset.x);
	writer.Put(data.dropOffset.y);
	writer.Put(static_cast<uint32>(data.fields.size()));
	for (const auto& field : data.fields) {
		writer.Put(field->type);
		writer.Put(static_cast<uint8>(field->fixedSize));
		writer.Put(static_cast<uint32>(field->name.size()));
		writer.Bytes(field->name.data(), field->name.size());
		writer.Put(static_cast<uint32>(field->values.size()));
		for (const auto& value : field->values) {
			writer.Put(static_cast<uint32>(value.size));
			writer.Bytes(value.bytes.get(), value.size);
		}
	}
}

}

namespace BPrivate {

status_t UnflattenMessage(BMessage* message, const char* buffer, ssize_t size)
{
	if (message == nullptr || buffer == nullptr || size < 0)
		return B_BAD_VALUE;
	Reader reader(buffer, size);
	if (reader.Get<uint32>() != kFlatMagic || reader.Failed())
		return B_NOT_A_MESSAGE;
	if (reader.Get<uint32>() != static_cast<uint32>(size))
		return B_BAD_DATA;

	BMessage result(reader.Get<uint32>());
	MessageData& data = MessageAccess::Data(result);
	data.dropped = (reader.Get<uint32>() & kDroppedFlag) != 0;
	data.dropPoint.x = reader.Get<float>();
	data.dropPoint.y = reader.Get<float>();
	data.dropOffset.x = reader.Get<float>();
	data.dropOffset.y = reader.Get<float>();
	const uint32 fieldCount = reader.Get<uint32>();
	for (uint32 i = 0; i < fieldCount && !reader.Failed(); i++) {
		const type_code type = reader.Get<uint32>();
		const bool fixedSize = reader.Get<uint8>() != 0;
		const uint32 nameLength = reader.Get<uint32>();
		const char* nameBytes = reader.Bytes(nameLength);
		const uint32 valueCount = reader.Get<uint32>();
		if (reader.Failed() || valueCount == 0)
			return B_BAD_DATA;
		const std::string name(nameBytes, nameLength);
		// A name seen twice would merge two fields into one.
		if (data.FindField(name.c_str()) != nullptr)
			return B_BAD_DATA;
		for (uint32 j = 0; j < valueCount; j++) {
			const uint32 valueSize = reader.Get<uint32>();
			const char* bytes = reader.Bytes(valueSize);
			if (reader.Failed()
				|| data.Add(name.c_str(), type, bytes, valueSize, fixedSize) != B_OK)
				return B_BAD_DATA;
		}
	}
	if (reader.Failed())
		return B_BAD_DATA;
	*message = result;
	return B_OK;
}

}

ssize_t BMessage::FlattenedSize() const
{
	Writer counter(nullptr);
	WriteMessage(*this, counter, 0);
	return static_cast<ssize_t>(counter.Size());
}

status_t BMessage::Flatten(char* buffer, ssize_t size) const
{
	const ssize_t needed = FlattenedSize();
	if (buffer == nullptr || size < needed)
		return B_BAD_VALUE;
	Writer writer(buffer);
	WriteMessage(*this, writer, static_cast<uint32>(needed));
	return B_OK;
}

status_t BMessage::Unflatten(const char* flatBuffer)
{
	if (flatBuffer == nullptr)
		return B_BAD_VALUE;
	// The buffer has no stated size; trust the header's, after the magic.
	Reader header(flatBuffer, 2 * sizeof(uint32));
	if (header.Get<uint32>() != kFlatMagic)
		return B_NOT_A_MESSAGE;
	const uint32 size = header.Get<uint32>();
	if (size < kHeaderSize)
		return B_BAD_DATA;
	return BPrivate::UnflattenMessage(this, flatBuffer, size);
}

// Printing

namespace {

template<typename T>
T ValueAs(const BPrivate::MessageValue& value)
{
	return value.size == sizeof(T) ? BPrivate::ReadFixed<T>(value.bytes.get()) : T();
}

std::string TypeName(uint32 code)
{
	std::string name;
	for (int shift = 24; shift >= 0; shift -= 8) {
		const unsigned char c = static_cast<unsigned char>(code >> shift);
		name += std::isprint(c) ? static_cast<char>(c) : '.';
	}
	return name;
}

void PrintMessage(const BMessage& message, int depth);

void PrintValue(const MessageField& field, const BPrivate::MessageValue& value,
	int depth)
{
	switch (field.type) {
		case B_INT8_TYPE: std::printf("int8(%d)\n", ValueAs<int8>(value)); break;
		case B_UINT8_TYPE: std::printf("uint8(%u)\n", ValueAs<uint8>(value)); break;
		case B_INT16_TYPE: std::printf("int16(%d)\n", ValueAs<int16>(value)); break;
		case B_UINT16_TYPE: std::printf("uint16(%u)\n", ValueAs<uint16>(value)); break;
		case B_INT32_TYPE:
			std::printf("int32(%" PRId32 ")\n", ValueAs<int32>(value));
			break;
		case B_UINT32_TYPE:
			std::printf("uint32(%" PRIu32 ")\n", ValueAs<uint32>(value));
			break;
		case B_INT64_TYPE:
			std::printf("int64(%" PRId64 ")\n", ValueAs<int64>(value));
			break;
		case B_UINT64_TYPE:
			std::printf("uint64(%" PRIu64 ")\n", ValueAs<uint64>(value));
			break;
		case B_BOOL_TYPE:
			std::printf("bool(%s)\n", ValueAs<bool>(value) ? "true" : "false");
			break;
		case B_FLOAT_TYPE: std::printf("float(%g)\n", ValueAs<float>(value)); break;
		case B_DOUBLE_TYPE: std::printf("double(%g)\n", ValueAs<double>(value)); break;
		case B_POINTER_TYPE:
			std::printf("pointer(%p)\n", ValueAs<void*>(value));
			break;
		case B_POINT_TYPE: {
			BPoint point = ValueAs<BPoint>(value);
			std::printf("BPoint(%g, %g)\n", point.x, point.y);
			break;
		}
		case B_RECT_TYPE: {
			BRect rect = ValueAs<BRect>(value);
			std::printf("BRect(%g, %g, %g, %g)\n", rect.left, rect.top, rect.right,
				rect.bottom);
			break;
		}
		case B_STRING_TYPE:
			std::printf("string(\"%.*s\")\n", static_cast<int>(value.size - 1),
				value.bytes.get());
			break;
		case B_REF_TYPE: {
			entry_ref ref;
			if (BPrivate::UnflattenRef(&ref, value.bytes.get(), value.size) == B_OK) {
				std::printf("entry_ref(%" PRId64 ", %" PRId64 ", \"%s\")\n",
					static_cast<int64>(ref.device), static_cast<int64>(ref.directory),
					ref.name != nullptr ? ref.name : "");
				break;
			}
			std::printf("entry_ref(?)\n");
			break;
		}
		case B_MESSAGE_TYPE: {
			BMessage nested;
			if (BPrivate::UnflattenMessage(&nested, value.bytes.get(), value.size)
					== B_OK) {
				PrintMessage(nested, depth + 1);
				break;
			}
			std::printf("BMessage(?)\n");
			break;
		}
		default:
			std::printf("'%s' (%zd bytes)\n", TypeName(field.type).c_str(), value.size);
			break;
	}
}

void PrintMessage(const BMessage& message, int depth)
{
	std::printf("BMessage('%s') {\n", TypeName(message.what).c_str());
	for (const auto& field : MessageAccess::Data(message).fields) {
		const size_t count = field->values.size();
		for (size_t i = 0; i < count; i++) {
			std::printf("%*s%s", (depth + 1) * 4, "", field->name.c_str());
			if (count > 1)
				std::printf("[%zu]", i);
			std::printf(" = ");
			PrintValue(*field, field->values[i], depth);
		}
	}
	std::printf("%*s}\n", depth * 4, "");
}

}

void BMessage::PrintToStream() const
{
	PrintMessage(*this, 0);
	std::fflush(stdout);
}
