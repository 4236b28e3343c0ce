#ifndef __TIZEN_MEDIA_PLAYER_H__
#define __TIZEN_MEDIA_PLAYER_H__

/* The media player, for sound files. Every callback runs on the main loop.
   States: IDLE -prepare-> READY -start-> PLAYING <-pause/start-> PAUSED; stop goes back to READY (at
   the start of the file), unprepare to IDLE. At the end of the file the completed callback fires and
   the state stays PLAYING until the owner stops. A call pauses playback (interrupted, BY_CALL) and its
   end is reported as PLAYER_INTERRUPTED_COMPLETED; so is nothing else. */
#include <tizen.h>
#include <sound_manager.h>

#ifdef __cplusplus
extern "C" {
#endif

#define PLAYER_ERROR_CLASS TIZEN_ERROR_PLAYER | 0x20

typedef struct player_s *player_h;

typedef enum {
	PLAYER_STATE_NONE,
	PLAYER_STATE_IDLE,
	PLAYER_STATE_READY,
	PLAYER_STATE_PLAYING,
	PLAYER_STATE_PAUSED,
} player_state_e;

typedef enum {
	PLAYER_ERROR_NONE = TIZEN_ERROR_NONE,
	PLAYER_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	PLAYER_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	PLAYER_ERROR_NO_SUCH_FILE = TIZEN_ERROR_NO_SUCH_FILE,
	PLAYER_ERROR_INVALID_OPERATION = TIZEN_ERROR_INVALID_OPERATION,
	PLAYER_ERROR_FILE_NO_SPACE_ON_DEVICE = TIZEN_ERROR_FILE_NO_SPACE_ON_DEVICE,
	PLAYER_ERROR_FEATURE_NOT_SUPPORTED_ON_DEVICE = TIZEN_ERROR_NOT_SUPPORTED,
	PLAYER_ERROR_SEEK_FAILED = PLAYER_ERROR_CLASS | 0x01,
	PLAYER_ERROR_INVALID_STATE = PLAYER_ERROR_CLASS | 0x02,
	PLAYER_ERROR_NOT_SUPPORTED_FILE = PLAYER_ERROR_CLASS | 0x03,
	PLAYER_ERROR_INVALID_URI = PLAYER_ERROR_CLASS | 0x04,
	PLAYER_ERROR_SOUND_POLICY = PLAYER_ERROR_CLASS | 0x05,
	PLAYER_ERROR_CONNECTION_FAILED = PLAYER_ERROR_CLASS | 0x06,
	PLAYER_ERROR_VIDEO_CAPTURE_FAILED = PLAYER_ERROR_CLASS | 0x07,
	PLAYER_ERROR_DRM_EXPIRED = PLAYER_ERROR_CLASS | 0x08,
	PLAYER_ERROR_DRM_NO_LICENSE = PLAYER_ERROR_CLASS | 0x09,
	PLAYER_ERROR_DRM_FUTURE_USE = PLAYER_ERROR_CLASS | 0x0a,
	PLAYER_ERROR_DRM_NOT_PERMITTED = PLAYER_ERROR_CLASS | 0x0b,
	PLAYER_ERROR_RESOURCE_LIMIT = PLAYER_ERROR_CLASS | 0x0c,
	PLAYER_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
} player_error_e;

typedef enum {
	PLAYER_INTERRUPTED_COMPLETED = 0,
	PLAYER_INTERRUPTED_BY_MEDIA,
	PLAYER_INTERRUPTED_BY_CALL,
	PLAYER_INTERRUPTED_BY_EARJACK_UNPLUG,
	PLAYER_INTERRUPTED_BY_RESOURCE_CONFLICT,
	PLAYER_INTERRUPTED_BY_ALARM,
	PLAYER_INTERRUPTED_BY_EMERGENCY,
	PLAYER_INTERRUPTED_BY_NOTIFICATION,
} player_interrupted_code_e;

typedef void (*player_completed_cb)(void *user_data);
typedef void (*player_seek_completed_cb)(void *user_data);
typedef void (*player_interrupted_cb)(player_interrupted_code_e code, void *user_data);

int player_create(player_h *player);
int player_destroy(player_h player);
/* A local path or a URI; only in IDLE. */
int player_set_uri(player_h player, const char *uri);
/* Opens the file and waits until it can play: PLAYER_ERROR_NO_SUCH_FILE, _NOT_SUPPORTED_FILE ... */
int player_prepare(player_h player);
int player_unprepare(player_h player);
int player_start(player_h player);
int player_pause(player_h player);
int player_stop(player_h player);
int player_get_state(player_h player, player_state_e *state);
int player_set_sound_type(player_h player, sound_type_e type);
/* Milliseconds, from READY on. */
int player_get_duration(player_h player, int *duration);
int player_get_play_position(player_h player, int *millisecond);
/* accurate: to the millisecond rather than the nearest key point; callback (may be NULL) when the
   new position is reached. */
int player_set_play_position(player_h player, int millisecond, bool accurate, player_seek_completed_cb callback,
                             void *user_data);
int player_set_completed_cb(player_h player, player_completed_cb callback, void *user_data);
int player_unset_completed_cb(player_h player);
int player_set_interrupted_cb(player_h player, player_interrupted_cb callback, void *user_data);
int player_unset_interrupted_cb(player_h player);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_MEDIA_PLAYER_H__ */
