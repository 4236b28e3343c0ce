// What the items report to the box control, and what the control passes on to its view.
#include "Box/MemoBoxControl.h"

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"

namespace
{
// Emptiness from the text itself: elm_entry_is_empty moves the entry's cursor, and these checks run
// inside "changed", which an entry may raise while it is moving its cursor.
bool hasText(Evas_Object *entry)
{
	const char *text = entry ? elm_entry_entry_get(entry) : nullptr;
	return text && *text;
}
} // namespace

bool MemoBoxControl::__areBodyItemsEmpty() const
{
	Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(__itemList, l, data) {
		Evas_Object *entry = static_cast<MemoBoxItem *>(data)->getEntry();
		if (hasText(entry))
			return false;
	}
	return true;
}

void MemoBoxControl::__emitDoneState(bool allEmpty)
{
	__signal.emit(allEmpty ? "action,done,disable" : "action,done,enable", nullptr);
}

void MemoBoxControl::onEntryChanged(Evas_Object *entry, void *item)
{
	(void)entry;
	(void)item;
	if (__isDestroying)
		return;
	const bool allEmpty = __areBodyItemsEmpty();
	if (__mode == MODE_UPDATE && !__docinfo) {
		MEMO_LOGE("__docinfo is NULL");
		__emitDoneState(allEmpty);
		return;
	}
	if ((__mode == MODE_UPDATE && __docinfo->getIsQuick()) || __mode == MODE_VIEW) {
		__emitDoneState(allEmpty);
		return;
	}
	// A new memo or an edited one with a title may be saved even with an empty body.
	Evas_Object *title = __titleItem ? __titleItem->getEntry() : nullptr;
	if (hasText(title)) {
		__signal.emit("action,done,enable", nullptr);
		return;
	}
	__emitDoneState(allEmpty);
}

void MemoBoxControl::onMaxLengthReached(Evas_Object *entry, void *item)
{
	// The item posts the toast itself.
	(void)entry;
	(void)item;
}

void MemoBoxControl::onChangeModeRequeted()
{
	if (__mode == MODE_VIEW)
		__signal.emit("action,mode,change", nullptr);
	else
		MEMO_LOGI("Already edit mode.");
}

void MemoBoxControl::onImageSelected(const char *path)
{
	if (!path) {
		MEMO_LOGE("path is null.");
		return;
	}
	__signal.emit("action,image,selected", const_cast<char *>(path));
}

void MemoBoxControl::onImagePopupRequested(bool show)
{
	__signal.emit(show ? "action,imagepopup,show" : "action,imagepopup,hide", nullptr);
}

void MemoBoxControl::onCheckGuideText(void *item)
{
	if (__isDestroying)
		return;
	MemoBoxItem *target = static_cast<MemoBoxItem *>(item);
	if (!target) {
		MEMO_LOGE("Current item is null");
		return;
	}
	if (target->getType() == MEMO_BOX_ITEM_TITLE || target->getType() == MEMO_BOX_ITEM_QUICK_TITLE)
		return;
	bool show = true;
	if (!__itemList || eina_list_count(__itemList) <= 1) {
		MEMO_LOGI("This is first item. Guide text shown.");
	} else {
		MEMO_LOGI("Number of items is more than 1. Guide text not shown.");
		show = false;
	}
	target->showGuideText(show);
}

void MemoBoxControl::onFavoriteChanged(Evas_Object *star, bool state, void *item)
{
	(void)star;
	(void)item;
	// While editing, the star is written by the save.
	if (__mode != MODE_VIEW)
		return;
	if (!__docinfo) {
		MEMO_LOGE("__docinfo is NULL");
		return;
	}
	__docinfo->setIsFavorite(state ? 1 : 0);
	MemoDbMgr::getInstance()->setFavorite(__docinfo->getMemoUUID(), state ? 1 : 0);
}
