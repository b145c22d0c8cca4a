#ifndef KIT_STORAGE_TRASH_RECORDS_H
#define KIT_STORAGE_TRASH_RECORDS_H

#include <string>

#include <SupportDefs.h>

namespace BPrivate {

struct EntryPath;

// The freedesktop.org home trash: $XDG_DATA_HOME/Trash (by default
// ~/.local/share/Trash), holding files/ and info/.
std::string HomeTrashFolder();
// Creates the home trash (mode 0700) where it is missing; gives the path of
// its files folder.
status_t MakeHomeTrash(std::string* filesFolder);

// Keeps the records of the home trash (info/NAME.trashinfo, written as
// `gio trash` writes them) in step with one move the kit makes: the record
// of an entry moved into the trash is written first, with O_EXCL, and taken
// back when the move fails; the record of an entry leaving the trash goes
// once it has left, and one renamed inside the trash follows it.
class TrashMove {
public:
	// Before moving source to targetFolder/targetName (a folder path
	// without links). B_FILE_EXISTS when the trash holds a record for that
	// name and clobber is false.
	status_t Prepare(const EntryPath& source,
		const std::string& targetFolder, const std::string& targetName,
		bool clobber);
	// After the move; moved tells whether it happened.
	void Finish(bool moved);

	// After the kit removed the entry name of folder.
	static void Removed(const std::string& folder, const std::string& name);

private:
	std::string fWritten;
	std::string fRecord;
	std::string fOldRecord;
};

}

#endif
