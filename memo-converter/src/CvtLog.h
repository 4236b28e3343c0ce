#ifndef MEMO_CONVERTER_SRC_CVTLOG_H
#define MEMO_CONVERTER_SRC_CVTLOG_H

#include <dlog.h>

// The converter logs like the app (tag "MEMO", same line format) without depending on it.
#define CVT_LOG_TAG "MEMO"

#define CVT_LOGE(fmt, arg...)                                                                                          \
	__dlog_print(LOG_ID_MAIN, DLOG_ERROR, CVT_LOG_TAG, "%s: %s(%d) > \e[0;31m* Critical * " fmt "\e[0;m", __MODULE__,  \
	             __func__, __LINE__, ##arg)
#define CVT_LOGI(fmt, arg...)                                                                                          \
	__dlog_print(LOG_ID_MAIN, DLOG_INFO, CVT_LOG_TAG, "%s: %s(%d) > \e[0;32m" fmt "\e[0;m", __MODULE__, __func__,      \
	             __LINE__, ##arg)

#endif
