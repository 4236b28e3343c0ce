#ifndef INC_RECORDER_MPLAYERNOTIMINICONTROLLER_H
#define INC_RECORDER_MPLAYERNOTIMINICONTROLLER_H

#include <Ecore.h>
#include <Evas.h>
#include <minicontrol-provider.h>
#include <player.h>

#include "WSignal.h"

// The running playback in the notification panel: one pause-or-resume button ("player,pausedResumed"),
// cancel ("player,canceled", at once) and a title that brings the app back. It reads the state of the
// owner's player and reports presses through _signal, with a null second argument.
class MplayerNotiMiniController
{
public:
	explicit MplayerNotiMiniController(player_h player);
	~MplayerNotiMiniController();

	// Makes the window "memoplayer_mini_controller" with its layout and shows it.
	void create();
	// Hides and deletes the window and drops the rotation handler.
	void hide();
	// Shows the orientation and the player's state (playing or paused) in the layout.
	void update();
	// The position as text: below one hour, and from one hour on.
	void setTime(const char *text);
	void setTimeHour(const char *text);

	Evas_Object *_layout;
	Evas_Object *_win;
	int _rotation;
	player_h _player;
	Ecore_Event_Handler *_xEventHandler;
	app_assist::WSignal<void(const char *, const char *)> _signal;

	void _registerXEvent();
	static Eina_Bool _clientMessageCb(void *data, int type, void *event);
	static void _titleButtonCliked(void *data, Evas *e, Evas_Object *obj, void *event_info);

private:
	void __addCancelButton();
	void __addTitle();
	void __addPauseResumeButton();
	static void __windowEventCb(minicontrol_viewer_event_e event, bundle *arg);
	static void __cancelBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
	static void __pauseResumeBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
};

// The controller alive now (null when none), for the window's event callback, which gets no user data.
extern MplayerNotiMiniController *gPlayerNotiMiniController;

#endif
