// Windows: input dispatch, threads, geometry, activation, the screen and
// screenshots.

#include <atomic>
#include <cstdio>
#include <cstring>
#include <future>
#include <thread>
#include <unistd.h>

#include <AppDefs.h>
#include <Application.h>
#include <Message.h>
#include <Screen.h>

#include "InterfaceTestSupport.h"
#include "MainLoop.h"
#include "WindowHooks.h"

using namespace InterfaceTest;
using BPrivate::Headless::PostKey;
using BPrivate::Headless::PostMouse;

namespace {

// Keeps a copy of each input message it gets, with the hook that got it.
class InputView : public BView {
public:
	InputView(BRect frame, const char* name)
		: BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0) {}

	void MouseDown(BPoint where) override { _Record("down", where); }
	void MouseUp(BPoint where) override { _Record("up", where); }
	void MouseMoved(BPoint where, uint32 transit, const BMessage*) override
	{
		_Record(transit == B_ENTERED_VIEW ? "entered" : transit == B_EXITED_VIEW
			? "exited" : transit == B_INSIDE_VIEW ? "inside" : "outside", where);
	}
	void KeyDown(const char* bytes, int32 numBytes) override
	{
		_Record(std::string("key ") + std::string(bytes, numBytes), B_ORIGIN);
	}
	void MessageReceived(BMessage* message) override
	{
		if (message->what == B_MOUSE_WHEEL_CHANGED)
			_Record("wheel", B_ORIGIN);
		else
			BView::MessageReceived(message);
	}

	struct Event {
		std::string what;
		BPoint where;
		BMessage message;
	};
	std::vector<Event> events;

private:
	void _Record(const std::string& what, BPoint where)
	{
		events.push_back({what, where, *Window()->CurrentMessage()});
	}
};

class InputTest : public WindowTest {
protected:
	void SetUp() override
	{
		left = new InputView(BRect(0, 0, 49, 49), "left");
		right = new InputView(BRect(50, 0, 99, 49), "right");
		window = MakeWindow(BRect(200, 100, 299, 149));
		window->AddChild(left);
		window->AddChild(right);
		window->Show();
		Idle();
	}

	void TearDown() override
	{
		BPrivate::Headless::SetModifiers(0);
		WindowTest::TearDown();
	}

	BWindow* window;
	InputView* left;
	InputView* right;
};

TEST_F(InputTest, MouseGoesToTheViewUnderThePointerWithItsFields)
{
	BPrivate::Headless::SetModifiers(B_CONTROL_KEY);
	PostMouse(window, B_MOUSE_DOWN, BPoint(60, 20), B_SECONDARY_MOUSE_BUTTON, 2);
	Idle();
	ASSERT_EQ(right->events.size(), 1u);
	EXPECT_TRUE(left->events.empty());
	const BMessage& down = right->events[0].message;
	EXPECT_EQ(right->events[0].where, BPoint(10, 20));
	BPoint point;
	EXPECT_EQ(down.FindPoint("where", &point), B_OK);
	EXPECT_EQ(point, BPoint(10, 20));
	EXPECT_EQ(down.FindPoint("be:view_where", &point), B_OK);
	EXPECT_EQ(point, BPoint(10, 20));
	EXPECT_EQ(down.FindPoint("screen_where", &point), B_OK);
	EXPECT_EQ(point, BPoint(260, 120));
	EXPECT_EQ(down.GetInt32("buttons", 0), B_SECONDARY_MOUSE_BUTTON);
	EXPECT_EQ(down.GetInt32("clicks", 0), 2);
	EXPECT_EQ(down.GetInt32("modifiers", 0), B_CONTROL_KEY);
	EXPECT_TRUE(down.HasInt64("when"));
}

TEST_F(InputTest, APressedViewKeepsThePointerUntilRelease)
{
	PostMouse(window, B_MOUSE_MOVED, BPoint(10, 10), 0);
	PostMouse(window, B_MOUSE_DOWN, BPoint(10, 10));
	PostMouse(window, B_MOUSE_MOVED, BPoint(70, 10));
	PostMouse(window, B_MOUSE_UP, BPoint(70, 10), 0);
	PostMouse(window, B_MOUSE_MOVED, BPoint(75, 10), 0);
	Idle();
	std::vector<std::string> leftEvents;
	for (const auto& event : left->events)
		leftEvents.push_back(event.what);
	EXPECT_EQ(leftEvents, (std::vector<std::string>{"entered", "down", "outside", "up",
		"exited"}));
	EXPECT_EQ(left->events[3].where, BPoint(70, 10));
	ASSERT_EQ(right->events.size(), 1u);
	EXPECT_EQ(right->events[0].what, "entered");
}

TEST_F(InputTest, WheelAndGetMouseFollowThePointer)
{
	PostMouse(window, B_MOUSE_MOVED, BPoint(70, 10), B_TERTIARY_MOUSE_BUTTON);
	BPrivate::Headless::PostWheel(window, 0, 2);
	Idle();
	ASSERT_EQ(right->events.size(), 2u);
	EXPECT_EQ(right->events[1].what, "wheel");
	EXPECT_EQ(right->events[1].message.GetFloat("be:wheel_delta_y", 0), 2);
	EXPECT_TRUE(left->events.empty());

	BPoint where;
	uint32 buttons;
	window->Lock();
	right->GetMouse(&where, &buttons);
	window->Unlock();
	EXPECT_EQ(where, BPoint(20, 10));
	EXPECT_EQ(buttons, uint32(B_TERTIARY_MOUSE_BUTTON));
}

TEST_F(InputTest, KeysGoToTheFocusViewOrToTheShortcutHandler)
{
	PostKey(window, "x", 0x4d);
	Idle();
	EXPECT_TRUE(left->events.empty());

	window->Lock();
	left->MakeFocus(true);
	window->Unlock();
	PostKey(window, "\xc3\xa9", 0x29);
	PostKey(window, "\x1b", 1);
	Idle();
	ASSERT_EQ(left->events.size(), 2u);
	EXPECT_EQ(left->events[0].what, "key \xc3\xa9");
	const BMessage& escape = left->events[1].message;
	EXPECT_EQ(escape.GetInt32("key", 0), 1);
	EXPECT_EQ(escape.GetString("bytes", ""), std::string("\x1b"));
	int8 byte = 0;
	EXPECT_EQ(escape.FindInt8("byte", &byte), B_OK);
	EXPECT_EQ(byte, B_ESCAPE);
	EXPECT_EQ(escape.GetInt32("raw_char", 0), B_ESCAPE);

	struct Shortcuts : BPrivate::ShortcutHandler {
		std::string seen;
		bool HandleShortcut(BWindow*, BMessage* keyDown) override
		{
			seen += keyDown->GetString("bytes", "");
			return true;
		}
	} shortcuts;
	window->Lock();
	BPrivate::SetShortcutHandler(window, &shortcuts);
	window->Unlock();
	BPrivate::Headless::SetModifiers(B_CONTROL_KEY | B_LEFT_CONTROL_KEY);
	PostKey(window, "o", 0x2f);
	BPrivate::Headless::SetModifiers(0);
	PostKey(window, "p", 0x30);
	Idle();
	window->Lock();
	BPrivate::SetShortcutHandler(window, nullptr);
	window->Unlock();
	EXPECT_EQ(shortcuts.seen, "o");
	ASSERT_EQ(left->events.size(), 3u);
	EXPECT_EQ(left->events[2].what, "key p");
}

TEST_F(InputTest, AModalWindowBlocksTheOthers)
{
	BWindow* modal = MakeWindow(BRect(0, 0, 49, 49), B_MODAL_APP_WINDOW_FEEL);
	modal->Show();
	Idle();
	PostMouse(window, B_MOUSE_DOWN, BPoint(10, 10));
	PostKey(window, "a");
	Idle();
	EXPECT_TRUE(left->events.empty());
	modal->Lock();
	modal->Hide();
	modal->Unlock();
	PostMouse(window, B_MOUSE_DOWN, BPoint(10, 10));
	Idle();
	EXPECT_EQ(left->events.size(), 1u);
}

using WindowsTest = WindowTest;

TEST_F(WindowsTest, EachWindowDrawsInItsOwnThread)
{
	constexpr int kCount = 4;
	std::vector<BWindow*> windows;
	std::vector<std::atomic<thread_id>> drawers(kCount);
	for (int i = 0; i < kCount; i++) {
		rgb_color color = make_color(40 * i, 255 - 40 * i, 7 * i);
		auto* view = new DrawView(BRect(0, 0, 99, 49), [&, i, color](BView* view) {
			drawers[i] = find_thread(NULL);
			view->SetHighColor(color);
			view->FillRect(view->Bounds());
		});
		windows.push_back(MakeWindow(BRect(10 * i, 10 * i, 10 * i + 99, 10 * i + 49)));
		windows.back()->AddChild(view);
		windows.back()->Show();
	}
	// Invalidations from several threads at once.
	std::vector<std::thread> threads;
	for (BWindow* window : windows) {
		threads.emplace_back([window] {
			for (int round = 0; round < 20; round++) {
				if (window->Lock()) {
					window->ChildAt(0)->Invalidate(BRect(0, 0, round, round));
					window->Unlock();
				}
			}
		});
	}
	for (std::thread& thread : threads)
		thread.join();
	Idle();
	for (int i = 0; i < kCount; i++) {
		EXPECT_EQ(drawers[i], windows[i]->Thread());
		EXPECT_NE(windows[i]->Thread(), find_thread(NULL));
		EXPECT_EQ(Pixel(windows[i], 50, 25), make_color(40 * i, 255 - 40 * i, 7 * i));
	}
	EXPECT_NE(windows[0]->Thread(), windows[1]->Thread());
}

TEST_F(WindowsTest, GeometryTitleAndTheWindowList)
{
	BApplication application("application/x-vnd.Varnel-interface-test");
	int32 before = application.CountWindows();
	BWindow* window = MakeWindow(BRect(10, 20, 109, 69));
	auto* all = new DrawView(BRect(0, 0, 99, 49), {}, B_FOLLOW_ALL_SIDES);
	all->SetViewColor(kBlue);
	window->AddChild(all);
	window->Show();
	window->Lock();
	window->SetTitle("Varnel");
	window->MoveTo(30, 40);
	window->ResizeTo(149, 79);
	EXPECT_EQ(window->Frame(), BRect(30, 40, 179, 119));
	EXPECT_EQ(window->Bounds(), BRect(0, 0, 149, 79));
	EXPECT_EQ(all->Frame(), BRect(0, 0, 149, 79));
	EXPECT_EQ(window->ConvertToScreen(BPoint(1, 2)), BPoint(31, 42));
	window->Unlock();
	Idle();
	EXPECT_EQ(Pixel(window, 149, 79), kBlue);

	auto listed = BPrivate::Headless::ListWindows();
	ASSERT_FALSE(listed.empty());
	EXPECT_EQ(listed[0].window, window);
	EXPECT_EQ(listed[0].title, "Varnel");
	EXPECT_EQ(listed[0].frame, BRect(30, 40, 179, 119));
	EXPECT_EQ(application.CountWindows(), before + 1);
	EXPECT_EQ(application.WindowAt(before), window);
	EXPECT_EQ(application.WindowAt(before + 1), nullptr);

	window->Lock();
	window->Hide();
	EXPECT_TRUE(window->IsHidden());
	window->Unlock();
	for (const auto& info : BPrivate::Headless::ListWindows())
		EXPECT_NE(info.window, window);
}

TEST_F(WindowsTest, TheLastShownWindowIsActive)
{
	struct ActivationWindow : BWindow {
		ActivationWindow(BRect frame)
			: BWindow(frame, "active", B_TITLED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL, 0) {}
		void WindowActivated(bool active) override { changes += active ? "+" : "-"; }
		std::string changes;
	};
	auto* first = new ActivationWindow(BRect(0, 0, 9, 9));
	auto* second = new ActivationWindow(BRect(20, 0, 29, 9));
	fWindows.push_back(first);
	fWindows.push_back(second);
	first->Show();
	Idle();
	second->Show();
	Idle();
	EXPECT_FALSE(first->IsActive());
	EXPECT_TRUE(second->IsActive());
	first->Lock();
	first->Activate();
	first->Unlock();
	Idle();
	EXPECT_EQ(first->changes, "+-+");
	EXPECT_EQ(second->changes, "+-");
}

TEST_F(WindowsTest, ABlockedWindowKeepsShowingItsLastFrame)
{
	std::promise<void> release;
	std::shared_future<void> released = release.get_future().share();
	auto* view = new DrawView(BRect(0, 0, 99, 49));
	view->SetViewColor(kGrey);
	BWindow* window = ShowView(view);
	struct Blocker : BHandler {
		std::shared_future<void> until;
		void MessageReceived(BMessage*) override
		{
			BPrivate::ModalWaitScope modal;
			until.wait();
		}
	} blocker;
	blocker.until = released;
	window->Lock();
	window->AddHandler(&blocker);
	window->PostMessage('blok', &blocker);
	window->Unlock();
	Idle();
	EXPECT_EQ(Pixel(window, 10, 10), kGrey);
	release.set_value();
	window->Lock();
	window->RemoveHandler(&blocker);
	window->Unlock();
}

TEST_F(WindowsTest, ScreenAndScreenshot)
{
	BPrivate::Headless::SetScreenSize(640, 480);
	EXPECT_EQ(BScreen(B_MAIN_SCREEN_ID).Frame(), BRect(0, 0, 639, 479));
	BPrivate::Headless::SetScreenSize(1024, 768);
	EXPECT_EQ(BScreen().Frame().right, 1023);

	auto* view = new DrawView(BRect(0, 0, 99, 49));
	view->SetViewColor(kRed);
	BWindow* window = ShowView(view);
	char path[] = "/tmp/varnel-shot-XXXXXX";
	int descriptor = mkstemp(path);
	ASSERT_GE(descriptor, 0);
	close(descriptor);
	EXPECT_EQ(BPrivate::Headless::SaveScreenshot(window, path), B_OK);
	FILE* file = fopen(path, "rb");
	ASSERT_NE(file, nullptr);
	unsigned char signature[8] = {};
	EXPECT_EQ(fread(signature, 1, 8, file), 8u);
	fclose(file);
	unlink(path);
	EXPECT_EQ(memcmp(signature, "\x89PNG\r\n\x1a\n", 8), 0);
	EXPECT_NE(BPrivate::Headless::SaveScreenshot(window, "/nonexistent/dir/shot.png"), B_OK);
	EXPECT_EQ(BPrivate::Headless::SaveScreenshot(nullptr, path), B_BAD_VALUE);
}

}
