#include "MemoViewParts.h"

#include <cstdlib>

#include <eext_floatingbutton.h>

#include "Util/MemoUtil.h"

bool memoViewPageLayoutAdd(Evas_Object *parent, const char *group, Evas_Object **layout)
{
	*layout = elm_layout_add(parent);
	evas_object_size_hint_weight_set(*layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	return elm_layout_file_set(*layout, MemoUtil::getEdjePath(), group);
}

Evas_Object *memoViewNoContentLayoutAdd(Evas_Object *parent, const char *domain, const char *textId)
{
	Evas_Object *layout = elm_layout_add(parent);
	elm_layout_theme_set(layout, "layout", "nocontents", "default");
	evas_object_size_hint_weight_set(layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(layout, EVAS_HINT_FILL, EVAS_HINT_FILL);
	elm_object_domain_translatable_part_text_set(layout, "elm.text", domain, textId);
	elm_object_domain_translatable_part_text_set(layout, "elm.help.text", domain,
	                                             "IDS_MEMO_BODY_AFTER_YOU_CREATE_MEMOS_THEY_WILL_BE_SHOWN_HERE");
	elm_object_signal_emit(layout, "text,disabled", "");
	elm_object_signal_emit(layout, "align.center", "elm");
	evas_object_show(layout);
	return layout;
}

Evas_Object *memoViewNewMemoFloatingButtonAdd(Evas_Object *baseLayout, Evas_Smart_Cb cb, void *data)
{
	Evas_Object *floatingBtn = eext_floatingbutton_add(baseLayout);
	if (!floatingBtn)
		return nullptr;
	eext_floatingbutton_mode_set(floatingBtn, EEXT_FLOATINGBUTTON_MODE_BOTH_SIDES);
	Evas_Object *button = elm_button_add(floatingBtn);
	elm_object_style_set(button, "memo_floating");
	elm_object_part_content_set(floatingBtn, "button1", button);
	Evas_Object *icon = elm_image_add(button);
	char *path = MemoUtil::getImageResourcePathN("core_floating_button_icon.png");
	if (path)
		elm_image_file_set(icon, path, nullptr);
	free(path);
	elm_object_part_content_set(button, "icon", icon);
	evas_object_smart_callback_add(button, "clicked", cb, data);
	return floatingBtn;
}
