#include <TextView.h>

#include <algorithm>
#include <cmath>
#include <cstring>

#include "TextViewData.h"

using BPrivate::TextViewData;

namespace {

bool IsContinuation(char byte)
{
	return (uint8(byte) & 0xc0) == 0x80;
}

// The longest prefix of text no longer than limit that ends on a character
// boundary.
int32 FitBytes(const char* text, int32 length, int32 limit)
{
	if (length <= limit)
		return length;
	int32 fit = std::max(limit, int32(0));
	while (fit > 0 && IsContinuation(text[fit]))
		fit--;
	return fit;
}

}

namespace BPrivate {

float TextViewData::Ascent() const
{
	font_height height;
	font.GetHeight(&height);
	return std::ceil(height.ascent);
}

float TextViewData::LineHeight() const
{
	font_height height;
	font.GetHeight(&height);
	return std::ceil(height.ascent) + std::ceil(height.descent) + std::ceil(height.leading);
}

float TextViewData::LineLeft(const Line& line) const
{
	float room = textRect.Width() + 1 - line.width;
	switch (align) {
		case B_ALIGN_CENTER:
			return textRect.left + std::floor(room / 2);
		case B_ALIGN_RIGHT:
			return textRect.left + room;
		default:
			return textRect.left;
	}
}

int32 TextViewData::Previous(int32 offset) const
{
	int32 limit = std::max(offset - 4, int32(0));
	offset = std::max(offset - 1, int32(0));
	while (offset > limit && IsContinuation(text[offset]))
		offset--;
	return offset;
}

int32 TextViewData::Next(int32 offset) const
{
	int32 length = int32(text.size());
	int32 limit = std::min(offset + 4, length);
	offset = std::min(offset + 1, length);
	while (offset < limit && IsContinuation(text[offset]))
		offset++;
	return offset;
}

void TextViewData::Relayout()
{
	lines.clear();
	float wrapWidth = wordWrap && !resizable ? textRect.Width() + 1 : 0;
	int32 length = int32(text.size());
	int32 start = 0;
	while (true) {
		int32 newline = int32(text.find('\n', start));
		int32 end = newline < 0 ? length : newline;
		// Break too long lines after their last space that fits, or else
		// after the last character that fits.
		while (wrapWidth > 0 && end > start
			&& font.StringWidth(text.c_str() + start, end - start) > wrapWidth) {
			int32 fit = start;
			while (fit < end
				&& font.StringWidth(text.c_str() + start, Next(fit) - start) <= wrapWidth)
				fit = Next(fit);
			// A space may hang past the edge.
			int32 space = int32(text.rfind(' ', fit));
			int32 cut = space >= start && space < end ? space + 1 : std::max(fit, Next(start));
			lines.push_back({start, cut, font.StringWidth(text.c_str() + start, cut - start)});
			start = cut;
		}
		lines.push_back({start, end, font.StringWidth(text.c_str() + start, end - start)});
		if (newline < 0)
			break;
		start = newline + 1;
	}

	if (resizable) {
		float widest = 0;
		for (const Line& line : lines)
			widest = std::max(widest, line.width);
		// Room for the caret after the last character.
		float right = textRect.left + std::ceil(widest) + 1;
		float dx = right - textRect.right;
		textRect.right = right;
		if (dx != 0) {
			view->ResizeBy(dx, 0);
			if (container != nullptr)
				container->ResizeBy(dx, 0);
		}
	}
	view->Invalidate();
}

void TextViewData::ScrollToCaret()
{
	if (resizable || view->Window() == nullptr)
		return;
	BRect bounds = view->Bounds();
	BRect visible(bounds.left + textRect.left, bounds.top + textRect.top,
		bounds.right - (view->Frame().Width() - textRect.right),
		bounds.bottom - (view->Frame().Height() - textRect.bottom));
	float height;
	BPoint caret = view->PointAt(Caret(), &height);
	BPoint scroll;
	if (caret.x > visible.right)
		scroll.x = caret.x - visible.right;
	else if (caret.x < visible.left)
		scroll.x = std::max(caret.x, textRect.left) - visible.left;
	if (caret.y + height - 1 > visible.bottom)
		scroll.y = caret.y + height - 1 - visible.bottom;
	else if (caret.y < visible.top)
		scroll.y = caret.y - visible.top;
	if (scroll.x != 0 || scroll.y != 0)
		view->ScrollBy(scroll.x, scroll.y);
}

bool TextViewData::Replace(const char* bytes, int32 length)
{
	int32 room = maxBytes - (int32(text.size()) - (selEnd - selStart));
	length = FitBytes(bytes, length, room);
	if (length <= 0 && selStart == selEnd)
		return false;
	int32 at = selStart;
	if (selEnd > selStart)
		view->DeleteText(selStart, selEnd);
	if (length > 0)
		view->InsertText(bytes, length, at);
	view->Select(at + length, at + length);
	return length > 0;
}

void TextViewData::SelectTo(int32 caret, bool extend)
{
	int32 fixed = extend ? anchor : caret;
	view->Select(std::min(fixed, caret), std::max(fixed, caret));
	anchor = fixed;
}

}

BTextView::BTextView(BRect frame, const char* name, BRect textRect, uint32 resizingMode,
	uint32 flags)
	: BTextView(frame, name, textRect, nullptr, nullptr, resizingMode, flags)
{
}

BTextView::BTextView(BRect frame, const char* name, BRect textRect, const BFont* initialFont,
	const rgb_color* initialColor, uint32 resizingMode, uint32 flags)
	:
	BView(frame, name, resizingMode, flags | B_FRAME_EVENTS),
	fTextViewData(std::make_unique<TextViewData>(this))
{
	TextViewData& data = *fTextViewData;
	data.textRect = textRect;
	data.font = initialFont != nullptr ? *initialFont : *be_plain_font;
	if (initialColor != nullptr)
		data.color = *initialColor;
	data.Relayout();
}

BTextView::~BTextView() = default;

void BTextView::SetText(const char* text)
{
	SetText(text, text != nullptr ? int32(strlen(text)) : 0);
}

void BTextView::SetText(const char* text, int32 length)
{
	TextViewData& data = *fTextViewData;
	if (!data.text.empty())
		DeleteText(0, int32(data.text.size()));
	length = FitBytes(text, text != nullptr ? length : 0, data.maxBytes);
	if (length > 0)
		InsertText(text, length, 0);
	Select(length, length);
}

void BTextView::Insert(const char* text)
{
	Insert(text, text != nullptr ? int32(strlen(text)) : 0);
}

void BTextView::Insert(const char* text, int32 length)
{
	Insert(fTextViewData->selStart, text, length);
}

void BTextView::Insert(int32 offset, const char* text, int32 length)
{
	TextViewData& data = *fTextViewData;
	offset = std::clamp(offset, int32(0), TextLength());
	length = FitBytes(text, text != nullptr ? length : 0,
		data.maxBytes - int32(data.text.size()));
	if (length <= 0)
		return;
	InsertText(text, length, offset);
	if (data.selStart == offset && data.selEnd == offset)
		Select(offset + length, offset + length);
}

void BTextView::Delete()
{
	Delete(fTextViewData->selStart, fTextViewData->selEnd);
}

void BTextView::Delete(int32 startOffset, int32 endOffset)
{
	startOffset = std::clamp(startOffset, int32(0), TextLength());
	endOffset = std::clamp(endOffset, startOffset, TextLength());
	if (endOffset > startOffset)
		DeleteText(startOffset, endOffset);
}

void BTextView::InsertText(const char* text, int32 length, int32 offset)
{
	TextViewData& data = *fTextViewData;
	data.text.insert(size_t(offset), text, size_t(length));
	// The selection keeps to its characters.
	for (int32* edge : {&data.selStart, &data.selEnd, &data.anchor}) {
		if (*edge > offset)
			*edge += length;
	}
	data.Relayout();
	data.ScrollToCaret();
}

void BTextView::DeleteText(int32 fromOffset, int32 toOffset)
{
	TextViewData& data = *fTextViewData;
	data.text.erase(size_t(fromOffset), size_t(toOffset - fromOffset));
	for (int32* edge : {&data.selStart, &data.selEnd, &data.anchor}) {
		if (*edge >= toOffset)
			*edge -= toOffset - fromOffset;
		else if (*edge > fromOffset)
			*edge = fromOffset;
	}
	data.Relayout();
	data.ScrollToCaret();
}

const char* BTextView::Text() const
{
	return fTextViewData->text.c_str();
}

int32 BTextView::TextLength() const
{
	return int32(fTextViewData->text.size());
}

void BTextView::GetText(int32 offset, int32 length, char* buffer) const
{
	const std::string& text = fTextViewData->text;
	offset = std::clamp(offset, int32(0), TextLength());
	length = std::clamp(length, int32(0), TextLength() - offset);
	text.copy(buffer, size_t(length), size_t(offset));
	buffer[length] = '\0';
}

char BTextView::ByteAt(int32 offset) const
{
	return offset >= 0 && offset < TextLength() ? fTextViewData->text[offset] : '\0';
}

int32 BTextView::CountLines() const
{
	return int32(fTextViewData->lines.size());
}

int32 BTextView::CurrentLine() const
{
	return LineAt(fTextViewData->selStart);
}

void BTextView::Select(int32 startOffset, int32 endOffset)
{
	TextViewData& data = *fTextViewData;
	startOffset = std::clamp(startOffset, int32(0), TextLength());
	endOffset = std::clamp(endOffset, startOffset, TextLength());
	data.anchor = startOffset;
	if (startOffset == data.selStart && endOffset == data.selEnd)
		return;
	data.selStart = startOffset;
	data.selEnd = endOffset;
	Invalidate();
	data.ScrollToCaret();
}

void BTextView::SelectAll()
{
	Select(0, TextLength());
}

void BTextView::GetSelection(int32* startOffset, int32* endOffset) const
{
	if (startOffset != nullptr)
		*startOffset = fTextViewData->selStart;
	if (endOffset != nullptr)
		*endOffset = fTextViewData->selEnd;
}

void BTextView::SetFontAndColor(const BFont* font, uint32 mode, const rgb_color* color)
{
	TextViewData& data = *fTextViewData;
	if (font != nullptr) {
		if ((mode & B_FONT_FAMILY_AND_STYLE) != 0) {
			font_family family;
			font_style style;
			font->GetFamilyAndStyle(&family, &style);
			data.font.SetFamilyAndStyle(family, style);
		}
		if ((mode & B_FONT_SIZE) != 0)
			data.font.SetSize(font->Size());
		if ((mode & B_FONT_SHEAR) != 0)
			data.font.SetShear(font->Shear());
		if ((mode & B_FONT_FACE) != 0)
			data.font.SetFace(font->Face());
	}
	if (color != nullptr)
		data.color = *color;
	data.Relayout();
}

void BTextView::GetFontAndColor(BFont* font, uint32* sameProperties, rgb_color* color,
	bool* sameColor) const
{
	if (font != nullptr)
		*font = fTextViewData->font;
	if (sameProperties != nullptr)
		*sameProperties = B_FONT_ALL;
	if (color != nullptr)
		*color = fTextViewData->color;
	if (sameColor != nullptr)
		*sameColor = true;
}

BPoint BTextView::PointAt(int32 offset, float* height) const
{
	const TextViewData& data = *fTextViewData;
	int32 index = LineAt(offset);
	const TextViewData::Line& line = data.lines[index];
	offset = std::clamp(offset, line.start, line.end);
	if (height != nullptr)
		*height = data.LineHeight();
	return BPoint(data.LineLeft(line)
			+ data.font.StringWidth(data.text.c_str() + line.start, offset - line.start),
		data.textRect.top + index * data.LineHeight());
}

int32 BTextView::OffsetAt(BPoint point) const
{
	const TextViewData& data = *fTextViewData;
	int32 index = int32(std::floor((point.y - data.textRect.top) / data.LineHeight()));
	const TextViewData::Line& line
		= data.lines[std::clamp(index, int32(0), CountLines() - 1)];
	float x = point.x - data.LineLeft(line);
	// The boundary nearest to x.
	int32 offset = line.start;
	float left = 0;
	while (offset < line.end) {
		int32 next = data.Next(offset);
		float right = data.font.StringWidth(data.text.c_str() + line.start, next - line.start);
		if (x < (left + right) / 2)
			break;
		offset = next;
		left = right;
	}
	return offset;
}

int32 BTextView::LineAt(int32 offset) const
{
	const std::vector<TextViewData::Line>& lines = fTextViewData->lines;
	for (int32 i = 1; i < int32(lines.size()); i++) {
		if (offset < lines[i].start)
			return i - 1;
	}
	return int32(lines.size()) - 1;
}

float BTextView::LineWidth(int32 lineNumber) const
{
	const std::vector<TextViewData::Line>& lines = fTextViewData->lines;
	return lineNumber >= 0 && lineNumber < int32(lines.size()) ? lines[lineNumber].width : 0;
}

float BTextView::LineHeight(int32) const
{
	return fTextViewData->LineHeight();
}

float BTextView::TextHeight(int32 startLine, int32 endLine) const
{
	startLine = std::clamp(startLine, int32(0), CountLines() - 1);
	endLine = std::clamp(endLine, startLine, CountLines() - 1);
	return (endLine - startLine + 1) * fTextViewData->LineHeight();
}

void BTextView::SetTextRect(BRect rect)
{
	fTextViewData->textRect = rect;
	fTextViewData->Relayout();
}

BRect BTextView::TextRect() const
{
	return fTextViewData->textRect;
}

void BTextView::MakeEditable(bool editable)
{
	fTextViewData->editable = editable;
	Invalidate();
}

bool BTextView::IsEditable() const
{
	return fTextViewData->editable;
}

void BTextView::MakeSelectable(bool selectable)
{
	fTextViewData->selectable = selectable;
	Invalidate();
}

bool BTextView::IsSelectable() const
{
	return fTextViewData->selectable;
}

void BTextView::SetWordWrap(bool wrap)
{
	fTextViewData->wordWrap = wrap;
	fTextViewData->Relayout();
}

bool BTextView::DoesWordWrap() const
{
	return fTextViewData->wordWrap;
}

void BTextView::SetMaxBytes(int32 max)
{
	TextViewData& data = *fTextViewData;
	data.maxBytes = std::max(max, int32(0));
	int32 keep = FitBytes(data.text.c_str(), TextLength(), data.maxBytes);
	Delete(keep, TextLength());
}

int32 BTextView::MaxBytes() const
{
	return fTextViewData->maxBytes;
}

void BTextView::DisallowChar(uint32 character)
{
	fTextViewData->disallowed.insert(character);
}

void BTextView::AllowChar(uint32 character)
{
	fTextViewData->disallowed.erase(character);
}

void BTextView::SetAlignment(alignment flag)
{
	fTextViewData->align = flag;
	Invalidate();
}

alignment BTextView::Alignment() const
{
	return fTextViewData->align;
}

void BTextView::MakeResizable(bool resize, BView* resizeView)
{
	TextViewData& data = *fTextViewData;
	data.resizable = resize;
	data.container = resize ? resizeView : nullptr;
	if (resize)
		data.wordWrap = false;
	data.Relayout();
}

bool BTextView::IsResizable() const
{
	return fTextViewData->resizable;
}
