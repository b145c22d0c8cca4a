#include "CopyWindow.h"

#include <Directory.h>
#include <Entry.h>
#include <Message.h>
#include <StatusBar.h>
#include <View.h>

#include <cstdio>

#include "Look.h"

namespace {
// The raw key of Escape.
const int32 kEscapeKey = 1;
}

CopyWindow::CopyWindow(BRect frame)
	: BWindow(frame, "", B_MODAL_WINDOW_LOOK, B_MODAL_APP_WINDOW_FEEL, B_NOT_RESIZABLE,
		B_CURRENT_WORKSPACE),
	  cancel(false),
	  itemsRemaining(0)
{
	backgroundView = new BView(Bounds(), "", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	backgroundView->SetViewColor(GV_GREY);
	BRect barFrame = Bounds();
	barFrame.InsetBy(20, 20);
	barFrame.OffsetBy(0, -10);
	bar = new BStatusBar(barFrame, "bar", "Copying: ", " items remaining");
	backgroundView->AddChild(bar);
	AddChild(backgroundView);
	Show();
}

CopyWindow::~CopyWindow()
{
}

void CopyWindow::MessageReceived(BMessage* message)
{
	if (message->what == B_KEY_DOWN && message->GetInt32("key", 0) == kEscapeKey) {
		cancel = true;
		return;
	}
	BWindow::MessageReceived(message);
}

int64 CopyWindow::CountEntries(const entry_ref* folder)
{
	BDirectory directory(folder);
	if (directory.InitCheck() != B_OK)
		return 0;
	int64 count = 0;
	entry_ref ref;
	while (directory.GetNextRef(&ref) == B_OK) {
		count++;
		struct stat st;
		if (directory.GetStatFor(ref.name, &st) == B_OK && S_ISDIR(st.st_mode))
			count += CountEntries(&ref);
	}
	return count;
}

void CopyWindow::ShowItem(const char* name)
{
	itemsRemaining--;
	char remaining[16];
	std::snprintf(remaining, sizeof(remaining), "%lu",
		static_cast<unsigned long>(itemsRemaining));
	if (Lock()) {
		bar->SetText(name);
		bar->SetTrailingText(remaining);
		Unlock();
	}
}

void CopyWindow::Advance(float delta)
{
	BMessage update(B_UPDATE_STATUS_BAR);
	update.AddFloat("delta", delta);
	PostMessage(&update, bar);
}
