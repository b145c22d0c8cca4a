#include "VolumeSources.h"

#include <algorithm>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <sstream>
#include <sys/stat.h>
#include <sys/sysmacros.h>
#include <unistd.h>

#include <fs_info.h>

namespace BPrivate {

namespace {

constexpr dev_t kFirstFoldedId = 0x7ff00000;
constexpr uint32 kAttributes = B_FS_HAS_ATTR | B_FS_HAS_MIME;
constexpr uint32 kDisk = B_FS_IS_PERSISTENT;
constexpr uint32 kNetwork = B_FS_IS_PERSISTENT | B_FS_IS_SHARED;

struct FileSystemKind {
	const char* name;
	uint32 flags;
};

// The file systems that keep their data (the others are kernel and memory
// file systems, overlay internals, packed images), and those that keep
// user attributes.
constexpr FileSystemKind kFileSystems[] = {
	{ "ext2", kDisk | kAttributes }, { "ext3", kDisk | kAttributes },
	{ "ext4", kDisk | kAttributes }, { "xfs", kDisk | kAttributes },
	{ "btrfs", kDisk | kAttributes }, { "f2fs", kDisk | kAttributes },
	{ "jfs", kDisk | kAttributes }, { "reiserfs", kDisk | kAttributes },
	{ "bcachefs", kDisk | kAttributes }, { "zfs", kDisk | kAttributes },
	{ "nilfs2", kDisk }, { "vfat", kDisk }, { "msdos", kDisk },
	{ "exfat", kDisk }, { "ntfs", kDisk }, { "ntfs3", kDisk },
	{ "fuseblk", kDisk }, { "hfs", kDisk }, { "hfsplus", kDisk },
	{ "iso9660", kDisk }, { "udf", kDisk }, { "befs", kDisk },
	{ "ufs", kDisk }, { "minix", kDisk },
	{ "nfs", kNetwork }, { "nfs4", kNetwork | kAttributes },
	{ "cifs", kNetwork }, { "smb3", kNetwork },
	{ "tmpfs", kAttributes }
};

uint32 FlagsForFileSystem(const std::string& fsName)
{
	for (const FileSystemKind& kind : kFileSystems) {
		if (fsName == kind.name)
			return kind.flags;
	}
	return 0;
}

bool ReadSmallFile(const std::string& path, std::string* contents)
{
	int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
	if (fd < 0)
		return false;
	char buffer[16];
	ssize_t length = read(fd, buffer, sizeof(buffer));
	close(fd);
	if (length <= 0)
		return false;
	contents->assign(buffer, length);
	return true;
}

// The kernel says whether a block device (or the disk a partition is on)
// is removable.
bool IsRemovableDevice(unsigned major, unsigned minor)
{
	if (major == 0)
		return false;
	std::string base = "/sys/dev/block/" + std::to_string(major) + ":"
		+ std::to_string(minor);
	std::string value;
	if (!ReadSmallFile(base + "/removable", &value)
		&& !ReadSmallFile(base + "/../removable", &value)) {
		return false;
	}
	return value[0] == '1';
}

bool HasOption(const std::string& options, const char* option)
{
	std::stringstream stream(options);
	std::string item;
	while (std::getline(stream, item, ',')) {
		if (item == option)
			return true;
	}
	return false;
}

std::string ReadAll(int fd)
{
	std::string contents;
	char buffer[16384];
	off_t offset = 0;
	while (true) {
		ssize_t length = pread(fd, buffer, sizeof(buffer), offset);
		if (length <= 0)
			break;
		contents.append(buffer, length);
		offset += length;
	}
	return contents;
}

struct MountLine {
	std::string root;
	std::string mountPoint;
	std::string fsName;
	std::string source;
	bool readOnly;
	unsigned major;
	unsigned minor;
};

// "36 35 98:0 /mnt1 /mnt/parent rw,noatime master:1 - ext3 /dev/root rw"
bool ParseMountLine(const std::string& line, MountLine* mount)
{
	std::vector<std::string> fields = SplitEscapedFields(line);
	size_t separator = 6;
	while (separator < fields.size() && fields[separator] != "-")
		separator++;
	if (separator + 2 >= fields.size())
		return false;
	if (std::sscanf(fields[2].c_str(), "%u:%u", &mount->major, &mount->minor)
			!= 2) {
		return false;
	}
	mount->root = fields[3];
	mount->mountPoint = fields[4];
	mount->readOnly = HasOption(fields[5], "ro");
	mount->fsName = fields[separator + 1];
	mount->source = fields[separator + 2];
	return !mount->mountPoint.empty() && mount->mountPoint[0] == '/';
}

}

std::vector<std::string> SplitEscapedFields(const std::string& line)
{
	std::vector<std::string> fields;
	std::string field;
	bool inField = false;
	for (size_t i = 0; i < line.size(); i++) {
		char c = line[i];
		if (c == ' ' || c == '\t' || c == '\n') {
			if (inField)
				fields.push_back(field);
			field.clear();
			inField = false;
			continue;
		}
		inField = true;
		if (c == '\\' && i + 3 < line.size() && line[i + 1] >= '0'
			&& line[i + 1] <= '3' && line[i + 2] >= '0' && line[i + 2] <= '7'
			&& line[i + 3] >= '0' && line[i + 3] <= '7') {
			field += static_cast<char>((line[i + 1] - '0') * 64
				+ (line[i + 2] - '0') * 8 + (line[i + 3] - '0'));
			i += 3;
		} else
			field += c;
	}
	if (inField)
		fields.push_back(field);
	return fields;
}

dev_t DeviceIdFolder::Fold(dev_t raw)
{
	if (raw != 0 && raw < kFirstFoldedId)
		return raw;
	auto found = fFolded.find(raw);
	if (found != fFolded.end())
		return found->second;
	dev_t id = kFirstFoldedId + fFolded.size();
	fFolded.emplace(raw, id);
	return id;
}

VolumeSnapshot ReadMountInfo(int fd, DeviceIdFolder& folder)
{
	std::vector<MountLine> mounts;
	std::stringstream stream(ReadAll(fd));
	std::string line;
	while (std::getline(stream, line)) {
		MountLine mount;
		if (!ParseMountLine(line, &mount))
			continue;
		// A later mount on the same folder hides the earlier one.
		std::erase_if(mounts, [&](const MountLine& other) {
			return other.mountPoint == mount.mountPoint;
		});
		mounts.push_back(mount);
	}

	VolumeSnapshot snapshot;
	std::vector<bool> wholeTrees;
	for (const MountLine& mount : mounts) {
		struct statx info;
		// Never wait on a network server or trigger an automount here.
		if (statx(AT_FDCWD, mount.mountPoint.c_str(),
				AT_SYMLINK_NOFOLLOW | AT_NO_AUTOMOUNT | AT_STATX_DONT_SYNC,
				STATX_TYPE, &info) != 0
			|| !S_ISDIR(info.stx_mode)) {
			continue;
		}
		dev_t device = folder.Fold(
			makedev(info.stx_dev_major, info.stx_dev_minor));
		snapshot.mountPoints.push_back({ mount.mountPoint, device });

		VolumeEntry volume;
		volume.device = device;
		volume.root = mount.mountPoint;
		volume.fsName = mount.fsName;
		volume.deviceName = mount.source;
		volume.flags = FlagsForFileSystem(mount.fsName);
		if (mount.readOnly)
			volume.flags |= B_FS_IS_READONLY;
		if (IsRemovableDevice(mount.major, mount.minor))
			volume.flags |= B_FS_IS_REMOVABLE;
		volume.boot = mount.mountPoint == "/";

		// A file system mounted again elsewhere (a bind mount) is one
		// volume: the root folder's mount counts, else the mount of the
		// file system's whole tree, else the first.
		auto same = std::find_if(snapshot.volumes.begin(),
			snapshot.volumes.end(), [&](const VolumeEntry& other) {
				return other.device == device;
			});
		bool wholeTree = mount.root == "/";
		if (same == snapshot.volumes.end()) {
			snapshot.volumes.push_back(volume);
			wholeTrees.push_back(wholeTree);
			continue;
		}
		size_t index = same - snapshot.volumes.begin();
		if (volume.boot || (wholeTree && !wholeTrees[index] && !same->boot)) {
			*same = volume;
			wholeTrees[index] = wholeTree;
		}
	}
	return snapshot;
}

VolumeSnapshot ReadVolumeTableFile(const std::string& path)
{
	std::vector<VolumeEntry> volumes;
	int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
	if (fd < 0)
		return {};
	std::stringstream stream(ReadAll(fd));
	close(fd);
	std::string line;
	while (std::getline(stream, line)) {
		std::vector<std::string> fields = SplitEscapedFields(line);
		if (fields.size() != 5 || fields[0][0] == '#')
			continue;
		char* end;
		long id = std::strtol(fields[0].c_str(), &end, 10);
		if (*end != '\0' || id <= 0 || id > INT32_MAX)
			continue;
		VolumeEntry volume;
		volume.device = id;
		volume.fsName = fields[1];
		volume.name = fields[3];
		char root[PATH_MAX];
		if (realpath(fields[4].c_str(), root) == nullptr)
			continue;
		volume.root = root;
		std::stringstream flags(fields[2]);
		std::string flag;
		while (std::getline(flags, flag, ',')) {
			if (flag == "ro")
				volume.flags |= B_FS_IS_READONLY;
			else if (flag == "persistent")
				volume.flags |= B_FS_IS_PERSISTENT;
			else if (flag == "removable")
				volume.flags |= B_FS_IS_REMOVABLE;
			else if (flag == "shared")
				volume.flags |= B_FS_IS_SHARED;
			else if (flag == "attr")
				volume.flags |= kAttributes;
			else if (flag == "boot")
				volume.boot = true;
		}
		bool taken = std::any_of(volumes.begin(), volumes.end(),
			[&](const VolumeEntry& other) {
				return other.device == volume.device;
			});
		if (!taken)
			volumes.push_back(volume);
	}
	return SnapshotOf(volumes);
}

VolumeSnapshot SnapshotOf(const std::vector<VolumeEntry>& volumes)
{
	VolumeSnapshot snapshot;
	snapshot.volumes = volumes;
	for (const VolumeEntry& volume : volumes)
		snapshot.mountPoints.push_back({ volume.root, volume.device });
	return snapshot;
}

}
