#ifndef KIT_STORAGE_ENTRY_PATH_H
#define KIT_STORAGE_ENTRY_PATH_H

#include <string>
#include <sys/stat.h>

#include <SupportDefs.h>

struct entry_ref;
class BDirectory;

namespace BPrivate {

// An entry as an absolute folder path without links, and a name in it. The
// root folder is the entry "." of itself.
struct EntryPath {
	std::string folder;
	std::string leaf;

	std::string Path() const;
};

// Splits path (absolute or relative to the working folder) into its entry;
// the folder must exist. With traverse a link (and a chain of links) is
// replaced by its target, which must exist.
status_t CanonicalEntry(const char* path, bool traverse, EntryPath* entry);
// The path of an existing node, its links resolved.
status_t CanonicalPath(const char* path, std::string* canonical);

// The ref of the entry at path (see CanonicalEntry); its folder is
// registered so that the ref resolves.
status_t RefForPath(const char* path, bool traverse, entry_ref* ref);
// The entry a ref names.
status_t EntryForRef(const entry_ref& ref, EntryPath* entry);
// Whether a ref's name can name an entry of its folder: a name (see
// CheckName) or "." for the folder itself.
status_t CheckRefName(const entry_ref& ref);

// Where the folder a BDirectory is open on lies now.
status_t PathOfDirectory(const BDirectory* dir, std::string* path);

std::string JoinPath(const std::string& folder, const std::string& leaf);
// B_BAD_VALUE for a name that is empty, ".", ".." or holds "/";
// B_NAME_TOO_LONG past B_FILE_NAME_LENGTH - 1 bytes.
status_t CheckName(const char* name);

// Applies the fields of st that what names (BStatable's B_STAT_* flags) to
// the node at path, a link itself and not its target, or when path is NULL
// to the node open as fd.
status_t ApplyStat(int fd, const char* path, const struct stat& st,
	uint32 what);

// The kit's volume id of a node at path (without links) whose own stat is
// st, given the volume of its folder: a folder that is a volume root
// belongs to that volume.
dev_t DeviceOfNode(const std::string& path, const struct stat& st,
	dev_t folderDevice);

}

#endif
