#ifndef GV_FILES_VIEW_H
#define GV_FILES_VIEW_H

#include "GvTargetView.h"

class BMessenger;
class GvRenView;

// The right pane: the entries of the folder selected in the tree.
class GvFilesView : public GvTargetView {
public:
	GvFilesView(BRect frame, const char* name);
	virtual ~GvFilesView();

	virtual void MessageReceived(BMessage* message);
	virtual void MakeFocus(bool focused = true);

	int32 GetStatus();

	GvRenView* renameView;
	// The tree; set by the window once both panes exist.
	BMessenger* treeMessenger;
};

#endif
