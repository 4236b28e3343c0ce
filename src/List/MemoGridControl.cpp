// The memo grid: reads chosen by grid mode, the cards and their layout codes, taps.
#include "List/MemoGridControl.h"

#include <cstdlib>
#include <cstring>
#include <memory>

#include <app_i18n.h>
#include <feedback.h>

#include <WUiTimer.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridItem.h"
#include "List/MemoItemList.h"
#include "MemoLog.h"

using app_assist::WUiTimer;

namespace
{
const double TAP_DELAY_SEC = 0.1;

// A gengrid item held weakly between a tap and its report: the grid may be rebuilt in between.
struct PressedItem {
	explicit PressedItem(Elm_Object_Item *objectItem) : item(objectItem) { efl_wref_add(item, &item); }
	~PressedItem()
	{
		if (item)
			efl_wref_del(item, &item);
	}
	Eo *item;
};
} // namespace

int MemoGridControl::savedScrollX = 0;
int MemoGridControl::savedScrollY = 0;
int MemoGridControl::restoreScrollY = 0;

MemoGridControl::MemoGridControl()
    : __checkStates(nullptr), __reservedFlag1(false), __reservedFlag2(false), __itemCount(0), __gridItems(nullptr),
      __gridMode(nullptr), __itemList(nullptr), __scrolledInPortrait(false), __scrolledInLandscape(false),
      __scrollEventCount(0), __itemsKind(-1), __itemsPortrait(true)
{
	setName("MemoGridControl");
}

MemoGridControl::~MemoGridControl()
{
	__gridItems = eina_list_free(__gridItems);
}

const char *MemoGridControl::getClassName() const
{
	return "MemoGridControl";
}

Evas_Object *MemoGridControl::onCreateView(Evas_Object *parent, void *param)
{
	if (!parent) {
		MEMO_LOGE("Parent object is NULL");
		return nullptr;
	}
	__gridMode = static_cast<int *>(param);
	Evas_Object *gengrid = elm_gengrid_add(parent);
	if (!gengrid) {
		MEMO_LOGE("elm_gengrid_add() is failed");
		return nullptr;
	}
	evas_object_smart_callback_add(gengrid, "scroll", __scrollCb, this);
	evas_object_size_hint_weight_set(gengrid, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(gengrid, EVAS_HINT_FILL, 1.0);
	elm_scroller_policy_set(gengrid, ELM_SCROLLER_POLICY_OFF, ELM_SCROLLER_POLICY_AUTO);
	elm_gengrid_align_set(gengrid, 0.0, 0.0);
	evas_object_show(gengrid);
	savedScrollX = savedScrollY = restoreScrollY = 0;
	return gengrid;
}

void MemoGridControl::onDestroy()
{
	__forgetCards();
	free(__checkStates);
	__checkStates = nullptr;
	delete __itemList;
	__itemList = nullptr;
	__itemsFrom.reset();
}

void MemoGridControl::updateGrid()
{
	updateGrid(false);
}

void MemoGridControl::updateGrid(bool keepList)
{
	Evas_Object *gengrid = getEvasObj();
	if (!gengrid) {
		MEMO_LOGE("gengrid obj is NULL");
		return;
	}
	Eina_List *previous = __gridItems;
	__gridItems = nullptr;
	__setGridSize(gengrid);
	if (!keepList) {
		MemoDbMgr *db = MemoDbMgr::getInstance();
		delete __itemList;
		__itemList = db->getVisibleMemoListN();
		if (__gridMode) {
			MemoItemList *replacement = nullptr;
			if (*__gridMode == 3)
				replacement = db->getAllNormalMemoListN();
			else if (*__gridMode == 2 || *__gridMode == 5)
				replacement = db->getAllMemoListN();
			else if (*__gridMode == 1)
				replacement = db->getVisibleMemoListN();
			if (replacement) {
				delete __itemList;
				__itemList = replacement;
			}
		}
		__itemCount = __itemList->getCount();
		free(__checkStates);
		__checkStates = static_cast<int *>(calloc(static_cast<size_t>(__itemCount) + 1, sizeof(int)));
		__rowOfUuid.clear();
	} else {
		__itemCount = __itemList ? __itemList->getCount() : 0;
	}
	if (!keepList && __rebindItems(previous))
		return;
	eina_list_free(previous);
	elm_gengrid_clear(gengrid);
	__fillLazily(__itemCount);
	// The search modes take their cards as the view nears them; the others make them all.
	if (!__gridMode || (*__gridMode != 0 && *__gridMode != 5)) {
		for (size_t row = __cards.size(); row < __targetRows.size(); ++row) {
			MemoGridItem *item =
			    __appendItem(__itemList->getItem(static_cast<int>(row)), static_cast<int>(row), nullptr);
			__cards.push_back({static_cast<int>(row), item, item ? item->getElmObjectItem() : nullptr});
		}
	}
	__noteItemsBuilt();
}

void MemoGridControl::reloadItems()
{
	// The cards point into the records that go here; a search that finds no row would keep them.
	if (getEvasObj())
		elm_gengrid_clear(getEvasObj());
	__itemsFrom.reset();
	__forgetCards();
	__rowOfUuid.clear();
	delete __itemList;
	__itemList = MemoDbMgr::getInstance()->getVisibleMemoListN();
}

Eina_List *MemoGridControl::getGridItems()
{
	return __gridItems;
}

MemoGridItem *MemoGridControl::__appendItem(MemoDocInfo *record, int row, const char *keyword, Elm_Object_Item *before)
{
	if (!record)
		return nullptr;
	__prepareRecord(record);
	MemoGridItem *item = new MemoGridItem(__getItemType(record), record);
	item->setViewKind(__gridMode ? *__gridMode : -1);
	if (keyword)
		item->setKeyword(keyword, getEvasObj());
	else
		item->setRow(row, __checkStates);
	Elm_Gengrid_Item_Class *itemClass = item->getItemClassNew();
	Elm_Object_Item *objectItem =
	    before ? elm_gengrid_item_insert_before(getEvasObj(), itemClass, item, before, __pressedItemCb, this)
	           : elm_gengrid_item_append(getEvasObj(), itemClass, item, __pressedItemCb, this);
	elm_gengrid_item_class_free(itemClass);
	if (!objectItem) {
		MEMO_LOGE("elm_gengrid_item_append() is failed");
		delete item;
		return nullptr;
	}
	item->setElmObjectItem(objectItem);
	__gridItems = eina_list_append(__gridItems, item);
	return item;
}

void MemoGridControl::__prepareRecord(MemoDocInfo *record)
{
	// The quick memo shows its header and, while empty, how to fill it; the store keeps its own row.
	if (record->getIsQuick() == 1) {
		record->setTitle(i18n_get_text("IDS_MEMO_HEADER_QUICK_MEMO"));
		if (!*record->getDisplayContent() && !*record->getTizenXmlContent())
			record->setDisplayContent(
			    i18n_get_text("IDS_MEMO_BODY_COLLECT_TEXT_FROM_ANY_APP_BY_SELECTING_IT_AND_TAPPING_QUICK_MEMO_MSG"));
	}
}

int MemoGridControl::__getItemType(MemoDocInfo *record)
{
	const bool voice = *record->getVrfileUUID() != '\0';
	// The record holds the thumbnail path (_data) as read with the row: the same answer as asking the store
	// for it (getMemoThumbnailImageN: a path of at least two bytes), without a statement per card.
	const bool thumbnail = strlen(record->getData()) > 1;
	const char *display = record->getDisplayContent();
	const bool checklist = strstr(display, "<CHECK state=") != nullptr;
	const bool plainText = *display && !checklist;
	if (!*record->getTitle()) {
		if (voice)
			return (thumbnail || checklist) ? 5 : 7;
		return thumbnail ? 3 : (checklist ? 9 : 0);
	}
	if (voice)
		return (thumbnail || checklist) ? 6 : (plainText ? 8 : 11);
	return thumbnail ? 4 : (checklist ? 10 : (plainText ? 2 : 1));
}

void MemoGridControl::__pressedItemCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	MemoGridControl *self = static_cast<MemoGridControl *>(data);
	Elm_Object_Item *objectItem = static_cast<Elm_Object_Item *>(eventInfo);
	if (!self || !objectItem)
		return;
	// The touch sound at once; the report after the pressed look has been seen.
	feedback_initialize();
	feedback_play(FEEDBACK_PATTERN_TAP);
	feedback_deinitialize();
	std::shared_ptr<PressedItem> pressed = std::make_shared<PressedItem>(objectItem);
	WUiTimer::addTimer(
	    TAP_DELAY_SEC,
	    [self, pressed](void *) {
		    if (!pressed->item)
			    return false;
		    MemoGridItem *item = static_cast<MemoGridItem *>(elm_object_item_data_get(pressed->item));
		    elm_gengrid_item_selected_set(pressed->item, EINA_FALSE);
		    self->__selectedSignal.emit("selected", item);
		    return false;
	    },
	    nullptr, self->getEvasObj());
}
