// The pieces both panes share: the frame's focus border, the rename editor
// and the drag images.

#include "support/AppFixture.h"

#include <Bitmap.h>
#include <TextView.h>

#include "Commands.h"
#include "GvDragView.h"
#include "GvFilesView.h"
#include "GvRenView.h"
#include "GvScrollView.h"

using namespace AppTest;

namespace {

const rgb_color kGrey = { 205, 205, 205, 255 };
const rgb_color kFocus = { 0, 120, 80, 255 };
const rgb_color kBlack = { 0, 0, 0, 255 };

using PanesTest = AppFixture;

// A stand-in pane that keeps what it is sent.
class RecorderView : public BView {
public:
	RecorderView() : BView(BRect(300, 100, 500, 200), "recorder", B_FOLLOW_NONE, 0) {}

	void MessageReceived(BMessage* message) override
	{
		messages.push_back(*message);
	}

	std::vector<BMessage> messages;
};

// A drag image as the panes make it, rendered into its bitmap.
class DragImage {
public:
	DragImage(int32 mode, const char* name, float width = 120)
		: fBitmap(BRect(0, 0, width, 19), B_RGB32, true)
	{
		BBitmap* icon = new BBitmap(BRect(0, 0, 15, 15), B_CMAP8);
		// A transparent icon with one opaque black pixel at (0, 0).
		memset(icon->Bits(), B_TRANSPARENT_MAGIC_CMAP8, icon->BitsLength());
		static_cast<uint8*>(icon->Bits())[0] = 0;
		fBitmap.Lock();
		fBitmap.AddChild(new GvDragView(fBitmap.Bounds(), icon, name, mode));
		fBitmap.Unlock();
	}

	rgb_color At(int32 x, int32 y) const
	{
		const uint8* pixel = static_cast<const uint8*>(fBitmap.Bits())
			+ y * fBitmap.BytesPerRow() + x * 4;
		return rgb_color{ pixel[2], pixel[1], pixel[0], 255 };
	}

	// The rows of the badge area as text: '#' black, '.' grey.
	std::string Badge() const
	{
		std::string rows;
		for (int32 y = 10; y <= 19; y++) {
			for (int32 x = 10; x <= 19; x++)
				rows += At(x, y) == kBlack ? '#' : At(x, y) == kGrey ? '.' : '?';
			rows += '\n';
		}
		return rows;
	}

private:
	BBitmap fBitmap;
};

}

TEST_F(PanesTest, FocusBorderFollowsTheFocus)
{
	Start();
	GvFilesView* files = window->fileList;
	EXPECT_EQ(kFocus, PixelOf(tree->scrollFrame, BPoint(0, 0)));
	EXPECT_EQ(kFocus, PixelOf(tree->scrollFrame, BPoint(200, 417)));
	EXPECT_EQ(kGrey, PixelOf(files->scrollFrame, BPoint(0, 0)));

	Locked([&] { files->MakeFocus(true); });
	Idle();
	EXPECT_EQ(kGrey, PixelOf(tree->scrollFrame, BPoint(0, 200)));
	EXPECT_EQ(kFocus, PixelOf(files->scrollFrame, BPoint(450, 200)));
	EXPECT_TRUE(Locked([&] { return files->IsFocus() && !tree->IsFocus(); }));
}

TEST_F(PanesTest, RenameEditorPostsTheNameAndItsPositionToItsPane)
{
	Start();
	RecorderView* pane = new RecorderView;
	GvRenView* editor = window->fileList->renameView;
	Locked([&] {
		window->AddChild(pane);
		editor->MoveTo(7, 45);
		pane->AddChild(editor);
		editor->Insert("old");
		editor->SelectAll();
		editor->MakeFocus(true);
	});
	Key("n");
	Key("\xc3\xa9");
	Key("\n");
	Locked([&] {
		EXPECT_EQ(nullptr, editor->Parent());
		EXPECT_EQ(0, editor->TextLength());
		ASSERT_EQ(1u, pane->messages.size());
		const BMessage& renamed = pane->messages[0];
		EXPECT_EQ(GV_RENAMED, renamed.what);
		EXPECT_STREQ("n\xc3\xa9", renamed.GetString(GV_NAME));
		EXPECT_EQ(45.0f, renamed.GetFloat(GV_POSITION, -1));
	});

	// Escape after typing sends nothing and leaves the editor empty.
	Locked([&] {
		pane->AddChild(editor);
		editor->Insert("kept");
		editor->MakeFocus(true);
	});
	Key("x");
	Key("\x1b");
	Locked([&] {
		EXPECT_EQ(nullptr, editor->Parent());
		EXPECT_EQ(0, editor->TextLength());
		EXPECT_EQ(1u, pane->messages.size());
		pane->RemoveSelf();
		delete pane;
	});
}

// The badge's outline is one pixel wide although its mark is drawn with a
// pen of 2; both marks cover the points their lines join.
TEST(DragImage, CopyAndLinkShowTheirMarkInAFramedSquare)
{
	DragImage copy(GV_COPY, "");
	DragImage link(GV_LINK, "");
	for (const DragImage* image : { &copy, &link }) {
		for (int32 i = 10; i <= 19; i++) {
			EXPECT_EQ(kBlack, image->At(i, 10)) << i;
			EXPECT_EQ(kBlack, image->At(i, 19)) << i;
			EXPECT_EQ(kBlack, image->At(10, i)) << i;
			EXPECT_EQ(kBlack, image->At(19, i)) << i;
		}
		for (int32 i = 11; i <= 18; i++) {
			EXPECT_EQ(kGrey, image->At(11, i)) << image->Badge();
			EXPECT_EQ(kGrey, image->At(i, 11)) << image->Badge();
			EXPECT_EQ(kGrey, image->At(18, i)) << image->Badge();
		}
		// The icon's own pixel, drawn over the grey.
		EXPECT_EQ(kBlack, image->At(0, 0));
		EXPECT_EQ(kGrey, image->At(1, 1));
	}
	for (int32 i = 12; i <= 17; i++) {
		EXPECT_EQ(kBlack, copy.At(i, 15)) << copy.Badge();
		EXPECT_EQ(kBlack, copy.At(14, i)) << copy.Badge();
		EXPECT_EQ(kBlack, link.At(13, i)) << link.Badge();
	}
	for (int32 i = 13; i <= 16; i++)
		EXPECT_EQ(kBlack, link.At(i, 17)) << link.Badge();
	EXPECT_EQ(kGrey, copy.At(17, 12)) << copy.Badge();
	EXPECT_EQ(kGrey, link.At(17, 12)) << link.Badge();
	EXPECT_EQ(kGrey, link.At(16, 14)) << link.Badge();
}

TEST(DragImage, MoveHasNoBadgeAndAnyOtherModeMoves)
{
	for (int32 mode : { int32(GV_MOVE), int32(0) }) {
		DragImage image(mode, "Folder");
		std::string badge = image.Badge();
		EXPECT_EQ(std::string::npos, badge.find("##########")) << badge;
		EXPECT_EQ(kBlack, image.At(0, 0));
	}
}
