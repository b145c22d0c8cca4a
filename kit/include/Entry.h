#ifndef _ENTRY_H
#define _ENTRY_H

#include <StorageDefs.h>
#include <sys/stat.h>

// A reference to a file-system entry: the device, the node of the folder it
// is in, and its name. Two refs are equal when those three are.
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

#endif
