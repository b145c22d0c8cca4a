#ifndef _FIND_DIRECTORY_H
#define _FIND_DIRECTORY_H

#include <SupportDefs.h>

class BPath;
class BVolume;

// The folders the program can ask for, with the platform's numbers, and
// where they lie on Linux:
//   B_DESKTOP_DIRECTORY        XDG_DESKTOP_DIR of user-dirs.dirs, else ~/Desktop
//   B_TRASH_DIRECTORY          the freedesktop.org home trash's files folder,
//                              $XDG_DATA_HOME/Trash/files; it is created,
//                              with info/, at mode 0700 whenever it is
//                              missing, create or not (the trash always
//                              exists on the original platform)
//   B_BEOS_APPS_DIRECTORY      /usr/bin
//   B_COMMON_TEMP_DIRECTORY    $TMPDIR, else /tmp
//   B_USER_DIRECTORY           $HOME
//   B_USER_CONFIG_DIRECTORY    $XDG_CONFIG_HOME, else ~/.config
//   B_USER_FONTS_DIRECTORY     $XDG_DATA_HOME/fonts
//   B_USER_SETTINGS_DIRECTORY  $XDG_CONFIG_HOME, else ~/.config
// (XDG_DATA_HOME defaults to ~/.local/share.) All are per user, whatever
// volume is given. With createIt, a missing folder is created with its
// parents; without it, the path is returned whether or not it exists.
typedef enum {
	B_DESKTOP_DIRECTORY = 0,
	B_TRASH_DIRECTORY = 1,
	B_BEOS_APPS_DIRECTORY = 1007,
	B_COMMON_TEMP_DIRECTORY = 2014,
	B_USER_DIRECTORY = 3000,
	B_USER_CONFIG_DIRECTORY = 3001,
	B_USER_FONTS_DIRECTORY = 3004,
	B_USER_SETTINGS_DIRECTORY = 3006
} directory_which;

status_t find_directory(directory_which which, dev_t volume, bool createIt,
	char* returnedPath, int32 pathLength);
status_t find_directory(directory_which which, BPath* path,
	bool createIt = false, BVolume* volume = NULL);

#endif
