#ifndef _STATABLE_H
#define _STATABLE_H

#include <SupportDefs.h>
#include <sys/stat.h>
#include <ctime>

struct node_ref;
class BVolume;

// What can be asked of a node's stat. In every stat the kit hands out,
// st_dev is the kit's id of the node's volume (see fs_info.h), the one refs
// and BVolume use.
class BStatable {
public:
	virtual ~BStatable();

	virtual status_t GetStat(struct stat* st) const = 0;

	bool IsFile() const;
	bool IsDirectory() const;
	bool IsSymLink() const;

	status_t GetNodeRef(node_ref* ref) const;
	status_t GetOwner(uid_t* owner) const;
	status_t SetOwner(uid_t owner);
	status_t GetGroup(gid_t* group) const;
	status_t SetGroup(gid_t group);
	status_t GetPermissions(mode_t* permissions) const;
	status_t SetPermissions(mode_t permissions);
	status_t GetSize(off_t* size) const;
	status_t GetModificationTime(time_t* mtime) const;
	status_t SetModificationTime(time_t mtime);
	status_t GetAccessTime(time_t* atime) const;
	status_t SetAccessTime(time_t atime);
	status_t GetVolume(BVolume* volume) const;

private:
	virtual status_t _SetStat(const struct stat& st, uint32 what) = 0;
};

#endif
