#ifndef __TIZEN_SYSTEM_SYSTEM_SETTINGS_H__
#define __TIZEN_SYSTEM_SYSTEM_SETTINGS_H__

#include <stdbool.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	SYSTEM_SETTINGS_ERROR_NONE = TIZEN_ERROR_NONE,
	SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	SYSTEM_SETTINGS_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	SYSTEM_SETTINGS_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
	SYSTEM_SETTINGS_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
	SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
	SYSTEM_SETTINGS_ERROR_LOCKSCREEN_APP_PASSWORD_MODE = TIZEN_ERROR_SYSTEM_SETTING | 0x01,
} system_settings_error_e;

typedef enum {
	SYSTEM_SETTINGS_KEY_INCOMING_CALL_RINGTONE,
	SYSTEM_SETTINGS_KEY_WALLPAPER_HOME_SCREEN,
	SYSTEM_SETTINGS_KEY_WALLPAPER_LOCK_SCREEN,
	SYSTEM_SETTINGS_KEY_FONT_SIZE,
	SYSTEM_SETTINGS_KEY_FONT_TYPE,
	SYSTEM_SETTINGS_KEY_MOTION_ACTIVATION,
	SYSTEM_SETTINGS_KEY_EMAIL_ALERT_RINGTONE,
	SYSTEM_SETTINGS_KEY_USB_DEBUGGING_ENABLED,
	SYSTEM_SETTINGS_KEY_3G_DATA_NETWORK_ENABLED,
	SYSTEM_SETTINGS_KEY_LOCKSCREEN_APP = SYSTEM_SETTINGS_KEY_3G_DATA_NETWORK_ENABLED + 2,
	SYSTEM_SETTINGS_KEY_DEFAULT_FONT_TYPE,
	SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY,
	SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE,
	SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR,
	SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE,
	SYSTEM_SETTINGS_KEY_TIME_CHANGED,
	SYSTEM_SETTINGS_KEY_SOUND_LOCK,
	SYSTEM_SETTINGS_KEY_SOUND_SILENT_MODE,
	SYSTEM_SETTINGS_KEY_SOUND_TOUCH,
	SYSTEM_SETTINGS_KEY_DISPLAY_SCREEN_ROTATION_AUTO,
	SYSTEM_SETTINGS_KEY_DEVICE_NAME,
	SYSTEM_SETTINGS_KEY_MOTION_ENABLED,
	SYSTEM_SETTINGS_KEY_NETWORK_WIFI_NOTIFICATION,
	SYSTEM_SETTINGS_KEY_NETWORK_FLIGHT_MODE,
	SYSTEM_SETTINGS_KEY_SCREEN_BACKLIGHT_TIME,
	SYSTEM_SETTINGS_KEY_SOUND_NOTIFICATION,
	SYSTEM_SETTINGS_KEY_SOUND_NOTIFICATION_REPETITION_PERIOD,
	SYSTEM_SETTINGS_KEY_LOCK_STATE,
	SYSTEM_SETTINGS_KEY_MAX,
} system_settings_key_e;

typedef enum {
	SYSTEM_SETTINGS_FONT_SIZE_SMALL = 0,
	SYSTEM_SETTINGS_FONT_SIZE_NORMAL,
	SYSTEM_SETTINGS_FONT_SIZE_LARGE,
	SYSTEM_SETTINGS_FONT_SIZE_HUGE,
	SYSTEM_SETTINGS_FONT_SIZE_GIANT,
} system_settings_font_size_e;

typedef void (*system_settings_changed_cb)(system_settings_key_e key, void *user_data);

/* Settings of the device, read from vconf as on the phone:
   LOCALE_LANGUAGE  string  language key without its codeset ("de_DE")
   LOCALE_COUNTRY   string  region format key without its codeset
   LOCALE_TIMEFORMAT_24HOUR bool  region format clock == 24 hours
   LOCALE_TIMEZONE  string  db/setting/timezone_id, else $TZ, /etc/timezone, /etc/localtime, "UTC"
   FONT_SIZE        int     accessibility font size (default NORMAL)
   FONT_TYPE, DEFAULT_FONT_TYPE string; SOUND_SILENT_MODE, SOUND_TOUCH, DISPLAY_SCREEN_ROTATION_AUTO bool;
   DEVICE_NAME string.
   Other keys give SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED; reading a key as the wrong type, a key out of range
   or a null argument SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER. Strings are malloc'ed; the caller frees them. */
int system_settings_get_value_string(system_settings_key_e key, char **value);
int system_settings_get_value_int(system_settings_key_e key, int *value);
int system_settings_get_value_bool(system_settings_key_e key, bool *value);

/* Writers for the same keys (the language and country take "de_DE" or "de_DE.UTF-8"). The time zone,
   TIME_CHANGED and the unsupported keys are read-only here. */
int system_settings_set_value_string(system_settings_key_e key, const char *value);
int system_settings_set_value_int(system_settings_key_e key, int value);
int system_settings_set_value_bool(system_settings_key_e key, bool value);

/* One callback per key (a second call replaces it), called on the Ecore main loop when the setting
   changes in any process. */
int system_settings_set_changed_cb(system_settings_key_e key, system_settings_changed_cb callback, void *user_data);
int system_settings_unset_changed_cb(system_settings_key_e key);

#ifdef __cplusplus
}
#endif

#endif
