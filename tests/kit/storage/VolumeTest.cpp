#include <cstdio>
#include <cstdlib>
#include <sys/mount.h>
#include <thread>

#include <gtest/gtest.h>

#include <Directory.h>
#include <Entry.h>
#include <FindDirectory.h>
#include <Path.h>
#include <Volume.h>
#include <VolumeRoster.h>
#include <fs_info.h>

#include "StorageTestSupport.h"

using namespace StorageTest;

namespace {

std::vector<dev_t> RosterDevices()
{
	BVolumeRoster roster;
	std::vector<dev_t> devices;
	BVolume volume;
	while (roster.GetNextVolume(&volume) == B_OK)
		devices.push_back(volume.Device());
	return devices;
}

std::string NameOf(dev_t device)
{
	char name[B_FILE_NAME_LENGTH] = {};
	BVolume(device).GetName(name);
	return name;
}

bool Shell(const std::string& command)
{
	return std::system((command + " >/dev/null 2>&1").c_str()) == 0;
}

// Replaces the table file as an editor or a test script would.
void WriteTable(const std::string& path, const std::string& contents)
{
	std::string temporary = path + ".new";
	std::ofstream(temporary) << contents;
	ASSERT_EQ(0, rename(temporary.c_str(), path.c_str()));
}

}

TEST(VolumeTest, SystemTableHasTheRootAsBootVolume)
{
	BVolumeRoster roster;
	BVolume boot;
	ASSERT_EQ(B_OK, roster.GetBootVolume(&boot));
	EXPECT_EQ(dev_for_path("/"), boot.Device());
	EXPECT_GT(static_cast<int32>(boot.Device()), 0);
	BDirectory root;
	ASSERT_EQ(B_OK, boot.GetRootDirectory(&root));
	EXPECT_TRUE(root.IsRootDirectory());
	fs_info info;
	ASSERT_EQ(B_OK, fs_stat_dev(boot.Device(), &info));
	EXPECT_GT(info.total_blocks, 0);
	EXPECT_GE(info.total_blocks, info.free_blocks);
	EXPECT_GT(info.block_size, 0);
	EXPECT_NE('\0', info.fsh_name[0]);
	EXPECT_NE('\0', info.volume_name[0]);
	EXPECT_GT(boot.Capacity(), 0);

	// Kernel file systems are volumes, but not persistent ones.
	dev_t proc = dev_for_path("/proc/self");
	EXPECT_NE(boot.Device(), proc);
	EXPECT_FALSE(BVolume(proc).IsPersistent());
	std::vector<dev_t> devices = RosterDevices();
	EXPECT_NE(devices.end(), std::find(devices.begin(), devices.end(), proc));

	EXPECT_LT(static_cast<int32>(dev_for_path("/no/such/path")), 0);
	EXPECT_EQ(B_BAD_VALUE, BVolume(0x7fffffff).InitCheck());
}

TEST(VolumeTest, ReplacedTableGivesDevicesOfFolders)
{
	Scratch scratch;
	std::string boot = scratch.Folder("boot");
	std::string stick = scratch.Folder("boot/media/My Stick");
	FakeVolumes volumes({
		Volume(7, stick, "", B_FS_IS_PERSISTENT | B_FS_IS_READONLY),
		Volume(3, boot, "Macintosh HD", B_FS_IS_PERSISTENT, true),
		Volume(9, scratch.Folder("ram"), "RAM") });

	EXPECT_EQ((std::vector<dev_t>{ 7, 3, 9 }), RosterDevices());
	BVolumeRoster roster;
	BVolume volume;
	ASSERT_EQ(B_OK, roster.GetBootVolume(&volume));
	EXPECT_EQ(3, volume.Device());
	EXPECT_EQ("Macintosh HD", NameOf(3));
	EXPECT_EQ("My Stick", NameOf(7));
	EXPECT_TRUE(BVolume(7).IsReadOnly());
	EXPECT_FALSE(BVolume(3).IsReadOnly());
	EXPECT_FALSE(BVolume(9).IsPersistent());

	// The deepest root wins; a path outside all of them is on the boot
	// volume.
	EXPECT_EQ(7, dev_for_path(scratch.Folder("boot/media/My Stick/d").c_str()));
	EXPECT_EQ(3, dev_for_path((boot + "/media").c_str()));
	EXPECT_EQ(3, dev_for_path("/etc"));

	// Refs carry the device of their folder; a root's own node is its
	// volume's.
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path(stick.c_str(), &ref));
	EXPECT_EQ(3, ref.device);
	BDirectory root;
	ASSERT_EQ(B_OK, BVolume(7).GetRootDirectory(&root));
	EXPECT_TRUE(root.IsRootDirectory());
	node_ref node;
	ASSERT_EQ(B_OK, root.GetNodeRef(&node));
	EXPECT_EQ(7, node.device);
	BDirectory media((boot + "/media").c_str());
	struct stat st;
	ASSERT_EQ(B_OK, media.GetStatFor("My Stick", &st));
	EXPECT_EQ(7, st.st_dev);
	BEntry stickEntry(stick.c_str());
	ASSERT_EQ(B_OK, stickEntry.GetStat(&st));
	EXPECT_EQ(7, st.st_dev);

	fs_info info;
	BPrivate::VolumeEntry dos = Volume(11, scratch.Folder("dos"), "D");
	dos.fsName = "vfat";
	ASSERT_EQ(B_OK, BPrivate::VolumeTable::Default().Mount(dos));
	ASSERT_EQ(B_OK, fs_stat_dev(11, &info));
	EXPECT_STREQ("dos", info.fsh_name);
	EXPECT_EQ(B_BAD_VALUE, BPrivate::VolumeTable::Default().Mount(dos));
}

TEST(VolumeTest, WatchersHearOfMountsAndUnmounts)
{
	Scratch scratch;
	FakeVolumes volumes({ Volume(1, scratch.Folder("boot"), "Boot", 0, true) });
	EventRecorder* recorder = new EventRecorder;
	BVolumeRoster roster;
	ASSERT_EQ(B_OK, roster.StartWatching(BMessenger(recorder)));

	BPrivate::VolumeTable& table = BPrivate::VolumeTable::Default();
	ASSERT_EQ(B_OK, table.Mount(Volume(5, scratch.Folder("disk"), "Disk")));
	EXPECT_TRUE(recorder->WaitFor(B_DEVICE_MOUNTED, 5));
	ASSERT_EQ(B_OK, table.Unmount(5));
	EXPECT_TRUE(recorder->WaitFor(B_DEVICE_UNMOUNTED, 5));
	EXPECT_EQ(B_BAD_VALUE, table.Unmount(5));

	// Mounted from a thread of its own, as the system's events are.
	std::thread mounter([&] {
		table.Mount(Volume(6, scratch.Folder("other"), "Other"));
	});
	mounter.join();
	EXPECT_TRUE(recorder->WaitFor(B_DEVICE_MOUNTED, 6));

	roster.StopWatching();
	ASSERT_EQ(B_OK, table.Unmount(6));
	table.Mount(Volume(8, scratch.Folder("late"), "Late"));
	std::vector<EventRecorder::Event> events = recorder->Events();
	EXPECT_EQ(3u, events.size());
	recorder->Stop();
}

TEST(VolumeTest, TableFileIsFollowedAsItChanges)
{
	Scratch scratch;
	std::string boot = scratch.Folder("boot");
	std::string odd = scratch.Folder("odd name\\here");
	std::string table = scratch / "volumes";
	WriteTable(table, "# id fs flags name root\n"
		"1 ext4 persistent,boot Boot " + boot + "\n"
		"not a volume line\n");
	setenv("VARNEL_VOLUME_TABLE", table.c_str(), 1);
	BPrivate::VolumeTable::Default().UseSystem();
	EXPECT_EQ((std::vector<dev_t>{ 1 }), RosterDevices());

	EventRecorder* recorder = new EventRecorder;
	BVolumeRoster roster;
	roster.StartWatching(BMessenger(recorder));
	WriteTable(table, "1 ext4 persistent,boot Boot " + boot + "\n"
		"4 vfat persistent,removable Odd\\040One " + scratch.Path()
		+ "/odd\\040name\\134here\n");
	EXPECT_TRUE(recorder->WaitFor(B_DEVICE_MOUNTED, 4));
	EXPECT_EQ("Odd One", NameOf(4));
	EXPECT_TRUE(BVolume(4).IsRemovable());
	EXPECT_EQ(4, dev_for_path(odd.c_str()));

	WriteTable(table, "1 ext4 persistent,boot Boot " + boot + "\n");
	EXPECT_TRUE(recorder->WaitFor(B_DEVICE_UNMOUNTED, 4));
	EXPECT_EQ(B_BAD_VALUE, BVolume(4).InitCheck());

	roster.StopWatching();
	recorder->Stop();
	unsetenv("VARNEL_VOLUME_TABLE");
	BPrivate::VolumeTable::Default().UseSystem();
	BVolume volume;
	ASSERT_EQ(B_OK, roster.GetBootVolume(&volume));
	EXPECT_EQ(dev_for_path("/"), volume.Device());
}

TEST(VolumeTest, RealLoopMountIsNoticed)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "mounting a loop device needs root";
	Scratch scratch;
	std::string image = scratch / "image.ext2";
	std::string mountPoint = scratch.Folder("mount point");
	if (!Shell("truncate -s 8M '" + image + "'")
		|| !Shell("mkfs.ext2 -q -F -L VarnelTest '" + image + "'")) {
		GTEST_SKIP() << "mkfs.ext2 is not available";
	}
	EventRecorder* recorder = new EventRecorder;
	BVolumeRoster roster;
	roster.StartWatching(BMessenger(recorder));
	if (!Shell("mount -o loop '" + image + "' '" + mountPoint + "'")) {
		recorder->Stop();
		GTEST_SKIP() << "no loop device to mount the image on";
	}

	dev_t device = dev_for_path(mountPoint.c_str());
	EXPECT_TRUE(recorder->WaitFor(B_DEVICE_MOUNTED, device));
	BVolume volume(device);
	ASSERT_EQ(B_OK, volume.InitCheck());
	EXPECT_TRUE(volume.IsPersistent());
	EXPECT_EQ("VarnelTest", NameOf(device));
	fs_info info;
	ASSERT_EQ(B_OK, fs_stat_dev(device, &info));
	EXPECT_STREQ("ext2", info.fsh_name);
	EXPECT_EQ(0, strncmp(info.device_name, "/dev/loop", 9));
	BDirectory root;
	ASSERT_EQ(B_OK, volume.GetRootDirectory(&root));
	EXPECT_TRUE(root.Contains("lost+found"));
	root.Unset();

	bool unmounted = Shell("umount '" + mountPoint + "'");
	if (!unmounted)
		Shell("umount -l '" + mountPoint + "'");
	EXPECT_TRUE(unmounted);
	EXPECT_TRUE(recorder->WaitFor(B_DEVICE_UNMOUNTED, device));
	roster.StopWatching();
	recorder->Stop();
}

TEST(VolumeTest, StackedMountsCountOnce)
{
	if (geteuid() != 0)
		GTEST_SKIP() << "mounting needs root";
	Scratch scratch;
	std::string point = scratch.Folder("stacked");
	ASSERT_EQ(0, mount("tmpfs", point.c_str(), "tmpfs", 0, "size=1m"));
	ASSERT_EQ(0, mount("tmpfs", point.c_str(), "tmpfs", MS_RDONLY, "size=2m"));
	dev_t device = dev_for_path(point.c_str());
	int count = 0;
	for (dev_t each : RosterDevices()) {
		BDirectory root;
		BVolume(each).GetRootDirectory(&root);
		BEntry entry;
		BPath path;
		if (root.GetEntry(&entry) == B_OK && entry.GetPath(&path) == B_OK
			&& point == path.Path()) {
			count++;
			EXPECT_EQ(device, each);
		}
	}
	EXPECT_EQ(1, count);
	EXPECT_TRUE(BVolume(device).IsReadOnly());
	umount2(point.c_str(), MNT_DETACH);
	umount2(point.c_str(), MNT_DETACH);
}
