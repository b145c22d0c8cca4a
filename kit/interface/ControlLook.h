#ifndef KIT_INTERFACE_CONTROL_LOOK_H
#define KIT_INTERFACE_CONTROL_LOOK_H

#include <GraphicsDefs.h>
#include <Rect.h>

class BView;

// The grey look shared by the controls: colours and the few shapes they are
// drawn with. Every function draws with the view's current state and leaves
// the high colour changed.
namespace BPrivate::ControlLook {

constexpr rgb_color kFace = {205, 205, 205, 255};
constexpr rgb_color kLight = {255, 255, 255, 255};
constexpr rgb_color kLightShadow = {184, 184, 184, 255};
constexpr rgb_color kShadow = {136, 136, 136, 255};
constexpr rgb_color kDarkShadow = {80, 80, 80, 255};
constexpr rgb_color kText = {0, 0, 0, 255};
constexpr rgb_color kDisabledText = {128, 128, 128, 255};
constexpr rgb_color kSelection = {150, 150, 150, 255};
constexpr rgb_color kTextSelection = {180, 200, 235, 255};

// A one-pixel 3-D edge: light on the top and left, dark on the bottom and
// right when raised; the other way round when sunken.
void DrawBevel(BView* view, BRect rect, bool raised);

// Solid shapes, drawn as rows of pixels.
void FillTriangle(BView* view, BPoint a, BPoint b, BPoint c, rgb_color color);
void FillEllipse(BView* view, BRect rect, rgb_color color);

// A small arrow head inside rect pointing in direction (one of the arrow
// key bytes of InterfaceDefs.h).
void DrawArrow(BView* view, BRect rect, char direction, rgb_color color);

// The baseline that centres one line of the view's font in rect.
float CenteredBaseline(const BView* view, BRect rect);

}

#endif
