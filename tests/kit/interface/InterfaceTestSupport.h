// Windows in the headless backend, views that draw with a function, and pixel
// reading for the Interface Kit tests.

#ifndef INTERFACE_TEST_SUPPORT_H
#define INTERFACE_TEST_SUPPORT_H

#include <cstdlib>
#include <filesystem>
#include <functional>
#include <ostream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <View.h>
#include <Window.h>

#include "Headless.h"

inline void PrintTo(const rgb_color& color, std::ostream* stream)
{
	*stream << "(" << int(color.red) << ", " << int(color.green) << ", "
		<< int(color.blue) << ", " << int(color.alpha) << ")";
}

namespace InterfaceTest {

// The headless backend, and a private home so that fontconfig's caches
// never touch the real one.
class Environment : public ::testing::Environment {
public:
	void SetUp() override
	{
		char pattern[] = "/tmp/varnel-interface-XXXXXX";
		fHome = mkdtemp(pattern);
		setenv("HOME", fHome.c_str(), 1);
		setenv("XDG_CACHE_HOME", (fHome + "/cache").c_str(), 1);
		setenv("XDG_CONFIG_HOME", (fHome + "/config").c_str(), 1);
		setenv("XDG_DATA_HOME", (fHome + "/data").c_str(), 1);
		setenv("VARNEL_BACKEND", "headless", 0);
	}

	void TearDown() override
	{
		std::error_code ignored;
		std::filesystem::remove_all(fHome, ignored);
	}

private:
	std::string fHome;
};

inline ::testing::Environment* const kEnvironment
	= ::testing::AddGlobalTestEnvironment(new Environment);

constexpr rgb_color kBlack = {0, 0, 0, 255};
constexpr rgb_color kWhite = {255, 255, 255, 255};
constexpr rgb_color kRed = {255, 0, 0, 255};
constexpr rgb_color kBlue = {0, 0, 255, 255};
constexpr rgb_color kGrey = {205, 205, 205, 255};

// A view whose Draw runs a function; it records the update rectangles.
class DrawView : public BView {
public:
	DrawView(BRect frame, std::function<void(BView*)> draw = {},
		uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP, uint32 flags = B_WILL_DRAW)
		: BView(frame, "draw", resizingMode, flags), fDraw(std::move(draw)) {}

	void Draw(BRect update) override
	{
		updates.push_back(update);
		if (fDraw)
			fDraw(this);
	}

	std::vector<BRect> updates;

private:
	std::function<void(BView*)> fDraw;
};

// Windows made by a test are quit when it ends.
class WindowTest : public ::testing::Test {
protected:
	void TearDown() override
	{
		for (BWindow* window : fWindows) {
			if (window->Lock())
				window->Quit();
		}
		ASSERT_TRUE(BPrivate::Headless::WaitForIdle());
	}

	BWindow* MakeWindow(BRect frame = BRect(100, 100, 199, 149),
		window_feel feel = B_NORMAL_WINDOW_FEEL)
	{
		BWindow* window = new BWindow(frame, "test", B_TITLED_WINDOW_LOOK, feel, 0);
		fWindows.push_back(window);
		return window;
	}

	// A shown window holding view, with everything drawn.
	BWindow* ShowView(BView* view, BRect frame = BRect(100, 100, 199, 149))
	{
		BWindow* window = MakeWindow(frame);
		window->AddChild(view);
		window->Show();
		Idle();
		return window;
	}

	void Idle() { ASSERT_TRUE(BPrivate::Headless::WaitForIdle()); }

	// Forgets a window the test quit itself.
	void Forget(BWindow* window) { std::erase(fWindows, window); }

	static rgb_color Pixel(const BWindow* window, int32 x, int32 y)
	{
		return BPrivate::Headless::PixelAt(window, x, y);
	}

	// Pixels from x0 to x1 on row y: '#' where they have ink, '.' elsewhere.
	static std::string Row(const BWindow* window, int32 y, int32 x0, int32 x1,
		rgb_color ink = kBlack)
	{
		return Line(window, x0, y, 1, 0, x1 - x0 + 1, ink);
	}

	static std::string Column(const BWindow* window, int32 x, int32 y0, int32 y1,
		rgb_color ink = kBlack)
	{
		return Line(window, x, y0, 0, 1, y1 - y0 + 1, ink);
	}

	static std::string Line(const BWindow* window, int32 x, int32 y, int32 dx, int32 dy,
		int32 count, rgb_color ink)
	{
		std::string line;
		for (int32 i = 0; i < count; i++)
			line += Pixel(window, x + i * dx, y + i * dy) == ink ? '#' : '.';
		return line;
	}

	std::vector<BWindow*> fWindows;
};

}

#endif
