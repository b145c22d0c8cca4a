#ifndef KIT_INTERFACE_MODAL_HANDOFF_H
#define KIT_INTERFACE_MODAL_HANDOFF_H

#include <condition_variable>
#include <mutex>

namespace BPrivate {

// Ends a synchronous modal call (BAlert::Go, BPopUpMenu::Go): one thread
// waits, counting as idle if it is a looper's, until another signals from
// its own looper. The signal returns only once the waiter is awake, so that
// no moment looks idle to WaitForIdleLoopers before the call has returned.
class ModalHandoff {
public:
	void Wait();
	// Returns once the waiter is awake; call it only when someone waits.
	void Signal();

private:
	std::mutex fLock;
	std::condition_variable fChanged;
	bool fSignaled = false;
	bool fAwake = false;
};

}

#endif
