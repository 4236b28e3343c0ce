// What reaches the recorder from around the app and what it tells outside: the app's broadcasts, the
// indicator, the media keys, the earjack, and the mini controllers.
#include "Recorder/MemoRecorder.h"

#include <cstring>

#include <app_i18n.h>
#include <notification.h>

#include "MemoLog.h"
#include "Model/MemoPopupMonitor.h"
#include "Recorder/MRecorderLockScreenMiniController.h"
#include "Recorder/MRecorderNotiMiniController.h"
#include "Recorder/MemoVoicePanel.h"

void MemoRecorder::__recorderBroadCasterCb(const char *key)
{
	if (!key)
		return;
	if (!strcmp(key, "broadcast,orientation,changed")) {
		__updateRecorderLayout();
	} else if (!strcmp(key, "broadcast,memo,app,pause")) {
		// The take keeps running in the background.
		__inBackground = true;
		if (__recorder && __isActive()) {
			__createMiniControllers();
			__showTime(static_cast<unsigned long long>(__elapsedMs));
			__sendMessagePort();
		}
	} else if (!strcmp(key, "broadcast,memo,app,resume")) {
		__inBackground = false;
		__sendMessagePort();
		__destroyMiniControllers();
	} else if (!strcmp(key, "broadcast,language,changed")) {
		if (__notiMini)
			__refreshNotiMini();
	}
}

void MemoRecorder::__removeBroadcastListener()
{
	memoVoiceRemoveBroadcastListener(&__broadcastId);
}

// The indicator shows a take running or paused while the app is in the background.
bool MemoRecorder::__sendMessagePort()
{
	const char *value = "voicerecorder_none";
	if (!__recorder) {
		MEMO_LOGE("Recorder handler is NULL");
	} else if (__inBackground) {
		const recorder_state_e state = __getState();
		if (state == RECORDER_STATE_RECORDING)
			value = "bg_recording_start";
		else if (state == RECORDER_STATE_PAUSED)
			value = "bg_recording_pause";
	}
	return memoVoiceSendIndicator(value);
}

// The media key pauses and resumes: its press and its release make one event pair.
void MemoRecorder::__media_key_event_cb(media_key_e key, media_key_event_e status, void *data)
{
	(void)status;
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	if (!self || !self->__recorder) {
		MEMO_LOGE("Memo Recorder Handler is NULL");
		return;
	}
	if (memoVoiceMediaKeyToggled(key, &self->__mediaKeyPressed) && self->__isActive())
		__pauseResumeCb(self, nullptr, nullptr, nullptr);
}

void MemoRecorder::_soundActiveDeviceChangedCb(sound_device_in_e in, sound_device_out_e out, void *data)
{
	(void)out;
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	MEMO_LOGI("sound route device is changed");
	MEMO_LOGI("sound route device is changed :: %x", static_cast<unsigned>(in));
	if (in == SOUND_DEVICE_IN_WIRED_ACCESSORY && static_cast<int>(in) != self->__lastInputDevice) {
		MEMO_LOGI("earjact is inserted");
		if (self->__recorder && self->__isActive()) {
			MEMO_LOGI("earjact is inserted During Recording");
			notification_status_message_post(i18n_get_text("IDS_VR_TPOP_RECORDING_WITH_EXTERNAL_MICROPHONE"));
		}
	}
	self->__lastInputDevice = static_cast<int>(in);
}

void MemoRecorder::__createMiniControllers()
{
	__notiMini = memoVoiceMiniCreateN<MRecorderNotiMiniController>(
	    __recorder, [this](const char *event) { __onNotiMiniEvent(event); });
	__lockMini = memoVoiceMiniCreateN<MRecorderLockScreenMiniController>(
	    __recorder, [this](const char *event) { __onLockMiniEvent(event); });
}

void MemoRecorder::__destroyMiniControllers()
{
	memoVoiceMiniDelete(&__lockMini);
	memoVoiceMiniDelete(&__notiMini);
}

void MemoRecorder::__setMiniTime(const char *text, unsigned long long ms)
{
	memoVoiceMiniSetTime(__notiMini, __lockMini, text, static_cast<long long>(ms));
}

void MemoRecorder::__refreshNotiMini()
{
	memoVoiceMiniUpdate(__notiMini);
}

void MemoRecorder::__refreshLockMini()
{
	memoVoiceMiniUpdate(__lockMini);
}

void MemoRecorder::__onNotiMiniEvent(const char *event)
{
	if (!strcmp(event, "recorder,paused") || !strcmp(event, "recorder,resumed")) {
		__pauseResumeCb(this, nullptr, nullptr, nullptr);
	} else if (!strcmp(event, "recorder,stopped")) {
		recorderStopCb(this, nullptr, nullptr, nullptr);
		__sendMessagePort();
	} else if (!strcmp(event, "recorder,canceled")) {
		if (MemoPopupMonitor::getInstance()->isPopupAlive())
			destroyPopup();
		__recorderCancel();
		__sendMessagePort();
	}
	__refreshLockMini();
}

void MemoRecorder::__onLockMiniEvent(const char *event)
{
	if (!strcmp(event, "recorder,paused") || !strcmp(event, "recorder,resumed"))
		__pauseResumeCb(this, nullptr, nullptr, nullptr);
	else if (!strcmp(event, "recorder,stopped"))
		recorderStopCb(this, nullptr, nullptr, nullptr);
	__refreshNotiMini();
}
