#include "Recorder/MPlayerLockScreenMiniController.h"

#include <Elementary.h>

#include "MemoLog.h"
#include "MiniControllerSupport.h"

using namespace mini_controller;

namespace
{
const char *const WINDOW_NAME = "memo-minicontrol.LOCKSCREEN";
const char *const GROUP = "mini_lockscreen_player_controller";
} // namespace

MPlayerLockScreenMiniController::MPlayerLockScreenMiniController(player_h player)
    : _layout(nullptr), _win(nullptr), _player(player)
{
}

MPlayerLockScreenMiniController::~MPlayerLockScreenMiniController()
{
	hide();
}

void MPlayerLockScreenMiniController::create()
{
	_win = createLockWindow(WINDOW_NAME);
	if (!_win)
		MEMO_LOGE("win creation failed return");
	_layout = addLayout(_win, GROUP);
	addButton(_layout, "recorder_pause_play_btn", __pauseResumeBtnCb, this);
	update();
}

void MPlayerLockScreenMiniController::hide()
{
	deleteWindow(&_win, &_layout);
}

void MPlayerLockScreenMiniController::update()
{
	player_state_e state = PLAYER_STATE_NONE;
	if (!_player || !_layout || player_get_state(_player, &state) != PLAYER_ERROR_NONE)
		return;
	if (state == PLAYER_STATE_PLAYING)
		emit(_layout, "player,resumed");
	else if (state == PLAYER_STATE_PAUSED)
		emit(_layout, "player,paused");
}

void MPlayerLockScreenMiniController::setTime(const char *text)
{
	setTimeParts(_layout, "play_time", text, nullptr);
}

void MPlayerLockScreenMiniController::__pauseResumeBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MPlayerLockScreenMiniController *>(data)->_signal.emit("player,pausedResumed", nullptr);
}
