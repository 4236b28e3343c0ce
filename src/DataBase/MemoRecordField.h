#ifndef SRC_DATABASE_MEMORECORDFIELD_H
#define SRC_DATABASE_MEMORECORDFIELD_H

// The checked setters of the records (MemoDocInfo, MemoFileInfo).

#include "MemoLog.h"

// A flag column holds 0 or 1; a negative value fails the test too, as unsigned.
static inline bool memoRecordIsFlag(int value)
{
	return static_cast<unsigned int>(value) <= 1;
}

// Stores `value` in `field` and returns true when `accepted`; otherwise logs `message` and returns
// false, keeping the old value. A macro, so that the line names the setter that refused.
#define MEMO_RECORD_SET(accepted, field, value, message)                                                               \
	do {                                                                                                               \
		if (!(accepted)) {                                                                                             \
			MEMO_LOGE(message);                                                                                        \
			return false;                                                                                              \
		}                                                                                                              \
		field = (value);                                                                                               \
		return true;                                                                                                   \
	} while (0)

#endif
