/* Platform features of the desktop "device": a fixed phone profile with per-key overrides. */
#define _GNU_SOURCE
#include <system_info.h>

#include <ctype.h>
#include <errno.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <dlog.h>

typedef enum {
	INFO_INT,
	INFO_BOOL,
	INFO_DOUBLE,
	INFO_STRING,
} info_kind_e;

typedef struct {
	const char *key;
	info_kind_e kind;
	const char *value; /* default, in the same text form as an override */
} info_def_t;

static const info_def_t __infos[] = {
    {"http://tizen.org/feature/screen.width", INFO_INT, "720"},
    {"http://tizen.org/feature/screen.height", INFO_INT, "1280"},
    {"http://tizen.org/feature/screen.dpi", INFO_INT, "320"},
    {"http://tizen.org/feature/screen.bpp", INFO_INT, "32"},
    {"http://tizen.org/feature/screen.size.large", INFO_BOOL, "false"},
    {"http://tizen.org/feature/screen.size.normal", INFO_BOOL, "true"},
    {"http://tizen.org/feature/screen.size.normal.720.1280", INFO_BOOL, "true"},
    {"http://tizen.org/feature/screen.auto_rotation", INFO_BOOL, "true"},
    {"http://tizen.org/feature/platform.version", INFO_STRING, "2.4.0"},
    {"http://tizen.org/feature/platform.core.cpu.arch", INFO_STRING, "x86"},
    {"http://tizen.org/feature/camera", INFO_BOOL, "false"},
    {"http://tizen.org/feature/microphone", INFO_BOOL, "true"},
    {"http://tizen.org/feature/network.telephony", INFO_BOOL, "false"},
    {"http://tizen.org/feature/multi_point_touch.point_count", INFO_INT, "1"},
    {"http://tizen.org/system/platform.name", INFO_STRING, "Tizen"},
    {"http://tizen.org/system/model_name", INFO_STRING, "Desktop"},
    {"http://tizen.org/system/manufacturer", INFO_STRING, "Tizen"},
    {"http://tizen.org/system/physical_screen_height", INFO_INT, "114"},
    {"http://tizen.org/system/physical_screen_width", INFO_INT, "64"},
};

static const info_def_t *__findInfo(const char *key)
{
	for (size_t i = 0; i < sizeof(__infos) / sizeof(__infos[0]); i++)
		if (!strcmp(__infos[i].key, key))
			return &__infos[i];
	return NULL;
}

/* The value text of a key: "TIZEN_SYSTEM_INFO_<NAME>" when set, else the default. */
static const char *__valueText(const info_def_t *def)
{
	const char *name = strrchr(def->key, '/') + 1;
	char var[128] = "TIZEN_SYSTEM_INFO_";
	size_t len = strlen(var);
	for (const char *p = name; *p && len < sizeof(var) - 1; p++)
		var[len++] = isalnum((unsigned char)*p) ? (char)toupper((unsigned char)*p) : '_';
	var[len] = '\0';
	const char *env = getenv(var);
	return env && env[0] ? env : def->value;
}

/* Checks the key and the type asked for; the value text in *text on success. */
static int __lookup(const char *key, info_kind_e kind, const char **text)
{
	if (!key) {
		LOGE("key is NULL");
		return SYSTEM_INFO_ERROR_INVALID_PARAMETER;
	}
	const info_def_t *def = __findInfo(key);
	if (!def) {
		LOGE("unknown key %s", key);
		return SYSTEM_INFO_ERROR_INVALID_PARAMETER;
	}
	if (def->kind != kind) {
		LOGE("%s has another type", key);
		return SYSTEM_INFO_ERROR_INVALID_PARAMETER;
	}
	*text = __valueText(def);
	return SYSTEM_INFO_ERROR_NONE;
}

int system_info_get_platform_int(const char *key, int *value)
{
	const char *text = NULL;
	if (!value)
		return SYSTEM_INFO_ERROR_INVALID_PARAMETER;
	int rc = __lookup(key, INFO_INT, &text);
	if (rc != SYSTEM_INFO_ERROR_NONE)
		return rc;
	char *end = NULL;
	errno = 0;
	long v = strtol(text, &end, 10);
	if (errno || end == text || *end || v < INT_MIN || v > INT_MAX) {
		LOGE("%s: bad value \"%s\"", key, text);
		return SYSTEM_INFO_ERROR_IO_ERROR;
	}
	*value = (int)v;
	return SYSTEM_INFO_ERROR_NONE;
}

int system_info_get_platform_bool(const char *key, bool *value)
{
	const char *text = NULL;
	if (!value)
		return SYSTEM_INFO_ERROR_INVALID_PARAMETER;
	int rc = __lookup(key, INFO_BOOL, &text);
	if (rc != SYSTEM_INFO_ERROR_NONE)
		return rc;
	if (!strcmp(text, "true") || !strcmp(text, "1")) {
		*value = true;
	} else if (!strcmp(text, "false") || !strcmp(text, "0")) {
		*value = false;
	} else {
		LOGE("%s: bad value \"%s\"", key, text);
		return SYSTEM_INFO_ERROR_IO_ERROR;
	}
	return SYSTEM_INFO_ERROR_NONE;
}

int system_info_get_platform_double(const char *key, double *value)
{
	const char *text = NULL;
	if (!value)
		return SYSTEM_INFO_ERROR_INVALID_PARAMETER;
	int rc = __lookup(key, INFO_DOUBLE, &text);
	if (rc != SYSTEM_INFO_ERROR_NONE)
		return rc;
	char *end = NULL;
	double v = strtod(text, &end);
	if (end == text || *end) {
		LOGE("%s: bad value \"%s\"", key, text);
		return SYSTEM_INFO_ERROR_IO_ERROR;
	}
	*value = v;
	return SYSTEM_INFO_ERROR_NONE;
}

int system_info_get_platform_string(const char *key, char **value)
{
	const char *text = NULL;
	if (!value)
		return SYSTEM_INFO_ERROR_INVALID_PARAMETER;
	int rc = __lookup(key, INFO_STRING, &text);
	if (rc != SYSTEM_INFO_ERROR_NONE)
		return rc;
	*value = strdup(text);
	return *value ? SYSTEM_INFO_ERROR_NONE : SYSTEM_INFO_ERROR_OUT_OF_MEMORY;
}
