// The title bar that the hidden memos' pages share.
#include "View/MemoHiddenTitle.h"

#include "MemoLog.h"

namespace
{
// The naviframe item style of the app's pages (theme group "elm/naviframe/item/memo_edit/default").
const char TITLE_BAR_STYLE[] = "memo_edit";
} // namespace

void memoHiddenTitleSet(Elm_Object_Item *naviItem, const char *textId, Evas_Smart_Cb backCb, void *data)
{
	if (!naviItem) {
		MEMO_LOGE("naviItem is NULL");
		return;
	}
	elm_naviframe_item_style_set(naviItem, TITLE_BAR_STYLE);
	elm_naviframe_item_title_enabled_set(naviItem, EINA_TRUE, EINA_FALSE);
	// A page that reads: no line under the bar, the back button on its left.
	elm_object_item_signal_emit(naviItem, "memo,title,view", "app");
	elm_object_item_domain_translatable_part_text_set(naviItem, "elm.text.title", "memo-sub", textId);
	if (!backCb)
		return;
	Evas_Object *naviframe = elm_object_item_widget_get(naviItem);
	Evas_Object *button = elm_button_add(naviframe);
	elm_object_style_set(button, "memo_back");
	// Keys belong to the page: a focused back button would take Return or space as a tap.
	elm_object_focus_allow_set(button, EINA_FALSE);
	evas_object_smart_callback_add(button, "clicked", backCb, data);
	elm_object_item_part_content_set(naviItem, "prev_btn", button);
}
