#ifndef KIT_STORAGE_VOLUME_SOURCES_H
#define KIT_STORAGE_VOLUME_SOURCES_H

#include <map>
#include <string>
#include <vector>

#include "VolumeTable.h"

namespace BPrivate {

// A folder where a volume is mounted. Bind mounts of a volume that is
// already listed still count for the device of the paths below them.
struct MountPoint {
	std::string path;
	dev_t device;
};

struct VolumeSnapshot {
	std::vector<VolumeEntry> volumes;
	std::vector<MountPoint> mountPoints;
};

// Turns st_dev numbers into ids that fit 31 bits, the same id for the same
// number for the life of the object (see fs_info.h).
class DeviceIdFolder {
public:
	dev_t Fold(dev_t raw);

private:
	std::map<dev_t, dev_t> fFolded;
};

// Splits one line of /proc/self/mountinfo, or of a volume table file, into
// its blank-separated fields, octal escapes (\040) decoded.
std::vector<std::string> SplitEscapedFields(const std::string& line);

// The volumes of /proc/self/mountinfo, read from its start through fd.
VolumeSnapshot ReadMountInfo(int fd, DeviceIdFolder& folder);
// The volumes of a table file; an unreadable file gives none.
VolumeSnapshot ReadVolumeTableFile(const std::string& path);
// The snapshot of volumes given whole.
VolumeSnapshot SnapshotOf(const std::vector<VolumeEntry>& volumes);

}

#endif
