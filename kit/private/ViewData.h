#ifndef KIT_PRIVATE_VIEW_DATA_H
#define KIT_PRIVATE_VIEW_DATA_H

#include <vector>

#include <View.h>

#include "Painter.h"
#include "Region.h"

namespace BPrivate {

// A scroll bar aimed at a view; told whenever the view scrolls.
class ScrollFollower {
public:
	virtual ~ScrollFollower() = default;
	// origin is the view's new Bounds().LeftTop().
	virtual void TargetScrolled(BPoint origin) = 0;
	// The view is being deleted.
	virtual void TargetDeleted() = 0;
};

// Scrolls view through its scroll bars by a B_MOUSE_WHEEL_CHANGED message;
// false when it has no bar to scroll with.
bool ScrollByWheel(BView* view, const BMessage* wheel);

struct ViewData {
	BView* parent = nullptr;
	// Back to front: later children cover earlier ones.
	std::vector<BView*> children;
	BWindow* window = nullptr;
	// In the parent's coordinates.
	BRect frame;
	// The top-left of the bounds: how far the content is scrolled.
	BPoint origin;
	uint32 resizingMode = 0;
	uint32 flags = 0;
	bool hidden = false;
	rgb_color viewColor = {255, 255, 255, 255};
	// Indexed by orientation; set by the scroll bars themselves.
	ScrollFollower* scrollBars[2] = {nullptr, nullptr};
	// The drawing state stack; back() is in effect.
	std::vector<DrawState> states = std::vector<DrawState>(1);

	// The view's visible pixels in window coordinates, and the same within
	// the update in progress; kept for as long as the stamps match.
	Region visible;
	uint32 visibleStamp = 0;
	Region drawClip;
	uint64 drawClipStamp = 0;

	DrawState& State() { return states.back(); }
};

// Restores the drawing state on leaving a scope.
class StateGuard {
public:
	explicit StateGuard(BView* view) : fView(view) { fView->PushState(); }
	~StateGuard() { fView->PopState(); }
	StateGuard(const StateGuard&) = delete;
	StateGuard& operator=(const StateGuard&) = delete;

private:
	BView* fView;
};

class ViewAccess {
public:
	static ViewData& Data(const BView* view) { return *view->fViewData; }
	static void Attach(BView* view, BWindow* window) { view->_Attach(window); }
	static void Detach(BView* view) { view->_Detach(); }
	static void ParentResized(BView* view, float dx, float dy)
	{
		view->_ParentResized(dx, dy);
	}

	// Where the view's (0, 0) lies in its window.
	static BPoint WindowOrigin(const BView* view);
	static BRect ConvertToWindow(const BView* view, BRect rect);
	static const Region& Visible(const BView* view);
	// Visible, and inside Draw only the part being updated.
	static const Region& DrawClip(const BView* view);
	// The deepest shown view under point (window coordinates), or NULL.
	static BView* ViewAt(BView* root, BPoint point);
	static bool Contains(const BView* ancestor, const BView* view);
};

}

#endif
