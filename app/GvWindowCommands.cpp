#include "GvWindow.h"

#include <Alert.h>
#include <Application.h>
#include <Directory.h>
#include <Entry.h>
#include <FindDirectory.h>
#include <Menu.h>
#include <MenuItem.h>
#include <Message.h>
#include <Path.h>
#include <Roster.h>

#include <string>

#include "Commands.h"
#include "CopyWindow.h"
#include "GvFilesView.h"
#include "GvTreeView.h"

bool GvWindow::QuitRequested()
{
	be_app->PostMessage(B_QUIT_REQUESTED);
	return true;
}

void GvWindow::MenusBeginning()
{
	int32 status = GV_STATUS_NO_FOCUS;
	BMenuItem* openItem = filesMenu->ItemAt(GV_FILES_ITEM_OPEN);
	if (tree->IsFocus()) {
		openItem->SetLabel("Expand/Collapse");
		status = tree->GetStatus();
	}
	if (fileList->IsFocus()) {
		openItem->SetLabel("Open");
		status = fileList->GetStatus();
	}

	bool open = status != GV_STATUS_NO_FOCUS;
	bool change = status == GV_STATUS_ORDINARY;
	bool create = status == GV_STATUS_ORDINARY || status == GV_STATUS_DESKTOP_OR_NONE
		|| status == GV_STATUS_VOLUME;
	openItem->SetEnabled(open);
	filesMenu->ItemAt(GV_FILES_ITEM_RENAME)->SetEnabled(change);
	filesMenu->ItemAt(GV_FILES_ITEM_DELETE)->SetEnabled(change);
	filesMenu->ItemAt(GV_FILES_ITEM_NEW_FOLDER)->SetEnabled(create);

	// A trash that cannot be read keeps the item enabled: trying is harmless.
	BPath trashPath;
	int32 trashCount = B_ERROR;
	if (find_directory(B_TRASH_DIRECTORY, &trashPath, false) == B_OK) {
		BDirectory trash(trashPath.Path());
		trashCount = trash.CountEntries();
	}
	filesMenu->ItemAt(GV_FILES_ITEM_EMPTY_TRASH)->SetEnabled(trashCount != 0);
}

void GvWindow::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case GV_OPEN:
		case GV_ASK_RENAME:
		case GV_DELETE:
		case GV_NEW_FOLDER:
			RouteToFocusedPane(message);
			break;
		case GV_EMPTY_TRASH:
			EmptyTrash();
			break;
		case GV_HELP:
			ShowHelp();
			break;
		case GV_REFRESH:
			ShowFolderInTitle(message);
			break;
		default:
			BWindow::MessageReceived(message);
	}
}

void GvWindow::RouteToFocusedPane(BMessage* message)
{
	if (tree->IsFocus())
		tree->MessageReceived(message);
	else
		fileList->MessageReceived(message);
}

void GvWindow::EmptyTrash()
{
	BRect bounds = Bounds();
	BPoint corner = ConvertToScreen(
		BPoint(0.25f * bounds.Width(), 0.25f * bounds.Height()));
	CopyWindow* progress = new CopyWindow(BRect(0, 0, 200, 60).OffsetToCopy(corner));
	progress->EmptyTrash();
	progress->UpdateIfNeeded();
	if (progress->Lock())
		progress->Quit();
	PostMessage(GV_REFRESH, fileList);
}

void GvWindow::ShowHelp()
{
	app_info info;
	status_t result = be_app->GetAppInfo(&info);
	entry_ref helpRef;
	if (result == B_OK) {
		BEntry executable(&info.ref, false);
		BEntry folder;
		BPath folderPath;
		result = executable.GetParent(&folder);
		if (result == B_OK)
			result = folder.GetPath(&folderPath);
		if (result == B_OK) {
			BPath helpPath(folderPath.Path(), "help.html", false);
			result = get_ref_for_path(helpPath.Path(), &helpRef);
		}
	}
	if (result == B_OK)
		result = be_roster->Launch(&helpRef);
	if (result == B_OK || result == B_ALREADY_RUNNING)
		return;

	const char* text = result == B_ENTRY_NOT_FOUND
		? "Help is unavailable at this time :\nI couldn't find the proper files in my directory"
		: "Unable to open help files";
	BAlert* alert = new BAlert("", text, "Ok", NULL, NULL, B_WIDTH_AS_USUAL,
		B_INFO_ALERT);
	alert->Go();
}

void GvWindow::ShowFolderInTitle(BMessage* message)
{
	entry_ref folderRef;
	if (message->FindRef(GV_PARENT_REF, &folderRef) != B_OK)
		return;
	BEntry folder(&folderRef);
	BPath path;
	if (folder.GetPath(&path) != B_OK)
		return;
	std::string title = std::string("Varnel  (   ") + path.Path() + "   )";
	SetTitle(title.c_str());
}
