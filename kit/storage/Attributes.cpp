#include "Attributes.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <sys/xattr.h>

#include <StorageDefs.h>
#include <TypeConstants.h>

#include "ErrnoStatus.h"

namespace BPrivate {

namespace {

const std::string kUntypedPrefix = "user.";
const std::string kTypedPrefix = "user.haiku.";
constexpr size_t kTypeSize = sizeof(type_code);
// The longest name that fits XATTR_NAME_MAX with the typed prefix.
constexpr size_t kMaxNameLength = 255 - 11;

status_t CheckAttributeName(const char* name)
{
	if (name == nullptr || name[0] == '\0')
		return B_BAD_VALUE;
	if (std::strlen(name) > kMaxNameLength)
		return B_NAME_TOO_LONG;
	return B_OK;
}

// Runs a size query of the xattr calls, then the call itself, again when the
// value grew in between.
template<typename Call>
status_t ReadSized(std::string* value, Call call)
{
	while (true) {
		ssize_t size = call(nullptr, 0);
		if (size < 0)
			return StatusFromErrno();
		value->resize(size);
		ssize_t length = call(value->data(), size);
		if (length >= 0) {
			value->resize(length);
			return B_OK;
		}
		if (errno != ERANGE)
			return StatusFromErrno();
	}
}

// Untyped data under a name that would read as typed goes typed.
bool StoredUntyped(const char* name, type_code type)
{
	return type == B_RAW_TYPE
		&& std::strncmp(name, "haiku.", 6) != 0;
}

}

struct Attributes::Value {
	type_code type;
	std::string data;
	bool typed;
};

Attributes::Attributes(int fd, bool pathOnly)
	:
	fFd(fd)
{
	if (pathOnly)
		fProcPath = "/proc/self/fd/" + std::to_string(fd);
}

status_t Attributes::_Get(const std::string& name, std::string* value) const
{
	return ReadSized(value, [&](char* buffer, size_t size) {
		return fProcPath.empty() ? fgetxattr(fFd, name.c_str(), buffer, size)
			: getxattr(fProcPath.c_str(), name.c_str(), buffer, size);
	});
}

status_t Attributes::_Set(const std::string& name, const std::string& value)
{
	int result = fProcPath.empty()
		? fsetxattr(fFd, name.c_str(), value.data(), value.size(), 0)
		: setxattr(fProcPath.c_str(), name.c_str(), value.data(), value.size(),
			0);
	return result == 0 ? B_OK : StatusFromErrno();
}

status_t Attributes::_Delete(const std::string& name)
{
	int result = fProcPath.empty()
		? fremovexattr(fFd, name.c_str())
		: removexattr(fProcPath.c_str(), name.c_str());
	return result == 0 ? B_OK : StatusFromErrno();
}

status_t Attributes::_Find(const char* name, Value* value) const
{
	status_t status = CheckAttributeName(name);
	if (status != B_OK)
		return status;
	std::string stored;
	status = _Get(kTypedPrefix + name, &stored);
	if (status == B_OK) {
		if (stored.size() < kTypeSize)
			return B_BAD_DATA;
		std::memcpy(&value->type, stored.data(), kTypeSize);
		value->data = stored.substr(kTypeSize);
		value->typed = true;
		return B_OK;
	}
	if (status != B_ENTRY_NOT_FOUND)
		return status;
	status = _Get(kUntypedPrefix + name, &value->data);
	value->type = B_RAW_TYPE;
	value->typed = false;
	return status;
}

status_t Attributes::Names(std::vector<std::string>* names) const
{
	std::string list;
	status_t status = ReadSized(&list, [&](char* buffer, size_t size) {
		return fProcPath.empty() ? flistxattr(fFd, buffer, size)
			: listxattr(fProcPath.c_str(), buffer, size);
	});
	if (status != B_OK)
		return status;

	names->clear();
	for (size_t start = 0; start < list.size();) {
		std::string stored = list.c_str() + start;
		start += stored.size() + 1;
		std::string name;
		if (stored.compare(0, kTypedPrefix.size(), kTypedPrefix) == 0)
			name = stored.substr(kTypedPrefix.size());
		else if (stored.compare(0, kUntypedPrefix.size(), kUntypedPrefix) == 0)
			name = stored.substr(kUntypedPrefix.size());
		else
			continue;
		if (!name.empty() && name.size() < B_ATTR_NAME_LENGTH
			&& std::find(names->begin(), names->end(), name) == names->end())
			names->push_back(name);
	}
	return B_OK;
}

status_t Attributes::Stat(const char* name, attr_info* info) const
{
	if (info == nullptr)
		return B_BAD_VALUE;
	Value value;
	status_t status = _Find(name, &value);
	if (status != B_OK)
		return status;
	info->type = value.type;
	info->size = value.data.size();
	return B_OK;
}

ssize_t Attributes::Read(const char* name, off_t offset, void* buffer,
	size_t length) const
{
	if (offset < 0 || (buffer == nullptr && length > 0))
		return B_BAD_VALUE;
	Value value;
	status_t status = _Find(name, &value);
	if (status != B_OK)
		return status;
	if (static_cast<size_t>(offset) >= value.data.size())
		return 0;
	size_t count = std::min(length, value.data.size() - offset);
	std::memcpy(buffer, value.data.data() + offset, count);
	return count;
}

ssize_t Attributes::Write(const char* name, type_code type, off_t offset,
	const void* buffer, size_t length)
{
	status_t status = CheckAttributeName(name);
	if (status != B_OK)
		return status;
	if (offset < 0 || (buffer == nullptr && length > 0))
		return B_BAD_VALUE;

	std::string data;
	if (offset > 0) {
		Value old;
		status = _Find(name, &old);
		if (status != B_OK && status != B_ENTRY_NOT_FOUND)
			return status;
		data = old.data.substr(0, offset);
		data.resize(offset, '\0');
	}
	data.append(static_cast<const char*>(buffer), length);

	bool untyped = StoredUntyped(name, type);
	std::string stored;
	if (!untyped)
		stored.assign(reinterpret_cast<const char*>(&type), kTypeSize);
	stored += data;
	std::string target = (untyped ? kUntypedPrefix : kTypedPrefix) + name;
	std::string other = (untyped ? kTypedPrefix : kUntypedPrefix) + name;
	status = _Set(target, stored);
	if (status != B_OK)
		return status;
	// The new value is in place before the other form goes.
	status = _Delete(other);
	if (status != B_OK && status != B_ENTRY_NOT_FOUND)
		return status;
	return length;
}

status_t Attributes::Remove(const char* name)
{
	status_t status = CheckAttributeName(name);
	if (status != B_OK)
		return status;
	status_t typed = _Delete(kTypedPrefix + name);
	status_t untyped = _Delete(kUntypedPrefix + name);
	if (typed == B_OK || untyped == B_OK)
		return B_OK;
	return typed != B_ENTRY_NOT_FOUND ? typed : untyped;
}

}
