/* The audio recorder: its states, settings and callbacks. The pipeline is recorder_pipeline.c. */
#define _GNU_SOURCE
#include <recorder.h>
#include <recorder_product.h>

#include <Ecore.h>
#include <dlog.h>
#include <stdlib.h>
#include <string.h>

#include "media/media_policy.h"
#include "media/recorder_pipeline.h"

#define STATUS_INTERVAL 0.1
#define MAX_STATE_EVENTS 8

typedef struct {
	recorder_state_e previous;
	recorder_state_e current;
	bool by_policy;
} state_event_s;

struct recorder_s {
	recorder_state_e state;
	char *filename;
	recorder_file_format_e format;
	recorder_audio_codec_e codec;
	int samplerate;
	int bitrate;
	int time_limit;
	int size_limit;
	recorder_audio_tuning_e tuning;
	recorder_pipeline_t *pipeline;
	Ecore_Timer *status_timer;
	bool limit_reported;
	/* State changes reach the owner after the call that made them, in order. */
	state_event_s events[MAX_STATE_EVENTS];
	int event_count;
	Ecore_Job *event_job;

	recorder_recording_status_cb status_cb;
	void *status_data;
	recorder_recording_limit_reached_cb limit_cb;
	void *limit_data;
	recorder_state_changed_cb state_cb;
	void *state_data;
	recorder_error_cb error_cb;
	void *error_data;
};

/* Recorders of this process that are recording or paused. */
static int __busy_count;

#define CHECK_HANDLE(r)                                                                                                \
	do {                                                                                                               \
		if (!(r)) {                                                                                                    \
			LOGE("invalid recorder handle");                                                                           \
			return RECORDER_ERROR_INVALID_PARAMETER;                                                                   \
		}                                                                                                              \
	} while (0)

static bool __active(recorder_state_e state)
{
	return state == RECORDER_STATE_RECORDING || state == RECORDER_STATE_PAUSED;
}

static int __invalid_state(recorder_h r, const char *what)
{
	LOGE("%s is not allowed in state %d", what, (int)r->state);
	return RECORDER_ERROR_INVALID_STATE;
}

static void __event_job_cb(void *data)
{
	recorder_h r = data;
	r->event_job = NULL;
	if (!r->event_count)
		return;
	state_event_s ev = r->events[0];
	memmove(r->events, r->events + 1, sizeof(r->events[0]) * (size_t)--r->event_count);
	if (r->event_count)
		r->event_job = ecore_job_add(__event_job_cb, r);
	/* Last: the owner may destroy the recorder here. */
	if (r->state_cb)
		r->state_cb(ev.previous, ev.current, ev.by_policy, r->state_data);
}

static void __state_set(recorder_h r, recorder_state_e state, bool by_policy)
{
	recorder_state_e previous = r->state;
	if (previous == state)
		return;
	r->state = state;
	__busy_count += __active(state) - __active(previous);
	if (r->event_count == MAX_STATE_EVENTS) {
		LOGE("state changes are not being taken; the oldest is dropped");
		memmove(r->events, r->events + 1, sizeof(r->events[0]) * (MAX_STATE_EVENTS - 1));
		r->event_count--;
	}
	r->events[r->event_count++] = (state_event_s){previous, state, by_policy};
	if (!r->event_job)
		r->event_job = ecore_job_add(__event_job_cb, r);
}

static void __status_report(recorder_h r)
{
	unsigned long long ms = 0, bytes = 0;
	recorder_pipeline_progress(r->pipeline, &ms, &bytes);
	if (r->status_cb)
		r->status_cb(ms, bytes / 1024, r->status_data);
}

static Eina_Bool __status_timer_cb(void *data)
{
	/* Nothing of the recorder is touched after the report: the owner may destroy it there. */
	__status_report(data);
	return ECORE_CALLBACK_RENEW;
}

static void __status_timer_set(recorder_h r, bool on)
{
	if (on && !r->status_timer)
		r->status_timer = ecore_timer_add(STATUS_INTERVAL, __status_timer_cb, r);
	if (!on && r->status_timer) {
		ecore_timer_del(r->status_timer);
		r->status_timer = NULL;
	}
}

static void __pipeline_event_cb(recorder_recording_limit_type_e limit, recorder_error_e error, void *data)
{
	recorder_h r = data;
	if (error != RECORDER_ERROR_NONE) {
		if (r->error_cb)
			r->error_cb(error, r->state, r->error_data);
		return;
	}
	if (r->limit_reported || !__active(r->state))
		return;
	r->limit_reported = true;
	LOGI("recording limit %d reached", (int)limit);
	/* The owner sees the final time before it is told to stop. */
	recorder_recording_limit_reached_cb cb = r->limit_cb;
	void *cb_data = r->limit_data;
	__status_report(r);
	if (cb)
		cb(limit, cb_data);
}

static void __finish(recorder_h r, bool keep)
{
	__status_timer_set(r, false);
	recorder_pipeline_finish(r->pipeline, keep);
}

/* A call takes the microphone: the take ends and is kept, as the owner's commit would keep it. */
static void __policy_cb(media_policy_event_e event, int value, void *data)
{
	recorder_h r = data;
	if (event != MEDIA_POLICY_CALL || !value || !__active(r->state))
		return;
	LOGI("a call ends the recording");
	__finish(r, true);
	__state_set(r, RECORDER_STATE_READY, true);
}

int recorder_create_audiorecorder(recorder_h *recorder)
{
	if (!recorder)
		return RECORDER_ERROR_INVALID_PARAMETER;
	recorder_h r = calloc(1, sizeof(*r));
	if (!r)
		return RECORDER_ERROR_OUT_OF_MEMORY;
	r->state = RECORDER_STATE_CREATED;
	r->format = RECORDER_FILE_FORMAT_AMR;
	r->codec = RECORDER_AUDIO_CODEC_AMR;
	r->samplerate = 8000;
	r->bitrate = 12200;
	if (!media_policy_listen(__policy_cb, r)) {
		free(r);
		return RECORDER_ERROR_INVALID_OPERATION;
	}
	*recorder = r;
	return RECORDER_ERROR_NONE;
}

int recorder_destroy(recorder_h recorder)
{
	CHECK_HANDLE(recorder);
	if (recorder->state != RECORDER_STATE_CREATED)
		return __invalid_state(recorder, "destroy");
	media_policy_unlisten(__policy_cb, recorder);
	if (recorder->event_job)
		ecore_job_del(recorder->event_job);
	free(recorder->filename);
	free(recorder);
	return RECORDER_ERROR_NONE;
}

int recorder_prepare(recorder_h recorder)
{
	CHECK_HANDLE(recorder);
	if (recorder->state != RECORDER_STATE_CREATED)
		return __invalid_state(recorder, "prepare");
	if (recorder->codec != RECORDER_AUDIO_CODEC_AMR || recorder->format != RECORDER_FILE_FORMAT_AMR) {
		LOGE("only AMR files are recorded here");
		return RECORDER_ERROR_NOT_SUPPORTED;
	}
	recorder_error_e rc = RECORDER_ERROR_NONE;
	recorder->pipeline = recorder_pipeline_new(recorder->bitrate, __pipeline_event_cb, recorder, &rc);
	if (!recorder->pipeline)
		return rc;
	__state_set(recorder, RECORDER_STATE_READY, false);
	return RECORDER_ERROR_NONE;
}

int recorder_unprepare(recorder_h recorder)
{
	CHECK_HANDLE(recorder);
	if (recorder->state != RECORDER_STATE_READY)
		return __invalid_state(recorder, "unprepare");
	recorder_pipeline_free(recorder->pipeline);
	recorder->pipeline = NULL;
	__state_set(recorder, RECORDER_STATE_CREATED, false);
	return RECORDER_ERROR_NONE;
}

int recorder_start(recorder_h recorder)
{
	CHECK_HANDLE(recorder);
	if (recorder->state != RECORDER_STATE_READY && recorder->state != RECORDER_STATE_PAUSED)
		return __invalid_state(recorder, "start");
	if (media_policy_in_call()) {
		LOGE("no recording during a call");
		return RECORDER_ERROR_SOUND_POLICY_BY_CALL;
	}
	recorder_error_e rc;
	if (recorder->state == RECORDER_STATE_PAUSED) {
		rc = recorder_pipeline_resume(recorder->pipeline);
	} else if (!recorder->filename) {
		LOGE("no file name set");
		rc = RECORDER_ERROR_INVALID_OPERATION;
	} else {
		recorder->limit_reported = false;
		rc =
		    recorder_pipeline_start(recorder->pipeline, recorder->filename, recorder->time_limit, recorder->size_limit);
	}
	if (rc != RECORDER_ERROR_NONE)
		return rc;
	__status_timer_set(recorder, true);
	__state_set(recorder, RECORDER_STATE_RECORDING, false);
	return RECORDER_ERROR_NONE;
}

int recorder_pause(recorder_h recorder)
{
	CHECK_HANDLE(recorder);
	if (recorder->state != RECORDER_STATE_RECORDING)
		return __invalid_state(recorder, "pause");
	recorder_error_e rc = recorder_pipeline_pause(recorder->pipeline);
	if (rc != RECORDER_ERROR_NONE)
		return rc;
	__status_timer_set(recorder, false);
	__state_set(recorder, RECORDER_STATE_PAUSED, false);
	return RECORDER_ERROR_NONE;
}

static int __end(recorder_h recorder, bool keep)
{
	CHECK_HANDLE(recorder);
	if (!__active(recorder->state))
		return __invalid_state(recorder, keep ? "commit" : "cancel");
	__finish(recorder, keep);
	__state_set(recorder, RECORDER_STATE_READY, false);
	return RECORDER_ERROR_NONE;
}

int recorder_commit(recorder_h recorder)
{
	return __end(recorder, true);
}

int recorder_cancel(recorder_h recorder)
{
	return __end(recorder, false);
}

int recorder_get_state(recorder_h recorder, recorder_state_e *state)
{
	CHECK_HANDLE(recorder);
	if (!state)
		return RECORDER_ERROR_INVALID_PARAMETER;
	*state = recorder->state;
	return RECORDER_ERROR_NONE;
}

/* Settings change only while nothing records. */
#define CHECK_SETTABLE(r)                                                                                              \
	do {                                                                                                               \
		CHECK_HANDLE(r);                                                                                               \
		if ((r)->state != RECORDER_STATE_CREATED && (r)->state != RECORDER_STATE_READY)                                \
			return __invalid_state((r), __func__);                                                                     \
	} while (0)

int recorder_set_filename(recorder_h recorder, const char *path)
{
	CHECK_SETTABLE(recorder);
	char *copy = path ? strdup(path) : NULL;
	if (!copy)
		return path ? RECORDER_ERROR_OUT_OF_MEMORY : RECORDER_ERROR_INVALID_PARAMETER;
	free(recorder->filename);
	recorder->filename = copy;
	return RECORDER_ERROR_NONE;
}

int recorder_get_filename(recorder_h recorder, char **path)
{
	CHECK_HANDLE(recorder);
	if (!path)
		return RECORDER_ERROR_INVALID_PARAMETER;
	*path = recorder->filename ? strdup(recorder->filename) : NULL;
	return *path || !recorder->filename ? RECORDER_ERROR_NONE : RECORDER_ERROR_OUT_OF_MEMORY;
}

int recorder_set_file_format(recorder_h recorder, recorder_file_format_e format)
{
	CHECK_SETTABLE(recorder);
	if (format < RECORDER_FILE_FORMAT_3GP || format > RECORDER_FILE_FORMAT_OGG)
		return RECORDER_ERROR_INVALID_PARAMETER;
	recorder->format = format;
	return RECORDER_ERROR_NONE;
}

int recorder_set_audio_encoder(recorder_h recorder, recorder_audio_codec_e codec)
{
	CHECK_SETTABLE(recorder);
	if (codec < RECORDER_AUDIO_CODEC_DISABLE || codec > RECORDER_AUDIO_CODEC_PCM)
		return RECORDER_ERROR_INVALID_PARAMETER;
	recorder->codec = codec;
	return RECORDER_ERROR_NONE;
}

int recorder_attr_set_audio_samplerate(recorder_h recorder, int samplerate)
{
	CHECK_SETTABLE(recorder);
	if (samplerate <= 0)
		return RECORDER_ERROR_INVALID_PARAMETER;
	/* Kept for the record: AMR-NB is 8000 Hz whatever is asked. */
	recorder->samplerate = samplerate;
	return RECORDER_ERROR_NONE;
}

int recorder_attr_set_audio_encoder_bitrate(recorder_h recorder, int bitrate)
{
	CHECK_SETTABLE(recorder);
	if (bitrate <= 0)
		return RECORDER_ERROR_INVALID_PARAMETER;
	recorder->bitrate = bitrate;
	return RECORDER_ERROR_NONE;
}

int recorder_attr_set_time_limit(recorder_h recorder, int second)
{
	CHECK_SETTABLE(recorder);
	if (second < 0)
		return RECORDER_ERROR_INVALID_PARAMETER;
	recorder->time_limit = second;
	return RECORDER_ERROR_NONE;
}

int recorder_attr_set_size_limit(recorder_h recorder, int kbyte)
{
	CHECK_SETTABLE(recorder);
	if (kbyte < 0)
		return RECORDER_ERROR_INVALID_PARAMETER;
	recorder->size_limit = kbyte;
	return RECORDER_ERROR_NONE;
}

int recorder_attr_set_audio_tuning(recorder_h recorder, recorder_audio_tuning_e tuning)
{
	CHECK_SETTABLE(recorder);
	recorder->tuning = tuning;
	return RECORDER_ERROR_NONE;
}

int recorder_is_in_recording(int type, bool *is_recording)
{
	if (!is_recording)
		return RECORDER_ERROR_INVALID_PARAMETER;
	/* Every recorder here is an audio recorder. */
	*is_recording = type == 0 && __busy_count > 0;
	return RECORDER_ERROR_NONE;
}

#define SET_CB(r, field, cb, data)                                                                                     \
	do {                                                                                                               \
		CHECK_HANDLE(r);                                                                                               \
		if (!(cb))                                                                                                     \
			return RECORDER_ERROR_INVALID_PARAMETER;                                                                   \
		(r)->field##_cb = (cb);                                                                                        \
		(r)->field##_data = (data);                                                                                    \
		return RECORDER_ERROR_NONE;                                                                                    \
	} while (0)

#define UNSET_CB(r, field)                                                                                             \
	do {                                                                                                               \
		CHECK_HANDLE(r);                                                                                               \
		(r)->field##_cb = NULL;                                                                                        \
		(r)->field##_data = NULL;                                                                                      \
		return RECORDER_ERROR_NONE;                                                                                    \
	} while (0)

int recorder_set_recording_status_cb(recorder_h recorder, recorder_recording_status_cb callback, void *user_data)
{
	SET_CB(recorder, status, callback, user_data);
}

int recorder_unset_recording_status_cb(recorder_h recorder)
{
	UNSET_CB(recorder, status);
}

int recorder_set_recording_limit_reached_cb(recorder_h recorder, recorder_recording_limit_reached_cb callback,
                                            void *user_data)
{
	SET_CB(recorder, limit, callback, user_data);
}

int recorder_unset_recording_limit_reached_cb(recorder_h recorder)
{
	UNSET_CB(recorder, limit);
}

int recorder_set_state_changed_cb(recorder_h recorder, recorder_state_changed_cb callback, void *user_data)
{
	SET_CB(recorder, state, callback, user_data);
}

int recorder_unset_state_changed_cb(recorder_h recorder)
{
	UNSET_CB(recorder, state);
}

int recorder_set_error_cb(recorder_h recorder, recorder_error_cb callback, void *user_data)
{
	SET_CB(recorder, error, callback, user_data);
}

int recorder_unset_error_cb(recorder_h recorder)
{
	UNSET_CB(recorder, error);
}
