// The more menu of the edit view: the memo's secondary actions, offered by mode and by the state of the
// device.
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

// The menu follows the keypad's or the attach panel's going down by this much.
static const double MENU_DELAY = 0.1;
static const char *const MENU_STYLE = "more/memo";

bool MemoEditView::__isKeypadOpen()
{
	if (!__boxControl) {
		MEMO_LOGE("__boxControl is null.");
		return false;
	}
	MemoBoxItem *item = __boxControl->getFocusedItem();
	Evas_Object *entry = item ? item->getEntry() : nullptr;
	Ecore_IMF_Context *imf = entry ? static_cast<Ecore_IMF_Context *>(elm_entry_imf_context_get(entry)) : nullptr;
	if (!imf)
		return false;
	Ecore_IMF_Input_Panel_State state = ecore_imf_context_input_panel_state_get(imf);
	return state == ECORE_IMF_INPUT_PANEL_STATE_SHOW || state == ECORE_IMF_INPUT_PANEL_STATE_WILL_SHOW;
}

void MemoEditView::__moreBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	// No menu over a picture being shrunk or over a question.
	if (self->__processingPopup || MemoPopupMonitor::getInstance()->isPopupAlive())
		return;
	bool keypadWasOpen = false;
	if (self->__isKeypadOpen()) {
		keypadWasOpen = true;
		for (MemoBoxItem *item : {self->__boxControl->getFocusedItem(), self->__boxControl->getTitleItem()}) {
			if (item && item->getEntry())
				elm_entry_input_panel_hide(item->getEntry());
		}
	} else if (self->__isAttachPanelOpened()) {
		attach_panel_hide(self->__attachPanel);
	} else {
		self->__createMoreMenu(false);
		return;
	}
	WUiTimer::addTimer(
	    MENU_DELAY,
	    [self, keypadWasOpen](void *) {
		    self->__createMoreMenu(keypadWasOpen);
		    return false;
	    },
	    nullptr, self->getEvasObj());
}

void MemoEditView::__createMoreMenu(bool keypadWasOpen)
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
	// The page's own menu look (theme style "more/memo").
	elm_object_style_set(menu->getEvasObj(), MENU_STYLE);
	const bool isQuick = __info && __info->getIsQuick();
	MemoDbMgr *db = MemoDbMgr::getInstance();

	if (__isHiddenMode == 1 && !isQuick) {
		const bool hidden = __info ? db && db->isMemoHidden(__UUID) : __isNewHidden == 1;
		menu->appendItem(i18n_get_text(hidden ? "IDS_MEMO_OPT_SHOW_MEMO" : "IDS_MEMO_OPT_HIDE_MEMO"),
		                 [this, hidden]() { __setHiddenState(!hidden); });
	}

	if (__mode == MODE_VIEW) {
		menu->appendItem(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"), [this]() { __changeToUpdateMode(); });
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_DELETE"), [this]() { __createDeletePopup(); });
		char **paths = nullptr;
		int fileCount = 0;
		if (db)
			db->getFilePathsN(__UUID, &paths, &fileCount);
		for (int i = 0; i < fileCount; i++)
			free(paths[i]);
		free(paths);
		if (__hasVisibleText(__getShareText()) || fileCount > 0)
			menu->appendItem(i18n_get_text("IDS_MEMO_OPT_SHARE"), [this]() { __shareMemo(); });
		menu->showMenu();
		attachPopup(menu);
		return;
	}

	MemoBoxItem *focused = __boxControl ? __boxControl->getFocusedItem() : nullptr;
	const bool isCheck = focused && memoBoxItemIsCheck(focused->getType());
	menu->appendItem(i18n_get_text(isCheck ? "IDS_MEMO_OPT_REMOVE_CHECKLIST_ABB" : "IDS_MEMO_OPT_ADD_CHECKLIST_ABB"),
	                 [this]() {
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
	if (!MemoUtil::isPowerSavingMode())
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_INSERT_IMAGE_ABB"), [this]() {
			if (__colorSelector)
				__closeColorSelector(false);
			__imageBtnCb();
		});
	// No recording during a call or in power saving, and one at a time.
	if (__isVoicePanelFree() && !MemoUtil::getCallStatus() && !MemoUtil::isRecorderBusy() &&
	    !MemoUtil::isPowerSavingMode())
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_RECORD_AUDIO_ABB2"),
		                 [this, keypadWasOpen]() { __onRecordMenuItem(keypadWasOpen); });
	if (MemoUtil::isQuickMemoFeatureEnabled() && !__colorSelector && !isQuick)
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_CHANGE_MEMO_COLOUR_ABB"), [this]() { __createColorSelector(); });
	menu->showMenu();
	attachPopup(menu);
}

// Hiding is written at once, whatever becomes of the edit.
void MemoEditView::__setHiddenState(bool hide)
{
	MemoDbMgr *db = MemoDbMgr::getInstance();
	const char *uuids[] = {__UUID};
	if (db) {
		if (hide)
			db->setHiddenMemos(uuids, 1);
		else
			db->setUnhiddenMemos(uuids, 1);
	}
	if (__info)
		__info->setIsHidden(hide ? 1 : 0);
	else
		__isNewHidden = hide ? 1 : 0;
	MemoBoxItem *title = __boxControl ? __boxControl->getTitleItem() : nullptr;
	if (title && title->getInnerLayout())
		elm_object_signal_emit(title->getInnerLayout(), hide ? "show,hidden,icon" : "hide,hidden,icon", "elm");
}

void MemoEditView::__onRecordMenuItem(bool keypadWasOpen)
{
	if (!MemoUtil::getMemorySpaceStatusGet()) {
		__createStorageFullPopup();
		return;
	}
	if (__colorSelector) {
		elm_object_signal_emit(getEvasObj(), "show,colorselector,with,recorder", "elm");
	} else if (!keypadWasOpen && __boxControl) {
		// The keypad stays down while the recorder's panel comes up.
		__boxControl->suspendKeypad();
		WUiTimer::addIdler(
		    [this](void *) {
			    if (__boxControl)
				    __boxControl->resumeKeypad();
			    return false;
		    },
		    nullptr, getEvasObj());
	}
	__audioBtnCb();
}
