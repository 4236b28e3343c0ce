#include "Recorder/MRecorderLockScreenMiniController.h"

#include <Elementary.h>
#include <minicontrol-provider.h>

#include "MemoLog.h"
#include "MiniControllerSupport.h"
#include "Util/MemoUtil.h"

using namespace mini_controller;

namespace
{
const char *const WINDOW_NAME = "memo-minicontrol.LOCKSCREEN";
const char *const GROUP = "mini_lockscreen_controller";

// The lock screen sends nothing that this controller acts on.
void windowEventCb(minicontrol_viewer_event_e, bundle *) {}
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
	_win = minicontrol_create_window(WINDOW_NAME, MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN, windowEventCb);
	elm_win_alpha_set(_win, EINA_TRUE);
	evas_object_resize(_win, lockWidth(_win), scaled(LOCK_HEIGHT));
	evas_object_show(_win);

	_layout = elm_layout_add(_win);
	elm_layout_file_set(_layout, MemoUtil::getEdjePath(), GROUP);
	evas_object_size_hint_weight_set(_layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_show(_layout);
	elm_win_resize_object_add(_win, _layout);

	if (!_layout)
		MEMO_LOGE("_layout is nullptr");
	else
		addPartMouseUp(_layout, "recorder_left_btn_bg", __stopBtnCb, this);
	for (const char *part : {"recorder_resume_btn", "recorder_pause_btn"}) {
		if (!_layout)
			MEMO_LOGE("getEvasObj() is nullptr");
		else
			addPartMouseUp(_layout, part, __toggleBtnCb, this);
	}
	update();
}

void MRecorderLockScreenMiniController::hide()
{
	if (_win) {
		evas_object_hide(_win);
		evas_object_del(_win);
	}
	_win = nullptr;
	_layout = nullptr;
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
