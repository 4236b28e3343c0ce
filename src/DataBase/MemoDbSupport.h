#ifndef SRC_DATABASE_MEMODBSUPPORT_H
#define SRC_DATABASE_MEMODBSUPPORT_H

#include <sys/time.h>

#include <vconf.h>

// Written after every announced change; the sync service watches it.
#define MEMO_DATA_CHANGE_KEY "db/memo/data-change"

// Store time stamps: whole seconds since the epoch, in milliseconds.
static inline unsigned long long memoDbTimeStamp()
{
	struct timeval now;
	gettimeofday(&now, nullptr);
	return static_cast<unsigned long long>(now.tv_sec) * 1000ULL;
}

static inline void memoDbNotifyChange()
{
	vconf_set_int(MEMO_DATA_CHANGE_KEY, 1);
}

#endif
