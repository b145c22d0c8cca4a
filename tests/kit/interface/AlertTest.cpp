// Buttons, the default button, and alerts answered while the window that
// asked waits in Go.

#include <atomic>

#include <Alert.h>
#include <Button.h>
#include <Invoker.h>
#include <TextView.h>

#include "ControlTestSupport.h"

using namespace ControlTest;
using BPrivate::Headless::PostMouse;

namespace {

class ButtonTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fWindow = MakeRecordingWindow();
		fButton = new BButton(BRect(10, 10, 89, 39), "ok", "Ok", new BMessage('okay'));
		fOther = new BButton(BRect(100, 10, 179, 39), "other", "Other", new BMessage('othr'));
		fText = new BTextView(BRect(10, 60, 150, 80), "text", BRect(2, 2, 138, 18),
			B_FOLLOW_NONE, B_WILL_DRAW);
		fWindow->AddChild(fButton);
		fWindow->AddChild(fOther);
		fWindow->AddChild(fText);
		fWindow->Show();
		Idle();
	}

	RecordingWindow* fWindow;
	BButton* fButton;
	BButton* fOther;
	BTextView* fText;
};

TEST_F(ButtonTest, AClickInvokesTheWindowByDefault)
{
	Click(fWindow, BPoint(30, 20));
	Idle();
	ASSERT_EQ(fWindow->recorder.Count('okay'), 1);
	BMessage invoked = fWindow->recorder.Messages()[0];
	EXPECT_TRUE(invoked.HasInt64("when"));
	void* source = nullptr;
	EXPECT_EQ(invoked.FindPointer("source", &source), B_OK);
	EXPECT_EQ(source, fButton);
	// Released elsewhere, or disabled, it does nothing.
	PostMouse(fWindow, B_MOUSE_DOWN, BPoint(30, 20));
	PostMouse(fWindow, B_MOUSE_MOVED, BPoint(30, 100));
	PostMouse(fWindow, B_MOUSE_UP, BPoint(30, 100), 0);
	ASSERT_TRUE(fWindow->Lock());
	fOther->SetEnabled(false);
	fWindow->Unlock();
	Click(fWindow, BPoint(120, 20));
	Idle();
	EXPECT_EQ(fWindow->recorder.Messages().size(), 1u);
}

TEST_F(ButtonTest, EnterPressesTheDefaultButtonWhereverTheFocusIs)
{
	ASSERT_TRUE(fWindow->Lock());
	fText->MakeFocus(true);
	fButton->MakeDefault(true);
	fOther->MakeDefault(true);
	EXPECT_FALSE(fButton->IsDefault());
	EXPECT_TRUE(fOther->IsDefault());
	fWindow->Unlock();
	Key(fWindow, "\n");
	Idle();
	EXPECT_EQ(fWindow->recorder.Count('othr'), 1);
	EXPECT_STREQ(fText->Text(), "");
	// Without a default button, Enter goes to the focus view.
	ASSERT_TRUE(fWindow->Lock());
	fOther->RemoveSelf();
	delete fOther;
	fWindow->Unlock();
	Key(fWindow, "\n");
	Idle();
	EXPECT_STREQ(fText->Text(), "\n");
}

TEST_F(ButtonTest, InvokersNeedAMessageAndATarget)
{
	BInvoker invoker;
	EXPECT_EQ(invoker.Invoke(), B_BAD_VALUE);
	invoker.SetMessage(new BMessage('ping'));
	EXPECT_EQ(invoker.Command(), uint32('ping'));
	EXPECT_NE(invoker.Invoke(), B_OK);
	EXPECT_EQ(invoker.SetTarget(fWindow), B_OK);
	EXPECT_EQ(invoker.Invoke(), B_OK);
	BView unattached(BRect(0, 0, 1, 1), "loose", B_FOLLOW_NONE, 0);
	EXPECT_EQ(invoker.SetTarget(&unattached), B_BAD_HANDLER);
	Idle();
	EXPECT_EQ(fWindow->recorder.Count('ping'), 1);
}

// Runs an alert from its own thread when told, as a window's command does.
class AskingWindow : public RecordingWindow {
public:
	AskingWindow() : RecordingWindow(BRect(100, 100, 299, 199), "asking") {}

	void MessageReceived(BMessage* message) override
	{
		if (message->what != 'ask ') {
			RecordingWindow::MessageReceived(message);
			return;
		}
		BAlert* alert = new BAlert("question", "First line\nSecond line", "Cancel",
			"Other", "Ok", B_WIDTH_FROM_WIDEST, B_WARNING_ALERT);
		if (message->GetBool("escape", false))
			alert->SetShortcut(0, B_ESCAPE);
		answer = alert->Go();
	}

	std::atomic<int32> answer{-2};
};

class AlertTest : public ControlWindowTest {
protected:
	void SetUp() override
	{
		fWindow = new AskingWindow;
		fWindows.push_back(fWindow);
		fWindow->Show();
		Idle();
	}

	// Asks, and returns the alert's window.
	BWindow* Ask(bool escape = false)
	{
		BMessage ask('ask ');
		ask.AddBool("escape", escape);
		fWindow->PostMessage(&ask);
		Idle();
		std::vector<BPrivate::Headless::WindowInfo> alerts
			= WindowsOf(B_MODAL_APP_WINDOW_FEEL);
		EXPECT_EQ(alerts.size(), 1u);
		return alerts.empty() ? nullptr : const_cast<BWindow*>(alerts[0].window);
	}

	AskingWindow* fWindow;
};

TEST_F(AlertTest, EnterAnswersWithTheLastButton)
{
	BWindow* alert = Ask();
	ASSERT_NE(alert, nullptr);
	EXPECT_EQ(fWindow->answer, -2);
	// The asking window still shows its last frame meanwhile.
	EXPECT_EQ(Pixel(fWindow, 10, 10), make_color(255, 255, 255));
	Key(alert, "\n");
	Idle();
	EXPECT_EQ(fWindow->answer, 2);
	EXPECT_TRUE(WindowsOf(B_MODAL_APP_WINDOW_FEEL).empty());
}

TEST_F(AlertTest, AClickAnswersWithItsButtonAndEscapeNeedsAShortcut)
{
	BWindow* alert = Ask();
	ASSERT_NE(alert, nullptr);
	Key(alert, "\x1b", 1);
	Idle();
	EXPECT_EQ(fWindow->answer, -2);
	BRect cancel;
	ASSERT_TRUE(alert->Lock());
	cancel = static_cast<BAlert*>(alert)->ButtonAt(0)->Frame();
	alert->Unlock();
	Click(alert, BPoint(cancel.left + 10, cancel.top + 10));
	Idle();
	EXPECT_EQ(fWindow->answer, 0);

	alert = Ask(true);
	ASSERT_NE(alert, nullptr);
	Key(alert, "\x1b", 1);
	Idle();
	EXPECT_EQ(fWindow->answer, 0);
}

TEST_F(AlertTest, LaysOutTextLinesButtonsAndIcon)
{
	BAlert* alert = new BAlert("", "One\nTwo", "A", "Longer label", "Ok",
		B_WIDTH_FROM_WIDEST, B_OFFSET_SPACING, B_INFO_ALERT);
	EXPECT_EQ(alert->TextView()->CountLines(), 2);
	EXPECT_EQ(alert->ButtonAt(3), nullptr);
	BRect a = alert->ButtonAt(0)->Frame();
	BRect longer = alert->ButtonAt(1)->Frame();
	BRect ok = alert->ButtonAt(2)->Frame();
	// As wide as the widest, the default one with its ring; right to left
	// with the first set apart.
	EXPECT_EQ(a.Width(), longer.Width());
	EXPECT_TRUE(alert->ButtonAt(2)->IsDefault());
	EXPECT_EQ(ok.right, alert->Bounds().right - 10);
	EXPECT_GT(longer.left - a.right, ok.left - longer.right);
	EXPECT_GT(ok.top, alert->TextView()->Frame().bottom);
	BPoint position = BAlert::AlertPosition(alert->Frame().Width() + 1,
		alert->Frame().Height() + 1);
	EXPECT_EQ(alert->Frame().LeftTop(), position);

	// The info icon is a blue disc on the stripe.
	BMessenger messenger(alert);
	EXPECT_EQ(alert->Go(new BInvoker(new BMessage('done'), fWindow)), B_OK);
	Idle();
	EXPECT_EQ(Pixel(alert, 22, 22), make_color(0, 90, 200));
	Key(alert, "\n");
	Idle();
	EXPECT_FALSE(messenger.IsValid());
	ASSERT_EQ(fWindow->recorder.Count('done'), 1);
	EXPECT_EQ(fWindow->recorder.Messages()[0].GetInt32("which", -1), 2);
}

}
