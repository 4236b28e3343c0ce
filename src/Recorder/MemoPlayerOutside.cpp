// What reaches the player from around it and what it tells outside: the delete question, the app's
// broadcasts, the indicator, the media keys, interruptions, and the mini controllers.
#include "Recorder/MemoPlayer.h"

#include <cstring>

#include <WPopupController.h>
#include <WUiTimer.h>

#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Model/MemoPopupMonitor.h"
#include "Recorder/MPlayerLockScreenMiniController.h"
#include "Recorder/MemoVoicePanel.h"
#include "Recorder/MplayerNotiMiniController.h"
#include "Util/MemoUtil.h"

using app_assist::WPopupController;

void MemoPlayer::__PlayerDeletePopupCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo)
{
	(void)evas;
	(void)obj;
	(void)eventInfo;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	MemoUtil::playTapFeedback();
	self->__signal.emit("player,deletePopUp", nullptr);
	app_assist::WUiTimer::addTimer(
	    0.1,
	    [self](void *) {
		    self->__showDeletePopup();
		    return false;
	    },
	    nullptr, self->getEvasObj());
}

void MemoPlayer::__showDeletePopup()
{
	WPopupController *popup = new WPopupController();
	popup->setTextTranslatable("memo-sub");
	popup->setTitle("IDS_MEMO_BUTTON_DELETE");
	popup->setContent("IDS_MEMO_POP_THIS_VOICE_MEMO_WILL_BE_DELETED");
	popup->addButton("IDS_MEMO_BUTTON_CANCEL", std::function<void(bool *)>());
	popup->addButton("IDS_MEMO_BUTTON_DELETE", [this](bool *close) {
		__playerDelete();
		*close = true;
	});
	MemoPopupMonitor::getInstance()->addPopup(popup);
	attachPopup(popup);
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

// From one hour on the notification controller shows the time in its hour part.
static const int HOUR_MS = 3600000;

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
	if (__broadcastId)
		MemoBroadCaster::getInstance().removeListener(__broadcastId);
	__broadcastId = 0;
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
	if (key != MEDIA_KEY_MEDIA)
		return;
	self->__mediaKeyPressed = !self->__mediaKeyPressed;
	if (!self->__mediaKeyPressed && self->__isActive())
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
	__notiMini = new MplayerNotiMiniController(__player);
	__notiMini->create();
	__notiMini->_signal.addListener([this](const char *event, const char *) { __onNotiMiniEvent(event); });
	__lockMini = new MPlayerLockScreenMiniController(__player);
	__lockMini->create();
	__lockMini->_signal.addListener([this](const char *event, const char *) { __onLockMiniEvent(event); });
}

void MemoPlayer::__destroyMiniControllers()
{
	if (__notiMini) {
		__notiMini->hide();
		delete __notiMini;
		__notiMini = nullptr;
	}
	if (__lockMini) {
		__lockMini->hide();
		delete __lockMini;
		__lockMini = nullptr;
	}
}

void MemoPlayer::__setMiniTime(const char *text, int ms)
{
	if (__notiMini) {
		if (ms >= HOUR_MS)
			__notiMini->setTimeHour(text);
		else
			__notiMini->setTime(text);
	}
	if (__lockMini)
		__lockMini->setTime(text);
}

void MemoPlayer::__refreshNotiMini()
{
	if (__notiMini)
		__notiMini->update();
}

void MemoPlayer::__refreshLockMini()
{
	if (__lockMini)
		__lockMini->update();
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
