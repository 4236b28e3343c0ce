/* The capture pipeline: source, scale to the asked size, one JPEG frame into a file. */
#define _GNU_SOURCE
#include "camera_shot.h"

#include <gst/gst.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/stat.h>
#include <unistd.h>

#define SHOT_TIMEOUT_SEC 15
/* A camera's first frames are often dark while its exposure settles. */
#define CAMERA_WARMUP_FRAMES 8

char *camera_shot_device_find(void)
{
	const char *env = getenv(CAMERA_DEVICE_ENV);
	if (env && *env)
		return access(env, R_OK) == 0 ? strdup(env) : NULL;
	for (int i = 0; i < 10; i++) {
		char path[32];
		snprintf(path, sizeof(path), "/dev/video%d", i);
		if (access(path, R_OK) == 0)
			return strdup(path);
	}
	return NULL;
}

bool camera_shot_resolution_parse(const char *text, int *width, int *height)
{
	static const struct {
		const char *name;
		int w, h;
	} named[] = {{"QVGA", 320, 240}, {"VGA", 640, 480}, {"SVGA", 800, 600},
	             {"XGA", 1024, 768}, {"HD", 1280, 720}, {"FHD", 1920, 1080}};
	if (!text)
		return false;
	for (size_t i = 0; i < sizeof(named) / sizeof(named[0]); i++) {
		if (!strcasecmp(text, named[i].name)) {
			*width = named[i].w;
			*height = named[i].h;
			return true;
		}
	}
	int w = 0, h = 0;
	char rest;
	if (sscanf(text, "%dx%d%c", &w, &h, &rest) != 2 || w < 16 || h < 16 || w > 8192 || h > 8192)
		return false;
	*width = w;
	*height = h;
	return true;
}

static GstPadProbeReturn warmup_probe_cb(GstPad *pad, GstPadProbeInfo *info, gpointer data)
{
	(void)pad;
	(void)info;
	int *left = data;
	if (*left > 0) {
		(*left)--;
		return GST_PAD_PROBE_DROP;
	}
	return GST_PAD_PROBE_REMOVE;
}

static void shot_fail(camera_shot_s *shot, const char *what, const char *detail)
{
	free(shot->error);
	if (asprintf(&shot->error, "%s%s%s", what, detail ? ": " : "", detail ? detail : "") < 0)
		shot->error = NULL;
}

/* Runs the pipeline to its end; true on end of stream. */
static bool pipeline_run(GstElement *pipeline, camera_shot_s *shot)
{
	if (gst_element_set_state(pipeline, GST_STATE_PLAYING) == GST_STATE_CHANGE_FAILURE) {
		shot_fail(shot, "The camera could not be started", NULL);
		return false;
	}
	GstBus *bus = gst_element_get_bus(pipeline);
	GstMessage *msg = gst_bus_timed_pop_filtered(bus, (GstClockTime)SHOT_TIMEOUT_SEC * GST_SECOND,
	                                             GST_MESSAGE_EOS | GST_MESSAGE_ERROR);
	bool ok = msg && GST_MESSAGE_TYPE(msg) == GST_MESSAGE_EOS;
	if (!msg) {
		shot_fail(shot, "The camera gave no picture in time", NULL);
	} else if (!ok) {
		GError *err = NULL;
		gst_message_parse_error(msg, &err, NULL);
		shot_fail(shot, "The camera failed", err ? err->message : NULL);
		g_clear_error(&err);
	}
	if (msg)
		gst_message_unref(msg);
	gst_object_unref(bus);
	gst_element_set_state(pipeline, GST_STATE_NULL);
	return ok;
}

bool camera_shot_take(camera_shot_s *shot)
{
	char *desc = NULL;
	if (asprintf(&desc,
	             "%s name=source ! videoconvert ! videoscale ! "
	             "video/x-raw,width=%d,height=%d,pixel-aspect-ratio=1/1 ! jpegenc snapshot=true quality=90 ! "
	             "filesink name=sink",
	             shot->device ? "v4l2src" : "videotestsrc pattern=smpte", shot->width, shot->height) < 0)
		return false;
	GError *err = NULL;
	GstElement *pipeline = gst_parse_launch(desc, &err);
	free(desc);
	if (!pipeline || err) {
		shot_fail(shot, "The capture pipeline could not be built", err ? err->message : NULL);
		g_clear_error(&err);
		if (pipeline)
			gst_object_unref(pipeline);
		return false;
	}
	GstElement *source = gst_bin_get_by_name(GST_BIN(pipeline), "source");
	GstElement *sink = gst_bin_get_by_name(GST_BIN(pipeline), "sink");
	g_object_set(sink, "location", shot->path, NULL);
	int warmup = CAMERA_WARMUP_FRAMES;
	if (shot->device) {
		g_object_set(source, "device", shot->device, NULL);
		GstPad *pad = gst_element_get_static_pad(source, "src");
		gst_pad_add_probe(pad, GST_PAD_PROBE_TYPE_BUFFER, warmup_probe_cb, &warmup, NULL);
		gst_object_unref(pad);
	}
	gst_object_unref(source);
	gst_object_unref(sink);

	bool ok = pipeline_run(pipeline, shot);
	gst_object_unref(pipeline);
	struct stat st;
	if (ok && (stat(shot->path, &st) != 0 || st.st_size == 0)) {
		shot_fail(shot, "The picture could not be written", shot->path);
		ok = false;
	}
	if (!ok)
		unlink(shot->path);
	return ok;
}
