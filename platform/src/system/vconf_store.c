/* Where vconf keys live, and what the device reports for keys nobody has set yet. */
#define _GNU_SOURCE
#include "system/vconf_store.h"

#include <ctype.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <vconf-keys.h>

char *vconf_store_dir_n(void)
{
	char *dir = NULL;
	const char *env = getenv("TIZEN_VCONF_DIR");
	if (env && env[0]) {
		size_t len = strlen(env);
		if (asprintf(&dir, "%s%s", env, env[len - 1] == '/' ? "" : "/") < 0)
			dir = NULL;
		return dir;
	}
	const char *config = getenv("XDG_CONFIG_HOME");
	if (config && config[0]) {
		if (asprintf(&dir, "%s/tizen-platform/vconf/", config) < 0)
			dir = NULL;
		return dir;
	}
	const char *home = getenv("HOME");
	if (!home || !home[0])
		return NULL;
	if (asprintf(&dir, "%s/.config/tizen-platform/vconf/", home) < 0)
		dir = NULL;
	return dir;
}

bool vconf_store_key_valid(const char *key)
{
	if (!key)
		return false;
	static const char *const prefixes[] = {"db/", "file/", "memory/"};
	for (size_t i = 0; i < sizeof(prefixes) / sizeof(prefixes[0]); i++) {
		size_t len = strlen(prefixes[i]);
		if (!strncmp(key, prefixes[i], len) && key[len])
			return true;
	}
	return false;
}

/* A locale name in the form the phone stores, "ll_CC.UTF-8", from $LANG; "en_US.UTF-8" when $LANG
   is unset or names no language (C, POSIX). */
static char *__localeFromEnvN(void)
{
	const char *lang = getenv("LANG");
	size_t len = 0;
	if (lang)
		while (lang[len] && lang[len] != '.' && lang[len] != '@')
			len++;
	bool valid = len >= 2 && islower((unsigned char)lang[0]) && islower((unsigned char)lang[1]);
	for (size_t i = 0; valid && i < len; i++)
		valid = isalpha((unsigned char)lang[i]) || lang[i] == '_';
	if (!valid)
		return strdup("en_US.UTF-8");
	char *locale = NULL;
	if (asprintf(&locale, "%.*s.UTF-8", (int)len, lang) < 0)
		locale = NULL;
	return locale;
}

bool vconf_store_seed(const char *key, key_file_value_t *value)
{
	if (!key || !value)
		return false;
	memset(value, 0, sizeof(*value));
	if (!strcmp(key, VCONFKEY_LANGSET) || !strcmp(key, VCONFKEY_REGIONFORMAT)) {
		value->s = __localeFromEnvN();
		value->type = value->s ? KEY_FILE_TYPE_STRING : KEY_FILE_TYPE_NONE;
		return value->s != NULL;
	}
	if (!strcmp(key, VCONFKEY_REGIONFORMAT_TIME1224)) {
		value->type = KEY_FILE_TYPE_INT;
		value->i = VCONFKEY_TIME_FORMAT_12;
		return true;
	}
	if (!strcmp(key, VCONFKEY_CALL_STATE) || !strcmp(key, VCONFKEY_SETAPPL_PSMODE)) {
		value->type = KEY_FILE_TYPE_INT;
		value->i = 0;
		return true;
	}
	return false;
}
