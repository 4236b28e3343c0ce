// The list's ways on: the floating button for a new memo (or the storage-full popup), and the more menu.
#include "View/MemoListView.h"

#include <app_i18n.h>
#include <notification_status.h>

#include <WMenuPopupController.h>
#include <WNaviframeController.h>
#include <WPopupController.h>
#include <WWindowController.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"
#include "Model/MemoPopupMonitor.h"
#include "Util/MemoUtil.h"
#include "View/MemoStorageFull.h"
#include "MemoViewParts.h"

using app_assist::WMenuPopupController;
using app_assist::WPopupController;
using app_assist::WWindowController;

namespace
{
const char FLOATING_BUTTON_PART[] = "elm.swallow.floatingbutton";

Evas_Object *__baseLayoutOf(WWindowController *window)
{
	return window ? window->getBaseLayoutEvasObj() : nullptr;
}
} // namespace

void MemoListView::__showFloatingButton()
{
	Evas_Object *baseLayout = __baseLayoutOf(getWindowController());
	if (!baseLayout) {
		MEMO_LOGE("no base layout for the floating button");
		return;
	}
	if (!__floatingBtn) {
		__floatingBtn = memoViewNewMemoFloatingButtonAdd(baseLayout, __newMemoBtnCb, this);
		if (!__floatingBtn)
			return;
	}
	elm_object_part_content_set(baseLayout, FLOATING_BUTTON_PART, __floatingBtn);
	evas_object_show(__floatingBtn);
}

void MemoListView::__hideFloatingButton()
{
	Evas_Object *baseLayout = __baseLayoutOf(getWindowController());
	if (!baseLayout)
		return;
	Evas_Object *button = elm_object_part_content_unset(baseLayout, FLOATING_BUTTON_PART);
	if (button)
		evas_object_hide(button);
}

void MemoListView::__newMemoBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoListView *self = static_cast<MemoListView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	// Storage is checked when a memo is started, not when one is opened.
	if (MemoUtil::getMemorySpaceStatusGet()) {
		self->__hideFloatingButton();
		self->__isTopView = false;
		self->__pushEditView(nullptr);
	} else {
		self->__createStorageFullPopup();
	}
}

void MemoListView::__createStorageFullPopup()
{
	WPopupController *popup = memoStorageFullPopupN(nullptr);
	if (popup && attachPopup(popup))
		MemoPopupMonitor::getInstance()->addPopup(popup);
}

void MemoListView::__launchStorageSettings()
{
	memoLaunchStorageSettings();
}

void MemoListView::__moreBtnSelectCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoListView *self = static_cast<MemoListView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	MemoDbMgr *db = MemoDbMgr::getInstance();
	const int memoCount = db->getMemoCount();
	if (memoCount < 1) {
		MEMO_LOGI("There is no memo. More button skipped.");
		return;
	}
	if (MemoPopupMonitor::getInstance()->isPopupAlive())
		return;
	WWindowController *window = self->getWindowController();
	WMenuPopupController *menu = new WMenuPopupController();
	if (!window || !menu->createMenu(window->getEvasObj(), self->getNaviframeController()->getEvasObj())) {
		menu->destroy();
		return;
	}
	if (self->__isPickMode) {
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_SEARCH"), [self] { self->__pushSearchView(true); });
	} else if (memoCount - db->getHiddenMemoCount() > 0) {
		menu->appendItem(i18n_get_text("IDS_MEMO_BUTTON_DELETE"), [self] { self->__pushSelectionView(); });
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_SEARCH"), [self] { self->__pushSearchView(false); });
	}
	if (!self->__isPickMode) {
		// Offered even when every memo is hidden: the hidden memos are the way back to them.
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_HIDDEN_MEMOS"), [self] {
			int gesture[2] = {0, 0};
			self->__openHiddenMemos(gesture);
		});
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_SETTINGS"), [self] { self->__pushSettingsView(); });
	}
	menu->showMenu();
	self->attachPopup(menu);
}
