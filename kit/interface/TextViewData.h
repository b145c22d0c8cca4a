#ifndef KIT_INTERFACE_TEXT_VIEW_DATA_H
#define KIT_INTERFACE_TEXT_VIEW_DATA_H

#include <set>
#include <string>
#include <vector>

#include <TextView.h>

namespace BPrivate {

struct TextViewData {
	struct Line {
		int32 start;
		// Exclusive, and before the line's newline if it has one.
		int32 end;
		float width;
	};

	explicit TextViewData(BTextView* owner) : view(owner) {}

	BTextView* view;
	std::string text;
	int32 selStart = 0;
	int32 selEnd = 0;
	// The end of the selection that stays put while Shift or the mouse
	// extends it.
	int32 anchor = 0;
	BRect textRect;
	BFont font;
	rgb_color color = {0, 0, 0, 255};
	bool editable = true;
	bool selectable = true;
	bool wordWrap = true;
	bool resizable = false;
	BView* container = nullptr;
	int32 maxBytes = 0x7fffffff;
	std::set<uint32> disallowed;
	alignment align = B_ALIGN_LEFT;
	bool tracking = false;
	std::vector<Line> lines;

	// Lays the text out again, resizes a resizable view and redraws.
	void Relayout();
	void ScrollToCaret();
	float Ascent() const;
	float LineHeight() const;
	float LineLeft(const Line& line) const;
	// The character boundaries around offset.
	int32 Previous(int32 offset) const;
	int32 Next(int32 offset) const;
	// Replaces the selection by text as typing does; false when nothing fit.
	bool Replace(const char* bytes, int32 length);
	// The caret end of the selection, the one that moves.
	int32 Caret() const { return anchor == selStart ? selEnd : selStart; }
	void SelectTo(int32 caret, bool extend);
};

}

#endif
