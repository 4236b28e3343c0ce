#include "Recorder/MPlayerLockScreenMiniController.h"

#include <Elementary.h>
#include <minicontrol-provider.h>

#include "MemoLog.h"
#include "MiniControllerSupport.h"
#include "Util/MemoUtil.h"

using namespace mini_controller;

namespace
{
const char *const WINDOW_NAME = "memo-minicontrol.LOCKSCREEN";
const char *const GROUP = "mini_lockscreen_player_controller";

// The lock screen sends nothing that this controller acts on.
void windowEventCb(minicontrol_viewer_event_e, bundle *) {}
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
	_win = minicontrol_create_window(WINDOW_NAME, MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN, windowEventCb);
	if (!_win)
		MEMO_LOGE("win creation failed return");
	elm_win_alpha_set(_win, EINA_TRUE);
	evas_object_resize(_win, lockWidth(_win), scaled(LOCK_HEIGHT));
	evas_object_show(_win);

	_layout = elm_layout_add(_win);
	elm_layout_file_set(_layout, MemoUtil::getEdjePath(), GROUP);
	evas_object_size_hint_weight_set(_layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_show(_layout);
	elm_win_resize_object_add(_win, _layout);

	if (!_layout)
		MEMO_LOGE("getEvasObj() is nullptr");
	else
		addPartMouseUp(_layout, "recorder_pause_play_btn", __pauseResumeBtnCb, this);
	update();
}

void MPlayerLockScreenMiniController::hide()
{
	if (_win) {
		evas_object_hide(_win);
		evas_object_del(_win);
	}
	_win = nullptr;
	_layout = nullptr;
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
