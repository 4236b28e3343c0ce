#include "Recorder/MplayerNotiMiniController.h"

#include <Ecore_X.h>
#include <Elementary.h>

#include "MemoLog.h"
#include "MiniControllerSupport.h"

using namespace mini_controller;

MplayerNotiMiniController *gPlayerNotiMiniController = nullptr;

namespace
{
const char *const WINDOW_NAME = "memoplayer_mini_controller";
const char *const GROUP = "mini_controller_player";
} // namespace

MplayerNotiMiniController::MplayerNotiMiniController(player_h player)
    : _layout(nullptr), _win(nullptr), _rotation(0), _player(player), _xEventHandler(nullptr)
{
	gPlayerNotiMiniController = this;
}

MplayerNotiMiniController::~MplayerNotiMiniController()
{
	if (gPlayerNotiMiniController == this)
		gPlayerNotiMiniController = nullptr;
	hide();
}

void MplayerNotiMiniController::create()
{
	_win = createNotiWindow(WINDOW_NAME, __windowEventCb, &_rotation);
	_layout = addLayout(_win, GROUP);
	__addCancelButton();
	__addTitle();
	__addPauseResumeButton();
	update();
	_registerXEvent();
}

void MplayerNotiMiniController::hide()
{
	deleteWindow(&_win, &_layout);
	deleteHandler(&_xEventHandler);
}

void MplayerNotiMiniController::update()
{
	player_state_e state = PLAYER_STATE_NONE;
	if (!_player || !_layout || player_get_state(_player, &state) != PLAYER_ERROR_NONE)
		return;
	if (state != PLAYER_STATE_PLAYING && state != PLAYER_STATE_PAUSED)
		return;
	emit(_layout, isLandscape(_rotation) ? "player,landscape" : "player,portrait");
	emit(_layout, state == PLAYER_STATE_PLAYING ? "player,resumed" : "player,paused");
}

void MplayerNotiMiniController::setTime(const char *text)
{
	setTimeParts(_layout, "player_time", text, "player_time_hour");
}

void MplayerNotiMiniController::setTimeHour(const char *text)
{
	setTimeParts(_layout, "player_time_hour", text, "player_time");
}

void MplayerNotiMiniController::__addCancelButton()
{
	addButton(_layout, "recorder_cancel_btn", __cancelBtnCb, this);
}

void MplayerNotiMiniController::__addTitle()
{
	addButton(_layout, "mini_title", _titleButtonCliked, this);
}

void MplayerNotiMiniController::__addPauseResumeButton()
{
	addButton(_layout, "recorder_pause_resume_btn", __pauseResumeBtnCb, this);
}

void MplayerNotiMiniController::__cancelBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MplayerNotiMiniController *>(data)->_signal.emit("player,canceled", nullptr);
}

void MplayerNotiMiniController::__pauseResumeBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MplayerNotiMiniController *>(data)->_signal.emit("player,pausedResumed", nullptr);
}

// No tap sound here, unlike the recorder's title.
void MplayerNotiMiniController::_titleButtonCliked(void *data, Evas *, Evas_Object *, void *)
{
	if (!data) {
		MEMO_LOGE("self is nullptr");
		return;
	}
	resumeApp();
}

void MplayerNotiMiniController::__windowEventCb(minicontrol_viewer_event_e event, bundle *)
{
	if ((int)event != EVENT_REQUEST_HIDE)
		return;
	if (!gPlayerNotiMiniController) {
		MEMO_LOGE("self is nullptr");
		return;
	}
	gPlayerNotiMiniController->_signal.emit("player,canceled", nullptr);
}

void MplayerNotiMiniController::_registerXEvent()
{
	if (!_xEventHandler)
		_xEventHandler = ecore_event_handler_add(ECORE_X_EVENT_CLIENT_MESSAGE, _clientMessageCb, this);
}

Eina_Bool MplayerNotiMiniController::_clientMessageCb(void *data, int, void *event)
{
	MplayerNotiMiniController *self = static_cast<MplayerNotiMiniController *>(data);
	if (!self) {
		MEMO_LOGE("self is nullptr");
		return EINA_FALSE;
	}
	if (rotateNotiWindow(self->_win, &self->_rotation, event))
		self->update();
	return EINA_TRUE;
}
