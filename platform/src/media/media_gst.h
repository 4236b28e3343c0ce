/* GStreamer shared by the recorder and the player: start-up, the configured sound devices, and bus
   messages brought to the main loop. */
#ifndef PLATFORM_SRC_MEDIA_MEDIA_GST_H
#define PLATFORM_SRC_MEDIA_MEDIA_GST_H

#include <gst/gst.h>
#include <stdbool.h>

/* Microphone and speakers: the desktop's defaults, or what these variables name. "test" and "fake" are
   the test devices (a live tone, a sink that only keeps the clock); anything else is a pipeline
   description such as "pulsesrc device=...". */
#define MEDIA_AUDIO_SOURCE_ENV "TIZEN_AUDIO_SOURCE"
#define MEDIA_AUDIO_SINK_ENV "TIZEN_AUDIO_SINK"

/* Starts GStreamer once; false (logged) when it cannot. */
bool media_gst_init(void);

/* A new floating source or sink element, or NULL (logged). */
GstElement *media_gst_audio_source_new(void);
GstElement *media_gst_audio_sink_new(void);

/* True when a default device (once READY) found no sound server and stands in a silent element. */
bool media_gst_device_missing(GstElement *device);

/* Hands every message of a bus to cb on the main loop, through the bus's poll descriptor. cb may
   delete the watch (and what owns it); the rest of the messages then stay on the bus. */
typedef void (*media_bus_cb)(GstMessage *message, void *data);
typedef struct media_bus_watch_s media_bus_watch_t;

media_bus_watch_t *media_bus_watch_add(GstElement *pipeline, media_bus_cb cb, void *data);
void media_bus_watch_del(media_bus_watch_t *watch);

#endif
