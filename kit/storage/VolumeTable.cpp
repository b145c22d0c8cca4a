#include "VolumeTable.h"

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <climits>
#include <fcntl.h>
#include <cstdlib>
#include <cstring>
#include <map>
#include <mutex>
#include <poll.h>
#include <sys/eventfd.h>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>

#include <AppDefs.h>
#include <Message.h>
#include <NodeMonitor.h>

#include "VolumeSources.h"

namespace BPrivate {

namespace {

enum class Source { kSystem, kFile, kTest };

// What tells that a table file was written again.
struct FileSignature {
	dev_t device = 0;
	ino_t node = 0;
	off_t size = -1;
	timespec modified = {};
	timespec changed = {};

	bool operator==(const FileSignature& other) const
	{
		return device == other.device && node == other.node
			&& size == other.size && modified.tv_sec == other.modified.tv_sec
			&& modified.tv_nsec == other.modified.tv_nsec
			&& changed.tv_sec == other.changed.tv_sec
			&& changed.tv_nsec == other.changed.tv_nsec;
	}
};

FileSignature SignatureOf(const std::string& path)
{
	FileSignature signature;
	struct stat st;
	if (stat(path.c_str(), &st) == 0) {
		signature.device = st.st_dev;
		signature.node = st.st_ino;
		signature.size = st.st_size;
		signature.modified = st.st_mtim;
		signature.changed = st.st_ctim;
	}
	return signature;
}

bool IsAncestorOrSelf(const std::string& root, const std::string& path)
{
	if (root == "/")
		return !path.empty() && path[0] == '/';
	return path.compare(0, root.size(), root) == 0
		&& (path.size() == root.size() || path[root.size()] == '/');
}

// The volume whose root is canonicalPath, or NULL.
const VolumeEntry* RootAt(const std::vector<VolumeEntry>& volumes,
	const std::string& canonicalPath)
{
	auto found = std::find_if(volumes.begin(), volumes.end(),
		[&](const VolumeEntry& volume) { return volume.root == canonicalPath; });
	return found != volumes.end() ? &*found : nullptr;
}

bool SameVolume(const VolumeEntry& a, const VolumeEntry& b)
{
	return a.device == b.device && a.root == b.root;
}

// Tells the targets about every volume of from that to lacks.
void SendChanges(const std::vector<VolumeEntry>& from,
	const std::vector<VolumeEntry>& to, int32 opcode, const char* field,
	const std::vector<BMessenger>& targets)
{
	for (const VolumeEntry& volume : from) {
		bool kept = std::any_of(to.begin(), to.end(),
			[&](const VolumeEntry& other) { return SameVolume(volume, other); });
		if (kept)
			continue;
		BMessage message(B_NODE_MONITOR);
		message.AddInt32("opcode", opcode);
		message.AddInt32(field, static_cast<int32>(volume.device));
		for (const BMessenger& target : targets)
			target.SendMessage(&message);
	}
}

}

struct VolumeTable::Private {
	// Serialises changes of the table and the events they send; taken
	// before lock.
	std::mutex changeLock;
	std::mutex lock;

	// Guarded by lock.
	Source source = Source::kSystem;
	std::string tableFile;
	FileSignature fileSignature;
	VolumeSnapshot snapshot;
	bool loaded = false;
	std::map<int32, BMessenger> watchers;
	int32 nextToken = 1;
	int tableWatch = -1;

	// Guarded by changeLock.
	DeviceIdFolder folder;

	// Serialises the test edits, which read the table and then replace it.
	std::mutex editLock;

	// Each descriptor of the mount table hears of a change once: the
	// queries and the monitor thread each have their own.
	int mountInfoFd = -1;
	int monitorFd = -1;
	int inotifyFd = -1;
	int wakeFd = -1;
	std::thread monitor;
	std::atomic<bool> quitting = false;

	void Load(Source newSource, const VolumeSnapshot* given);
	void LoadLocked(Source newSource, const VolumeSnapshot* given);
	void CheckFresh();
	void WatchTableFile();
	void Monitor();
};

void VolumeTable::Private::Load(Source newSource, const VolumeSnapshot* given)
{
	std::lock_guard<std::mutex> changing(changeLock);
	LoadLocked(newSource, given);
}

// Reads the table from newSource (or takes the one given) and tells the
// watchers what changed.
void VolumeTable::Private::LoadLocked(Source newSource,
	const VolumeSnapshot* given)
{
	std::string file;
	{
		std::lock_guard<std::mutex> locker(lock);
		if (newSource == Source::kFile && tableFile.empty())
			newSource = Source::kSystem;
		file = tableFile;
	}

	VolumeSnapshot fresh;
	FileSignature signature;
	if (given != nullptr)
		fresh = *given;
	else if (newSource == Source::kFile) {
		// The signature goes first: a write after it makes it stale again.
		signature = SignatureOf(file);
		fresh = ReadVolumeTableFile(file);
	} else
		fresh = ReadMountInfo(mountInfoFd, folder);

	std::vector<VolumeEntry> current = fresh.volumes;
	std::vector<VolumeEntry> old;
	std::vector<BMessenger> targets;
	bool wasLoaded;
	{
		std::lock_guard<std::mutex> locker(lock);
		old = std::move(snapshot.volumes);
		wasLoaded = loaded;
		snapshot = std::move(fresh);
		source = newSource;
		fileSignature = signature;
		loaded = true;
		for (const auto& [token, messenger] : watchers)
			targets.push_back(messenger);
	}
	if (wasLoaded) {
		SendChanges(old, current, B_DEVICE_UNMOUNTED, "device", targets);
		SendChanges(current, old, B_DEVICE_MOUNTED, "new device", targets);
	}
}

// Re-reads the table when its source says it has changed. A change being
// read by another thread is waited for.
void VolumeTable::Private::CheckFresh()
{
	std::lock_guard<std::mutex> changing(changeLock);
	Source current;
	std::string file;
	FileSignature signature;
	bool stale;
	{
		std::lock_guard<std::mutex> locker(lock);
		current = source;
		file = tableFile;
		signature = fileSignature;
		stale = !loaded;
	}
	if (!stale && current == Source::kSystem) {
		pollfd changed = { mountInfoFd, POLLPRI, 0 };
		stale = poll(&changed, 1, 0) > 0
			&& (changed.revents & (POLLPRI | POLLERR)) != 0;
	} else if (!stale && current == Source::kFile)
		stale = !(SignatureOf(file) == signature);
	if (stale)
		LoadLocked(current, nullptr);
}

// Points the inotify watch at the folder of the table file, which editors
// often replace rather than rewrite.
void VolumeTable::Private::WatchTableFile()
{
	std::lock_guard<std::mutex> locker(lock);
	if (tableWatch >= 0)
		inotify_rm_watch(inotifyFd, tableWatch);
	tableWatch = -1;
	if (tableFile.empty() || inotifyFd < 0)
		return;
	std::string folder = tableFile.substr(0, tableFile.rfind('/') + 1);
	if (folder.empty())
		folder = ".";
	tableWatch = inotify_add_watch(inotifyFd, folder.c_str(),
		IN_CLOSE_WRITE | IN_MOVED_TO | IN_MOVED_FROM | IN_CREATE | IN_DELETE);
}

void VolumeTable::Private::Monitor()
{
	while (!quitting) {
		pollfd fds[3] = {
			{ monitorFd, POLLPRI, 0 },
			{ inotifyFd, POLLIN, 0 },
			{ wakeFd, POLLIN, 0 }
		};
		if (poll(fds, 3, -1) < 0)
			continue;
		if (quitting)
			break;
		Source current;
		{
			std::lock_guard<std::mutex> locker(lock);
			current = source;
		}
		bool mountsChanged = (fds[0].revents & (POLLPRI | POLLERR)) != 0;
		bool fileChanged = false;
		if ((fds[1].revents & POLLIN) != 0) {
			char events[4096];
			fileChanged = read(inotifyFd, events, sizeof(events)) > 0;
		}
		if ((mountsChanged && current == Source::kSystem)
			|| (fileChanged && current == Source::kFile)) {
			Load(current, nullptr);
		}
	}
}

VolumeTable::VolumeTable()
	:
	fPrivate(std::make_unique<Private>())
{
	fPrivate->mountInfoFd = open("/proc/self/mountinfo", O_RDONLY | O_CLOEXEC);
	fPrivate->monitorFd = open("/proc/self/mountinfo", O_RDONLY | O_CLOEXEC);
	fPrivate->inotifyFd = inotify_init1(IN_NONBLOCK | IN_CLOEXEC);
	fPrivate->wakeFd = eventfd(0, EFD_NONBLOCK | EFD_CLOEXEC);
	UseSystem();
}

VolumeTable::~VolumeTable()
{
	if (fPrivate->monitor.joinable()) {
		fPrivate->quitting = true;
		uint64 one = 1;
		while (write(fPrivate->wakeFd, &one, sizeof(one)) < 0 && errno == EINTR)
			;
		fPrivate->monitor.join();
	}
	for (int fd : { fPrivate->mountInfoFd, fPrivate->monitorFd,
			fPrivate->inotifyFd, fPrivate->wakeFd }) {
		if (fd >= 0)
			close(fd);
	}
}

VolumeTable& VolumeTable::Default()
{
	static VolumeTable table;
	return table;
}

status_t VolumeTable::Replace(const std::vector<VolumeEntry>& volumes)
{
	std::lock_guard<std::mutex> editing(fPrivate->editLock);
	return _Replace(volumes);
}

status_t VolumeTable::_Replace(const std::vector<VolumeEntry>& volumes)
{
	std::vector<VolumeEntry> canonical;
	for (VolumeEntry volume : volumes) {
		char root[PATH_MAX];
		if (volume.device == 0 || volume.device > INT32_MAX
			|| realpath(volume.root.c_str(), root) == nullptr) {
			return B_BAD_VALUE;
		}
		bool taken = std::any_of(canonical.begin(), canonical.end(),
			[&](const VolumeEntry& other) {
				return other.device == volume.device;
			});
		if (taken)
			return B_BAD_VALUE;
		volume.root = root;
		canonical.push_back(volume);
	}
	VolumeSnapshot snapshot = SnapshotOf(canonical);
	fPrivate->Load(Source::kTest, &snapshot);
	return B_OK;
}

status_t VolumeTable::Mount(const VolumeEntry& volume)
{
	std::lock_guard<std::mutex> editing(fPrivate->editLock);
	std::vector<VolumeEntry> volumes = Volumes();
	volumes.push_back(volume);
	return _Replace(volumes);
}

status_t VolumeTable::Unmount(dev_t device)
{
	std::lock_guard<std::mutex> editing(fPrivate->editLock);
	std::vector<VolumeEntry> volumes = Volumes();
	if (std::erase_if(volumes, [&](const VolumeEntry& volume) {
			return volume.device == device;
		}) == 0) {
		return B_BAD_VALUE;
	}
	return _Replace(volumes);
}

void VolumeTable::UseSystem()
{
	const char* file = std::getenv("VARNEL_VOLUME_TABLE");
	{
		std::lock_guard<std::mutex> locker(fPrivate->lock);
		fPrivate->tableFile = file != nullptr ? file : "";
	}
	fPrivate->WatchTableFile();
	fPrivate->Load(Source::kFile, nullptr);
}

std::vector<VolumeEntry> VolumeTable::Volumes()
{
	fPrivate->CheckFresh();
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	return fPrivate->snapshot.volumes;
}

status_t VolumeTable::Find(dev_t device, VolumeEntry* volume)
{
	fPrivate->CheckFresh();
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	for (const VolumeEntry& entry : fPrivate->snapshot.volumes) {
		if (entry.device == device) {
			*volume = entry;
			return B_OK;
		}
	}
	return B_BAD_VALUE;
}

status_t VolumeTable::Boot(VolumeEntry* volume)
{
	fPrivate->CheckFresh();
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	const std::vector<VolumeEntry>& volumes = fPrivate->snapshot.volumes;
	if (volumes.empty())
		return B_ENTRY_NOT_FOUND;
	auto boot = std::find_if(volumes.begin(), volumes.end(),
		[](const VolumeEntry& entry) { return entry.boot; });
	*volume = boot != volumes.end() ? *boot : volumes.front();
	return B_OK;
}

dev_t VolumeTable::DeviceFor(const std::string& canonicalPath, bool* isRoot)
{
	fPrivate->CheckFresh();
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	if (isRoot != nullptr)
		*isRoot = RootAt(fPrivate->snapshot.volumes, canonicalPath) != nullptr;
	const MountPoint* deepest = nullptr;
	for (const MountPoint& mount : fPrivate->snapshot.mountPoints) {
		if (IsAncestorOrSelf(mount.path, canonicalPath)
			&& (deepest == nullptr || mount.path.size() > deepest->path.size()))
			deepest = &mount;
	}
	if (deepest != nullptr)
		return deepest->device;
	// Outside every root of a replaced table: the boot volume.
	const std::vector<VolumeEntry>& volumes = fPrivate->snapshot.volumes;
	if (volumes.empty())
		return 0;
	auto boot = std::find_if(volumes.begin(), volumes.end(),
		[](const VolumeEntry& entry) { return entry.boot; });
	return boot != volumes.end() ? boot->device : volumes.front().device;
}

bool VolumeTable::IsRoot(const std::string& canonicalPath, dev_t* device)
{
	fPrivate->CheckFresh();
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	const VolumeEntry* volume = RootAt(fPrivate->snapshot.volumes, canonicalPath);
	if (volume != nullptr && device != nullptr)
		*device = volume->device;
	return volume != nullptr;
}

bool VolumeTable::MayBeRootNamed(const char* leaf)
{
	size_t length = std::strlen(leaf);
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	for (const VolumeEntry& volume : fPrivate->snapshot.volumes) {
		const std::string& root = volume.root;
		if (root.size() > length
			&& root.compare(root.size() - length, length, leaf) == 0
			&& root[root.size() - length - 1] == '/')
			return true;
	}
	return false;
}

int32 VolumeTable::AddWatcher(const BMessenger& messenger)
{
	fPrivate->CheckFresh();
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	int32 token = fPrivate->nextToken++;
	fPrivate->watchers.emplace(token, messenger);
	if (!fPrivate->monitor.joinable() && fPrivate->wakeFd >= 0)
		fPrivate->monitor = std::thread(&Private::Monitor, fPrivate.get());
	return token;
}

void VolumeTable::RemoveWatcher(int32 token)
{
	std::lock_guard<std::mutex> locker(fPrivate->lock);
	fPrivate->watchers.erase(token);
}

}
