// The selection view: its page, the select-all row, the grid of checks, the title with the count.
#include "View/MemoSelectionView.h"

#include <cstdio>
#include <cstring>

#include <app_i18n.h>

#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridControl.h"
#include "List/MemoGridItem.h"
#include "List/MemoItemList.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"
#include "MemoViewParts.h"

namespace
{
const size_t TITLE_SIZE = 200;
const char CHECK_PART[] = "selection_swallow_check";
// The title bar with a left and a right button (title_bar.edc).
const char TITLE_BAR_STYLE[] = "memo_edit";
// The check style of the select-all row and the cards (select_view.edc).
const char CHECK_STYLE[] = "memo_select";
} // namespace

MemoSelectionView::MemoSelectionView(int viewMode)
    : __grid(nullptr), __viewMode(viewMode), __selectedCount(0), __checkedCount(0), __gridMode(0), __totalCount(0),
      __selectAllCheck(nullptr), __actionButton(nullptr)
{
}

MemoSelectionView::~MemoSelectionView() {}

const char *MemoSelectionView::getClassName() const
{
	return "MemoSelectionView";
}

Evas_Object *MemoSelectionView::onCreateView(Evas_Object *parent, void *param)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	Evas_Object *layout = nullptr;
	memoViewPageLayoutAdd(parent, "memo.delete.view", &layout);

	__selectAllRow = elm_layout_add(layout);
	elm_layout_theme_set(__selectAllRow, "genlist", "item", "select_all/default");
	elm_object_domain_translatable_part_text_set(__selectAllRow, "elm.text.main", "memo",
	                                             "IDS_MEMO_HEADER_SELECT_ALL_ABB3");
	__selectAllCheck = elm_check_add(__selectAllRow);
	elm_object_style_set(__selectAllCheck, CHECK_STYLE);
	// A tap on the check is a tap on the row.
	elm_object_signal_emit(__selectAllCheck, "elm,event,pass,enabled", "elm");
	elm_object_part_content_set(__selectAllRow, "elm.icon", __selectAllCheck);

	Evas_Object *listLayout = elm_layout_add(layout);
	evas_object_size_hint_weight_set(listLayout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_layout_file_set(listLayout, MemoUtil::getEdjePath(), "list_view");
	__grid = new MemoGridControl();
	__checkedCount = 0;
	__gridMode = __viewMode == 0 ? 1 : 3;
	if (!__grid->create(listLayout, &__gridMode)) {
		delete __grid;
		__grid = nullptr;
		evas_object_del(layout);
		return nullptr;
	}
	__grid->updateGrid();
	MemoDbMgr *db = MemoDbMgr::getInstance();
	MemoItemList *list = __gridMode == 3 ? db->getAllNormalMemoListN() : db->getVisibleMemoListN();
	__totalCount = list->getCount();
	delete list;
	__grid->getSelectedSignal().addListener(
	    [this](const char *, MemoGridItem *item) {
		    if (item)
			    __onItemTapped(item);
	    },
	    layout);

	elm_object_part_content_set(listLayout, "contents", __grid->getEvasObj());
	elm_object_part_content_set(layout, "memo.grid", listLayout);
	elm_object_part_content_set(layout, "memo.selectall", __selectAllRow);
	elm_layout_signal_callback_add(__selectAllRow, "mouse,clicked,1", "*", __selectAllClickedCb, this);
	return layout;
}

void MemoSelectionView::onPushed(Elm_Object_Item *naviItem)
{
	__naviItem = naviItem;
	elm_naviframe_item_style_set(naviItem, TITLE_BAR_STYLE);
	elm_naviframe_item_title_enabled_set(naviItem, EINA_TRUE, EINA_FALSE);
	char title[TITLE_SIZE] = {};
	snprintf(title, sizeof(title), "%s", i18n_get_text("IDS_MEMO_HEADER_SELECT_MEMOS_ABB"));
	elm_object_item_part_text_set(naviItem, "elm.text.title", title);

	Evas_Object *naviframe = getNaviframeController() ? getNaviframeController()->getEvasObj() : getEvasObj();
	Evas_Object *cancel = elm_button_add(naviframe);
	elm_object_style_set(cancel, "naviframe/title_left");
	elm_object_text_set(cancel, i18n_get_text("IDS_MEMO_ACBUTTON_CANCEL_ABB2"));
	evas_object_smart_callback_add(cancel, "clicked", __cancelBtnCb, this);
	elm_object_item_part_content_set(naviItem, "title_left_btn", cancel);

	__actionButton = elm_button_add(naviframe);
	elm_object_style_set(__actionButton, "naviframe/title_right");
	elm_object_text_set(__actionButton, i18n_get_text(__viewMode == 1 ? "IDS_MEMO_ACBUTTON_DONE_ABB2"
	                                                                  : "IDS_TPLATFORM_ACBUTTON_DELETE_ABB"));
	evas_object_smart_callback_add(__actionButton, "clicked", __actionBtnCb, this);
	elm_object_item_part_content_set(naviItem, "title_right_btn", __actionButton);
	elm_object_disabled_set(__actionButton, !__emptyChoiceAllowed());

	if (__viewMode != 1)
		return;
	// Choosing the hidden set starts from the hidden set as it is.
	MemoItemList *list = MemoDbMgr::getInstance()->getAllNormalMemoListN();
	const int count = list->getCount();
	int *flags = __grid->getCheckStates();
	if (count == 0) {
		elm_object_disabled_set(__selectAllCheck, EINA_TRUE);
	} else {
		for (int row = 0; row < count && row < __grid->getItemCount(); ++row) {
			flags[row] = list->getItem(row)->getIsHidden() ? 1 : 0;
			__checkedCount += flags[row];
		}
		if (__checkedCount == count)
			__setCheck(__selectAllCheck, true);
		elm_gengrid_realized_items_update(__grid->getEvasObj());
	}
	delete list;
	__refreshTitle(__checkedCount);
}

void MemoSelectionView::__refreshTitle(int count)
{
	char title[TITLE_SIZE] = {};
	if (count == 0) {
		snprintf(title, sizeof(title), "%s", i18n_get_text("IDS_MEMO_HEADER_SELECT_MEMOS_ABB"));
	} else {
		char format[TITLE_SIZE] = {};
		snprintf(format, sizeof(format), "%s", i18n_get_text("IDS_MEMO_HEADER_PD_SELECTED_ABB3"));
		snprintf(title, sizeof(title), format, count);
	}
	elm_object_item_part_text_set(__naviItem, "elm.text.title", title);
	elm_object_disabled_set(__actionButton, EINA_FALSE);
}

void MemoSelectionView::__onItemTapped(MemoGridItem *item)
{
	__setCheck(__selectAllCheck, false);
	Elm_Object_Item *objectItem = item->getElmObjectItem();
	Evas_Object *check = objectItem ? elm_object_item_part_content_get(objectItem, CHECK_PART) : nullptr;
	int *flags = __grid->getCheckStates();
	const int row = item->getRow();
	int *flag = (flags && row >= 0 && row < __grid->getItemCount()) ? &flags[row] : nullptr;
	// An unrealized card has no check: its flag tells.
	const bool wasOn = check ? elm_check_state_get(check) : (flag && *flag == 1);
	if (!wasOn) {
		++__checkedCount;
		if (flag)
			*flag = 1;
		__refreshTitle(__checkedCount);
		if (__checkedCount == __totalCount)
			__setCheck(__selectAllCheck, true);
	} else {
		--__checkedCount;
		if (flag)
			*flag = 0;
		__refreshTitle(__checkedCount);
	}
	if (__checkedCount > 0)
		elm_object_disabled_set(__actionButton, EINA_FALSE);
	else if (!__emptyChoiceAllowed())
		elm_object_disabled_set(__actionButton, EINA_TRUE);
	if (check)
		__setCheck(check, !wasOn);
}

void MemoSelectionView::__onSelectAllTapped()
{
	if (elm_object_disabled_get(__selectAllCheck))
		return;
	const bool wasOn = elm_check_state_get(__selectAllCheck);
	__selectedCount = 0;
	if (wasOn) {
		__setCheck(__selectAllCheck, false);
		__checkedCount = 0;
	} else {
		__setCheck(__selectAllCheck, true);
	}
	MemoItemList *list = __readListN();
	if (!list)
		return;
	delete list;
	int *flags = __grid->getCheckStates();
	Eina_List *cell = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(__grid->getGridItems(), cell, data)
	{
		MemoGridItem *item = static_cast<MemoGridItem *>(data);
		Elm_Object_Item *objectItem = item->getElmObjectItem();
		Evas_Object *check = objectItem ? elm_object_item_part_content_get(objectItem, CHECK_PART) : nullptr;
		const int row = item->getRow();
		int *flag = (flags && row >= 0 && row < __grid->getItemCount()) ? &flags[row] : nullptr;
		if (wasOn) {
			if (check)
				__setCheck(check, false);
			if (flag)
				*flag = 0;
			elm_object_disabled_set(__actionButton, EINA_FALSE);
		} else {
			++__selectedCount;
			if (check)
				__setCheck(check, true);
			if (flag)
				*flag = 1;
			if (!__emptyChoiceAllowed())
				elm_object_disabled_set(__actionButton, EINA_TRUE);
		}
	}
	// The refresh enables the button even with nothing chosen; a Delete then removes nothing.
	__refreshTitle(__selectedCount);
	__checkedCount = __selectedCount;
}

void MemoSelectionView::__selectAllClickedCb(void *data, Evas_Object *obj, const char *emission, const char *source)
{
	(void)obj;
	(void)emission;
	(void)source;
	MemoSelectionView *self = static_cast<MemoSelectionView *>(data);
	if (self)
		self->__onSelectAllTapped();
}

void MemoSelectionView::__cancelBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoSelectionView *self = static_cast<MemoSelectionView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->popOut();
}

void MemoSelectionView::__actionBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoSelectionView *self = static_cast<MemoSelectionView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	if (self->__viewMode == 1)
		self->__setHiddenChosen();
	else
		self->__deleteChosen();
}

MemoItemList *MemoSelectionView::__readListN()
{
	MemoDbMgr *db = MemoDbMgr::getInstance();
	return (__viewMode == 1 || __viewMode == 4) ? db->getAllNormalMemoListN() : db->getVisibleMemoListN();
}

bool MemoSelectionView::__emptyChoiceAllowed() const
{
	return __gridMode == 3 && __viewMode != 4;
}

bool MemoSelectionView::__isTop()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}

void MemoSelectionView::__setCheck(Evas_Object *check, bool on)
{
	elm_object_signal_emit(check, on ? "elm,activate,check,on" : "elm,activate,check,off", "elm");
	elm_check_state_set(check, on ? EINA_TRUE : EINA_FALSE);
}
