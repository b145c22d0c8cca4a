#include <atomic>
#include <thread>

#include <gtest/gtest.h>

#include <Directory.h>
#include <Entry.h>
#include <Path.h>
#include <Volume.h>
#include <VolumeRoster.h>
#include <fs_info.h>

#include "StorageTestSupport.h"

using namespace StorageTest;

// Readers resolve refs and walk folders while the kit renames their folder
// and the volume table changes: every answer is one of the folder's two
// places, and the registry and table stay whole.
TEST(ConcurrencyTest, RefsResolveWhileFoldersMoveAndVolumesChange)
{
	Scratch scratch;
	FakeVolumes volumes({ Volume(1, scratch.Path(), "Root", 0, true) });
	scratch.Folder("one/deep");
	scratch.File("one/deep/file");
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "one/deep/file").c_str(),
		&ref));
	entry_ref deep;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "one/deep").c_str(), &deep));

	std::atomic<bool> done = false;
	std::atomic<int> strays = 0;
	std::vector<std::thread> readers;
	for (int i = 0; i < 3; i++) {
		readers.emplace_back([&] {
			while (!done) {
				BPath path(&ref);
				if (path.InitCheck() == B_OK
					&& path != (scratch / "one/deep/file").c_str()
					&& path != (scratch / "two/deep/file").c_str())
					strays++;
				BDirectory dir(&deep);
				entry_ref listed;
				if (dir.GetNextRef(&listed) == B_OK && listed != ref)
					strays++;
				BVolumeRoster roster;
				BVolume volume;
				while (roster.GetNextVolume(&volume) == B_OK)
					dev_for_path(scratch.Path().c_str());
			}
		});
	}
	entry_ref folderRef;
	ASSERT_EQ(B_OK, get_ref_for_path((scratch / "one").c_str(), &folderRef));
	BEntry folder(&folderRef);
	for (int i = 0; i < 200; i++) {
		ASSERT_EQ(B_OK, folder.Rename(i % 2 == 0 ? "two" : "one"));
		BPrivate::VolumeTable::Default().Mount(
			Volume(2, scratch.Path(), "Again"));
		BPrivate::VolumeTable::Default().Unmount(2);
	}
	done = true;
	for (std::thread& reader : readers)
		reader.join();
	EXPECT_EQ(0, strays);
	EXPECT_EQ(scratch / "one/deep/file", BPath(&ref).Path());
}
