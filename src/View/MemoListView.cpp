// The main list: its page, the grid or the empty state, the reloads and the bus.
#include "View/MemoListView.h"

#include <cstdlib>
#include <cstring>

#include <WNaviframeController.h>
#include <WUiTimer.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridControl.h"
#include "List/MemoGridItem.h"
#include "List/MemoItemList.h"
#include "MemoApp.h"
#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "MemoViewParts.h"

using app_assist::WUiTimer;

namespace
{
const double ROTATION_SCROLL_DELAY_SEC = 0.05;

// The number of visible memos, by the list read that the screen is built from.
int __visibleMemoCount()
{
	MemoItemList *list = MemoDbMgr::getInstance()->getVisibleMemoListN();
	int count = list->getCount();
	delete list;
	return count;
}
} // namespace

MemoListView::MemoListView()
    : __gridControl(nullptr), __floatingBtn(nullptr), __isPickMode(false), __pickRequest(nullptr), __layout(nullptr),
      __isTopView(true)
{
}

MemoListView::~MemoListView()
{
	if (__pickRequest)
		app_control_destroy(__pickRequest);
	delete __openedRecord;
}

const char *MemoListView::getClassName() const
{
	return "MemoListView";
}

Evas_Object *MemoListView::onCreateView(Evas_Object *parent, void *param)
{
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	if (param) {
		__pickRequest = *static_cast<app_control_h *>(param);
		char *operation = nullptr;
		app_control_get_operation(__pickRequest, &operation);
		if (operation && !strcmp(operation, APP_CONTROL_OPERATION_PICK))
			__isPickMode = true;
		free(operation);
	}
	memoViewPageLayoutAdd(parent, "list_view", &__layout);
	elm_object_signal_emit(__layout, "custom,naviframe,show", "elm");
	return __layout;
}

void MemoListView::onDestroy()
{
	if (__gridControl && __gridControl->getEvasObj())
		__gridControl->destroy();
	__gridControl = nullptr;
	// The button lives in the window's base layout, not in this page: it goes with the page all the same.
	if (__floatingBtn)
		evas_object_del(__floatingBtn);
	__floatingBtn = nullptr;
}

void MemoListView::__setNaviTitle(Elm_Object_Item *naviItem)
{
	elm_naviframe_item_title_enabled_set(naviItem, EINA_FALSE, EINA_FALSE);
	elm_object_domain_translatable_part_text_set(__layout, "naviframe.title", "memo-sub", "IDS_MEMO_BODY_MEMO");
}

MemoGridControl *MemoListView::__createGrid(bool popAtOnce)
{
	MemoGridControl *grid = new MemoGridControl();
	if (!grid->create(getEvasObj(), nullptr)) {
		delete grid;
		return nullptr;
	}
	grid->getSelectedSignal().addListener([this, popAtOnce](const char *key, MemoGridItem *item) {
		if (key && !strcmp(key, "selected"))
			__onGridSelected(item, popAtOnce);
	});
	return grid;
}

void MemoListView::onPushed(Elm_Object_Item *naviItem)
{
	__setNaviTitle(naviItem);
	// The first grid pops at once after a pick; the ones that onBecomeTop makes wait for an idler.
	__gridControl = __createGrid(true);
	if (__gridControl)
		__gridControl->updateGrid();
	if (__gridControl && __visibleMemoCount() >= 1)
		elm_object_part_content_set(__layout, "contents", __gridControl->getEvasObj());
	else
		elm_object_part_content_set(__layout, "contents", __createNoContentLayout(__layout));

	MemoBroadCaster::getInstance().addListener([this](const char *key, void *data) { __broadCasterCb(key, data); },
	                                           getEvasObj());
	WUiTimer::addIdler(
	    [this, naviItem](void *) {
		    if (!__isPickMode)
			    __showFloatingButton();
		    setMoreButton(naviItem, __moreBtnSelectCb, this);
		    return false;
	    },
	    nullptr, getEvasObj());
}

void MemoListView::onBecomeTop()
{
	// The editor that held the copy has gone.
	delete __openedRecord;
	__openedRecord = nullptr;
	if (!__isPickMode)
		__showFloatingButton();
	__isTopView = true;
	MemoItemList *list = MemoDbMgr::getInstance()->getVisibleMemoListN();
	if (list->getCount() < 1) {
		// The grid, if shown, goes with the content it is replaced by.
		elm_object_part_content_set(__layout, "contents", __createNoContentLayout(__layout));
		__gridControl = nullptr;
	} else {
		if (!__gridControl)
			__gridControl = __createGrid(false);
		if (__gridControl) {
			__gridControl->updateGrid();
			elm_object_part_content_set(__layout, "contents", __gridControl->getEvasObj());
		}
	}
	delete list;
}

void MemoListView::refresh()
{
	onBecomeTop();
}

int MemoListView::getGridItemCount()
{
	return __gridControl ? __gridControl->getItemCount() : 0;
}

// A tap on a card: the editor in normal mode; the reply and the way out in pick mode.
void MemoListView::__onGridSelected(MemoGridItem *item, bool popAtOnce)
{
	if (!item || !item->getDocInfo()) {
		MEMO_LOGE("selectedItem->getDocInfo() is NULL");
		return;
	}
	if (!__isPickMode) {
		__hideFloatingButton();
		__isTopView = false;
		__pushEditView(item->getDocInfo());
		return;
	}
	__sendPickResult(item);
	if (!__isTop())
		return;
	if (popAtOnce) {
		popOut();
		return;
	}
	WUiTimer::addIdler(
	    [this](void *) {
		    popOut();
		    return false;
	    },
	    nullptr, getEvasObj());
}

bool MemoListView::__isTop()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}

Evas_Object *MemoListView::__createNoContentLayout(Evas_Object *parent)
{
	return memoViewNoContentLayoutAdd(parent, "memo", "IDS_MEMO_NPBODY_NO_MEMOS");
}

void MemoListView::__broadCasterCb(const char *key, void *data)
{
	(void)data;
	if (!key)
		return;
	if (!strcmp(key, "broadcast,sync,idle")) {
		// A reload under another page would show the floating button over it: that page's return reloads.
		if (!__isTop()) {
			MEMO_LOGE("self is NULL or Top is not Me");
			return;
		}
		onBecomeTop();
	} else if (!strcmp(key, "broadcast,orientation,changed")) {
		if (__gridControl)
			__gridControl->updateGrid(true);
		elm_object_signal_emit(__layout, gIsPortrait ? "main,view,potrait,pad" : "main,view,landscape,pad", "elm");
		WUiTimer::addTimer(
		    ROTATION_SCROLL_DELAY_SEC,
		    [this](void *) {
			    if (__gridControl)
				    __gridControl->restoreScrollPosition();
			    return false;
		    },
		    nullptr, getEvasObj());
	}
}

void MemoListView::__cancelBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoListView *self = static_cast<MemoListView *>(data);
	if (!self) {
		MEMO_LOGE(" self is NULL");
		return;
	}
	self->popOut();
}
