// View hierarchy, geometry, clipping, scrolling, updates and focus.

#include <string>

#include <Message.h>

#include "InterfaceTestSupport.h"

using namespace InterfaceTest;

namespace {

// Records its hooks in a shared journal.
class JournalView : public BView {
public:
	JournalView(BRect frame, const char* name, std::string& journal,
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP, uint32 flags = 0)
		: BView(frame, name, resizingMode, flags), fJournal(journal) {}

	void AttachedToWindow() override { fJournal += std::string("+") + Name(); }
	void AllAttached() override { fJournal += std::string("*") + Name(); }
	void DetachedFromWindow() override { fJournal += std::string("-") + Name(); }
	void FrameResized(float width, float height) override
	{
		fJournal += std::string("resized ") + Name() + " " + std::to_string(int(width)) + "x"
			+ std::to_string(int(height)) + ";";
	}
	void MakeFocus(bool focused) override
	{
		fJournal += std::string(focused ? "focus " : "unfocus ") + Name() + ";";
		// As the panes do: whatever they are told, they ask for the focus.
		if (asksForFocus)
			BView::MakeFocus(true);
		else
			BView::MakeFocus(focused);
	}

	bool asksForFocus = false;

private:
	std::string& fJournal;
};

class ViewTest : public WindowTest {
protected:
	// Outlives the windows, whose views write to it until they are gone.
	std::string journal;
};

TEST_F(ViewTest, HierarchyAndAttachmentHooks)
{
	BWindow* window = MakeWindow();
	auto* parent = new JournalView(BRect(0, 0, 50, 40), "p", journal);
	auto* first = new JournalView(BRect(0, 0, 9, 9), "a", journal);
	auto* second = new JournalView(BRect(10, 0, 19, 9), "b", journal);
	parent->AddChild(first);
	parent->AddChild(second, first);
	EXPECT_EQ(journal, "");
	window->AddChild(parent);
	EXPECT_EQ(journal, "+p+b+a*b*a*p");
	EXPECT_EQ(parent->ChildAt(0), second);
	EXPECT_EQ(second->NextSibling(), first);
	EXPECT_EQ(first->PreviousSibling(), second);
	EXPECT_EQ(first->Window(), window);
	EXPECT_EQ(first->Looper(), window);
	EXPECT_EQ(window->FindView("a"), first);
	EXPECT_EQ(window->FindView(BPoint(12, 3)), second);

	// A view with a parent, or its own ancestor, is refused.
	parent->AddChild(first);
	first->AddChild(parent);
	EXPECT_EQ(parent->CountChildren(), 2);

	journal.clear();
	EXPECT_TRUE(first->RemoveSelf());
	EXPECT_EQ(journal, "-a");
	EXPECT_EQ(first->Window(), nullptr);
	EXPECT_EQ(first->Looper(), nullptr);
	EXPECT_FALSE(parent->RemoveChild(first));
	delete first;
}

TEST_F(ViewTest, ResizingModesFollowTheParent)
{
	BWindow* window = MakeWindow(BRect(0, 0, 199, 199));
	auto* parent = new BView(BRect(0, 0, 99, 99), "parent", B_FOLLOW_NONE, 0);
	struct Case {
		uint32 mode;
		BRect after;
	};
	const Case cases[] = {
		{B_FOLLOW_ALL_SIDES, BRect(10, 10, 49, 49)},
		{B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, BRect(10, 10, 49, 29)},
		{B_FOLLOW_TOP_BOTTOM | B_FOLLOW_RIGHT, BRect(30, 10, 49, 49)},
		{B_FOLLOW_H_CENTER | B_FOLLOW_V_CENTER, BRect(20, 20, 39, 39)},
		{B_FOLLOW_NONE, BRect(10, 10, 29, 29)},
	};
	std::vector<BView*> children;
	for (const Case& test : cases) {
		children.push_back(new JournalView(BRect(10, 10, 29, 29),
			test.mode == B_FOLLOW_ALL_SIDES ? "all" : "other", journal, test.mode,
			test.mode == B_FOLLOW_ALL_SIDES ? uint32(B_FRAME_EVENTS) : 0));
		parent->AddChild(children.back());
	}
	window->AddChild(parent);
	window->Show();
	window->Lock();
	parent->ResizeBy(20, 20);
	window->Unlock();
	Idle();
	for (size_t i = 0; i < children.size(); i++)
		EXPECT_EQ(children[i]->Frame(), cases[i].after) << "case " << i;
	EXPECT_EQ(journal, "+all+other+other+other+other*all*other*other*other*other"
		"resized all 39x39;");
}

TEST_F(ViewTest, ScrollingMovesBoundsAndDrawing)
{
	auto* view = new DrawView(BRect(10, 10, 59, 59), [](BView* view) {
		view->FillRect(BRect(40, 40, 44, 44));
	});
	BWindow* window = ShowView(view, BRect(100, 100, 199, 199));
	EXPECT_EQ(Pixel(window, 50, 50), kBlack);

	window->Lock();
	view->ScrollTo(30, 35);
	EXPECT_EQ(view->Bounds(), BRect(30, 35, 79, 84));
	EXPECT_EQ(view->Frame(), BRect(10, 10, 59, 59));
	EXPECT_EQ(view->ConvertToParent(BPoint(30, 35)), BPoint(10, 10));
	EXPECT_EQ(view->ConvertFromParent(BPoint(10, 10)), BPoint(30, 35));
	EXPECT_EQ(view->ConvertToScreen(BPoint(30, 35)), BPoint(110, 110));
	EXPECT_EQ(view->ConvertFromScreen(BRect(110, 110, 111, 111)), BRect(30, 35, 31, 36));
	window->Unlock();
	Idle();
	EXPECT_EQ(Pixel(window, 50, 50), kWhite);
	EXPECT_EQ(Row(window, 15, 18, 26), "..#####..");
	EXPECT_EQ(Column(window, 20, 13, 21), "..#####..");
}

TEST_F(ViewTest, DrawingIsClippedToTheVisiblePart)
{
	// The parent paints everything red; its first child is covered by the
	// second and the window's edge; the child's own ink stays inside it.
	auto* parent = new DrawView(BRect(0, 0, 99, 49), [](BView* view) {
		view->SetHighColor(kRed);
		view->FillRect(BRect(-50, -50, 500, 500));
	});
	auto* under = new DrawView(BRect(10, 10, 39, 39), [](BView* view) {
		view->FillRect(BRect(-50, -50, 500, 500));
	});
	auto* over = new DrawView(BRect(30, 10, 49, 39));
	over->SetViewColor(kBlue);
	auto* clipped = new DrawView(BRect(90, 10, 139, 19), [](BView* view) {
		view->FillRect(view->Bounds());
	});
	parent->AddChild(under);
	parent->AddChild(over);
	parent->AddChild(clipped);
	BWindow* window = ShowView(parent);
	EXPECT_EQ(Row(window, 20, 8, 51, kRed), "##" + std::string(40, '.') + "##");
	EXPECT_EQ(Row(window, 20, 8, 51), ".." + std::string(20, '#') + std::string(22, '.'));
	EXPECT_EQ(Row(window, 20, 8, 51, kBlue), std::string(22, '.') + std::string(20, '#') + "..");
	EXPECT_EQ(Row(window, 15, 88, 99), "..##########");
}

TEST_F(ViewTest, InvalidationRedrawsOnlyWhatIsInvalid)
{
	int32 draws = 0;
	auto* view = new DrawView(BRect(0, 0, 99, 49), [&](BView* view) {
		draws++;
		view->FillRect(view->Bounds());
	});
	view->SetViewColor(kGrey);
	BWindow* window = ShowView(view);
	EXPECT_EQ(draws, 1);
	EXPECT_EQ(view->updates.back(), BRect(0, 0, 99, 49));

	// Paint outside of Draw, then invalidate a part: only that part is erased
	// with the view colour and handed to Draw.
	window->Lock();
	view->SetHighColor(kRed);
	view->FillRect(view->Bounds());
	view->SetHighColor(kBlack);
	view->Invalidate(BRect(10, 10, 19, 14));
	view->Invalidate(BRect(15, 12, 29, 19));
	window->Unlock();
	Idle();
	EXPECT_EQ(draws, 2);
	EXPECT_EQ(view->updates.back(), BRect(10, 10, 29, 19));
	EXPECT_EQ(Pixel(window, 5, 5), kRed);
	EXPECT_EQ(Pixel(window, 12, 12), kBlack);
	EXPECT_EQ(Pixel(window, 12, 17), kRed);
}

TEST_F(ViewTest, UpdateIfNeededDrawsAtOnceInTheWindowThread)
{
	int32 draws = 0;
	int32 drawsSeen = -1;
	auto* view = new DrawView(BRect(0, 0, 99, 49), [&](BView*) { draws++; });
	view->SetViewColor(B_TRANSPARENT_COLOR);
	BWindow* window = ShowView(view);
	window->Lock();
	view->Invalidate();
	// From another thread it does nothing.
	window->UpdateIfNeeded();
	EXPECT_TRUE(window->NeedsUpdate());
	EXPECT_EQ(draws, 1);
	window->Unlock();

	struct Updater : BHandler {
		std::function<void()> run;
		void MessageReceived(BMessage*) override { run(); }
	} updater;
	updater.run = [&] {
		view->Invalidate(BRect(0, 0, 5, 5));
		window->UpdateIfNeeded();
		drawsSeen = draws;
	};
	window->Lock();
	window->AddHandler(&updater);
	window->PostMessage('updt', &updater);
	window->Unlock();
	Idle();
	EXPECT_EQ(drawsSeen, 3);
	window->Lock();
	window->RemoveHandler(&updater);
	window->Unlock();
}

TEST_F(ViewTest, FocusFollowsThePlatformRules)
{
	BWindow* window = MakeWindow();
	auto* tree = new JournalView(BRect(0, 0, 9, 9), "tree", journal);
	auto* files = new JournalView(BRect(10, 0, 19, 9), "files", journal);
	tree->asksForFocus = files->asksForFocus = true;
	window->AddChild(tree);
	window->AddChild(files);
	journal.clear();

	tree->MakeFocus(true);
	EXPECT_EQ(window->CurrentFocus(), tree);
	// The view losing the focus is told first, and asks for it back; the one
	// asking still ends up with it.
	files->MakeFocus(true);
	EXPECT_EQ(journal, "focus tree;focus files;unfocus tree;");
	EXPECT_TRUE(files->IsFocus());
	EXPECT_FALSE(tree->IsFocus());

	tree->asksForFocus = files->asksForFocus = false;
	tree->MakeFocus(false);
	EXPECT_EQ(window->CurrentFocus(), files);
	window->RemoveChild(files);
	EXPECT_EQ(window->CurrentFocus(), nullptr);
	delete files;
}

}
