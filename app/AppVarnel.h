#ifndef APP_VARNEL_H
#define APP_VARNEL_H

#include <Application.h>

class GvWindow;

extern const char* const kVarnelSignature;

class AppVarnel : public BApplication {
public:
	AppVarnel();

	virtual void AboutRequested();

	// Shown for the program's whole life; the window list owns it.
	GvWindow* mainWindow;
};

#endif
