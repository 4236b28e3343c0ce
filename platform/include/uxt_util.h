#ifndef __UXT_UTIL_H__
#define __UXT_UTIL_H__

#include <time.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Fields of a date-time text, OR-ed into the format argument below (0x37: date and 24-hour time,
   0x77: date and 12-hour time). */
typedef enum {
	UXT_UTIL_DATE_TIME_FORMAT_YEAR = 0x01,
	UXT_UTIL_DATE_TIME_FORMAT_MONTH = 0x02,
	UXT_UTIL_DATE_TIME_FORMAT_DAY = 0x04,
	UXT_UTIL_DATE_TIME_FORMAT_WEEKDAY = 0x08,
	UXT_UTIL_DATE_TIME_FORMAT_HOUR = 0x10,
	UXT_UTIL_DATE_TIME_FORMAT_MINUTE = 0x20,
	UXT_UTIL_DATE_TIME_FORMAT_12H = 0x40,
	UXT_UTIL_DATE_TIME_FORMAT_SECOND = 0x80,
} Uxt_Util_Date_Time_Format;

/* Formats time with the locale's best pattern for the requested fields (locale like "en_US" or
   "ko_KR.UTF-8"; NULL or empty uses "en_US"). Returns a malloc'ed text the caller frees, or NULL (logged)
   on a null time or a format without fields. */
char *uxt_util_get_date_time_text_by_locale(int format, const char *locale, const struct tm *time);

#ifdef __cplusplus
}
#endif

#endif
