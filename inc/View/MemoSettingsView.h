#ifndef INC_VIEW_MEMOSETTINGSVIEW_H
#define INC_VIEW_MEMOSETTINGSVIEW_H

#include <Elementary.h>

#include <WContentViewController.h>

class MemoListView;

// The settings: one row for hidden mode, in two levels. A tap on "Hidden mode" turns the row into "Set PIN" (no
// PIN yet) or "Change PIN"; a tap on that goes to the first use of hidden mode or to the PIN change. Back from
// the second level returns to the first; a second back leaves.
class MemoSettingsView : public app_assist::WContentViewController
{
public:
	// parent: the list (not owned), or null.
	explicit MemoSettingsView(MemoListView *parent);
	const char *getClassName() const override;

	void onPushed(Elm_Object_Item *naviItem) override;

protected:
	// The page (group "memo.settings") with its list of one row; null with "parent object is NULL".
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;

private:
	static char *__rowTextCb(void *data, Evas_Object *obj, const char *part);
	static void __rowClickedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __backBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	void __setRowText(const char *textId);
	bool __isTop();

	MemoListView *__parent;
	Evas_Object *__genlist;
	Elm_Object_Item *__row;
	const char *__rowTextId;
	int __clickCount;
	int __backCount;
	// Handed to the PIN view: the change comes from the settings.
	bool __isFromSettings;
};

#endif
