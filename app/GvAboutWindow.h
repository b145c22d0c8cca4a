#ifndef GV_ABOUT_WINDOW_H
#define GV_ABOUT_WINDOW_H

#include <Window.h>

class GvAboutView;

// A small floating window with the program's icon, name, version and
// authors; its button closes it.
class GvAboutWindow : public BWindow {
public:
	GvAboutWindow(BRect frame);

	GvAboutView* aboutView;
};

#endif
