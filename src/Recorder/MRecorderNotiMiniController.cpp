#include "Recorder/MRecorderNotiMiniController.h"

#include <app_i18n.h>
#include <feedback.h>

#include <set>

#include "MemoLog.h"
#include "MiniControllerSupport.h"

#include <Ecore_X.h>
#include <Elementary.h>

using namespace mini_controller;

MRecorderNotiMiniController *gRecorderNotiMiniController = nullptr;

namespace
{
const char *const WINDOW_NAME = "memorecorder_mini_controller";
const char *const GROUP = "mini_controller";
const char *const POPUP_APP_ID = "com.veltron.memo-popup";

// Controllers alive now: a popup's reply may come after its controller is gone.
std::set<MRecorderNotiMiniController *> &liveControllers()
{
	static std::set<MRecorderNotiMiniController *> live;
	return live;
}
} // namespace

MRecorderNotiMiniController::MRecorderNotiMiniController(recorder_h recorder)
    : _layout(nullptr), _win(nullptr), _rotation(0), _recorder(recorder), _popupRequest(nullptr),
      _xEventHandler(nullptr)
{
	gRecorderNotiMiniController = this;
	liveControllers().insert(this);
}

MRecorderNotiMiniController::~MRecorderNotiMiniController()
{
	liveControllers().erase(this);
	destroy();
}

void MRecorderNotiMiniController::create()
{
	_win = createNotiWindow(WINDOW_NAME, __windowEventCb, &_rotation);
	_layout = addLayout(_win, GROUP);
	__addCancelButton();
	__addTitle();
	__addStopButton();
	__addResumeButton();
	__addPauseButton();
	update();
	_registerXEvent();
}

void MRecorderNotiMiniController::hide()
{
	deleteWindow(&_win, &_layout);
	deleteHandler(&_xEventHandler);
}

void MRecorderNotiMiniController::destroy()
{
	deleteHandler(&_xEventHandler);
	if (_win)
		evas_object_del(_win);
	_win = nullptr;
	_layout = nullptr;
	if (_popupRequest) {
		int ret = app_control_send_terminate_request(_popupRequest);
		if (ret != APP_CONTROL_ERROR_NONE)
			MEMO_LOGE("app_control_send_terminate_request failed [%d]", ret);
		app_control_destroy(_popupRequest);
		_popupRequest = nullptr;
	}
}

void MRecorderNotiMiniController::update()
{
	recorder_state_e state = RECORDER_STATE_NONE;
	if (!_recorder || !_layout || recorder_get_state(_recorder, &state) != RECORDER_ERROR_NONE)
		return;
	const bool landscape = isLandscape(_rotation);
	if (state == RECORDER_STATE_PAUSED) {
		emit(_layout, landscape ? "recorder,pauseLandScape" : "recorder,pausePortrait");
		elm_object_part_text_set(_layout, "recorder_status_text", i18n_get_text("IDS_MEMO_BODY_PAUSED_M_STATUS"));
	} else if (state == RECORDER_STATE_RECORDING) {
		emit(_layout, landscape ? "recorder,resumeLandScape" : "recorder,resumePortrait");
		elm_object_part_text_set(_layout, "recorder_status_text", i18n_get_text("IDS_MEMO_BODY_RECORDING_ING_M_AUDIO"));
	}
}

void MRecorderNotiMiniController::setTime(const char *text)
{
	setTimeParts(_layout, "recorder_time", text, "recorder_time_hour");
}

void MRecorderNotiMiniController::setTimeHour(const char *text)
{
	setTimeParts(_layout, "recorder_time_hour", text, "recorder_time");
}

// ---- buttons ----

void MRecorderNotiMiniController::__addCancelButton()
{
	addButton(_layout, "recorder_cancel_btn", __cancelBtnCb, this);
}

void MRecorderNotiMiniController::__addTitle()
{
	if (!_layout) {
		MEMO_LOGE("getEvasObj() is nullptr");
		return;
	}
	elm_layout_signal_callback_add(_layout, "mouse,clicked,1", "mini_title", _titleButtonCliked, this);
}

void MRecorderNotiMiniController::__addStopButton()
{
	if (!_layout) {
		MEMO_LOGE("_layout is nullptr");
		return;
	}
	addPartMouseUp(_layout, "recorder_stop_btn", __stopBtnCb, this);
}

void MRecorderNotiMiniController::__addResumeButton()
{
	addButton(_layout, "recorder_resume_btn", __resumeBtnCb, this);
}

void MRecorderNotiMiniController::__addPauseButton()
{
	addButton(_layout, "recorder_pause_btn", __pauseBtnCb, this);
}

void MRecorderNotiMiniController::__cancelBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MRecorderNotiMiniController *>(data)->__cancel();
}

void MRecorderNotiMiniController::__stopBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MRecorderNotiMiniController *>(data)->_signal.emit("recorder,stopped", nullptr);
}

// The two toggles keep their crossed names: the owner takes either as "pause or resume".
void MRecorderNotiMiniController::__resumeBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MRecorderNotiMiniController *>(data)->_signal.emit("recorder,paused", nullptr);
}

void MRecorderNotiMiniController::__pauseBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MRecorderNotiMiniController *>(data)->_signal.emit("recorder,resumed", nullptr);
}

void MRecorderNotiMiniController::_titleButtonCliked(void *data, Evas_Object *, const char *, const char *)
{
	feedback_initialize();
	feedback_play(FEEDBACK_PATTERN_TAP);
	feedback_deinitialize();
	if (!data) {
		MEMO_LOGE("self is nullptr");
		return;
	}
	resumeApp();
}

// ---- cancel ----

void MRecorderNotiMiniController::__windowEventCb(minicontrol_viewer_event_e event, bundle *)
{
	if ((int)event != EVENT_REQUEST_HIDE)
		return;
	if (!gRecorderNotiMiniController) {
		MEMO_LOGE("self is nullptr");
		return;
	}
	gRecorderNotiMiniController->__cancel();
}

void MRecorderNotiMiniController::__cancel()
{
	evas_object_hide(_win);
	_requestCancelPopup();
}

void MRecorderNotiMiniController::_requestCancelPopup()
{
	app_control_h request = nullptr;
	int ret = app_control_create(&request);
	if (ret != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("app_control_create failed [%d]", ret);
		return;
	}
	ret = app_control_set_app_id(request, POPUP_APP_ID);
	if (ret != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("app_control_set_app_id failed [%d]", ret);
	else if ((ret = app_control_send_launch_request(request, __popupReplyCb, this)) != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("app_control_send_launch_request failed [%d]", ret);
	if (ret == APP_CONTROL_ERROR_NONE) {
		// A second cancel while one popup is up replaces the handle; the first reply still arrives.
		if (_popupRequest)
			app_control_destroy(_popupRequest);
		_popupRequest = request;
		return;
	}
	ret = app_control_destroy(request);
	if (ret != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("app_control_set_app_id failed [%d]", ret);
}

void MRecorderNotiMiniController::__popupReplyCb(app_control_h, app_control_h, app_control_result_e result,
                                                 void *user_data)
{
	if (!user_data) {
		MEMO_LOGE("user_data is nullptr");
		return;
	}
	MRecorderNotiMiniController *self = static_cast<MRecorderNotiMiniController *>(user_data);
	if (!liveControllers().count(self)) {
		MEMO_LOGI("the controller went before the popup answered");
		return;
	}
	if (self->_popupRequest)
		app_control_destroy(self->_popupRequest);
	self->_popupRequest = nullptr;
	if (result == APP_CONTROL_RESULT_SUCCEEDED) {
		self->_signal.emit("recorder,canceled", nullptr);
	} else if (result == APP_CONTROL_RESULT_FAILED) {
		if (!self->_win) {
			MEMO_LOGE("_win is NULL");
			return;
		}
		evas_object_show(self->_win);
	}
}

// ---- rotation ----

void MRecorderNotiMiniController::_registerXEvent()
{
	if (!_xEventHandler)
		_xEventHandler = ecore_event_handler_add(ECORE_X_EVENT_CLIENT_MESSAGE, _clientMessageCb, this);
}

Eina_Bool MRecorderNotiMiniController::_clientMessageCb(void *data, int, void *event)
{
	MRecorderNotiMiniController *self = static_cast<MRecorderNotiMiniController *>(data);
	if (!self) {
		MEMO_LOGE("self is nullptr");
		return EINA_FALSE;
	}
	if (rotateNotiWindow(self->_win, &self->_rotation, event))
		self->update();
	return EINA_TRUE;
}
