#ifndef _BITMAP_H
#define _BITMAP_H

#include <memory>

#include <GraphicsDefs.h>
#include <Rect.h>

class BView;
class BWindow;

namespace BPrivate {
struct BitmapData;
}

#define B_ANY_BYTES_PER_ROW (-1)

// A rectangle of pixels in one colour space. Rows are padded to a multiple of
// four bytes. A bitmap that accepts views is also a drawing surface: views
// added to it draw straight into its pixels, in the thread that draws.
class BBitmap {
public:
	BBitmap(BRect bounds, color_space space, bool acceptsViews = false,
		bool needsContiguous = false);
	// A copy of source's pixels (and not of its views).
	BBitmap(const BBitmap* source, bool acceptsViews = false,
		bool needsContiguous = false);
	virtual ~BBitmap();

	BBitmap(const BBitmap&) = delete;
	BBitmap& operator=(const BBitmap&) = delete;

	status_t InitCheck() const;
	bool IsValid() const;

	BRect Bounds() const;
	void* Bits() const;
	int32 BitsLength() const;
	int32 BytesPerRow() const;
	color_space ColorSpace() const;

	// Copies length bytes of data, given in colorSpace, into the bitmap
	// starting offset bytes into Bits(), converting pixels when the colour
	// spaces differ. Source rows are laid out as this bitmap's rows would be
	// in colorSpace. Data beyond the end of the bitmap is ignored.
	void SetBits(const void* data, int32 length, int32 offset,
		color_space colorSpace);

	// Views. The bitmap owns the views added to it and deletes them with
	// itself. Only a bitmap constructed to accept views takes them.
	void AddChild(BView* view);
	bool RemoveChild(BView* view);
	int32 CountChildren() const;
	BView* ChildAt(int32 index) const;
	BView* FindView(const char* name) const;
	BView* FindView(BPoint point) const;

	// Drawing into the bitmap's views happens under this lock.
	bool Lock();
	void Unlock();
	bool IsLocked() const;

private:
	void _Init(BRect bounds, color_space space, bool acceptsViews);

	std::unique_ptr<BPrivate::BitmapData> fData;
};

#endif
