#ifndef KIT_PRIVATE_VOLUME_TABLE_H
#define KIT_PRIVATE_VOLUME_TABLE_H

#include <memory>
#include <string>
#include <vector>

#include <Messenger.h>
#include <SupportDefs.h>

namespace BPrivate {

// One mounted volume as the kit knows it.
struct VolumeEntry {
	dev_t device = 0;
	// The root folder, an absolute path with its links resolved.
	std::string root;
	// Empty for a system volume: its name is looked up when asked for.
	std::string name;
	std::string fsName;
	std::string deviceName;
	// B_FS_* flags known from the table; B_FS_IS_READONLY is also taken live
	// from the file system.
	uint32 flags = 0;
	bool boot = false;
};

// The kit's table of volumes: the system's mounts, the file named by
// VARNEL_VOLUME_TABLE (see fs_info.h), or, for tests in this process, a
// table given with Replace. Each change of the table sends B_DEVICE_MOUNTED
// and B_DEVICE_UNMOUNTED to the watchers for the volumes that came and went,
// from the thread that noticed the change.
class VolumeTable {
public:
	static VolumeTable& Default();

	// Test support. Replace takes over from the system and the file (roots
	// must exist and are canonicalised; ids must be positive int32 values
	// and distinct); Mount and Unmount take over the current table the same
	// way and change it one volume at a time; UseSystem goes back to the
	// file or the system, reading VARNEL_VOLUME_TABLE again. Each has sent
	// the events of a real change when it returns.
	status_t Replace(const std::vector<VolumeEntry>& volumes);
	status_t Mount(const VolumeEntry& volume);
	status_t Unmount(dev_t device);
	void UseSystem();

	// The current table, read again first if its source has changed.
	std::vector<VolumeEntry> Volumes();
	status_t Find(dev_t device, VolumeEntry* volume);
	status_t Boot(VolumeEntry* volume);
	// The id of the volume whose root is the deepest ancestor of an
	// absolute path without links (the path itself included), and whether
	// the path is that root when isRoot is not NULL.
	dev_t DeviceFor(const std::string& canonicalPath, bool* isRoot = nullptr);
	// Whether an absolute path without links is the root of a volume.
	bool IsRoot(const std::string& canonicalPath, dev_t* device = nullptr);
	// Whether a volume's root has leaf as its last name, in the table as it
	// was last read: a quick way for a caller who has just used the table
	// to rule out that an entry is a root, without its path.
	bool MayBeRootNamed(const char* leaf);

	// Mount and unmount events go to messenger until RemoveWatcher.
	int32 AddWatcher(const BMessenger& messenger);
	void RemoveWatcher(int32 token);

	~VolumeTable();

private:
	VolumeTable();
	VolumeTable(const VolumeTable&) = delete;
	status_t _Replace(const std::vector<VolumeEntry>& volumes);
	VolumeTable& operator=(const VolumeTable&) = delete;

	struct Private;
	std::unique_ptr<Private> fPrivate;
};

}

#endif
