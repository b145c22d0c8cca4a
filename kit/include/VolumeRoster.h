#ifndef _VOLUME_ROSTER_H
#define _VOLUME_ROSTER_H

#include <Application.h>
#include <Messenger.h>

class BVolume;

// The mounted volumes, and a watch on mounts and unmounts. A watcher gets
// B_NODE_MONITOR messages: "opcode" B_DEVICE_MOUNTED with "new device" (the
// new volume), or "opcode" B_DEVICE_UNMOUNTED with "device", all int32. They
// are sent from the thread that noticed the change. The watch lasts until
// StopWatching or the roster's destruction.
class BVolumeRoster {
public:
	BVolumeRoster();
	virtual ~BVolumeRoster();

	status_t GetNextVolume(BVolume* volume);
	void Rewind();
	status_t GetBootVolume(BVolume* volume);

	status_t StartWatching(BMessenger messenger = be_app_messenger);
	void StopWatching();
	BMessenger Messenger() const;

private:
	BVolumeRoster(const BVolumeRoster&) = delete;
	BVolumeRoster& operator=(const BVolumeRoster&) = delete;

	int32 fCookie;
	int32 fWatchToken;
	BMessenger fTarget;
};

#endif
