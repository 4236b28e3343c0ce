#ifndef __TIZEN_SYSTEM_FEEDBACK_H__
#define __TIZEN_SYSTEM_FEEDBACK_H__

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	FEEDBACK_ERROR_NONE = TIZEN_ERROR_NONE,
	FEEDBACK_ERROR_OPERATION_FAILED = TIZEN_ERROR_NOT_PERMITTED,
	FEEDBACK_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	FEEDBACK_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
	FEEDBACK_ERROR_NOT_INITIALIZED = TIZEN_ERROR_SYSTEM_CLASS | 0x52,
} feedback_error_e;

typedef enum {
	FEEDBACK_TYPE_NONE = 0,
	FEEDBACK_TYPE_SOUND,
	FEEDBACK_TYPE_VIBRATION,
	FEEDBACK_TYPE_END,
} feedback_type_e;

typedef enum {
	FEEDBACK_PATTERN_NONE = -1,
	FEEDBACK_PATTERN_TAP = 0,
	FEEDBACK_PATTERN_SIP = 1,
	FEEDBACK_PATTERN_KEY0 = 6,
	FEEDBACK_PATTERN_KEY1,
	FEEDBACK_PATTERN_KEY2,
	FEEDBACK_PATTERN_KEY3,
	FEEDBACK_PATTERN_KEY4,
	FEEDBACK_PATTERN_KEY5,
	FEEDBACK_PATTERN_KEY6,
	FEEDBACK_PATTERN_KEY7,
	FEEDBACK_PATTERN_KEY8,
	FEEDBACK_PATTERN_KEY9,
	FEEDBACK_PATTERN_KEY_STAR,
	FEEDBACK_PATTERN_KEY_SHARP,
	FEEDBACK_PATTERN_KEY_BACK = 18,
	FEEDBACK_PATTERN_HOLD = 19,
	FEEDBACK_PATTERN_HW_TAP = 21,
	FEEDBACK_PATTERN_HW_HOLD = 22,
	FEEDBACK_PATTERN_MESSAGE = 23,
	FEEDBACK_PATTERN_EMAIL = 25,
	FEEDBACK_PATTERN_LIST_REORDER = 62,
	FEEDBACK_PATTERN_LIST_SLIDER = 63,
	FEEDBACK_PATTERN_VOLUME_KEY = 64,
	FEEDBACK_PATTERN_END = 74,
} feedback_pattern_e;

/* Touch sounds and vibration. The desktop has neither: calls are checked and logged, and do nothing.
   Calls other than initialize give FEEDBACK_ERROR_NOT_INITIALIZED before feedback_initialize (or after
   the matching feedback_deinitialize); a pattern out of range gives FEEDBACK_ERROR_INVALID_PARAMETER. */
int feedback_initialize(void);
int feedback_deinitialize(void);
int feedback_play(feedback_pattern_e pattern);
int feedback_play_type(feedback_type_e type, feedback_pattern_e pattern);
int feedback_stop(void);
int feedback_is_supported_pattern(feedback_type_e type, feedback_pattern_e pattern, bool *status);

#ifdef __cplusplus
}
#endif

#endif
