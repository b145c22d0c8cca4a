#ifndef _FS_ATTR_H
#define _FS_ATTR_H

#include <SupportDefs.h>

// The type and size of an attribute (see BNode for how attributes are kept).
typedef struct attr_info {
	uint32 type;
	off_t size;
} attr_info;

#endif
