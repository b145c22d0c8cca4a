#include "GvAboutWindow.h"

#include "GvAboutView.h"
#include "Look.h"

GvAboutWindow::GvAboutWindow(BRect frame)
	: BWindow(frame, "", B_MODAL_WINDOW_LOOK, B_FLOATING_APP_WINDOW_FEEL,
		B_NOT_RESIZABLE | B_NOT_ZOOMABLE, B_CURRENT_WORKSPACE)
{
	aboutView = new GvAboutView(Bounds());
	aboutView->SetViewColor(GV_GREY);
	AddChild(aboutView);
}
