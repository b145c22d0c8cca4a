// The About window: its mail link and its version text.

#include "support/AppFixture.h"

#include <AppFileInfo.h>

#include "GvAboutView.h"
#include "GvAboutWindow.h"
#include "RosterPrivate.h"

using namespace AppTest;

namespace {

class AboutTest : public AppFixture {
protected:
	void SetUp() override
	{
		AppFixture::SetUp();
		BPrivate::SetLaunchHook([this](const char* what) {
			launched.push_back(what);
			return B_OK;
		});
	}

	void TearDown() override
	{
		BPrivate::SetLaunchHook(nullptr);
		AppFixture::TearDown();
	}

	GvAboutWindow* About()
	{
		for (const auto& info : BPrivate::Headless::ListWindows()) {
			if (auto about = dynamic_cast<const GvAboutWindow*>(info.window))
				return const_cast<GvAboutWindow*>(about);
		}
		return nullptr;
	}

	void ClickAbout(BPoint where)
	{
		ASSERT_EQ(B_OK, BPrivate::Headless::PostMouse(About(), B_MOUSE_DOWN, where));
		ASSERT_EQ(B_OK, BPrivate::Headless::PostMouse(About(), B_MOUSE_UP, where, 0));
		Idle();
	}

	std::vector<std::string> launched;
};

version_info Version(uint32 major, uint32 middle, uint32 minor)
{
	version_info version = {};
	version.major = major;
	version.middle = middle;
	version.minor = minor;
	return version;
}

}

TEST(AboutVersion, MinorNumberAddsTheThirdPartOnlyWhenNotZero)
{
	EXPECT_EQ("2.0", GvAboutView::VersionText(Version(2, 0, 0)));
	EXPECT_EQ("2.0.1", GvAboutView::VersionText(Version(2, 0, 1)));
	EXPECT_EQ("2.1", GvAboutView::VersionText(Version(2, 1, 0)));
	EXPECT_EQ("4294967295.4294967295.4294967295",
		GvAboutView::VersionText(Version(UINT32_MAX, UINT32_MAX, UINT32_MAX)));
}

TEST_F(AboutTest, MailLinkAnswersOnItsTextAndUnderlineOnly)
{
	Start();
	be_app->PostMessage(B_ABOUT_REQUESTED);
	Idle();
	GvAboutWindow* about = About();
	ASSERT_NE(nullptr, about);
	about->Lock();
	EXPECT_STREQ("About Varnel...", about->Title());
	EXPECT_EQ(BRect(0, 0, 300, 220), about->Bounds());
	BRect mail = about->aboutView->mailRect;
	about->Unlock();

	// From 12 above the address's baseline (125) to 3 below it, where the
	// underline is.
	EXPECT_EQ(113, mail.top);
	EXPECT_EQ(128, mail.bottom);
	EXPECT_GT(mail.left, 40);
	EXPECT_GT(mail.right, mail.left + 50);

	ClickAbout(BPoint(25, 120));
	ClickAbout(BPoint(mail.left + 5, 129));
	EXPECT_TRUE(launched.empty());
	ClickAbout(BPoint(mail.left + 5, 128));
	EXPECT_EQ(std::vector<std::string>{
		std::string("application/x-vnd.Be.URL.mailto mailto:") + kVarnelMail }, launched);

	// The icon is drawn at (20, 20); Enter presses "Amazing !" and closes.
	EXPECT_NE(rgb_color({ 205, 205, 205, 255 }),
		BPrivate::Headless::PixelAt(about, 21, 21));
	ASSERT_EQ(B_OK, BPrivate::Headless::PostKey(about, "\n"));
	Idle();
	EXPECT_EQ(nullptr, About());
}
