#ifndef __UXT_SCROLLER_H__
#define __UXT_SCROLLER_H__

#include <Elementary.h>
#include <uxt_error.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Lets the scroller follow the focused entry's cursor (kept as a flag on the desktop; on by default). */
int uxt_scroller_set_auto_scroll_enabled(Evas_Object *scroller, Eina_Bool enabled);
Eina_Bool uxt_scroller_get_auto_scroll_enabled(const Evas_Object *scroller);

#ifdef __cplusplus
}
#endif

#endif
