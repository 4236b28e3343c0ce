// Sound-related device state: tap feedback and the recorders' activity.
#include "Util/MemoUtil.h"

#include <feedback.h>

#if __has_include(<recorder.h>)
#include <recorder.h>
#endif

void MemoUtil::playTapFeedback()
{
	feedback_initialize();
	feedback_play(FEEDBACK_PATTERN_TAP);
	feedback_deinitialize();
}

bool MemoUtil::isRecorderBusy()
{
#ifdef RECORDER_IS_IN_RECORDING_AVAILABLE
	// Audio recorders first, then video ones.
	bool value = false;
	recorder_is_in_recording(0, &value);
	if (!value)
		recorder_is_in_recording(1, &value);
	return value;
#else
	// A platform without the query has no other recorder to ask about.
	return false;
#endif
}
