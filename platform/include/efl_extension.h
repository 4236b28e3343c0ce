#ifndef __EFL_EXTENSION_H__
#define __EFL_EXTENSION_H__

/* Widget extensions: hardware back/more key routing and the floating button. */
#include <Elementary.h>

#include <efl_extension_events.h>
#include <eext_floatingbutton.h>

#endif
