#ifndef GV_TARGET_VIEW_H
#define GV_TARGET_VIEW_H

#include <Font.h>
#include <View.h>

class GvScrollView;

// The base of both panes: their two fonts and the frame around them.
class GvTargetView : public BView {
public:
	GvTargetView(BRect frame, const char* name, uint32 resizingMode, uint32 flags);

	// The installed family whose name begins with "Dutch", the last one in the
	// system's order when there are several; false when there is none.
	static bool FindDutchFamily(font_family* family);

	BFont plainFont;
	BFont boldFont;
	// Set by the frame built around the pane; the frame is the pane's parent.
	GvScrollView* scrollFrame;
};

#endif
