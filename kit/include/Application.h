#ifndef _APPLICATION_H
#define _APPLICATION_H

#include <AppDefs.h>
#include <Looper.h>
#include <Messenger.h>

struct app_info;
class BWindow;

namespace BPrivate {
struct ApplicationData;
}

// The program's application object; there is one at a time (be_app). Run()
// runs in the calling (main) thread, which also drives the display, and
// starts with B_READY_TO_RUN (ReadyToRun), posted at construction. Quit, from
// any thread, makes Run return after the current message; the object is not
// deleted, as it belongs to main. B_ABOUT_REQUESTED calls AboutRequested.
// The default QuitRequested asks each window to quit and quits those that
// agree; the first that refuses keeps the application running.
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

private:
	std::unique_ptr<BPrivate::ApplicationData> fAppData;
};

extern BApplication* be_app;
extern BMessenger be_app_messenger;

#endif
