#ifndef APP_ASSIST_INCLUDE_WGENGRIDITEM_H
#define APP_ASSIST_INCLUDE_WGENGRIDITEM_H

#include <Elementary.h>

namespace app_assist
{

// Data of one gengrid item. The gengrid owns it: the delete callback of the item classes below deletes the
// WGengridItem when its gengrid item goes. Derived classes add their text and content callbacks to the class.
class WGengridItem
{
public:
	WGengridItem();
	virtual ~WGengridItem();
	WGengridItem(const WGengridItem &) = delete;
	WGengridItem &operator=(const WGengridItem &) = delete;

	// A class shared by all items, style "default", with only the delete callback. Not to be freed.
	virtual Elm_Gengrid_Item_Class *getItemClassStatic();
	// A new class, style "default", with the delete callback; the caller frees it with
	// elm_gengrid_item_class_free() after appending.
	virtual Elm_Gengrid_Item_Class *getItemClassNew();
	// Called when the item is selected, with the gengrid. Default: nothing.
	virtual void onSelect(Evas_Object *gengrid);
	// Called by setElmObjectItem() with the new item. Default: nothing.
	virtual void onSetElmObjectItem(Elm_Object_Item *item);

	// The gengrid item, or null before setElmObjectItem() and after the item went.
	Elm_Object_Item *getElmObjectItem() const;
	// Records the gengrid item of this data and calls onSetElmObjectItem().
	void setElmObjectItem(Elm_Object_Item *item);

	// The delete callback of the item classes: deletes the WGengridItem given as item data.
	static void deleteItemCb(void *data, Evas_Object *obj);

private:
	Elm_Object_Item *__item;
};

} // namespace app_assist

#endif
