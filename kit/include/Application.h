#ifndef _APPLICATION_H
#define _APPLICATION_H

#include <Looper.h>
#include <Messenger.h>

struct app_info;
class BWindow;

// The program's application object. Run() runs in the calling (main) thread,
// which also drives the display.
class BApplication : public BLooper {
public:
	BApplication(const char* signature);
	BApplication(const char* signature, status_t* error);
	virtual ~BApplication();

	status_t InitCheck() const;

	virtual thread_id Run();
	virtual void Quit();
	virtual bool QuitRequested();

	virtual void ReadyToRun();
	virtual void ArgvReceived(int32 argc, char** argv);
	virtual void AppActivated(bool active);
	virtual void RefsReceived(BMessage* message);
	virtual void AboutRequested();
	virtual void Pulse();

	virtual void MessageReceived(BMessage* message);
	virtual void DispatchMessage(BMessage* message, BHandler* handler);

	// The windows of the program, in the order they were created.
	int32 CountWindows() const;
	BWindow* WindowAt(int32 index) const;

	// The running executable's ref, its signature, thread and team.
	status_t GetAppInfo(app_info* info) const;
	const char* Signature() const;
};

extern BApplication* be_app;
extern BMessenger be_app_messenger;

#endif
