#ifndef KIT_PRIVATE_ERRNO_STATUS_H
#define KIT_PRIVATE_ERRNO_STATUS_H

#include <SupportDefs.h>

namespace BPrivate {

// The one place where a Linux errno becomes the platform's status code.
status_t StatusFromErrno(int error);

// The same for the current errno.
status_t StatusFromErrno();

}

#endif
