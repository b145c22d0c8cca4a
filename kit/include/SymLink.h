#ifndef _SYM_LINK_H
#define _SYM_LINK_H

#include <Node.h>

class BPath;

// A symbolic link itself (never its target). Linux keeps no user attributes
// on links: writing one fails with B_NOT_ALLOWED.
class BSymLink : public BNode {
public:
	BSymLink();
	BSymLink(const BSymLink& link);
	BSymLink(const entry_ref* ref);
	BSymLink(const BEntry* entry);
	BSymLink(const char* path);
	BSymLink(const BDirectory* dir, const char* path);
	virtual ~BSymLink();

	status_t SetTo(const entry_ref* ref);
	status_t SetTo(const BEntry* entry);
	status_t SetTo(const char* path);
	status_t SetTo(const BDirectory* dir, const char* path);

	// Copies the link's contents, NUL-terminated and cut to size - 1 bytes
	// when longer; returns the number of bytes copied. B_BAD_VALUE when the
	// node is not a link.
	ssize_t ReadLink(char* buffer, size_t size);
	// The path the link points to, a relative link taken from dirPath (the
	// folder that holds the link). Returns the path's length.
	ssize_t MakeLinkedPath(const char* dirPath, BPath* path);
	ssize_t MakeLinkedPath(const BDirectory* dir, BPath* path);
	bool IsAbsolute();

	BSymLink& operator=(const BSymLink& link);
};

#endif
