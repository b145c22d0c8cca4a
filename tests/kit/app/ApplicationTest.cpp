#include <gtest/gtest.h>

#include <atomic>
#include <climits>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include <unistd.h>

#include <Application.h>
#include <Entry.h>
#include <Path.h>
#include <Roster.h>

#include "MainLoop.h"
#include "Recorder.h"
#include "RosterPrivate.h"

namespace {

constexpr char kSignature[] = "application/x-vnd.Varnel-KitTest";

// Logs every hook it sees as a message with the hook's code.
class TestApp : public BApplication {
public:
	TestApp() : BApplication(kSignature) {}

	void ReadyToRun() override { log.Add(BMessage(B_READY_TO_RUN)); }
	void AboutRequested() override { log.Add(BMessage(B_ABOUT_REQUESTED)); }
	void AppActivated(bool active) override
	{
		BMessage activated(B_APP_ACTIVATED);
		activated.AddBool("active", active);
		log.Add(activated);
	}
	void ArgvReceived(int32 argc, char** argv) override
	{
		BMessage arguments(B_ARGV_RECEIVED);
		for (int32 i = 0; i < argc; i++)
			arguments.AddString("argv", argv[i]);
		log.Add(arguments);
	}
	bool QuitRequested() override
	{
		log.Add(BMessage(B_QUIT_REQUESTED));
		return agree;
	}
	void MessageReceived(BMessage* message) override { log.Add(*message); }

	MessageLog log;
	std::atomic<bool> agree{true};
};

std::vector<uint32> Codes(const MessageLog& log)
{
	std::vector<uint32> codes;
	for (const BMessage& message : log.Messages())
		codes.push_back(message.what);
	return codes;
}

class TemporaryFolder {
public:
	TemporaryFolder()
	{
		char pattern[] = "/tmp/varnel-app-test-XXXXXX";
		fPath = mkdtemp(pattern);
	}
	~TemporaryFolder() { std::filesystem::remove_all(fPath); }

	std::string Create(const std::string& name) const
	{
		const std::string path = fPath + "/" + name;
		std::ofstream(path) << "data";
		return path;
	}
	const std::string& Path() const { return fPath; }

private:
	std::string fPath;
};

entry_ref RefFor(const std::string& path)
{
	entry_ref ref;
	EXPECT_EQ(B_OK, get_ref_for_path(path.c_str(), &ref));
	return ref;
}

}

TEST(Application, RunStartsReadyAndEndsAfterTheQuitRequest)
{
	{
		TestApp app;
		EXPECT_EQ(&app, be_app);
		EXPECT_EQ(B_OK, app.InitCheck());
		EXPECT_STREQ(kSignature, app.Signature());
		app.PostMessage(B_ABOUT_REQUESTED);
		BMessage arguments(B_ARGV_RECEIVED);
		arguments.AddString("argv", "varnel");
		arguments.AddString("argv", "it's \"odd\"");
		app.PostMessage(&arguments);
		app.PostMessage('cust');
		app.PostMessage(B_QUIT_REQUESTED);
		app.PostMessage('late');

		EXPECT_EQ(find_thread(NULL), app.Run());
		EXPECT_EQ((std::vector<uint32>{B_READY_TO_RUN, B_ABOUT_REQUESTED, B_ARGV_RECEIVED,
			'cust', B_QUIT_REQUESTED}), Codes(app.log));
		const char* argument = nullptr;
		const std::vector<BMessage> handled = app.log.Messages();
		handled[2].FindString("argv", 1, &argument);
		EXPECT_STREQ("it's \"odd\"", argument);
		// Run is over: the application takes no more messages, yet lives on.
		EXPECT_EQ(B_BAD_PORT_ID, app.PostMessage('more'));
		EXPECT_EQ(&app, be_app);
	}
	EXPECT_EQ(nullptr, be_app);
	EXPECT_FALSE(be_app_messenger.IsValid());
}

TEST(Application, OtherThreadsAskAndTellItToQuit)
{
	TestApp app;
	app.agree = false;
	BMessage answer;
	std::thread other([&] {
		ASSERT_TRUE(app.log.WaitForCount(1));
		// Refused: the application keeps running.
		ASSERT_EQ(B_OK, be_app_messenger.SendMessage(B_QUIT_REQUESTED, &answer));
		be_app->Quit();
	});
	app.Run();
	other.join();
	EXPECT_FALSE(answer.GetBool("result", true));
	EXPECT_EQ((std::vector<uint32>{B_READY_TO_RUN, B_QUIT_REQUESTED}), Codes(app.log));
}

TEST(Application, BadSignatureOrSecondApplicationFailsInitCheck)
{
	for (const char* bad : {"text/plain", "application/", "application/x vnd", "application/a/b"}) {
		status_t status;
		BApplication app(bad, &status);
		EXPECT_EQ(B_BAD_VALUE, status) << bad;
		EXPECT_EQ(B_BAD_VALUE, app.Run());
	}
	TestApp first;
	status_t status;
	BApplication second(kSignature, &status);
	EXPECT_EQ(B_NOT_ALLOWED, status);
	EXPECT_EQ(&first, be_app);
}

TEST(Application, AnInstalledMainLoopRunsTheApplication)
{
	class CountingLoop : public BPrivate::MainLoop {
	public:
		void Run(BApplication* app) override
		{
			runs++;
			while (BPrivate::DispatchApplicationMessages(app, B_INFINITE_TIMEOUT)) {
			}
		}
		void Wake() override { wakes++; }

		std::atomic<int> runs{0};
		std::atomic<int> wakes{0};
	};
	auto* loop = new CountingLoop;
	BPrivate::SetMainLoop(loop);
	{
		TestApp app;
		app.PostMessage(B_QUIT_REQUESTED);
		app.Run();
		EXPECT_EQ(1, loop->runs);
		// B_READY_TO_RUN and the quit request both woke the loop.
		EXPECT_GE(loop->wakes, 2);
		EXPECT_EQ(2u, app.log.Count());
	}
	BPrivate::SetMainLoop(NULL);
	EXPECT_EQ(nullptr, BPrivate::CurrentMainLoop());
}

TEST(Application, AppInfoNamesTheRunningExecutable)
{
	TestApp app;
	app_info info;
	ASSERT_EQ(B_OK, app.GetAppInfo(&info));
	EXPECT_STREQ(kSignature, info.signature);
	EXPECT_EQ(getpid(), info.team);
	char executable[PATH_MAX];
	ASSERT_NE(nullptr, realpath("/proc/self/exe", executable));
	BPath path(&info.ref);
	EXPECT_STREQ(executable, path.Path());

	// Only this program is known to the roster.
	EXPECT_EQ(getpid(), be_roster->TeamFor(kSignature));
	EXPECT_EQ(getpid(), be_roster->TeamFor(&info.ref));
	EXPECT_TRUE(be_roster->IsRunning(kSignature));
	EXPECT_EQ(B_ERROR, be_roster->TeamFor("application/x-vnd.Other"));
	EXPECT_FALSE(be_roster->IsRunning("application/x-vnd.Other"));
	app_info running;
	EXPECT_EQ(B_OK, be_roster->GetRunningAppInfo(getpid(), &running));
	EXPECT_EQ(info.ref, running.ref);
	EXPECT_EQ(B_BAD_TEAM_ID, be_roster->GetRunningAppInfo(getpid() + 1, &running));
	EXPECT_EQ(B_BAD_TEAM_ID, be_roster->ActivateApp(getpid() + 1));

	ASSERT_EQ(B_OK, be_roster->ActivateApp(getpid()));
	app.PostMessage(B_QUIT_REQUESTED);
	app.Run();
	ASSERT_EQ(3u, app.log.Count());
	EXPECT_EQ(uint32(B_APP_ACTIVATED), app.log.Messages()[1].what);
	EXPECT_TRUE(app.log.Messages()[1].GetBool("active"));
}

TEST(Roster, LaunchGoesToTheTestHookAndNeverStartsAnything)
{
	TemporaryFolder folder;
	const std::string file = folder.Create("it's a $HOME `file`\n.txt");
	std::vector<std::string> launched;
	status_t answer = B_OK;
	BPrivate::SetLaunchHook([&](const char* path) {
		launched.push_back(path);
		return answer;
	});

	entry_ref ref = RefFor(file);
	EXPECT_EQ(B_OK, be_roster->Launch(&ref));
	entry_ref folderRef = RefFor(folder.Path());
	EXPECT_EQ(B_OK, be_roster->Launch(&folderRef));
	answer = B_LAUNCH_FAILED;
	EXPECT_EQ(B_LAUNCH_FAILED, be_roster->Launch("text/plain"));
	answer = B_OK;
	const char* link[] = { "mailto:someone@example.org" };
	EXPECT_EQ(B_OK, be_roster->Launch("application/x-vnd.Be.URL.mailto", 1, link));
	EXPECT_EQ((std::vector<std::string>{file, folder.Path(), "text/plain",
		"application/x-vnd.Be.URL.mailto mailto:someone@example.org"}), launched);
	EXPECT_EQ(B_BAD_VALUE, be_roster->Launch("text/plain", 1, NULL));

	// Nothing there: refused before anything is started.
	entry_ref missing = RefFor(folder.Path() + "/missing");
	EXPECT_EQ(B_ENTRY_NOT_FOUND, be_roster->Launch(&missing));
	EXPECT_EQ(B_BAD_VALUE, be_roster->Launch(static_cast<const entry_ref*>(NULL)));
	EXPECT_EQ(4u, launched.size());
	BPrivate::SetLaunchHook(nullptr);
}

TEST(Roster, LaunchLogCollectsPathsForWholeProgramTests)
{
	TemporaryFolder folder;
	const std::string first = folder.Create("first");
	const std::string second = folder.Create("second \"two\"");
	const std::string log = folder.Path() + "/launch.log";
	setenv("VARNEL_LAUNCH_LOG", log.c_str(), 1);

	entry_ref ref = RefFor(first);
	EXPECT_EQ(B_OK, be_roster->Launch(&ref));
	ref = RefFor(second);
	EXPECT_EQ(B_OK, be_roster->Launch(&ref));
	std::stringstream written;
	written << std::ifstream(log).rdbuf();
	EXPECT_EQ(first + "\n" + second + "\n", written.str());

	// A log that cannot be written is a failed launch, not a real one.
	setenv("VARNEL_LAUNCH_LOG", (folder.Path() + "/no/such/log").c_str(), 1);
	EXPECT_EQ(B_LAUNCH_FAILED, be_roster->Launch(&ref));
	unsetenv("VARNEL_LAUNCH_LOG");
}
