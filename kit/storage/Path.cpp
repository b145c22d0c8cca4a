#include <Path.h>

#include <cstring>

#include <Directory.h>
#include <Entry.h>
#include <TypeConstants.h>

#include "EntryPath.h"
#include "RefFlattening.h"

namespace {

bool MustNormalize(const std::string& path)
{
	if (path.empty() || path[0] != '/')
		return true;
	if (path.size() > 1 && path.back() == '/')
		return true;
	std::string wrapped = path + "/";
	return wrapped.find("//") != std::string::npos
		|| wrapped.find("/./") != std::string::npos
		|| wrapped.find("/../") != std::string::npos;
}

// The entry_ref a path flattens to; an empty ref when it has none.
entry_ref RefFor(const BPath& path)
{
	entry_ref ref;
	if (path.InitCheck() != B_OK || get_ref_for_path(path.Path(), &ref) != B_OK)
		ref = entry_ref();
	return ref;
}

}

BPath::BPath()
	:
	fCStatus(B_NO_INIT)
{
}

BPath::BPath(const BPath& path)
	:
	BFlattenable(),
	fName(path.fName),
	fCStatus(path.fCStatus)
{
}

BPath::BPath(const entry_ref* ref)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(ref);
}

BPath::BPath(const BEntry* entry)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(entry);
}

BPath::BPath(const char* dir, const char* leaf, bool normalize)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(dir, leaf, normalize);
}

BPath::BPath(const BDirectory* dir, const char* leaf, bool normalize)
	:
	fCStatus(B_NO_INIT)
{
	SetTo(dir, leaf, normalize);
}

BPath::~BPath() = default;

status_t BPath::InitCheck() const
{
	return fCStatus;
}

status_t BPath::SetTo(const entry_ref* ref)
{
	Unset();
	if (ref == nullptr)
		return fCStatus = B_BAD_VALUE;
	BPrivate::EntryPath entry;
	status_t status = BPrivate::EntryForRef(*ref, &entry);
	if (status != B_OK)
		return fCStatus = status;
	fName = entry.Path();
	return fCStatus = B_OK;
}

status_t BPath::SetTo(const BEntry* entry)
{
	Unset();
	if (entry == nullptr)
		return fCStatus = B_BAD_VALUE;
	status_t status = entry->GetPath(this);
	if (status != B_OK)
		Unset();
	return fCStatus = status;
}

status_t BPath::SetTo(const char* path, const char* leaf, bool normalize)
{
	Unset();
	if (path == nullptr || path[0] == '\0' || (leaf != nullptr && leaf[0] == '/'))
		return fCStatus = B_BAD_VALUE;
	std::string full = leaf != nullptr && leaf[0] != '\0'
		? BPrivate::JoinPath(path, leaf) : path;
	if (normalize || MustNormalize(full)) {
		BPrivate::EntryPath entry;
		status_t status = BPrivate::CanonicalEntry(full.c_str(), false,
			&entry);
		if (status != B_OK)
			return fCStatus = status;
		full = entry.Path();
	}
	fName = full;
	return fCStatus = B_OK;
}

status_t BPath::SetTo(const BDirectory* dir, const char* leaf, bool normalize)
{
	Unset();
	std::string folder;
	status_t status = BPrivate::PathOfDirectory(dir, &folder);
	if (status != B_OK)
		return fCStatus = status;
	return SetTo(folder.c_str(), leaf, normalize);
}

void BPath::Unset()
{
	fName.clear();
	fCStatus = B_NO_INIT;
}

status_t BPath::Append(const char* path, bool normalize)
{
	if (fCStatus != B_OK)
		return B_BAD_VALUE;
	std::string folder = fName;
	return SetTo(folder.c_str(), path, normalize);
}

const char* BPath::Path() const
{
	return fCStatus == B_OK ? fName.c_str() : nullptr;
}

const char* BPath::Leaf() const
{
	if (fCStatus != B_OK)
		return nullptr;
	return fName.c_str() + fName.rfind('/') + 1;
}

status_t BPath::GetParent(BPath* path) const
{
	if (path == nullptr)
		return B_BAD_VALUE;
	if (fCStatus != B_OK)
		return fCStatus;
	if (fName == "/")
		return B_ENTRY_NOT_FOUND;
	size_t slash = fName.rfind('/');
	return path->SetTo(slash == 0 ? "/" : fName.substr(0, slash).c_str());
}

bool BPath::operator==(const BPath& item) const
{
	return *this == item.Path();
}

bool BPath::operator==(const char* path) const
{
	if (fCStatus != B_OK || path == nullptr)
		return fCStatus != B_OK && path == nullptr;
	return fName == path;
}

bool BPath::operator!=(const BPath& item) const
{
	return !(*this == item);
}

bool BPath::operator!=(const char* path) const
{
	return !(*this == path);
}

BPath& BPath::operator=(const BPath& item)
{
	fName = item.fName;
	fCStatus = item.fCStatus;
	return *this;
}

BPath& BPath::operator=(const char* path)
{
	SetTo(path);
	return *this;
}

bool BPath::IsFixedSize() const
{
	return false;
}

type_code BPath::TypeCode() const
{
	return B_REF_TYPE;
}

ssize_t BPath::FlattenedSize() const
{
	return BPrivate::FlattenedRefSize(RefFor(*this));
}

status_t BPath::Flatten(void* buffer, ssize_t size) const
{
	return BPrivate::FlattenRef(RefFor(*this), buffer, size);
}

bool BPath::AllowsTypeCode(type_code code) const
{
	return code == B_REF_TYPE;
}

status_t BPath::Unflatten(type_code code, const void* buffer, ssize_t size)
{
	if (code != B_REF_TYPE)
		return B_BAD_TYPE;
	entry_ref ref;
	status_t status = BPrivate::UnflattenRef(&ref, buffer, size);
	if (status != B_OK)
		return status;
	if (ref.name == nullptr) {
		Unset();
		return B_OK;
	}
	return SetTo(&ref);
}
