// The text view edited keystroke by keystroke and with the mouse, as the
// rename editor uses it.

#include <cmath>

#include <TextView.h>

#include "ControlTestSupport.h"

using namespace ControlTest;
using BPrivate::Headless::PostMouse;
using BPrivate::Headless::SetModifiers;

namespace {

constexpr char kLeft[] = "\x1c";
constexpr char kRight[] = "\x1d";
constexpr char kHome[] = "\x01";
constexpr char kEnd[] = "\x04";
constexpr char kBackspace[] = "\x08";
constexpr char kDelete[] = "\x7f";

class TextViewTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fText = new BTextView(BRect(10, 10, 189, 29), "text", BRect(2, 2, 177, 17),
			B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, B_WILL_DRAW | B_NAVIGABLE);
		fWindow = ShowView(fText, BRect(100, 100, 299, 149));
		ASSERT_TRUE(fWindow->Lock());
		fText->MakeFocus(true);
		fWindow->Unlock();
	}

	void Type(std::initializer_list<const char*> keys, uint32 modifiers = 0)
	{
		SetModifiers(modifiers);
		for (const char* key : keys)
			Key(fWindow, key);
		Idle();
		SetModifiers(0);
	}

	std::string Text()
	{
		fWindow->Lock();
		std::string text = fText->Text();
		fWindow->Unlock();
		return text;
	}

	std::pair<int32, int32> Selection()
	{
		int32 start;
		int32 end;
		fWindow->Lock();
		fText->GetSelection(&start, &end);
		fWindow->Unlock();
		return {start, end};
	}

	BWindow* fWindow;
	BTextView* fText;
};

TEST_F(TextViewTest, TypingAndDeletingGoByWholeCharacters)
{
	// One, two, three and four bytes long.
	Type({"a", "\xc3\xa9", "\xe2\x82\xac", "\xf0\x9f\x98\x80"});
	EXPECT_EQ(Text(), "a\xc3\xa9\xe2\x82\xac\xf0\x9f\x98\x80");
	EXPECT_EQ(Selection(), std::make_pair(10, 10));

	Type({kLeft});
	EXPECT_EQ(Selection(), std::make_pair(6, 6));
	Type({kBackspace});
	EXPECT_EQ(Text(), "a\xc3\xa9\xf0\x9f\x98\x80");
	Type({kDelete});
	EXPECT_EQ(Text(), "a\xc3\xa9");
	Type({kHome, kRight, kDelete});
	EXPECT_EQ(Text(), "a");
	// Nothing to delete at either end.
	Type({kEnd, kDelete, kHome, kBackspace});
	EXPECT_EQ(Text(), "a");
}

TEST_F(TextViewTest, ShiftSelectsAndTypingReplacesTheSelection)
{
	Type({"o", "l", "d", " ", "n", "a", "m", "e"});
	Type({kHome});
	Type({kRight, kRight, kRight}, B_SHIFT_KEY);
	EXPECT_EQ(Selection(), std::make_pair(0, 3));
	Type({"n", "e", "w"});
	EXPECT_EQ(Text(), "new name");
	// Shift+Left from the end, then a plain Left drops the selection at its
	// start.
	Type({kEnd});
	Type({kLeft, kLeft, kLeft, kLeft}, B_SHIFT_KEY);
	EXPECT_EQ(Selection(), std::make_pair(4, 8));
	Type({kLeft});
	EXPECT_EQ(Selection(), std::make_pair(4, 4));
	Type({kEnd}, B_SHIFT_KEY);
	Type({kBackspace});
	EXPECT_EQ(Text(), "new ");
	// Ctrl+A selects everything and Ctrl with a letter types nothing.
	Type({"a"}, B_CONTROL_KEY);
	EXPECT_EQ(Selection(), std::make_pair(0, 4));
	Type({"x"}, B_CONTROL_KEY);
	EXPECT_EQ(Text(), "new ");
}

TEST_F(TextViewTest, LimitsHoldForTypedText)
{
	ASSERT_TRUE(fWindow->Lock());
	fText->SetMaxBytes(4);
	fText->DisallowChar('/');
	fWindow->Unlock();
	Type({"a", "/", "b", "\xe2\x82\xac", "c", "d", "e"});
	EXPECT_EQ(Text(), "abcd");
	// Inserting stops on a character boundary too.
	ASSERT_TRUE(fWindow->Lock());
	fText->SetText("");
	fText->Insert("x\xe2\x82\xac\xe2\x82\xac");
	EXPECT_STREQ(fText->Text(), "x\xe2\x82\xac");
	fText->SetMaxBytes(2);
	EXPECT_STREQ(fText->Text(), "x");
	fWindow->Unlock();
}

TEST_F(TextViewTest, OddBytesAreKeptAndDeletedOneByOne)
{
	ASSERT_TRUE(fWindow->Lock());
	fText->SetText("a\xff\xfe'$`\nb");
	EXPECT_EQ(fText->TextLength(), 8);
	EXPECT_EQ(fText->CountLines(), 2);
	fText->Select(3, 3);
	fWindow->Unlock();
	Type({kBackspace});
	EXPECT_EQ(Text(), "a\xff'$`\nb");
}

TEST_F(TextViewTest, TheMouseSelects)
{
	ASSERT_TRUE(fWindow->Lock());
	fText->SetText("first second");
	BPoint start = fText->ConvertToParent(fText->PointAt(0)) + BPoint(0, 5);
	BPoint sixth = fText->ConvertToParent(fText->PointAt(6)) + BPoint(0, 5);
	BPoint end = fText->ConvertToParent(fText->PointAt(12)) + BPoint(0, 5);
	fWindow->Unlock();

	PostMouse(fWindow, B_MOUSE_DOWN, start);
	PostMouse(fWindow, B_MOUSE_MOVED, sixth);
	PostMouse(fWindow, B_MOUSE_UP, sixth, 0);
	Idle();
	EXPECT_EQ(Selection(), std::make_pair(0, 6));
	// Shift-click extends from where the selection started.
	SetModifiers(B_SHIFT_KEY);
	PostMouse(fWindow, B_MOUSE_DOWN, end);
	PostMouse(fWindow, B_MOUSE_UP, end, 0);
	Idle();
	SetModifiers(0);
	EXPECT_EQ(Selection(), std::make_pair(0, 12));
	// A double click takes the word.
	PostMouse(fWindow, B_MOUSE_DOWN, sixth + BPoint(12, 0), B_PRIMARY_MOUSE_BUTTON, 2);
	PostMouse(fWindow, B_MOUSE_UP, sixth + BPoint(12, 0), 0);
	Idle();
	EXPECT_EQ(Selection(), std::make_pair(6, 12));
}

TEST_F(TextViewTest, AResizableViewFollowsItsText)
{
	ASSERT_TRUE(fWindow->Lock());
	fText->MakeResizable(true);
	// Empty, it keeps its insets of 2 and room for the caret.
	EXPECT_EQ(fText->Bounds().Width(), 2 + 1 + 2);
	fText->Insert("a long enough name");
	float wide = fText->Bounds().Width();
	EXPECT_EQ(wide, std::ceil(be_plain_font->StringWidth("a long enough name")) + 1 + 4);
	EXPECT_EQ(fText->TextRect().right, wide - 2);
	fText->Select(1, 14);
	fText->Delete();
	EXPECT_LT(fText->Bounds().Width(), wide);
	EXPECT_FALSE(fText->DoesWordWrap());
	fWindow->Unlock();
}

TEST_F(TextViewTest, WordWrapBreaksLongLines)
{
	ASSERT_TRUE(fWindow->Lock());
	fText->SetText("several words that cannot fit on one line of this narrow view");
	EXPECT_GT(fText->CountLines(), 1);
	for (int32 line = 0; line < fText->CountLines(); line++)
		EXPECT_LE(fText->LineWidth(line), fText->TextRect().Width() + 1);
	fText->SetWordWrap(false);
	EXPECT_EQ(fText->CountLines(), 1);
	fWindow->Unlock();
}

// Enter and Escape taken before the editing, as the rename editor does.
class Editor : public BTextView {
public:
	Editor(BRect frame) : BTextView(frame, "", frame.OffsetToCopy(0, 0).InsetByCopy(2, 2),
		B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, B_WILL_DRAW | B_NAVIGABLE) {}

	void KeyDown(const char* bytes, int32 numBytes) override
	{
		if (bytes[0] == B_ENTER)
			confirmed = Text();
		else
			BTextView::KeyDown(bytes, numBytes);
	}

	void Draw(BRect update) override
	{
		StrokeRect(Bounds());
		BTextView::Draw(update);
	}

	std::string confirmed;
};

TEST_F(TextViewTest, SubclassesPassKeysOnAndDrawInsideTheTextRectangle)
{
	Editor* editor = new Editor(BRect(20, 40, 119, 59));
	ASSERT_TRUE(fWindow->Lock());
	fWindow->AddChild(editor);
	editor->MakeFocus(true);
	fWindow->Unlock();
	Type({"x", "\t", "y", "\n"});
	ASSERT_TRUE(fWindow->Lock());
	EXPECT_EQ(editor->confirmed, "x\ty");
	fWindow->Unlock();
	Idle();
	// The frame stays, and the text lies inside its rectangle; the caret
	// shows after it.
	EXPECT_EQ(Row(fWindow, 40, 20, 119), std::string(100, '#'));
	EXPECT_EQ(Row(fWindow, 41, 21, 118), std::string(98, '.'));
	bool ink = false;
	for (int32 y = 42; y <= 57; y++) {
		for (int32 x = 22; x < 60; x++)
			ink = ink || Pixel(fWindow, x, y).red < 128;
	}
	EXPECT_TRUE(ink);
}

}
