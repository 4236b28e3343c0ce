// The hidden memos' page: the grid or the empty state, the editor on a tap, the floating button, the way back.
#include "View/MemoHiddenView.h"

#include <cstring>

#include <efl_extension.h>

#include <WNaviframeController.h>
#include <WWindowController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridControl.h"
#include "List/MemoGridItem.h"
#include "MemoLog.h"
#include "View/MemoEditView.h"
#include "View/MemoHiddenTitle.h"
#include "MemoViewParts.h"

namespace
{
const char FLOATING_BUTTON_PART[] = "elm.swallow.floatingbutton";
const int HIDDEN_GRID_MODE = 2;
} // namespace

MemoHiddenView::MemoHiddenView(MemoListView *parent)
    : __parent(parent), __gridControl(nullptr), __floatingBtn(nullptr), __layout(nullptr), __gridMode(HIDDEN_GRID_MODE),
      __openedRecord(nullptr)
{
}

MemoHiddenView::~MemoHiddenView()
{
	delete __openedRecord;
}

const char *MemoHiddenView::getClassName() const
{
	return "MemoHiddenView";
}

Evas_Object *MemoHiddenView::onCreateView(Evas_Object *parent, void *param)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	memoViewPageLayoutAdd(parent, "list_view", &__layout);
	eext_object_event_callback_add(__layout, EEXT_CALLBACK_BACK, __backBtnCb, this);
	eext_object_event_callback_add(__layout, EEXT_CALLBACK_MORE, __moreBtnSelectCb, this);
	__updateGrid();
	evas_object_show(__layout);
	return __layout;
}

void MemoHiddenView::onDestroy()
{
	if (__gridControl && __gridControl->getEvasObj())
		__gridControl->destroy();
	__gridControl = nullptr;
	// The button lives in the window's base layout: it goes with the page all the same.
	if (__floatingBtn)
		evas_object_del(__floatingBtn);
}

void MemoHiddenView::onPushed(Elm_Object_Item *naviItem)
{
	memoHiddenTitleSet(naviItem, "IDS_MEMO_HEADER_HIDDEN_MODE_ABB", __backBtnCb, this);
	__showFloatingButton();
}

void MemoHiddenView::onBecomeTop()
{
	// The editor that held the copy has gone.
	delete __openedRecord;
	__openedRecord = nullptr;
	__showFloatingButton();
	__updateGrid();
}

// Every memo in grid mode 2, or the empty state when there is none at all.
void MemoHiddenView::__updateGrid()
{
	if (!__gridControl) {
		__gridControl = new MemoGridControl();
		if (!__gridControl->create(__layout, &__gridMode)) {
			delete __gridControl;
			__gridControl = nullptr;
			return;
		}
		__gridControl->getSelectedSignal().addListener([this](const char *key, MemoGridItem *item) {
			if (key && !strcmp(key, "selected"))
				__onSelected(item);
		});
	}
	__gridControl->updateGrid();
	if (__gridControl->getItemCount() > 0) {
		if (elm_object_part_content_get(__layout, "contents") != __gridControl->getEvasObj())
			elm_object_part_content_set(__layout, "contents", __gridControl->getEvasObj());
		return;
	}
	// The grid goes with the content it is replaced by.
	if (elm_object_part_content_get(__layout, "contents") != __gridControl->getEvasObj())
		__gridControl->destroy();
	__gridControl = nullptr;
	elm_object_part_content_set(__layout, "contents", __createNoContentLayout(__layout));
}

Evas_Object *MemoHiddenView::__createNoContentLayout(Evas_Object *parent)
{
	return memoViewNoContentLayoutAdd(parent, "memo-sub", "IDS_MEMO_BODY_NO_MEMOS_ABB");
}

void MemoHiddenView::__onSelected(MemoGridItem *item)
{
	if (!item || !item->getDocInfo()) {
		MEMO_LOGE("selectedItem->getDocInfo() is NULL");
		return;
	}
	if (!__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	__hideFloatingButton();
	__pushEditView(item->getDocInfo());
}

// The editor gets a fresh copy of the record: the grid may reload its records while the editor is open.
void MemoHiddenView::__pushEditView(MemoDocInfo *record)
{
	delete __openedRecord;
	__openedRecord = record ? MemoDbMgr::getInstance()->getOneMemoN(record->getMemoUUID()) : nullptr;
	if (record && !__openedRecord) {
		MEMO_LOGE("the memo %s is gone", record->getMemoUUID());
		__showFloatingButton();
		return;
	}
	MemoEditView *editor = new MemoEditView(__openedRecord, false, false);
	// A new memo started here is not hidden by itself.
	if (record)
		editor->setHiddenMode(1);
	getNaviframeController()->push(editor);
}

void MemoHiddenView::__showFloatingButton()
{
	app_assist::WWindowController *window = getWindowController();
	Evas_Object *baseLayout = window ? window->getBaseLayoutEvasObj() : nullptr;
	if (!baseLayout) {
		MEMO_LOGE("no base layout for the floating button");
		return;
	}
	if (!__floatingBtn) {
		__floatingBtn = memoViewNewMemoFloatingButtonAdd(baseLayout, __newMemoBtnCb, this);
		if (!__floatingBtn)
			return;
		// Whoever fills the part next deletes what is left in it.
		evas_object_event_callback_add(
		    __floatingBtn, EVAS_CALLBACK_DEL,
		    [](void *data, Evas *, Evas_Object *, void *) {
			    static_cast<MemoHiddenView *>(data)->__floatingBtn = nullptr;
		    },
		    this);
	}
	// The list's button may sit in the part: it is hidden, not deleted.
	Evas_Object *previous = elm_object_part_content_unset(baseLayout, FLOATING_BUTTON_PART);
	if (previous && previous != __floatingBtn)
		evas_object_hide(previous);
	elm_object_part_content_set(baseLayout, FLOATING_BUTTON_PART, __floatingBtn);
	evas_object_show(__floatingBtn);
}

void MemoHiddenView::__hideFloatingButton()
{
	app_assist::WWindowController *window = getWindowController();
	Evas_Object *baseLayout = window ? window->getBaseLayoutEvasObj() : nullptr;
	if (!baseLayout || !__floatingBtn || elm_object_part_content_get(baseLayout, FLOATING_BUTTON_PART) != __floatingBtn)
		return;
	evas_object_hide(elm_object_part_content_unset(baseLayout, FLOATING_BUTTON_PART));
}

void MemoHiddenView::__newMemoBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoHiddenView *self = static_cast<MemoHiddenView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->__hideFloatingButton();
	self->__pushEditView(nullptr);
}

void MemoHiddenView::__backBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoHiddenView *self = static_cast<MemoHiddenView *>(data);
	if (!self) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->__hideFloatingButton();
	if (self->__isTop())
		self->popOut();
}

bool MemoHiddenView::__isTop()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}
