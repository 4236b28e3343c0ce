/* Device settings as views of vconf keys. */
#define _GNU_SOURCE
#include <system_settings.h>

#include <stdint.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <dlog.h>
#include <vconf.h>

typedef enum {
	SETTING_STRING,
	SETTING_INT,
	SETTING_BOOL,
} setting_kind_e;

typedef struct {
	setting_kind_e kind;
	const char *vconfKey;
} setting_def_t;

#define DEFAULT_FONT "Sans"
#define DEFAULT_DEVICE_NAME "Tizen"

/* The settings this device has; NULL for keys it lacks. */
static const setting_def_t *__settingDef(system_settings_key_e key)
{
	static const setting_def_t fontSize = {SETTING_INT, VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_SIZE};
	static const setting_def_t fontType = {SETTING_STRING, VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_NAME};
	static const setting_def_t defaultFont = {SETTING_STRING, NULL};
	static const setting_def_t country = {SETTING_STRING, VCONFKEY_REGIONFORMAT};
	static const setting_def_t language = {SETTING_STRING, VCONFKEY_LANGSET};
	static const setting_def_t hour24 = {SETTING_BOOL, VCONFKEY_REGIONFORMAT_TIME1224};
	static const setting_def_t zone = {SETTING_STRING, VCONFKEY_SETAPPL_TIMEZONE_ID};
	static const setting_def_t silent = {SETTING_BOOL, VCONFKEY_SETAPPL_SOUND_STATUS_BOOL};
	static const setting_def_t touch = {SETTING_BOOL, VCONFKEY_SETAPPL_TOUCH_SOUNDS_BOOL};
	static const setting_def_t rotation = {SETTING_BOOL, VCONFKEY_SETAPPL_AUTO_ROTATE_SCREEN_BOOL};
	static const setting_def_t deviceName = {SETTING_STRING, VCONFKEY_SETAPPL_DEVICE_NAME_STR};
	switch (key) {
	case SYSTEM_SETTINGS_KEY_FONT_SIZE:
		return &fontSize;
	case SYSTEM_SETTINGS_KEY_FONT_TYPE:
		return &fontType;
	case SYSTEM_SETTINGS_KEY_DEFAULT_FONT_TYPE:
		return &defaultFont;
	case SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY:
		return &country;
	case SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE:
		return &language;
	case SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR:
		return &hour24;
	case SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE:
		return &zone;
	case SYSTEM_SETTINGS_KEY_SOUND_SILENT_MODE:
		return &silent;
	case SYSTEM_SETTINGS_KEY_SOUND_TOUCH:
		return &touch;
	case SYSTEM_SETTINGS_KEY_DISPLAY_SCREEN_ROTATION_AUTO:
		return &rotation;
	case SYSTEM_SETTINGS_KEY_DEVICE_NAME:
		return &deviceName;
	default:
		return NULL;
	}
}

/* Checks the key and the type asked for; the definition in *def on success. */
static int __lookup(system_settings_key_e key, setting_kind_e kind, const setting_def_t **def)
{
	if ((int)key < 0 || key >= SYSTEM_SETTINGS_KEY_MAX) {
		LOGE("invalid key %d", (int)key);
		return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
	}
	*def = __settingDef(key);
	if (!*def) {
		LOGE("key %d is not supported", (int)key);
		return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
	}
	if ((*def)->kind != kind) {
		LOGE("key %d has another type", (int)key);
		return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
	}
	return SYSTEM_SETTINGS_ERROR_NONE;
}

/* As __lookup, for the operations that take a pointer: a NULL one is an invalid parameter. */
static int __lookupWith(const void *ptr, system_settings_key_e key, setting_kind_e kind, const setting_def_t **def)
{
	return ptr ? __lookup(key, kind, def) : SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
}

/* "de_DE.UTF-8" -> "de_DE", malloc'ed. */
static char *__withoutCodesetN(const char *locale)
{
	return strndup(locale, strcspn(locale, ".@"));
}

/* The zone of the desktop when no zone was set through vconf. */
static char *__hostTimezoneN(void)
{
	const char *tz = getenv("TZ");
	if (tz && tz[0])
		return strdup(tz[0] == ':' ? tz + 1 : tz);
	char line[256] = "";
	FILE *f = fopen("/etc/timezone", "r");
	if (f) {
		if (!fgets(line, sizeof(line), f))
			line[0] = '\0';
		fclose(f);
		line[strcspn(line, "\r\n")] = '\0';
		if (line[0])
			return strdup(line);
	}
	char link[512];
	ssize_t n = readlink("/etc/localtime", link, sizeof(link) - 1);
	if (n > 0) {
		link[n] = '\0';
		const char *zone = strstr(link, "zoneinfo/");
		if (zone)
			return strdup(zone + strlen("zoneinfo/"));
	}
	return strdup("UTC");
}

int system_settings_get_value_string(system_settings_key_e key, char **value)
{
	const setting_def_t *def = NULL;
	int rc = __lookupWith(value, key, SETTING_STRING, &def);
	if (rc != SYSTEM_SETTINGS_ERROR_NONE)
		return rc;
	char *stored = def->vconfKey ? vconf_get_str(def->vconfKey) : NULL;
	char *result = NULL;
	switch (key) {
	case SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE:
	case SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY:
		result = stored ? __withoutCodesetN(stored) : strdup("en_US");
		break;
	case SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE:
		result = stored && stored[0] ? strdup(stored) : __hostTimezoneN();
		break;
	case SYSTEM_SETTINGS_KEY_DEVICE_NAME:
		result = strdup(stored ? stored : DEFAULT_DEVICE_NAME);
		break;
	default:
		result = strdup(stored ? stored : DEFAULT_FONT);
		break;
	}
	free(stored);
	if (!result)
		return SYSTEM_SETTINGS_ERROR_OUT_OF_MEMORY;
	*value = result;
	return SYSTEM_SETTINGS_ERROR_NONE;
}

int system_settings_get_value_int(system_settings_key_e key, int *value)
{
	const setting_def_t *def = NULL;
	int rc = __lookupWith(value, key, SETTING_INT, &def);
	if (rc != SYSTEM_SETTINGS_ERROR_NONE)
		return rc;
	int stored = SYSTEM_SETTINGS_FONT_SIZE_NORMAL;
	vconf_get_int(def->vconfKey, &stored);
	*value = stored;
	return SYSTEM_SETTINGS_ERROR_NONE;
}

int system_settings_get_value_bool(system_settings_key_e key, bool *value)
{
	const setting_def_t *def = NULL;
	int rc = __lookupWith(value, key, SETTING_BOOL, &def);
	if (rc != SYSTEM_SETTINGS_ERROR_NONE)
		return rc;
	if (key == SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR) {
		int format = VCONFKEY_TIME_FORMAT_12;
		vconf_get_int(def->vconfKey, &format);
		*value = format == VCONFKEY_TIME_FORMAT_24;
		return SYSTEM_SETTINGS_ERROR_NONE;
	}
	int stored = 1; /* sound, touch sounds and auto rotation are on until turned off */
	vconf_get_bool(def->vconfKey, &stored);
	*value = key == SYSTEM_SETTINGS_KEY_SOUND_SILENT_MODE ? !stored : stored != 0;
	return SYSTEM_SETTINGS_ERROR_NONE;
}

static int __vconfResult(int rc)
{
	return rc == VCONF_OK ? SYSTEM_SETTINGS_ERROR_NONE : SYSTEM_SETTINGS_ERROR_IO_ERROR;
}

int system_settings_set_value_string(system_settings_key_e key, const char *value)
{
	const setting_def_t *def = NULL;
	int rc = __lookupWith(value, key, SETTING_STRING, &def);
	if (rc != SYSTEM_SETTINGS_ERROR_NONE)
		return rc;
	if (!def->vconfKey || key == SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE)
		return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
	if (key == SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE || key == SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY) {
		if (!value[0])
			return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
		char *locale = NULL;
		if (asprintf(&locale, "%s%s", value, strchr(value, '.') ? "" : ".UTF-8") < 0)
			return SYSTEM_SETTINGS_ERROR_OUT_OF_MEMORY;
		rc = __vconfResult(vconf_set_str(def->vconfKey, locale));
		free(locale);
		return rc;
	}
	return __vconfResult(vconf_set_str(def->vconfKey, value));
}

int system_settings_set_value_int(system_settings_key_e key, int value)
{
	const setting_def_t *def = NULL;
	int rc = __lookup(key, SETTING_INT, &def);
	if (rc != SYSTEM_SETTINGS_ERROR_NONE)
		return rc;
	if (value < SYSTEM_SETTINGS_FONT_SIZE_SMALL || value > SYSTEM_SETTINGS_FONT_SIZE_GIANT)
		return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
	return __vconfResult(vconf_set_int(def->vconfKey, value));
}

int system_settings_set_value_bool(system_settings_key_e key, bool value)
{
	const setting_def_t *def = NULL;
	int rc = __lookup(key, SETTING_BOOL, &def);
	if (rc != SYSTEM_SETTINGS_ERROR_NONE)
		return rc;
	if (key == SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR)
		return __vconfResult(vconf_set_int(def->vconfKey, value ? VCONFKEY_TIME_FORMAT_24 : VCONFKEY_TIME_FORMAT_12));
	if (key == SYSTEM_SETTINGS_KEY_SOUND_SILENT_MODE)
		value = !value;
	return __vconfResult(vconf_set_bool(def->vconfKey, value));
}

typedef struct {
	system_settings_changed_cb cb;
	void *user_data;
} setting_watcher_t;

static setting_watcher_t __watchers[SYSTEM_SETTINGS_KEY_MAX];

static void __vconfChangedCb(keynode_t *node, void *data)
{
	(void)node;
	system_settings_key_e key = (system_settings_key_e)(intptr_t)data;
	setting_watcher_t *w = &__watchers[key];
	if (w->cb)
		w->cb(key, w->user_data);
}

/* The vconf key behind a setting that can be watched, or NULL. */
static const char *__watchedKey(system_settings_key_e key)
{
	if ((int)key < 0 || key >= SYSTEM_SETTINGS_KEY_MAX)
		return NULL;
	const setting_def_t *def = __settingDef(key);
	return def ? def->vconfKey : NULL;
}

int system_settings_set_changed_cb(system_settings_key_e key, system_settings_changed_cb callback, void *user_data)
{
	if ((int)key < 0 || key >= SYSTEM_SETTINGS_KEY_MAX || !callback)
		return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
	const char *vconfKey = __watchedKey(key);
	if (!vconfKey)
		return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
	setting_watcher_t *w = &__watchers[key];
	if (!w->cb && vconf_notify_key_changed(vconfKey, __vconfChangedCb, (void *)(intptr_t)key) != VCONF_OK)
		return SYSTEM_SETTINGS_ERROR_IO_ERROR;
	w->cb = callback;
	w->user_data = user_data;
	return SYSTEM_SETTINGS_ERROR_NONE;
}

int system_settings_unset_changed_cb(system_settings_key_e key)
{
	if ((int)key < 0 || key >= SYSTEM_SETTINGS_KEY_MAX)
		return SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER;
	const char *vconfKey = __watchedKey(key);
	if (!vconfKey)
		return SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED;
	setting_watcher_t *w = &__watchers[key];
	if (!w->cb)
		return SYSTEM_SETTINGS_ERROR_NONE;
	vconf_ignore_key_changed(vconfKey, __vconfChangedCb);
	w->cb = NULL;
	w->user_data = NULL;
	return SYSTEM_SETTINGS_ERROR_NONE;
}
