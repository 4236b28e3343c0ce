#ifndef __UXT_ENTRY_H__
#define __UXT_ENTRY_H__

#include <Elementary.h>
#include <uxt_error.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Allows dragging text out of the entry (kept as a flag on the desktop). */
int uxt_entry_set_drag_enabled(Evas_Object *entry, Eina_Bool enabled);
Eina_Bool uxt_entry_get_drag_enabled(const Evas_Object *entry);

/* Allows selecting text (elm_entry_select_allow_set). */
int uxt_entry_set_selection_enabled(Evas_Object *entry, Eina_Bool enabled);
Eina_Bool uxt_entry_get_selection_enabled(const Evas_Object *entry);

#ifdef __cplusplus
}
#endif

#endif
