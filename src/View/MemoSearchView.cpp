// The search view: its page, the grid narrowed by each search, the no-result layout, taps, the bus.
#include "View/MemoSearchView.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>

#include <app_i18n.h>

#include <WNaviframeController.h>
#include <WUiTimer.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridControl.h"
#include "List/MemoGridItem.h"
#include "MemoApp.h"
#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Util/MemoUtil.h"
#include "View/MemoEditView.h"
#include "View/MemoPickReply.h"

using app_assist::WUiTimer;

namespace
{
const double ROTATION_FIT_DELAY_SEC = 0.05;
const size_t NO_RESULT_TEXT_SIZE = 1024;
} // namespace

MemoSearchView::MemoSearchView()
    : __grid(nullptr), __outerLayout(nullptr), __layout(nullptr), __guideEntry(nullptr), __entry(nullptr),
      __resultCount(0), __lastEntryText(nullptr), __request(nullptr), __popPending(false), __isPickMode(false),
      __searchBar(nullptr), __searchText(strdup("")), gridMode(0)
{
}

MemoSearchView::~MemoSearchView()
{
	free(__lastEntryText);
	free(__searchText);
	delete __openedRecord;
	if (__resultCount == 0 && !__gridRef.expired() && __grid->getEvasObj())
		__grid->destroy();
}

const char *MemoSearchView::getClassName() const
{
	return "MemoSearchView";
}

Evas_Object *MemoSearchView::onCreateView(Evas_Object *parent, void *viewParam)
{
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	if (viewParam) {
		__request = *static_cast<app_control_h *>(viewParam);
		char *operation = nullptr;
		app_control_get_operation(__request, &operation);
		if (operation && !strcmp(operation, APP_CONTROL_OPERATION_PICK))
			__isPickMode = true;
		free(operation);
	}
	// The outer layout is never shown: it only parents the page's layout.
	__outerLayout = elm_layout_add(parent);
	evas_object_size_hint_weight_set(__outerLayout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_layout_file_set(__outerLayout, MemoUtil::getEdjePath(), "memo.search.view");
	__layout = elm_layout_add(__outerLayout);
	evas_object_size_hint_weight_set(__layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_layout_file_set(__layout, MemoUtil::getEdjePath(), "list_view");

	__grid = new MemoGridControl();
	if (!__grid->create(__layout, &gridMode)) {
		delete __grid;
		__grid = nullptr;
		evas_object_del(__outerLayout);
		return nullptr;
	}
	__gridRef = __grid->getWeakPtr();
	__grid->updateGrid();
	__grid->getSelectedSignal().addListener([this](const char *, MemoGridItem *item) { __onGridSelected(item); },
	                                        __layout);
	__emitOrientationSignal();
	__searchBar = __createSearchBar(parent);
	elm_object_part_content_set(__layout, "contents", __grid->getEvasObj());
	return __layout;
}

Elm_Object_Item *MemoSearchView::onPushToNaviframe(Evas_Object *naviframeObj)
{
	return elm_naviframe_item_push(naviframeObj, nullptr, nullptr, nullptr, getEvasObj(), "empty");
}

void MemoSearchView::onPushed(Elm_Object_Item *naviItem)
{
	elm_naviframe_item_title_enabled_set(naviItem, EINA_TRUE, EINA_FALSE);
	elm_object_item_part_content_set(naviItem, "title", __searchBar);
	elm_object_focus_set(__entry, EINA_TRUE);
	MemoBroadCaster::getInstance().addListener([this](const char *key, void *data) { __broadCasterCb(key, data); },
	                                           getEvasObj());
}

void MemoSearchView::onBecomeTop()
{
	// The editor that held the copy has gone.
	if (__isTop()) {
		delete __openedRecord;
		__openedRecord = nullptr;
	}
	char *text = __getEntryTextN();
	__grid->reloadItems();
	if (!__lastEntryText || !text || strcmp(__lastEntryText, text)) {
		free(__lastEntryText);
		__lastEntryText = strdup(text ? text : "");
	}
	free(text);
	__search(__lastEntryText);
	// Nothing sets popPending: the pop below never runs.
	WUiTimer::addIdler(
	    [this](void *) {
		    if (__popPending) {
			    __popPending = false;
			    popOut();
		    }
		    return false;
	    },
	    nullptr, getEvasObj());
}

void MemoSearchView::__search(const char *text)
{
	int count = 0;
	__grid->searchGrid(text, &count);
	__resultCount = count;
	Evas_Object *gridObj = __grid->getEvasObj();
	elm_object_part_content_set(__layout, "contents", gridObj);
	evas_object_show(gridObj);
	char *copy = strdup(text ? text : "");
	free(__searchText);
	__searchText = copy;
	if (__resultCount != 0)
		return;

	Evas_Object *shown = elm_object_part_content_unset(__layout, "contents");
	if (shown)
		evas_object_hide(shown);
	Evas_Object *noResult = elm_layout_add(__layout);
	elm_layout_theme_set(noResult, "layout", "nocontents", "default");
	char buffer[NO_RESULT_TEXT_SIZE] = {};
	snprintf(buffer, sizeof(buffer), "%s%s%s", "<font_size=40 color=#000000>",
	         i18n_get_text("IDS_MEMO_NPBODY_NO_RESULTS_FOUND"), "</font_size>");
	elm_object_domain_translatable_part_text_set(noResult, "elm.text", "memo", buffer);
	elm_object_signal_emit(noResult, "text,disabled", "");
	elm_object_signal_emit(noResult, "align.center", "elm");
	evas_object_show(noResult);
	elm_object_part_content_set(__layout, "contents", noResult);
}

// A tap on a result: the editor, read-only; in a pick the reply, and the end of the app when this view is on
// top.
void MemoSearchView::__onGridSelected(MemoGridItem *item)
{
	MemoDocInfo *info = item ? item->getDocInfo() : nullptr;
	if (__isPickMode) {
		__sendPickResult(item);
		if (__isTop()) {
			elm_exit();
			return;
		}
	}
	__pushEditView(info);
}

void MemoSearchView::__pushEditView(MemoDocInfo *record)
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!naviframe || !record)
		return;
	// A copy that the search keeps until it is on top again: a reload of the grid frees its records.
	delete __openedRecord;
	__openedRecord = MemoDbMgr::getInstance()->getOneMemoN(record->getMemoUUID());
	if (!__openedRecord)
		return;
	MemoEditView *editor = new MemoEditView(__openedRecord, false, false);
	editor->setHiddenMode(gridMode != 0);
	naviframe->push(editor);
}

void MemoSearchView::__sendPickResult(MemoGridItem *item)
{
	memoSendPickReply(item ? item->getDocInfo() : nullptr, __request);
}

void MemoSearchView::__broadCasterCb(const char *key, void *data)
{
	(void)data;
	if (!key)
		return;
	if (!strcmp(key, "broadcast,language,changed")) {
		if (__entry)
			__setGuideText();
	} else if (!strcmp(key, "broadcast,orientation,changed")) {
		__emitOrientationSignal();
		__grid->updateGrid(true);
		WUiTimer::addTimer(
		    ROTATION_FIT_DELAY_SEC,
		    [this](void *) {
			    __grid->restoreScrollPosition();
			    return false;
		    },
		    nullptr, getEvasObj());
		char *text = strdup(__searchText);
		__search(text);
		free(text);
	} else if (!strcmp(key, "broadcast,sync,listupdate")) {
		onBecomeTop();
	}
}

void MemoSearchView::__emitOrientationSignal()
{
	elm_object_signal_emit(__layout, gIsPortrait ? "search,view,potrait,pad" : "search,view,landscape,pad", "elm");
}

bool MemoSearchView::__isTop()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}
