#ifndef _TEXT_VIEW_H
#define _TEXT_VIEW_H

#include <memory>

#include <View.h>

namespace BPrivate {
struct TextViewData;
}

// Editable text in one font and colour, laid out inside the text
// rectangle (view coordinates): lines break at newlines and, with word
// wrap, at the rectangle's right edge. The user types UTF-8 text, deletes
// and moves by whole characters, selects with Shift and the arrows or with
// the mouse (a double click takes a word). Offsets count bytes.
class BTextView : public BView {
public:
	BTextView(BRect frame, const char* name, BRect textRect, uint32 resizingMode,
		uint32 flags);
	BTextView(BRect frame, const char* name, BRect textRect, const BFont* initialFont,
		const rgb_color* initialColor, uint32 resizingMode, uint32 flags);
	virtual ~BTextView();

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void MouseUp(BPoint where);
	// The editing keys: characters, B_BACKSPACE, B_DELETE, the arrows with
	// or without Shift, B_HOME, B_END; Ctrl+A selects everything.
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void MakeFocus(bool focus = true);
	virtual void WindowActivated(bool active);
	virtual void FrameResized(float width, float height);

	// Text. Insertions go where the selection starts (a caret there moves
	// after them) and stop at MaxBytes, on a character boundary.
	void SetText(const char* text);
	void SetText(const char* text, int32 length);
	void Insert(const char* text);
	void Insert(const char* text, int32 length);
	void Insert(int32 offset, const char* text, int32 length);
	// The selection, or the bytes from startOffset to endOffset.
	void Delete();
	void Delete(int32 startOffset, int32 endOffset);
	const char* Text() const;
	int32 TextLength() const;
	void GetText(int32 offset, int32 length, char* buffer) const;
	char ByteAt(int32 offset) const;
	int32 CountLines() const;
	int32 CurrentLine() const;

	virtual void Select(int32 startOffset, int32 endOffset);
	void SelectAll();
	void GetSelection(int32* startOffset, int32* endOffset) const;

	// The whole text takes the properties of font that mode names, and
	// color when given.
	void SetFontAndColor(const BFont* font, uint32 mode = B_FONT_ALL,
		const rgb_color* color = NULL);
	void GetFontAndColor(BFont* font, uint32* sameProperties, rgb_color* color = NULL,
		bool* sameColor = NULL) const;

	// Geometry of the laid-out text, in view coordinates: the top left of
	// the character at offset, and the offset nearest to point.
	BPoint PointAt(int32 offset, float* height = NULL) const;
	int32 OffsetAt(BPoint point) const;
	int32 LineAt(int32 offset) const;
	float LineWidth(int32 lineNumber = 0) const;
	float LineHeight(int32 lineNumber = 0) const;
	float TextHeight(int32 startLine, int32 endLine) const;

	void SetTextRect(BRect rect);
	BRect TextRect() const;
	void MakeEditable(bool editable = true);
	bool IsEditable() const;
	void MakeSelectable(bool selectable = true);
	bool IsSelectable() const;
	void SetWordWrap(bool wrap);
	bool DoesWordWrap() const;
	void SetMaxBytes(int32 max);
	int32 MaxBytes() const;
	// Characters the user may not type.
	void DisallowChar(uint32 character);
	void AllowChar(uint32 character);
	void SetAlignment(alignment flag);
	alignment Alignment() const;
	// A resizable view widens and narrows to fit its text (word wrap is
	// then off); resizeView, when given, grows and shrinks with it.
	void MakeResizable(bool resize, BView* resizeView = NULL);
	bool IsResizable() const;

protected:
	// Every change of the text goes through these two.
	virtual void InsertText(const char* text, int32 length, int32 offset);
	virtual void DeleteText(int32 fromOffset, int32 toOffset);

private:
	friend struct BPrivate::TextViewData;

	std::unique_ptr<BPrivate::TextViewData> fTextViewData;
};

#endif
