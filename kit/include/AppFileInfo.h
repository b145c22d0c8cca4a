#ifndef _APP_FILE_INFO_H
#define _APP_FILE_INFO_H

#include <NodeInfo.h>

class BFile;

enum version_kind {
	B_APP_VERSION_KIND,
	B_SYSTEM_VERSION_KIND
};

enum {
	B_DEVELOPMENT_VERSION = 0,
	B_ALPHA_VERSION,
	B_BETA_VERSION,
	B_GAMMA_VERSION,
	B_GOLDEN_MASTER_VERSION,
	B_FINAL_VERSION
};

struct version_info {
	uint32 major;
	uint32 middle;
	uint32 minor;
	uint32 variety;
	uint32 internal;
	char short_info[64];
	char long_info[256];
};

// The application data of an executable. For the running program they are
// the resources compiled into it (cmake/EmbedResources.cmake) and the
// version it was built as; any other file has only the icons of its
// attributes (see BNodeInfo::GetIcon).
class BAppFileInfo : public BNodeInfo {
public:
	BAppFileInfo();
	BAppFileInfo(BFile* file);
	virtual ~BAppFileInfo();

	status_t SetTo(BFile* file);

	// B_ENTRY_NOT_FOUND when the program has no icon of that size.
	virtual status_t GetIcon(BBitmap* icon,
		icon_size which = B_LARGE_ICON) const;
	// B_APP_VERSION_KIND only; B_ENTRY_NOT_FOUND for any other kind or file.
	status_t GetVersionInfo(version_info* info, version_kind kind) const;

private:
	bool fIsRunningProgram;
};

#endif
