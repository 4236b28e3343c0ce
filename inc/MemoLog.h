#ifndef INC_MEMOLOG_H
#define INC_MEMOLOG_H

#include <dlog.h>

// The app's log lines: tag "MEMO", "file: function(line) > " in front, errors red with
// "* Critical * ", info green.
#define MEMO_LOG_TAG "MEMO"
#define MEMO_COLOR_RED "\e[0;31m"
#define MEMO_COLOR_GREEN "\e[0;32m"
#define MEMO_COLOR_RESET "\e[0;m"

#define MEMO_LOGE(fmt, arg...)                                                                                        \
	__dlog_print(LOG_ID_MAIN, DLOG_ERROR, MEMO_LOG_TAG,                                                            \
		     "%s: %s(%d) > " MEMO_COLOR_RED "* Critical * " fmt MEMO_COLOR_RESET, __MODULE__, __func__, __LINE__,     \
		     ##arg)
#define MEMO_LOGI(fmt, arg...)                                                                                        \
	__dlog_print(LOG_ID_MAIN, DLOG_INFO, MEMO_LOG_TAG, "%s: %s(%d) > " MEMO_COLOR_GREEN fmt MEMO_COLOR_RESET,     \
		     __MODULE__, __func__, __LINE__, ##arg)
#define MEMO_LOGD(fmt, arg...)                                                                                        \
	__dlog_print(LOG_ID_MAIN, DLOG_DEBUG, MEMO_LOG_TAG, "%s: %s(%d) > " fmt, __MODULE__, __func__, __LINE__, ##arg)

#endif
