#ifndef GV_ABOUT_VIEW_H
#define GV_ABOUT_VIEW_H

#include <string>

#include <View.h>

class BButton;
struct version_info;

// The content of the About window. The e-mail address is drawn as a link;
// mailRect is where a click starts the mail program, set by each Draw.
class GvAboutView : public BView {
public:
	GvAboutView(BRect frame);

	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);

	// "2.0" for 2.0.0, "2.0.1" when the minor number is not 0.
	static std::string VersionText(const version_info& version);

	BRect mailRect;
	BButton* closeButton;
};

extern const char* const kVarnelAuthor;
extern const char* const kVarnelMail;
extern const char* const kVarnelRights;

#endif
