/* The media player on playbin: states, position and seeking, the end of the file, interruptions. */
#define _GNU_SOURCE
#include <player.h>

#include <dlog.h>
#include <gst/pbutils/pbutils.h>
#include <stdlib.h>
#include <string.h>
#include <vconf.h>

#include "media/media_amr.h"
#include "media/media_gst.h"
#include "media/media_policy.h"

#define PREPARE_WAIT (5 * GST_SECOND)
#define PLAY_FLAG_AUDIO 0x2 /* playbin's GstPlayFlags: sound only */

struct player_s {
	player_state_e state;
	char *uri;
	sound_type_e sound_type;
	GstElement *playbin;
	media_bus_watch_t *watch;
	int duration_ms;
	int earjack;         /* the earjack key as last seen */
	bool completed;      /* the end was reported for this run */
	bool paused_by_call; /* its end is reported as PLAYER_INTERRUPTED_COMPLETED */
	bool seeking;

	player_seek_completed_cb seek_cb;
	void *seek_data;
	player_completed_cb completed_cb;
	void *completed_data;
	player_interrupted_cb interrupted_cb;
	void *interrupted_data;
};

#define CHECK_HANDLE(p)                                                                                                \
	do {                                                                                                               \
		if (!(p)) {                                                                                                    \
			LOGE("invalid player handle");                                                                             \
			return PLAYER_ERROR_INVALID_PARAMETER;                                                                     \
		}                                                                                                              \
	} while (0)

static int __invalid_state(player_h p, const char *what)
{
	LOGE("%s is not allowed in state %d", what, (int)p->state);
	return PLAYER_ERROR_INVALID_STATE;
}

static bool __prepared(player_h p)
{
	return p->state == PLAYER_STATE_READY || p->state == PLAYER_STATE_PLAYING || p->state == PLAYER_STATE_PAUSED;
}

static void __message_cb(GstMessage *message, void *data)
{
	player_h p = data;
	switch (GST_MESSAGE_TYPE(message)) {
	case GST_MESSAGE_EOS:
		if (p->state != PLAYER_STATE_PLAYING || p->completed)
			return;
		p->completed = true;
		if (p->completed_cb)
			p->completed_cb(p->completed_data);
		return;
	case GST_MESSAGE_ASYNC_DONE:
		if (!p->seeking)
			return;
		p->seeking = false;
		if (p->seek_cb)
			p->seek_cb(p->seek_data);
		return;
	case GST_MESSAGE_ERROR: {
		GError *error = NULL;
		gst_message_parse_error(message, &error, NULL);
		LOGE("playback failed: %s", error ? error->message : "?");
		g_clear_error(&error);
		return;
	}
	default:
		return;
	}
}

static void __interrupt(player_h p, player_interrupted_code_e code)
{
	if (p->interrupted_cb)
		p->interrupted_cb(code, p->interrupted_data);
}

/* A call pauses playback until it is over; so does pulling the earjack out, for good. */
static void __policy_cb(media_policy_event_e event, int value, void *data)
{
	player_h p = data;
	bool unplugged = event == MEDIA_POLICY_EARJACK && p->earjack != VCONFKEY_SYSMAN_EARJACK_REMOVED &&
	                 value == VCONFKEY_SYSMAN_EARJACK_REMOVED;
	if (event == MEDIA_POLICY_EARJACK)
		p->earjack = value;
	if (event == MEDIA_POLICY_CALL && !value && p->paused_by_call) {
		p->paused_by_call = false;
		if (p->state == PLAYER_STATE_PAUSED)
			__interrupt(p, PLAYER_INTERRUPTED_COMPLETED);
		return;
	}
	if (p->state != PLAYER_STATE_PLAYING || !(unplugged || (event == MEDIA_POLICY_CALL && value)))
		return;
	gst_element_set_state(p->playbin, GST_STATE_PAUSED);
	p->state = PLAYER_STATE_PAUSED;
	p->paused_by_call = !unplugged;
	LOGI("playback paused by %s", unplugged ? "the earjack" : "a call");
	__interrupt(p, unplugged ? PLAYER_INTERRUPTED_BY_EARJACK_UNPLUG : PLAYER_INTERRUPTED_BY_CALL);
}

int player_create(player_h *player)
{
	if (!player)
		return PLAYER_ERROR_INVALID_PARAMETER;
	if (!media_gst_init())
		return PLAYER_ERROR_INVALID_OPERATION;
	player_h p = calloc(1, sizeof(*p));
	if (!p)
		return PLAYER_ERROR_OUT_OF_MEMORY;
	p->state = PLAYER_STATE_IDLE;
	p->sound_type = SOUND_TYPE_MEDIA;
	p->earjack = media_policy_earjack();
	if (!media_policy_listen(__policy_cb, p)) {
		free(p);
		return PLAYER_ERROR_INVALID_OPERATION;
	}
	*player = p;
	return PLAYER_ERROR_NONE;
}

int player_destroy(player_h player)
{
	CHECK_HANDLE(player);
	if (player->state != PLAYER_STATE_IDLE)
		player_unprepare(player);
	media_policy_unlisten(__policy_cb, player);
	free(player->uri);
	free(player);
	return PLAYER_ERROR_NONE;
}

int player_set_uri(player_h player, const char *uri)
{
	CHECK_HANDLE(player);
	if (!uri || !*uri)
		return PLAYER_ERROR_INVALID_PARAMETER;
	if (player->state != PLAYER_STATE_IDLE)
		return __invalid_state(player, "set_uri");
	gchar *made = strstr(uri, "://") ? g_strdup(uri) : gst_filename_to_uri(uri, NULL);
	char *copy = made ? strdup(made) : NULL;
	g_free(made);
	if (!copy)
		return PLAYER_ERROR_INVALID_URI;
	free(player->uri);
	player->uri = copy;
	return PLAYER_ERROR_NONE;
}

/* The reason playback could not be prepared, from the error the pipeline posted. */
static player_error_e __prepare_error(GstElement *playbin)
{
	GstBus *bus = gst_element_get_bus(playbin);
	/* The streaming thread may post its error just after the state change has failed. */
	GstMessage *m = gst_bus_timed_pop_filtered(bus, GST_SECOND, GST_MESSAGE_ERROR);
	gst_object_unref(bus);
	if (!m) {
		LOGE("the file did not get ready in time");
		return PLAYER_ERROR_INVALID_OPERATION;
	}
	GError *error = NULL;
	gst_message_parse_error(m, &error, NULL);
	gst_message_unref(m);
	LOGE("cannot play: %s", error ? error->message : "?");
	player_error_e rc = PLAYER_ERROR_INVALID_OPERATION;
	if (error && error->domain == GST_RESOURCE_ERROR)
		rc = error->code == GST_RESOURCE_ERROR_NOT_FOUND ? PLAYER_ERROR_NO_SUCH_FILE
		     : error->code == GST_RESOURCE_ERROR_OPEN_READ || error->code == GST_RESOURCE_ERROR_READ
		         ? PLAYER_ERROR_INVALID_URI
		         : PLAYER_ERROR_INVALID_OPERATION;
	else if (error && (error->domain == GST_STREAM_ERROR || error->domain == GST_CORE_ERROR))
		rc = PLAYER_ERROR_NOT_SUPPORTED_FILE;
	g_clear_error(&error);
	return rc;
}

/* Parsers of some formats (AMR among them) tell no duration: AMR files are counted, others are read
   through by the discoverer. */
static int __duration_ms(player_h p)
{
	gint64 ns = 0;
	if (gst_element_query_duration(p->playbin, GST_FORMAT_TIME, &ns) && ns >= 0)
		return (int)(ns / GST_MSECOND);
	gchar *path = g_filename_from_uri(p->uri, NULL, NULL);
	int amr_ms = media_amr_duration_ms(path);
	g_free(path);
	if (amr_ms >= 0)
		return amr_ms;
	GstDiscoverer *discoverer = gst_discoverer_new(PREPARE_WAIT, NULL);
	GstDiscovererInfo *info = discoverer ? gst_discoverer_discover_uri(discoverer, p->uri, NULL) : NULL;
	GstClockTime d = info ? gst_discoverer_info_get_duration(info) : GST_CLOCK_TIME_NONE;
	if (info)
		gst_discoverer_info_unref(info);
	if (discoverer)
		g_object_unref(discoverer);
	return GST_CLOCK_TIME_IS_VALID(d) ? (int)(d / GST_MSECOND) : 0;
}

int player_prepare(player_h player)
{
	CHECK_HANDLE(player);
	if (player->state != PLAYER_STATE_IDLE)
		return __invalid_state(player, "prepare");
	if (!player->uri) {
		LOGE("no file set");
		return PLAYER_ERROR_INVALID_OPERATION;
	}
	GstElement *playbin = gst_element_factory_make("playbin", NULL);
	GstElement *sink = media_gst_audio_sink_new();
	GstElement *video = gst_element_factory_make("fakesink", NULL);
	if (!playbin || !sink || !video) {
		GstElement *made[] = {playbin, sink, video};
		for (size_t i = 0; i < G_N_ELEMENTS(made); i++)
			if (made[i])
				gst_object_unref(gst_object_ref_sink(made[i]));
		return PLAYER_ERROR_INVALID_OPERATION;
	}
	g_object_set(playbin, "uri", player->uri, "audio-sink", sink, "video-sink", video, "flags", PLAY_FLAG_AUDIO, NULL);
	GstStateChangeReturn ret = gst_element_set_state(playbin, GST_STATE_PAUSED);
	if (ret == GST_STATE_CHANGE_ASYNC)
		ret = gst_element_get_state(playbin, NULL, NULL, PREPARE_WAIT);
	if (ret != GST_STATE_CHANGE_SUCCESS && ret != GST_STATE_CHANGE_NO_PREROLL) {
		player_error_e rc = __prepare_error(playbin);
		gst_element_set_state(playbin, GST_STATE_NULL);
		gst_object_unref(playbin);
		return rc;
	}
	player->playbin = playbin;
	player->watch = media_bus_watch_add(playbin, __message_cb, player);
	player->duration_ms = __duration_ms(player);
	player->completed = false;
	player->seeking = false;
	player->state = PLAYER_STATE_READY;
	return PLAYER_ERROR_NONE;
}

int player_unprepare(player_h player)
{
	CHECK_HANDLE(player);
	if (!__prepared(player))
		return __invalid_state(player, "unprepare");
	media_bus_watch_del(player->watch);
	player->watch = NULL;
	gst_element_set_state(player->playbin, GST_STATE_NULL);
	gst_object_unref(player->playbin);
	player->playbin = NULL;
	player->paused_by_call = false;
	player->state = PLAYER_STATE_IDLE;
	return PLAYER_ERROR_NONE;
}

int player_start(player_h player)
{
	CHECK_HANDLE(player);
	if (player->state != PLAYER_STATE_READY && player->state != PLAYER_STATE_PAUSED)
		return __invalid_state(player, "start");
	if (media_policy_in_call()) {
		LOGE("no playback during a call");
		return PLAYER_ERROR_SOUND_POLICY;
	}
	if (gst_element_set_state(player->playbin, GST_STATE_PLAYING) == GST_STATE_CHANGE_FAILURE)
		return PLAYER_ERROR_INVALID_OPERATION;
	player->paused_by_call = false;
	player->state = PLAYER_STATE_PLAYING;
	return PLAYER_ERROR_NONE;
}

int player_pause(player_h player)
{
	CHECK_HANDLE(player);
	if (player->state != PLAYER_STATE_PLAYING)
		return __invalid_state(player, "pause");
	if (gst_element_set_state(player->playbin, GST_STATE_PAUSED) == GST_STATE_CHANGE_FAILURE)
		return PLAYER_ERROR_INVALID_OPERATION;
	player->state = PLAYER_STATE_PAUSED;
	return PLAYER_ERROR_NONE;
}

int player_stop(player_h player)
{
	CHECK_HANDLE(player);
	if (player->state != PLAYER_STATE_PLAYING && player->state != PLAYER_STATE_PAUSED)
		return __invalid_state(player, "stop");
	/* Ready again means ready at the start of the file. */
	gst_element_set_state(player->playbin, GST_STATE_PAUSED);
	gst_element_seek_simple(player->playbin, GST_FORMAT_TIME, GST_SEEK_FLAG_FLUSH | GST_SEEK_FLAG_KEY_UNIT, 0);
	player->completed = false;
	player->paused_by_call = false;
	player->state = PLAYER_STATE_READY;
	return PLAYER_ERROR_NONE;
}

int player_get_state(player_h player, player_state_e *state)
{
	CHECK_HANDLE(player);
	if (!state)
		return PLAYER_ERROR_INVALID_PARAMETER;
	*state = player->state;
	return PLAYER_ERROR_NONE;
}

int player_set_sound_type(player_h player, sound_type_e type)
{
	CHECK_HANDLE(player);
	if (type < SOUND_TYPE_SYSTEM || type > SOUND_TYPE_VOICE)
		return PLAYER_ERROR_INVALID_PARAMETER;
	if (player->state != PLAYER_STATE_IDLE)
		return __invalid_state(player, "set_sound_type");
	player->sound_type = type;
	return PLAYER_ERROR_NONE;
}

int player_get_duration(player_h player, int *duration)
{
	CHECK_HANDLE(player);
	if (!duration)
		return PLAYER_ERROR_INVALID_PARAMETER;
	if (!__prepared(player))
		return __invalid_state(player, "get_duration");
	*duration = player->duration_ms;
	return PLAYER_ERROR_NONE;
}

int player_get_play_position(player_h player, int *millisecond)
{
	CHECK_HANDLE(player);
	if (!millisecond)
		return PLAYER_ERROR_INVALID_PARAMETER;
	if (!__prepared(player))
		return __invalid_state(player, "get_play_position");
	gint64 ns = 0;
	if (!gst_element_query_position(player->playbin, GST_FORMAT_TIME, &ns) || ns < 0)
		ns = 0;
	*millisecond = (int)(ns / GST_MSECOND);
	return PLAYER_ERROR_NONE;
}

int player_set_play_position(player_h player, int millisecond, bool accurate, player_seek_completed_cb callback,
                             void *user_data)
{
	CHECK_HANDLE(player);
	if (millisecond < 0)
		return PLAYER_ERROR_INVALID_PARAMETER;
	if (!__prepared(player))
		return __invalid_state(player, "set_play_position");
	GstSeekFlags flags = GST_SEEK_FLAG_FLUSH | (accurate ? GST_SEEK_FLAG_ACCURATE : GST_SEEK_FLAG_KEY_UNIT);
	if (!gst_element_seek_simple(player->playbin, GST_FORMAT_TIME, flags, (gint64)millisecond * GST_MSECOND)) {
		LOGE("cannot seek to %d ms", millisecond);
		return PLAYER_ERROR_SEEK_FAILED;
	}
	player->completed = false;
	player->seeking = true;
	player->seek_cb = callback;
	player->seek_data = user_data;
	return PLAYER_ERROR_NONE;
}

int player_set_completed_cb(player_h player, player_completed_cb callback, void *user_data)
{
	CHECK_HANDLE(player);
	if (!callback)
		return PLAYER_ERROR_INVALID_PARAMETER;
	player->completed_cb = callback;
	player->completed_data = user_data;
	return PLAYER_ERROR_NONE;
}

int player_unset_completed_cb(player_h player)
{
	CHECK_HANDLE(player);
	player->completed_cb = NULL;
	player->completed_data = NULL;
	return PLAYER_ERROR_NONE;
}

int player_set_interrupted_cb(player_h player, player_interrupted_cb callback, void *user_data)
{
	CHECK_HANDLE(player);
	if (!callback)
		return PLAYER_ERROR_INVALID_PARAMETER;
	player->interrupted_cb = callback;
	player->interrupted_data = user_data;
	return PLAYER_ERROR_NONE;
}

int player_unset_interrupted_cb(player_h player)
{
	CHECK_HANDLE(player);
	player->interrupted_cb = NULL;
	player->interrupted_data = NULL;
	return PLAYER_ERROR_NONE;
}
