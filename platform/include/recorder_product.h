#ifndef __TIZEN_MULTIMEDIA_RECORDER_PRODUCT_H__
#define __TIZEN_MULTIMEDIA_RECORDER_PRODUCT_H__

/* Recorder calls of the phone product, beyond the public API. */
#include <recorder.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Sound processing for the kind of recording; the desktop keeps the value only. */
typedef enum {
	RECORDER_AUDIO_TUNING_NONE = 0,
	RECORDER_AUDIO_TUNING_NORMAL,
	RECORDER_AUDIO_TUNING_CONVERSATION,
	RECORDER_AUDIO_TUNING_VOICE_MEMO,
} recorder_audio_tuning_e;

int recorder_attr_set_audio_tuning(recorder_h recorder, recorder_audio_tuning_e tuning);

/* Whether a recorder of the type (0 audio, 1 video) is recording or paused in this process. */
int recorder_is_in_recording(int type, bool *is_recording);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_MULTIMEDIA_RECORDER_PRODUCT_H__ */
