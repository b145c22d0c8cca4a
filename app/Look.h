#ifndef VARNEL_LOOK_H
#define VARNEL_LOOK_H

#include <GraphicsDefs.h>

// The colours the whole program shares.

// Background of the panes, their frames, drag images, the About view and the
// progress window.
constexpr rgb_color GV_GREY = { 205, 205, 205, 255 };
// Selection highlight and the wash over a pane that is busy.
constexpr rgb_color GV_WASH = { 150, 150, 150, 255 };
// The border of the pane that has the keyboard focus.
constexpr rgb_color GV_FOCUS = { 0, 120, 80, 255 };

#endif
