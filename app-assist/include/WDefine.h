#ifndef APP_ASSIST_INCLUDE_WDEFINE_H
#define APP_ASSIST_INCLUDE_WDEFINE_H

#include <dlog.h>

// Log lines of the view framework: tag "WAPP", "file: function(line) > " in front, errors red with
// "* Critical * ", info green (the same shape as the app's own lines).
#define WAPP_LOG_TAG "WAPP"
#define WAPP_COLOR_RED "\e[0;31m"
#define WAPP_COLOR_GREEN "\e[0;32m"
#define WAPP_COLOR_RESET "\e[0;m"

#define WERROR(fmt, arg...)                                                                                            \
	__dlog_print(LOG_ID_MAIN, DLOG_ERROR, WAPP_LOG_TAG,                                                                \
	             "%s: %s(%d) > " WAPP_COLOR_RED "* Critical * " fmt WAPP_COLOR_RESET, __MODULE__, __func__, __LINE__,  \
	             ##arg)
#define WINFO(fmt, arg...)                                                                                             \
	__dlog_print(LOG_ID_MAIN, DLOG_INFO, WAPP_LOG_TAG, "%s: %s(%d) > " WAPP_COLOR_GREEN fmt WAPP_COLOR_RESET,          \
	             __MODULE__, __func__, __LINE__, ##arg)
#define WDEBUG(fmt, arg...)                                                                                            \
	__dlog_print(LOG_ID_MAIN, DLOG_DEBUG, WAPP_LOG_TAG, "%s: %s(%d) > " fmt, __MODULE__, __func__, __LINE__, ##arg)

#endif
