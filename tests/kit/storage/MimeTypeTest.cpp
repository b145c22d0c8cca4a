#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include <MimeType.h>

#include "TypeTestSupport.h"

using TypeTest::Scratch;

TEST(MimeTypeTest, AcceptsOnlyWellFormedTypes)
{
	for (const char* valid : {"text/plain", "text",
			"application/x-vnd.be-directory", "Application/X-Foo+XML"})
		EXPECT_TRUE(BMimeType::IsValid(valid)) << valid;
	std::string tooLong = "text/" + std::string(B_MIME_TYPE_LENGTH, 'a');
	for (const char* invalid : {"", "/plain", "text/", "text/plain/x",
			"text/pl ain", "text/plain;charset=utf-8", "te\"xt/plain",
			"text/pl\xc3\xa4in", "text/\n", tooLong.c_str()})
		EXPECT_FALSE(BMimeType::IsValid(invalid)) << invalid;
	EXPECT_FALSE(BMimeType::IsValid(NULL));

	BMimeType type("text/plain");
	EXPECT_EQ(B_BAD_VALUE, type.SetTo("text/"));
	EXPECT_EQ(B_BAD_VALUE, type.InitCheck());
	EXPECT_EQ(NULL, type.Type());
	EXPECT_TRUE(type == BMimeType());

	EXPECT_EQ(B_OK, type.SetTo("Text/Plain"));
	EXPECT_STREQ("Text/Plain", type.Type());
	EXPECT_TRUE(type == "text/PLAIN");
	EXPECT_TRUE(type == BMimeType("TEXT/plain"));
	EXPECT_FALSE(type == "text/plain2");
	EXPECT_FALSE(type == BMimeType());
}

TEST(MimeTypeTest, DescribesKnownTypesOnly)
{
	char description[B_MIME_TYPE_LENGTH];
	EXPECT_EQ(B_OK, BMimeType("application/x-vnd.be-directory")
		.GetShortDescription(description));
	EXPECT_STREQ("Folder", description);
	EXPECT_EQ(B_OK, BMimeType("application/x-vnd.Be-volume")
		.GetLongDescription(description));
	EXPECT_STREQ("Volume", description);

	// The database's comment, capitalised for the short form.
	EXPECT_EQ(B_OK, BMimeType("TEXT/plain").GetShortDescription(description));
	EXPECT_STREQ("Plain text document", description);
	EXPECT_EQ(B_OK, BMimeType("text/plain").GetLongDescription(description));
	EXPECT_STREQ("plain text document", description);
	// An alias is described as the type it stands for.
	EXPECT_EQ(B_OK, BMimeType("application/x-gzip")
		.GetShortDescription(description));

	strcpy(description, "kept");
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BMimeType("application/x-varnel-unheard-of")
		.GetShortDescription(description));
	EXPECT_STREQ("kept", description);
	EXPECT_EQ(B_NO_INIT, BMimeType("bad/").GetShortDescription(description));
	EXPECT_EQ(B_BAD_VALUE, BMimeType("text/plain").GetShortDescription(NULL));
}

// GIO reads the folders of applications once per process: the child of a
// death test starts afresh with the test's own.
TEST(MimeTypeDeathTest, PreferredAppIsTheUsersDefault)
{
	GTEST_FLAG_SET(death_test_style, "threadsafe");
	auto check = [] {
		StorageTest::PrivateHome home;
		const Scratch& root = home.Root();
		root.Folder("home/.local/share/applications");
		for (const char* app : {"varnel-text", "varnel-files"}) {
			root.File(std::string("home/.local/share/applications/") + app
				+ ".desktop", "[Desktop Entry]\nType=Application\nName=x\n"
				"Exec=true %f\nMimeType=text/plain;inode/directory;\n");
		}
		root.File("home/.config/mimeapps.list", "[Default Applications]\n"
			"text/plain=varnel-text.desktop\n"
			"inode/directory=varnel-files.desktop\n");

		char app[B_MIME_TYPE_LENGTH];
		bool text = BMimeType("Text/Plain").GetPreferredApp(app) == B_OK
			&& strcmp(app, "varnel-text.desktop") == 0;
		bool folder = BMimeType("application/x-vnd.be-directory")
			.GetPreferredApp(app) == B_OK
			&& strcmp(app, "varnel-files.desktop") == 0;
		bool none = BMimeType("application/x-varnel-unheard-of")
			.GetPreferredApp(app) == B_ENTRY_NOT_FOUND;
		exit(text && folder && none ? 0 : 1);
	};
	EXPECT_EXIT(check(), testing::ExitedWithCode(0), "");
}
