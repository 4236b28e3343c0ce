// The recorder's panel: the layout in the owner's "recorder_contents", its buttons and the time text.
#include "Recorder/MemoRecorder.h"

#include <cstdio>
#include <cstdlib>
#include <string>

#include <Ecore_File.h>
#include <WPopupController.h>
#include <app_i18n.h>
#include <notification.h>

#include "MemoApp.h"
#include "MemoLog.h"
#include "Recorder/MemoMprisPlayer.h"
#include "Recorder/MemoVoicePanel.h"
#include "Util/MemoUtil.h"

static const char *const RECORDER_GROUP = "memo_recorder";
static const int PATH_MAX_LEN = 1024;

int MemoRecorder::__timeLimitSeconds = 3600;

MemoRecorder::MemoRecorder()
    : __recorder(nullptr), __mediaKeyPressed(false), __filePath(nullptr), __fileUUID(nullptr), __parent(nullptr),
      __startBtn(nullptr), __cancelBtn(nullptr), __stopBtn(nullptr), __pauseResumeBtn(nullptr), __elapsedMs(0),
      __broadcastId(0), __session(nullptr), __callManager(nullptr), __notiMini(nullptr), __lockMini(nullptr),
      __inBackground(false), __lastInputDevice(0)
{
}

MemoRecorder::~MemoRecorder()
{
	free(__fileUUID);
	free(__filePath);
	sound_manager_unset_active_device_changed_cb();
	__destroyMiniControllers();
	__stopMpris();
}

Evas_Object *MemoRecorder::onCreateView(Evas_Object *parent, void *param)
{
	if (!parent) {
		MEMO_LOGE("parent is NULL");
		return nullptr;
	}
	__makeFilePath(static_cast<const char *>(param));
	__parent = parent;
	Evas_Object *layout = memoVoiceAddPanelLayout(parent, RECORDER_GROUP);

	__cancelBtn = __takePartObject("recorder_cancel_btn", __recorderDeletePopupCb);
	__startBtn = __takePartObject("recorder_start_btn", __recorderCreateCb);
	elm_object_part_text_set(layout, "recorder_time", "00:00");
	if (!__callManager && cm_init(&__callManager) != CM_ERROR_NONE)
		__callManager = nullptr;
	int ret = sound_manager_set_active_device_changed_cb(_soundActiveDeviceChangedCb, this);
	if (ret != SOUND_MANAGER_ERROR_NONE)
		MEMO_LOGE("sound_manager_set_active_device_changed_cb failed : [%d]!!!", ret);
	return layout;
}

// "<data>media/<memo UUID>/<file UUID>.amr"; the folder is made here.
bool MemoRecorder::__makeFilePath(const char *memoUUID)
{
	char folder[PATH_MAX_LEN] = {0};
	snprintf(folder, sizeof(folder), "%smedia/%s/", MemoUtil::getDataPath(), memoUUID ? memoUUID : "");
	ecore_file_mkpath(folder);
	if (!MemoUtil::createUUIDN(&__fileUUID))
		return false;
	free(__filePath);
	__filePath = strdup((std::string(folder) + __fileUUID + ".amr").c_str());
	return true;
}

// The object of a part of the panel's layout (the view's object, or the one being built).
Evas_Object *MemoRecorder::__takePartObject(const char *part, Evas_Object_Event_Cb callback)
{
	Evas_Object *layout = getEvasObj() ? getEvasObj() : elm_object_part_content_get(__parent, "recorder_contents");
	Evas_Object *obj =
	    layout ? const_cast<Evas_Object *>(edje_object_part_object_get(elm_layout_edje_get(layout), part)) : nullptr;
	if (!obj) {
		MEMO_LOGE("part %s not found", part);
		return nullptr;
	}
	if (callback) {
		// One registration, however often a take starts.
		evas_object_event_callback_del_full(obj, EVAS_CALLBACK_MOUSE_UP, callback, this);
		evas_object_event_callback_add(obj, EVAS_CALLBACK_MOUSE_UP, callback, this);
	}
	return obj;
}

void MemoRecorder::onCreated()
{
	__updateRecorderLayout();
	memoVoiceAddBroadcastListener(
	    &__broadcastId, [this](const char *key) { __recorderBroadCasterCb(key); }, getEvasObj());
}

void MemoRecorder::onDestroy()
{
	// A take still running is given up: the file goes with it.
	__discardTake();
	__destroySession("onDestroy");
	__stopMpris();
	memoVoiceEndCalls(&__callManager);
	memoVoiceMediaKeyReleaseAsync();
	if (__notiMini)
		__sendMessagePort();
}

recorder_state_e MemoRecorder::__getState()
{
	recorder_state_e state = RECORDER_STATE_NONE;
	if (__recorder)
		recorder_get_state(__recorder, &state);
	return state;
}

bool MemoRecorder::__isActive()
{
	const recorder_state_e state = __getState();
	return state == RECORDER_STATE_RECORDING || state == RECORDER_STATE_PAUSED;
}

bool MemoRecorder::isRecordedEnough() const
{
	return __elapsedMs > 999;
}

bool MemoRecorder::__isInCall()
{
	return memoVoiceInCall(__callManager);
}

void MemoRecorder::__updateRecorderLayout()
{
	Evas_Object *layout = getEvasObj();
	if (!layout)
		return;
	const recorder_state_e state = __getState();
	const char *orientation = gIsPortrait ? "Portrait" : "Landscape";
	elm_object_signal_emit(layout, gIsPortrait ? "recorder,portrait" : "recorder,landscape", "elm");
	if (!__recorder) {
		elm_object_signal_emit(layout, "hide,recRightBtn", "elm");
		return;
	}
	if (state != RECORDER_STATE_RECORDING && state != RECORDER_STATE_PAUSED) {
		elm_object_signal_emit(layout, "recorder,cancel", "elm");
		return;
	}
	const std::string signal = std::string(state == RECORDER_STATE_RECORDING ? "recorder,resumed" : "recorder,paused") +
	                           (__elapsedMs < MEMO_VOICE_HOUR_MS ? "Minute" : "Hour") + orientation;
	elm_object_signal_emit(layout, "hide,recStartBtn", "elm");
	elm_object_signal_emit(layout, signal.c_str(), "elm");
}

void MemoRecorder::__showTime(unsigned long long ms)
{
	char text[32] = {0};
	memoVoiceFormatTime(static_cast<long long>(ms), text, sizeof(text));
	elm_object_part_text_set(getEvasObj(), "recorder_time", text);
	__setMiniTime(text, ms);
	if (__mpris)
		__mpris->setPosition(ms);
}

void MemoRecorder::__recorderCreateCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	MemoUtil::playTapFeedback();
	memoVoiceMediaKeyReserveAsync(__media_key_event_cb, self);
	memoVoiceAfterTap(self->getEvasObj(), [self]() { self->__onStartTimer(); });
}

void MemoRecorder::__onStartTimer()
{
	if (__isInCall()) {
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_UNABLE_TO_RECORD_AUDIO_DURING_CALLS"));
		return;
	}
	if (__recorder) {
		// A second tap before the buttons changed: the take has its handle already.
		MEMO_LOGI("the recorder is started already");
		return;
	}
	__recorder = __recHandleCreate(__filePath);
	if (!__recorder) {
		MEMO_LOGE("recorder handle create fail");
		return;
	}
	if (__recorderStart(__recorder) != RECORDER_ERROR_NONE)
		return;
	elm_object_signal_emit(getEvasObj(), "recorder,recording", "elm");
	__stopBtn = __takePartObject("recorder_stop_btn", recorderStopCb);
	__pauseResumeBtn = __takePartObject("recorder_pause_resume_btn", __pauseResumeCb);
	__updateRecorderLayout();
	__startMpris();
	__signal.emit("recorder,start", __fileUUID);
}

void MemoRecorder::__pauseResumeCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	MemoUtil::playTapFeedback();
	const recorder_state_e state = self->__getState();
	if (state == RECORDER_STATE_RECORDING) {
		recorder_pause(self->__recorder);
	} else {
		if (self->__isInCall()) {
			notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_UNABLE_TO_RECORD_AUDIO_DURING_CALLS"));
			return;
		}
		// Only a paused take goes on: one that a call has just ended is being stopped.
		if (state == RECORDER_STATE_PAUSED)
			recorder_start(self->__recorder);
	}
	self->__updateRecorderLayout();
	self->__updateMpris();
	if (self->__notiMini) {
		self->__sendMessagePort();
		self->__refreshNotiMini();
	}
	if (self->__lockMini)
		self->__refreshLockMini();
}

void MemoRecorder::recorderStopCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	if (!self)
		return;
	MemoUtil::playTapFeedback();
	self->__stopLater();
}

void MemoRecorder::__stopLater()
{
	memoVoiceAfterTap(getEvasObj(), [this]() { recorderStop(); });
}

void MemoRecorder::__recorderDeletePopupCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	MemoUtil::playTapFeedback();
	if (!self->__recorder) {
		self->__recorderCancel();
		return;
	}
	if (self->__elapsedMs < 1000) {
		notification_status_message_post(
		    i18n_get_text("IDS_MEMO_TPOP_RECORDING_CANCELLED_RECORDING_TOO_SHORT_M_VOICE"));
		self->__recorderCancel();
		return;
	}
	self->__signal.emit("recorder,dicardPopUp", self->__fileUUID);
	memoVoiceAfterTap(self->getEvasObj(), [self]() { self->__showDiscardPopup(); });
}

// The take goes on while the question is up.
void MemoRecorder::__showDiscardPopup()
{
	attachPopup(memoVoiceConfirmPopupN("IDS_MEMO_HEADER_DISCARD_RECORDING_ABB2",
	                                   "IDS_MEMO_POP_RECORDING_WILL_BE_STOPPED_AND_THE_FILE_WILL_BE_DISCARDED",
	                                   "IDS_MEMO_SK_OK", [this]() { __recorderCancel(); }));
}
