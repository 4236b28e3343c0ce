// Sound-related device state: tap feedback and the recorders' activity.
#include "Util/MemoUtil.h"

#include <feedback.h>

#include <recorder_product.h>

void MemoUtil::playTapFeedback()
{
	feedback_initialize();
	feedback_play(FEEDBACK_PATTERN_TAP);
	feedback_deinitialize();
}

bool MemoUtil::isRecorderBusy()
{
	// Audio recorders first, then video ones.
	bool value = false;
	recorder_is_in_recording(0, &value);
	if (!value)
		recorder_is_in_recording(1, &value);
	return value;
}
