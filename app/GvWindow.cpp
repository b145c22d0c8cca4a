#include "GvWindow.h"

#include <Application.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Messenger.h>
#include <Screen.h>

#include "Commands.h"
#include "GvFilesView.h"
#include "GvScrollView.h"
#include "GvTreeView.h"
#include "Look.h"

namespace {

struct Layout {
	BRect windowFrame;
	float treeRight;
	float paneBottom;
	float filesWidth;
};

const Layout kLargeLayout = { BRect(60, 60, 739, 510), 200, 436, 450 };
const Layout kSmallLayout = { BRect(40, 40, 619, 440), 170, 386, 380 };

const Layout& CurrentLayout()
{
	return GvWindow::IsSmallScreen() ? kSmallLayout : kLargeLayout;
}

void SetUpPane(BView* pane)
{
	pane->SetViewColor(GV_GREY);
	pane->SetLowColor(GV_GREY);
	pane->SetDrawingMode(B_OP_OVER);
}

}

GvWindow::GvWindow(BRect frame, const char* title)
	: BWindow(frame, title, B_DOCUMENT_WINDOW_LOOK, B_NORMAL_WINDOW_FEEL, 0,
		B_CURRENT_WORKSPACE)
{
	BuildMenus();
	BuildPanes();
	tree->Select(0);
	tree->MakeFocus(true);
}

bool GvWindow::IsSmallScreen()
{
	BRect screen = BScreen(B_MAIN_SCREEN_ID).Frame();
	return screen.right - screen.left <= 640;
}

BRect GvWindow::FrameForScreen()
{
	return CurrentLayout().windowFrame;
}

void GvWindow::BuildMenus()
{
	BRect barFrame = Bounds();
	barFrame.bottom = 19;
	menuBar = new BMenuBar(barFrame, "", B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP,
		B_ITEMS_IN_ROW, true);

	filesMenu = new BMenu("Files", B_ITEMS_IN_COLUMN);
	filesMenu->AddItem(new BMenuItem("Open", new BMessage(GV_OPEN), 'O', B_COMMAND_KEY));
	filesMenu->AddItem(new BMenuItem("Rename", new BMessage(GV_ASK_RENAME), 'R',
		B_COMMAND_KEY));
	filesMenu->AddItem(new BMenuItem("Move to trash", new BMessage(GV_DELETE), 'T',
		B_COMMAND_KEY));
	filesMenu->AddSeparatorItem();
	filesMenu->AddItem(new BMenuItem("Create a new folder", new BMessage(GV_NEW_FOLDER),
		'N', B_COMMAND_KEY));
	filesMenu->AddSeparatorItem();
	filesMenu->AddItem(new BMenuItem("Empty Trash", new BMessage(GV_EMPTY_TRASH)));
	filesMenu->AddSeparatorItem();
	filesMenu->AddItem(new BMenuItem("Quit", new BMessage(B_QUIT_REQUESTED), 'Q',
		B_COMMAND_KEY));
	filesMenu->SetTargetForItems(this);

	BMenu* helpMenu = new BMenu("Help", B_ITEMS_IN_COLUMN);
	BMenuItem* helpItem = new BMenuItem("Some Help ?", new BMessage(GV_HELP), 'H',
		B_COMMAND_KEY);
	helpItem->SetTarget(this);
	helpMenu->AddItem(helpItem);
	BMenuItem* aboutItem = new BMenuItem("About Varnel...",
		new BMessage(B_ABOUT_REQUESTED), 'B', B_COMMAND_KEY);
	aboutItem->SetTarget(be_app);
	helpMenu->AddItem(aboutItem);

	menuBar->AddItem(filesMenu);
	menuBar->AddItem(helpMenu);
}

void GvWindow::BuildPanes()
{
	const Layout& layout = CurrentLayout();

	tree = new GvTreeView(BRect(0, 19, layout.treeRight, layout.paneBottom), "");
	SetUpPane(tree);
	GvScrollView* treeFrame = new GvScrollView("Folders", tree,
		B_FOLLOW_LEFT | B_FOLLOW_TOP_BOTTOM);

	float filesLeft = treeFrame->Frame().right + 1;
	fileList = new GvFilesView(
		BRect(filesLeft, 19, filesLeft + layout.filesWidth, layout.paneBottom), "");
	SetUpPane(fileList);
	GvScrollView* filesFrame = new GvScrollView("Files", fileList, B_FOLLOW_ALL);

	AddChild(menuBar);
	AddChild(treeFrame);
	AddChild(filesFrame);

	tree->filesMessenger = new BMessenger(fileList);
	fileList->treeMessenger = new BMessenger(tree);
}
