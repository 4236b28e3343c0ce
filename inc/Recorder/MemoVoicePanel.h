#ifndef INC_RECORDER_MEMOVOICEPANEL_H
#define INC_RECORDER_MEMOVOICEPANEL_H

#include <cstddef>

#include <media_key.h>

// What the recorder and the player share: the time text, the one indicator channel and the media keys.

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

#endif
