// Temporary folders, a private home and a recorder of volume events for the
// Storage Kit tests.

#ifndef STORAGE_TEST_SUPPORT_H
#define STORAGE_TEST_SUPPORT_H

#include <condition_variable>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <mutex>
#include <optional>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

#include <gtest/gtest.h>

#include <AppDefs.h>
#include <Looper.h>
#include <Message.h>
#include <NodeMonitor.h>

#include "VolumeTable.h"

namespace StorageTest {

// A fresh folder under /tmp, removed with everything in it.
class Scratch {
public:
	Scratch()
	{
		char pattern[] = "/tmp/varnel-storage-XXXXXX";
		fPath = mkdtemp(pattern);
	}

	~Scratch()
	{
		std::error_code ignored;
		std::filesystem::remove_all(fPath, ignored);
	}

	const std::string& Path() const { return fPath; }

	std::string operator/(const std::string& relative) const
	{
		return fPath + "/" + relative;
	}

	std::string Folder(const std::string& relative) const
	{
		std::filesystem::create_directories(*this / relative);
		return *this / relative;
	}

	std::string File(const std::string& relative,
		const std::string& content = "") const
	{
		std::ofstream(*this / relative, std::ios::binary) << content;
		return *this / relative;
	}

private:
	std::string fPath;
};

inline std::string Contents(const std::string& path)
{
	std::ifstream file(path, std::ios::binary);
	return std::string(std::istreambuf_iterator<char>(file), {});
}

inline bool Exists(const std::string& path)
{
	struct stat st;
	return lstat(path.c_str(), &st) == 0;
}

// HOME and the XDG folders inside a scratch folder for the test's life.
class PrivateHome {
public:
	PrivateHome()
	{
		_Set("HOME", fRoot.Folder("home"));
		_Set("XDG_DATA_HOME", fRoot.Folder("home/.local/share"));
		_Set("XDG_CONFIG_HOME", fRoot.Folder("home/.config"));
	}

	~PrivateHome()
	{
		for (auto saved = fSaved.rbegin(); saved != fSaved.rend(); saved++) {
			if (saved->second.has_value())
				setenv(saved->first.c_str(), saved->second->c_str(), 1);
			else
				unsetenv(saved->first.c_str());
		}
	}

	const Scratch& Root() const { return fRoot; }
	std::string Home() const { return fRoot / "home"; }

private:
	void _Set(const char* name, const std::string& value)
	{
		const char* old = getenv(name);
		fSaved.emplace_back(name, old != nullptr
			? std::optional<std::string>(old) : std::nullopt);
		setenv(name, value.c_str(), 1);
	}

	Scratch fRoot;
	std::vector<std::pair<std::string, std::optional<std::string>>> fSaved;
};

// A replaced volume table for the test's life.
class FakeVolumes {
public:
	explicit FakeVolumes(const std::vector<BPrivate::VolumeEntry>& volumes)
	{
		EXPECT_EQ(B_OK, BPrivate::VolumeTable::Default().Replace(volumes));
	}

	~FakeVolumes() { BPrivate::VolumeTable::Default().UseSystem(); }
};

inline BPrivate::VolumeEntry Volume(dev_t device, const std::string& root,
	const std::string& name, uint32 flags = 0, bool boot = false)
{
	BPrivate::VolumeEntry volume;
	volume.device = device;
	volume.root = root;
	volume.name = name;
	volume.fsName = "ext4";
	volume.flags = flags;
	volume.boot = boot;
	return volume;
}

// A running looper that keeps the B_NODE_MONITOR messages it gets.
class EventRecorder : public BLooper {
public:
	struct Event {
		int32 opcode;
		int32 device;
	};

	EventRecorder() : BLooper("event recorder") { Run(); }

	void MessageReceived(BMessage* message) override
	{
		if (message->what != B_NODE_MONITOR) {
			BLooper::MessageReceived(message);
			return;
		}
		Event event = {};
		message->FindInt32("opcode", &event.opcode);
		message->FindInt32(event.opcode == B_DEVICE_MOUNTED
			? "new device" : "device", &event.device);
		std::lock_guard<std::mutex> locker(fLock);
		fEvents.push_back(event);
		fChanged.notify_all();
	}

	// Waits (at most a generous while) for an event like that.
	bool WaitFor(int32 opcode, dev_t device)
	{
		std::unique_lock<std::mutex> locker(fLock);
		return fChanged.wait_for(locker, std::chrono::seconds(20), [&] {
			for (const Event& event : fEvents) {
				if (event.opcode == opcode
					&& event.device == static_cast<int32>(device))
					return true;
			}
			return false;
		});
	}

	std::vector<Event> Events()
	{
		std::lock_guard<std::mutex> locker(fLock);
		return fEvents;
	}

	// Quits and deletes the looper.
	void Stop()
	{
		Lock();
		Quit();
	}

private:
	std::mutex fLock;
	std::condition_variable fChanged;
	std::vector<Event> fEvents;
};

}

#endif
