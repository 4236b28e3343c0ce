// Whether the memo changed, Done, and the write of the memo with every stored form of its body.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>
#include <sys/time.h>

#include <MemoCvt.h>
#include <WUiTimer.h>
#include <app_i18n.h>
#include <notification.h>

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "Recorder/MemoRecorder.h"
#include "Util/MemoUtil.h"

using app_assist::WUiTimer;

// Done lowers the keypad and saves after this delay, so the keypad is seen going first.
static const double SAVE_DELAY = 0.2;

namespace
{
bool isEmpty(const char *text)
{
	return !text || !*text;
}

// Drops or gives back the keypad of an entry.
void setKeypad(MemoBoxItem *item, bool enabled)
{
	Evas_Object *entry = item ? item->getEntry() : nullptr;
	if (!entry)
		return;
	elm_entry_input_panel_enabled_set(entry, enabled);
	if (!enabled)
		elm_entry_input_panel_hide(entry);
}
} // namespace

bool MemoEditView::__isChanged()
{
	if (!__boxControl) {
		MEMO_LOGE("Box Control is NULL");
		return false;
	}
	char *content = __boxControl->getTodoListXmlN();
	char *title = __boxControl->getTitleTextN();
	const bool favorite = __boxControl->getFavoriteStatus();
	bool changed = true;

	if (!__info) {
		if (isEmpty(content) && isEmpty(title) && !__vrUUID && !__isRecording()) {
			MEMO_LOGI("Contents not added.");
			changed = false;
		}
	} else {
		// In this order, the first difference deciding: title, body, star, recording, colour.
		int rgba[4] = {0, 0, 0, 0};
		__info->getBgColorRgba(&rgba[0], &rgba[1], &rgba[2], &rgba[3]);
		if (!strcmp(title ? title : "", __info->getTitle()) &&
		    !strcmp(content ? content : "", __info->getTizenXmlContent()) &&
		    (__info->getIsFavorite() != 0) == favorite && !__isRecorderUpdated() &&
		    __colorIndex == __findPaletteIndex(rgba[0], rgba[1], rgba[2], rgba[3])) {
			MEMO_LOGI("Memo not changed.");
			changed = false;
		}
	}
	free(content);
	free(title);
	return changed;
}

bool MemoEditView::__isRecorderUpdated()
{
	if (!__info) {
		MEMO_LOGE("__info is NULL");
		return __vrUUID != nullptr;
	}
	const char *stored = __info->getVrfileUUID();
	const bool hasStored = !isEmpty(stored);
	if (hasStored && !__vrUUID)
		return true;
	if (!hasStored && __vrUUID)
		return true;
	if (hasStored && __vrUUID && strcmp(stored, __vrUUID))
		return true;
	return __recorder && __isRecording();
}

void MemoEditView::__doneBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self) {
		MEMO_LOGE("self is NULL");
		return;
	}
	if (!MemoUtil::getMemorySpaceStatusGet()) {
		self->__createStorageFullPopup();
		return;
	}
	if (!self->__canSave)
		return;
	self->__destroyAttachPanel();
	if (self->__isRecorderDeleted == 0 && self->__recorder && self->__isRecording() && !self->__stopRecording()) {
		// A recording under one second is not kept, and the memo is not saved with it: the user stays.
		MEMO_LOGI("Not saved. Recording time is less than 1 sec.");
		return;
	}
	MemoBoxItem *focused = self->__boxControl ? self->__boxControl->getFocusedItem() : nullptr;
	MemoBoxItem *title = self->__boxControl ? self->__boxControl->getTitleItem() : nullptr;
	setKeypad(focused, false);
	setKeypad(title, false);
	self->__canSave = false;

	WUiTimer::addTimer(
	    SAVE_DELAY,
	    [self](void *) {
		    if (self->__isChanged() && !self->__saveMemo()) {
			    self->__onSaveFailed();
			    return false;
		    }
		    if (self->__isTop())
			    self->popOut();
		    return false;
	    },
	    nullptr, self->getEvasObj());
}

// The editor stays with the text: the user is told, and Done works again.
void MemoEditView::__onSaveFailed()
{
	notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_UNABLE_TO_SAVE_MEMO_TRY_AGAIN"));
	__canSave = true;
	if (__boxControl) {
		setKeypad(__boxControl->getFocusedItem(), true);
		setKeypad(__boxControl->getTitleItem(), true);
	}
}

bool MemoEditView::__saveMemo()
{
	if (!__boxControl) {
		MEMO_LOGE("Box Control is NULL");
		return false;
	}
	char *content = __boxControl->getTodoListXmlN();
	char *title = __boxControl->getTitleTextN();
	Eina_List *images = __boxControl->getImageList();
	if (!content) {
		MEMO_LOGE("the body could not be composed: %s is not saved", __UUID ? __UUID : "");
		free(title);
		return false;
	}
	if (!*content && !__isRecorderUpdated()) {
		// A title alone saves nothing. Emptying the quick memo empties its row; any other memo keeps its row.
		if (__info && __info->getIsQuick()) {
			MemoDbMgr *db = MemoDbMgr::getInstance();
			if (db)
				db->initQuickMemo();
		}
		free(content);
		free(title);
		return true;
	}

	MemoDocInfo *record = new MemoDocInfo();
	struct timeval now;
	gettimeofday(&now, nullptr);
	const unsigned long long stamp = static_cast<unsigned long long>(now.tv_sec) * 1000ULL;
	record->setMemoUUID(__UUID);
	if (title) {
		// A record holds its title as markup and the store writes it as plain text: handed in plain, a title
		// such as "Salt & pepper" would be stored as "Salt ".
		char *markupTitle = elm_entry_utf8_to_markup(title);
		record->setTitle(markupTitle ? markupTitle : title);
		free(markupTitle);
	}
	bool composed = true;
	if (*content) {
		MemoCvt converter(MEMO_CVT_SRC_TODOLIST, content);
		const std::string xmlContent = converter.getXmlContent();
		composed = !xmlContent.empty();
		record->setTizenXmlContent(content);
		record->setDisplayContent(converter.getDisplayContent().c_str());
		record->setStrippedContent(converter.getStrippedContent().c_str());
		record->setContent(converter.getContent().c_str());
		record->setAndroidXmlContent(xmlContent.c_str());
	}
	bool saved = false;
	if (!composed) {
		MEMO_LOGE("the body could not be converted: %s is not saved", __UUID ? __UUID : "");
	} else {
		record->setLastModifiedAt(stamp);
		const int *rgba = __palette[__colorIndex];
		record->setBgColorRgba(rgba[0], rgba[1], rgba[2], rgba[3]);
		const bool isQuick = __info && __info->getIsQuick();
		record->setIsDirty(isQuick ? 0 : 1);
		record->setIsQuick(isQuick ? 1 : 0);
		record->setIsFavorite(__boxControl->getFavoriteStatus() ? 1 : 0);
		__collectFiles(record, images, title);
		if (__mode == MODE_NEW || __mode == MODE_NEW_EXTERNAL) {
			record->setIsHidden(__isNewHidden);
			record->setCreatedAt(stamp);
		}
		saved = __writeRecord(record);
	}
	free(content);
	free(title);
	delete record;
	return saved;
}

bool MemoEditView::__writeRecord(MemoDocInfo *record)
{
	MemoDbMgr *db = MemoDbMgr::getInstance();
	if (!db)
		return false;
	bool ok = true;
	if (__mode == MODE_NEW || __mode == MODE_NEW_EXTERNAL) {
		// A new memo is inserted once: when its row exists already (an earlier save went through, or got
		// half way before it failed), the row is rewritten instead.
		MemoDocInfo *existing = db->getOneMemoN(__UUID);
		const bool exists = existing && !strcmp(existing->getMemoUUID(), __UUID);
		delete existing;
		ok = exists ? db->updateMemo(record) : db->addMemo(record);
	} else if (__mode == MODE_UPDATE) {
		ok = db->updateMemo(record);
	}
	if (!ok)
		MEMO_LOGE("the store did not take memo %s", __UUID ? __UUID : "");
	return ok;
}

void MemoEditView::saveOnExit()
{
	if (__mode == MODE_VIEW)
		return;
	if (__isRecorderDeleted == 0 && __recorder && __isRecording()) {
		// At once: the memo is written right after.
		__recorder->recorderStop();
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_RECORDING_SAVED"));
	}
	// No change test: an untouched edit is written too, with a new stamp.
	if (!__saveMemo())
		MEMO_LOGE("memo %s was not saved at exit", __UUID ? __UUID : "");
}
