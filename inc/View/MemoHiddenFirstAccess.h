#ifndef INC_VIEW_MEMOHIDDENFIRSTACCESS_H
#define INC_VIEW_MEMOHIDDENFIRSTACCESS_H

#include <Elementary.h>

#include <WContentViewController.h>

class MemoListView;

// The first use of hidden mode: what it does, and a button that goes on to the creation of the PIN.
class MemoHiddenFirstAccess : public app_assist::WContentViewController
{
public:
	// parent: the list the hidden memos are opened from (not owned), or null.
	explicit MemoHiddenFirstAccess(MemoListView *parent);
	const char *getClassName() const override;

	void onPushed(Elm_Object_Item *naviItem) override;

protected:
	// The page (group "hidden.mode.first") with its texts and the set-up button; the list's floating button
	// goes. Null with "parent object is NULL".
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;

private:
	static void __startBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __backBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	bool __isTop();

	MemoListView *__parent;
};

#endif
