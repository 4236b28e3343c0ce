#ifndef INC_LIST_MEMOGRIDCONTROL_H
#define INC_LIST_MEMOGRIDCONTROL_H

#include <vector>

#include <Elementary.h>

#include <memory>

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
	void __appendItem(MemoDocInfo *record, int row, const char *keyword);
	// MemoGridControlSearch.cpp: turns the search grid's cards into those of `records` by deleting the others
	// and giving the rest the keyword; false (nothing changed) when a card of records is missing or the
	// order differs.
	bool __reconcileSearchItems(const std::vector<MemoDocInfo *> &records, const char *keyword);
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
	// What the items were last built from: the rows (kept while the items stand), the view kind, the orientation.
	std::shared_ptr<const MemoTextArena> __itemsFrom;
	int __itemsKind;
	bool __itemsPortrait;
	// The gengrid holds the cards of a search (each with the keyword), not those of a full update.
	bool __searchShown = false;

	// Shared by every grid of the process: a new grid forgets the position of the others.
	static int savedScrollX;
	static int savedScrollY;
	static int restoreScrollY;
};

#endif
