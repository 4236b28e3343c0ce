#ifndef APP_ASSIST_INCLUDE_WCONTENTVIEWCONTROLLER_H
#define APP_ASSIST_INCLUDE_WCONTENTVIEWCONTROLLER_H

#include "WViewController.h"

namespace app_assist
{

class WNaviframeController;

// A page of a WNaviframeController. Calling order: constructor, create() (through the push), onCreateView(),
// onCreated(), onPushed(); any number of onBecomeTop() when the page comes back on top after the page above it
// went; then onPop() and onDestroy() when its Evas object goes.
class WContentViewController : public WViewController
{
public:
	WContentViewController();

	// Called before the page is created by a push, with the naviframe controller and its Evas object.
	// Default: nothing.
	virtual void onSetContainerProperties(WNaviframeController *naviframe, Evas_Object *naviframeObj);
	// Puts the created object on the naviframe and returns the new item, null to fail the push.
	// Default: elm_naviframe_item_push with no title and no buttons, default style.
	virtual Elm_Object_Item *onPushToNaviframe(Evas_Object *naviframeObj);
	// Called once the page is on the naviframe. Default: nothing.
	virtual void onPushed(Elm_Object_Item *naviItem);
	// Called once when the page leaves the naviframe, before onDestroy(). Default: nothing.
	virtual void onPop();
	// Called each time the page is on top again after the page above it went. Default: nothing.
	virtual void onBecomeTop();
	// For containers that show the page as plain content rather than a naviframe item. Default: nothing.
	virtual void onSetAsPageContent(Evas_Object *parentLayout);
	// Installs callback for the hardware menu ("more") key on obj. Default: the efl extension's more key
	// callback on obj, replacing the one installed before.
	virtual void onSetMoreButton(Evas_Object *obj, Evas_Smart_Cb callback, void *data);

	~WContentViewController() override;

	// The naviframe that holds this page, null before the push and after the naviframe went.
	WNaviframeController *getNaviframeController() const;
	// The page's naviframe item, null before the push and after the pop.
	Elm_Object_Item *getNaviItem() const;
	// Takes this page off the naviframe: a pop when it is on top (the last page's pop asks the naviframe's
	// last-item hook), else the item is deleted. Logs when the page is not on a naviframe.
	void popOut();
	// Places the hardware menu key's handler on the page (the content of naviItem, else this view's object)
	// through onSetMoreButton(). callback gets data, the object and the key type.
	void setMoreButton(Elm_Object_Item *naviItem, Evas_Smart_Cb callback, void *data);

private:
	friend class WNaviframeController;
	static void __pageDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	void __leaveNaviframe();

	WNaviframeController *__naviframe;
	Elm_Object_Item *__naviItem;
	Evas_Object *__moreKeyObj;
	Evas_Smart_Cb __moreKeyCb;
	bool __covered;
	bool __popped;
	bool __popPending;
};

} // namespace app_assist

#endif
