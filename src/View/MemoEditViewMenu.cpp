// The more menu of the edit view and the memo colour selector. Sharing, pictures and recordings join the
// menu with their own flows.
#include "View/MemoEditView.h"

#include <Ecore_IMF.h>
#include <WMenuPopupController.h>
#include <WNaviframeController.h>
#include <WUiTimer.h>
#include <WWindowController.h>
#include <app_i18n.h>

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "Model/MemoPopupMonitor.h"
#include "Util/MemoUtil.h"

using app_assist::WMenuPopupController;
using app_assist::WUiTimer;

// The menu follows the keypad's going down by this much.
static const double MENU_DELAY = 0.1;

namespace
{
bool isKeypadOpen(MemoBoxControl *control)
{
	if (!control) {
		MEMO_LOGE("__boxControl is null.");
		return false;
	}
	MemoBoxItem *item = control->getFocusedItem();
	Evas_Object *entry = item ? item->getEntry() : nullptr;
	Ecore_IMF_Context *imf = entry ? static_cast<Ecore_IMF_Context *>(elm_entry_imf_context_get(entry)) : nullptr;
	if (!imf)
		return false;
	Ecore_IMF_Input_Panel_State state = ecore_imf_context_input_panel_state_get(imf);
	return state == ECORE_IMF_INPUT_PANEL_STATE_SHOW || state == ECORE_IMF_INPUT_PANEL_STATE_WILL_SHOW;
}
} // namespace

void MemoEditView::__moreBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	if (self->__processingPopup || MemoPopupMonitor::getInstance()->isPopupAlive())
		return;
	if (isKeypadOpen(self->__boxControl)) {
		MemoBoxItem *focused = self->__boxControl->getFocusedItem();
		MemoBoxItem *title = self->__boxControl->getTitleItem();
		if (focused && focused->getEntry())
			elm_entry_input_panel_hide(focused->getEntry());
		if (title && title->getEntry())
			elm_entry_input_panel_hide(title->getEntry());
		WUiTimer::addTimer(
		    MENU_DELAY,
		    [self](void *) {
			    self->__createMoreMenu();
			    return false;
		    },
		    nullptr, self->getEvasObj());
		return;
	}
	self->__createMoreMenu();
}

void MemoEditView::__createMoreMenu()
{
	app_assist::WWindowController *window = getWindowController();
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!window || !naviframe)
		return;
	WMenuPopupController *menu = new WMenuPopupController();
	if (!menu->createMenu(window->getEvasObj(), naviframe->getEvasObj())) {
		menu->destroy();
		return;
	}
	const bool isQuick = __info && __info->getIsQuick();
	if (__isHiddenMode == 1 && !isQuick) {
		const bool hidden = __info ? MemoDbMgr::getInstance()->isMemoHidden(__UUID) : __isNewHidden == 1;
		menu->appendItem(i18n_get_text(hidden ? "IDS_MEMO_OPT_SHOW_MEMO" : "IDS_MEMO_OPT_HIDE_MEMO"), [this, hidden]() {
			// Hiding is written at once, whatever becomes of the edit.
			const char *uuids[] = {__UUID};
			if (hidden)
				MemoDbMgr::getInstance()->setUnhiddenMemos(uuids, 1);
			else
				MemoDbMgr::getInstance()->setHiddenMemos(uuids, 1);
			if (__info)
				__info->setIsHidden(hidden ? 0 : 1);
			else
				__isNewHidden = hidden ? 0 : 1;
			MemoBoxItem *title = __boxControl ? __boxControl->getTitleItem() : nullptr;
			if (title && title->getInnerLayout())
				elm_object_signal_emit(title->getInnerLayout(), hidden ? "hide,hidden,icon" : "show,hidden,icon",
				                       "elm");
		});
	}
	if (__mode == MODE_VIEW) {
		menu->appendItem(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"), [this]() { __changeToUpdateMode(); });
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_DELETE"), [this]() { __createDeletePopup(); });
	} else {
		MemoBoxItem *focused = __boxControl ? __boxControl->getFocusedItem() : nullptr;
		const bool isCheck = focused && memoBoxItemIsCheck(focused->getType());
		menu->appendItem(
		    i18n_get_text(isCheck ? "IDS_MEMO_OPT_REMOVE_CHECKLIST_ABB" : "IDS_MEMO_OPT_ADD_CHECKLIST_ABB"), [this]() {
			    if (__colorSelector)
				    __closeColorSelector(true);
			    if (!__boxControl)
				    return;
			    __boxControl->suspendKeypad();
			    WUiTimer::addIdler(
			        [this](void *) {
				        if (!__boxControl)
					        return false;
				        __boxControl->resumeKeypad();
				        MemoBoxItem *item = __boxControl->getFocusedItem();
				        if (item)
					        item->changeMode();
				        return false;
			        },
			        nullptr, getEvasObj());
		    });
		if (MemoUtil::isQuickMemoFeatureEnabled() && !__colorSelector && !isQuick)
			menu->appendItem(i18n_get_text("IDS_MEMO_OPT_CHANGE_MEMO_COLOUR_ABB"),
			                 [this]() { __createColorSelector(); });
	}
	menu->showMenu();
	attachPopup(menu);
}

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
