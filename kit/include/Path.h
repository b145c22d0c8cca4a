#ifndef _PATH_H
#define _PATH_H

#include <string>

#include <Flattenable.h>
#include <StorageDefs.h>

class BDirectory;
class BEntry;
struct entry_ref;

// An absolute path string. It is normalised (".", ".." and "//" taken out,
// the folder's links resolved; the folder must exist) when asked to, and
// whenever the string needs it: a relative path, one containing "." or ".."
// components or "//", or one ending in "/". A leaf must be relative.
//
// A BPath flattens to the flat form of its entry's entry_ref (B_REF_TYPE),
// so a path added to a message with AddFlat reads back with FindRef as well
// as with FindFlat.
class BPath : public BFlattenable {
public:
	BPath();
	BPath(const BPath& path);
	BPath(const entry_ref* ref);
	BPath(const BEntry* entry);
	BPath(const char* dir, const char* leaf = NULL, bool normalize = false);
	BPath(const BDirectory* dir, const char* leaf = NULL,
		bool normalize = false);
	virtual ~BPath();

	status_t InitCheck() const;

	status_t SetTo(const entry_ref* ref);
	status_t SetTo(const BEntry* entry);
	status_t SetTo(const char* path, const char* leaf = NULL,
		bool normalize = false);
	status_t SetTo(const BDirectory* dir, const char* leaf = NULL,
		bool normalize = false);
	void Unset();

	status_t Append(const char* path, bool normalize = false);

	// NULL when the object is not initialised.
	const char* Path() const;
	const char* Leaf() const;
	status_t GetParent(BPath* path) const;

	bool operator==(const BPath& item) const;
	bool operator==(const char* path) const;
	bool operator!=(const BPath& item) const;
	bool operator!=(const char* path) const;
	BPath& operator=(const BPath& item);
	BPath& operator=(const char* path);

	virtual bool IsFixedSize() const;
	virtual type_code TypeCode() const;
	virtual ssize_t FlattenedSize() const;
	virtual status_t Flatten(void* buffer, ssize_t size) const;
	virtual bool AllowsTypeCode(type_code code) const;
	virtual status_t Unflatten(type_code code, const void* buffer,
		ssize_t size);

private:
	std::string fName;
	status_t fCStatus;
};

#endif
