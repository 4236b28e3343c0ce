#ifndef INC_RECORDER_MPLAYERLOCKSCREENMINICONTROLLER_H
#define INC_RECORDER_MPLAYERLOCKSCREENMINICONTROLLER_H

#include <Evas.h>
#include <player.h>

#include "WSignal.h"

// The running playback on the lock screen: one pause-or-resume button ("player,pausedResumed") and the
// position.
class MPlayerLockScreenMiniController
{
public:
	explicit MPlayerLockScreenMiniController(player_h player);
	~MPlayerLockScreenMiniController();

	// Makes the window "memo-minicontrol.LOCKSCREEN" with its layout and shows it.
	void create();
	// Hides and deletes the window.
	void hide();
	// Shows the player's state (playing or paused).
	void update();
	// The position as text, in any format.
	void setTime(const char *text);

	Evas_Object *_layout;
	Evas_Object *_win;
	player_h _player;
	app_assist::WSignal<void(const char *, const char *)> _signal;

private:
	static void __pauseResumeBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
};

#endif
