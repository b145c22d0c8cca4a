#include <Statable.h>

#include <Node.h>
#include <NodeMonitor.h>
#include <Volume.h>

namespace {

template<typename Field, typename Pick>
status_t GetField(const BStatable& node, Field* field, Pick pick)
{
	if (field == nullptr)
		return B_BAD_VALUE;
	struct stat st;
	status_t status = node.GetStat(&st);
	if (status == B_OK)
		*field = pick(st);
	return status;
}

}

BStatable::~BStatable() = default;

bool BStatable::IsFile() const
{
	struct stat st;
	return GetStat(&st) == B_OK && S_ISREG(st.st_mode);
}

bool BStatable::IsDirectory() const
{
	struct stat st;
	return GetStat(&st) == B_OK && S_ISDIR(st.st_mode);
}

bool BStatable::IsSymLink() const
{
	struct stat st;
	return GetStat(&st) == B_OK && S_ISLNK(st.st_mode);
}

status_t BStatable::GetNodeRef(node_ref* ref) const
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	struct stat st;
	status_t status = GetStat(&st);
	if (status == B_OK)
		*ref = node_ref(st.st_dev, st.st_ino);
	return status;
}

status_t BStatable::GetOwner(uid_t* owner) const
{
	return GetField(*this, owner, [](const struct stat& st) { return st.st_uid; });
}

status_t BStatable::SetOwner(uid_t owner)
{
	struct stat st = {};
	st.st_uid = owner;
	return _SetStat(st, B_STAT_UID);
}

status_t BStatable::GetGroup(gid_t* group) const
{
	return GetField(*this, group, [](const struct stat& st) { return st.st_gid; });
}

status_t BStatable::SetGroup(gid_t group)
{
	struct stat st = {};
	st.st_gid = group;
	return _SetStat(st, B_STAT_GID);
}

status_t BStatable::GetPermissions(mode_t* permissions) const
{
	return GetField(*this, permissions,
		[](const struct stat& st) { return st.st_mode & 07777; });
}

status_t BStatable::SetPermissions(mode_t permissions)
{
	struct stat st = {};
	st.st_mode = permissions;
	return _SetStat(st, B_STAT_MODE);
}

status_t BStatable::GetSize(off_t* size) const
{
	return GetField(*this, size, [](const struct stat& st) { return st.st_size; });
}

status_t BStatable::GetModificationTime(time_t* mtime) const
{
	return GetField(*this, mtime,
		[](const struct stat& st) { return st.st_mtim.tv_sec; });
}

status_t BStatable::SetModificationTime(time_t mtime)
{
	struct stat st = {};
	st.st_mtim.tv_sec = mtime;
	return _SetStat(st, B_STAT_MODIFICATION_TIME);
}

status_t BStatable::GetAccessTime(time_t* atime) const
{
	return GetField(*this, atime,
		[](const struct stat& st) { return st.st_atim.tv_sec; });
}

status_t BStatable::SetAccessTime(time_t atime)
{
	struct stat st = {};
	st.st_atim.tv_sec = atime;
	return _SetStat(st, B_STAT_ACCESS_TIME);
}

status_t BStatable::GetVolume(BVolume* volume) const
{
	if (volume == nullptr)
		return B_BAD_VALUE;
	struct stat st;
	status_t status = GetStat(&st);
	if (status != B_OK)
		return status;
	return volume->SetTo(st.st_dev);
}
