#ifndef _NODE_H
#define _NODE_H

#include <memory>
#include <string>

#include <Statable.h>
#include <StorageDefs.h>
#include <fs_attr.h>

class BDirectory;
class BEntry;
struct entry_ref;

namespace BPrivate {
struct NodeData;
}

// A node and its device.
struct node_ref {
	node_ref();
	node_ref(dev_t device, ino_t node);
	node_ref(const node_ref& other);

	bool operator==(const node_ref& other) const;
	bool operator!=(const node_ref& other) const;
	bool operator<(const node_ref& other) const;
	node_ref& operator=(const node_ref& other);

	dev_t device;
	ino_t node;
};

// An open node: its stat, its lock and its attributes. Links are followed.
//
// Attributes are Linux extended attributes in the "user." namespace. An
// attribute NAME of type B_RAW_TYPE is stored as "user.NAME" holding exactly
// its data, so attributes written by other programs read as untyped data and
// are written back byte for byte. Any other type is stored as
// "user.haiku.NAME" holding the four-byte type code (in the machine's byte
// order) followed by the data; writing either form removes the other. Names
// are listed once, without their prefix. Attributes of other namespaces are
// not visible. Names may be up to B_ATTR_NAME_LENGTH - 11 bytes long.
//
// WriteAttr at offset 0 replaces the attribute; at a larger offset it keeps
// the bytes before the offset (padding with zeros) and drops those after the
// written data.
//
// Lock takes an exclusive flock() on the node: another BNode's Lock fails
// with B_BUSY until this one unlocks.
class BNode : public BStatable {
public:
	BNode();
	BNode(const entry_ref* ref);
	BNode(const BEntry* entry);
	BNode(const char* path);
	BNode(const BDirectory* dir, const char* path);
	BNode(const BNode& node);
	virtual ~BNode();

	status_t InitCheck() const;

	virtual status_t GetStat(struct stat* st) const;

	status_t SetTo(const entry_ref* ref);
	status_t SetTo(const BEntry* entry);
	status_t SetTo(const char* path);
	status_t SetTo(const BDirectory* dir, const char* path);
	void Unset();

	status_t Lock();
	status_t Unlock();
	status_t Sync();

	ssize_t WriteAttr(const char* name, type_code type, off_t offset,
		const void* buffer, size_t length);
	ssize_t ReadAttr(const char* name, type_code type, off_t offset,
		void* buffer, size_t length) const;
	status_t RemoveAttr(const char* name);
	status_t GetAttrInfo(const char* name, attr_info* info) const;
	// buffer must hold B_ATTR_NAME_LENGTH bytes; B_ENTRY_NOT_FOUND at the end.
	status_t GetNextAttrName(char* buffer);
	status_t RewindAttrs();

	BNode& operator=(const BNode& node);
	bool operator==(const BNode& node) const;
	bool operator!=(const BNode& node) const;

	// A new descriptor of the node, owned by the caller; -1 when unset.
	int Dup();

protected:
	// Opens path with the given open(2) flags (O_CLOEXEC is added) and
	// takes it as this node. O_PATH opens give a node without data access.
	status_t _SetToPath(const char* path, int openFlags);
	status_t _SetToRef(const entry_ref* ref, int openFlags);
	status_t _SetToEntry(const BEntry* entry, int openFlags);
	status_t _SetToAt(const BDirectory* dir, const char* path, int openFlags);
	// Unsets the node, keeping status as its InitCheck.
	status_t _Fail(status_t status);
	int _FileDescriptor() const;
	// Where the node is now, links resolved.
	status_t _GetPath(std::string* path) const;
	// The kit's id of the node's volume.
	dev_t _Device() const;
	// The open node's state, or NULL when unset.
	const std::shared_ptr<BPrivate::NodeData>& _Data() const { return fData; }

private:
	virtual status_t _SetStat(const struct stat& st, uint32 what);
	status_t _Adopt(int fd, int openFlags);

	// Shared with the folder registry while a folder is open, so that the
	// refs of its entries open through it.
	std::shared_ptr<BPrivate::NodeData> fData;
	status_t fCStatus;
};

#endif
