// The search view's title: the search field with its guide, filter and callbacks, and the back button.
#include "View/MemoSearchView.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <app_i18n.h>
#include <notification_status.h>
#include <uxt_edit_field.h>
#include <uxt_theme.h>

#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
// The search glyph of the platform's icon font, in front of the guide.
const char SEARCH_GLYPH[] = "\xEF\xA2\x97 ";
// The input is bounded in bytes, not characters.
Elm_Entry_Filter_Limit_Size gSearchLimit = {0, 32};

const char *const CLEAR_BUTTON_COLORS[][2] = {
    {"W0113", "F050"}, {"W0113D", "F050D"}, {"W0113P", "F050P"}, {"B042", "B043"}, {"B042A", "B043A"}};
} // namespace

Evas_Object *MemoSearchView::__createSearchBar(Evas_Object *parent)
{
	Evas_Object *bar = elm_layout_add(parent);
	elm_layout_file_set(bar, MemoUtil::getEdjePath(), "naviframe_searchbar");

	__entry = uxt_edit_field_add(bar, UXT_EDIT_FIELD_SEARCHBAR);
	__guideEntry = __entry;
	elm_object_style_set(__entry, "editfield/searchbar/title");
	__setGuideText();
	elm_entry_input_panel_return_key_type_set(__entry, ELM_INPUT_PANEL_RETURN_KEY_TYPE_SEARCH);
	elm_entry_autocapital_type_set(__entry, ELM_AUTOCAPITAL_TYPE_SENTENCE);
	elm_entry_cnp_mode_set(__entry, ELM_CNP_MODE_PLAINTEXT);
	elm_entry_cursor_end_set(__entry);
	Evas_Object *clear = elm_object_part_content_get(__entry, "elm.swallow.clear");
	if (clear)
		for (const auto &colors : CLEAR_BUTTON_COLORS)
			uxt_theme_object_replace_color(clear, colors[0], colors[1]);
	evas_object_size_hint_weight_set(__entry, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(__entry, EVAS_HINT_FILL, 0.5);
	elm_object_part_content_set(bar, "elm.swallow.searchbar", __entry);

	// So worded, though the button goes back.
	Evas_Object *back = elm_button_add(bar);
	// The default theme has a group of this style: the button takes the app's (the title bar's arrow) from a
	// theme of its own that puts the app's file first.
	Elm_Theme *theme = elm_theme_new();
	elm_theme_overlay_add(theme, MemoUtil::getEdjePath());
	elm_object_theme_set(back, theme);
	elm_theme_free(theme);
	elm_object_style_set(back, "naviframe/back_btn/default");
	elm_object_text_set(back, "Next Page");
	elm_object_part_content_set(bar, "prev_btn", back);
	evas_object_smart_callback_add(back, "clicked", __backBtnCb, this);

	elm_entry_markup_filter_append(__entry, elm_entry_filter_limit_size, &gSearchLimit);
	evas_object_smart_callback_add(__entry, "changed", __entryChangedCb, this);
	evas_object_smart_callback_add(__entry, "preedit,changed", __entryChangedCb, this);
	evas_object_smart_callback_add(__entry, "activated", __entryActivatedCb, this);
	evas_object_smart_callback_add(__entry, "maxlength,reached", __maxLengthReachedCb, this);
	return bar;
}

void MemoSearchView::__setGuideText()
{
	std::string guide = std::string(SEARCH_GLYPH) + i18n_get_text("IDS_MEMO_OPT_SEARCH");
	elm_object_part_text_set(__guideEntry, "elm.guide", guide.c_str());
}

char *MemoSearchView::__getEntryTextN()
{
	const char *markup = __entry ? elm_entry_entry_get(__entry) : nullptr;
	return markup ? elm_entry_markup_to_utf8(markup) : nullptr;
}

void MemoSearchView::__entryChangedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoSearchView *self = static_cast<MemoSearchView *>(data);
	if (!self)
		return;
	char *text = self->__getEntryTextN();
	if (self->__lastEntryText && text && !strcmp(self->__lastEntryText, text)) {
		free(text);
		return;
	}
	free(self->__lastEntryText);
	self->__lastEntryText = strdup(text ? text : "");
	free(text);
	self->__search(self->__lastEntryText);
}

void MemoSearchView::__entryActivatedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)data;
	(void)eventInfo;
	elm_object_focus_set(obj, EINA_FALSE);
}

void MemoSearchView::__maxLengthReachedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)data;
	(void)obj;
	(void)eventInfo;
	notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"));
}

void MemoSearchView::__backBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoSearchView *self = static_cast<MemoSearchView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->popOut();
}
