#ifndef KIT_STORAGE_ATTRIBUTES_H
#define KIT_STORAGE_ATTRIBUTES_H

#include <string>
#include <vector>

#include <fs_attr.h>

namespace BPrivate {

// The typed attributes of one open node on Linux extended attributes, as
// BNode describes them: "user.NAME" for untyped data, "user.haiku.NAME"
// holding a four-byte type and the data for the rest.
class Attributes {
public:
	// pathOnly: fd was opened with O_PATH, so the calls go through its
	// /proc/self/fd path.
	Attributes(int fd, bool pathOnly);

	status_t Names(std::vector<std::string>* names) const;
	status_t Stat(const char* name, attr_info* info) const;
	ssize_t Read(const char* name, off_t offset, void* buffer,
		size_t length) const;
	ssize_t Write(const char* name, type_code type, off_t offset,
		const void* buffer, size_t length);
	status_t Remove(const char* name);

private:
	struct Value;

	status_t _Get(const std::string& name, std::string* value) const;
	status_t _Set(const std::string& name, const std::string& value);
	status_t _Delete(const std::string& name);
	status_t _Find(const char* name, Value* value) const;

	int fFd;
	std::string fProcPath;
};

}

#endif
