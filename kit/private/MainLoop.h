#ifndef KIT_PRIVATE_MAIN_LOOP_H
#define KIT_PRIVATE_MAIN_LOOP_H

#include <SupportDefs.h>

class BApplication;
class BLooper;

namespace BPrivate {

// How BApplication::Run drives the main thread. Without a display the
// application simply runs its message loop; the display layer installs a
// main loop of its own (the SDL event pump) that also dispatches the
// application's messages. Installed before Run, typically when the first
// window or screen is created.
class MainLoop {
public:
	virtual ~MainLoop() = default;
	// Runs in the main thread until the application quits. It dispatches the
	// application's messages with DispatchApplicationMessages.
	virtual void Run(BApplication* app) = 0;
	// Called from any thread whenever a message is posted to the application,
	// so that a main loop blocked waiting for display events wakes up.
	virtual void Wake() = 0;
};

// Ownership passes to the kit; NULL restores the plain message loop.
void SetMainLoop(MainLoop* loop);
MainLoop* CurrentMainLoop();

// Dispatches the application's queued messages, waiting at most timeout for
// the first one. Returns false once the application has been asked to quit
// (its loop must then return).
bool DispatchApplicationMessages(BApplication* app, bigtime_t timeout);

// Test support: waits until every looper's queue is empty and no looper is
// dispatching (a looper blocked in a modal wait, see ModalWaitScope, counts
// as idle). Returns false on timeout.
bool WaitForIdleLoopers(bigtime_t timeout);

// Marks the calling looper thread as blocked in a synchronous modal call
// (BAlert::Go, BPopUpMenu::Go, a copy engine) for the idle wait above.
class ModalWaitScope {
public:
	ModalWaitScope();
	~ModalWaitScope();
	ModalWaitScope(const ModalWaitScope&) = delete;
	ModalWaitScope& operator=(const ModalWaitScope&) = delete;
};

}

#endif
