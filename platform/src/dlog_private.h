#ifndef PLATFORM_SRC_DLOG_PRIVATE_H
#define PLATFORM_SRC_DLOG_PRIVATE_H

#include <stdbool.h>

/* The app's lifecycle says when the main thread's lines may be gathered although the main loop does not run
   yet: from create until the loop has ended, the first request and the first frame included. Ending the
   span writes what was gathered. */
void dlog_gather_main_thread(bool on);

/* Writes the gathered lines now. */
void dlog_flush(void);

#endif
