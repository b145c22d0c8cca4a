#ifndef GV_REN_VIEW_H
#define GV_REN_VIEW_H

#include <TextView.h>

// The one-line editor a pane lays over a row's name to rename it in place.
// Enter posts the name and the editor's position to the pane; Escape just
// removes the editor. Whenever it leaves its window it is emptied.
class GvRenView : public BTextView {
public:
	GvRenView(const BFont& font, BRect frame);

	virtual void DetachedFromWindow();
	virtual void Draw(BRect updateRect);
	virtual void KeyDown(const char* bytes, int32 numBytes);
};

#endif
