#ifndef _SCREEN_H
#define _SCREEN_H

#include <GraphicsDefs.h>
#include <Rect.h>

class BWindow;

// A display. There is one, the main screen; its frame starts at (0, 0) and
// its right edge is its width minus one.
class BScreen {
public:
	BScreen(screen_id id = B_MAIN_SCREEN_ID);
	BScreen(BWindow* window);

	bool IsValid() const;
	status_t InitCheck() const { return IsValid() ? B_OK : B_ERROR; }
	screen_id ID() const;
	BRect Frame() const;
	color_space ColorSpace() const;

private:
	screen_id fID;
};

#endif
