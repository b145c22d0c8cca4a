// Expanding a folder of 10,000 subfolders (each holding a folder and two
// files) in the tree, beside the floor measured in the same run: a plain
// loop doing the same directory reads and lstat calls. Then the down arrow
// through 10,000 shown rows. Prints the times; not a test.

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>

#include <Application.h>
#include <Entry.h>
#include <InterfaceDefs.h>

#include "FolderItem.h"
#include "GvTreeView.h"

namespace {

const int kFolders = 10000;
const int kRuns = 5;

using Clock = std::chrono::steady_clock;

double Seconds(Clock::time_point start)
{
	return std::chrono::duration<double>(Clock::now() - start).count();
}

void MakeFolders(const std::string& root)
{
	for (int i = 0; i < kFolders; i++) {
		std::string folder = root + "/folder " + std::to_string(i);
		std::filesystem::create_directories(folder + "/inner");
		std::ofstream(folder + "/a") << "a";
		std::ofstream(folder + "/b") << "b";
	}
}

// What expanding a folder must do at least: read it and lstat its entries,
// and read and lstat the entries of each subfolder to count its own.
// Returns how many subfolders it found.
int ReadFolder(int dirFd, bool openSubfolders)
{
	DIR* dir = fdopendir(dirFd);
	if (dir == nullptr) {
		close(dirFd);
		return 0;
	}
	int folders = 0;
	while (dirent* entry = readdir(dir)) {
		if (std::strcmp(entry->d_name, ".") == 0 || std::strcmp(entry->d_name, "..") == 0)
			continue;
		struct stat st;
		if (fstatat(dirfd(dir), entry->d_name, &st, AT_SYMLINK_NOFOLLOW) != 0
			|| !S_ISDIR(st.st_mode))
			continue;
		folders++;
		if (!openSubfolders)
			continue;
		int fd = openat(dirfd(dir), entry->d_name, O_RDONLY | O_DIRECTORY);
		fstat(fd, &st);
		ReadFolder(fd, false);
	}
	closedir(dir);
	return folders;
}

double Floor(const std::string& root)
{
	Clock::time_point start = Clock::now();
	int counted = ReadFolder(open(root.c_str(), O_RDONLY | O_DIRECTORY), true);
	double seconds = Seconds(start);
	if (counted != kFolders)
		std::fprintf(stderr, "floor counted %d subfolders\n", counted);
	return seconds;
}

double Expand(GvTreeView* tree, const entry_ref* ref)
{
	tree->RemoveAll();
	tree->AddItem(NULL, new FolderItem(ref, 0, GV_FOLDER_ORDINARY));
	Clock::time_point start = Clock::now();
	tree->Expand(tree->first);
	double seconds = Seconds(start);
	if (tree->lastVisible != kFolders)
		std::fprintf(stderr, "the tree shows %d rows\n", int(tree->lastVisible + 1));
	return seconds;
}

}

int main()
{
	setenv("VARNEL_BACKEND", "headless", 0);
	char pattern[] = "/tmp/varnel-bench-XXXXXX";
	if (mkdtemp(pattern) == nullptr)
		return 1;
	std::string root = std::string(pattern) + "/big";
	MakeFolders(root);

	int result = 0;
	{
		BApplication app("application/x-vnd.Quillmoor.Varnel-bench");
		GvTreeView tree(BRect(0, 0, 199, 399), "bench");
		entry_ref ref;
		if (get_ref_for_path(root.c_str(), &ref) != B_OK) {
			std::fprintf(stderr, "no ref for %s\n", root.c_str());
			result = 1;
		} else {
			double floor = 1e9;
			double treeTime = 1e9;
			for (int run = 0; run < kRuns; run++) {
				floor = std::min(floor, Floor(root));
				treeTime = std::min(treeTime, Expand(&tree, &ref));
			}
			std::printf("expand %d subfolders: %.1f ms, floor %.1f ms, ratio %.2f"
				" (best of %d)\n", kFolders, treeTime * 1e3, floor * 1e3,
				treeTime / floor, kRuns);

			tree.Select(0);
			const char down[] = { B_DOWN_ARROW, 0 };
			Clock::time_point start = Clock::now();
			for (int i = 0; i < kFolders; i++)
				tree.KeyDown(down, 1);
			double keys = Seconds(start);
			std::printf("down arrow through %d shown rows: %.1f ms, %.1f us a key\n",
				kFolders + 1, keys * 1e3, keys * 1e6 / kFolders);
		}
	}
	std::error_code ignored;
	std::filesystem::remove_all(pattern, ignored);
	return result;
}
