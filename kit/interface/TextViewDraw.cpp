#include <TextView.h>

#include <algorithm>

#include <Window.h>

#include "ControlLook.h"
#include "TextViewData.h"
#include "ViewData.h"

using BPrivate::TextViewData;

void BTextView::Draw(BRect updateRect)
{
	const TextViewData& data = *fTextViewData;
	BPrivate::StateGuard state(this);
	bool showing = IsFocus() && Window()->IsActive();
	float lineHeight = data.LineHeight();

	SetDrawingMode(B_OP_COPY);
	if (showing && data.selStart != data.selEnd) {
		SetHighColor(BPrivate::ControlLook::kTextSelection);
		for (int32 i = LineAt(data.selStart); i <= LineAt(data.selEnd); i++) {
			const TextViewData::Line& line = data.lines[i];
			int32 from = std::max(data.selStart, line.start);
			int32 to = std::min(data.selEnd, line.end);
			float left = PointAt(from).x;
			// A selected newline shows as a little room after the line.
			float right = PointAt(to).x - 1 + (data.selEnd > line.end && i + 1 < CountLines() ? 4 : 0);
			float top = data.textRect.top + i * lineHeight;
			if (right >= left)
				FillRect(BRect(left, top, right, top + lineHeight - 1));
		}
	}

	SetDrawingMode(B_OP_OVER);
	SetFont(&data.font);
	SetHighColor(data.color);
	for (int32 i = 0; i < CountLines(); i++) {
		const TextViewData::Line& line = data.lines[i];
		float top = data.textRect.top + i * lineHeight;
		if (top > updateRect.bottom || top + lineHeight <= updateRect.top)
			continue;
		DrawString(data.text.c_str() + line.start, line.end - line.start,
			BPoint(data.LineLeft(line), top + data.Ascent()));
	}

	if (showing && data.editable && data.selStart == data.selEnd) {
		float height;
		BPoint caret = PointAt(data.selStart, &height);
		SetDrawingMode(B_OP_COPY);
		StrokeLine(caret, caret + BPoint(0, height - 1));
	}
}
