#ifndef KIT_INTERFACE_AUTO_REPEAT_H
#define KIT_INTERFACE_AUTO_REPEAT_H

#include <condition_variable>
#include <mutex>
#include <thread>

#include <Message.h>
#include <Messenger.h>

namespace BPrivate {

// Sends a message again and again while a button is held: first after a
// delay, then at a steady interval, until stopped or destroyed.
class AutoRepeat {
public:
	AutoRepeat(BMessenger target, uint32 what, bigtime_t delay = 300000,
		bigtime_t interval = 50000);
	~AutoRepeat();
	AutoRepeat(const AutoRepeat&) = delete;
	AutoRepeat& operator=(const AutoRepeat&) = delete;

private:
	void _Run(BMessenger target, uint32 what, bigtime_t delay, bigtime_t interval);

	std::mutex fLock;
	std::condition_variable fStopped;
	bool fStop = false;
	std::thread fThread;
};

}

#endif
