// The recorder's take on the platform recorder: its settings, start, stop with the one-second rule, cancel,
// and what the platform reports while it records.
#include "Recorder/MemoRecorder.h"

#include <cstdlib>

#include <WUiTimer.h>
#include <app_i18n.h>
#include <notification.h>
#include <recorder_product.h>

#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Recorder/MemoVoicePanel.h"
#include "Util/MemoUtil.h"
#include "View/MemoStorageFull.h"

static const int SAMPLE_RATE = 8000;
static const int BIT_RATE = 12200;
static const int SIZE_LIMIT_KB = 7200;
// A take kept is at least this long.
static const int MIN_RECORDING_MS = 1000;

recorder_h MemoRecorder::__recHandleCreate(const char *path)
{
	if (!__session) {
		int ret = sound_manager_multi_session_create(SOUND_MULTI_SESSION_TYPE_RECORD_AUDIO, &__session);
		if (ret != SOUND_MANAGER_ERROR_NONE) {
			MEMO_LOGE("sound_manager_multi_session_create Error : %d", ret);
			__session = nullptr;
		} else {
			ret = sound_manager_multi_session_set_option(__session, SOUND_MULTI_SESSION_OPT_PAUSE_OTHERS);
			if (ret != SOUND_MANAGER_ERROR_NONE)
				MEMO_LOGE("sound_manager_multi_session_set_option Error : %d", ret);
		}
	}
	// Every setting is tried; any failure gives the handle up.
	recorder_h recorder = nullptr;
	int failed = recorder_create_audiorecorder(&recorder);
	failed |= recorder_attr_set_audio_samplerate(recorder, SAMPLE_RATE);
	failed |= recorder_attr_set_audio_encoder_bitrate(recorder, BIT_RATE);
	failed |= recorder_attr_set_time_limit(recorder, __timeLimitSeconds);
	failed |= recorder_attr_set_size_limit(recorder, SIZE_LIMIT_KB);
	failed |= recorder_set_audio_encoder(recorder, RECORDER_AUDIO_CODEC_AMR);
	failed |= recorder_set_file_format(recorder, RECORDER_FILE_FORMAT_AMR);
	failed |= recorder_attr_set_audio_tuning(recorder, RECORDER_AUDIO_TUNING_VOICE_MEMO);
	failed |= recorder_set_filename(recorder, path);
	if (failed) {
		recorder_unprepare(recorder);
		recorder_destroy(recorder);
		return nullptr;
	}
	return recorder;
}

// 0 when the take started, or when storage was short and the popup shows (the panel then finds no take
// running at its next update and goes back to rest).
int MemoRecorder::__recorderStart(recorder_h recorder)
{
	if (!MemoUtil::getMemorySpaceStatusGet()) {
		__createStorageFullPopup();
		return RECORDER_ERROR_NONE;
	}
	recorder_set_state_changed_cb(recorder, __stateChangedCb, this);
	recorder_set_recording_status_cb(recorder, __recordingStatusCb, this);
	recorder_set_error_cb(recorder, __errorCb, nullptr);
	recorder_set_recording_limit_reached_cb(recorder, __limitReachedCb, this);
	int ret = recorder_prepare(recorder);
	if (ret != RECORDER_ERROR_NONE)
		MEMO_LOGE("prepare fail, err code: %d", ret);
	if (_isEarjackInserted())
		notification_status_message_post(i18n_get_text("IDS_VR_TPOP_RECORDING_WITH_EXTERNAL_MICROPHONE"));
	ret = recorder_start(recorder);
	if (ret != RECORDER_ERROR_NONE) {
		MEMO_LOGE("start fail, err code: %d", ret);
		return ret;
	}
	return RECORDER_ERROR_NONE;
}

bool MemoRecorder::_isEarjackInserted()
{
	sound_device_in_e in = SOUND_DEVICE_IN_MIC;
	if (sound_manager_get_active_route(nullptr, &in) != SOUND_MANAGER_ERROR_NONE) {
		MEMO_LOGE("sound_manager_get_active_route failed");
		return false;
	}
	return in == SOUND_DEVICE_IN_WIRED_ACCESSORY;
}

// Kept for the owner's use; nothing calls it at present.
void MemoRecorder::__recorderPause()
{
	if (!__recorder) {
		MEMO_LOGE("Recorder Handler is NULL");
		return;
	}
	if (__getState() == RECORDER_STATE_RECORDING) {
		recorder_pause(__recorder);
		__updateRecorderLayout();
	}
}

void MemoRecorder::recorderStop()
{
	if (__elapsedMs < MIN_RECORDING_MS) {
		notification_status_message_post(
		    i18n_get_text("IDS_MEMO_TPOP_RECORDING_CANCELLED_RECORDING_TOO_SHORT_M_VOICE"));
		__recorderCancel();
		return;
	}
	if (__recorder) {
		if (__isActive())
			recorder_commit(__recorder);
		// The handle stays, unprepared, until the panel goes.
		if (__getState() == RECORDER_STATE_READY)
			recorder_unprepare(__recorder);
	}
	free(__filePath);
	__filePath = nullptr;
	__removeBroadcastListener();
	__destroySession(__func__);
	memoVoiceEndCalls(&__callManager);
	memoVoiceMediaKeyReleaseAsync();
	elm_object_signal_emit(getEvasObj(), "recorder,cancel", "elm");
	__stopMpris();
	__signal.emit("recorder,stop", __fileUUID);
	if (__notiMini || __lockMini) {
		__destroyMiniControllers();
		__sendMessagePort();
	}
}

// recorder_cancel removes the file of a running take; the handle goes once it is back to created.
void MemoRecorder::__discardTake()
{
	if (!__recorder)
		return;
	if (__isActive())
		recorder_cancel(__recorder);
	if (__getState() == RECORDER_STATE_READY)
		recorder_unprepare(__recorder);
	if (__getState() == RECORDER_STATE_CREATED) {
		recorder_destroy(__recorder);
		__recorder = nullptr;
	}
}

void MemoRecorder::__recorderCancel()
{
	memoVoiceMediaKeyReleaseAsync();
	__discardTake();
	free(__filePath);
	__filePath = nullptr;
	elm_object_signal_emit(getEvasObj(), "recorder,cancel", "elm");
	__removeBroadcastListener();
	__destroySession(__func__);
	memoVoiceEndCalls(&__callManager);
	__stopMpris();
	__signal.emit("recorder,delete", __fileUUID);
	app_assist::WUiTimer::addTimer(
	    0.1,
	    [this](void *) {
		    __destroyMiniControllers();
		    return false;
	    },
	    nullptr, getEvasObj());
}

void MemoRecorder::__destroySession(const char *caller)
{
	if (!__session)
		return;
	int ret = sound_manager_multi_session_destroy(__session);
	if (ret != SOUND_MANAGER_ERROR_NONE)
		MEMO_LOGE("%s: sound_manager_multi_session_destroy Error : %d", caller, ret);
	__session = nullptr;
}

// The popup of the list and the editor; the take's own, so it is not registered with the popup monitor.
void MemoRecorder::__createStorageFullPopup()
{
	app_assist::WPopupController *popup = memoStorageFullPopupN(nullptr);
	if (popup)
		attachPopup(popup);
}

void MemoRecorder::__recordingStatusCb(unsigned long long elapsedMs, unsigned long long fileSize, void *data)
{
	(void)fileSize;
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	self->__elapsedMs = static_cast<int>(elapsedMs);
	self->__showTime(elapsedMs);
	self->__updateRecorderLayout();
}

// A call, or any sound of higher priority, ends the take; it is kept when long enough.
void MemoRecorder::__stateChangedCb(recorder_state_e previous, recorder_state_e current, bool byPolicy, void *data)
{
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	if (current != RECORDER_STATE_READY || !byPolicy ||
	    (previous != RECORDER_STATE_RECORDING && previous != RECORDER_STATE_PAUSED))
		return;
	if (self->isRecordedEnough())
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_RECORDING_SAVED"));
	MemoUtil::playTapFeedback();
	self->__stopLater();
}

// Time, size and free space end a take alike.
void MemoRecorder::__limitReachedCb(recorder_recording_limit_type_e type, void *data)
{
	MEMO_LOGI("recording limit %d reached", static_cast<int>(type));
	MemoRecorder *self = static_cast<MemoRecorder *>(data);
	notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_RECORDING_SAVED"));
	MemoUtil::playTapFeedback();
	self->__stopLater();
}

// Failures show in the state and in the next call's result; nothing is done here.
void MemoRecorder::__errorCb(recorder_error_e error, recorder_state_e state, void *data)
{
	(void)error;
	(void)state;
	(void)data;
}
