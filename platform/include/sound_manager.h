#ifndef __TIZEN_MEDIA_SOUND_MANAGER_H__
#define __TIZEN_MEDIA_SOUND_MANAGER_H__

/* Sound types and the media session of the app. The desktop has one mixer for everything: the
   session calls keep what they are given and change nothing else. */
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

#define SOUND_MANAGER_ERROR_CLASS TIZEN_ERROR_SOUND_MANAGER

typedef enum {
	SOUND_MANAGER_ERROR_NONE = TIZEN_ERROR_NONE,
	SOUND_MANAGER_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	SOUND_MANAGER_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	SOUND_MANAGER_ERROR_INVALID_OPERATION = TIZEN_ERROR_INVALID_OPERATION,
	SOUND_MANAGER_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
	SOUND_MANAGER_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
	SOUND_MANAGER_ERROR_NO_DATA = TIZEN_ERROR_NO_DATA,
	SOUND_MANAGER_ERROR_INTERNAL = SOUND_MANAGER_ERROR_CLASS | 01,
	SOUND_MANAGER_ERROR_POLICY = SOUND_MANAGER_ERROR_CLASS | 02,
	SOUND_MANAGER_ERROR_NO_PLAYING_SOUND = SOUND_MANAGER_ERROR_CLASS | 03,
} sound_manager_error_e;

typedef enum {
	SOUND_TYPE_SYSTEM,
	SOUND_TYPE_NOTIFICATION,
	SOUND_TYPE_ALARM,
	SOUND_TYPE_RINGTONE,
	SOUND_TYPE_MEDIA,
	SOUND_TYPE_CALL,
	SOUND_TYPE_VOIP,
	SOUND_TYPE_VOICE,
} sound_type_e;

typedef enum {
	SOUND_SESSION_TYPE_MEDIA = 0,
	SOUND_SESSION_TYPE_ALARM,
	SOUND_SESSION_TYPE_NOTIFICATION,
	SOUND_SESSION_TYPE_EMERGENCY,
	SOUND_SESSION_TYPE_VOIP,
} sound_session_type_e;

typedef enum {
	SOUND_SESSION_OPTION_MIX_WITH_OTHERS_WHEN_START = 0,
	SOUND_SESSION_OPTION_PAUSE_OTHERS_WHEN_START,
} sound_session_option_for_starting_e;

typedef enum {
	SOUND_SESSION_OPTION_INTERRUPTIBLE_DURING_PLAY = 0,
	SOUND_SESSION_OPTION_UNINTERRUPTIBLE_DURING_PLAY,
} sound_session_option_for_during_play_e;

int sound_manager_set_session_type(sound_session_type_e type);
int sound_manager_get_session_type(sound_session_type_e *type);
/* Only for the media session. */
int sound_manager_set_media_session_option(sound_session_option_for_starting_e s_option,
                                           sound_session_option_for_during_play_e d_option);
int sound_manager_get_media_session_option(sound_session_option_for_starting_e *s_option,
                                           sound_session_option_for_during_play_e *d_option);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_MEDIA_SOUND_MANAGER_H__ */
