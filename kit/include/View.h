#ifndef _VIEW_H
#define _VIEW_H

#include <memory>

#include <Font.h>
#include <Handler.h>
#include <InterfaceDefs.h>
#include <Rect.h>

class BBitmap;
class BMessage;
class BScrollBar;
class BWindow;

namespace BPrivate {
struct ViewData;
class ViewAccess;
}

// Resizing modes: how each edge follows the parent's when the parent changes
// size. Bits 12-15 rule the top edge, 8-11 the left, 4-7 the bottom and 0-3
// the right one.
enum {
	_VIEW_TOP_ = 1,
	_VIEW_LEFT_ = 2,
	_VIEW_BOTTOM_ = 3,
	_VIEW_RIGHT_ = 4,
	_VIEW_CENTER_ = 5
};

inline constexpr uint32 _rule_(uint32 r1, uint32 r2, uint32 r3, uint32 r4)
{
	return (r1 << 12) | (r2 << 8) | (r3 << 4) | r4;
}

#define B_FOLLOW_NONE 0
#define B_FOLLOW_ALL_SIDES _rule_(_VIEW_TOP_, _VIEW_LEFT_, _VIEW_BOTTOM_, _VIEW_RIGHT_)
#define B_FOLLOW_ALL B_FOLLOW_ALL_SIDES
#define B_FOLLOW_LEFT _rule_(0, _VIEW_LEFT_, 0, _VIEW_LEFT_)
#define B_FOLLOW_RIGHT _rule_(0, _VIEW_RIGHT_, 0, _VIEW_RIGHT_)
#define B_FOLLOW_LEFT_RIGHT _rule_(0, _VIEW_LEFT_, 0, _VIEW_RIGHT_)
#define B_FOLLOW_H_CENTER _rule_(0, _VIEW_CENTER_, 0, _VIEW_CENTER_)
#define B_FOLLOW_TOP _rule_(_VIEW_TOP_, 0, _VIEW_TOP_, 0)
#define B_FOLLOW_BOTTOM _rule_(_VIEW_BOTTOM_, 0, _VIEW_BOTTOM_, 0)
#define B_FOLLOW_TOP_BOTTOM _rule_(_VIEW_TOP_, 0, _VIEW_BOTTOM_, 0)
#define B_FOLLOW_V_CENTER _rule_(_VIEW_CENTER_, 0, _VIEW_CENTER_, 0)

// View flags.
enum {
	B_FULL_UPDATE_ON_RESIZE = 0x80000000UL,
	_B_RESERVED1_ = 0x40000000UL,
	B_WILL_DRAW = 0x20000000UL,
	B_PULSE_NEEDED = 0x10000000UL,
	B_NAVIGABLE_JUMP = 0x08000000UL,
	B_FRAME_EVENTS = 0x04000000UL,
	B_NAVIGABLE = 0x02000000UL,
	B_SUBPIXEL_PRECISE = 0x01000000UL,
	B_DRAW_ON_CHILDREN = 0x00800000UL,
	B_INPUT_METHOD_AWARE = 0x00400000UL
};

// The transit argument of MouseMoved.
enum {
	B_ENTERED_VIEW = 0,
	B_INSIDE_VIEW,
	B_EXITED_VIEW,
	B_OUTSIDE_VIEW
};

// A rectangle of a window (or of a bitmap that accepts views) that draws and
// receives input. Coordinates are the view's own: Bounds() starts at the
// scrolled-to origin. Drawing is clipped to the visible part of the view and,
// inside Draw, to the area being updated. Rectangles are inclusive:
// FillRect(BRect(10, 10, 19, 19)) paints 10 x 10 pixels.
class BView : public BHandler {
public:
	BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags);
	// Deleting a view deletes its children; remove it from its parent first.
	virtual ~BView();

	// Hooks.
	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void DetachedFromWindow();
	virtual void AllDetached();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void KeyUp(const char* bytes, int32 numBytes);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void WindowActivated(bool active);
	virtual void MakeFocus(bool focus = true);
	virtual void MessageReceived(BMessage* message);

	// Hierarchy. AddChild passes ownership of child to this view; before,
	// when given, names the sibling it goes in front of (drawn under).
	void AddChild(BView* child, BView* before = NULL);
	bool RemoveChild(BView* child);
	bool RemoveSelf();
	int32 CountChildren() const;
	BView* ChildAt(int32 index) const;
	BView* NextSibling() const;
	BView* PreviousSibling() const;
	BView* Parent() const;
	BWindow* Window() const;
	BView* FindView(const char* name) const;
	bool IsFocus() const;

	// Geometry.
	BRect Frame() const;
	BRect Bounds() const;
	void MoveTo(BPoint where);
	void MoveTo(float x, float y);
	void MoveBy(float dx, float dy);
	void ResizeTo(float width, float height);
	void ResizeBy(float dx, float dy);
	void ScrollTo(BPoint where);
	void ScrollTo(float x, float y) { ScrollTo(BPoint(x, y)); }
	void ScrollBy(float dx, float dy);
	uint32 ResizingMode() const;
	void SetResizingMode(uint32 mode);
	uint32 Flags() const;
	void SetFlags(uint32 flags);
	void Hide();
	void Show();
	bool IsHidden() const;

	// Coordinate conversions.
	BPoint ConvertToParent(BPoint point) const;
	void ConvertToParent(BPoint* point) const;
	BRect ConvertToParent(BRect rect) const;
	void ConvertToParent(BRect* rect) const;
	BPoint ConvertFromParent(BPoint point) const;
	void ConvertFromParent(BPoint* point) const;
	BRect ConvertFromParent(BRect rect) const;
	void ConvertFromParent(BRect* rect) const;
	BPoint ConvertToScreen(BPoint point) const;
	void ConvertToScreen(BPoint* point) const;
	BRect ConvertToScreen(BRect rect) const;
	void ConvertToScreen(BRect* rect) const;
	BPoint ConvertFromScreen(BPoint point) const;
	void ConvertFromScreen(BPoint* point) const;
	BRect ConvertFromScreen(BRect rect) const;
	void ConvertFromScreen(BRect* rect) const;

	// The pointer in this view's coordinates and the buttons held now.
	void GetMouse(BPoint* location, uint32* buttons, bool checkMessageQueue = true);

	// Updating.
	void Invalidate(BRect rect);
	void Invalidate();
	// Flush shows what was drawn; Sync also waits until it is on screen (in a
	// bitmap, until the pixels hold it).
	void Flush() const;
	void Sync() const;

	// Drawing state; PushState saves a copy of all of it, PopState restores
	// the last copy.
	void SetViewColor(rgb_color color);
	void SetViewColor(uint8 red, uint8 green, uint8 blue, uint8 alpha = 255);
	rgb_color ViewColor() const;
	void SetHighColor(rgb_color color);
	void SetHighColor(uint8 red, uint8 green, uint8 blue, uint8 alpha = 255);
	rgb_color HighColor() const;
	void SetLowColor(rgb_color color);
	void SetLowColor(uint8 red, uint8 green, uint8 blue, uint8 alpha = 255);
	rgb_color LowColor() const;
	void SetDrawingMode(drawing_mode mode);
	drawing_mode DrawingMode() const;
	void SetPenSize(float size);
	float PenSize() const;
	void MovePenTo(BPoint point);
	void MovePenTo(float x, float y);
	void MovePenBy(float x, float y);
	BPoint PenLocation() const;
	void SetFont(const BFont* font, uint32 mask = B_FONT_ALL);
	void GetFont(BFont* font) const;
	void SetFontSize(float size);
	void GetFontHeight(font_height* height) const;
	float StringWidth(const char* string) const;
	float StringWidth(const char* string, int32 length) const;
	void PushState();
	void PopState();

	// Drawing. A line of pen size n is n pixels thick across its direction,
	// from n / 2 pixels before the ideal line (rounded down) to the rest after
	// it, and runs exactly from its start to its end point: a horizontal line
	// at y = 15 with pen size 2 covers the rows 14 and 15. Rectangle outlines
	// are four such lines.
	void StrokeLine(BPoint toPoint, const pattern& p = B_SOLID_HIGH);
	void StrokeLine(BPoint start, BPoint end, const pattern& p = B_SOLID_HIGH);
	void StrokeRect(BRect rect, const pattern& p = B_SOLID_HIGH);
	void FillRect(BRect rect, const pattern& p = B_SOLID_HIGH);
	void InvertRect(BRect rect);
	// Text rests on the baseline: the lowest row of a letter without
	// descender is the row of the baseline's y. At the pen, the pen advances.
	void DrawString(const char* string);
	void DrawString(const char* string, int32 length);
	void DrawString(const char* string, BPoint where);
	void DrawString(const char* string, int32 length, BPoint where);
	// Bitmaps are drawn at their size, at the pen or with their top-left at
	// where. B_OP_OVER skips transparent pixels (the B_CMAP8 magic index, the
	// B_RGB32 magic colour) and blends B_RGBA32 pixels by their alpha.
	void DrawBitmap(const BBitmap* bitmap);
	void DrawBitmap(const BBitmap* bitmap, BPoint where);
	void DrawBitmap(const BBitmap* bitmap, BRect bitmapRect, BRect viewRect);
	void DrawBitmapAsync(const BBitmap* bitmap);
	void DrawBitmapAsync(const BBitmap* bitmap, BPoint where);
	void DrawBitmapAsync(const BBitmap* bitmap, BRect bitmapRect, BRect viewRect);

	// Scrolling and dragging, provided with the scroll bars and drag and
	// drop: the scroll bar aimed at this view, and a drag whose image or
	// rectangle follows the pointer. DragMessage copies the message and takes
	// ownership of the bitmap.
	BScrollBar* ScrollBar(orientation posture) const;
	void DragMessage(BMessage* message, BRect dragRect, BHandler* replyTo = NULL);
	void DragMessage(BMessage* message, BBitmap* bitmap, BPoint offset,
		BHandler* replyTo = NULL);
	void DragMessage(BMessage* message, BBitmap* bitmap, drawing_mode dragMode,
		BPoint offset, BHandler* replyTo = NULL);

private:
	friend class BPrivate::ViewAccess;

	void _Attach(BWindow* window);
	void _Detach();
	void _ParentResized(float dx, float dy);

	std::unique_ptr<BPrivate::ViewData> fViewData;
};

#endif
