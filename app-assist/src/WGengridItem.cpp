// Gengrid item data owned by its gengrid item.
#include "WGengridItem.h"

namespace app_assist
{

WGengridItem::WGengridItem() : __item(nullptr) {}

WGengridItem::~WGengridItem()
{
	// Deleted before its gengrid item: the item must not delete it again.
	if (__item)
		elm_object_item_data_set(__item, nullptr);
}

Elm_Gengrid_Item_Class *WGengridItem::getItemClassStatic()
{
	static Elm_Gengrid_Item_Class itemClass;
	static bool ready = false;
	if (!ready) {
		itemClass = {};
		itemClass.version = ELM_GENGRID_ITEM_CLASS_VERSION;
		itemClass.refcount = 1;
		itemClass.item_style = "default";
		itemClass.func.del = deleteItemCb;
		ready = true;
	}
	return &itemClass;
}

Elm_Gengrid_Item_Class *WGengridItem::getItemClassNew()
{
	Elm_Gengrid_Item_Class *itemClass = elm_gengrid_item_class_new();
	if (!itemClass)
		return nullptr;
	itemClass->item_style = "default";
	itemClass->func.del = deleteItemCb;
	return itemClass;
}

void WGengridItem::onSelect(Evas_Object *) {}

void WGengridItem::onSetElmObjectItem(Elm_Object_Item *) {}

Elm_Object_Item *WGengridItem::getElmObjectItem() const
{
	return __item;
}

void WGengridItem::setElmObjectItem(Elm_Object_Item *item)
{
	__item = item;
	onSetElmObjectItem(item);
}

void WGengridItem::deleteItemCb(void *data, Evas_Object *)
{
	WGengridItem *item = static_cast<WGengridItem *>(data);
	if (!item)
		return;
	item->__item = nullptr;
	delete item;
}

} // namespace app_assist
