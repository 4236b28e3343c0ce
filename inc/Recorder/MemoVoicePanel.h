#ifndef INC_RECORDER_MEMOVOICEPANEL_H
#define INC_RECORDER_MEMOVOICEPANEL_H

#include <cstddef>
#include <functional>

#include <Elementary.h>
#include <call-manager.h>
#include <media_key.h>

namespace app_assist
{
class WPopupController;
}

// What the recorder and the player share: the panel's layout, the time text, the one indicator channel,
// the media keys, the tap delay, the confirm popup, calls and the mini controllers.

// From this many milliseconds on the time shows hours (and the notification controllers their hour part).
const long long MEMO_VOICE_HOUR_MS = 3600000;

// Announces the panel to the owner's layout ("recorder,start") and puts a shown layout of the theme's group
// in its "recorder_contents"; a missing group logs "group %s not found".
Evas_Object *memoVoiceAddPanelLayout(Evas_Object *parent, const char *group);

// Runs `action` once, 0.1 second after a tap, so that the tap is seen before what it starts; the timer goes
// with `owner`.
void memoVoiceAfterTap(Evas_Object *owner, std::function<void()> action);

// A translatable question with Cancel and a confirming button that runs `action` and closes; the popup
// monitor knows of it. The caller attaches it to its view.
app_assist::WPopupController *memoVoiceConfirmPopupN(const char *title, const char *content, const char *confirm,
                                                     std::function<void()> action);

// True while the call manager reports a call.
bool memoVoiceInCall(cm_client_h callManager);
// Lets go of the call manager when `*callManager` is set, and clears it.
void memoVoiceEndCalls(cm_client_h *callManager);

// Listens to the app's broadcasts for as long as `owner` lives, unless `*id` says it does already.
void memoVoiceAddBroadcastListener(unsigned int *id, std::function<void(const char *)> onKey, Evas_Object *owner);
// Stops listening to the app's broadcasts when `*id` is set, and clears it.
void memoVoiceRemoveBroadcastListener(unsigned int *id);

// "mm:ss" below one hour, "hh:mm:ss" from there on, of `ms` milliseconds (truncated) into `buffer`.
void memoVoiceFormatTime(long long ms, char *buffer, size_t size);

// Tells the indicator app ("com.veltron.indicator", port "voicerecorder_indicator_port") the state of the
// voice panel under the key "voicerecorder_indicator_data". Nobody listening is not a failure; other send
// failures are logged. False when the message could not be built or freed.
bool memoVoiceSendIndicator(const char *value);

// Takes the media keys for `callback` on the main loop, after letting go of any earlier reservation.
void memoVoiceMediaKeyReserveAsync(media_key_event_cb callback, void *data);
// Lets go of the media keys on the main loop.
void memoVoiceMediaKeyReleaseAsync();

// Press and release of the media key make one event pair: flips *pressed on that key and is true at the
// release.
bool memoVoiceMediaKeyToggled(media_key_e key, bool *pressed);

// Makes the mini controller of `Mini` over the handle, shows it and passes its events to `onEvent`.
template <typename Mini, typename Handle>
Mini *memoVoiceMiniCreateN(Handle handle, std::function<void(const char *)> onEvent)
{
	Mini *mini = new Mini(handle);
	mini->create();
	mini->_signal.addListener([onEvent](const char *event, const char *) { onEvent(event); });
	return mini;
}

// Hides and deletes *mini when set, and nulls it.
template <typename Mini> void memoVoiceMiniDelete(Mini **mini)
{
	if (!*mini)
		return;
	(*mini)->hide();
	delete *mini;
	*mini = nullptr;
}

// Shows the time on the controllers present: the notification one in its hour part from one hour on.
template <typename Noti, typename Lock>
void memoVoiceMiniSetTime(Noti *noti, Lock *lock, const char *text, long long ms)
{
	if (noti) {
		if (ms >= MEMO_VOICE_HOUR_MS)
			noti->setTimeHour(text);
		else
			noti->setTime(text);
	}
	if (lock)
		lock->setTime(text);
}

// Brings the controller, when present, up to the state of its handle.
template <typename Mini> void memoVoiceMiniUpdate(Mini *mini)
{
	if (mini)
		mini->update();
}

#endif
