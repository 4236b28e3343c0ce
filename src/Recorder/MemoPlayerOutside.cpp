// What reaches the player from around it and what it tells outside: the delete question, the app's
// broadcasts, the indicator, the media keys, interruptions, and the mini controllers.
#include "Recorder/MemoPlayer.h"

#include <cstring>

#include <WPopupController.h>

#include "MemoLog.h"
#include "Recorder/MPlayerLockScreenMiniController.h"
#include "Recorder/MemoVoicePanel.h"
#include "Recorder/MplayerNotiMiniController.h"
#include "Util/MemoUtil.h"

void MemoPlayer::__PlayerDeletePopupCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	MemoUtil::playTapFeedback();
	self->__signal.emit("player,deletePopUp", nullptr);
	memoVoiceAfterTap(self->getEvasObj(), [self]() { self->__showDeletePopup(); });
}

void MemoPlayer::__showDeletePopup()
{
	attachPopup(memoVoiceConfirmPopupN("IDS_MEMO_BUTTON_DELETE", "IDS_MEMO_POP_THIS_VOICE_MEMO_WILL_BE_DELETED",
	                                   "IDS_MEMO_BUTTON_DELETE", [this]() { __playerDelete(); }));
}

// The owner forgets the file; the file itself goes at the next save.
void MemoPlayer::__playerDelete()
{
	if (__progressTimer) {
		ecore_timer_del(__progressTimer);
		__progressTimer = nullptr;
	}
	if (__player) {
		player_destroy(__player);
		__player = nullptr;
	}
	if (__resetJob) {
		ecore_job_del(__resetJob);
		__resetJob = nullptr;
	}
	elm_object_signal_emit(getEvasObj(), "player,delete", "elm");
	__removeBroadcastListener();
	memoVoiceMediaKeyReleaseAsync();
	__signal.emit("player,delete", nullptr);
}

void MemoPlayer::__playerBroadCasterCb(const char *key)
{
	if (!key)
		return;
	if (!strcmp(key, "broadcast,orientation,changed")) {
		__updatePlayerLayout();
	} else if (!strcmp(key, "broadcast,memo,app,pause")) {
		// Playback keeps running in the background.
		__inBackground = true;
		if (__isActive()) {
			__createMiniControllers();
			__sendMessagePort();
			__progressTimerCb(this);
		}
	} else if (!strcmp(key, "broadcast,memo,app,resume")) {
		__inBackground = false;
		__sendMessagePort();
		__destroyMiniControllers();
	}
}

void MemoPlayer::__removeBroadcastListener()
{
	memoVoiceRemoveBroadcastListener(&__broadcastId);
}

// The indicator shows playback running or paused while the app is in the background; the recorder uses
// the same channel.
bool MemoPlayer::__sendMessagePort()
{
	const char *value = "voicerecorder_none";
	if (!__player) {
		MEMO_LOGE("Player handler is NULL");
	} else if (__inBackground) {
		const player_state_e state = __getState();
		if (state == PLAYER_STATE_PLAYING)
			value = "bg_playing_start";
		else if (state == PLAYER_STATE_PAUSED)
			value = "bg_playing_pause";
	}
	return memoVoiceSendIndicator(value);
}

// Press and release of the media key make one pause or resume.
void MemoPlayer::__media_key_event_cb(media_key_e key, media_key_event_e status, void *data)
{
	(void)status;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	if (!self || !self->__player) {
		MEMO_LOGE("Memo Player Handler is NULL");
		return;
	}
	if (memoVoiceMediaKeyToggled(key, &self->__mediaKeyPressed) && self->__isActive())
		__pauseResumeCb(self, nullptr, nullptr, nullptr);
}

// The platform paused playback (a call, another sound); code 0 says the interruption is over, and
// playback goes on by itself.
void MemoPlayer::__playerInterruptedCb(player_interrupted_code_e code, void *data)
{
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	self->__updatePlayerLayout();
	if (code == PLAYER_INTERRUPTED_COMPLETED) {
		self->__playerResume();
		self->__updatePlayerLayout();
	}
	self->__updateMpris();
	if (self->__notiMini) {
		self->__refreshNotiMini();
		self->__sendMessagePort();
	}
	if (self->__lockMini)
		self->__refreshLockMini();
}

void MemoPlayer::__createMiniControllers()
{
	__notiMini = memoVoiceMiniCreateN<MplayerNotiMiniController>(
	    __player, [this](const char *event) { __onNotiMiniEvent(event); });
	__lockMini = memoVoiceMiniCreateN<MPlayerLockScreenMiniController>(
	    __player, [this](const char *event) { __onLockMiniEvent(event); });
}

void MemoPlayer::__destroyMiniControllers()
{
	memoVoiceMiniDelete(&__notiMini);
	memoVoiceMiniDelete(&__lockMini);
}

void MemoPlayer::__setMiniTime(const char *text, int ms)
{
	memoVoiceMiniSetTime(__notiMini, __lockMini, text, ms);
}

void MemoPlayer::__refreshNotiMini()
{
	memoVoiceMiniUpdate(__notiMini);
}

void MemoPlayer::__refreshLockMini()
{
	memoVoiceMiniUpdate(__lockMini);
}

void MemoPlayer::__onNotiMiniEvent(const char *event)
{
	if (!strcmp(event, "player,pausedResumed"))
		__pauseResumeCb(this, nullptr, nullptr, nullptr);
	else if (!strcmp(event, "player,canceled"))
		__playerCompletedCb(this);
	__refreshLockMini();
}

void MemoPlayer::__onLockMiniEvent(const char *event)
{
	if (!strcmp(event, "player,pausedResumed"))
		__pauseResumeCb(this, nullptr, nullptr, nullptr);
	__refreshNotiMini();
}
