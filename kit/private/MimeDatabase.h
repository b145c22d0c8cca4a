#ifndef KIT_PRIVATE_MIME_DATABASE_H
#define KIT_PRIVATE_MIME_DATABASE_H

#include <functional>
#include <string>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {

// The platform's own types for nodes that have no content type.
extern const char* const kDirectoryMimeType;
extern const char* const kVolumeMimeType;
extern const char* const kSymLinkMimeType;

// The attribute (raw, as other programs on Linux write it) that holds a
// node's type.
extern const char* const kTypeAttribute;

// A type lower-cased: MIME types compare without case, GIO with it.
std::string NormalizedMimeType(const char* type);

// GIO's guess for a regular file from its name. Only when the name says
// nothing is readHead called, with a buffer of a few KiB, to read the
// file's first bytes; it returns how many it read or a negative error.
std::string GuessMimeType(const char* name,
	const std::function<ssize_t(void* buffer, size_t size)>& readHead);

// Descriptions of a normalized type; B_ENTRY_NOT_FOUND when the database
// does not know the type. The short form starts with a capital.
status_t GetMimeDescription(const std::string& type, bool shortForm,
	std::string* description);

// Icon theme names for a normalized type, most specific first.
std::vector<std::string> MimeIconNames(const std::string& type);

// The desktop file id of the default application for a normalized type.
status_t GetMimePreferredApp(const std::string& type, std::string* appId);

// Copies text into a buffer of capacity bytes, cut at a character boundary
// when longer.
void CopyString(const std::string& text, char* buffer, size_t capacity);

}

#endif
