// A page of the naviframe: its place on the stack, popOut and the menu key.
#include "WContentViewController.h"

#include <efl_extension.h>

#include "WDefine.h"
#include "WNaviframeController.h"

namespace app_assist
{

WContentViewController::WContentViewController()
    : __naviframe(nullptr), __naviItem(nullptr), __moreKeyObj(nullptr), __moreKeyCb(nullptr), __covered(false),
      __popped(false), __popPending(false)
{
}

WContentViewController::~WContentViewController()
{
	// Deleted directly rather than through its object: the base deletes the object without calling back here.
	if (getEvasObj())
		evas_object_event_callback_del_full(getEvasObj(), EVAS_CALLBACK_DEL, __pageDelCb, this);
	if (__naviframe)
		__naviframe->__onPageLeft(this, __naviItem);
}

void WContentViewController::onSetContainerProperties(WNaviframeController *, Evas_Object *) {}

Elm_Object_Item *WContentViewController::onPushToNaviframe(Evas_Object *naviframeObj)
{
	return elm_naviframe_item_push(naviframeObj, nullptr, nullptr, nullptr, getEvasObj(), nullptr);
}

void WContentViewController::onPushed(Elm_Object_Item *) {}

void WContentViewController::onPop() {}

void WContentViewController::onBecomeTop() {}

void WContentViewController::onSetAsPageContent(Evas_Object *) {}

void WContentViewController::onSetMoreButton(Evas_Object *obj, Evas_Smart_Cb callback, void *data)
{
	if (__moreKeyObj && __moreKeyCb)
		eext_object_event_callback_del(__moreKeyObj, EEXT_CALLBACK_MORE, __moreKeyCb);
	__moreKeyObj = nullptr;
	__moreKeyCb = nullptr;
	if (!obj || !callback)
		return;
	eext_object_event_callback_add(obj, EEXT_CALLBACK_MORE, callback, data);
	__moreKeyObj = obj;
	__moreKeyCb = callback;
}

WNaviframeController *WContentViewController::getNaviframeController() const
{
	return __naviframe;
}

Elm_Object_Item *WContentViewController::getNaviItem() const
{
	return __naviItem;
}

void WContentViewController::popOut()
{
	if (!__naviframe || !__naviItem || __popped) {
		WERROR("%s is not on a naviframe", getClassName());
		return;
	}
	Evas_Object *naviframeObj = __naviframe->getEvasObj();
	if (elm_naviframe_top_item_get(naviframeObj) == __naviItem) {
		__naviframe->__popTop(this);
		return;
	}
	// Below the top: the page goes at once, and this controller with it.
	Elm_Object_Item *item = __naviItem;
	__popped = true;
	__naviItem = nullptr;
	onPop();
	elm_object_item_del(item);
}

void WContentViewController::setMoreButton(Elm_Object_Item *naviItem, Evas_Smart_Cb callback, void *data)
{
	Evas_Object *obj = naviItem ? elm_object_item_content_get(naviItem) : nullptr;
	if (!obj)
		obj = getEvasObj();
	if (!obj) {
		WERROR("%s has no object for the menu key", getClassName());
		return;
	}
	onSetMoreButton(obj, callback, data);
}

// Runs before the base's delete callback, so that onPop() comes before onDestroy().
void WContentViewController::__pageDelCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<WContentViewController *>(data)->__leaveNaviframe();
}

void WContentViewController::__leaveNaviframe()
{
	__moreKeyObj = nullptr;
	__moreKeyCb = nullptr;
	if (!__popped) {
		__popped = true;
		onPop();
	}
	Elm_Object_Item *item = __naviItem;
	__naviItem = nullptr;
	WNaviframeController *naviframe = __naviframe;
	__naviframe = nullptr;
	if (naviframe)
		naviframe->__onPageLeft(this, item);
}

} // namespace app_assist
