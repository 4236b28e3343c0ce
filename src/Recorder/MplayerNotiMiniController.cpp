#include "Recorder/MplayerNotiMiniController.h"

#include <Ecore_X.h>
#include <Elementary.h>

#include "MemoLog.h"
#include "MiniControllerSupport.h"
#include "Util/MemoUtil.h"

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
	_win = minicontrol_create_window(WINDOW_NAME, MINICONTROL_TARGET_VIEWER_QUICK_PANEL, __windowEventCb);
	_rotation = elm_win_rotation_get(_win);
	elm_win_alpha_set(_win, EINA_TRUE);
	evas_object_resize(_win, panelWidth(_rotation), scaled(NOTI_HEIGHT));
	evas_object_show(_win);

	_layout = elm_layout_add(_win);
	elm_layout_file_set(_layout, MemoUtil::getEdjePath(), GROUP);
	evas_object_size_hint_weight_set(_layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_show(_layout);
	elm_win_resize_object_add(_win, _layout);

	__addCancelButton();
	__addTitle();
	__addPauseResumeButton();
	update();
	_registerXEvent();
}

void MplayerNotiMiniController::hide()
{
	if (_win) {
		evas_object_hide(_win);
		evas_object_del(_win);
	}
	_win = nullptr;
	_layout = nullptr;
	if (_xEventHandler)
		ecore_event_handler_del(_xEventHandler);
	_xEventHandler = nullptr;
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
	if (!_layout) {
		MEMO_LOGE("getEvasObj() is nullptr");
		return;
	}
	addPartMouseUp(_layout, "recorder_cancel_btn", __cancelBtnCb, this);
}

void MplayerNotiMiniController::__addTitle()
{
	if (!_layout) {
		MEMO_LOGE("getEvasObj() is nullptr");
		return;
	}
	addPartMouseUp(_layout, "mini_title", _titleButtonCliked, this);
}

void MplayerNotiMiniController::__addPauseResumeButton()
{
	if (!_layout) {
		MEMO_LOGE("getEvasObj() is nullptr");
		return;
	}
	addPartMouseUp(_layout, "recorder_pause_resume_btn", __pauseResumeBtnCb, this);
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
	Ecore_X_Event_Client_Message *ev = static_cast<Ecore_X_Event_Client_Message *>(event);
	if (ev->message_type == ECORE_X_ATOM_E_ILLUME_ROTATE_ROOT_ANGLE && ev->data.l[0] != self->_rotation) {
		int angle = static_cast<int>(ev->data.l[0]);
		evas_object_resize(self->_win, panelWidth(angle), scaled(NOTI_HEIGHT));
		self->_rotation = angle;
		self->update();
	}
	return EINA_TRUE;
}
