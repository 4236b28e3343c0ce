// The memo colour selector: a palette of the seven memo colours over the foot of the page. A colour chosen
// shows at once and is written with the memo.
#include "View/MemoEditView.h"

#include "MemoLog.h"

void MemoEditView::__createColorSelector()
{
	if (__colorSelector) {
		MEMO_LOGE("Color selector already exists.");
		return;
	}
	const bool voicePanelLive = (__recorder && !__isRecorderDeleted) || (__player && !__isPlayerDeleted);
	elm_object_signal_emit(
	    getEvasObj(), voicePanelLive ? "show,colorselector,with,recorder" : "show,colorselector,no,recorder", "elm");
	Evas_Object *selector = elm_colorselector_add(getEvasObj());
	elm_object_style_set(selector, "memo");
	elm_colorselector_mode_set(selector, ELM_COLORSELECTOR_PALETTE);
	// A palette of its own, so that the toolkit's shared default palette stays as it is.
	elm_colorselector_palette_name_set(selector, "memo");
	elm_colorselector_palette_clear(selector);
	for (int i = 0; i < PALETTE_SIZE; i++)
		elm_colorselector_palette_color_add(selector, __palette[i][0], __palette[i][1], __palette[i][2],
		                                    __palette[i][3]);
	const Eina_List *items = elm_colorselector_palette_items_get(selector);
	Elm_Object_Item *selected = static_cast<Elm_Object_Item *>(eina_list_nth(items, __colorIndex));
	if (selected)
		elm_colorselector_palette_item_selected_set(selected, EINA_TRUE);
	evas_object_smart_callback_add(selector, "color,item,selected", __colorSelectedCb, this);
	elm_object_focus_set(selector, EINA_TRUE);
	evas_object_show(selector);
	elm_object_part_content_set(getEvasObj(), "colorselector", selector);
	__colorSelector = selector;
	if (__boxControl)
		__boxControl->suspendKeypad();
}

void MemoEditView::__closeColorSelector(bool focus)
{
	if (!__colorSelector) {
		MEMO_LOGE("Color selector already not exists.");
		return;
	}
	// A deleted player still counts here, unlike when the selector opens.
	const bool noVoice = (!__recorder || __isRecorderDeleted) && !__player;
	elm_object_signal_emit(getEvasObj(),
	                       noVoice ? "close,colorselector,no,recorder" : "close,colorselector,with,recorder", "elm");
	evas_object_smart_callback_del_full(__colorSelector, "color,item,selected", __colorSelectedCb, this);
	elm_object_part_content_unset(getEvasObj(), "colorselector");
	evas_object_del(__colorSelector);
	__colorSelector = nullptr;
	if (focus)
		__focusEntry(true);
	if (__boxControl)
		__boxControl->resumeKeypad();
}

void MemoEditView::__colorSelectedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	Elm_Object_Item *item = static_cast<Elm_Object_Item *>(eventInfo);
	if (!self)
		return;
	if (!item) {
		MEMO_LOGE("selected item is null.");
		return;
	}
	int r = 0, g = 0, b = 0, a = 0;
	elm_colorselector_palette_item_color_get(item, &r, &g, &b, &a);
	if (self->__bgObject)
		elm_bg_color_set(self->__bgObject, r, g, b);
	self->__colorIndex = self->__findPaletteIndex(r, g, b, a);
}
