// The demo window under Xvfb with the SDL backend: the X server shows exactly
// the pixels the headless backend draws, where the window's frame says, and
// keys and clicks arrive as the platform's messages.

#include <cerrno>
#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <functional>
#include <fstream>
#include <map>
#include <spawn.h>
#include <string>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>
#include <vector>

#include <gtest/gtest.h>

extern char** environ;

namespace {

constexpr int kLeft = 40;
constexpr int kTop = 30;
constexpr int kWidth = 320;
constexpr int kHeight = 200;
constexpr int kScreenWidth = 1024;
constexpr int kScreenHeight = 768;
constexpr auto kPatience = std::chrono::seconds(20);

using Environment = std::map<std::string, std::string>;

std::vector<char*> MakeEnvironment(const Environment& changes, std::vector<std::string>& storage)
{
	Environment merged;
	for (char** entry = environ; *entry != nullptr; entry++) {
		std::string text(*entry);
		size_t equals = text.find('=');
		if (equals != std::string::npos)
			merged[text.substr(0, equals)] = text.substr(equals + 1);
	}
	for (const auto& change : changes) {
		if (change.second.empty())
			merged.erase(change.first);
		else
			merged[change.first] = change.second;
	}
	for (const auto& entry : merged)
		storage.push_back(entry.first + "=" + entry.second);
	std::vector<char*> pointers;
	for (std::string& entry : storage)
		pointers.push_back(entry.data());
	pointers.push_back(nullptr);
	return pointers;
}

// A child process, ended with SIGTERM when it is dropped.
class Process {
public:
	Process(std::vector<std::string> arguments, const Environment& changes,
		posix_spawn_file_actions_t* actions = nullptr)
	{
		std::vector<char*> argv;
		for (std::string& argument : arguments)
			argv.push_back(argument.data());
		argv.push_back(nullptr);
		std::vector<std::string> storage;
		std::vector<char*> envp = MakeEnvironment(changes, storage);
		if (posix_spawnp(&fPid, argv[0], actions, nullptr, argv.data(), envp.data()) != 0)
			fPid = -1;
	}

	~Process()
	{
		if (fPid > 0 && !fExited) {
			kill(fPid, SIGTERM);
			waitpid(fPid, nullptr, 0);
		}
	}

	bool Started() const { return fPid > 0; }

	// The exit status, or -1 when it did not end in time.
	int Wait(std::chrono::seconds patience)
	{
		auto deadline = std::chrono::steady_clock::now() + patience;
		while (std::chrono::steady_clock::now() < deadline) {
			int status;
			if (waitpid(fPid, &status, WNOHANG) == fPid) {
				fExited = true;
				return WIFEXITED(status) ? WEXITSTATUS(status) : 128;
			}
			std::this_thread::sleep_for(std::chrono::milliseconds(50));
		}
		return -1;
	}

private:
	pid_t fPid = -1;
	bool fExited = false;
};

std::string Output(const std::string& command)
{
	std::string output;
	FILE* pipe = popen(command.c_str(), "r");
	if (pipe == nullptr)
		return output;
	char buffer[65536];
	size_t count;
	while ((count = fread(buffer, 1, sizeof(buffer), pipe)) > 0)
		output.append(buffer, count);
	pclose(pipe);
	return output;
}

class InterfaceE2ETest : public ::testing::Test {
protected:
	static void SetUpTestSuite()
	{
		char pattern[] = "/tmp/varnel-e2e-interface-XXXXXX";
		sHome = mkdtemp(pattern);
		// Xvfb picks a free display and writes its number once it accepts
		// connections.
		int fds[2];
		ASSERT_EQ(pipe(fds), 0);
		posix_spawn_file_actions_t actions;
		posix_spawn_file_actions_init(&actions);
		posix_spawn_file_actions_addclose(&actions, fds[0]);
		sServer = new Process({"Xvfb", "-displayfd", std::to_string(fds[1]), "-screen", "0",
			std::to_string(kScreenWidth) + "x" + std::to_string(kScreenHeight) + "x24",
			"-nolisten", "tcp"}, {}, &actions);
		posix_spawn_file_actions_destroy(&actions);
		close(fds[1]);
		// It writes the number and the newline separately: read up to the
		// newline, or it fails writing to a closed pipe.
		std::string number;
		char byte;
		while (read(fds[0], &byte, 1) == 1 && byte != '\n')
			number += byte;
		close(fds[0]);
		ASSERT_TRUE(sServer->Started());
		ASSERT_FALSE(number.empty()) << "Xvfb did not start";
		sDisplay = ":" + number;
	}

	static void TearDownTestSuite()
	{
		delete sServer;
		sServer = nullptr;
		std::error_code ignored;
		std::filesystem::remove_all(sHome, ignored);
	}

	Environment Children(const char* backend) const
	{
		return {{"VARNEL_BACKEND", backend}, {"HOME", sHome},
			{"XDG_CACHE_HOME", sHome + "/cache"}, {"XDG_CONFIG_HOME", sHome + "/config"},
			{"XDG_DATA_HOME", sHome + "/data"},
			{"DISPLAY", strcmp(backend, "sdl") == 0 ? sDisplay : ""}};
	}

	std::string OnDisplay(const std::string& command) const
	{
		return Output("DISPLAY=" + sDisplay + " " + command + " 2>/dev/null");
	}

	// The window's area of the X screen as RGB rows.
	std::string WindowPixels() const
	{
		std::string screen = OnDisplay("import -window root -depth 8 rgb:-");
		if (screen.size() != size_t(kScreenWidth) * kScreenHeight * 3)
			return "";
		std::string window;
		for (int y = kTop; y < kTop + kHeight; y++)
			window += screen.substr((size_t(y) * kScreenWidth + kLeft) * 3, kWidth * 3);
		return window;
	}

	// Waits until the window shows what check accepts.
	bool WaitForPixels(const std::function<bool(const std::string&)>& check,
		std::string* last = nullptr) const
	{
		auto deadline = std::chrono::steady_clock::now() + kPatience;
		std::string pixels;
		while (std::chrono::steady_clock::now() < deadline) {
			pixels = WindowPixels();
			if (check(pixels))
				return true;
			std::this_thread::sleep_for(std::chrono::milliseconds(200));
		}
		if (last != nullptr)
			*last = pixels;
		return false;
	}

	static std::string PixelAt(const std::string& pixels, int x, int y)
	{
		size_t at = (size_t(y) * kWidth + x) * 3;
		return pixels.size() >= at + 3 ? pixels.substr(at, 3) : "";
	}

	static std::string sDisplay;
	static std::string sHome;
	static Process* sServer;
};

std::string InterfaceE2ETest::sDisplay;
std::string InterfaceE2ETest::sHome;
Process* InterfaceE2ETest::sServer = nullptr;

TEST_F(InterfaceE2ETest, TheXServerShowsTheHeadlessFrameAndInputArrives)
{
	std::string dump = sHome + "/headless.rgb";
	Process headless({INTERFACE_DEMO, "--dump", dump}, Children("headless"));
	ASSERT_EQ(headless.Wait(kPatience), 0);
	std::ifstream file(dump, std::ios::binary);
	std::string expected((std::istreambuf_iterator<char>(file)), {});
	ASSERT_EQ(expected.size(), size_t(kWidth) * kHeight * 3);

	Process demo({INTERFACE_DEMO}, Children("sdl"));
	ASSERT_TRUE(demo.Started());
	std::string shown;
	bool same = WaitForPixels([&](const std::string& pixels) { return pixels == expected; },
		&shown);
	if (!same) {
		int differing = 0;
		for (size_t i = 0; i + 3 <= shown.size(); i += 3)
			differing += shown.compare(i, 3, expected, i, 3) != 0;
		FAIL() << "the screen shows " << shown.size() / 3 << " pixels of the window, "
			<< differing << " of them unlike the headless frame";
	}

	std::string id = OnDisplay("xdotool search --name '^Interface demo$'");
	id = id.substr(0, id.find('\n'));
	ASSERT_FALSE(id.empty());
	std::string geometry = OnDisplay("xdotool getwindowgeometry " + id);
	EXPECT_NE(geometry.find("Position: 40,30"), std::string::npos) << geometry;
	EXPECT_NE(geometry.find("Geometry: 320x200"), std::string::npos) << geometry;

	// F5 marks a red square; a double click a blue one where it happened.
	OnDisplay("xdotool windowfocus --sync " + id + " key F5");
	EXPECT_TRUE(WaitForPixels([](const std::string& pixels) {
		return PixelAt(pixels, 290, 160) == std::string("\xff\x00\x00", 3);
	}));
	OnDisplay("xdotool mousemove --sync " + std::to_string(kLeft + 150) + " "
		+ std::to_string(kTop + 150) + " click --repeat 2 --delay 50 1");
	EXPECT_TRUE(WaitForPixels([](const std::string& pixels) {
		return PixelAt(pixels, 150, 150) == std::string("\x00\x00\xff", 3)
			&& PixelAt(pixels, 153, 150) != std::string("\x00\x00\xff", 3);
	}));

	// Escape (raw key 1) quits.
	OnDisplay("xdotool windowfocus --sync " + id + " key Escape");
	EXPECT_EQ(demo.Wait(kPatience), 0);
}

}
