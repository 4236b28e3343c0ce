/* A second process that changes one preference or vconf key, for cross-process notice tests.
   It inherits TIZEN_APP_ROOT and TIZEN_VCONF_DIR, so it writes the stores of the test that starts it.
     test_writer pref-int <key> <value> | pref-string <key> <value> | pref-remove <key>
     test_writer vconf-int <key> <value> | vconf-str <key> <value>
   Exit status 0 when the call succeeded, 1 when it failed, 2 on bad arguments. */
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <app_preference.h>
#include <vconf.h>

int main(int argc, char **argv)
{
	if (argc < 3) {
		fprintf(stderr, "usage: %s <pref-int|pref-string|pref-remove|vconf-int|vconf-str> <key> [value]\n", argv[0]);
		return 2;
	}
	const char *what = argv[1];
	const char *key = argv[2];
	const char *value = argc > 3 ? argv[3] : NULL;
	int rc;
	if (!strcmp(what, "pref-remove"))
		rc = preference_remove(key) == PREFERENCE_ERROR_NONE;
	else if (!value)
		return 2;
	else if (!strcmp(what, "pref-int"))
		rc = preference_set_int(key, atoi(value)) == PREFERENCE_ERROR_NONE;
	else if (!strcmp(what, "pref-string"))
		rc = preference_set_string(key, value) == PREFERENCE_ERROR_NONE;
	else if (!strcmp(what, "vconf-int"))
		rc = vconf_set_int(key, atoi(value)) == VCONF_OK;
	else if (!strcmp(what, "vconf-str"))
		rc = vconf_set_str(key, value) == VCONF_OK;
	else
		return 2;
	return rc ? 0 : 1;
}
