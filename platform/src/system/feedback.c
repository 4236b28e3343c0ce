/* Touch feedback: the desktop has no vibrator and no touch sounds; calls are checked and logged. */
#include <feedback.h>

#include <dlog.h>

static int __initCount;

static bool __validPattern(feedback_pattern_e pattern)
{
	return pattern > FEEDBACK_PATTERN_NONE && pattern < FEEDBACK_PATTERN_END;
}

int feedback_initialize(void)
{
	__initCount++;
	return FEEDBACK_ERROR_NONE;
}

int feedback_deinitialize(void)
{
	if (__initCount == 0)
		return FEEDBACK_ERROR_NOT_INITIALIZED;
	__initCount--;
	return FEEDBACK_ERROR_NONE;
}

int feedback_play(feedback_pattern_e pattern)
{
	if (__initCount == 0) {
		LOGE("not initialized");
		return FEEDBACK_ERROR_NOT_INITIALIZED;
	}
	if (!__validPattern(pattern)) {
		LOGE("invalid pattern %d", (int)pattern);
		return FEEDBACK_ERROR_INVALID_PARAMETER;
	}
	LOGD("pattern %d (no feedback device)", (int)pattern);
	return FEEDBACK_ERROR_NONE;
}

int feedback_play_type(feedback_type_e type, feedback_pattern_e pattern)
{
	if (__initCount == 0) {
		LOGE("not initialized");
		return FEEDBACK_ERROR_NOT_INITIALIZED;
	}
	if (type <= FEEDBACK_TYPE_NONE || type >= FEEDBACK_TYPE_END || !__validPattern(pattern)) {
		LOGE("invalid type %d or pattern %d", (int)type, (int)pattern);
		return FEEDBACK_ERROR_INVALID_PARAMETER;
	}
	LOGD("type %d pattern %d (no feedback device)", (int)type, (int)pattern);
	return FEEDBACK_ERROR_NONE;
}

int feedback_stop(void)
{
	return __initCount == 0 ? FEEDBACK_ERROR_NOT_INITIALIZED : FEEDBACK_ERROR_NONE;
}

int feedback_is_supported_pattern(feedback_type_e type, feedback_pattern_e pattern, bool *status)
{
	if (__initCount == 0)
		return FEEDBACK_ERROR_NOT_INITIALIZED;
	if (!status || type <= FEEDBACK_TYPE_NONE || type >= FEEDBACK_TYPE_END || !__validPattern(pattern))
		return FEEDBACK_ERROR_INVALID_PARAMETER;
	*status = false;
	return FEEDBACK_ERROR_NONE;
}
