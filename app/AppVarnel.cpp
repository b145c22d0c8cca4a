#include "AppVarnel.h"

#include "GvAboutWindow.h"
#include "GvWindow.h"

const char* const kVarnelSignature = "application/x-vnd.Quillmoor.Varnel-2";

AppVarnel::AppVarnel()
	: BApplication(kVarnelSignature)
{
	const char* title = GvWindow::IsSmallScreen() ? "Varnel II" : "Varnel";
	mainWindow = new GvWindow(GvWindow::FrameForScreen(), title);
	mainWindow->Show();
}

void AppVarnel::AboutRequested()
{
	GvAboutWindow* about = new GvAboutWindow(BRect(250, 200, 550, 420));
	about->SetTitle("About Varnel...");
	about->Show();
}
