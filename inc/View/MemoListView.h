#ifndef INC_VIEW_MEMOLISTVIEW_H
#define INC_VIEW_MEMOLISTVIEW_H

#include <Elementary.h>
#include <app_control.h>

#include <WContentViewController.h>

class MemoDocInfo;
class MemoGridControl;
class MemoGridItem;

// The first screen: the memo grid or the empty state, the floating button for a new memo and the more menu.
// Pushed with a pointer to a pick request (app_control_h, which the view then owns) it serves that request
// instead: a tap on a card answers it with the memo's text and shared copies of its files, then leaves.
class MemoListView : public app_assist::WContentViewController
{
public:
	MemoListView();
	const char *getClassName() const override;

	// Sets the title, builds the grid (or the empty state), listens to the bus, then, once idle, shows the
	// floating button (normal mode) and installs the more key.
	void onPushed(Elm_Object_Item *naviItem) override;
	// Shows the floating button (normal mode) and reloads the grid from the store, or the empty state.
	void onBecomeTop() override;

	// The same as onBecomeTop; MemoApp calls it on the list on top.
	void refresh();
	// Rows of the grid's last update, 0 without a grid.
	int getGridItemCount();
	// Takes the floating button out of the window; every view that goes on from the list calls it first.
	void __hideFloatingButton();

protected:
	// param: null, or the address of a launch request (app_control_h) whose operation may be a pick.
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~MemoListView() override;

private:
	// The hidden memos' pages take the list's floating button away and mark it as left, as the list does.
	friend class MemoHiddenPasswordView;
	friend class MemoHiddenFirstAccess;
	friend class MemoSettingsView;

	void __setNaviTitle(Elm_Object_Item *naviItem);
	Evas_Object *__createNoContentLayout(Evas_Object *parent);
	MemoGridControl *__createGrid(bool popAtOnce);
	void __onGridSelected(MemoGridItem *item, bool popAtOnce);
	void __showFloatingButton();
	bool __isTop();
	static void __moreBtnSelectCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __newMemoBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	void __createStorageFullPopup();
	void __launchStorageSettings();
	void __sendPickResult(MemoGridItem *item);
	void __broadCasterCb(const char *key, void *data);
	static void __cancelBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	// Kept for the hidden memos: an event whose second int is below 76 opens them while the list is on top.
	bool __openHiddenMemos(void *event);
	void __launchAccountSettings();

	// The editor on a memo, read-only, or on a new memo for a null record (MemoListViewEditor.cpp).
	void __pushEditView(MemoDocInfo *record);
	// Where else the list goes on (MemoListViewRoutes.cpp): the search (serving the pick request when
	// asked), the selection for deletion, the hidden memos (the PIN, or its first use), the settings.
	void __pushSearchView(bool servePick);
	void __pushSelectionView();
	void __pushHiddenView(bool hasPassword);
	void __pushSettingsView();

	MemoGridControl *__gridControl;
	Evas_Object *__floatingBtn;
	bool __isPickMode;
	app_control_h __pickRequest;
	Evas_Object *__layout;
	bool __isTopView;
	// The editor's own copy of the memo it shows: the grid may reload its records under it.
	MemoDocInfo *__openedRecord = nullptr;
};

#endif
