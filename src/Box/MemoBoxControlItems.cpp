// Adding and removing body items on request of an item, focus, and the shared character budget.
#include "Box/MemoBoxControl.h"

#include <WUiTimer.h>

#include <string>

#include "Box/MemoBoxItem.h"
#include "MemoLog.h"

namespace
{
// Characters that all body items share; the title stands outside.
const int BODY_CHAR_BUDGET = 4096;

int plainLength(MemoBoxItem *item)
{
	if (!item || !item->getEntry())
		return 0;
	char *plain = elm_entry_markup_to_utf8(elm_entry_entry_get(item->getEntry()));
	const int length = plain ? evas_string_char_len_get(plain) : 0;
	free(plain);
	return length;
}

bool isTitleType(_MemoBoxItemType type)
{
	return type == MEMO_BOX_ITEM_TITLE || type == MEMO_BOX_ITEM_QUICK_TITLE;
}
} // namespace

MemoBoxItem *MemoBoxControl::onAddRequested(Evas_Object *entry, _MemoBoxItemType type, const char *text, void *item)
{
	(void)entry;
	if (__isDestroying)
		return nullptr;
	if (type == MEMO_BOX_ITEM_TITLE) {
		MEMO_LOGI("Next button pressed at title.");
		if (__currentItem && __currentItem->getEntry()) {
			elm_object_focus_set(__currentItem->getEntry(), EINA_TRUE);
			elm_entry_cursor_end_set(__currentItem->getEntry());
		}
		return nullptr;
	}

	MemoBoxItem *added = __createItem(type);
	if (!added)
		return nullptr;
	if (text)
		added->insertText(text);
	Evas_Object *box = getEvasObj();
	if (__currentItem && __currentItem->getLayout()) {
		elm_box_pack_after(box, added->getLayout(), __currentItem->getLayout());
		__itemList = eina_list_append_relative(__itemList, added, __currentItem);
	} else {
		elm_box_pack_end(box, added->getLayout());
		__itemList = eina_list_append(__itemList, added);
	}
	__currentItem = added;

	// After the asking entry has finished its event: its input panel back on, focus to the new item.
	MemoBoxItem *asking = static_cast<MemoBoxItem *>(item);
	app_assist::WUiTimer::addTimer(
	    0.0,
	    [this, asking, added](void *) {
		    if (__isLiveItem(asking) && asking->getEntry())
			    elm_entry_input_panel_enabled_set(asking->getEntry(), EINA_TRUE);
		    if (__isLiveItem(added) && added->getEntry())
			    elm_object_focus_set(added->getEntry(), EINA_TRUE);
		    return false;
	    },
	    nullptr, added->getLayout());
	return added;
}

void MemoBoxControl::onUnpackRequested(Evas_Object *entry, void *item)
{
	(void)entry;
	if (__isDestroying)
		return;
	MemoBoxItem *removed = static_cast<MemoBoxItem *>(item);
	const unsigned int count = eina_list_count(__itemList);
	if (count <= 1) {
		// The list never empties: a lone check line only turns into text.
		if (__currentItem && __currentItem->getType() == MEMO_BOX_ITEM_FIRST_CHECK)
			__currentItem->changeMode();
		return;
	}

	int index = 0;
	Eina_List *l = nullptr;
	void *data = nullptr;
	bool found = false;
	EINA_LIST_FOREACH(__itemList, l, data)
	{
		if (data == removed) {
			found = true;
			break;
		}
		index++;
	}
	if (!found) {
		MEMO_LOGE("item is not in the list");
		return;
	}
	Eina_List *remaining = eina_list_remove(eina_list_clone(__itemList), removed);

	MemoBoxItem *neighbour = nullptr;
	if (index == 0) {
		neighbour = static_cast<MemoBoxItem *>(eina_list_nth(__itemList, 1));
		if (neighbour->getType() == MEMO_BOX_ITEM_CHECK)
			neighbour->setType(MEMO_BOX_ITEM_FIRST_CHECK);
		else if (neighbour->getType() == MEMO_BOX_ITEM_TEXT)
			neighbour->setType(MEMO_BOX_ITEM_FIRST_TEXT);
	} else {
		neighbour = static_cast<MemoBoxItem *>(eina_list_nth(__itemList, index - 1));
	}

	// The removed item leaves the list before the neighbour takes focus, so that the budget and the
	// picture count see its text once, as the merged text: counted twice, the merge would be cut
	// short and its pictures refused.
	eina_list_free(__itemList);
	__itemList = remaining;
	if (__currentItem == removed)
		__currentItem = neighbour;
	if (__holdItem == removed)
		__holdItem = nullptr;

	int position = 0;
	Evas_Object *target = neighbour->getEntry();
	if (target) {
		elm_object_focus_set(target, EINA_TRUE);
		__applyBudget(neighbour);
		elm_entry_cursor_end_set(target);
		position = elm_entry_cursor_pos_get(target);
	}
	// The removed text goes behind the neighbour's text, also when the neighbour came after it.
	Evas_Object *source = removed->getEntry();
	const char *removedText = source ? elm_entry_entry_get(source) : nullptr;
	if (target && removedText && *removedText) {
		const std::string text = removedText;
		elm_entry_entry_insert(target, text.c_str());
		elm_entry_cursor_pos_set(target, position);
	}

	Evas_Object *box = getEvasObj();
	if (removed->getLayout()) {
		elm_box_unpack(box, removed->getLayout());
		evas_object_del(removed->getLayout());
	}
	delete removed;
	evas_object_show(box);
}

void MemoBoxControl::onFocusChanged(Evas_Object *entry, void *item)
{
	(void)entry;
	if (__isDestroying)
		return;
	MemoBoxItem *focused = static_cast<MemoBoxItem *>(item);
	if (!focused) {
		MEMO_LOGE("data(focused item) is NULL");
		return;
	}
	// The quick memo's title (type 4) counts as a title too, though only type 3 is named for this: it
	// is not in the list, so as the current item it would take pictures, new items and the checklist
	// toggle meant for the body, and its own 128-character limit would meet the body's budget.
	if (isTitleType(focused->getType())) {
		__isTitleFocused = true;
		return;
	}
	__currentItem = focused;
	__isTitleFocused = false;
	__applyBudget(focused);
}

void MemoBoxControl::__applyBudget(MemoBoxItem *item)
{
	int sum = 0;
	Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(__itemList, l, data)
	sum += plainLength(static_cast<MemoBoxItem *>(data));
	item->setLimit(BODY_CHAR_BUDGET - sum + plainLength(item));
}
