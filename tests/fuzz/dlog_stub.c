/* The fuzz targets link no platform library: log lines are dropped, texts are their keys, toasts go
   nowhere. */
#include <app_i18n.h>
#include <dlog.h>
#include <notification_status.h>

int __dlog_print(log_id_t log_id, int prio, const char *tag, const char *fmt, ...)
{
	(void)log_id;
	(void)prio;
	(void)tag;
	(void)fmt;
	return 0;
}

char *i18n_get_text(const char *message)
{
	return (char *)message;
}

int notification_status_message_post(const char *message)
{
	(void)message;
	return 0;
}
