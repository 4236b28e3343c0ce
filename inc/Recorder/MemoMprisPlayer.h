#ifndef INC_RECORDER_MEMOMPRISPLAYER_H
#define INC_RECORDER_MEMOMPRISPLAYER_H

#include <player.h>
#include <recorder.h>

#include <string>

#include "WSignal.h"

typedef struct _Eldbus_Connection Eldbus_Connection;
typedef struct _Eldbus_Service_Interface Eldbus_Service_Interface;

// A running recording or playback published on the session bus as the media player
// "org.mpris.MediaPlayer2.memo", so that the desktop's media controls (its panel, its lock screen, the media
// keys) reach it. It owns no audio: it reads the state of the owner's handle and reports the requests through
// _signal with the events of the mini controllers: "recorder,paused" (pause or resume) and
// "recorder,stopped" for a recording, "player,pausedResumed" and "player,canceled" for a playback.
class MemoMprisPlayer
{
public:
	MemoMprisPlayer(recorder_h recorder, const char *title);
	MemoMprisPlayer(player_h player, const char *title);
	~MemoMprisPlayer();

	// Publishes the player; false (with an info line) when there is no session bus or the name is taken.
	bool create();
	// Announces the state of the handle (after a pause, a resume or a stop).
	void update();
	// The recording's elapsed time, which the bus reads as the position (a player's is read from it).
	void setPosition(unsigned long long ms);
	void setTitle(const char *title);

	app_assist::WSignal<void(const char *, const char *)> _signal;

private:
	// The bus side: the interfaces' tables and callbacks (MemoMprisPlayer.cpp).
	friend struct MemoMprisBus;

	// "Playing", "Paused" or "Stopped", by the handle's state.
	const char *__playbackStatus() const;
	long long __positionUs() const;
	// Play, Pause, PlayPause and Stop, as the owner's events: plays 1, pauses -1, toggles 0, stops 2.
	void __request(int request);

	recorder_h __recorder;
	player_h __player;
	std::string __title;
	unsigned long long __positionMs;
	Eldbus_Connection *__conn;
	Eldbus_Service_Interface *__rootIface;
	Eldbus_Service_Interface *__playerIface;
};

#endif
