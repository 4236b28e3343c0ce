/* Entry and scroller switches that the desktop keeps as flags on the object, or maps to Elementary. */
#include <uxt_entry.h>
#include <uxt_scroller.h>

#include <dlog.h>
#include <elm_entry_eo.h>
#include <stdint.h>

#define DRAG_KEY "__uxt_drag_enabled"
#define AUTO_SCROLL_KEY "__uxt_auto_scroll_disabled"

int uxt_entry_set_drag_enabled(Evas_Object *entry, Eina_Bool enabled)
{
	if (!entry) {
		LOGE("entry is NULL");
		return UXT_ERROR_INVALID_PARAMETER;
	}
	evas_object_data_set(entry, DRAG_KEY, (void *)(intptr_t)(enabled ? 1 : 0));
	return UXT_ERROR_NONE;
}

Eina_Bool uxt_entry_get_drag_enabled(const Evas_Object *entry)
{
	return entry && evas_object_data_get(entry, DRAG_KEY) != NULL;
}

int uxt_entry_set_selection_enabled(Evas_Object *entry, Eina_Bool enabled)
{
	if (!entry || !efl_isa(entry, ELM_ENTRY_CLASS)) {
		LOGE("%p is not an entry", (void *)entry);
		return UXT_ERROR_INVALID_PARAMETER;
	}
	elm_entry_select_allow_set(entry, enabled);
	return UXT_ERROR_NONE;
}

Eina_Bool uxt_entry_get_selection_enabled(const Evas_Object *entry)
{
	return entry && efl_isa(entry, ELM_ENTRY_CLASS) && elm_entry_select_allow_get(entry);
}

int uxt_scroller_set_auto_scroll_enabled(Evas_Object *scroller, Eina_Bool enabled)
{
	if (!scroller) {
		LOGE("scroller is NULL");
		return UXT_ERROR_INVALID_PARAMETER;
	}
	evas_object_data_set(scroller, AUTO_SCROLL_KEY, (void *)(intptr_t)(enabled ? 0 : 1));
	return UXT_ERROR_NONE;
}

Eina_Bool uxt_scroller_get_auto_scroll_enabled(const Evas_Object *scroller)
{
	return scroller && evas_object_data_get(scroller, AUTO_SCROLL_KEY) == NULL;
}
