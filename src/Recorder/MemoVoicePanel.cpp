// The time text, the indicator message and the media keys of the voice panels.
#include "Recorder/MemoVoicePanel.h"

#include <cstdio>

#include <Ecore.h>
#include <WPopupController.h>
#include <WUiTimer.h>
#include <bundle.h>
#include <message_port.h>

#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Model/MemoPopupMonitor.h"
#include "Util/MemoUtil.h"

static const char *const INDICATOR_APP = "com.veltron.indicator";
static const char *const INDICATOR_PORT = "voicerecorder_indicator_port";
static const char *const INDICATOR_KEY = "voicerecorder_indicator_data";
// A tap is seen before what it starts.
static const double TAP_DELAY = 0.1;

namespace
{
struct Reservation {
	media_key_event_cb callback;
	void *data;
};

void releaseCb(void *)
{
	int ret = media_key_release();
	if (ret != MEDIA_KEY_ERROR_NONE)
		MEMO_LOGE("media_key_release failed [%d]", ret);
}

void reserveCb(void *data)
{
	Reservation *reservation = static_cast<Reservation *>(data);
	int ret = media_key_reserve(reservation->callback, reservation->data);
	if (ret != MEDIA_KEY_ERROR_NONE)
		MEMO_LOGE("media_key_reserve failed [%d]", ret);
	delete reservation;
}
} // namespace

Evas_Object *memoVoiceAddPanelLayout(Evas_Object *parent, const char *group)
{
	elm_object_signal_emit(parent, "recorder,start", "elm");
	Evas_Object *layout = elm_layout_add(parent);
	elm_object_part_content_set(parent, "recorder_contents", layout);
	if (!elm_layout_file_set(layout, MemoUtil::getEdjePath(), group))
		MEMO_LOGE("group %s not found", group);
	evas_object_show(layout);
	return layout;
}

void memoVoiceAfterTap(Evas_Object *owner, std::function<void()> action)
{
	app_assist::WUiTimer::addTimer(
	    TAP_DELAY,
	    [action](void *) {
		    action();
		    return false;
	    },
	    nullptr, owner);
}

app_assist::WPopupController *memoVoiceConfirmPopupN(const char *title, const char *content, const char *confirm,
                                                     std::function<void()> action)
{
	app_assist::WPopupController *popup = new app_assist::WPopupController();
	popup->setTextTranslatable("memo-sub");
	popup->setTitle(title);
	popup->setContent(content);
	popup->addButton("IDS_MEMO_BUTTON_CANCEL", std::function<void(bool *)>());
	popup->addButton(confirm, [action](bool *close) {
		action();
		*close = true;
	});
	MemoPopupMonitor::getInstance()->addPopup(popup);
	return popup;
}

bool memoVoiceInCall(cm_client_h callManager)
{
	cm_call_status_e status = CM_CALL_STATUS_IDLE;
	return callManager && cm_get_call_status(callManager, &status) == CM_ERROR_NONE && status != CM_CALL_STATUS_IDLE;
}

void memoVoiceEndCalls(cm_client_h *callManager)
{
	if (*callManager)
		cm_deinit(*callManager);
	*callManager = nullptr;
}

void memoVoiceAddBroadcastListener(unsigned int *id, std::function<void(const char *)> onKey, Evas_Object *owner)
{
	if (*id == 0)
		*id = MemoBroadCaster::getInstance().addListener([onKey](const char *key, void *) { onKey(key); }, owner);
}

void memoVoiceRemoveBroadcastListener(unsigned int *id)
{
	if (*id)
		MemoBroadCaster::getInstance().removeListener(*id);
	*id = 0;
}

bool memoVoiceMediaKeyToggled(media_key_e key, bool *pressed)
{
	if (key != MEDIA_KEY_MEDIA)
		return false;
	*pressed = !*pressed;
	return !*pressed;
}

void memoVoiceFormatTime(long long ms, char *buffer, size_t size)
{
	const int minutes = static_cast<int>(ms / 60000);
	const int seconds = static_cast<int>(ms / 1000 % 60);
	if (minutes < 60)
		snprintf(buffer, size, "%02d:%02d", minutes, seconds);
	else
		snprintf(buffer, size, "%02d:%02d:%02d", minutes / 60, minutes % 60, seconds);
}

bool memoVoiceSendIndicator(const char *value)
{
	bundle *message = bundle_create();
	if (!message) {
		MEMO_LOGE("bundle_create failed!!!");
		return false;
	}
	int ret = bundle_add_str(message, INDICATOR_KEY, value);
	if (ret != BUNDLE_ERROR_NONE)
		MEMO_LOGE("bundle_add_str failed : [%d]!!!", ret);
	bool exists = false;
	if (message_port_check_remote_port(INDICATOR_APP, INDICATOR_PORT, &exists) == MESSAGE_PORT_ERROR_NONE) {
		ret = message_port_send_message(INDICATOR_APP, INDICATOR_PORT, message);
		if (ret != MESSAGE_PORT_ERROR_NONE && ret != MESSAGE_PORT_ERROR_PORT_NOT_FOUND)
			MEMO_LOGE("messageport_send_message failed : [%d]!!!", ret);
	}
	ret = bundle_free(message);
	if (ret != BUNDLE_ERROR_NONE) {
		MEMO_LOGE("bundle_free failed : [%d]!!!", ret);
		return false;
	}
	return true;
}

void memoVoiceMediaKeyReserveAsync(media_key_event_cb callback, void *data)
{
	ecore_main_loop_thread_safe_call_async(releaseCb, nullptr);
	ecore_main_loop_thread_safe_call_async(reserveCb, new Reservation{callback, data});
}

void memoVoiceMediaKeyReleaseAsync()
{
	ecore_main_loop_thread_safe_call_async(releaseCb, nullptr);
}
