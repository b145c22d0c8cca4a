#include "GvAboutWindow.h"

#include "GvAboutView.h"

GvAboutWindow::GvAboutWindow(BRect frame)
	: BWindow(frame, "", B_MODAL_WINDOW_LOOK, B_FLOATING_APP_WINDOW_FEEL,
		B_NOT_RESIZABLE | B_NOT_ZOOMABLE, B_CURRENT_WORKSPACE)
{
	aboutView = new GvAboutView(Bounds());
	aboutView->SetViewColor(205, 205, 205);
	AddChild(aboutView);
}
