#ifndef KIT_STORAGE_USER_FOLDERS_H
#define KIT_STORAGE_USER_FOLDERS_H

#include <string>

namespace BPrivate {

// The user's folders after the XDG base directory and user-dirs rules,
// read from the environment at each call.
std::string HomeFolder();
std::string DataHome();
std::string ConfigHome();
std::string DesktopFolder();

}

#endif
