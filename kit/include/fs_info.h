#ifndef _FS_INFO_H
#define _FS_INFO_H

#include <OS.h>
#include <StorageDefs.h>

// Volumes are the mounts of /proc/self/mountinfo, one per file system (bind
// mounts of one file system count once; where mounts stack on one folder the
// last one counts). A volume's id is its st_dev as the C library encodes it
// (major and minor numbers). That fits in 31 bits for every major below 4096
// and minor below 524288, which covers the devices Linux hands out in
// practice; a device beyond that gets an id of 0x7ff00000 upwards, kept for
// the life of the process. So ids always fit the int32 "device" fields of
// messages and are positive, and dev_for_path's error codes are negative once
// the result is taken as an int32.
//
// The device of a path is the id of the volume whose root is the path's
// deepest ancestor (the path's links resolved).
//
// VARNEL_VOLUME_TABLE=FILE replaces the system's volumes with the folders
// FILE lists, one volume a line:
//     ID FSNAME FLAGS NAME ROOT
// separated by blanks; ID a positive number, FSNAME the file-system name
// (fsh_name), FLAGS a comma-separated list of "ro", "persistent",
// "removable", "shared", "attr" and "boot" ("-" for none), NAME the volume
// name and ROOT its root folder; a space, tab, newline or backslash inside a
// field is written \040, \011, \012 or \134, as in mountinfo. Empty lines and
// lines starting with "#" are skipped, and so are lines whose root does not
// exist. The "boot" volume (else the first) is the boot volume; paths outside
// every listed root count as on the boot volume. The file is read again
// whenever it changes, and watchers hear of the volumes that came and went
// as of real mounts; write a new table beside it and rename it over the old
// one, so that it is never read half-written.
enum {
	B_FS_IS_READONLY = 0x00000001,
	B_FS_IS_REMOVABLE = 0x00000002,
	B_FS_IS_PERSISTENT = 0x00000004,
	B_FS_IS_SHARED = 0x00000008,
	B_FS_HAS_MIME = 0x00010000,
	B_FS_HAS_ATTR = 0x00020000,
	B_FS_HAS_QUERY = 0x00040000
};

typedef struct fs_info {
	dev_t dev;
	ino_t root;
	uint32 flags;
	off_t block_size;
	off_t io_size;
	off_t total_blocks;
	off_t free_blocks;
	off_t total_nodes;
	off_t free_nodes;
	char device_name[128];
	char volume_name[B_FILE_NAME_LENGTH];
	char fsh_name[B_OS_NAME_LENGTH];
} fs_info;

// The device of path (followed if it is a link), or an error code.
dev_t dev_for_path(const char* path);
// The volumes one after the other: pos starts at 0; an error code (as an
// int32, negative) after the last one.
dev_t next_dev(int32* pos);
// Fills info for the volume dev: fsh_name is the Linux file-system name, with
// FAT ("vfat", "msdos") reported as "dos" and BeOS volumes ("befs") as "bfs";
// volume_name is the file-system label, else the last component of the
// mount point, and the root volume without a label takes the host name;
// device_name is the mount source.
status_t fs_stat_dev(dev_t dev, fs_info* info);

#endif
