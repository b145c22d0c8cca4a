// The whole program in this process, on the headless display: a private
// home on a boot volume of temporary folders, more volumes when a test asks,
// the application running in a thread of its own, and input posted as the
// display would post it.

#ifndef APP_FIXTURE_H
#define APP_FIXTURE_H

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <mutex>
#include <optional>
#include <string>
#include <sys/stat.h>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include <AppDefs.h>
#include <Entry.h>
#include <Looper.h>
#include <Message.h>
#include <Messenger.h>
#include <Window.h>
#include <fs_info.h>

#include "AppVarnel.h"
#include "Commands.h"
#include "FolderItem.h"
#include "GvRenView.h"
#include "GvTreeView.h"
#include "GvWindow.h"
#include "Headless.h"
#include "VolumeTable.h"

namespace AppTest {

// Keeps a copy of every message it is sent, for the file list's side of a
// test.
class MessageLog : public BLooper {
public:
	MessageLog() : BLooper("message log") { Run(); }

	void MessageReceived(BMessage* message) override
	{
		std::lock_guard<std::mutex> guard(fLock);
		fMessages.push_back(*message);
	}

	// What came since the last call, once every looper is idle.
	std::vector<BMessage> Take()
	{
		EXPECT_TRUE(BPrivate::Headless::WaitForIdle());
		std::lock_guard<std::mutex> guard(fLock);
		return std::exchange(fMessages, {});
	}

	// Quits and deletes the looper.
	void Stop()
	{
		Lock();
		Quit();
	}

private:
	std::mutex fLock;
	std::vector<BMessage> fMessages;
};

class AppFixture : public ::testing::Test {
protected:
	enum { kBootDevice = 11 };

	void SetUp() override
	{
		setenv("VARNEL_BACKEND", "headless", 0);
		char pattern[] = "/tmp/varnel-app-XXXXXX";
		ASSERT_NE(nullptr, mkdtemp(pattern));
		fRoot = pattern;
		boot = Folder("boot");
		home = Folder("boot/home");
		desktop = Folder("boot/home/Desktop");
		_SetEnv("HOME", home);
		_SetEnv("XDG_DATA_HOME", Folder("boot/home/.local/share"));
		_SetEnv("XDG_CONFIG_HOME", Folder("boot/home/.config"));
		_SetEnv("XDG_CACHE_HOME", Folder("cache"));
		trash = home + "/.local/share/Trash/files";
		AddVolume(kBootDevice, "boot", "Boot", B_FS_IS_PERSISTENT, true);
	}

	void TearDown() override
	{
		if (fApp != nullptr) {
			fApp->PostMessage(B_QUIT_REQUESTED);
			fRunner.join();
			delete fApp;
		}
		if (fLog != nullptr)
			fLog->Stop();
		BPrivate::VolumeTable::Default().UseSystem();
		for (auto saved = fSaved.rbegin(); saved != fSaved.rend(); saved++) {
			if (saved->second.has_value())
				setenv(saved->first.c_str(), saved->second->c_str(), 1);
			else
				unsetenv(saved->first.c_str());
		}
		std::error_code ignored;
		std::filesystem::remove_all(fRoot, ignored);
	}

	// A folder (with its parents) below the scratch root; its path.
	std::string Folder(const std::string& relative)
	{
		std::filesystem::create_directories(fRoot + "/" + relative);
		return fRoot + "/" + relative;
	}

	void File(const std::string& relative)
	{
		std::ofstream(fRoot + "/" + relative) << "data";
	}

	static bool Exists(const std::string& path)
	{
		struct stat st;
		return lstat(path.c_str(), &st) == 0;
	}

	// A volume whose root is the scratch folder root, for the next Start.
	void AddVolume(dev_t device, const std::string& root, const std::string& name,
		uint32 flags, bool isBoot = false)
	{
		BPrivate::VolumeEntry volume;
		volume.device = device;
		volume.root = Folder(root);
		volume.name = name;
		volume.fsName = "ext4";
		volume.flags = flags;
		volume.boot = isBoot;
		fVolumes.push_back(volume);
	}

	// Starts the program on the volumes added so far and waits until it
	// is idle, its first folder shown.
	void Start()
	{
		ASSERT_EQ(B_OK, BPrivate::VolumeTable::Default().Replace(fVolumes));
		fApp = new AppVarnel;
		window = fApp->mainWindow;
		tree = window->tree;
		fRunner = std::thread([this] { fApp->Run(); });
		Idle();
	}

	static void Idle() { ASSERT_TRUE(BPrivate::Headless::WaitForIdle()); }

	// Sends what the tree sends the file list to a log from now on.
	MessageLog* LogFileList()
	{
		fLog = new MessageLog;
		window->Lock();
		delete tree->filesMessenger;
		tree->filesMessenger = new BMessenger(fLog);
		window->Unlock();
		return fLog;
	}

	// Runs action with the window locked and returns what it returns.
	template<typename Action>
	auto Locked(Action action)
	{
		window->Lock();
		struct Unlocker {
			BWindow* window;
			~Unlocker() { window->Unlock(); }
		} unlocker{window};
		return action();
	}

	void Post(BMessage* message)
	{
		ASSERT_EQ(B_OK, window->PostMessage(message, tree));
		Idle();
	}

	// A press (and release) at where in the tree's own coordinates.
	void Click(BPoint where, uint32 buttons = B_PRIMARY_MOUSE_BUTTON, int32 clicks = 1)
	{
		BPoint point = Locked([&] { return window->ConvertFromScreen(tree->ConvertToScreen(where)); });
		ASSERT_EQ(B_OK, BPrivate::Headless::PostMouse(window, B_MOUSE_DOWN, point, buttons,
			clicks));
		ASSERT_EQ(B_OK, BPrivate::Headless::PostMouse(window, B_MOUSE_UP, point, 0, clicks));
		Idle();
	}

	void Key(const char* bytes, int32 key = 0)
	{
		ASSERT_EQ(B_OK, BPrivate::Headless::PostKey(window, bytes, key));
		Idle();
	}

	// Asks the tree to show the folder at path, as the file list does.
	void OpenInTree(const std::string& path, int32 device = kBootDevice)
	{
		BMessage open(GV_FOLDER_OPEN);
		entry_ref ref = Ref(path);
		open.AddRef(GV_SOURCE_REF, &ref);
		open.AddInt32(GV_DEVICE, device);
		Post(&open);
	}

	// A pixel of the window's last frame, at a point of view.
	rgb_color PixelOf(BView* view, BPoint point)
	{
		BPoint where = Locked([&] {
			return window->ConvertFromScreen(view->ConvertToScreen(point));
		});
		return BPrivate::Headless::PixelAt(window, int32(where.x), int32(where.y));
	}

	std::string Title()
	{
		return Locked([&] { return std::string(window->Title()); });
	}

	static entry_ref Ref(const std::string& path)
	{
		entry_ref ref;
		EXPECT_EQ(B_OK, get_ref_for_path(path.c_str(), &ref));
		return ref;
	}

	// The tree's row of the folder at path, shown or not; NULL when none.
	FolderItem* Item(const std::string& path)
	{
		entry_ref ref = Ref(path);
		return Locked([&] { return tree->FindItem(&ref); });
	}

	// The index of the tree's row of the folder at path; -1 when not shown.
	int32 IndexOf(const std::string& path)
	{
		return Locked([&] { return tree->IndexOf(Item(path)); });
	}

	// What the tree's rename editor holds; empty when it is not open.
	std::string Editor()
	{
		return Locked([&] {
			return std::string(tree->renameView->Parent() == tree
				? tree->renameView->Text() : "");
		});
	}

	// The labels of the shown rows, indented by level. Also checks that
	// lastVisible counts exactly the rows of the chain.
	std::vector<std::string> Rows()
	{
		return Locked([&] {
			std::vector<std::string> rows;
			for (FolderItem* item = tree->first; item != NULL; item = item->nextVisible) {
				char label[B_FILE_NAME_LENGTH];
				item->GetName(label);
				rows.push_back(std::string(item->level, ' ') + label);
			}
			EXPECT_EQ(int32(rows.size()) - 1, tree->lastVisible);
			return rows;
		});
	}

	std::string boot;
	std::string home;
	std::string desktop;
	std::string trash;
	GvWindow* window = nullptr;
	GvTreeView* tree = nullptr;

private:
	void _SetEnv(const char* name, const std::string& value)
	{
		const char* old = getenv(name);
		fSaved.emplace_back(name, old != nullptr
			? std::optional<std::string>(old) : std::nullopt);
		setenv(name, value.c_str(), 1);
	}

	std::string fRoot;
	std::vector<BPrivate::VolumeEntry> fVolumes;
	std::vector<std::pair<std::string, std::optional<std::string>>> fSaved;
	AppVarnel* fApp = nullptr;
	std::thread fRunner;
	MessageLog* fLog = nullptr;
};

}

#endif
