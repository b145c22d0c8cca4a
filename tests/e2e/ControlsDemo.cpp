// Two windows with the controls a user meets in the program: a menu bar, a
// pop-up menu, a drag to the other window and an alert. Each outcome is
// printed on a line of its own for the driving script (controls.sh).
//   controls_demo     run it; quit from the Files menu

#include <cstdio>

#include <Alert.h>
#include <Application.h>
#include <Bitmap.h>
#include <Button.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>
#include <View.h>
#include <Window.h>

namespace {

constexpr uint32 kAsk = 'ask ';

void Report(const char* format, const char* what, BPoint where = BPoint(-1, -1))
{
	printf(format, what, int(where.x), int(where.y));
	printf("\n");
	fflush(stdout);
}

// The top half opens a pop-up menu; the bottom half starts a drag.
class ActionView : public BView {
public:
	ActionView(BRect frame) : BView(frame, "actions", B_FOLLOW_ALL, B_WILL_DRAW)
	{
		SetViewColor(205, 205, 205);
	}

	void Draw(BRect) override
	{
		SetHighColor(0, 0, 0);
		StrokeLine(BPoint(0, 50), BPoint(Bounds().right, 50));
		DrawString("Menu here", BPoint(10, 30));
		DrawString("Drag from here", BPoint(10, 80));
	}

	void MouseDown(BPoint where) override
	{
		if (where.y >= 50) {
			BBitmap* image = new BBitmap(BRect(0, 0, 39, 15), B_RGB32);
			uint32* bits = static_cast<uint32*>(image->Bits());
			for (int32 i = 0; i < image->BitsLength() / 4; i++)
				bits[i] = 0xff3060c0;
			BMessage drag('move');
			DragMessage(&drag, image, BPoint(-18, -10));
			return;
		}
		BPopUpMenu* menu = new BPopUpMenu("popup", false, false);
		menu->AddItem(new BMenuItem("First", new BMessage('frst')));
		menu->AddItem(new BMenuItem("Second", new BMessage('scnd')));
		menu->SetTargetForItems(this);
		BPoint screen = ConvertToScreen(where);
		BMenuItem* chosen = menu->Go(screen, true, true,
			BRect(screen - BPoint(5, 5), screen + BPoint(5, 5)));
		Report("popup returned %s", chosen != nullptr ? chosen->Label() : "nothing");
		delete menu;
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what == 'frst' || message->what == 'scnd')
			Report("popup message %s", message->what == 'frst' ? "First" : "Second");
		else
			BView::MessageReceived(message);
	}
};

class DropView : public BView {
public:
	DropView(BRect frame) : BView(frame, "drop", B_FOLLOW_ALL, B_WILL_DRAW)
	{
		SetViewColor(230, 230, 230);
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->WasDropped())
			Report("dropped %s at %d,%d", message->what == 'move' ? "move" : "?",
				message->DropPoint());
		else
			BView::MessageReceived(message);
	}
};

class DemoWindow : public BWindow {
public:
	DemoWindow()
		: BWindow(BRect(40, 30, 339, 229), "Controls demo", B_TITLED_WINDOW_LOOK,
			B_NORMAL_WINDOW_FEEL, B_NOT_RESIZABLE)
	{
		BMenuBar* bar = new BMenuBar(Bounds(), "bar");
		BMenu* files = new BMenu("Files");
		files->AddItem(new BMenuItem("Open", new BMessage('open'), 'O'));
		files->AddItem(new BMenuItem("Rename", new BMessage('arnm'), 'R'));
		files->AddSeparatorItem();
		files->AddItem(new BMenuItem("Quit", new BMessage(B_QUIT_REQUESTED), 'Q'));
		bar->AddItem(files);
		AddChild(bar);
		AddChild(new ActionView(BRect(0, 20, 299, 129)));
		AddChild(new BButton(BRect(10, 150, 99, 179), "ask", "Ask", new BMessage(kAsk)));
	}

	void MessageReceived(BMessage* message) override
	{
		switch (message->what) {
			case 'open':
			case 'arnm':
				Report("menu %s", message->what == 'open' ? "Open" : "Rename");
				break;
			case kAsk:
			{
				BAlert* alert = new BAlert("Question", "Keep going?\nSay yes.", "No", "Yes");
				Report("alert answered %s", alert->Go() == 1 ? "Yes" : "No");
				break;
			}
			default:
				BWindow::MessageReceived(message);
				break;
		}
	}

	bool QuitRequested() override
	{
		be_app->PostMessage(B_QUIT_REQUESTED);
		return true;
	}
};

}

int main()
{
	BApplication application("application/x-vnd.Varnel-controls-demo");
	(new DemoWindow)->Show();
	BWindow* target = new BWindow(BRect(400, 30, 599, 229), "Drop target",
		B_TITLED_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL, B_NOT_RESIZABLE);
	target->AddChild(new DropView(target->Bounds()));
	target->Show();
	application.Run();
	return 0;
}
