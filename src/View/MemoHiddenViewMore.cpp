// The hidden memos' more menu: the choice of hidden memos, deletion and search in hidden mode, the PIN change.
#include "View/MemoHiddenView.h"

#include <app_i18n.h>

#include <WMenuPopupController.h>
#include <WNaviframeController.h>
#include <WWindowController.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"
#include "Model/MemoPopupMonitor.h"
#include "View/MemoHiddenPasswordView.h"
#include "View/MemoHiddenRoutes.h"

using app_assist::WMenuPopupController;

void MemoHiddenView::__moreBtnSelectCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoHiddenView *self = static_cast<MemoHiddenView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	if (MemoPopupMonitor::getInstance()->isPopupAlive())
		return;
	app_assist::WWindowController *window = self->getWindowController();
	app_assist::WNaviframeController *naviframe = self->getNaviframeController();
	WMenuPopupController *menu = new WMenuPopupController();
	if (!window || !menu->createMenu(window->getEvasObj(), naviframe->getEvasObj())) {
		menu->destroy();
		return;
	}
	auto goOn = [self, naviframe](MemoHiddenListPage page, int mode) {
		self->__hideFloatingButton();
		if (!memoHiddenPushListPage(naviframe, page, mode))
			self->__showFloatingButton();
	};
	if (MemoDbMgr::getInstance()->getMemoCount() >= 1) {
		// A plain text: this row has never had a text key.
		menu->appendItem("Edit Hidden Memo", [goOn] { goOn(MemoHiddenListPage::SELECTION, 1); });
		menu->appendItem(i18n_get_text("IDS_MEMO_BUTTON_DELETE"), [goOn] { goOn(MemoHiddenListPage::SELECTION, 4); });
		menu->appendItem(i18n_get_text("IDS_MEMO_OPT_SEARCH"), [goOn] { goOn(MemoHiddenListPage::SEARCH, 5); });
	}
	menu->appendItem(i18n_get_text("IDS_MEMO_TMBODY_CHANGE_PIN"), [self, naviframe] {
		self->__hideFloatingButton();
		MemoHiddenPasswordView *pinView = new MemoHiddenPasswordView(nullptr);
		pinView->setChangePin(true);
		naviframe->push(pinView);
	});
	menu->showMenu();
	self->attachPopup(menu);
}
