// The search grid: the matches of a keyword among the current records, as cards that highlight it. The gengrid
// holds cards for the first matches only and makes the next ones as the view nears the end of those: every
// change of a gengrid costs in proportion to the cards it holds (its focus order is rebuilt at the next
// frame), so thousands of cards would cost tens of milliseconds per key. Cards that a key keeps stay, with
// the new keyword, so that the cards on screen are not made again.
#include "List/MemoGridControl.h"

#include <algorithm>
#include <cstdlib>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridItem.h"
#include "List/MemoItemList.h"
#include "MemoLog.h"

namespace
{
// Cards made at a time: at least two screens of them at any scale and orientation.
const size_t CARDS_PER_LOAD = 48;
const int SCREENS_PER_LOAD = 2;
} // namespace

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
	if (!__searchCannotMatch(keyword)) {
		MemoDbMgr *db = MemoDbMgr::getInstance();
		const std::pair<long long, long long> stamp = db->getChangeStamp();
		const bool ok = db->getSearchReultN(keyword, &uuids, &count);
		__keepSearch(keyword, count, ok, stamp);
	}
	const int rows = __itemList ? __itemList->getCount() : 0;
	std::vector<int> shown = __rowsOfResult(uuids, count, rows);
	// An empty list leaves the grid as it was; otherwise the cards of the last update are changed or gone.
	if (rows >= 1) {
		__itemsFrom.reset();
		__showRows(std::move(shown), keyword, rows);
	}
	if (outCount)
		*outCount = count;
}

// When the store counts as many matches as the list has rows, every row is taken for a match and the list's
// order stands, no UUID compared. Otherwise each result goes to the first row that holds its UUID, in the
// result's order.
std::vector<int> MemoGridControl::__rowsOfResult(char **uuids, int count, int listRows)
{
	std::vector<int> rows;
	if (listRows == count) {
		for (int row = 0; row < listRows; ++row)
			if (__itemList->getItem(row))
				rows.push_back(row);
	} else if (listRows > 0) {
		if (__rowOfUuid.empty())
			for (int row = 0; row < listRows; ++row)
				if (MemoDocInfo *record = __itemList->getItem(row))
					__rowOfUuid.emplace(record->getMemoUUID(), row);
		rows.reserve(static_cast<size_t>(count));
		for (int i = 0; i < count; ++i) {
			auto found = uuids[i] ? __rowOfUuid.find(uuids[i]) : __rowOfUuid.end();
			if (found != __rowOfUuid.end())
				rows.push_back(found->second);
		}
	}
	for (int i = 0; i < count; ++i)
		free(uuids[i]);
	free(uuids);
	return rows;
}

// The first cards of rows, in order: a card that shows the same row stays and takes the keyword, the others
// go, and the rows that no card shows get a new one in its place. The view starts from the top.
void MemoGridControl::__showRows(std::vector<int> rows, const char *keyword, int listRows)
{
	Evas_Object *gengrid = getEvasObj();
	std::vector<int> targetOf(static_cast<size_t>(listRows), -1);
	for (size_t i = 0; i < rows.size(); ++i)
		if (rows[i] >= 0 && rows[i] < listRows)
			targetOf[static_cast<size_t>(rows[i])] = static_cast<int>(i);
	__targetRows = std::move(rows);
	__targetSearch = true;
	__targetKeyword = keyword ? keyword : "";
	const char *kept = __targetKeyword.c_str();
	const size_t wanted = std::min(__targetRows.size(), __cardsPerLoad());

	std::vector<Card> before;
	before.swap(__cards);
	__cards.reserve(wanted);
	size_t at = 0;
	while (__cards.size() < wanted) {
		const int place = static_cast<int>(__cards.size());
		if (at < before.size()) {
			const Card &card = before[at];
			const int to = (card.row >= 0 && card.row < listRows) ? targetOf[static_cast<size_t>(card.row)] : -1;
			if (!card.objectItem) {
				++at;
				continue;
			}
			// Gone from the result, shown already, or beyond the cards made now.
			if (to < place || to >= static_cast<int>(wanted)) {
				elm_object_item_del(card.objectItem);
				++at;
				continue;
			}
			if (to == place) {
				card.item->setRow(-1, nullptr);
				card.item->setKeyword(kept, gengrid);
				__cards.push_back(card);
				++at;
				continue;
			}
		}
		const int row = __targetRows[static_cast<size_t>(place)];
		Elm_Object_Item *next = at < before.size() ? before[at].objectItem : nullptr;
		MemoGridItem *item = __appendItem(__itemList->getItem(row), -1, kept, next);
		__cards.push_back({row, item, item ? item->getElmObjectItem() : nullptr});
	}
	for (; at < before.size(); ++at)
		if (before[at].objectItem)
			elm_object_item_del(before[at].objectItem);

	// The cards on screen that stayed change the highlight of their texts and check lines.
	Eina_List *realized = elm_gengrid_realized_items_get(gengrid);
	void *data = nullptr;
	EINA_LIST_FREE(realized, data)
	{
		if (auto *card = static_cast<MemoGridItem *>(elm_object_item_data_get(static_cast<Elm_Object_Item *>(data))))
			card->refreshHighlight();
	}
	Evas_Coord w = 0, h = 0;
	elm_scroller_region_get(gengrid, nullptr, nullptr, &w, &h);
	elm_scroller_region_show(gengrid, 0, 0, w, h);
}

// The rows of a full update, 0 to rows - 1, with the first cards made.
void MemoGridControl::__fillLazily(int rows)
{
	__forgetCards();
	__targetRows.resize(static_cast<size_t>(std::max(rows, 0)));
	for (size_t row = 0; row < __targetRows.size(); ++row)
		__targetRows[row] = static_cast<int>(row);
	__loadMoreCards();
}

size_t MemoGridControl::__cardsPerLoad()
{
	Evas_Coord w = 0, h = 0, itemW = 0, itemH = 0;
	evas_object_geometry_get(getEvasObj(), nullptr, nullptr, &w, &h);
	elm_gengrid_item_size_get(getEvasObj(), &itemW, &itemH);
	const int perRow = itemW > 0 ? std::max(1, w / itemW) : 1;
	const int rowsOnScreen = itemH > 0 ? h / itemH + 1 : 1;
	return std::max(CARDS_PER_LOAD, static_cast<size_t>(perRow * rowsOnScreen * SCREENS_PER_LOAD));
}

void MemoGridControl::__loadMoreCards()
{
	Evas_Object *gengrid = getEvasObj();
	if (!gengrid || !__itemList)
		return;
	if (!__watchingEnd) {
		__watchingEnd = true;
		evas_object_smart_callback_add(gengrid, "scroll", __nearEndCb, this);
		evas_object_event_callback_add(gengrid, EVAS_CALLBACK_RESIZE, __resizedCb, this);
	}
	const size_t until = std::min(__targetRows.size(), __cards.size() + __cardsPerLoad());
	for (size_t place = __cards.size(); place < until; ++place) {
		const int row = __targetRows[place];
		MemoGridItem *item = __targetSearch ? __appendItem(__itemList->getItem(row), -1, __targetKeyword.c_str())
		                                    : __appendItem(__itemList->getItem(row), row, nullptr);
		__cards.push_back({row, item, item ? item->getElmObjectItem() : nullptr});
	}
}

void MemoGridControl::__forgetCards()
{
	__cards.clear();
	__targetRows.clear();
	__targetSearch = false;
	__targetKeyword.clear();
}

// Within a screen of the end of the cards made, the next ones are made.
void MemoGridControl::__nearEndCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoGridControl *self = static_cast<MemoGridControl *>(data);
	if (!self || self->__cards.size() >= self->__targetRows.size())
		return;
	// The height of the cards made, from the cell size: the scroller's own figure lags until the next frame.
	Evas_Coord y = 0, w = 0, h = 0, itemW = 0, itemH = 0;
	elm_scroller_region_get(obj, nullptr, &y, nullptr, nullptr);
	evas_object_geometry_get(obj, nullptr, nullptr, &w, &h);
	elm_gengrid_item_size_get(obj, &itemW, &itemH);
	const Evas_Coord perRow = itemW > 0 ? std::max(1, w / itemW) : 1;
	const Evas_Coord made = static_cast<Evas_Coord>((self->__cards.size() + perRow - 1) / perRow) * itemH;
	if (h > 0 && y + 2 * h >= made)
		self->__loadMoreCards();
}

void MemoGridControl::__resizedCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	__nearEndCb(data, obj, eventInfo);
}
