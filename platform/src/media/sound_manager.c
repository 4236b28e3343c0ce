/* Sound sessions and the active route. One mixer plays everything on the desktop, so sessions only
   keep what they are told; the route follows the earjack key. */
#include <sound_manager.h>
#include <sound_manager_product.h>

#include <dlog.h>
#include <stdlib.h>
#include <vconf.h>

#include "media/media_policy.h"

struct sound_multi_session_s {
	sound_multi_session_type_e type;
	sound_multi_session_option_e option;
};

static sound_session_type_e __session_type = SOUND_SESSION_TYPE_MEDIA;
static sound_session_option_for_starting_e __start_option = SOUND_SESSION_OPTION_MIX_WITH_OTHERS_WHEN_START;
static sound_session_option_for_during_play_e __play_option = SOUND_SESSION_OPTION_INTERRUPTIBLE_DURING_PLAY;
static sound_active_device_changed_cb __device_cb;
static void *__device_data;

int sound_manager_set_session_type(sound_session_type_e type)
{
	if (type < SOUND_SESSION_TYPE_MEDIA || type > SOUND_SESSION_TYPE_VOIP)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	__session_type = type;
	return SOUND_MANAGER_ERROR_NONE;
}

int sound_manager_get_session_type(sound_session_type_e *type)
{
	if (!type)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	*type = __session_type;
	return SOUND_MANAGER_ERROR_NONE;
}

int sound_manager_set_media_session_option(sound_session_option_for_starting_e s_option,
                                           sound_session_option_for_during_play_e d_option)
{
	if (s_option < SOUND_SESSION_OPTION_MIX_WITH_OTHERS_WHEN_START ||
	    s_option > SOUND_SESSION_OPTION_PAUSE_OTHERS_WHEN_START ||
	    d_option < SOUND_SESSION_OPTION_INTERRUPTIBLE_DURING_PLAY ||
	    d_option > SOUND_SESSION_OPTION_UNINTERRUPTIBLE_DURING_PLAY)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	if (__session_type != SOUND_SESSION_TYPE_MEDIA) {
		LOGE("session options belong to the media session");
		return SOUND_MANAGER_ERROR_INVALID_OPERATION;
	}
	__start_option = s_option;
	__play_option = d_option;
	return SOUND_MANAGER_ERROR_NONE;
}

int sound_manager_get_media_session_option(sound_session_option_for_starting_e *s_option,
                                           sound_session_option_for_during_play_e *d_option)
{
	if (!s_option || !d_option)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	*s_option = __start_option;
	*d_option = __play_option;
	return SOUND_MANAGER_ERROR_NONE;
}

int sound_manager_multi_session_create(sound_multi_session_type_e type, sound_multi_session_h *session)
{
	if (!session || type < SOUND_MULTI_SESSION_TYPE_VOICE_RECOGNITION || type > SOUND_MULTI_SESSION_TYPE_RECORD_VIDEO)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	*session = calloc(1, sizeof(**session));
	if (!*session)
		return SOUND_MANAGER_ERROR_OUT_OF_MEMORY;
	(*session)->type = type;
	return SOUND_MANAGER_ERROR_NONE;
}

int sound_manager_multi_session_set_option(sound_multi_session_h session, sound_multi_session_option_e option)
{
	if (!session || option < SOUND_MULTI_SESSION_OPT_RESUME_OTHERS ||
	    option > SOUND_MULTI_SESSION_OPT_RESET_OTHERS_RESUME_INFO)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	session->option = option;
	return SOUND_MANAGER_ERROR_NONE;
}

int sound_manager_multi_session_get_option(sound_multi_session_h session, sound_multi_session_option_e *option)
{
	if (!session || !option)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	*option = session->option;
	return SOUND_MANAGER_ERROR_NONE;
}

int sound_manager_multi_session_destroy(sound_multi_session_h session)
{
	if (!session)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	free(session);
	return SOUND_MANAGER_ERROR_NONE;
}

static void __route_of(int earjack, sound_device_out_e *out, sound_device_in_e *in)
{
	if (out)
		*out = earjack == VCONFKEY_SYSMAN_EARJACK_REMOVED ? SOUND_DEVICE_OUT_SPEAKER : SOUND_DEVICE_OUT_WIRED_ACCESSORY;
	/* Only a headset (four contacts) brings a microphone. */
	if (in)
		*in = earjack == VCONFKEY_SYSMAN_EARJACK_4WIRE ? SOUND_DEVICE_IN_WIRED_ACCESSORY : SOUND_DEVICE_IN_MIC;
}

int sound_manager_get_active_route(sound_device_out_e *out, sound_device_in_e *in)
{
	if (!out && !in)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	__route_of(media_policy_earjack(), out, in);
	return SOUND_MANAGER_ERROR_NONE;
}

static void __earjack_cb(media_policy_event_e event, int value, void *data)
{
	(void)data;
	if (event != MEDIA_POLICY_EARJACK || !__device_cb)
		return;
	sound_device_out_e out;
	sound_device_in_e in;
	__route_of(value, &out, &in);
	__device_cb(in, out, __device_data);
}

int sound_manager_set_active_device_changed_cb(sound_active_device_changed_cb callback, void *user_data)
{
	if (!callback)
		return SOUND_MANAGER_ERROR_INVALID_PARAMETER;
	if (!__device_cb && !media_policy_listen(__earjack_cb, NULL))
		return SOUND_MANAGER_ERROR_INTERNAL;
	__device_cb = callback;
	__device_data = user_data;
	return SOUND_MANAGER_ERROR_NONE;
}

void sound_manager_unset_active_device_changed_cb(void)
{
	if (!__device_cb)
		return;
	media_policy_unlisten(__earjack_cb, NULL);
	__device_cb = NULL;
	__device_data = NULL;
}
