#ifndef GV_SCROLL_VIEW_H
#define GV_SCROLL_VIEW_H

#include <View.h>

class BScrollBar;
class GvTargetView;

// The frame around a pane: a border line one pixel outside the pane, drawn in
// the focus colour while the pane has the focus, and two scroll bars aimed at
// the pane along the bottom and right edges.
class GvScrollView : public BView {
public:
	GvScrollView(const char* name, GvTargetView* target, uint32 resizingMode);

	virtual void Draw(BRect updateRect);
	virtual void FrameResized(float width, float height);

	void SetBorder(bool shown);

	BRect borderRect;
	bool borderShown;
	GvTargetView* target;
	BScrollBar* hbar;
	BScrollBar* vbar;
};

#endif
