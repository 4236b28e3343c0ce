/* GStreamer start-up, configured sound devices, bus messages on the main loop. */
#include "media/media_gst.h"

#include <Ecore.h>
#include <dlog.h>
#include <stdlib.h>
#include <string.h>

bool media_gst_init(void)
{
	static bool started = false;
	if (started)
		return true;
	GError *error = NULL;
	if (!gst_init_check(NULL, NULL, &error)) {
		LOGE("GStreamer does not start: %s", error ? error->message : "?");
		g_clear_error(&error);
		return false;
	}
	started = true;
	return true;
}

/* The element the variable names, else the default factory's. */
static GstElement *__device_new(const char *env, const char *test_name, const char *test_desc,
                                const char *default_factory)
{
	const char *value = getenv(env);
	if (!value || !*value) {
		GstElement *e = gst_element_factory_make(default_factory, NULL);
		if (!e)
			LOGE("no %s element: is the GStreamer base plugin set installed?", default_factory);
		return e;
	}
	const char *desc = strcmp(value, test_name) ? value : test_desc;
	GError *error = NULL;
	GstElement *e = gst_parse_bin_from_description(desc, TRUE, &error);
	if (!e) {
		LOGE("%s=\"%s\": %s", env, value, error ? error->message : "?");
		g_clear_error(&error);
	}
	return e;
}

GstElement *media_gst_audio_source_new(void)
{
	return __device_new(MEDIA_AUDIO_SOURCE_ENV, "test", "audiotestsrc is-live=true", "autoaudiosrc");
}

GstElement *media_gst_audio_sink_new(void)
{
	return __device_new(MEDIA_AUDIO_SINK_ENV, "fake", "fakesink sync=true", "autoaudiosink");
}

bool media_gst_device_missing(GstElement *device)
{
	if (!GST_IS_BIN(device))
		return false;
	/* autoaudiosrc and autoaudiosink name their stand-ins "fake-...". */
	bool fake = false;
	GstIterator *it = gst_bin_iterate_elements(GST_BIN(device));
	GValue item = G_VALUE_INIT;
	while (gst_iterator_next(it, &item) == GST_ITERATOR_OK) {
		fake = fake || g_str_has_prefix(GST_ELEMENT_NAME(g_value_get_object(&item)), "fake-");
		g_value_reset(&item);
	}
	g_value_unset(&item);
	gst_iterator_free(it);
	return fake;
}

struct media_bus_watch_s {
	GstBus *bus;
	Ecore_Fd_Handler *handler;
	media_bus_cb cb;
	void *data;
	int dispatching;
	bool deleted;
};

static void __watch_free(media_bus_watch_t *w)
{
	if (w->handler)
		ecore_main_fd_handler_del(w->handler);
	gst_object_unref(w->bus);
	free(w);
}

static Eina_Bool __bus_readable_cb(void *data, Ecore_Fd_Handler *handler)
{
	(void)handler;
	media_bus_watch_t *w = data;
	GstMessage *message;
	w->dispatching++;
	while (!w->deleted && (message = gst_bus_pop(w->bus))) {
		w->cb(message, w->data);
		gst_message_unref(message);
	}
	w->dispatching--;
	if (w->deleted && !w->dispatching)
		__watch_free(w);
	return ECORE_CALLBACK_RENEW;
}

media_bus_watch_t *media_bus_watch_add(GstElement *pipeline, media_bus_cb cb, void *data)
{
	media_bus_watch_t *w = calloc(1, sizeof(*w));
	if (!w)
		return NULL;
	w->bus = gst_element_get_bus(pipeline);
	w->cb = cb;
	w->data = data;
	GPollFD fd = {.fd = -1};
	gst_bus_get_pollfd(w->bus, &fd);
	/* The descriptor stays readable while messages wait, whichever thread posted them. */
	w->handler = fd.fd >= 0 ? ecore_main_fd_handler_add(fd.fd, ECORE_FD_READ, __bus_readable_cb, w, NULL, NULL) : NULL;
	if (!w->handler) {
		LOGE("cannot watch the pipeline's messages");
		__watch_free(w);
		return NULL;
	}
	return w;
}

void media_bus_watch_del(media_bus_watch_t *watch)
{
	if (!watch)
		return;
	if (watch->dispatching) {
		watch->deleted = true;
		return;
	}
	__watch_free(watch);
}
