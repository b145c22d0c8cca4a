#include "GvAboutView.h"

#include <AppFileInfo.h>
#include <Application.h>
#include <Bitmap.h>
#include <Button.h>
#include <File.h>
#include <Font.h>
#include <Message.h>
#include <Roster.h>

#include <cstdio>

#include "GvTargetView.h"

const char* const kVarnelAuthor = "The Varnel developers";
const char* const kVarnelMail = "varnel@quillmoor.org";
const char* const kVarnelRights = "Copyright 2026 The Varnel developers.";

namespace {
const rgb_color kBlack = { 0, 0, 0, 255 };
const rgb_color kBlue = { 0, 0, 255, 255 };
const rgb_color kRed = { 255, 0, 0, 255 };
const char* const kProductName = "Varnel";
// The platform's type of a mailto: link, handled by the desktop's mail program.
const char* const kMailtoType = "application/x-vnd.Be.URL.mailto";
}

GvAboutView::GvAboutView(BRect frame)
	: BView(frame, "", B_FOLLOW_ALL, B_WILL_DRAW),
	  mailRect(0, 0, 0, 0)
{
	closeButton = new BButton(BRect(110, 170, 190, 200), "", "Amazing !",
		new BMessage(B_QUIT_REQUESTED), B_FOLLOW_BOTTOM | B_FOLLOW_H_CENTER,
		B_WILL_DRAW | B_NAVIGABLE);
	AddChild(closeButton);
	closeButton->MakeDefault(true);
}

std::string GvAboutView::VersionText(const version_info& version)
{
	char text[64];
	if (version.minor != 0) {
		std::snprintf(text, sizeof(text), "%lu.%lu.%lu",
			static_cast<unsigned long>(version.major),
			static_cast<unsigned long>(version.middle),
			static_cast<unsigned long>(version.minor));
	} else {
		std::snprintf(text, sizeof(text), "%lu.%lu",
			static_cast<unsigned long>(version.major),
			static_cast<unsigned long>(version.middle));
	}
	return text;
}

void GvAboutView::Draw(BRect)
{
	BFont textFont(be_plain_font);
	BFont titleFont(be_bold_font);
	font_family family;
	if (GvTargetView::FindDutchFamily(&family)) {
		textFont.SetFamilyAndFace(family, B_ITALIC_FACE);
		titleFont.SetFamilyAndFace(family, B_BOLD_FACE);
	}

	// Read every time: the view keeps no cache of the program's data.
	BBitmap icon(BRect(0, 0, 31, 31), B_CMAP8);
	version_info version = {};
	app_info info;
	bool haveIcon = false;
	if (be_app->GetAppInfo(&info) == B_OK) {
		BFile file(&info.ref, B_READ_ONLY);
		BAppFileInfo appFileInfo(&file);
		haveIcon = appFileInfo.GetIcon(&icon, B_LARGE_ICON) == B_OK;
		appFileInfo.GetVersionInfo(&version, B_APP_VERSION_KIND);
	}

	SetLowColor(ViewColor());

	MovePenTo(20, 20);
	SetDrawingMode(B_OP_OVER);
	if (haveIcon)
		DrawBitmap(&icon, BPoint(20, 20));

	MovePenBy(50, 28);
	titleFont.SetSize(40);
	SetFont(&titleFont, B_FONT_ALL);
	SetHighColor(kBlue);
	DrawString(kProductName, 1);
	SetHighColor(kRed);
	DrawString(kProductName + 1, 1);
	SetHighColor(kBlack);
	DrawString(kProductName + 2);

	MovePenTo(20, 80);
	textFont.SetSize(13);
	SetFont(&textFont, B_FONT_ALL);
	DrawString(VersionText(version).c_str());
	MovePenBy(15, 0);
	DrawString(" - ");
	MovePenBy(15, 0);
	DrawString(version.short_info);

	MovePenTo(20, 105);
	DrawString(kVarnelAuthor);

	MovePenTo(20, 125);
	DrawString("E-Mail : ");
	BPoint addressStart = PenLocation();
	mailRect.SetLeftTop(addressStart + BPoint(0, -12));
	BPoint underlineEnd = addressStart + BPoint(0, 3);
	SetHighColor(kBlue);
	DrawString(kVarnelMail);
	MovePenBy(0, 3);
	mailRect.SetRightBottom(PenLocation());
	StrokeLine(underlineEnd, B_SOLID_HIGH);

	MovePenTo(20, underlineEnd.y + 20);
	SetHighColor(kBlack);
	DrawString(kVarnelRights);
}

void GvAboutView::MouseDown(BPoint where)
{
	if (!mailRect.Contains(where))
		return;
	// The link goes straight to the desktop's mail handler: no shell sees it.
	std::string link = std::string("mailto:") + kVarnelMail;
	const char* arguments[] = { link.c_str() };
	be_roster->Launch(kMailtoType, 1, arguments);
}
