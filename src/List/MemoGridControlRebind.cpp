// A reload of the grid that finds the rows it was built from: the list view reads the whole list several
// times in one step (its push, the resume, its return to the top), and the rows of those reads are one and the
// same while the store is unchanged. Building ten thousand cards again costs more than the read itself (the
// grid queues work for every card it adds or removes), so the cards stay and take the new records.
#include "List/MemoGridControl.h"

#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridItem.h"
#include "List/MemoItemList.h"
#include "MemoApp.h"

void MemoGridControl::__noteItemsBuilt()
{
	__itemsFrom.reset();
	if (__itemCount > 0)
		__itemsFrom = __itemList->getItem(0)->getTexts();
	__itemsKind = __gridMode ? *__gridMode : -1;
	__itemsPortrait = gIsPortrait;
}

bool MemoGridControl::__rebindItems(Eina_List *items)
{
	// Equal rows give equal records, layout codes and texts; the view kind and the orientation choose the
	// item class; a rebuilt grid starts at the top. The cards are taken from the gengrid itself: a search
	// may have deleted some since, and a search's cards (__targetSearch) are left to a rebuild. In the search
	// modes, whose cards come as the view nears them, only a grid holding every card is rebound.
	Evas_Object *gengrid = getEvasObj();
	Evas_Coord x = 0, y = 0;
	elm_scroller_region_get(gengrid, &x, &y, nullptr, nullptr);
	if (__itemCount <= 0 || !__itemsFrom || __targetSearch || __itemList->getItem(0)->getTexts() != __itemsFrom ||
	    __itemsKind != (__gridMode ? *__gridMode : -1) || __itemsPortrait != gIsPortrait || x || y ||
	    static_cast<int>(elm_gengrid_items_count(gengrid)) != __itemCount)
		return false;
	eina_list_free(items);
	// Every row keeps its card: the rows to show and the cards made are all of them, in order.
	__cards.clear();
	__cards.reserve(static_cast<size_t>(__itemCount));
	__targetRows.resize(static_cast<size_t>(__itemCount));
	int row = 0;
	for (Elm_Object_Item *it = elm_gengrid_first_item_get(gengrid); it; it = elm_gengrid_item_next_get(it), ++row) {
		MemoGridItem *card = static_cast<MemoGridItem *>(elm_object_item_data_get(it));
		MemoDocInfo *record = __itemList->getItem(row);
		__prepareRecord(record);
		card->rebind(record, row, __checkStates);
		__gridItems = eina_list_append(__gridItems, card);
		__targetRows[static_cast<size_t>(row)] = row;
		__cards.push_back({row, card, it});
	}
	elm_gengrid_realized_items_update(gengrid);
	return true;
}
