#ifndef KIT_APP_APP_MAIN_LOOP_H
#define KIT_APP_APP_MAIN_LOOP_H

#include <memory>

#include "MainLoop.h"

namespace BPrivate {

// The installed main loop, kept alive for as long as the caller holds it
// (BApplication::Run runs it while another may be installed).
std::shared_ptr<MainLoop> ActiveMainLoop();
// Wakes the installed main loop, if any.
void WakeMainLoop();

}

#endif
