// Building the box control's items, its accessors and the keypad hold.
#include "Box/MemoBoxControl.h"

#include <cstring>

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"

MemoBoxControl::MemoBoxControl(MemoDocInfo *docinfo, int mode, const char *memoUuid)
	: __itemList(nullptr), __currentItem(nullptr), __titleItem(nullptr), __imagePathList(nullptr),
	  __docinfo(docinfo), __mode(mode), __holdItem(nullptr), __memoUuid(memoUuid ? memoUuid : ""),
	  __isTitleFocused(false), __isDestroying(false)
{
}

MemoBoxControl::~MemoBoxControl()
{
	// Normally onDestroy has run; a control that never got its box still frees what it made.
	onDestroy();
}

const char *MemoBoxControl::getClassName() const
{
	return "MemoBoxControl";
}

Evas_Object *MemoBoxControl::onCreateView(Evas_Object *parent, void *param)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("parent is NULL");
		return nullptr;
	}
	Evas_Object *box = elm_box_add(parent);
	elm_box_horizontal_set(box, EINA_FALSE);
	evas_object_size_hint_weight_set(box, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(box, EVAS_HINT_FILL, 0.0);
	evas_object_show(box);
	const char *type = elm_object_widget_type_get(parent);
	if (type && strstr(type, "croller"))
		elm_object_content_set(parent, box);
	return box;
}

void MemoBoxControl::onCreated()
{
	Evas_Object *box = getEvasObj();
	if (!box) {
		MEMO_LOGE("main box is NULL");
		return;
	}
	const bool isQuick = __docinfo && __docinfo->getIsQuick();

	__titleItem = new MemoBoxItem(isQuick ? MEMO_BOX_ITEM_QUICK_TITLE : MEMO_BOX_ITEM_TITLE, __memoUuid.c_str(),
								  __isEditable());
	Evas_Object *titleLayout = __titleItem->create(box, nullptr, this);
	if (titleLayout)
		elm_box_pack_start(box, titleLayout);
	// The hidden mark belongs to the title group inside the item's outer layout.
	const char *hiddenSignal = __docinfo && __docinfo->getIsHidden() ? "show,hidden,icon" : "hide,hidden,icon";
	if (__titleItem->getInnerLayout())
		elm_object_signal_emit(__titleItem->getInnerLayout(), hiddenSignal, "elm");

	if (!__docinfo) {
		__appendItem(__createItem(MEMO_BOX_ITEM_FIRST_TEXT));
		return;
	}

	const char *title = __docinfo->getTitle();
	if (title && *title) {
		__titleItem->insertText(title);
		if (__isEditable() && __titleItem->getEntry())
			elm_entry_cursor_pos_set(__titleItem->getEntry(), 0);
	}
	if (!isQuick)
		__titleItem->setFavoriteStatus(__docinfo->getIsFavorite() != 0);

	const char *xml = __docinfo->getTizenXmlContent();
	if (xml && *xml)
		__composeBoxItemFromXml(xml);
	else
		__appendItem(__createItem(isQuick ? MEMO_BOX_ITEM_QUICK_TEXT : MEMO_BOX_ITEM_FIRST_TEXT));
}

void MemoBoxControl::onDestroy()
{
	__isDestroying = true;
	// Layouts go first, while every item still lives: deleting an entry can move focus to another
	// item's entry, whose callbacks must find their item.
	if (__titleItem && __titleItem->getLayout())
		evas_object_del(__titleItem->getLayout());
	Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(__itemList, l, data) {
		MemoBoxItem *item = static_cast<MemoBoxItem *>(data);
		if (item->getLayout())
			evas_object_del(item->getLayout());
	}
	delete __titleItem;
	__titleItem = nullptr;
	EINA_LIST_FREE(__itemList, data)
	delete static_cast<MemoBoxItem *>(data);
	freeImageList();
	__currentItem = nullptr;
	__holdItem = nullptr;
}

MemoBoxItem *MemoBoxControl::__createItem(_MemoBoxItemType type)
{
	Evas_Object *box = getEvasObj();
	MemoBoxItem *item = new MemoBoxItem(type, __memoUuid.c_str(), __isEditable());
	if (!box || !item->create(box, nullptr, this)) {
		MEMO_LOGE("box item can not be made");
		delete item;
		return nullptr;
	}
	return item;
}

void MemoBoxControl::__appendItem(MemoBoxItem *item)
{
	if (!item)
		return;
	elm_box_pack_end(getEvasObj(), item->getLayout());
	__itemList = eina_list_append(__itemList, item);
	__currentItem = item;
}

bool MemoBoxControl::__isLiveItem(const MemoBoxItem *item) const
{
	if (!item || __isDestroying)
		return false;
	return item == __titleItem || eina_list_data_find(__itemList, item);
}

MemoBoxItem *MemoBoxControl::getLastItem() const
{
	if (!__itemList) {
		MEMO_LOGE("__itemList is NULL.");
		return nullptr;
	}
	return static_cast<MemoBoxItem *>(eina_list_last_data_get(__itemList));
}

char *MemoBoxControl::getTitleTextN()
{
	if (!__titleItem)
		return nullptr;
	const char *markup = nullptr;
	if (__titleItem->getEntry())
		markup = elm_entry_entry_get(__titleItem->getEntry());
	else if (__titleItem->getInnerLayout())
		markup = elm_object_part_text_get(__titleItem->getInnerLayout(), "title");
	char *text = markup ? elm_entry_markup_to_utf8(markup) : nullptr;
	if (text && !*text) {
		free(text);
		text = nullptr;
	}
	return text;
}

bool MemoBoxControl::getFavoriteStatus()
{
	return __titleItem && __titleItem->getFavoriteStatus();
}

bool MemoBoxControl::isFavoriteArea(int x, int y)
{
	if (!__titleItem || !__titleItem->getInnerLayout())
		return false;
	Evas_Object *edje = elm_layout_edje_get(__titleItem->getInnerLayout());
	const Evas_Object *touch = edje ? edje_object_part_object_get(edje, "favourite.touch") : nullptr;
	if (!touch)
		return false;
	Evas_Coord px = 0, py = 0, pw = 0, ph = 0;
	evas_object_geometry_get(touch, &px, &py, &pw, &ph);
	return x >= px && x < px + pw && y >= py && y < py + ph;
}

bool MemoBoxControl::isTitleArea(int x, int y)
{
	if (!__titleItem || !__titleItem->getLayout())
		return false;
	Evas_Coord tx = 0, ty = 0, tw = 0, th = 0;
	evas_object_geometry_get(__titleItem->getLayout(), &tx, &ty, &tw, &th);
	return x >= tx && x < tx + tw && y >= ty && y < ty + th;
}

void MemoBoxControl::suspendKeypad()
{
	if (__mode == MODE_VIEW)
		return;
	__holdItem = __isTitleFocused ? __titleItem : __currentItem;
	if (!__holdItem || !__holdItem->getEntry())
		return;
	elm_entry_input_panel_show_on_demand_set(__holdItem->getEntry(), EINA_TRUE);
	elm_entry_input_panel_enabled_set(__holdItem->getEntry(), EINA_FALSE);
}

void MemoBoxControl::resumeKeypad()
{
	if (__isLiveItem(__holdItem) && __holdItem->getEntry()) {
		elm_entry_input_panel_show_on_demand_set(__holdItem->getEntry(), EINA_FALSE);
		elm_entry_input_panel_enabled_set(__holdItem->getEntry(), EINA_TRUE);
	}
	__holdItem = nullptr;
}

void MemoBoxControl::onFocusCurrentItem()
{
	if (__isLiveItem(__currentItem) && __currentItem->getEntry())
		elm_object_focus_set(__currentItem->getEntry(), EINA_TRUE);
}
