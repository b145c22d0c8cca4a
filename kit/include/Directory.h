#ifndef _DIRECTORY_H
#define _DIRECTORY_H

#include <memory>

#include <Node.h>

class BFile;
class BSymLink;

namespace BPrivate {
struct DirectoryIterator;
}

// An open folder. GetNextRef and GetNextEntry return the entries in the file
// system's own order, never "." and "..", then B_ENTRY_NOT_FOUND; Rewind
// starts over. CountEntries reads the folder on its own and leaves the
// iteration where it was. GetStatFor gives an entry's own stat (links are not
// followed). The Create functions take a name or a path relative to this
// folder; the new node is opened into the object given, if any.
class BDirectory : public BNode {
public:
	BDirectory();
	BDirectory(const BDirectory& dir);
	BDirectory(const entry_ref* ref);
	BDirectory(const node_ref* nref);
	BDirectory(const BEntry* entry);
	BDirectory(const char* path);
	BDirectory(const BDirectory* dir, const char* path);
	virtual ~BDirectory();

	status_t SetTo(const entry_ref* ref);
	status_t SetTo(const node_ref* nref);
	status_t SetTo(const BEntry* entry);
	status_t SetTo(const char* path);
	status_t SetTo(const BDirectory* dir, const char* path);
	void Unset();

	status_t GetEntry(BEntry* entry) const;
	bool IsRootDirectory() const;

	status_t FindEntry(const char* path, BEntry* entry,
		bool traverse = false) const;
	bool Contains(const char* path, int32 nodeFlags = B_ANY_NODE) const;
	bool Contains(const BEntry* entry, int32 nodeFlags = B_ANY_NODE) const;
	status_t GetStatFor(const char* path, struct stat* st) const;

	status_t GetNextEntry(BEntry* entry, bool traverse = false);
	status_t GetNextRef(entry_ref* ref);
	status_t Rewind();
	int32 CountEntries() const;

	status_t CreateDirectory(const char* path, BDirectory* dir);
	status_t CreateFile(const char* path, BFile* file,
		bool failIfExists = false);
	status_t CreateSymLink(const char* path, const char* linkToPath,
		BSymLink* link);

	BDirectory& operator=(const BDirectory& dir);

private:
	status_t _Open(status_t status);
	status_t _Absolute(const char* path, std::string* absolute) const;

	std::unique_ptr<BPrivate::DirectoryIterator> fIterator;
};

// Creates path and every missing folder above it with the given mode.
status_t create_directory(const char* path, mode_t mode);

#endif
