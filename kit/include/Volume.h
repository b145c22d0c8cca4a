#ifndef _VOLUME_H
#define _VOLUME_H

#include <SupportDefs.h>

class BDirectory;

// A mounted volume, known by its id (see fs_info.h). Its properties are read
// from the system each time they are asked for.
class BVolume {
public:
	BVolume();
	BVolume(dev_t device);
	BVolume(const BVolume& volume);
	virtual ~BVolume();

	status_t InitCheck() const;
	status_t SetTo(dev_t device);
	void Unset();

	dev_t Device() const;
	status_t GetRootDirectory(BDirectory* directory) const;

	off_t Capacity() const;
	off_t FreeBytes() const;
	off_t BlockSize() const;

	// name must hold B_FILE_NAME_LENGTH bytes.
	status_t GetName(char* name) const;

	bool IsRemovable() const;
	bool IsReadOnly() const;
	bool IsPersistent() const;
	bool IsShared() const;
	bool KnowsMime() const;
	bool KnowsAttr() const;
	bool KnowsQuery() const;

	bool operator==(const BVolume& volume) const;
	bool operator!=(const BVolume& volume) const;
	BVolume& operator=(const BVolume& volume);

private:
	status_t _GetInfo(struct fs_info* info) const;
	bool _HasFlag(uint32 flag) const;

	dev_t fDevice;
	status_t fCStatus;
};

#endif
