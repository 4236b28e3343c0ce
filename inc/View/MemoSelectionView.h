#ifndef INC_VIEW_MEMOSELECTIONVIEW_H
#define INC_VIEW_MEMOSELECTIONVIEW_H

#include <Elementary.h>

#include <WContentViewController.h>

class MemoGridControl;
class MemoGridItem;
class MemoItemList;

// Choosing several memos on the memo grid, with a select-all row above it and the count in the title.
// viewMode says what for:
//   0  delete, from the main list: the visible memos (grid mode 1), Delete removes the ticked ones;
//   1  choose which memos are hidden, from the hidden view: every normal memo (grid mode 3), ticked as they
//      are hidden now; Done hides the ticked ones and unhides the others;
//   4  delete in hidden mode: every normal memo (grid mode 3), Delete removes the ticked ones.
// Either action pops the view; there is no confirmation.
class MemoSelectionView : public app_assist::WContentViewController
{
public:
	explicit MemoSelectionView(int viewMode);
	const char *getClassName() const override;

protected:
	// Logs "parent object is NULL" and returns null on a null parent.
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	// The title: the count, Cancel on the left, Delete or Done on the right.
	void onPushed(Elm_Object_Item *naviItem) override;

public:
	~MemoSelectionView() override;

private:
	void __refreshTitle(int count);
	void __onItemTapped(MemoGridItem *item);
	void __onSelectAllTapped();
	static void __selectAllClickedCb(void *data, Evas_Object *obj, const char *emission, const char *source);
	static void __cancelBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __actionBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	// The read that the table of view modes names: every normal memo in modes 1 and 4, else the visible ones.
	MemoItemList *__readListN();
	// Whether the right button stays enabled with nothing chosen (Done in viewMode 1).
	bool __emptyChoiceAllowed() const;
	bool __isTop();
	static void __setCheck(Evas_Object *check, bool on);

	// MemoSelectionViewActions.cpp
	void __deleteChosen();
	void __setHiddenChosen();

	MemoGridControl *__grid;
	int __viewMode;
	int __selectedCount;
	int __checkedCount;
	int __gridMode;
	int __totalCount;
	Evas_Object *__selectAllCheck;
	Evas_Object *__actionButton;
	// The select-all row and the page's title text, kept for the title's refresh.
	Evas_Object *__selectAllRow = nullptr;
	Elm_Object_Item *__naviItem = nullptr;
};

#endif
