#ifndef _OS_H
#define _OS_H

#include <SupportDefs.h>

typedef int32 thread_id;
typedef int32 team_id;
typedef int32 port_id;
typedef int32 sem_id;

// Microseconds since an arbitrary start (monotonic).
bigtime_t system_time();
// Sleeps for the given number of microseconds.
status_t snooze(bigtime_t microseconds);
// The id of the calling thread (the kernel's thread id).
thread_id find_thread(const char* name);

#define B_OS_NAME_LENGTH 32

#endif
