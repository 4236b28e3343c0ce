#ifndef INC_VIEW_MEMOHIDDENVIEW_H
#define INC_VIEW_MEMOHIDDENVIEW_H

#include <Elementary.h>

#include <WContentViewController.h>

class MemoDocInfo;
class MemoGridControl;
class MemoGridItem;
class MemoListView;

// The hidden memos behind the PIN: the grid of every memo (grid mode 2, hidden ones marked) or the empty
// state, a floating button for a new memo (which is not hidden by itself), and the more menu that leads to the
// choice of hidden memos, their deletion, the search and the PIN change. Hidden mode is nothing but this page
// on the stack; the back key ends it.
//
// Files: MemoHiddenView.cpp (page, grid, floating button, back), MemoHiddenViewMore.cpp (the more menu).
class MemoHiddenView : public app_assist::WContentViewController
{
public:
	// parent: the list the hidden memos were opened from (not owned), or null.
	explicit MemoHiddenView(MemoListView *parent);
	const char *getClassName() const override;

	// The title with its back button, the floating button and the more key.
	void onPushed(Elm_Object_Item *naviItem) override;
	// The floating button again and a fresh grid.
	void onBecomeTop() override;

protected:
	// The page (group "list_view") with the grid or the empty state; null with "parent object is NULL".
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~MemoHiddenView() override;

private:
	void __updateGrid();
	void __onSelected(MemoGridItem *item);
	void __pushEditView(MemoDocInfo *record);
	void __showFloatingButton();
	void __hideFloatingButton();
	bool __isTop();
	Evas_Object *__createNoContentLayout(Evas_Object *parent);
	static void __backBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __moreBtnSelectCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __newMemoBtnCb(void *data, Evas_Object *obj, void *eventInfo);

	MemoListView *__parent;
	MemoGridControl *__gridControl;
	Evas_Object *__floatingBtn;
	Evas_Object *__layout;
	int __gridMode;
	// The editor's own copy of the memo it shows, kept until this page is on top again.
	MemoDocInfo *__openedRecord;
};

#endif
