// The player's panel: the layout in the owner's "recorder_contents", play and pause, the progress shown 30
// times a second, and the end of the file.
#include "Recorder/MemoPlayer.h"

#include <cstdlib>
#include <cstring>

#include <app_i18n.h>
#include <notification.h>
#include <sound_manager.h>

#include "MemoApp.h"
#include "MemoLog.h"
#include "Recorder/MemoVoicePanel.h"
#include "Util/MemoUtil.h"

static const char *const PLAYER_GROUP = "memo_recorder_play";
static const double PROGRESS_INTERVAL = 1.0 / 30.0;

MemoPlayer::MemoPlayer(const char *filePath)
    : __mediaKeyPressed(false), __player(nullptr), __sliderState(0), __progressTimer(nullptr), __resetJob(nullptr),
      __filePath(filePath ? strdup(filePath) : nullptr), __viewMode(0), __parent(nullptr), __pauseResumeBtn(nullptr),
      __broadcastId(0), __callManager(nullptr), __lastDragPosition(0.0), __notiMini(nullptr), __lockMini(nullptr),
      __inBackground(false)
{
}

MemoPlayer::~MemoPlayer()
{
	__destroyMiniControllers();
	__stopMpris();
	free(__filePath);
}

Evas_Object *MemoPlayer::onCreateView(Evas_Object *parent, void *param)
{
	if (!parent) {
		MEMO_LOGE("parent is NULL");
		return nullptr;
	}
	if (!__player) {
		__player = __playerHandleCreate(__filePath);
		if (!__player)
			MEMO_LOGE("Player handle create error");
	}
	player_set_interrupted_cb(__player, __playerInterruptedCb, this);
	__parent = parent;
	Evas_Object *layout = memoVoiceAddPanelLayout(parent, PLAYER_GROUP);
	Evas_Object *edje = elm_layout_edje_get(layout);

	if (!param) {
		Evas_Object *cancel = const_cast<Evas_Object *>(edje_object_part_object_get(edje, "player_cancel_btn"));
		if (cancel)
			evas_object_event_callback_add(cancel, EVAS_CALLBACK_MOUSE_UP, __PlayerDeletePopupCb, this);
	} else {
		elm_object_signal_emit(layout, "player,view", "elm");
		__viewMode = 1;
	}
	__pauseResumeBtn = const_cast<Evas_Object *>(edje_object_part_object_get(edje, "player_pause_resume_btn"));
	if (__pauseResumeBtn)
		evas_object_event_callback_add(__pauseResumeBtn, EVAS_CALLBACK_MOUSE_UP, __playerStartCb, this);

	Evas_Object *slider = elm_slider_add(layout);
	elm_object_focus_allow_set(slider, EINA_FALSE);
	evas_object_size_hint_weight_set(slider, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(slider, EVAS_HINT_FILL, EVAS_HINT_FILL);
	elm_slider_horizontal_set(slider, EINA_TRUE);
	evas_object_smart_callback_add(slider, "slider,drag,start", __sliderDragStartCb, this);
	evas_object_smart_callback_add(slider, "changed", __sliderChangedCb, this);
	evas_object_smart_callback_add(slider, "slider,drag,stop", __sliderDragStopCb, this);
	elm_object_part_content_set(layout, "recorder_slider", slider);

	int duration = 0;
	player_get_duration(__player, &duration);
	char total[32] = {0};
	memoVoiceFormatTime(duration, total, sizeof(total));
	elm_object_part_text_set(layout, "recorder_sliderTime", "00:00");
	elm_object_part_text_set(layout, "recorder_totalTime", total);
	elm_object_part_text_set(layout, "player_view_totalTime", total);
	return layout;
}

// Every step is tried; only the prepare decides.
player_h MemoPlayer::__playerHandleCreate(const char *path)
{
	sound_manager_set_session_type(SOUND_SESSION_TYPE_MEDIA);
	sound_manager_set_media_session_option(SOUND_SESSION_OPTION_PAUSE_OTHERS_WHEN_START,
	                                       SOUND_SESSION_OPTION_INTERRUPTIBLE_DURING_PLAY);
	player_h player = nullptr;
	int ret = player_create(&player);
	if (ret != PLAYER_ERROR_NONE)
		MEMO_LOGE("player create error1! %d", ret);
	ret |= player_set_sound_type(player, SOUND_TYPE_MEDIA);
	if (ret != PLAYER_ERROR_NONE)
		MEMO_LOGE("player create error2! %d", ret);
	ret |= player_set_uri(player, path);
	if (ret != PLAYER_ERROR_NONE)
		MEMO_LOGE("player create error3! %d", ret);
	ret |= player_prepare(player);
	if (ret != PLAYER_ERROR_NONE) {
		MEMO_LOGE("player create error4! %d", ret);
		player_unprepare(player);
		player_destroy(player);
		MEMO_LOGE("player create error5! %d", ret);
		return nullptr;
	}
	return player;
}

void MemoPlayer::onCreated()
{
	__updatePlayerLayout();
	memoVoiceAddBroadcastListener(
	    &__broadcastId, [this](const char *key) { __playerBroadCasterCb(key); }, getEvasObj());
}

void MemoPlayer::onDestroy()
{
	// The owner may have put another panel in the part since.
	if (__parent && elm_object_part_content_get(__parent, "recorder_contents") == getEvasObj())
		elm_object_part_content_unset(__parent, "recorder_contents");
	if (__progressTimer) {
		ecore_timer_del(__progressTimer);
		__progressTimer = nullptr;
	}
	__stopMpris();
	if (__player) {
		player_destroy(__player);
		__player = nullptr;
	}
	if (__resetJob) {
		ecore_job_del(__resetJob);
		__resetJob = nullptr;
	}
	memoVoiceMediaKeyReleaseAsync();
	memoVoiceEndCalls(&__callManager);
	if (__notiMini)
		__sendMessagePort();
}

player_state_e MemoPlayer::__getState()
{
	player_state_e state = PLAYER_STATE_NONE;
	if (__player)
		player_get_state(__player, &state);
	return state;
}

bool MemoPlayer::__isActive()
{
	const player_state_e state = __getState();
	return state == PLAYER_STATE_PLAYING || state == PLAYER_STATE_PAUSED;
}

// The call manager is asked for at the first check.
bool MemoPlayer::__isInCall()
{
	if (!__callManager && cm_init(&__callManager) != CM_ERROR_NONE)
		__callManager = nullptr;
	return memoVoiceInCall(__callManager);
}

void MemoPlayer::__setText(const char *part, int ms)
{
	char text[32] = {0};
	memoVoiceFormatTime(ms, text, sizeof(text));
	elm_object_part_text_set(getEvasObj(), part, text);
}

void MemoPlayer::__updatePlayerLayout()
{
	Evas_Object *layout = getEvasObj();
	if (!layout)
		return;
	const player_state_e state = __getState();
	elm_object_signal_emit(layout, gIsPortrait ? "player,portrait" : "player,landscape", "elm");
	if (__viewMode == 1) {
		elm_object_signal_emit(layout, "player,view", "elm");
		if (state == PLAYER_STATE_PLAYING || state == PLAYER_STATE_PAUSED) {
			elm_object_signal_emit(layout, state == PLAYER_STATE_PLAYING ? "player,resumed" : "player,paused", "elm");
			elm_object_signal_emit(layout, "player,hideViewModeTotalTime", "elm");
		} else {
			elm_object_signal_emit(layout, "player,paused", "elm");
			elm_object_signal_emit(
			    layout, gIsPortrait ? "player,showViewModeTotalTimePortrait" : "player,showViewModeTotalTimeLandscape",
			    "elm");
		}
		return;
	}
	elm_object_signal_emit(layout, "player,hideViewModeTotalTime", "elm");
	elm_object_signal_emit(layout, state == PLAYER_STATE_PLAYING ? "player,resumed" : "player,paused", "elm");
}

void MemoPlayer::__playerStartCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	MemoUtil::playTapFeedback();
	if (self->__isInCall()) {
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_CANT_PLAY_AUDIO_DURING_CALLS"));
		return;
	}
	// A warning only: playback begins all the same.
	if (MemoUtil::isRecorderBusy())
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_CANT_PLAY_AUDIO_WHILE_RECORDING_AUDIO_OR_VIDEO"));
	memoVoiceMediaKeyReserveAsync(__media_key_event_cb, self);
	// Later taps pause and resume.
	if (self->__pauseResumeBtn) {
		evas_object_event_callback_del_full(self->__pauseResumeBtn, EVAS_CALLBACK_MOUSE_UP, __playerStartCb, self);
		evas_object_event_callback_add(self->__pauseResumeBtn, EVAS_CALLBACK_MOUSE_UP, __pauseResumeCb, self);
	}
	player_set_completed_cb(self->__player, __playerCompletedCb, self);
	player_start(self->__player);
	self->__startProgress();
	self->__updatePlayerLayout();
	self->__startMpris();
	self->__updateMpris();
	self->__signal.emit("player,start", "To do. uuid");
}

void MemoPlayer::__startProgress()
{
	if (!__progressTimer)
		__progressTimer = ecore_timer_add(PROGRESS_INTERVAL, __progressTimerCb, this);
	else if (ecore_timer_freeze_get(__progressTimer))
		ecore_timer_thaw(__progressTimer);
}

void MemoPlayer::__pauseResumeCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	MemoUtil::playTapFeedback();
	memoVoiceMediaKeyReserveAsync(__media_key_event_cb, self);
	if (!self->__player)
		return;
	if (self->__getState() == PLAYER_STATE_PLAYING) {
		player_pause(self->__player);
		if (self->__progressTimer)
			ecore_timer_freeze(self->__progressTimer);
	} else {
		if (self->__isInCall()) {
			notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_CANT_PLAY_AUDIO_DURING_CALLS"));
			return;
		}
		if (MemoUtil::isRecorderBusy())
			notification_status_message_post(
			    i18n_get_text("IDS_MEMO_TPOP_CANT_PLAY_AUDIO_WHILE_RECORDING_AUDIO_OR_VIDEO"));
		player_start(self->__player);
		self->__startProgress();
	}
	self->__updatePlayerLayout();
	self->__startMpris();
	self->__updateMpris();
	if (self->__notiMini) {
		self->__sendMessagePort();
		self->__refreshNotiMini();
	}
	if (self->__lockMini)
		self->__refreshLockMini();
}

Eina_Bool MemoPlayer::__progressTimerCb(void *data)
{
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	// A drag shows its own position.
	if (self->__sliderState == 2)
		return ECORE_CALLBACK_RENEW;
	if (!self->__player) {
		self->__progressTimer = nullptr;
		return ECORE_CALLBACK_CANCEL;
	}
	int position = 0, duration = 0;
	player_get_play_position(self->__player, &position);
	player_get_duration(self->__player, &duration);
	Evas_Object *slider = elm_object_part_content_get(self->getEvasObj(), "recorder_slider");
	elm_slider_value_set(slider, duration > 0 ? static_cast<double>(position) / duration : 0.0);
	char text[32] = {0};
	memoVoiceFormatTime(position, text, sizeof(text));
	elm_object_part_text_set(self->getEvasObj(), "recorder_sliderTime", text);
	self->__setMiniTime(text, position);
	return ECORE_CALLBACK_RENEW;
}

// A completion must not change the view at once: the reset runs as a job.
void MemoPlayer::__playerCompletedCb(void *data)
{
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	if (self->__getState() > PLAYER_STATE_READY)
		player_stop(self->__player);
	if (self->__progressTimer) {
		ecore_timer_del(self->__progressTimer);
		self->__progressTimer = nullptr;
	}
	if (self->__resetJob)
		ecore_job_del(self->__resetJob);
	self->__resetJob = ecore_job_add(__playerResetJob, self);
	self->__updatePlayerLayout();
	elm_object_part_text_set(self->getEvasObj(), "recorder_sliderTime", "00:00");
}

// Back at the start; the next tap plays from there through __pauseResumeCb.
void MemoPlayer::__playerResetJob(void *data)
{
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	if (self->__pauseResumeBtn) {
		evas_object_event_callback_del_full(self->__pauseResumeBtn, EVAS_CALLBACK_MOUSE_UP, __pauseResumeCb, self);
		evas_object_event_callback_add(self->__pauseResumeBtn, EVAS_CALLBACK_MOUSE_UP, __pauseResumeCb, self);
	}
	elm_slider_value_set(elm_object_part_content_get(self->getEvasObj(), "recorder_slider"), 0.0);
	elm_object_part_text_set(self->getEvasObj(), "recorder_slider.time", "00:00:00");
	self->__resetJob = nullptr;
	memoVoiceMediaKeyReleaseAsync();
	self->__stopMpris();
	if (self->__notiMini || self->__lockMini) {
		self->__destroyMiniControllers();
		self->__sendMessagePort();
	}
}

// Kept for the owner's use; nothing calls it at present.
void MemoPlayer::__playerPause()
{
	if (!__player) {
		MEMO_LOGE("Player Handler is NULL");
		return;
	}
	if (__getState() == PLAYER_STATE_PLAYING) {
		player_pause(__player);
		if (__progressTimer)
			ecore_timer_freeze(__progressTimer);
		__updatePlayerLayout();
	}
}

void MemoPlayer::__playerResume()
{
	if (__player && __getState() == PLAYER_STATE_PAUSED)
		player_start(__player);
	if (__notiMini) {
		__sendMessagePort();
		__refreshNotiMini();
	}
}
