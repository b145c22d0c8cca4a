#include <Volume.h>

#include <cstring>

#include <Directory.h>
#include <fs_info.h>

#include "VolumeTable.h"

BVolume::BVolume()
	:
	fDevice(0),
	fCStatus(B_NO_INIT)
{
}

BVolume::BVolume(dev_t device)
	:
	fDevice(0),
	fCStatus(B_NO_INIT)
{
	SetTo(device);
}

BVolume::BVolume(const BVolume& volume) = default;

BVolume::~BVolume() = default;

status_t BVolume::InitCheck() const
{
	return fCStatus;
}

status_t BVolume::SetTo(dev_t device)
{
	Unset();
	BPrivate::VolumeEntry volume;
	fCStatus = BPrivate::VolumeTable::Default().Find(device, &volume);
	if (fCStatus == B_OK)
		fDevice = device;
	return fCStatus;
}

void BVolume::Unset()
{
	fDevice = 0;
	fCStatus = B_NO_INIT;
}

dev_t BVolume::Device() const
{
	return fDevice;
}

status_t BVolume::GetRootDirectory(BDirectory* directory) const
{
	if (directory == nullptr)
		return B_BAD_VALUE;
	BPrivate::VolumeEntry volume;
	status_t status = fCStatus == B_OK
		? BPrivate::VolumeTable::Default().Find(fDevice, &volume) : fCStatus;
	if (status != B_OK) {
		directory->Unset();
		return status;
	}
	return directory->SetTo(volume.root.c_str());
}

status_t BVolume::_GetInfo(fs_info* info) const
{
	return fCStatus == B_OK ? fs_stat_dev(fDevice, info) : fCStatus;
}

off_t BVolume::Capacity() const
{
	fs_info info;
	status_t status = _GetInfo(&info);
	return status == B_OK ? info.block_size * info.total_blocks : status;
}

off_t BVolume::FreeBytes() const
{
	fs_info info;
	status_t status = _GetInfo(&info);
	return status == B_OK ? info.block_size * info.free_blocks : status;
}

off_t BVolume::BlockSize() const
{
	fs_info info;
	status_t status = _GetInfo(&info);
	return status == B_OK ? info.block_size : status;
}

status_t BVolume::GetName(char* name) const
{
	if (name == nullptr)
		return B_BAD_VALUE;
	fs_info info;
	status_t status = _GetInfo(&info);
	if (status == B_OK)
		std::strcpy(name, info.volume_name);
	return status;
}

bool BVolume::_HasFlag(uint32 flag) const
{
	fs_info info;
	return _GetInfo(&info) == B_OK && (info.flags & flag) != 0;
}

bool BVolume::IsRemovable() const
{
	return _HasFlag(B_FS_IS_REMOVABLE);
}

bool BVolume::IsReadOnly() const
{
	return _HasFlag(B_FS_IS_READONLY);
}

bool BVolume::IsPersistent() const
{
	return _HasFlag(B_FS_IS_PERSISTENT);
}

bool BVolume::IsShared() const
{
	return _HasFlag(B_FS_IS_SHARED);
}

bool BVolume::KnowsMime() const
{
	return _HasFlag(B_FS_HAS_MIME);
}

bool BVolume::KnowsAttr() const
{
	return _HasFlag(B_FS_HAS_ATTR);
}

bool BVolume::KnowsQuery() const
{
	return _HasFlag(B_FS_HAS_QUERY);
}

bool BVolume::operator==(const BVolume& volume) const
{
	return fCStatus == volume.fCStatus && fDevice == volume.fDevice;
}

bool BVolume::operator!=(const BVolume& volume) const
{
	return !(*this == volume);
}

BVolume& BVolume::operator=(const BVolume& volume) = default;
