#include "GvTreeView.h"

#include <Bitmap.h>
#include <FindDirectory.h>
#include <Message.h>
#include <Messenger.h>
#include <MimeType.h>
#include <Path.h>
#include <ScrollBar.h>
#include <VolumeRoster.h>
#include <Window.h>

#include "Commands.h"
#include "FolderItem.h"
#include "GvRenView.h"

namespace {

std::unique_ptr<BBitmap> MiniIcon(const char* type)
{
	auto icon = std::make_unique<BBitmap>(BRect(0, 0, 15, 15), B_CMAP8);
	BMimeType(type).GetIcon(icon.get(), B_MINI_ICON);
	return icon;
}

void GetFolderRef(directory_which which, entry_ref* ref)
{
	BPath path;
	if (find_directory(which, &path, false) == B_OK)
		get_ref_for_path(path.Path(), ref);
}

}

GvTreeView::GvTreeView(BRect frame, const char* name)
	: GvTargetView(frame, name, B_FOLLOW_ALL_SIDES,
		B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE),
	  renameView(new GvRenView(plainFont, BRect(0, 0, 70, GV_TREE_V_INT))),
	  volumeRoster(std::make_unique<BVolumeRoster>()),
	  folderIcon(MiniIcon("application/x-vnd.be-directory")),
	  volumeIcon(MiniIcon("application/x-vnd.be-volume")),
	  verticalBar(NULL),
	  horizontalBar(NULL),
	  enabled(true),
	  widestRow(0),
	  lastVisible(-1),
	  first(NULL),
	  selected(NULL),
	  filesMessenger(NULL)
{
	GetFolderRef(B_DESKTOP_DIRECTORY, &desktopRef);
	GetFolderRef(B_TRASH_DIRECTORY, &trashRef);
}

GvTreeView::~GvTreeView()
{
	RemoveAll();
	delete renameView;
	delete filesMessenger;
}

void GvTreeView::AttachedToWindow()
{
	horizontalBar = ScrollBar(B_HORIZONTAL);
	if (horizontalBar != NULL)
		horizontalBar->SetSteps(20, 100);
	verticalBar = ScrollBar(B_VERTICAL);
	if (verticalBar != NULL)
		verticalBar->SetSteps(20, 200);
	InitTree();
}

bool GvTreeView::_IsProtected(const FolderItem* item) const
{
	return item->isVolume || item->ref == desktopRef || item->status == GV_FOLDER_TRASH;
}

void GvTreeView::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_NODE_MONITOR:
			Monitor(message);
			break;
		case GV_ASK_RENAME:
		{
			int32 index;
			if (message->FindInt32(GV_TREE_INDEX, &index) != B_OK)
				index = IndexOf(selected);
			Rename(index);
			break;
		}
		case GV_FOLDER_OPEN:
		{
			entry_ref ref;
			if (message->FindRef(GV_SOURCE_REF, &ref) == B_OK) {
				FindAndOpen(&ref, message->GetInt32(GV_DEVICE, 0));
				MakeFocus(true);
			}
			break;
		}
		case GV_OPEN:
			Open(message);
			break;
		case GV_RENAMED:
			_Renamed(message);
			break;
		case GV_COPY:
			Copy(message);
			break;
		case GV_MOVE:
			Move(message);
			break;
		case GV_LINK:
			LinkTo(message);
			break;
		case GV_DELETE:
			Delete(message);
			break;
		case GV_NEW_FOLDER:
			NewFolder(message);
			break;
		case GV_REFRESH:
			Refresh(message);
			break;
		default:
			GvTargetView::MessageReceived(message);
	}
}

// The rename editor was confirmed. Volumes, the Desktop and the Trash keep
// their names; a name the file system refuses (empty, ".", "..", one with
// "/", one that exists) leaves the old one, and the notification then
// carries the same ref twice.
void GvTreeView::_Renamed(BMessage* message)
{
	FolderItem* item = ItemAt(_RowAt(message->GetFloat(GV_POSITION, -1)));
	const char* name = message->GetString(GV_NAME, NULL);
	if (item == NULL || name == NULL || _IsProtected(item))
		return;

	BMessage notification(GV_REFRESH);
	notification.AddInt32(GV_EVENT, GV_RENAMED);
	notification.AddRef(GV_OLD_REF, &item->ref);
	BEntry entry(&item->ref);
	entry.Rename(name, false);
	entry_ref renamed = item->ref;
	entry.GetRef(&renamed);
	notification.AddRef(GV_RENAMED_REF, &renamed);
	Window()->PostMessage(&notification, this);
}
