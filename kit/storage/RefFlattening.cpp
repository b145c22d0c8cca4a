#include "RefFlattening.h"

#include <cstring>

#include <Entry.h>

namespace BPrivate {

namespace {
constexpr ssize_t kHeaderSize = 2 * sizeof(int64);
}

ssize_t FlattenedRefSize(const entry_ref& ref)
{
	return kHeaderSize + (ref.name != nullptr ? std::strlen(ref.name) : 0) + 1;
}

status_t FlattenRef(const entry_ref& ref, void* buffer, ssize_t size)
{
	if (buffer == nullptr || size < FlattenedRefSize(ref))
		return B_BAD_VALUE;
	int64 numbers[2] = { static_cast<int64>(ref.device),
		static_cast<int64>(ref.directory) };
	char* out = static_cast<char*>(buffer);
	std::memcpy(out, numbers, kHeaderSize);
	const char* name = ref.name != nullptr ? ref.name : "";
	std::memcpy(out + kHeaderSize, name, std::strlen(name) + 1);
	return B_OK;
}

status_t UnflattenRef(entry_ref* ref, const void* buffer, ssize_t size)
{
	if (ref == nullptr || buffer == nullptr || size < kHeaderSize + 1)
		return B_BAD_VALUE;
	const char* in = static_cast<const char*>(buffer);
	// The name must end inside the buffer.
	const char* name = in + kHeaderSize;
	if (std::memchr(name, '\0', size - kHeaderSize) == nullptr)
		return B_BAD_DATA;
	int64 numbers[2];
	std::memcpy(numbers, in, kHeaderSize);
	ref->device = static_cast<dev_t>(numbers[0]);
	ref->directory = static_cast<ino_t>(numbers[1]);
	return ref->set_name(*name != '\0' ? name : nullptr);
}

}
