/* Edit fields: an entry set up for its kind, with a clear button on single-line kinds. */
#include <uxt_edit_field.h>

#include <dlog.h>

#define CLEAR_BUTTON_KEY "__uxt_clear_button"

static Eina_Bool __isSingleLine(int type)
{
	return type != UXT_EDIT_FIELD_MULTILINE && type != UXT_EDIT_FIELD_SCROLL_MULTILINE;
}

static Eina_Bool __isScrollable(int type)
{
	return type != UXT_EDIT_FIELD_SINGLELINE && type != UXT_EDIT_FIELD_MULTILINE;
}

/* The button shows only while the field is being edited and there is something to clear. */
static void __clearButtonUpdate(Evas_Object *entry)
{
	Evas_Object *button = evas_object_data_get(entry, CLEAR_BUTTON_KEY);
	if (!button)
		return;
	/* Not elm_entry_is_empty: inside "changed" it moves the cursor to where the pending change began, so
	   that every typed character would land at the same place. */
	const char *text = elm_entry_entry_get(entry);
	Eina_Bool show = text && *text && elm_entry_editable_get(entry) && elm_object_focus_get(entry);
	if (elm_object_part_content_get(entry, "elm.swallow.clear") == button) {
		if (show)
			evas_object_show(button);
		else
			evas_object_hide(button);
	} else {
		elm_entry_end_visible_set(entry, show);
	}
}

static void __entryChangedCb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)event_info;
	__clearButtonUpdate(obj);
}

static void __clearClickedCb(void *data, Evas_Object *obj, void *event_info)
{
	(void)obj;
	(void)event_info;
	Evas_Object *entry = data;
	elm_entry_entry_set(entry, "");
	elm_object_focus_set(entry, EINA_TRUE);
	__clearButtonUpdate(entry);
}

static void __addClearButton(Evas_Object *entry)
{
	Evas_Object *button = elm_button_add(entry);
	if (!button) {
		LOGE("cannot create the clear button");
		return;
	}
	Evas_Object *icon = elm_icon_add(button);
	if (icon && elm_icon_standard_set(icon, "edit-clear")) {
		elm_object_part_content_set(button, "icon", icon);
	} else {
		evas_object_del(icon);
		elm_object_text_set(button, "x");
	}
	elm_object_focus_allow_set(button, EINA_FALSE);
	evas_object_smart_callback_add(button, "clicked", __clearClickedCb, entry);

	Evas_Object *edje = elm_layout_edje_get(entry);
	const char *part = (edje && edje_object_part_exists(edje, "elm.swallow.clear")) ? "elm.swallow.clear" : "end";
	elm_object_part_content_set(entry, part, button);
	evas_object_data_set(entry, CLEAR_BUTTON_KEY, button);
	evas_object_smart_callback_add(entry, "changed", __entryChangedCb, NULL);
	evas_object_smart_callback_add(entry, "preedit,changed", __entryChangedCb, NULL);
	evas_object_smart_callback_add(entry, "focused", __entryChangedCb, NULL);
	evas_object_smart_callback_add(entry, "unfocused", __entryChangedCb, NULL);
	__clearButtonUpdate(entry);
}

Evas_Object *uxt_edit_field_add(Evas_Object *parent, int type)
{
	if (!parent || type < 0 || type >= UXT_EDIT_FIELD_LAST) {
		LOGE("invalid parameter: parent %p, type %d", (void *)parent, type);
		return NULL;
	}
	Evas_Object *entry = elm_entry_add(parent);
	if (!entry) {
		LOGE("cannot create the entry");
		return NULL;
	}
	elm_entry_single_line_set(entry, __isSingleLine(type));
	elm_entry_scrollable_set(entry, __isScrollable(type));
	if (type == UXT_EDIT_FIELD_SCROLL_SINGLELINE_PASSWORD)
		elm_entry_password_set(entry, EINA_TRUE);
	if (type == UXT_EDIT_FIELD_SEARCHBAR)
		elm_entry_input_panel_return_key_type_set(entry, ELM_INPUT_PANEL_RETURN_KEY_TYPE_SEARCH);
	evas_object_size_hint_weight_set(entry, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(entry, EVAS_HINT_FILL, EVAS_HINT_FILL);
	if (__isSingleLine(type))
		__addClearButton(entry);
	return entry;
}
