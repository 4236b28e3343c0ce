/* The AMR-NB recording pipeline; see recorder_pipeline.h. */
#define _GNU_SOURCE
#include "media/recorder_pipeline.h"

#include <dlog.h>
#include <errno.h>
#include <fcntl.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include "media/media_gst.h"

#define AMR_HEADER "#!AMR\n"
#define AMR_FRAME_NS (20 * GST_MSECOND)
/* How long a commit waits for the last sound to reach the file. */
#define EOS_WAIT (3 * GST_SECOND)

struct recorder_pipeline_s {
	GstElement *pipeline;
	GstElement *source;
	GstElement *sink;
	media_bus_watch_t *watch;
	recorder_pipeline_event_cb cb;
	void *data;
	char *path;
	bool failed;
	/* Written by the streaming thread, read on the main loop. */
	GMutex lock;
	guint64 written_ns;
	guint64 written_bytes;
	guint64 time_limit_ns;
	guint64 size_limit_bytes;
	int limit_hit; /* recorder_recording_limit_type_e, -1 before */
};

/* The band mode of amrnbenc for a bit rate: the fastest at or below it. */
static int __band_mode(int bitrate)
{
	static const int rates[] = {4750, 5150, 5900, 6700, 7400, 7950, 10200, 12200};
	int mode = 0;
	for (int i = 0; i < (int)G_N_ELEMENTS(rates); i++)
		if (bitrate >= rates[i])
			mode = i;
	return mode;
}

static GstPadProbeReturn __written_probe_cb(GstPad *pad, GstPadProbeInfo *info, gpointer data)
{
	(void)pad;
	recorder_pipeline_t *p = data;
	GstBuffer *buffer = GST_PAD_PROBE_INFO_BUFFER(info);
	guint64 size = gst_buffer_get_size(buffer);
	guint64 duration = GST_BUFFER_DURATION_IS_VALID(buffer) ? GST_BUFFER_DURATION(buffer) : AMR_FRAME_NS;
	bool drop = false;
	int reached = -1;

	g_mutex_lock(&p->lock);
	if (p->limit_hit >= 0) {
		drop = true;
	} else if (p->size_limit_bytes && p->written_bytes + size > p->size_limit_bytes) {
		drop = true;
		reached = p->limit_hit = RECORDER_RECORDING_LIMIT_SIZE;
	} else {
		p->written_bytes += size;
		p->written_ns += duration;
		if (p->time_limit_ns && p->written_ns >= p->time_limit_ns)
			reached = p->limit_hit = RECORDER_RECORDING_LIMIT_TIME;
	}
	g_mutex_unlock(&p->lock);

	if (reached >= 0) {
		GstStructure *s = gst_structure_new("recorder-limit", "type", G_TYPE_INT, reached, NULL);
		gst_element_post_message(p->sink, gst_message_new_application(GST_OBJECT(p->sink), s));
	}
	return drop ? GST_PAD_PROBE_DROP : GST_PAD_PROBE_OK;
}

static recorder_error_e __error_of(GError *error)
{
	if (error->domain == GST_RESOURCE_ERROR &&
	    (error->code == GST_RESOURCE_ERROR_WRITE || error->code == GST_RESOURCE_ERROR_OPEN_WRITE ||
	     error->code == GST_RESOURCE_ERROR_NO_SPACE_LEFT))
		return RECORDER_ERROR_OUT_OF_STORAGE;
	return RECORDER_ERROR_DEVICE;
}

static void __message_cb(GstMessage *message, void *data)
{
	recorder_pipeline_t *p = data;
	if (GST_MESSAGE_TYPE(message) == GST_MESSAGE_APPLICATION &&
	    gst_structure_has_name(gst_message_get_structure(message), "recorder-limit")) {
		int type = RECORDER_RECORDING_LIMIT_TIME;
		gst_structure_get_int(gst_message_get_structure(message), "type", &type);
		p->cb((recorder_recording_limit_type_e)type, RECORDER_ERROR_NONE, p->data);
		return;
	}
	if (GST_MESSAGE_TYPE(message) != GST_MESSAGE_ERROR)
		return;
	GError *error = NULL;
	gst_message_parse_error(message, &error, NULL);
	LOGE("recording failed: %s", error ? error->message : "?");
	p->failed = true;
	/* A full disk is one more limit: the owner keeps what was written. */
	bool full = error && error->domain == GST_RESOURCE_ERROR && error->code == GST_RESOURCE_ERROR_NO_SPACE_LEFT;
	recorder_error_e code = error ? __error_of(error) : RECORDER_ERROR_DEVICE;
	g_clear_error(&error);
	if (full)
		p->cb(RECORDER_RECORDING_LIMIT_FREE_SPACE, RECORDER_ERROR_NONE, p->data);
	else
		p->cb(RECORDER_RECORDING_LIMIT_TIME, code, p->data);
}

static bool __build(recorder_pipeline_t *p, int bitrate)
{
	GstElement *source = p->source = media_gst_audio_source_new();
	GstElement *convert = gst_element_factory_make("audioconvert", NULL);
	GstElement *resample = gst_element_factory_make("audioresample", NULL);
	GstElement *filter = gst_element_factory_make("capsfilter", NULL);
	GstElement *encoder = gst_element_factory_make("amrnbenc", NULL);
	p->sink = gst_element_factory_make("filesink", NULL);
	p->pipeline = gst_pipeline_new("recorder");
	if (!encoder)
		LOGE("no amrnbenc: install gstreamer1.0-plugins-ugly");
	if (!source || !convert || !resample || !filter || !encoder || !p->sink || !p->pipeline) {
		GstElement *made[] = {source, convert, resample, filter, encoder, p->sink};
		for (size_t i = 0; i < G_N_ELEMENTS(made); i++)
			if (made[i])
				gst_object_unref(gst_object_ref_sink(made[i]));
		p->source = p->sink = NULL;
		return false;
	}
	GstCaps *caps = gst_caps_from_string("audio/x-raw,format=S16LE,rate=8000,channels=1");
	g_object_set(filter, "caps", caps, NULL);
	gst_caps_unref(caps);
	g_object_set(encoder, "band-mode", __band_mode(bitrate), NULL);
	g_object_set(p->sink, "append", TRUE, "async", FALSE, NULL);
	/* The file sink opens its file on the way to READY: it stays down until a take starts. */
	gst_element_set_locked_state(p->sink, TRUE);
	gst_bin_add_many(GST_BIN(p->pipeline), source, convert, resample, filter, encoder, p->sink, NULL);
	if (!gst_element_link_many(source, convert, resample, filter, encoder, p->sink, NULL)) {
		LOGE("cannot link the recording pipeline");
		return false;
	}
	GstPad *pad = gst_element_get_static_pad(p->sink, "sink");
	gst_pad_add_probe(pad, GST_PAD_PROBE_TYPE_BUFFER, __written_probe_cb, p, NULL);
	gst_object_unref(pad);
	return true;
}

recorder_pipeline_t *recorder_pipeline_new(int bitrate, recorder_pipeline_event_cb cb, void *data,
                                           recorder_error_e *error)
{
	*error = RECORDER_ERROR_OUT_OF_MEMORY;
	recorder_pipeline_t *p = media_gst_init() ? calloc(1, sizeof(*p)) : NULL;
	if (!p)
		return NULL;
	g_mutex_init(&p->lock);
	p->cb = cb;
	p->data = data;
	p->limit_hit = -1;
	*error = RECORDER_ERROR_DEVICE;
	if (!__build(p, bitrate) || !(p->watch = media_bus_watch_add(p->pipeline, __message_cb, p)) ||
	    gst_element_set_state(p->pipeline, GST_STATE_READY) == GST_STATE_CHANGE_FAILURE ||
	    media_gst_device_missing(p->source)) {
		LOGE("the microphone cannot be opened (%s=test records a test tone instead)", MEDIA_AUDIO_SOURCE_ENV);
		recorder_pipeline_free(p);
		return NULL;
	}
	*error = RECORDER_ERROR_NONE;
	return p;
}

void recorder_pipeline_free(recorder_pipeline_t *p)
{
	if (!p)
		return;
	if (p->pipeline) {
		gst_element_set_state(p->pipeline, GST_STATE_NULL);
		if (p->sink)
			gst_element_set_state(p->sink, GST_STATE_NULL);
		gst_object_unref(p->pipeline);
	}
	media_bus_watch_del(p->watch);
	g_mutex_clear(&p->lock);
	free(p->path);
	free(p);
}

static recorder_error_e __header_write(const char *path)
{
	int fd = open(path, O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
	bool ok = fd >= 0 && write(fd, AMR_HEADER, strlen(AMR_HEADER)) == (ssize_t)strlen(AMR_HEADER);
	int err = errno;
	if (fd >= 0 && close(fd) != 0 && ok) {
		ok = false;
		err = errno;
	}
	if (ok)
		return RECORDER_ERROR_NONE;
	LOGE("cannot write %s: %s", path, strerror(err));
	if (fd >= 0)
		unlink(path);
	if (err == ENOSPC || err == EDQUOT)
		return RECORDER_ERROR_OUT_OF_STORAGE;
	return err == EACCES || err == EPERM || err == EROFS ? RECORDER_ERROR_PERMISSION_DENIED
	                                                     : RECORDER_ERROR_INVALID_OPERATION;
}

recorder_error_e recorder_pipeline_start(recorder_pipeline_t *p, const char *path, int time_limit_s, int size_limit_kb)
{
	recorder_error_e rc = __header_write(path);
	if (rc != RECORDER_ERROR_NONE)
		return rc;
	free(p->path);
	p->path = strdup(path);
	g_mutex_lock(&p->lock);
	p->written_ns = 0;
	p->written_bytes = strlen(AMR_HEADER);
	p->time_limit_ns = (guint64)(time_limit_s > 0 ? time_limit_s : 0) * GST_SECOND;
	p->size_limit_bytes = (guint64)(size_limit_kb > 0 ? size_limit_kb : 0) * 1024;
	p->limit_hit = -1;
	g_mutex_unlock(&p->lock);
	p->failed = false;
	g_object_set(p->sink, "location", path, NULL);
	gst_element_set_locked_state(p->sink, FALSE);
	if (gst_element_set_state(p->pipeline, GST_STATE_PLAYING) == GST_STATE_CHANGE_FAILURE) {
		LOGE("recording does not start");
		recorder_pipeline_finish(p, false);
		return RECORDER_ERROR_DEVICE;
	}
	return RECORDER_ERROR_NONE;
}

recorder_error_e recorder_pipeline_pause(recorder_pipeline_t *p)
{
	return gst_element_set_state(p->pipeline, GST_STATE_PAUSED) == GST_STATE_CHANGE_FAILURE ? RECORDER_ERROR_DEVICE
	                                                                                        : RECORDER_ERROR_NONE;
}

recorder_error_e recorder_pipeline_resume(recorder_pipeline_t *p)
{
	return gst_element_set_state(p->pipeline, GST_STATE_PLAYING) == GST_STATE_CHANGE_FAILURE ? RECORDER_ERROR_DEVICE
	                                                                                         : RECORDER_ERROR_NONE;
}

void recorder_pipeline_finish(recorder_pipeline_t *p, bool keep)
{
	GstState state = GST_STATE_NULL;
	gst_element_get_state(p->pipeline, &state, NULL, 0);
	/* Sound on its way through the encoder reaches the file before it closes. A paused source sends
	   nothing more, so there is nothing to wait for then. */
	if (keep && !p->failed && state == GST_STATE_PLAYING) {
		gst_element_send_event(p->pipeline, gst_event_new_eos());
		GstBus *bus = gst_element_get_bus(p->pipeline);
		GstMessage *m = gst_bus_timed_pop_filtered(bus, EOS_WAIT, GST_MESSAGE_EOS | GST_MESSAGE_ERROR);
		if (!m)
			LOGE("the end of the recording did not reach the file in time");
		else
			gst_message_unref(m);
		gst_object_unref(bus);
	}
	gst_element_set_state(p->pipeline, GST_STATE_READY);
	gst_element_set_locked_state(p->sink, TRUE);
	gst_element_set_state(p->sink, GST_STATE_NULL);
	if (!keep && p->path && unlink(p->path) != 0 && errno != ENOENT)
		LOGE("cannot remove %s: %s", p->path, strerror(errno));
	free(p->path);
	p->path = NULL;
}

void recorder_pipeline_progress(recorder_pipeline_t *p, unsigned long long *ms, unsigned long long *bytes)
{
	g_mutex_lock(&p->lock);
	*ms = p->written_ns / GST_MSECOND;
	*bytes = p->written_bytes;
	g_mutex_unlock(&p->lock);
}
