#ifndef __TIZEN_H__
#define __TIZEN_H__

#include <tizen_error.h>
#include <tizen_type.h>

#endif
