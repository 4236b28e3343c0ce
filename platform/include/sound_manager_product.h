#ifndef __TIZEN_MEDIA_SOUND_MANAGER_PRODUCT_H__
#define __TIZEN_MEDIA_SOUND_MANAGER_PRODUCT_H__

/* Sound manager calls of the phone product, beyond the public API: sessions of recording apps and the
   active route. On the desktop the route follows the earjack key VCONFKEY_SYSMAN_EARJACK
   ("memory/sysman/earjack": 0 removed, 1 headphones, 3 headset with a microphone). */
#include <sound_manager.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct sound_multi_session_s *sound_multi_session_h;

typedef enum {
	SOUND_MULTI_SESSION_TYPE_VOICE_RECOGNITION = 0,
	SOUND_MULTI_SESSION_TYPE_RECORD_AUDIO,
	SOUND_MULTI_SESSION_TYPE_RECORD_VIDEO,
} sound_multi_session_type_e;

typedef enum {
	SOUND_MULTI_SESSION_OPT_RESUME_OTHERS = 0,
	SOUND_MULTI_SESSION_OPT_MIX_WITH_OTHERS,
	SOUND_MULTI_SESSION_OPT_PAUSE_OTHERS,
	SOUND_MULTI_SESSION_OPT_RESET_OTHERS_RESUME_INFO,
} sound_multi_session_option_e;

typedef enum {
	SOUND_DEVICE_IN_MIC = 0x01,
	SOUND_DEVICE_IN_WIRED_ACCESSORY = 0x02,
	SOUND_DEVICE_IN_BT_SCO = 0x04,
} sound_device_in_e;

typedef enum {
	SOUND_DEVICE_OUT_SPEAKER = 0x01 << 8,
	SOUND_DEVICE_OUT_RECEIVER = 0x02 << 8,
	SOUND_DEVICE_OUT_WIRED_ACCESSORY = 0x04 << 8,
	SOUND_DEVICE_OUT_BT_SCO = 0x08 << 8,
	SOUND_DEVICE_OUT_BT_A2DP = 0x10 << 8,
	SOUND_DEVICE_OUT_DOCK = 0x020 << 8,
	SOUND_DEVICE_OUT_HDMI = 0x040 << 8,
	SOUND_DEVICE_OUT_WFD = 0x080 << 8,
	SOUND_DEVICE_OUT_USB_AUDIO = 0x100 << 8,
} sound_device_out_e;

/* Called on the main loop when the earjack comes or goes, with the devices then in use. */
typedef void (*sound_active_device_changed_cb)(sound_device_in_e in, sound_device_out_e out, void *user_data);

int sound_manager_multi_session_create(sound_multi_session_type_e type, sound_multi_session_h *session);
int sound_manager_multi_session_set_option(sound_multi_session_h session, sound_multi_session_option_e option);
int sound_manager_multi_session_get_option(sound_multi_session_h session, sound_multi_session_option_e *option);
int sound_manager_multi_session_destroy(sound_multi_session_h session);

/* The output and input devices in use; either pointer may be NULL. */
int sound_manager_get_active_route(sound_device_out_e *out, sound_device_in_e *in);

/* One callback per process; a new one replaces the old. */
int sound_manager_set_active_device_changed_cb(sound_active_device_changed_cb callback, void *user_data);
void sound_manager_unset_active_device_changed_cb(void);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_MEDIA_SOUND_MANAGER_PRODUCT_H__ */
