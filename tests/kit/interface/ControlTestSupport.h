// Windows and views that record what reaches them, and helpers to find the
// windows the controls open, for the tests of the controls.

#ifndef CONTROL_TEST_SUPPORT_H
#define CONTROL_TEST_SUPPORT_H

#include <mutex>
#include <vector>

#include <Message.h>
#include <View.h>
#include <Window.h>

#include "InterfaceTestSupport.h"
#include "WindowHooks.h"

namespace ControlTest {

// Copies of messages, kept for the test thread.
class Recorder {
public:
	void Record(const BMessage* message)
	{
		std::lock_guard<std::mutex> guard(fLock);
		fMessages.push_back(*message);
	}

	std::vector<BMessage> Messages() const
	{
		std::lock_guard<std::mutex> guard(fLock);
		return fMessages;
	}

	int32 Count(uint32 what) const
	{
		std::lock_guard<std::mutex> guard(fLock);
		int32 count = 0;
		for (const BMessage& message : fMessages)
			count += message.what == what ? 1 : 0;
		return count;
	}

private:
	mutable std::mutex fLock;
	std::vector<BMessage> fMessages;
};

// A window that records the messages no view took, and counts its menu hooks.
class RecordingWindow : public BWindow {
public:
	explicit RecordingWindow(BRect frame, const char* title = "test")
		: BWindow(frame, title, B_TITLED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL, 0) {}

	void MessageReceived(BMessage* message) override { recorder.Record(message); }
	void MenusBeginning() override { menusBeginning++; }
	void MenusEnded() override { menusEnded++; }

	Recorder recorder;
	std::atomic<int32> menusBeginning{0};
	std::atomic<int32> menusEnded{0};
};

// A view that records the messages it receives (drops among them).
class RecordingView : public BView {
public:
	explicit RecordingView(BRect frame, const char* name = "recorder")
		: BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW) {}

	void MessageReceived(BMessage* message) override { recorder.Record(message); }

	Recorder recorder;
};

class ControlWindowTest : public InterfaceTest::WindowTest {
protected:
	RecordingWindow* MakeRecordingWindow(BRect frame = BRect(100, 100, 299, 249))
	{
		RecordingWindow* window = new RecordingWindow(frame);
		fWindows.push_back(window);
		return window;
	}

	// The shown windows of a feel, front to back.
	static std::vector<BPrivate::Headless::WindowInfo> WindowsOf(window_feel feel)
	{
		std::vector<BPrivate::Headless::WindowInfo> found;
		for (const auto& info : BPrivate::Headless::ListWindows()) {
			if (info.feel == feel)
				found.push_back(info);
		}
		return found;
	}

	static std::vector<BPrivate::Headless::WindowInfo> OpenMenus()
	{
		return WindowsOf(BPrivate::kMenuWindowFeel);
	}

	// A click: press and release at where.
	void Click(const BWindow* window, BPoint where)
	{
		using BPrivate::Headless::PostMouse;
		ASSERT_EQ(PostMouse(window, B_MOUSE_MOVED, where, 0), B_OK);
		ASSERT_EQ(PostMouse(window, B_MOUSE_DOWN, where), B_OK);
		ASSERT_EQ(PostMouse(window, B_MOUSE_UP, where, 0), B_OK);
	}

	void Key(const BWindow* window, const char* bytes, int32 key = 0)
	{
		ASSERT_EQ(BPrivate::Headless::PostKey(window, bytes, key), B_OK);
	}

	void TearDown() override
	{
		BPrivate::Headless::SetModifiers(0);
		InterfaceTest::WindowTest::TearDown();
	}
};

}

#endif
