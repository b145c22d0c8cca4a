#ifndef GV_DRAG_VIEW_H
#define GV_DRAG_VIEW_H

#include <View.h>

class BBitmap;

// Draws the image shown under the pointer while a row is dragged: the row's
// icon with a badge for the kind of drop (a plus for a copy, a corner for a
// link, none for a move) and the row's name. It draws once, when added to
// the drag bitmap.
class GvDragView : public BView {
public:
	// Takes ownership of icon (16 x 16, B_CMAP8).
	GvDragView(BRect frame, BBitmap* icon, const char* name, int32 mode);
	virtual ~GvDragView();

	virtual void AttachedToWindow();
	virtual void Draw(BRect updateRect);

	void DrawCopy();
	void DrawLink();
	void DrawMove();

	int32 mode;
	BBitmap* icon;
	char name[256];

private:
	void DrawIcon();
	void DrawBadge(BPoint firstStart, BPoint firstEnd, BPoint secondStart,
		BPoint secondEnd);
};

#endif
