#ifndef __TIZEN_COMMON_TIZEN_TYPE_H__
#define __TIZEN_COMMON_TIZEN_TYPE_H__

#include <stdbool.h>

#define EXPORT_API __attribute__((__visibility__("default")))

#endif
