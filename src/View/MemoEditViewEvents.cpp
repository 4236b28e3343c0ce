// What reaches the edit view from around it: rotation, the app's broadcasts, and calls.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>

#include <app_i18n.h>

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoApp.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

// Stamps above this are milliseconds; older rows kept seconds.
static const unsigned long long MAX_SECONDS_STAMP = 9999999999ULL;

char *MemoEditView::__getTimeTextN()
{
	if (!__info)
		return nullptr;
	unsigned long long stamp = __info->getLastModifiedAt();
	if (stamp > MAX_SECONDS_STAMP) {
		stamp /= 1000;
	} else {
		// A stamp in seconds is written back in the store's unit.
		__info->setLastModifiedAt(stamp * 1000);
	}
	return MemoUtil::getDateTimeTextN(static_cast<time_t>(stamp));
}

void MemoEditView::__updateRotationSignal()
{
	Evas_Object *layout = getEvasObj();
	if (!layout)
		return;
	if (!gIsPortrait) {
		__isPortrait = 0;
		elm_object_signal_emit(layout, __mode == MODE_VIEW ? "rotate,view_landscape" : "rotate,landscape", "elm");
		return;
	}
	__isPortrait = 1;
	if (__mode == MODE_VIEW) {
		elm_object_signal_emit(layout, "rotate,view_portrait", "elm");
		return;
	}
	int voiceClosed = 1;
	if (__player)
		voiceClosed = __isPlayerDeleted;
	else if (__recorder)
		voiceClosed = __isRecorderDeleted;
	elm_object_signal_emit(layout, voiceClosed == 1 ? "rotate,portrait,no,recorder" : "rotate,portrait,with,recorder",
	                       "elm");
}

void MemoEditView::__onBroadcast(const char *key)
{
	if (!key)
		return;
	if (!strcmp(key, "broadcast,orientation,changed")) {
		__updateRotationSignal();
	} else if (!strcmp(key, "broadcast,timeformat,changed")) {
		if (__mode == MODE_VIEW) {
			char *time = __getTimeTextN();
			elm_object_part_text_set(getEvasObj(), "time", time);
			free(time);
		}
	} else if (!strcmp(key, "broadcast,language,changed")) {
		if (__info && __info->getIsQuick() == 1) {
			const char *title = i18n_get_text("IDS_MEMO_HEADER_QUICK_MEMO");
			__info->setTitle(title);
			MemoBoxItem *titleItem = __boxControl ? __boxControl->getTitleItem() : nullptr;
			if (titleItem && titleItem->getEntry())
				elm_entry_entry_set(titleItem->getEntry(), title);
		}
	} else if (!strcmp(key, "broadcast,memo,app,pause")) {
		__isAppPaused = true;
	} else if (!strcmp(key, "broadcast,memo,app,resume")) {
		__isAppPaused = false;
	}
}

void MemoEditView::__registerCallStatus()
{
	if (!__callHandle && cm_init(&__callHandle) != CM_ERROR_NONE) {
		MEMO_LOGE("cm_init failed");
		__callHandle = nullptr;
		return;
	}
	cm_call_status_e status = CM_CALL_STATUS_IDLE;
	cm_get_call_status(__callHandle, &status);
	__onCallStatusChanged(status);
	cm_set_call_status_cb(__callHandle, __callStatusCb, this);
}

void MemoEditView::__callStatusCb(cm_call_status_e status, const char *number, void *data)
{
	(void)number;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (self)
		self->__onCallStatusChanged(status);
}

// Recording is offered only without a call, and only while the voice panel is free.
void MemoEditView::__onCallStatusChanged(cm_call_status_e status)
{
	if (status == CM_CALL_STATUS_IDLE) {
		if (!__isVoicePanelFree())
			return;
		__updateAudioBtnStatus(true);
	} else {
		__updateAudioBtnStatus(false);
	}
}
