#ifndef INC_LIST_MEMOGRIDCONTROL_H
#define INC_LIST_MEMOGRIDCONTROL_H

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include <Elementary.h>

#include <WSignal.h>
#include <WViewController.h>

class MemoGridItem;
class MemoItemList;
class MemoDocInfo;
class MemoTextArena;

// The memo grid: one elm_gengrid with a MemoGridItem per record. The owner's grid mode (see create) picks the
// store read; the control sizes the cells for scale and orientation, keeps the scroll position across a
// rotation and reports a tap as "selected".
// Owner's order: construct, create(parent, &mode) (null mode for the main list), updateGrid(), add a listener
// to getSelectedSignal(), set getEvasObj() into the owner's layout.
class MemoGridControl : public app_assist::WViewController
{
public:
	using SelectedSignal = app_assist::WSignal<void(const char *, MemoGridItem *)>;

	MemoGridControl();
	const char *getClassName() const override;

	// Rebuilds the grid from a fresh read chosen by the grid mode: none or 0 and 1 the visible memos,
	// 3 every normal memo, 2 and 5 every memo. The check marks start unticked.
	void updateGrid();
	// keepList true rebuilds from the records of the last read (a rotation): check marks survive.
	void updateGrid(bool keepList);
	// Rebuilds the grid with the matches of keyword among the current records, in the search's order, and
	// writes their number to outCount.
	void searchGrid(const char *keyword, int *outCount);
	// Replaces the records with a fresh read of the visible memos, whatever the mode.
	void reloadItems();
	// The cards of the last update; the list cells are the control's, the cards the gengrid's.
	Eina_List *getGridItems();
	// Puts the scroller back where it stood before a rotation.
	void restoreScrollPosition();
	// Number of rows of the last full update.
	int getItemCount() const { return __itemCount; }
	// The selection flags of the last full update, one int per row (1 ticked), owned by the control.
	int *getCheckStates() { return __checkStates; }
	// Emits "selected" with the tapped card, 0.1 s after the tap.
	SelectedSignal &getSelectedSignal() { return __selectedSignal; }

protected:
	// param is the owner's int grid mode (borrowed) or null. Logs "Parent object is NULL" on a null parent.
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~MemoGridControl() override;

private:
	void __setGridSize(Evas_Object *gengrid);
	// The card made, or null.
	MemoGridItem *__appendItem(MemoDocInfo *record, int row, const char *keyword, Elm_Object_Item *before = nullptr);
	// A card on the gengrid, with the row of __itemList that it shows.
	struct Card {
		int row;
		MemoGridItem *item;
		Elm_Object_Item *objectItem;
	};
	// MemoGridControlSearch.cpp: the rows of the store's result (the UUIDs are freed), the cards they need, and
	// the cards that come as the view nears the end of those made.
	std::vector<int> __rowsOfResult(char **uuids, int count, int listRows);
	void __showRows(std::vector<int> rows, const char *keyword, int listRows);
	void __fillLazily(int rows);
	size_t __cardsPerLoad();
	void __loadMoreCards();
	void __forgetCards();
	static void __nearEndCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __resizedCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	// MemoGridSearchQuery.cpp: what may spare the store's search.
	bool __searchCannotMatch(const char *keyword);
	void __keepSearch(const char *keyword, int count, bool ok, std::pair<long long, long long> stamp);
	int __getItemType(MemoDocInfo *record);
	// The quick memo's header and guide, written into the in-memory record before its item is built.
	void __prepareRecord(MemoDocInfo *record);
	// Binds the items of the last update (items, taken over) to the rows of the new list instead of building
	// them again, when both come from the same rows of the store and nothing else differs; false otherwise.
	bool __rebindItems(Eina_List *items);
	void __noteItemsBuilt();
	static void __scrollCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __pressedItemCb(void *data, Evas_Object *obj, void *eventInfo);

	int *__checkStates;
	bool __reservedFlag1;
	bool __reservedFlag2;
	int __itemCount;
	Eina_List *__gridItems;
	SelectedSignal __selectedSignal;
	int *__gridMode;
	MemoItemList *__itemList;
	bool __scrolledInPortrait;
	bool __scrolledInLandscape;
	int __scrollEventCount;
	// The rows that the grid shows, in order: a search's matches (cards with the keyword) or the rows of a full
	// update (cards with their row). __cards are the gengrid's cards, for the first of them; in the search
	// modes the others come as the view nears the end (a gengrid's every change costs in proportion to its
	// cards, so it holds few of them).
	std::vector<int> __targetRows;
	// The gengrid holds a search's cards (each with the keyword): a reload never rebinds them.
	bool __targetSearch = false;
	std::string __targetKeyword;
	std::vector<Card> __cards;
	bool __watchingEnd = false;
	// The row of each UUID of __itemList, made on the first search over it.
	std::unordered_map<std::string_view, int> __rowOfUuid;
	// The last result the store gave, with where the store and the language stood then.
	struct {
		bool valid = false;
		std::string text;
		int count = 0;
		std::pair<long long, long long> stamp;
		std::string header;
	} __lastSearch;
	// What the items were last built from: the rows (kept while the items stand), the view kind, the orientation.
	std::shared_ptr<const MemoTextArena> __itemsFrom;
	int __itemsKind;
	bool __itemsPortrait;

	// Shared by every grid of the process: a new grid forgets the position of the others.
	static int savedScrollX;
	static int savedScrollY;
	static int restoreScrollY;
};

#endif
