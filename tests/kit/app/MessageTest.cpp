#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <string>

#include <Entry.h>
#include <Flattenable.h>
#include <Message.h>
#include <Messenger.h>

#include "MessagePrivate.h"
#include "RefFlattening.h"

namespace {

// A flattenable stored under B_REF_TYPE, as a path is: it must read back
// with FindRef.
class RefObject : public BFlattenable {
public:
	entry_ref ref;

	bool IsFixedSize() const override { return false; }
	type_code TypeCode() const override { return B_REF_TYPE; }
	ssize_t FlattenedSize() const override { return BPrivate::FlattenedRefSize(ref); }
	status_t Flatten(void* buffer, ssize_t size) const override
	{
		return BPrivate::FlattenRef(ref, buffer, size);
	}
	status_t Unflatten(type_code, const void* buffer, ssize_t size) override
	{
		return BPrivate::UnflattenRef(&ref, buffer, size);
	}
};

// One value of every kind the kit carries, under a name each.
BMessage EveryType()
{
	BMessage message('test');
	message.AddInt8("int8", -8);
	message.AddUInt8("uint8", 250);
	message.AddInt16("int16", -1600);
	message.AddUInt16("uint16", 65000);
	message.AddInt32("int32", -320000);
	message.AddUInt32("uint32", 4000000000u);
	message.AddInt64("int64", -(1LL << 40));
	message.AddUInt64("uint64", 1ULL << 63);
	message.AddBool("bool", true);
	message.AddFloat("float", 2.5f);
	message.AddDouble("double", -1e100);
	message.AddString("string", "it's $HOME `x`\n\xff\xfe");
	message.AddPointer("pointer", &message);
	message.AddPoint("point", BPoint(3, -4));
	message.AddRect("rect", BRect(1, 2, 30, 40));
	entry_ref ref(7, 1234, "name \"quoted\"");
	message.AddRef("ref", &ref);
	const char raw[] = {0, 1, 2, 3};
	message.AddData("raw", B_RAW_TYPE, raw, sizeof(raw), false);
	BMessage inner('innr');
	inner.AddString("deep", "value");
	message.AddMessage("message", &inner);
	return message;
}

void ExpectEveryType(const BMessage& message)
{
	EXPECT_EQ(uint32('test'), message.what);
	int8 i8; uint8 u8; int16 i16; uint16 u16; int32 i32; uint32 u32;
	int64 i64; uint64 u64; bool b; float f; double d;
	ASSERT_EQ(B_OK, message.FindInt8("int8", &i8));
	ASSERT_EQ(B_OK, message.FindUInt8("uint8", &u8));
	ASSERT_EQ(B_OK, message.FindInt16("int16", &i16));
	ASSERT_EQ(B_OK, message.FindUInt16("uint16", &u16));
	ASSERT_EQ(B_OK, message.FindInt32("int32", &i32));
	ASSERT_EQ(B_OK, message.FindUInt32("uint32", &u32));
	ASSERT_EQ(B_OK, message.FindInt64("int64", &i64));
	ASSERT_EQ(B_OK, message.FindUInt64("uint64", &u64));
	ASSERT_EQ(B_OK, message.FindBool("bool", &b));
	ASSERT_EQ(B_OK, message.FindFloat("float", &f));
	ASSERT_EQ(B_OK, message.FindDouble("double", &d));
	EXPECT_EQ(-8, i8);
	EXPECT_EQ(250, u8);
	EXPECT_EQ(-1600, i16);
	EXPECT_EQ(65000, u16);
	EXPECT_EQ(-320000, i32);
	EXPECT_EQ(4000000000u, u32);
	EXPECT_EQ(-(1LL << 40), i64);
	EXPECT_EQ(1ULL << 63, u64);
	EXPECT_TRUE(b);
	EXPECT_EQ(2.5f, f);
	EXPECT_EQ(-1e100, d);
	EXPECT_STREQ("it's $HOME `x`\n\xff\xfe", message.GetString("string"));
	void* pointer;
	ASSERT_EQ(B_OK, message.FindPointer("pointer", &pointer));
	EXPECT_NE(nullptr, pointer);
	BPoint point;
	ASSERT_EQ(B_OK, message.FindPoint("point", &point));
	EXPECT_EQ(BPoint(3, -4), point);
	BRect rect;
	ASSERT_EQ(B_OK, message.FindRect("rect", &rect));
	EXPECT_EQ(BRect(1, 2, 30, 40), rect);
	entry_ref ref;
	ASSERT_EQ(B_OK, message.FindRef("ref", &ref));
	EXPECT_EQ(entry_ref(7, 1234, "name \"quoted\""), ref);
	const void* raw;
	ssize_t size;
	ASSERT_EQ(B_OK, message.FindData("raw", B_RAW_TYPE, &raw, &size));
	ASSERT_EQ(4, size);
	EXPECT_EQ(3, static_cast<const char*>(raw)[3]);
	BMessage inner;
	ASSERT_EQ(B_OK, message.FindMessage("message", &inner));
	EXPECT_EQ(uint32('innr'), inner.what);
	EXPECT_STREQ("value", inner.GetString("deep"));
}

}

TEST(Message, EveryTypeReadsBackAndSurvivesCopyAndFlattening)
{
	BMessage message = EveryType();
	ExpectEveryType(message);

	BMessage copy(message);
	ExpectEveryType(copy);
	BMessage assigned;
	assigned = message;
	ExpectEveryType(assigned);

	std::string buffer(message.FlattenedSize(), '\0');
	ASSERT_EQ(B_OK, message.Flatten(buffer.data(), buffer.size()));
	BMessage restored;
	ASSERT_EQ(B_OK, restored.Unflatten(buffer.data()));
	ExpectEveryType(restored);
	EXPECT_EQ(message.CountNames(B_ANY_TYPE), restored.CountNames(B_ANY_TYPE));
	// Too small a buffer is refused rather than overrun.
	EXPECT_EQ(B_BAD_VALUE, message.Flatten(buffer.data(), buffer.size() - 1));
}

TEST(Message, ErrorsSayWhatIsWrong)
{
	BMessage message;
	message.AddInt32("number", 5);
	int32 number = 0;
	int16 small;
	const char* string;
	EXPECT_EQ(B_NAME_NOT_FOUND, message.FindInt32("other", &number));
	EXPECT_EQ(B_BAD_INDEX, message.FindInt32("number", 1, &number));
	EXPECT_EQ(B_BAD_INDEX, message.FindInt32("number", -1, &number));
	// Another type is an error, never the same bytes read another way.
	EXPECT_EQ(B_BAD_TYPE, message.FindInt16("number", &small));
	EXPECT_EQ(B_BAD_TYPE, message.FindString("number", &string));
	EXPECT_EQ(B_BAD_TYPE, message.AddString("number", "five"));
	EXPECT_EQ(B_BAD_TYPE, message.ReplaceFloat("number", 1.0f));
	EXPECT_EQ(B_NAME_NOT_FOUND, message.ReplaceInt32("other", 1));
	EXPECT_EQ(B_BAD_INDEX, message.ReplaceInt32("number", 3, 1));
	EXPECT_EQ(B_BAD_VALUE, message.AddString(NULL, "x"));
	EXPECT_EQ(B_BAD_VALUE, message.AddString("x", NULL));
	EXPECT_EQ(B_BAD_VALUE, message.AddRef("x", NULL));
	// A fixed-size field takes only values of its size.
	const int16 two = 2;
	EXPECT_EQ(B_BAD_VALUE, message.AddData("number", B_INT32_TYPE, &two, sizeof(two)));
	EXPECT_EQ(5, message.GetInt32("number", 0));

	// Defaults stand in for missing and mistyped fields alike.
	EXPECT_EQ(-1, message.GetInt32("missing", -1));
	EXPECT_EQ(7.0f, message.GetFloat("number", 7.0f));
	EXPECT_TRUE(message.GetBool("number", true));
	EXPECT_STREQ("none", message.GetString("number", "none"));
	EXPECT_FALSE(message.HasString("number"));
	EXPECT_TRUE(message.HasInt32("number"));
	EXPECT_FALSE(message.HasInt32("number", 1));
}

TEST(Message, RawBytesUnderATypeAreCheckedBeforeUse)
{
	BMessage message;
	const char unterminated[] = {'a', 'b'};
	message.AddData("text", B_STRING_TYPE, unterminated, sizeof(unterminated), false);
	const char* string;
	EXPECT_EQ(B_BAD_DATA, message.FindString("text", &string));

	const uint8 two = 2;
	message.AddData("flag", B_BOOL_TYPE, &two, sizeof(two));
	EXPECT_TRUE(message.GetBool("flag"));

	const char junk[] = "not a message at all";
	message.AddData("inner", B_MESSAGE_TYPE, junk, sizeof(junk), false);
	BMessage inner;
	EXPECT_EQ(B_NOT_A_MESSAGE, message.FindMessage("inner", &inner));

	// A flattened message cut short is bad data, not a crash.
	BMessage full = EveryType();
	std::string flat(full.FlattenedSize(), '\0');
	full.Flatten(flat.data(), flat.size());
	message.AddData("cut", B_MESSAGE_TYPE, flat.data(), flat.size() / 2, false);
	EXPECT_EQ(B_BAD_DATA, message.FindMessage("cut", &inner));
	EXPECT_EQ(B_NOT_A_MESSAGE, inner.Unflatten(junk));
}

TEST(Message, SeveralValuesKeepTheirIndexes)
{
	BMessage message;
	for (int32 i = 0; i < 4; i++)
		message.AddInt32("event", 100 + i);
	message.AddString("name", "a");
	const char* first;
	ASSERT_EQ(B_OK, message.FindString("name", &first));
	// Pointers into the message survive additions.
	for (int i = 0; i < 100; i++)
		message.AddString("name", "more");
	EXPECT_STREQ("a", first);

	int32 value;
	ASSERT_EQ(B_OK, message.ReplaceInt32("event", 2, 7));
	ASSERT_EQ(B_OK, message.RemoveData("event", 0));
	type_code type;
	int32 count;
	ASSERT_EQ(B_OK, message.GetInfo("event", &type, &count));
	EXPECT_EQ(uint32(B_INT32_TYPE), type);
	EXPECT_EQ(3, count);
	message.FindInt32("event", 0, &value);
	EXPECT_EQ(101, value);
	message.FindInt32("event", 1, &value);
	EXPECT_EQ(7, value);

	// The field goes when its last value does.
	for (int i = 0; i < 3; i++)
		ASSERT_EQ(B_OK, message.RemoveData("event"));
	EXPECT_EQ(B_NAME_NOT_FOUND, message.GetInfo("event", &type, &count));
	EXPECT_EQ(B_NAME_NOT_FOUND, message.RemoveData("event"));
}

TEST(Message, FieldsAreListedRenamedAndRemoved)
{
	BMessage message;
	EXPECT_TRUE(message.IsEmpty());
	message.AddInt32("a", 1);
	message.AddString("b", "x");
	message.AddInt32("c", 2);
	EXPECT_EQ(3, message.CountNames(B_ANY_TYPE));
	EXPECT_EQ(2, message.CountNames(B_INT32_TYPE));

	char* name;
	type_code type;
	ASSERT_EQ(B_OK, message.GetInfo(B_INT32_TYPE, 1, &name, &type));
	EXPECT_STREQ("c", name);
	EXPECT_EQ(B_BAD_INDEX, message.GetInfo(B_INT32_TYPE, 2, &name, &type));
	EXPECT_EQ(B_BAD_TYPE, message.GetInfo(B_FLOAT_TYPE, 0, &name, &type));

	EXPECT_EQ(B_NAME_IN_USE, message.Rename("a", "c"));
	ASSERT_EQ(B_OK, message.Rename("a", "renamed"));
	EXPECT_EQ(1, message.GetInt32("renamed", 0));
	EXPECT_FALSE(message.HasInt32("a"));

	ASSERT_EQ(B_OK, message.RemoveName("b"));
	EXPECT_EQ(B_NAME_NOT_FOUND, message.RemoveName("b"));
	message.what = 'keep';
	message.MakeEmpty();
	EXPECT_TRUE(message.IsEmpty());
	EXPECT_EQ(uint32('keep'), message.what);
}

TEST(Message, CopiesAreIndependent)
{
	BMessage original('orig');
	original.AddString("name", "first");
	BMessage copy(original);
	copy.ReplaceString("name", "second");
	copy.AddInt32("extra", 1);
	copy.what = 'copy';
	EXPECT_STREQ("first", original.GetString("name"));
	EXPECT_FALSE(original.HasInt32("extra"));
	EXPECT_EQ(uint32('orig'), original.what);

	original = copy;
	copy.MakeEmpty();
	EXPECT_STREQ("second", original.GetString("name"));
	original = original;
	EXPECT_STREQ("second", original.GetString("name"));
}

TEST(Message, FlatObjectsCheckTheirTypeAndReadBackAsRefs)
{
	RefObject object;
	object.ref = entry_ref(3, 99, "file");
	BMessage message;
	ASSERT_EQ(B_OK, message.AddFlat("source path", &object));

	entry_ref ref;
	ASSERT_EQ(B_OK, message.FindRef("source path", &ref));
	EXPECT_EQ(object.ref, ref);
	RefObject back;
	ASSERT_EQ(B_OK, message.FindFlat("source path", &back));
	EXPECT_EQ(object.ref, back.ref);
	EXPECT_TRUE(message.HasFlat("source path", &back));

	// A ref added directly reads back as the object too; a string does not.
	message.AddRef("ref", &object.ref);
	EXPECT_EQ(B_OK, message.FindFlat("ref", &back));
	message.AddString("text", "file");
	EXPECT_EQ(B_BAD_TYPE, message.FindFlat("text", &back));
	EXPECT_FALSE(message.HasFlat("text", &back));
	EXPECT_EQ(B_BAD_INDEX, message.FindFlat("ref", 1, &back));
}

TEST(Message, DropInformationTravelsOutsideTheFields)
{
	BMessage message('copy');
	message.AddInt32("field", 1);
	EXPECT_FALSE(message.WasDropped());
	BPrivate::MessageAccess::SetDropped(&message, BPoint(100, 200), BPoint(5, 6));

	BMessage copy(message);
	std::string flat(message.FlattenedSize(), '\0');
	message.Flatten(flat.data(), flat.size());
	BMessage restored;
	restored.Unflatten(flat.data());
	for (const BMessage* each : {&message, &copy, &restored}) {
		EXPECT_TRUE(each->WasDropped());
		BPoint offset;
		EXPECT_EQ(BPoint(100, 200), each->DropPoint(&offset));
		EXPECT_EQ(BPoint(5, 6), offset);
		EXPECT_EQ(1, each->CountNames(B_ANY_TYPE));
	}
}

TEST(Message, MessengersTravelInFields)
{
	BMessage message;
	BMessenger invalid;
	ASSERT_EQ(B_OK, message.AddMessenger("target", invalid));
	BMessenger back;
	ASSERT_EQ(B_OK, message.FindMessenger("target", &back));
	EXPECT_EQ(invalid, back);
	EXPECT_FALSE(back.IsValid());
	EXPECT_TRUE(message.HasMessenger("target"));
}

TEST(Message, PrintToStreamShowsNamesAndValues)
{
	BMessage message('rfsh');
	message.AddInt32("event", 'nfld');
	message.AddInt32("event", 'delt');
	message.AddString("name", "x");
	testing::internal::CaptureStdout();
	message.PrintToStream();
	const std::string printed = testing::internal::GetCapturedStdout();
	EXPECT_NE(std::string::npos, printed.find("'rfsh'"));
	EXPECT_NE(std::string::npos, printed.find("event[1] = int32"));
	EXPECT_NE(std::string::npos, printed.find("name = string(\"x\")"));
}

TEST(Message, SystemCodesAreRecognised)
{
	EXPECT_TRUE(BMessage(B_QUIT_REQUESTED).IsSystem());
	EXPECT_FALSE(BMessage('rfsh').IsSystem());
	EXPECT_FALSE(BMessage('_abc').IsSystem());
}
