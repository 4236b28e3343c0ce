// The time text, the indicator message and the media keys of the voice panels.
#include "Recorder/MemoVoicePanel.h"

#include <cstdio>

#include <Ecore.h>
#include <bundle.h>
#include <message_port.h>

#include "MemoLog.h"

static const char *const INDICATOR_APP = "com.veltron.indicator";
static const char *const INDICATOR_PORT = "voicerecorder_indicator_port";
static const char *const INDICATOR_KEY = "voicerecorder_indicator_data";

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
