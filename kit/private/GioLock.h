#ifndef KIT_PRIVATE_GIO_LOCK_H
#define KIT_PRIVATE_GIO_LOCK_H

#include <mutex>

namespace BPrivate {

// GLib's own locks are invisible to ThreadSanitizer, which then reports
// races inside GIO between the kit's threads; every GIO call in the kit
// holds this lock instead.
std::mutex& GioLock();

}

#endif
