#ifndef KIT_STORAGE_NODE_DATA_H
#define KIT_STORAGE_NODE_DATA_H

#include <string>
#include <sys/stat.h>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {

// The state of an open BNode.
struct NodeData {
	NodeData() = default;
	NodeData(const NodeData&) = delete;
	NodeData& operator=(const NodeData&) = delete;
	~NodeData();

	int fd = -1;
	// Opened with O_PATH (a link itself): no data or descriptor calls.
	bool pathOnly = false;
	dev_t device = 0;
	bool locked = false;

	// Where the node was and what it was when it was opened, read once so
	// that a folder opened for a walk needs no second look; opened is false
	// when the node was removed before it could be located.
	bool opened = false;
	// The registry's count of moves just before openedPath was read.
	uint64 movesBeforeLocating = 0;
	std::string openedPath;
	struct stat openedStat = {};
	bool isRoot = false;

	// The names GetNextAttrName walks through, read at its first call.
	std::vector<std::string> attributeNames;
	size_t nextAttribute = 0;
	bool attributesListed = false;
};

// The current path of an open descriptor, as the kernel knows it;
// B_ENTRY_NOT_FOUND once the node has been removed. Gives the node's stat
// as well when st is not NULL.
status_t PathOfDescriptor(int fd, std::string* path, struct stat* st = nullptr);

}

#endif
