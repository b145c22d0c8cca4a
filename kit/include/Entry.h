#ifndef _ENTRY_H
#define _ENTRY_H

#include <Statable.h>
#include <StorageDefs.h>
#include <sys/stat.h>

class BDirectory;
class BPath;

namespace BPrivate {
struct EntryPath;
}

// A reference to a file-system entry: the device, the node of the folder it
// is in, and its name. Two refs are equal when those three are.
//
// The device is the id of the volume whose root is the folder's deepest
// ancestor (see fs_info.h). A ref stays valid while its folder lives: the kit
// remembers where every folder it has seen lies, and follows the folder when
// the kit itself renames or moves it. The root folder "/" is the entry "."
// of itself.
struct entry_ref {
	entry_ref();
	entry_ref(dev_t dev, ino_t dir, const char* name);
	entry_ref(const entry_ref& other);
	~entry_ref();

	status_t set_name(const char* name);

	bool operator==(const entry_ref& other) const;
	bool operator!=(const entry_ref& other) const;
	entry_ref& operator=(const entry_ref& other);

	dev_t device;
	ino_t directory;
	char* name;
};

// A named entry in a folder, whether or not anything exists under that name
// (the folder itself must exist). The entry is kept as an entry_ref, so it
// follows its folder when the kit renames or moves that folder.
//
// Names given to Rename and MoveTo are single names: one containing "/", an
// empty one, "." and ".." are refused with B_BAD_VALUE. Without clobber an
// existing target gives B_FILE_EXISTS and nothing changes; a move to another
// volume gives B_CROSS_DEVICE_LINK (nothing is copied).
//
// Moving an entry into the trash (find_directory B_TRASH_DIRECTORY) writes
// its freedesktop.org record info/NAME.trashinfo before the move; moving a
// trashed entry out of the trash, or removing it, removes that record, and
// renaming it inside the trash renames the record.
class BEntry : public BStatable {
public:
	BEntry();
	BEntry(const BDirectory* dir, const char* path, bool traverse = false);
	BEntry(const entry_ref* ref, bool traverse = false);
	BEntry(const char* path, bool traverse = false);
	BEntry(const BEntry& entry);
	virtual ~BEntry();

	status_t InitCheck() const;
	bool Exists() const;

	virtual status_t GetStat(struct stat* st) const;

	status_t SetTo(const BDirectory* dir, const char* path,
		bool traverse = false);
	status_t SetTo(const entry_ref* ref, bool traverse = false);
	status_t SetTo(const char* path, bool traverse = false);
	void Unset();

	status_t GetRef(entry_ref* ref) const;
	status_t GetPath(BPath* path) const;
	status_t GetParent(BEntry* entry) const;
	status_t GetParent(BDirectory* dir) const;
	// name must hold B_FILE_NAME_LENGTH bytes.
	status_t GetName(char* name) const;

	status_t Rename(const char* path, bool clobber = false);
	// A NULL name keeps the entry's own name.
	status_t MoveTo(BDirectory* dir, const char* path = NULL,
		bool clobber = false);
	status_t Remove();

	bool operator==(const BEntry& item) const;
	bool operator!=(const BEntry& item) const;
	BEntry& operator=(const BEntry& item);

private:
	virtual status_t _SetStat(const struct stat& st, uint32 what);
	// Where the entry lies now.
	status_t _Resolve(BPrivate::EntryPath* entry) const;
	status_t _MoveTo(const char* dirPath, dev_t dirDevice, ino_t dirNode,
		const char* name, bool clobber);

	entry_ref fRef;
	status_t fCStatus;
};

// The ref of the entry at path (the entry itself need not exist, its folder
// must). Links are not followed.
status_t get_ref_for_path(const char* path, entry_ref* ref);

bool operator<(const entry_ref& a, const entry_ref& b);

#endif
