#ifndef _NODE_INFO_H
#define _NODE_INFO_H

#include <Mime.h>

class BBitmap;
class BNode;
struct entry_ref;

// The type and icons of a node. A node's type is the "mime_type" attribute
// (stored raw as "user.mime_type", where other Linux programs keep it too)
// when it holds a valid type; otherwise a folder is
// "application/x-vnd.be-directory", a link itself (a BSymLink)
// "application/x-vnd.be-symlink", and a file what GIO guesses from its name,
// or from its first few KiB when the name says nothing. The program may give
// a volume's root folder the type "application/x-vnd.be-volume".
//
// Icons are B_CMAP8 bitmaps of exactly the asked size. The node is not owned.
class BNodeInfo {
public:
	BNodeInfo();
	BNodeInfo(BNode* node);
	virtual ~BNodeInfo();

	status_t SetTo(BNode* node);
	status_t InitCheck() const;

	// type must hold B_MIME_TYPE_LENGTH bytes.
	virtual status_t GetType(char* type) const;
	// NULL removes the type attribute.
	virtual status_t SetType(const char* type);

	// The node's own icon: the platform's "BEOS:L:STD_ICON" ('ICON') or
	// "BEOS:M:STD_ICON" ('MICN') attribute of palette indices.
	// B_ENTRY_NOT_FOUND when the node has none.
	virtual status_t GetIcon(BBitmap* icon,
		icon_size which = B_LARGE_ICON) const;

	// The icon a file manager shows: the node's own, else its type's, else a
	// plain file, folder or link picture.
	status_t GetTrackerIcon(BBitmap* icon,
		icon_size which = B_LARGE_ICON) const;
	// The same for an entry; a link whose target is missing gets the link
	// picture.
	static status_t GetTrackerIcon(const entry_ref* ref, BBitmap* icon,
		icon_size which = B_LARGE_ICON);

private:
	BNode* fNode;
	status_t fCStatus;
};

#endif
