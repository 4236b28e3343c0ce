// The search grid: the matches of a keyword among the current records, as cards that highlight it.
#include "List/MemoGridControl.h"

#include <cstdlib>
#include <string>
#include <unordered_map>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridItem.h"
#include "List/MemoItemList.h"
#include "MemoLog.h"

void MemoGridControl::searchGrid(const char *keyword, int *outCount)
{
	Evas_Object *gengrid = getEvasObj();
	if (!gengrid) {
		MEMO_LOGE("gengrid obj is NULL");
		return;
	}
	__setGridSize(gengrid);
	char **uuids = nullptr;
	int count = 0;
	MemoDbMgr::getInstance()->getSearchReultN(keyword, &uuids, &count);
	const int rows = __itemList ? __itemList->getCount() : 0;

	// The cards to show. When the store counts as many matches as the list has rows, every row is taken for a
	// match and the list's order stands, no UUID compared. Otherwise each result goes to the first row that
	// holds its UUID, in the result's order (a map: a scan of the list per result cost count x rows string
	// compares, most of a keystroke over thousands of memos).
	std::vector<MemoDocInfo *> records;
	if (rows == count) {
		for (int row = 0; row < rows; ++row)
			if (MemoDocInfo *record = __itemList->getItem(row))
				records.push_back(record);
	} else if (rows > 0) {
		std::unordered_map<std::string, int> rowOf;
		rowOf.reserve(static_cast<size_t>(rows));
		for (int row = 0; row < rows; ++row)
			if (MemoDocInfo *record = __itemList->getItem(row))
				rowOf.emplace(record->getMemoUUID(), row);
		for (int i = 0; i < count; ++i) {
			auto found = uuids[i] ? rowOf.find(uuids[i]) : rowOf.end();
			if (found != rowOf.end())
				records.push_back(__itemList->getItem(found->second));
		}
	}
	for (int i = 0; i < count; ++i)
		free(uuids[i]);
	free(uuids);

	// An empty list leaves the grid as it was.
	if (rows >= 1) {
		if (!__searchShown || !__reconcileSearchItems(records, keyword)) {
			elm_gengrid_clear(gengrid);
			for (MemoDocInfo *record : records)
				__appendItem(record, -1, keyword);
		}
		__searchShown = true;
	}
	if (outCount)
		*outCount = count;
}

// Cards are the gengrid's most costly part to make and to drop, and a key added to the text mostly keeps the
// matches of the one before, or some of them, in the store's order: the cards that stay take the new keyword
// and redraw their texts and check lines, those that go are deleted. The grid ends as a rebuild would leave
// it. A new match (BackSpace) is left to the rebuild: inserting thousands of cards one by one costs more.
bool MemoGridControl::__reconcileSearchItems(const std::vector<MemoDocInfo *> &records, const char *keyword)
{
	Evas_Object *gengrid = getEvasObj();
	std::unordered_map<const MemoDocInfo *, size_t> position;
	position.reserve(records.size());
	for (size_t i = 0; i < records.size(); ++i)
		position.emplace(records[i], i);
	auto recordOf = [](Elm_Object_Item *it) {
		MemoGridItem *card = static_cast<MemoGridItem *>(elm_object_item_data_get(it));
		return card ? card->getDocInfo() : nullptr;
	};

	// Every card to show must be there already, in the new order; otherwise nothing is touched.
	size_t kept = 0;
	for (Elm_Object_Item *it = elm_gengrid_first_item_get(gengrid); it; it = elm_gengrid_item_next_get(it)) {
		auto found = position.find(recordOf(it));
		if (found == position.end())
			continue;
		if (found->second != kept)
			return false;
		++kept;
	}
	if (kept != records.size())
		return false;
	for (Elm_Object_Item *it = elm_gengrid_first_item_get(gengrid); it;) {
		Elm_Object_Item *next = elm_gengrid_item_next_get(it);
		if (!position.count(recordOf(it)))
			elm_object_item_del(it);
		it = next;
	}
	for (Elm_Object_Item *it = elm_gengrid_first_item_get(gengrid); it; it = elm_gengrid_item_next_get(it))
		static_cast<MemoGridItem *>(elm_object_item_data_get(it))->setKeyword(keyword, gengrid);
	// Only the highlight changes: the texts and the check lines of the cards on screen, not the whole cards.
	Eina_List *realized = elm_gengrid_realized_items_get(gengrid);
	void *data = nullptr;
	EINA_LIST_FREE(realized, data)
	{
		Elm_Object_Item *it = static_cast<Elm_Object_Item *>(data);
		elm_gengrid_item_fields_update(it, "*", ELM_GENGRID_ITEM_FIELD_TEXT);
		elm_gengrid_item_fields_update(it, "*check*", ELM_GENGRID_ITEM_FIELD_CONTENT);
	}
	// A rebuilt grid starts from the top.
	Evas_Coord w = 0, h = 0;
	elm_scroller_region_get(gengrid, nullptr, nullptr, &w, &h);
	elm_scroller_region_show(gengrid, 0, 0, w, h);
	return true;
}
