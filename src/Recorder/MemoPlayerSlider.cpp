// The player's slider: a tap on the bar seeks at once; a drag shows the position it would take and seeks when
// let go.
#include "Recorder/MemoPlayer.h"

#include <cstring>

#include "MemoLog.h"
#include "Recorder/MemoVoicePanel.h"

static const int SLIDER_DRAGGING = 2;
static const int SLIDER_RELEASED = 3;

void MemoPlayer::__sliderDragStartCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	self->__sliderState = SLIDER_DRAGGING;
	self->__signal.emit("player,dragStart", nullptr);
	self->__lastDragPosition = 0;
}

void MemoPlayer::__sliderChangedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	if (self->__sliderState != SLIDER_DRAGGING)
		self->__playerProgressbarChanged(self->__player, obj);
	int duration = 0;
	player_get_duration(self->__player, &duration);
	const double position = elm_slider_value_get(obj) * duration;
	char shown[1024] = {0};
	char last[1024] = {0};
	memoVoiceFormatTime(static_cast<long long>(position), shown, sizeof(shown));
	memoVoiceFormatTime(static_cast<long long>(self->__lastDragPosition), last, sizeof(last));
	// The label changes only with the second it shows.
	if (strcmp(shown, last))
		elm_object_part_text_set(self->getEvasObj(), "recorder_sliderTime", shown);
	self->__lastDragPosition = position;
}

void MemoPlayer::__sliderDragStopCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoPlayer *self = static_cast<MemoPlayer *>(data);
	const player_state_e state = self->__getState();
	self->__sliderState = SLIDER_RELEASED;
	// Reading a memo that is not playing, the slider goes back rather than seek.
	if (state == PLAYER_STATE_READY && self->__viewMode == 1) {
		__playerResetJob(self);
		return;
	}
	self->__playerProgressbarChanged(self->__player, obj);
	self->__signal.emit("player,dragStop", nullptr);
}

void MemoPlayer::__playerProgressbarChanged(player_h player, Evas_Object *slider)
{
	int duration = 0;
	player_get_duration(player, &duration);
	const int position = static_cast<int>(elm_slider_value_get(slider) * duration);
	int ret = player_set_play_position(player, position, true, nullptr, nullptr);
	if (ret != PLAYER_ERROR_NONE)
		MEMO_LOGE("player_set_play_position is error error code :%d", ret);
}
