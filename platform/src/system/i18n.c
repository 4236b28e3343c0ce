/* Message lookup in the package's gettext domain (the app id). */
#define _GNU_SOURCE
#include <app_i18n.h>

#include <libintl.h>
#include <locale.h>
#include <pthread.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <app_common.h>
#include <dlog.h>

static pthread_once_t __bindOnce = PTHREAD_ONCE_INIT;
static char *__domain;
static locale_t __utf8Locale;

/* Binds the domain lazily, so that the resource path and app id are final by the time of the first
   lookup, and needs no global textdomain() that would clash with a library's. */
static void __bindDomain(void)
{
	char *id = NULL;
	if (app_get_id(&id) != 0 || !id) {
		LOGE("no app id: translations are off");
		return;
	}
	char *res = app_get_resource_path();
	char *dir = NULL;
	if (!res || asprintf(&dir, "%slocale", res) < 0)
		dir = NULL;
	free(res);
	if (!dir) {
		LOGE("no resource path: translations are off");
		free(id);
		return;
	}
	if (!bindtextdomain(id, dir) || !bind_textdomain_codeset(id, "UTF-8")) {
		LOGE("cannot bind %s to %s", id, dir);
		free(id);
		free(dir);
		return;
	}
	LOGI("messages of %s from %s", id, dir);
	free(dir);
	__domain = id;
	/* gettext ignores LANGUAGE under the plain "C" locale, which is what a process gets when the
	   device language has no installed system locale; C.UTF-8 keeps LANGUAGE in force. */
	__utf8Locale = newlocale(LC_MESSAGES_MASK, "C.UTF-8", (locale_t)0);
}

static pthread_mutex_t __languageLock = PTHREAD_MUTEX_INITIALIZER;
static char *__lastLanguage;

/* gettext caches each lookup under the locale name, not under LANGUAGE, and drops the cache only
   on a successful setlocale. A device language without an installed locale changes LANGUAGE alone,
   so re-announce the text domain (gettext's own signal for changed environment) when it moves. */
static void __noticeLanguageChange(void)
{
	const char *language = getenv("LANGUAGE");
	pthread_mutex_lock(&__languageLock);
	bool changed =
	    (language == NULL) != (__lastLanguage == NULL) || (language && strcmp(language, __lastLanguage) != 0);
	if (changed) {
		free(__lastLanguage);
		__lastLanguage = language ? strdup(language) : NULL;
		textdomain(textdomain(NULL));
	}
	pthread_mutex_unlock(&__languageLock);
}

static bool __isPlainCLocale(void)
{
	const char *name = setlocale(LC_MESSAGES, NULL);
	return !name || !strcmp(name, "C") || !strcmp(name, "POSIX");
}

char *i18n_get_text(const char *message)
{
	if (!message)
		return NULL;
	pthread_once(&__bindOnce, __bindDomain);
	if (!__domain)
		return (char *)message;
	__noticeLanguageChange();
	if (__utf8Locale && __isPlainCLocale()) {
		locale_t previous = uselocale(__utf8Locale);
		char *text = dgettext(__domain, message);
		uselocale(previous);
		return text;
	}
	return dgettext(__domain, message);
}
