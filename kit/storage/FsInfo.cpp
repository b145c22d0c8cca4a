#include <fs_info.h>

#include <cstring>
#include <fcntl.h>
#include <linux/fs.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <unistd.h>

#include "EntryPath.h"
#include "ErrnoStatus.h"
#include "VolumeTable.h"

namespace {

void CopyString(char* target, size_t size, const std::string& source)
{
	size_t length = std::min(source.size(), size - 1);
	std::memcpy(target, source.data(), length);
	target[length] = '\0';
}

std::string PlatformFileSystemName(const std::string& name)
{
	if (name == "vfat" || name == "msdos")
		return "dos";
	if (name == "befs")
		return "bfs";
	return name;
}

// The file-system label where the file system tells it.
std::string Label(const std::string& root)
{
	int fd = open(root.c_str(),
		O_RDONLY | O_DIRECTORY | O_NONBLOCK | O_CLOEXEC);
	if (fd < 0)
		return "";
	char label[FSLABEL_MAX] = {};
	bool known = ioctl(fd, FS_IOC_GETFSLABEL, label) == 0;
	close(fd);
	return known ? std::string(label, strnlen(label, sizeof(label))) : "";
}

std::string VolumeName(const BPrivate::VolumeEntry& volume)
{
	if (!volume.name.empty())
		return volume.name;
	std::string label = Label(volume.root);
	if (!label.empty())
		return label;
	if (volume.root == "/") {
		char host[256] = {};
		if (gethostname(host, sizeof(host) - 1) == 0 && host[0] != '\0')
			return host;
		return "/";
	}
	return volume.root.substr(volume.root.rfind('/') + 1);
}

dev_t ErrorDevice(status_t status)
{
	return static_cast<dev_t>(static_cast<int64>(status));
}

}

dev_t dev_for_path(const char* path)
{
	std::string canonical;
	status_t status = BPrivate::CanonicalPath(path, &canonical);
	if (status != B_OK)
		return ErrorDevice(status);
	return BPrivate::VolumeTable::Default().DeviceFor(canonical);
}

dev_t next_dev(int32* pos)
{
	if (pos == nullptr || *pos < 0)
		return ErrorDevice(B_BAD_VALUE);
	std::vector<BPrivate::VolumeEntry> volumes
		= BPrivate::VolumeTable::Default().Volumes();
	if (static_cast<size_t>(*pos) >= volumes.size())
		return ErrorDevice(B_BAD_VALUE);
	return volumes[(*pos)++].device;
}

status_t fs_stat_dev(dev_t dev, fs_info* info)
{
	if (info == nullptr)
		return B_BAD_VALUE;
	BPrivate::VolumeEntry volume;
	status_t status = BPrivate::VolumeTable::Default().Find(dev, &volume);
	if (status != B_OK)
		return status;
	struct statvfs space;
	struct stat root;
	if (statvfs(volume.root.c_str(), &space) != 0
		|| stat(volume.root.c_str(), &root) != 0) {
		return BPrivate::StatusFromErrno();
	}
	*info = fs_info();
	info->dev = dev;
	info->root = root.st_ino;
	info->flags = volume.flags;
	if ((space.f_flag & ST_RDONLY) != 0)
		info->flags |= B_FS_IS_READONLY;
	info->block_size = space.f_frsize;
	info->io_size = space.f_bsize;
	info->total_blocks = space.f_blocks;
	info->free_blocks = space.f_bavail;
	info->total_nodes = space.f_files;
	info->free_nodes = space.f_ffree;
	CopyString(info->device_name, sizeof(info->device_name),
		volume.deviceName);
	CopyString(info->volume_name, sizeof(info->volume_name),
		VolumeName(volume));
	CopyString(info->fsh_name, sizeof(info->fsh_name),
		PlatformFileSystemName(volume.fsName));
	return B_OK;
}
