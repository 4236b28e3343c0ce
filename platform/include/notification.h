#ifndef __NOTIFICATION_H__
#define __NOTIFICATION_H__

#include <notification_error.h>
#include <notification_status.h>

#endif
