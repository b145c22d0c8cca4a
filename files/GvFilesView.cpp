#include "GvFilesView.h"

#include <Message.h>
#include <Messenger.h>

#include "Commands.h"
#include "GvRenView.h"
#include "GvScrollView.h"

namespace {
const float GV_FILES_TEXT = 200;
const float GV_FILES_V_INT = 16;
}

GvFilesView::GvFilesView(BRect frame, const char* name)
	: GvTargetView(frame, name, B_FOLLOW_ALL, B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE),
	  renameView(new GvRenView(plainFont, BRect(0, 0, GV_FILES_TEXT, GV_FILES_V_INT))),
	  treeMessenger(NULL)
{
}

GvFilesView::~GvFilesView()
{
	if (renameView->Parent() == NULL)
		delete renameView;
	delete treeMessenger;
}

void GvFilesView::MakeFocus(bool focused)
{
	if (scrollFrame != NULL)
		scrollFrame->SetBorder(focused);
	BView::MakeFocus(true);
}

int32 GvFilesView::GetStatus()
{
	return GV_STATUS_DESKTOP_OR_NONE;
}

void GvFilesView::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case GV_OPEN:
		case GV_ASK_RENAME:
		case GV_DELETE:
			// They act on the selected row; with no rows there is none.
			break;
		case GV_NEW_FOLDER:
			// Folders are created by the tree, in the folder it has selected.
			if (treeMessenger != NULL)
				treeMessenger->SendMessage(message);
			break;
		default:
			GvTargetView::MessageReceived(message);
	}
}
