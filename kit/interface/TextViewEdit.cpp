#include <TextView.h>

#include <algorithm>
#include <cctype>

#include <Message.h>
#include <Window.h>

#include "TextViewData.h"

using BPrivate::TextViewData;

namespace {

// The code point that starts bytes (a stray byte stands for itself).
uint32 FirstCharacter(const char* bytes, int32 numBytes)
{
	uint8 first = uint8(bytes[0]);
	int32 count = first >= 0xf0 ? 4 : first >= 0xe0 ? 3 : first >= 0xc0 ? 2 : 1;
	if (count == 1 || count > numBytes)
		return first;
	uint32 character = first & (0x7f >> count);
	for (int32 i = 1; i < count; i++)
		character = (character << 6) | (uint8(bytes[i]) & 0x3f);
	return character;
}

bool IsWordByte(char byte)
{
	return isalnum(uint8(byte)) || uint8(byte) >= 0x80 || byte == '_';
}

uint32 CurrentModifiers(const BView* view)
{
	const BMessage* message = view->Window() != nullptr
		? view->Window()->CurrentMessage() : nullptr;
	return message != nullptr ? uint32(message->GetInt32("modifiers", 0)) : modifiers();
}

}

void BTextView::AttachedToWindow()
{
	fTextViewData->Relayout();
	BView::AttachedToWindow();
}

void BTextView::DetachedFromWindow()
{
	fTextViewData->tracking = false;
	BView::DetachedFromWindow();
}

void BTextView::MouseDown(BPoint where)
{
	TextViewData& data = *fTextViewData;
	if (!data.selectable)
		return;
	MakeFocus(true);
	const BMessage* message = Window()->CurrentMessage();
	int32 clicks = message != nullptr ? message->GetInt32("clicks", 1) : 1;
	int32 offset = OffsetAt(where);
	if (clicks == 2) {
		int32 start = offset;
		int32 end = offset;
		while (start > 0 && IsWordByte(data.text[start - 1]))
			start--;
		while (end < TextLength() && IsWordByte(data.text[end]))
			end++;
		Select(start, end);
	} else
		data.SelectTo(offset, (CurrentModifiers(this) & B_SHIFT_KEY) != 0);
	data.tracking = true;
}

void BTextView::MouseMoved(BPoint where, uint32, const BMessage*)
{
	TextViewData& data = *fTextViewData;
	if (data.tracking)
		data.SelectTo(OffsetAt(where), true);
}

void BTextView::MouseUp(BPoint)
{
	fTextViewData->tracking = false;
}

void BTextView::KeyDown(const char* bytes, int32 numBytes)
{
	TextViewData& data = *fTextViewData;
	uint32 held = CurrentModifiers(this);
	bool shift = (held & B_SHIFT_KEY) != 0;
	int32 caret = data.Caret();
	// Moving without Shift first drops the selection towards the move.
	bool collapse = !shift && data.selStart != data.selEnd;
	switch (bytes[0]) {
		case B_LEFT_ARROW:
			data.SelectTo(collapse ? data.selStart : data.Previous(caret), shift);
			return;
		case B_RIGHT_ARROW:
			data.SelectTo(collapse ? data.selEnd : data.Next(caret), shift);
			return;
		case B_UP_ARROW:
		case B_DOWN_ARROW:
		{
			float height;
			BPoint point = PointAt(caret, &height);
			point.y += bytes[0] == B_UP_ARROW ? -height / 2 : height * 3 / 2;
			int32 line = LineAt(caret) + (bytes[0] == B_UP_ARROW ? -1 : 1);
			if (line >= 0 && line < CountLines())
				data.SelectTo(OffsetAt(point), shift);
			return;
		}
		case B_HOME:
			data.SelectTo(data.lines[LineAt(caret)].start, shift);
			return;
		case B_END:
			data.SelectTo(data.lines[LineAt(caret)].end, shift);
			return;
		default:
			break;
	}
	if (!data.editable) {
		BView::KeyDown(bytes, numBytes);
		return;
	}
	switch (bytes[0]) {
		case B_BACKSPACE:
			if (data.selStart == data.selEnd)
				Delete(data.Previous(data.selStart), data.selStart);
			else
				Delete();
			return;
		case B_DELETE:
			if (data.selStart == data.selEnd)
				Delete(data.selStart, data.Next(data.selStart));
			else
				Delete();
			return;
		default:
			break;
	}
	// Shortcuts are not text.
	if ((held & (B_COMMAND_KEY | B_CONTROL_KEY)) != 0) {
		if (tolower(uint8(bytes[0])) == 'a')
			SelectAll();
		return;
	}
	bool control = uint8(bytes[0]) < B_SPACE && bytes[0] != B_TAB && bytes[0] != B_ENTER;
	if (control || data.disallowed.count(FirstCharacter(bytes, numBytes)) != 0) {
		BView::KeyDown(bytes, numBytes);
		return;
	}
	data.Replace(bytes, numBytes);
}

void BTextView::MakeFocus(bool focus)
{
	if (focus == IsFocus())
		return;
	BView::MakeFocus(focus);
	Invalidate();
}

void BTextView::WindowActivated(bool active)
{
	if (IsFocus())
		Invalidate();
	BView::WindowActivated(active);
}

void BTextView::FrameResized(float width, float height)
{
	TextViewData& data = *fTextViewData;
	if (data.wordWrap && !data.resizable)
		data.Relayout();
	BView::FrameResized(width, height);
}
