#ifndef _SUPPORT_DEFS_H
#define _SUPPORT_DEFS_H

#include <cstddef>
#include <cstdint>
#include <sys/types.h>

#include <Errors.h>

typedef int8_t int8;
typedef uint8_t uint8;
typedef int16_t int16;
typedef uint16_t uint16;
typedef int32_t int32;
typedef uint32_t uint32;
typedef int64_t int64;
typedef uint64_t uint64;

typedef int32 status_t;
typedef int64 bigtime_t;
typedef uint32 type_code;
typedef uint32 perform_code;

// dev_t, ino_t, off_t and mode_t are the system's own (sys/types.h).

#ifndef NULL
#define NULL nullptr
#endif

#define B_INFINITE_TIMEOUT (9223372036854775807LL)

template <typename T>
inline T min_c(T a, T b) { return a < b ? a : b; }
template <typename T>
inline T max_c(T a, T b) { return a > b ? a : b; }

#endif
