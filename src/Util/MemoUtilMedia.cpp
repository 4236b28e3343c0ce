// Sound-related device state: tap feedback and the recorders' activity.
#include "Util/MemoUtil.h"

#include <feedback.h>

void MemoUtil::playTapFeedback()
{
	feedback_initialize();
	feedback_play(FEEDBACK_PATTERN_TAP);
	feedback_deinitialize();
}
