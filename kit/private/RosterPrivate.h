#ifndef KIT_PRIVATE_ROSTER_PRIVATE_H
#define KIT_PRIVATE_ROSTER_PRIVATE_H

#include <functional>

#include <SupportDefs.h>

namespace BPrivate {

// Test support: replaces what BRoster::Launch does once it has a path (or,
// for a launch by type, the MIME type); Launch returns the hook's result.
// An empty function restores the real launcher. Whole-program tests set the
// environment variable VARNEL_LAUNCH_LOG=FILE instead: Launch then appends
// each path and a newline to FILE and starts nothing.
void SetLaunchHook(std::function<status_t(const char* path)> hook);

}

#endif
