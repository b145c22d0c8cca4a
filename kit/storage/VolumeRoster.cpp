#include <VolumeRoster.h>

#include <Volume.h>
#include <fs_info.h>

#include "VolumeTable.h"

BVolumeRoster::BVolumeRoster()
	:
	fCookie(0),
	fWatchToken(-1)
{
}

BVolumeRoster::~BVolumeRoster()
{
	StopWatching();
}

status_t BVolumeRoster::GetNextVolume(BVolume* volume)
{
	if (volume == nullptr)
		return B_BAD_VALUE;
	dev_t device = next_dev(&fCookie);
	if (static_cast<int32>(device) < 0)
		return static_cast<int32>(device);
	return volume->SetTo(device);
}

void BVolumeRoster::Rewind()
{
	fCookie = 0;
}

status_t BVolumeRoster::GetBootVolume(BVolume* volume)
{
	if (volume == nullptr)
		return B_BAD_VALUE;
	BPrivate::VolumeEntry boot;
	status_t status = BPrivate::VolumeTable::Default().Boot(&boot);
	if (status != B_OK)
		return status;
	return volume->SetTo(boot.device);
}

status_t BVolumeRoster::StartWatching(BMessenger messenger)
{
	StopWatching();
	if (!messenger.IsValid())
		return B_BAD_VALUE;
	fWatchToken = BPrivate::VolumeTable::Default().AddWatcher(messenger);
	fTarget = messenger;
	return B_OK;
}

void BVolumeRoster::StopWatching()
{
	if (fWatchToken >= 0)
		BPrivate::VolumeTable::Default().RemoveWatcher(fWatchToken);
	fWatchToken = -1;
	fTarget = BMessenger();
}

BMessenger BVolumeRoster::Messenger() const
{
	return fTarget;
}
