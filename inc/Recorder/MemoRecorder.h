#ifndef INC_RECORDER_MEMORECORDER_H
#define INC_RECORDER_MEMORECORDER_H

#include <call-manager.h>
#include <media_key.h>
#include <recorder.h>
#include <sound_manager_product.h>

#include <Elementary.h>
#include <string>
#include <WSignal.h>
#include <WViewController.h>

class MRecorderNotiMiniController;
class MRecorderLockScreenMiniController;
class MemoMprisPlayer;

// The panel that records one voice memo into the memo's media folder, as "<data>media/<memo UUID>/<file
// UUID>.amr" (AMR-NB, 8 kHz, 12.2 kbit/s, at most an hour or 7200 KB). The owner swallows it in its
// layout's part "recorder_contents" and listens to __signal.
//
// Files: MemoRecorder.cpp (the panel, its buttons and the time text), MemoRecorderTake.cpp (the platform
// recorder: start, stop, cancel and its callbacks), MemoRecorderOutside.cpp (broadcasts, the indicator,
// media keys, the earjack, the mini controllers).
class MemoRecorder : public app_assist::WViewController
{
public:
	MemoRecorder();
	~MemoRecorder() override;

	// Commits the take when it reached one second and tells "recorder,stop"; a shorter take is given up with
	// the too-short message and "recorder,delete".
	void recorderStop();
	// The stop button's handler: tap feedback, then recorderStop() after 0.1 s. `data` is the recorder.
	static void recorderStopCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	// The memo's title, which the desktop's media controls show while the take runs; copied.
	void setMediaTitle(const char *title);
	// True when the recorder last reported more than 999 ms.
	bool isRecordedEnough() const;
	// True from the start tap until the take is given up or the panel goes: a committed take keeps it.
	bool hasRecorderHandle() const { return __recorder != nullptr; }

protected:
	// `param` is the memo's UUID (const char *). Null with "parent is NULL" on a null parent.
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onCreated() override;
	// A take still running is lost.
	void onDestroy() override;

private:
	// Tests drive the platform's callbacks and shorten the time limit.
	friend struct MemoRecorderTestAccess;

	// ---- The panel (MemoRecorder.cpp) ----
	bool __makeFilePath(const char *memoUUID);
	Evas_Object *__takePartObject(const char *part, Evas_Object_Event_Cb callback);
	void __updateRecorderLayout();
	void __showTime(unsigned long long ms);
	void __onStartTimer();
	void __showDiscardPopup();
	static void __recorderCreateCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	static void __pauseResumeCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	static void __recorderDeletePopupCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	bool __isInCall();
	bool __isActive();
	recorder_state_e __getState();

	// ---- The take (MemoRecorderTake.cpp) ----
	recorder_h __recHandleCreate(const char *path);
	int __recorderStart(recorder_h recorder);
	void __recorderPause();
	void __recorderCancel();
	// Cancels a running take, unprepares and destroys the handle.
	void __discardTake();
	void __destroySession(const char *caller);
	void __createStorageFullPopup();
	bool _isEarjackInserted();
	// Runs recorderStop() after 0.1 s, tied to the panel.
	void __stopLater();
	static void __recordingStatusCb(unsigned long long elapsedMs, unsigned long long fileSize, void *data);
	static void __stateChangedCb(recorder_state_e previous, recorder_state_e current, bool byPolicy, void *data);
	static void __limitReachedCb(recorder_recording_limit_type_e type, void *data);
	static void __errorCb(recorder_error_e error, recorder_state_e state, void *data);

	// ---- Around the panel (MemoRecorderOutside.cpp) ----
	void __recorderBroadCasterCb(const char *key);
	void __removeBroadcastListener();
	bool __sendMessagePort();
	static void __media_key_event_cb(media_key_e key, media_key_event_e status, void *data);
	static void _soundActiveDeviceChangedCb(sound_device_in_e in, sound_device_out_e out, void *data);
	// The mini controllers keep a take controllable from the notification panel and the lock screen while
	// the app is in the background.
	void __createMiniControllers();
	void __destroyMiniControllers();
	void __setMiniTime(const char *text, unsigned long long ms);
	void __refreshNotiMini();
	void __refreshLockMini();
	void __onNotiMiniEvent(const char *event);
	void __onLockMiniEvent(const char *event);

	recorder_h __recorder;
	bool __mediaKeyPressed;
	char *__filePath;
	char *__fileUUID;
	Evas_Object *__parent;
	Evas_Object *__startBtn;
	Evas_Object *__cancelBtn;
	Evas_Object *__stopBtn;
	Evas_Object *__pauseResumeBtn;
	int __elapsedMs;
	unsigned int __broadcastId;
	sound_multi_session_h __session;
	cm_client_h __callManager;
	MRecorderNotiMiniController *__notiMini;
	MRecorderLockScreenMiniController *__lockMini;
	bool __inBackground;
	int __lastInputDevice;

	// ---- The desktop's media controls (MemoRecorderMpris.cpp) ----
	// Published from the start of the take to its end.
	void __startMpris();
	void __stopMpris();
	void __updateMpris();
	MemoMprisPlayer *__mpris = nullptr;
	std::string __mediaTitle;

	// The time limit of a take in seconds: an hour.
	static int __timeLimitSeconds;

public:
	// "recorder,start", "recorder,stop", "recorder,delete" and "recorder,dicardPopUp", each with the new file's
	// UUID.
	app_assist::WSignal<void(const char *, const char *)> __signal;
};

#endif
