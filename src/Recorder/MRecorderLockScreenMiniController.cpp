#include "Recorder/MRecorderLockScreenMiniController.h"

#include <Elementary.h>

#include "MemoLog.h"
#include "MiniControllerSupport.h"

using namespace mini_controller;

namespace
{
const char *const WINDOW_NAME = "memo-minicontrol.LOCKSCREEN";
const char *const GROUP = "mini_lockscreen_controller";
} // namespace

MRecorderLockScreenMiniController::MRecorderLockScreenMiniController(recorder_h recorder)
    : _layout(nullptr), _win(nullptr), _recorder(recorder)
{
}

MRecorderLockScreenMiniController::~MRecorderLockScreenMiniController()
{
	hide();
}

void MRecorderLockScreenMiniController::create()
{
	_win = createLockWindow(WINDOW_NAME);
	_layout = addLayout(_win, GROUP);
	if (!_layout)
		MEMO_LOGE("_layout is nullptr");
	else
		addPartMouseUp(_layout, "recorder_left_btn_bg", __stopBtnCb, this);
	for (const char *part : {"recorder_resume_btn", "recorder_pause_btn"})
		addButton(_layout, part, __toggleBtnCb, this);
	update();
}

void MRecorderLockScreenMiniController::hide()
{
	deleteWindow(&_win, &_layout);
}

void MRecorderLockScreenMiniController::update()
{
	recorder_state_e state = RECORDER_STATE_NONE;
	if (!_recorder || !_layout)
		return;
	recorder_get_state(_recorder, &state);
	if (state == RECORDER_STATE_PAUSED) {
		emit(_layout, "recorder,paused");
		elm_object_domain_translatable_part_text_set(_layout, "recorder_status_text", "memo",
		                                             "IDS_MEMO_BODY_PAUSED_M_STATUS");
	} else if (state == RECORDER_STATE_RECORDING) {
		emit(_layout, "recorder,resumed");
		elm_object_domain_translatable_part_text_set(_layout, "recorder_status_text", "memo",
		                                             "IDS_MEMO_BODY_RECORDING_ING_M_AUDIO");
	} else {
		MEMO_LOGE("Recorder is not in play or pause state");
	}
}

void MRecorderLockScreenMiniController::setTime(const char *text)
{
	setTimeParts(_layout, "recorder_time", text, nullptr);
}

void MRecorderLockScreenMiniController::__stopBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MRecorderLockScreenMiniController *>(data)->_signal.emit("recorder,stopped", nullptr);
}

// Pause and resume alike: the owner reads the true state from the recorder.
void MRecorderLockScreenMiniController::__toggleBtnCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<MRecorderLockScreenMiniController *>(data)->_signal.emit("recorder,paused", nullptr);
}
