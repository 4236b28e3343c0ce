#ifndef INC_VIEW_MEMOSEARCHVIEW_H
#define INC_VIEW_MEMOSEARCHVIEW_H

#include <Elementary.h>
#include <app_control.h>

#include <WContentViewController.h>

class MemoDocInfo;
class MemoGridControl;
class MemoGridItem;

// The full-screen search: a search bar in the naviframe's title and the memo grid below, narrowed with each
// keystroke. Pushed from the main list (gridMode 0) and from the hidden view (gridMode 5, set before the
// push). Pushed with the address of a pick request (app_control_h, not owned) it answers that request with
// the tapped memo instead of opening it.
class MemoSearchView : public app_assist::WContentViewController
{
public:
	MemoSearchView();
	~MemoSearchView() override;
	const char *getClassName() const override;

protected:
	// viewParam: null, or the address of an app_control_h whose operation may be a pick. Logs "parent object
	// is NULL" and returns null on a null parent.
	Evas_Object *onCreateView(Evas_Object *parent, void *viewParam) override;
	// No title, no buttons, the item style "empty".
	Elm_Object_Item *onPushToNaviframe(Evas_Object *naviframeObj) override;
	// The search bar into the title, the focus into the entry, the bus listener.
	void onPushed(Elm_Object_Item *naviItem) override;
	// Re-reads the visible memos and searches again with the entry's text.
	void onBecomeTop() override;

private:
	// MemoSearchViewBar.cpp: the title's search bar and what the entry reports.
	Evas_Object *__createSearchBar(Evas_Object *parent);
	void __setGuideText();
	static void __entryChangedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __entryActivatedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __maxLengthReachedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __backBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	// The entry's text as plain text (owned), or null.
	char *__getEntryTextN();

	// MemoSearchView.cpp
	void __search(const char *text);
	void __onGridSelected(MemoGridItem *item);
	void __pushEditView(MemoDocInfo *record);
	void __sendPickResult(MemoGridItem *item);
	void __broadCasterCb(const char *key, void *data);
	void __emitOrientationSignal();
	bool __isTop();

	MemoGridControl *__grid;
	Evas_Object *__outerLayout;
	Evas_Object *__layout;
	Evas_Object *__guideEntry;
	Evas_Object *__entry;
	int __resultCount;
	char *__lastEntryText;
	app_control_h __request;
	bool __popPending;
	bool __isPickMode;
	Evas_Object *__searchBar;
	char *__searchText;

public:
	// The grid mode: 0 from the main list, 5 from the hidden view; set by the pusher before the push.
	int gridMode;

private:
	// Empties when the grid goes; a grid taken out for the no-result layout outlives the page otherwise.
	app_assist::WViewControllerWeakPtr __gridRef;
	// The editor's own copy of the memo it shows: the grid may reload its records under it.
	MemoDocInfo *__openedRecord = nullptr;
};

#endif
