#ifndef _DLOG_H_
#define _DLOG_H_

#include <stdarg.h>
#include <string.h>
#include <tizen_error.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	DLOG_ERROR_NONE = TIZEN_ERROR_NONE,
	DLOG_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	DLOG_ERROR_NOT_PERMITTED = TIZEN_ERROR_NOT_PERMITTED,
} dlog_error_e;

typedef enum {
	DLOG_UNKNOWN = 0,
	DLOG_DEFAULT,
	DLOG_VERBOSE,
	DLOG_DEBUG,
	DLOG_INFO,
	DLOG_WARN,
	DLOG_ERROR,
	DLOG_FATAL,
	DLOG_SILENT,
	DLOG_PRIO_MAX,
} log_priority;

typedef enum {
	LOG_ID_MAIN = 0,
	LOG_ID_RADIO,
	LOG_ID_SYSTEM,
	LOG_ID_APPS,
	LOG_ID_MAX,
} log_id_t;

/* Writes "<prio letter>/<tag>( pid): <message>" to stderr and appends it to dlog.log in the
   data folder. Lines below DLOG_LEVEL (a number, default 0) are dropped. */
int __dlog_print(log_id_t log_id, int prio, const char *tag, const char *fmt, ...)
	__attribute__((format(printf, 4, 5)));
int __dlog_vprint(log_id_t log_id, int prio, const char *tag, const char *fmt, va_list ap);
int dlog_print(log_priority prio, const char *tag, const char *fmt, ...) __attribute__((format(printf, 3, 4)));
int dlog_vprint(log_priority prio, const char *tag, const char *fmt, va_list ap);

#ifndef __MODULE__
#define __MODULE__ (strrchr(__FILE__, '/') ? strrchr(__FILE__, '/') + 1 : __FILE__)
#endif

#ifndef LOG_TAG
#define LOG_TAG NULL
#endif

#define LOG_(id, prio, tag, fmt, arg...)                                                                              \
	__dlog_print(id, prio, tag, "%s: %s(%d) > " fmt, __MODULE__, __func__, __LINE__, ##arg)
#define LOGV(format, arg...) LOG_(LOG_ID_MAIN, DLOG_VERBOSE, LOG_TAG, format, ##arg)
#define LOGD(format, arg...) LOG_(LOG_ID_MAIN, DLOG_DEBUG, LOG_TAG, format, ##arg)
#define LOGI(format, arg...) LOG_(LOG_ID_MAIN, DLOG_INFO, LOG_TAG, format, ##arg)
#define LOGW(format, arg...) LOG_(LOG_ID_MAIN, DLOG_WARN, LOG_TAG, format, ##arg)
#define LOGE(format, arg...) LOG_(LOG_ID_MAIN, DLOG_ERROR, LOG_TAG, format, ##arg)
#define LOGF(format, arg...) LOG_(LOG_ID_MAIN, DLOG_FATAL, LOG_TAG, format, ##arg)

#ifdef __cplusplus
}
#endif

#endif
