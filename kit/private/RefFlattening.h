#ifndef KIT_PRIVATE_REF_FLATTENING_H
#define KIT_PRIVATE_REF_FLATTENING_H

#include <SupportDefs.h>

struct entry_ref;

namespace BPrivate {

// The one flat form of an entry_ref (B_REF_TYPE): int64 device, int64 folder
// node, then the name with its terminating NUL. BMessage stores refs this way
// and BPath flattens to it, so a flattened path reads back as a ref.
ssize_t FlattenedRefSize(const entry_ref& ref);
status_t FlattenRef(const entry_ref& ref, void* buffer, ssize_t size);
status_t UnflattenRef(entry_ref* ref, const void* buffer, ssize_t size);

}

#endif
