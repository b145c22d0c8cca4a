#include <View.h>

#include <Bitmap.h>
#include <InterfaceDefs.h>
#include <Looper.h>
#include <Message.h>
#include <Window.h>

#include "ControlLook.h"
#include "Display.h"
#include "MessagePrivate.h"
#include "WindowHooks.h"

namespace BPrivate {

namespace {

constexpr uint32 kDragMoved = '_DMV';
constexpr uint32 kDragEnded = '_DND';

// Shows what is dragged: the bitmap, or the outline of a rectangle.
class DragImageView : public BView {
public:
	DragImageView(BRect bounds, BBitmap* bitmap, drawing_mode mode)
		:
		BView(bounds, "drag image", B_FOLLOW_ALL, B_WILL_DRAW),
		fBitmap(bitmap),
		fMode(mode)
	{
		SetViewColor(B_TRANSPARENT_COLOR);
	}

	void Draw(BRect) override
	{
		if (fBitmap != nullptr) {
			SetDrawingMode(fMode);
			DrawBitmap(fBitmap.get(), B_ORIGIN);
			return;
		}
		SetHighColor(ControlLook::kText);
		SetLowColor(ControlLook::kLight);
		StrokeRect(Bounds(), B_MIXED_COLORS);
	}

private:
	std::unique_ptr<BBitmap> fBitmap;
	drawing_mode fMode;
};

// A borderless window that follows the pointer for the length of a drag.
class DragWindow : public BWindow {
public:
	DragWindow(BRect frame, BBitmap* bitmap, drawing_mode mode)
		:
		BWindow(frame, "drag", B_NO_BORDER_WINDOW_LOOK, B_FLOATING_ALL_WINDOW_FEEL,
			B_AVOID_FOCUS | B_NOT_MOVABLE | B_NOT_RESIZABLE | B_NOT_CLOSABLE),
		fImage(new DragImageView(Bounds(), bitmap, mode))
	{
		AddChild(fImage);
	}

	void MessageReceived(BMessage* message) override
	{
		BPoint where;
		switch (message->what) {
			case kDragMoved:
				if (message->FindPoint("where", &where) == B_OK)
					MoveTo(where);
				break;
			case kDragEnded:
				// Gone from the screen, and the bitmap freed, before the
				// window itself goes.
				Hide();
				RemoveChild(fImage);
				delete fImage;
				Quit();
				break;
			default:
				BWindow::MessageReceived(message);
				break;
		}
	}

private:
	DragImageView* fImage;
};

class ViewDrag : public DragSession {
public:
	ViewDrag(const BMessage& message, BPoint offset, BHandler* replyTo, BWindow* source,
		DragWindow* image)
		:
		fMessage(message),
		fOffset(offset),
		fReplyTo(replyTo != nullptr ? BMessenger(replyTo) : BMessenger()),
		fSource(source),
		fSourceMessenger(source),
		fSourceOrigin(source->Frame().LeftTop()),
		fImage(image),
		fImageMessenger(image)
	{
	}

	~ViewDrag() override
	{
		// The image goes, and the bitmap with it.
		fImageMessenger.SendMessage(kDragEnded);
	}

	const BMessage* Message() const override { return &fMessage; }

	void Moved(BPoint screenWhere) override
	{
		BMessage moved(kDragMoved);
		moved.AddPoint("where", screenWhere - fOffset);
		fImageMessenger.SendMessage(&moved);
	}

	void Released(BPoint screenWhere) override
	{
		// The window that got the press hears of its release, wherever the
		// display delivered it.
		if (BLooper::LooperForThread(find_thread(NULL)) != fSource) {
			BMessage release(B_MOUSE_UP);
			release.AddInt64("when", system_time());
			release.AddPoint("where", screenWhere - fSourceOrigin);
			release.AddPoint("screen_where", screenWhere);
			release.AddInt32("buttons", 0);
			release.AddInt32("modifiers", int32(modifiers()));
			fSourceMessenger.SendMessage(&release);
		}
		// The frontmost window under the pointer, the image aside.
		for (const auto& window : Display::Default().Windows()) {
			{
				std::lock_guard<std::mutex> guard(window->lock);
				if (window->owner == fImage || !window->visible
					|| !window->frame.Contains(screenWhere))
					continue;
			}
			BMessage dropped(fMessage);
			MessageAccess::SetDropped(&dropped, screenWhere, fOffset);
			if (fReplyTo.IsValid())
				MessageAccess::SetReturnAddress(&dropped, fReplyTo);
			window->target.SendMessage(&dropped);
			return;
		}
	}

private:
	const BMessage fMessage;
	const BPoint fOffset;
	const BMessenger fReplyTo;
	// Identities only: the windows may be gone.
	const BLooper* const fSource;
	const BMessenger fSourceMessenger;
	const BPoint fSourceOrigin;
	const BWindow* const fImage;
	const BMessenger fImageMessenger;
};

// Starts a drag from source whose image, of size imageBounds, has its point
// offset under the pointer.
void StartDrag(BView* source, const BMessage& message, BRect imageBounds, BBitmap* bitmap,
	drawing_mode mode, BPoint offset, BHandler* replyTo)
{
	BPoint pointer;
	uint32 buttons;
	Display::Default().GetPointer(&pointer, &buttons);
	DragWindow* image = new DragWindow(imageBounds.OffsetToCopy(pointer - offset), bitmap,
		mode);
	SetDragSession(std::make_shared<ViewDrag>(message, offset, replyTo, source->Window(),
		image));
	image->Show();
}

}

}

void BView::DragMessage(BMessage* message, BRect dragRect, BHandler* replyTo)
{
	if (message == nullptr || !dragRect.IsValid() || Window() == nullptr)
		return;
	BPoint pointer;
	uint32 buttons;
	BPrivate::Display::Default().GetPointer(&pointer, &buttons);
	BPrivate::StartDrag(this, *message, dragRect.OffsetToCopy(B_ORIGIN), nullptr, B_OP_COPY,
		pointer - ConvertToScreen(dragRect.LeftTop()), replyTo);
}

void BView::DragMessage(BMessage* message, BBitmap* bitmap, BPoint offset, BHandler* replyTo)
{
	DragMessage(message, bitmap, B_OP_COPY, offset, replyTo);
}

void BView::DragMessage(BMessage* message, BBitmap* bitmap, drawing_mode dragMode,
	BPoint offset, BHandler* replyTo)
{
	std::unique_ptr<BBitmap> owned(bitmap);
	if (message == nullptr || bitmap == nullptr || !bitmap->IsValid() || Window() == nullptr)
		return;
	BRect bounds = bitmap->Bounds().OffsetToCopy(B_ORIGIN);
	BPrivate::StartDrag(this, *message, bounds, owned.release(), dragMode, offset, replyTo);
}
