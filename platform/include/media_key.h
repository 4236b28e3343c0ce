#ifndef __TIZEN_SYSTEM_MEDIA_KEY_H__
#define __TIZEN_SYSTEM_MEDIA_KEY_H__

/* The keyboard's media keys (XF86AudioPlay, Pause, Stop, Next, Prev, Forward, Rewind, PlayPause,
   Media), taken in every window of the app while reserved. */
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	MEDIA_KEY_ERROR_NONE = TIZEN_ERROR_NONE,
	MEDIA_KEY_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	MEDIA_KEY_ERROR_OPERATION_FAILED = TIZEN_ERROR_MEDIA_KEY | 0x01,
} media_key_error_e;

typedef enum {
	MEDIA_KEY_PLAY,
	MEDIA_KEY_STOP,
	MEDIA_KEY_PAUSE,
	MEDIA_KEY_PREVIOUS,
	MEDIA_KEY_NEXT,
	MEDIA_KEY_FASTFORWARD,
	MEDIA_KEY_REWIND,
	MEDIA_KEY_PLAYPAUSE,
	MEDIA_KEY_MEDIA,
	MEDIA_KEY_UNKNOWN,
} media_key_e;

typedef enum {
	MEDIA_KEY_STATUS_PRESSED,
	MEDIA_KEY_STATUS_RELEASED,
	MEDIA_KEY_STATUS_UNKNOWN,
} media_key_event_e;

typedef void (*media_key_event_cb)(media_key_e key, media_key_event_e status, void *user_data);

/* Takes the keys for this callback (replacing an earlier reservation). MEDIA_KEY_ERROR_OPERATION_FAILED
   when the app has no window. */
int media_key_reserve(media_key_event_cb callback, void *user_data);
int media_key_release(void);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_SYSTEM_MEDIA_KEY_H__ */
