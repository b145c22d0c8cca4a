// One decoded icon per theme file and one answer per type and size, so a
// folder of many files of few types decodes few PNGs.

#include <mutex>

#include "MimeDatabase.h"
#include "TypeIcons.h"

namespace BPrivate {

namespace {

IconRef KitDrawnIcon(const std::string& type, int32 size)
{
	if (type == kDirectoryMimeType)
		return GetBuiltinIcon(BuiltinIcon::kFolder, size);
	if (type == kVolumeMimeType)
		return GetBuiltinIcon(BuiltinIcon::kVolume, size);
	if (type == kSymLinkMimeType)
		return GetBuiltinIcon(BuiltinIcon::kLink, size);
	return nullptr;
}

class IconCache {
public:
	IconRef Get(const std::string& type, int32 size)
	{
		std::lock_guard<std::mutex> lock(fLock);
		auto key = std::make_pair(type, size);
		auto known = fByType.find(key);
		if (known != fByType.end())
			return known->second;
		IconRef icon = _Load(type, size);
		fByType.emplace(key, icon);
		return icon;
	}

	void Flush()
	{
		std::lock_guard<std::mutex> lock(fLock);
		fByType.clear();
		fByFile.clear();
		fTheme.reset();
	}

private:
	IconRef _Load(const std::string& type, int32 size)
	{
		if (fTheme == nullptr)
			fTheme = std::make_unique<IconTheme>();
		IconRef icon = fTheme->Find(MimeIconNames(type), size,
			[&](const std::string& path) { return _Decoded(path, size); });
		return icon != nullptr ? icon : KitDrawnIcon(type, size);
	}

	// A file that does not decode is remembered as such too.
	IconRef _Decoded(const std::string& path, int32 size)
	{
		auto known = fByFile.find(path);
		if (known != fByFile.end())
			return known->second;
		return fByFile.emplace(path, DecodePngIcon(path.c_str(), size))
			.first->second;
	}

	std::mutex fLock;
	std::unique_ptr<IconTheme> fTheme;
	std::map<std::pair<std::string, int32>, IconRef> fByType;
	// Keyed by path: a path names one size only.
	std::map<std::string, IconRef> fByFile;
};

IconCache& Cache()
{
	static IconCache sCache;
	return sCache;
}

}

IconRef IconForType(const std::string& type, int32 size)
{
	return Cache().Get(type, size);
}

void FlushIconCache()
{
	Cache().Flush();
}

}
