// What the system's shared MIME database (through GIO) says about types,
// and the platform's own folder, volume and link types.

#include <algorithm>
#include <cstring>
#include <memory>

#include <gio/gio.h>

#include <StorageDefs.h>

#include "GioLock.h"
#include "MimeDatabase.h"

namespace BPrivate {

const char* const kTypeAttribute = "mime_type";
const char* const kDirectoryMimeType = "application/x-vnd.be-directory";
const char* const kVolumeMimeType = "application/x-vnd.be-volume";
const char* const kSymLinkMimeType = "application/x-vnd.be-symlink";

namespace {

struct KitType {
	const char* type;
	const char* description;
	const char* iconName;
	// The type GIO knows for the same nodes, for their default application.
	const char* systemType;
};

const KitType kKitTypes[] = {
	{kDirectoryMimeType, "Folder", "folder", "inode/directory"},
	{kVolumeMimeType, "Volume", "drive-harddisk", "inode/directory"},
	{kSymLinkMimeType, "Symbolic link", "inode-symlink", "inode/symlink"},
};

const KitType* FindKitType(const std::string& type)
{
	for (const KitType& kitType : kKitTypes) {
		if (type == kitType.type)
			return &kitType;
	}
	return nullptr;
}

struct GFree {
	void operator()(void* data) const { g_free(data); }
};
typedef std::unique_ptr<char, GFree> GText;

struct GUnref {
	void operator()(void* object) const { g_object_unref(object); }
};

std::string Guess(const char* name, const guchar* data, size_t size,
	bool* uncertain)
{
	std::lock_guard<std::mutex> lock(GioLock());
	gboolean unsure = FALSE;
	GText guess(g_content_type_guess(name, data, size, &unsure));
	*uncertain = unsure;
	return guess.get();
}

// GIO describes a type it does not know by wrapping the type's name in a
// (translated) phrase; the phrase is found once with a name no database has.
bool IsMadeUpDescription(const std::string& type,
	const std::string& description)
{
	struct Wrapping {
		bool known;
		std::string before;
		std::string after;
	};
	static const Wrapping sWrapping = [] {
		const std::string probe = "x-varnel-probe/x-never-registered";
		GText text(g_content_type_get_description(probe.c_str()));
		std::string made = text ? text.get() : "";
		size_t at = made.find(probe);
		if (at == std::string::npos)
			return Wrapping{false, "", ""};
		return Wrapping{true, made.substr(0, at),
			made.substr(at + probe.size())};
	}();
	return sWrapping.known
		&& description == sWrapping.before + type + sWrapping.after;
}

}

std::mutex& GioLock()
{
	static std::mutex sLock;
	return sLock;
}

std::string NormalizedMimeType(const char* type)
{
	std::string normalized(type);
	for (char& c : normalized) {
		if (c >= 'A' && c <= 'Z')
			c += 'a' - 'A';
	}
	return normalized;
}

std::string GuessMimeType(const char* name,
	const std::function<ssize_t(void* buffer, size_t size)>& readHead)
{
	bool uncertain;
	std::string guess = Guess(name, nullptr, 0, &uncertain);
	if (uncertain) {
		guchar head[4096];
		ssize_t length = readHead(head, sizeof(head));
		if (length >= 0)
			guess = Guess(name, head, length, &uncertain);
	}
	return guess;
}

status_t GetMimeDescription(const std::string& type, bool shortForm,
	std::string* description)
{
	if (const KitType* kitType = FindKitType(type)) {
		*description = kitType->description;
		return B_OK;
	}

	std::lock_guard<std::mutex> lock(GioLock());
	GText text(g_content_type_get_description(type.c_str()));
	if (text == nullptr || IsMadeUpDescription(type, text.get()))
		return B_ENTRY_NOT_FOUND;
	*description = text.get();
	if (shortForm && !description->empty() && (*description)[0] >= 'a'
		&& (*description)[0] <= 'z')
		(*description)[0] += 'A' - 'a';
	return B_OK;
}

std::vector<std::string> MimeIconNames(const std::string& type)
{
	if (const KitType* kitType = FindKitType(type))
		return {kitType->iconName};

	std::vector<std::string> names;
	std::lock_guard<std::mutex> lock(GioLock());
	std::unique_ptr<GIcon, GUnref> icon(g_content_type_get_icon(type.c_str()));
	if (icon != nullptr && G_IS_THEMED_ICON(icon.get())) {
		// Symbolic icons are monochrome outlines, not file icons.
		for (const gchar* const* name
				= g_themed_icon_get_names(G_THEMED_ICON(icon.get()));
			*name != nullptr; name++) {
			if (!g_str_has_suffix(*name, "-symbolic"))
				names.push_back(*name);
		}
	}
	return names;
}

status_t GetMimePreferredApp(const std::string& type, std::string* appId)
{
	const KitType* kitType = FindKitType(type);
	std::lock_guard<std::mutex> lock(GioLock());
	std::unique_ptr<GAppInfo, GUnref> app(g_app_info_get_default_for_type(
		kitType != nullptr ? kitType->systemType : type.c_str(), FALSE));
	if (app == nullptr)
		return B_ENTRY_NOT_FOUND;
	const char* id = g_app_info_get_id(app.get());
	*appId = id != nullptr ? id : g_app_info_get_name(app.get());
	return B_OK;
}

void CopyString(const std::string& text, char* buffer, size_t capacity)
{
	size_t length = std::min(text.size(), capacity - 1);
	// Never end inside a UTF-8 sequence.
	if (length < text.size()) {
		while (length > 0 && (text[length] & 0xc0) == 0x80)
			length--;
	}
	memcpy(buffer, text.data(), length);
	buffer[length] = '\0';
}

}
