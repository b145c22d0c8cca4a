#include "DirectoryRegistry.h"

#include <sys/stat.h>

#include "NodeData.h"
#include "VolumeTable.h"

namespace BPrivate {

namespace {

bool IsAtOrBelow(const std::string& path, const std::string& folder)
{
	return path.compare(0, folder.size(), folder) == 0
		&& (path.size() == folder.size() || path[folder.size()] == '/');
}

bool StillThere(const std::string& path, ino_t node, dev_t systemDevice)
{
	struct stat st;
	return lstat(path.c_str(), &st) == 0 && S_ISDIR(st.st_mode)
		&& st.st_ino == node && st.st_dev == systemDevice;
}

}

DirectoryRegistry& DirectoryRegistry::Default()
{
	static DirectoryRegistry registry;
	return registry;
}

void DirectoryRegistry::Register(dev_t device, ino_t node, dev_t systemDevice,
	const std::string& path, const std::shared_ptr<NodeData>& open)
{
	std::lock_guard<std::mutex> locker(fLock);
	Location& location = fFolders[{ device, node }];
	location.path = path;
	location.systemDevice = systemDevice;
	if (open != nullptr)
		location.open = open;
}

std::shared_ptr<NodeData> DirectoryRegistry::OpenFolder(dev_t device,
	ino_t node)
{
	std::lock_guard<std::mutex> locker(fLock);
	auto found = fFolders.find({ device, node });
	return found != fFolders.end() ? found->second.open.lock() : nullptr;
}

status_t DirectoryRegistry::Resolve(dev_t device, ino_t node,
	std::string* path)
{
	std::shared_lock<std::shared_mutex> noMoves(fMoveLock);
	Location location;
	bool known = false;
	{
		std::lock_guard<std::mutex> locker(fLock);
		auto found = fFolders.find({ device, node });
		if (found != fFolders.end()) {
			location = found->second;
			known = true;
		}
	}
	if (known) {
		if (StillThere(location.path, node, location.systemDevice)) {
			*path = location.path;
			return B_OK;
		}
		// A folder open right now is found wherever another program put it.
		std::shared_ptr<NodeData> open = location.open.lock();
		std::string now;
		if (open != nullptr && PathOfDescriptor(open->fd, &now) == B_OK) {
			Register(device, node, location.systemDevice, now);
			*path = now;
			return B_OK;
		}
		std::lock_guard<std::mutex> locker(fLock);
		auto found = fFolders.find({ device, node });
		if (found != fFolders.end() && found->second.path == location.path)
			fFolders.erase(found);
	}
	// Volume roots are known without having been seen.
	VolumeEntry volume;
	struct stat st;
	if (VolumeTable::Default().Find(device, &volume) == B_OK
		&& lstat(volume.root.c_str(), &st) == 0 && st.st_ino == node) {
		Register(device, node, st.st_dev, volume.root);
		*path = volume.root;
		return B_OK;
	}
	return B_ENTRY_NOT_FOUND;
}

void DirectoryRegistry::Moved(const std::string& from, const std::string& to)
{
	fMoves++;
	std::lock_guard<std::mutex> locker(fLock);
	for (auto& [key, location] : fFolders) {
		if (IsAtOrBelow(location.path, from))
			location.path = to + location.path.substr(from.size());
	}
}

void DirectoryRegistry::Removed(const std::string& path)
{
	std::lock_guard<std::mutex> locker(fLock);
	std::erase_if(fFolders, [&](const auto& item) {
		return item.second.path == path;
	});
}

}
