#include <Entry.h>

#include <cstring>

#include <Directory.h>
#include <Path.h>

#include "EntryPath.h"
#include "ErrnoStatus.h"

using BPrivate::EntryPath;

BEntry::BEntry()
	:
	fCStatus(B_NO_INIT)
{
}

BEntry::BEntry(const BDirectory* dir, const char* path, bool traverse)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(dir, path, traverse);
}

BEntry::BEntry(const entry_ref* ref, bool traverse)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(ref, traverse);
}

BEntry::BEntry(const char* path, bool traverse)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(path, traverse);
}

BEntry::BEntry(const BEntry& entry)
	:
	BStatable(),
	fRef(entry.fRef),
	fCStatus(entry.fCStatus)
{
}

BEntry::~BEntry() = default;

status_t BEntry::InitCheck() const
{
	return fCStatus;
}

bool BEntry::Exists() const
{
	struct stat st;
	return GetStat(&st) == B_OK;
}

status_t BEntry::GetStat(struct stat* st) const
{
	if (st == nullptr)
		return B_BAD_VALUE;
	EntryPath entry;
	status_t status = _Resolve(&entry);
	if (status != B_OK)
		return status;
	std::string path = entry.Path();
	if (lstat(path.c_str(), st) != 0)
		return BPrivate::StatusFromErrno();
	st->st_dev = BPrivate::DeviceOfNode(path, *st, fRef.device);
	return B_OK;
}

status_t BEntry::SetTo(const BDirectory* dir, const char* path, bool traverse)
{
	Unset();
	if (dir == nullptr || path == nullptr)
		return fCStatus = B_BAD_VALUE;
	if (path[0] == '/')
		return SetTo(path, traverse);
	std::string folder;
	status_t status = BPrivate::PathOfDirectory(dir, &folder);
	if (status != B_OK)
		return fCStatus = status;
	return SetTo(BPrivate::JoinPath(folder, path).c_str(), traverse);
}

status_t BEntry::SetTo(const entry_ref* ref, bool traverse)
{
	Unset();
	if (ref == nullptr)
		return fCStatus = B_BAD_VALUE;
	EntryPath entry;
	status_t status = BPrivate::EntryForRef(*ref, &entry);
	if (status != B_OK)
		return fCStatus = status;
	struct stat st;
	if (traverse && lstat(entry.Path().c_str(), &st) == 0
		&& S_ISLNK(st.st_mode)) {
		return SetTo(entry.Path().c_str(), true);
	}
	fRef = *ref;
	return fCStatus = B_OK;
}

status_t BEntry::SetTo(const char* path, bool traverse)
{
	Unset();
	return fCStatus = BPrivate::RefForPath(path, traverse, &fRef);
}

void BEntry::Unset()
{
	fRef = entry_ref();
	fCStatus = B_NO_INIT;
}

status_t BEntry::GetRef(entry_ref* ref) const
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (ref == nullptr)
		return B_BAD_VALUE;
	*ref = fRef;
	return B_OK;
}

status_t BEntry::GetPath(BPath* path) const
{
	if (path == nullptr)
		return B_BAD_VALUE;
	EntryPath entry;
	status_t status = _Resolve(&entry);
	if (status != B_OK)
		return status;
	return path->SetTo(entry.Path().c_str());
}

status_t BEntry::GetParent(BEntry* entry) const
{
	if (entry == nullptr)
		return B_BAD_VALUE;
	EntryPath self;
	status_t status = _Resolve(&self);
	if (status != B_OK)
		return status;
	// The root has no parent.
	if (self.leaf == ".")
		return B_ENTRY_NOT_FOUND;
	return entry->SetTo(self.folder.c_str());
}

status_t BEntry::GetParent(BDirectory* dir) const
{
	if (dir == nullptr)
		return B_BAD_VALUE;
	BEntry parent;
	status_t status = GetParent(&parent);
	if (status != B_OK)
		return status;
	return dir->SetTo(&parent);
}

status_t BEntry::GetName(char* name) const
{
	if (fCStatus != B_OK)
		return fCStatus;
	if (name == nullptr)
		return B_BAD_VALUE;
	std::strcpy(name, fRef.name);
	return B_OK;
}

bool BEntry::operator==(const BEntry& item) const
{
	if (fCStatus != B_OK || item.fCStatus != B_OK)
		return fCStatus != B_OK && item.fCStatus != B_OK;
	return fRef == item.fRef;
}

bool BEntry::operator!=(const BEntry& item) const
{
	return !(*this == item);
}

BEntry& BEntry::operator=(const BEntry& item)
{
	fRef = item.fRef;
	fCStatus = item.fCStatus;
	return *this;
}

status_t BEntry::_SetStat(const struct stat& st, uint32 what)
{
	EntryPath entry;
	status_t status = _Resolve(&entry);
	if (status != B_OK)
		return status;
	return BPrivate::ApplyStat(-1, entry.Path().c_str(), st, what);
}

status_t BEntry::_Resolve(EntryPath* entry) const
{
	if (fCStatus != B_OK)
		return fCStatus;
	return BPrivate::EntryForRef(fRef, entry);
}

status_t get_ref_for_path(const char* path, entry_ref* ref)
{
	if (ref == nullptr)
		return B_BAD_VALUE;
	return BPrivate::RefForPath(path, false, ref);
}

bool operator<(const entry_ref& a, const entry_ref& b)
{
	if (a.device != b.device)
		return a.device < b.device;
	if (a.directory != b.directory)
		return a.directory < b.directory;
	if (a.name == nullptr || b.name == nullptr)
		return b.name != nullptr;
	return std::strcmp(a.name, b.name) < 0;
}
