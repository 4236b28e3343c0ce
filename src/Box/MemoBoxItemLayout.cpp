// The title layout and the body layout of a box item, and what belongs to them: the title's filter,
// the back key during a title selection, the text styles and the quick memo description.
#include "Box/MemoBoxItem.h"

#include <app_i18n.h>
#include <efl_extension.h>
#include <uxt_edit_field.h>
#include <uxt_entry.h>

#include <cstring>

#include "MemoBoxItemPrivate.h"
#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Util/MemoUtil.h"

namespace
{
// Both limits of a title; the filter keeps a pointer to it, so it lives as long as the process.
Elm_Entry_Filter_Limit_Size gTitleLimit = {MEMO_BOX_TITLE_CHAR_LIMIT, MEMO_BOX_TITLE_CHAR_LIMIT};

const char *const TITLE_BACK_MARK = "eext_entry";

// The scrolling field of the toolkit paints a background of its own; the title shows the page instead.
void clearFieldBackground(Evas_Object *entry)
{
	Eina_List *members = evas_object_smart_members_get(entry);
	void *member = nullptr;
	EINA_LIST_FREE(members, member)
	{
		Evas_Object *obj = static_cast<Evas_Object *>(member);
		const char *type = evas_object_type_get(obj);
		if (type && !strcmp(type, "edje"))
			edje_object_color_class_set(obj, "/bg/normal/entry", 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0);
	}
}

Evas_Coord scaled(int size)
{
	return static_cast<Evas_Coord>(size * elm_config_scale_get() / elm_app_base_scale_get());
}

// Text sizes of the editor at the Elementary scale 1.0, like the theme's other sizes: the toolkit's
// entry is sized for dialogs, a memo is read like a page.
const Evas_Font_Size BODY_TEXT_SIZE = 26;
const Evas_Font_Size TITLE_TEXT_SIZE = 34;

// The entry's text classes, set on this entry's theme objects only (a scrolling field keeps its text in
// an inner one); the font stays the theme's.
void setEntryTextSize(Evas_Object *obj, Evas_Font_Size size)
{
	const char *type = evas_object_type_get(obj);
	if (type && !strcmp(type, "edje")) {
		edje_object_text_class_set(obj, "entry_text", nullptr, size);
		edje_object_text_class_set(obj, "entry_guide_text", nullptr, size);
	}
	Eina_List *members = evas_object_smart_members_get(obj);
	void *member = nullptr;
	EINA_LIST_FREE(members, member)
	setEntryTextSize(static_cast<Evas_Object *>(member), size);
}
} // namespace

void MemoBoxItem::__createTitleLayout()
{
	Evas_Object *layout = elm_layout_add(__layoutObj);
	elm_layout_file_set(layout, MemoUtil::getEdjePath(), __isEditable ? "box_item_title" : "box_item_title_detail");
	evas_object_size_hint_weight_set(layout, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(layout, EVAS_HINT_FILL, 0.0);
	evas_object_show(layout);
	elm_object_part_content_set(__layoutObj, "content", layout);
	__innerLayoutObj = layout;

	if (__isEditable) {
		Evas_Object *entry = uxt_edit_field_add(layout, UXT_EDIT_FIELD_SCROLL_SINGLELINE);
		elm_object_domain_translatable_part_text_set(entry, "elm.guide", MEMO_SUB_DOMAIN, "IDS_MEMO_NPBODY_TITLE");
		elm_entry_cnp_mode_set(entry, ELM_CNP_MODE_PLAINTEXT);
		elm_object_part_content_set(layout, "title", entry);
		elm_entry_editable_set(entry, __type != MEMO_BOX_ITEM_QUICK_TITLE);
		evas_object_smart_callback_add(entry, "selection,start", __titleSelectionStartCb, this);
		evas_object_smart_callback_add(entry, "selection,cleared", __titleSelectionClearedCb, this);
		evas_object_smart_callback_add(entry, "changed", __onEntryChangedCb, this);
		evas_object_smart_callback_add(entry, "preedit,changed", __onEntryChangedCb, this);
		evas_object_smart_callback_add(entry, "activated", __onEntryActivateCb, this);
		evas_object_smart_callback_add(entry, "focused", __onEntryFocusedCb, this);
		evas_object_smart_callback_add(entry, "maxlength,reached", __onEntryMaxLengthCb, this);
		evas_object_event_callback_add(entry, EVAS_CALLBACK_MOUSE_DOWN, __onEntryMouseDownCb, this);
		evas_object_event_callback_add(entry, EVAS_CALLBACK_MOUSE_UP, __onEntryMouseUpCb, this);
		elm_entry_markup_filter_append(entry, __titleFilter, this);
		elm_entry_markup_filter_append(entry, elm_entry_filter_limit_size, &gTitleLimit);
		elm_entry_input_panel_return_key_type_set(entry, ELM_INPUT_PANEL_RETURN_KEY_TYPE_NEXT);
		// The title sits on the page itself: no field background, bold dark text.
		clearFieldBackground(entry);
		setEntryTextSize(entry, TITLE_TEXT_SIZE);
		elm_entry_text_style_user_push(entry, MEMO_BOX_TEXT_STYLE_TITLE);
		__entryObj = entry;
	}

	if (__type == MEMO_BOX_ITEM_TITLE) {
		Evas_Object *star = elm_check_add(layout);
		elm_object_style_set(star, "favorite");
		elm_object_part_content_set(layout, "favorite", star);
		__favoriteObj = star;
		Evas_Object *touch =
		    const_cast<Evas_Object *>(edje_object_part_object_get(elm_layout_edje_get(layout), "favourite.touch"));
		if (touch)
			evas_object_event_callback_add(touch, EVAS_CALLBACK_MOUSE_UP, __onFavoriteMouseUpCb, this);
		else
			MEMO_LOGE("favourite.touch is missing in the theme");
	} else {
		Evas_Object *icon = elm_image_add(layout);
		char *iconPath = MemoUtil::getImageResourcePathN("icon_create_memo_quick.png");
		elm_image_file_set(icon, iconPath, nullptr);
		free(iconPath);
		const Evas_Coord size = scaled(55);
		evas_object_size_hint_min_set(icon, size, size);
		evas_object_size_hint_max_set(icon, size, size);
		elm_image_aspect_fixed_set(icon, EINA_FALSE);
		int r = 97, g = 97, b = 97, a = 255;
		edje_object_color_class_get(elm_layout_edje_get(layout), "AO005", &r, &g, &b, &a, nullptr, nullptr, nullptr,
		                            nullptr, nullptr, nullptr, nullptr, nullptr);
		evas_object_color_set(icon, r * a / 255, g * a / 255, b * a / 255, a);
		elm_object_part_content_set(layout, "favorite", icon);
	}
}

void MemoBoxItem::__createInnerLayout()
{
	if (__innerLayoutObj) {
		elm_object_part_content_unset(__layoutObj, "content");
		if (__entryObj)
			evas_object_event_callback_del_full(__entryObj, EVAS_CALLBACK_KEY_DOWN, __onEntryKeyDownCb, this);
		evas_object_del(__innerLayoutObj);
		__innerLayoutObj = nullptr;
		__entryObj = nullptr;
		__checkObj = nullptr;
	}

	const bool isCheck = memoBoxItemIsCheck(__type);
	Evas_Object *layout = elm_layout_add(__layoutObj);
	elm_layout_file_set(layout, MemoUtil::getEdjePath(), isCheck ? "box_item_check" : "box_item_text");
	evas_object_size_hint_weight_set(layout, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(layout, EVAS_HINT_FILL, 0.0);
	const bool isTop =
	    __type == MEMO_BOX_ITEM_FIRST_CHECK || __type == MEMO_BOX_ITEM_FIRST_TEXT || __type == MEMO_BOX_ITEM_QUICK_TEXT;
	elm_object_signal_emit(layout, isTop ? "top,item" : "normal,item", "elm");
	evas_object_show(layout);
	elm_object_part_content_set(__layoutObj, "content", layout);
	__innerLayoutObj = layout;

	if (isCheck) {
		Evas_Object *check = elm_check_add(layout);
		elm_object_style_set(check, "memo_check");
		elm_object_part_content_set(layout, "check", check);
		evas_object_smart_callback_add(check, "changed", __onCheckChangedCb, this);
		evas_object_event_callback_add(check, EVAS_CALLBACK_MOUSE_DOWN, __onCheckMouseDownCb, this);
		evas_object_event_callback_add(check, EVAS_CALLBACK_MOUSE_UP, __onCheckMouseUpCb, this);
		__checkObj = check;
	}

	Evas_Object *entry = elm_entry_add(layout);
	elm_entry_cnp_mode_set(entry, ELM_CNP_MODE_MARKUP);
	setEntryTextSize(entry, BODY_TEXT_SIZE);
	__entryObj = entry;

	if (__type == MEMO_BOX_ITEM_FIRST_TEXT && __listener)
		__listener->onCheckGuideText(this);
	if (__type == MEMO_BOX_ITEM_QUICK_TEXT && !__isEditable) {
		if (!__busListenerId)
			__busListenerId = MemoBroadCaster::getInstance().addListener(
			    [this](const char *, void *) { __setQuickPanelDescription(); }, __layoutObj);
		__setQuickPanelDescription();
	}

	elm_object_part_content_set(layout, "entry", entry);
	elm_entry_editable_set(entry, __isEditable);
	uxt_entry_set_drag_enabled(entry, __isEditable);
	uxt_entry_set_selection_enabled(entry, __isEditable);
	elm_entry_context_menu_disabled_set(entry, !__isEditable);

	elm_entry_item_provider_prepend(entry, __onEntryItemProviderCb, this);
	evas_object_event_callback_add(entry, EVAS_CALLBACK_KEY_DOWN, __onEntryKeyDownCb, this);
	evas_object_smart_callback_add(entry, "focused", __onEntryFocusedCb, this);
	evas_object_smart_callback_add(entry, "activated", __onEntryActivateCb, this);
	evas_object_smart_callback_add(entry, "changed", __onEntryChangedCb, this);
	evas_object_smart_callback_add(entry, "preedit,changed", __onEntryChangedCb, this);
	evas_object_smart_callback_add(entry, "maxlength,reached", __onEntryMaxLengthCb, this);
	evas_object_smart_callback_add(entry, "longpressed", __onEntryLongPressedCb, this);
	evas_object_smart_callback_add(entry, "clicked", __onEntryClickedCb, this);
	evas_object_event_callback_add(entry, EVAS_CALLBACK_MOUSE_DOWN, __onEntryMouseDownCb, this);
	evas_object_event_callback_add(entry, EVAS_CALLBACK_MOUSE_UP, __onEntryMouseUpCb, this);
	elm_entry_markup_filter_append(entry, __entryFilter, this);
	elm_entry_text_style_user_push(entry, MEMO_BOX_TEXT_STYLE_NORMAL);
}

void MemoBoxItem::__pushTextStyle(bool checked)
{
	if (!__entryObj)
		return;
	elm_entry_text_style_user_pop(__entryObj);
	elm_entry_text_style_user_push(__entryObj, checked ? MEMO_BOX_TEXT_STYLE_CHECKED : MEMO_BOX_TEXT_STYLE_NORMAL);
}

void MemoBoxItem::__setQuickPanelDescription()
{
	if (__type != MEMO_BOX_ITEM_QUICK_TEXT || __isEditable || !__entryObj) {
		MEMO_LOGE("Quick memo description can not be set in this item type");
		return;
	}
	std::string text =
	    i18n_get_text("IDS_MEMO_BODY_COLLECT_TEXT_FROM_ANY_APP_BY_SELECTING_IT_AND_TAPPING_QUICK_MEMO_MSG");
	memoBoxReplaceAll(text, "\n", MEMO_BOX_LINE_BREAK);
	elm_object_part_text_set(__entryObj, "elm.guide", text.c_str());
}

void MemoBoxItem::__titleFilter(void *data, Evas_Object *entry, char **text)
{
	(void)data;
	(void)entry;
	if (!text || !*text)
		return;
	// Composition text is the input method's business until it is committed.
	if (strstr(*text, "<preedit") && strstr(*text, "</preedit"))
		return;
	char *plain = elm_entry_markup_to_utf8(*text);
	if (!plain)
		return;
	char *markup = elm_entry_utf8_to_markup(plain);
	free(plain);
	if (!markup)
		return;
	std::string oneLine = markup;
	free(markup);
	memoBoxReplaceAll(oneLine, MEMO_BOX_LINE_BREAK, "");
	free(*text);
	*text = strdup(oneLine.c_str());
}

void MemoBoxItem::__titleSelectionStartCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	if (evas_object_data_get(obj, TITLE_BACK_MARK))
		return;
	eext_object_event_callback_add(obj, EEXT_CALLBACK_BACK, __titleBackKeyCb, data);
	evas_object_data_set(obj, TITLE_BACK_MARK, obj);
}

void MemoBoxItem::__titleSelectionClearedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)data;
	(void)eventInfo;
	if (!evas_object_data_get(obj, TITLE_BACK_MARK))
		return;
	eext_object_event_callback_del(obj, EEXT_CALLBACK_BACK, __titleBackKeyCb);
	evas_object_data_del(obj, TITLE_BACK_MARK);
}

// The first back press during a selection only ends the selection.
void MemoBoxItem::__titleBackKeyCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)data;
	(void)eventInfo;
	if (elm_entry_selection_get(obj))
		elm_entry_select_none(obj);
	eext_object_event_callback_del(obj, EEXT_CALLBACK_BACK, __titleBackKeyCb);
	evas_object_data_del(obj, TITLE_BACK_MARK);
}
