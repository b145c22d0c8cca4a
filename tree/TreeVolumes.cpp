// Filling the tree from the file system: the volumes, their mounts and
// unmounts, and the lazy, one-time reading of a folder's subfolders.

#include "GvTreeView.h"

#include <Directory.h>
#include <Message.h>
#include <Messenger.h>
#include <NodeMonitor.h>
#include <Volume.h>
#include <VolumeRoster.h>
#include <Window.h>

#include "Commands.h"
#include "FolderItem.h"

int32 GvTreeView::InitTree()
{
	RemoveAll();

	BVolume volume;
	dev_t boot = -1;
	if (volumeRoster->GetBootVolume(&volume) == B_OK) {
		boot = volume.Device();
		AddVolume(boot);
	}
	volumeRoster->Rewind();
	while (volumeRoster->GetNextVolume(&volume) == B_OK) {
		if (volume.IsPersistent() && volume.Device() != boot)
			AddVolume(volume.Device());
	}
	volumeRoster->StartWatching(BMessenger(this));

	int32 result = 2;
	if (first != NULL) {
		result = AddSubdirs(first);
		if (result == 1)
			_Open(first);
	}
	AdjustScrollBars(Bounds().Width(), Bounds().Height());
	return result;
}

void GvTreeView::AddVolume(int32 device)
{
	// A mount that is heard of twice still gets one row.
	for (FolderItem* item = first; item != NULL; item = item->nextVisible) {
		if (item->level == 0 && item->device == dev_t(device))
			return;
	}

	BVolume volume(device);
	BDirectory root;
	BEntry rootEntry;
	entry_ref rootRef;
	if (volume.GetRootDirectory(&root) != B_OK || root.GetEntry(&rootEntry) != B_OK
		|| rootEntry.GetRef(&rootRef) != B_OK)
		return;

	FolderItem* item = new FolderItem(&rootRef, 0,
		volume.IsReadOnly() ? GV_FOLDER_READ_ONLY : GV_FOLDER_ORDINARY);
	item->device = device;
	AddItem(FindLast(), item);
}

void GvTreeView::RemoveVolume(int32 device)
{
	for (FolderItem* item = first; item != NULL; item = item->next) {
		if (item->isVolume && item->device == dev_t(device)) {
			RemoveItem(item);
			return;
		}
	}
}

void GvTreeView::Monitor(BMessage* message)
{
	switch (message->GetInt32(GV_OPCODE, 0)) {
		case B_DEVICE_MOUNTED:
		{
			int32 device = message->GetInt32(GV_NEW_DEVICE, -1);
			BVolume volume(device);
			if (volume.InitCheck() == B_OK && volume.IsPersistent())
				AddVolume(device);
			break;
		}
		case B_DEVICE_UNMOUNTED:
			RemoveVolume(message->GetInt32(GV_DEVICE, -1));
			break;
	}
	if (Window() != NULL)
		Window()->PostMessage(GV_REFRESH, this);
	BMessage refresh(GV_REFRESH);
	_SendToFiles(&refresh);
}

int GvTreeView::_StatusFor(const entry_ref* ref, const FolderItem* parent) const
{
	if (*ref == desktopRef)
		return GV_FOLDER_DESKTOP;
	if (*ref == trashRef)
		return GV_FOLDER_TRASH;
	return parent->status;
}

int32 GvTreeView::AddSubdirs(FolderItem* item)
{
	if (item == NULL)
		return 2;
	if (item->subdirsRead)
		return 1;
	BDirectory folder(&item->ref);
	if (folder.InitCheck() != B_OK)
		return 0;

	// Rows made before a first read that failed are not made twice.
	FolderItem* last = _LastOf(item);
	bool hadChildren = last != item;
	int32 result = 0;
	entry_ref ref;
	struct stat st;
	while (folder.GetNextRef(&ref) == B_OK) {
		if (folder.GetStatFor(ref.name, &st) != B_OK || !S_ISDIR(st.st_mode))
			continue;
		result = 1;
		if (hadChildren && _FindChild(item, &ref) != NULL)
			continue;
		FolderItem* child = new FolderItem(&ref, item->level + 1, _StatusFor(&ref, item));
		_Link(last, child);
		last = child;
	}
	item->subdirsRead = true;
	_CountRows();
	return result;
}

int32 GvTreeView::Expand_Collapse(FolderItem* item)
{
	BRect area = Bounds();
	if (item == NULL)
		return 2;
	area.top = _RowTop(IndexOf(item));
	if (item->subdirCount <= 0)
		return 1;

	int32 result = 1;
	if (item->expanded)
		Collapse(item);
	else {
		if (!item->subdirsRead)
			Disable(area);
		result = Expand(item);
	}
	Enable(area);
	AdjustScrollBars(Bounds().Width(), Bounds().Height());
	return result;
}
