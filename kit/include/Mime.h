#ifndef _MIME_H
#define _MIME_H

#include <SupportDefs.h>

// The two icon sizes, in pixels per side.
enum icon_size {
	B_LARGE_ICON = 32,
	B_MINI_ICON = 16
};

#include <MimeType.h>

#endif
