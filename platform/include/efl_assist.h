#ifndef __EFL_ASSIST_H__
#define __EFL_ASSIST_H__

#include <efl_assist_theme.h>

#endif
