#ifndef INC_RECORDER_MEMOPLAYER_H
#define INC_RECORDER_MEMOPLAYER_H

#include <call-manager.h>
#include <media_key.h>
#include <player.h>

#include <Elementary.h>
#include <string>
#include <WSignal.h>
#include <WViewController.h>

class MplayerNotiMiniController;
class MPlayerLockScreenMiniController;
class MemoMprisPlayer;

// The panel that plays a memo's voice file: play and pause, a slider with the position and the length, and
// in an edit a delete button that asks first. The owner swallows it in its layout's part "recorder_contents"
// and listens to __signal. A call pauses playback and its end resumes it.
//
// Files: MemoPlayer.cpp (the panel, taps, progress, end of the file), MemoPlayerSlider.cpp (dragging and
// seeking), MemoPlayerOutside.cpp (delete popup, broadcasts, indicator, media keys, interruptions, the mini
// controllers).
class MemoPlayer : public app_assist::WViewController
{
public:
	// The file to play; copied.
	explicit MemoPlayer(const char *filePath);
	~MemoPlayer() override;
	// The memo's title, which the desktop's media controls show while the file plays; copied.
	void setMediaTitle(const char *title);

protected:
	// Any non-null `param` shows the panel for reading (no delete button); null gives the edit form. Null
	// with "parent is NULL" on a null parent; a file that cannot be played leaves a panel with no player.
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onCreated() override;
	void onDestroy() override;

private:
	// Tests reach the slider's callbacks and the interruption as the platform gives them.
	friend struct MemoPlayerTestAccess;

	// ---- The panel (MemoPlayer.cpp) ----
	player_h __playerHandleCreate(const char *path);
	void __updatePlayerLayout();
	bool __isInCall();
	player_state_e __getState();
	bool __isActive();
	void __startProgress();
	void __setText(const char *part, int ms);
	static void __playerStartCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	static void __pauseResumeCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	static Eina_Bool __progressTimerCb(void *data);
	static void __playerCompletedCb(void *data);
	static void __playerResetJob(void *data);
	void __playerPause();
	void __playerResume();

	// ---- The slider (MemoPlayerSlider.cpp) ----
	static void __sliderDragStartCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __sliderChangedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __sliderDragStopCb(void *data, Evas_Object *obj, void *eventInfo);
	void __playerProgressbarChanged(player_h player, Evas_Object *slider);

	// ---- Around the panel (MemoPlayerOutside.cpp) ----
	static void __PlayerDeletePopupCb(void *data, Evas *evas, Evas_Object *obj, void *eventInfo);
	void __showDeletePopup();
	void __playerDelete();
	void __playerBroadCasterCb(const char *key);
	void __removeBroadcastListener();
	bool __sendMessagePort();
	static void __media_key_event_cb(media_key_e key, media_key_event_e status, void *data);
	static void __playerInterruptedCb(player_interrupted_code_e code, void *data);
	// The mini controllers keep playback controllable from the notification panel and the lock screen while
	// the app is in the background.
	void __createMiniControllers();
	void __destroyMiniControllers();
	void __setMiniTime(const char *text, int ms);
	void __refreshNotiMini();
	void __refreshLockMini();
	void __onNotiMiniEvent(const char *event);
	void __onLockMiniEvent(const char *event);

	bool __mediaKeyPressed;
	player_h __player;
	int __sliderState;
	Ecore_Timer *__progressTimer;
	Ecore_Job *__resetJob;
	char *__filePath;
	int __viewMode;
	Evas_Object *__parent;
	Evas_Object *__pauseResumeBtn;

public:
	// "player,start" (with the text "To do. uuid", not to be parsed), "player,dragStart", "player,dragStop",
	// "player,deletePopUp" and "player,delete" (with null).
	app_assist::WSignal<void(const char *, const char *)> __signal;

private:
	unsigned int __broadcastId;
	cm_client_h __callManager;
	double __lastDragPosition;
	MplayerNotiMiniController *__notiMini;
	MPlayerLockScreenMiniController *__lockMini;
	bool __inBackground;

	// ---- The desktop's media controls (MemoPlayerMpris.cpp) ----
	// Published from the start of playback to its end.
	void __startMpris();
	void __stopMpris();
	void __updateMpris();
	MemoMprisPlayer *__mpris = nullptr;
	std::string __mediaTitle;
};

#endif
