/* A process that logs on its running main loop and then ends in one of the ways a log must survive:
     test_log_end crash | fatal | exit | idle
   Each first logs the error line "gathered error" and the info line "gathered info" from a timer. crash then
   dies of SIGSEGV and fatal logs "fatal line" and aborts, both before the loop goes idle; exit leaves main;
   idle checks that the lines reached the log file only once the loop went idle (status 0, else 1). It
   inherits TIZEN_APP_ROOT, so it logs into the data folder of the test that starts it. */
#include <Ecore.h>
#include <app_common.h>
#include <dlog.h>
#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

static const char *mode;
static int status = 1;

static int log_has(const char *what)
{
	char *dir = app_get_data_path();
	char path[4096];
	snprintf(path, sizeof(path), "%sdlog.log", dir ? dir : "");
	free(dir);
	FILE *file = fopen(path, "r");
	char line[8192];
	int found = 0;
	while (file && !found && fgets(line, sizeof(line), file))
		found = strstr(line, what) != NULL;
	if (file)
		fclose(file);
	return found;
}

static Eina_Bool check_cb(void *data)
{
	(void)data;
	status = (status == 0 && log_has("gathered error")) ? 0 : 1;
	ecore_main_loop_quit();
	return ECORE_CALLBACK_CANCEL;
}

static Eina_Bool log_cb(void *data)
{
	(void)data;
	dlog_print(DLOG_ERROR, "TEST", "gathered error");
	dlog_print(DLOG_INFO, "TEST", "gathered info");
	if (!strcmp(mode, "crash"))
		raise(SIGSEGV);
	if (!strcmp(mode, "fatal")) {
		dlog_print(DLOG_FATAL, "TEST", "fatal line");
		abort();
	}
	if (!strcmp(mode, "idle")) {
		status = log_has("gathered error") ? 1 : 0;
		ecore_timer_add(0.05, check_cb, NULL);
	} else {
		status = 0;
		ecore_main_loop_quit();
	}
	return ECORE_CALLBACK_CANCEL;
}

int main(int argc, char **argv)
{
	if (argc < 2)
		return 2;
	mode = argv[1];
	ecore_init();
	ecore_timer_add(0.0, log_cb, NULL);
	ecore_main_loop_begin();
	ecore_shutdown();
	return status;
}
