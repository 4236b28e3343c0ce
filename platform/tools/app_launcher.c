/* app_launcher: sends launch requests to apps (starting them when needed), ends them, lists them. */
#include <Ecore.h>
#include <app_control.h>
#include <app_manager.h>
#include <desktop/app_registry.h>

#include <getopt.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#define DEFAULT_REPLY_TIMEOUT_SEC 10.0

enum { EXIT_OK = 0, EXIT_FAILED = 1, EXIT_USAGE = 2 };

static void usage(FILE *out)
{
	fprintf(out,
	        "Usage:\n"
	        "  app_launcher -s <appid> [-o operation] [-u uri] [-m mime] [-d key value]...\n"
	        "               [-a key v1,v2,...]... [-r] [-t timeout]\n"
	        "      send a launch request (the app is started when it is not running);\n"
	        "      -r waits for the reply and prints its result and extra data, -t bounds the wait\n"
	        "      in seconds (default %.0f)\n"
	        "  app_launcher -k <appid>   ask a running app to end\n"
	        "  app_launcher -l           list the registered apps\n",
	        DEFAULT_REPLY_TIMEOUT_SEC);
}

static const char *error_text(int err)
{
	switch (err) {
	case APP_CONTROL_ERROR_APP_NOT_FOUND:
		return "no registered app has this id (see app_launcher -l and TIZEN_APPS_DIR)";
	case APP_CONTROL_ERROR_LAUNCH_FAILED:
		return "the app could not be started";
	case APP_CONTROL_ERROR_TIMED_OUT:
		return "the app did not take the request in time (stopped or hung?)";
	case APP_CONTROL_ERROR_KEY_REJECTED:
		return "the key is reserved";
	case APP_CONTROL_ERROR_INVALID_PARAMETER:
		return "invalid parameter";
	case APP_CONTROL_ERROR_IO_ERROR:
		return "the request could not be sent";
	case APP_CONTROL_ERROR_OUT_OF_MEMORY:
		return "out of memory";
	default:
		return "request failed";
	}
}

static const char *result_text(app_control_result_e result)
{
	switch (result) {
	case APP_CONTROL_RESULT_SUCCEEDED:
		return "succeeded";
	case APP_CONTROL_RESULT_FAILED:
		return "failed";
	case APP_CONTROL_RESULT_CANCELED:
		return "canceled";
	case APP_CONTROL_RESULT_APP_STARTED:
		return "app_started";
	}
	return "unknown";
}

/* ---- the reply ---- */

typedef struct {
	bool done;
	int exit_code;
	Ecore_Timer *timer;
} reply_wait_s;

static bool print_extra_cb(app_control_h reply, const char *key, void *user_data)
{
	(void)user_data;
	bool array = false;
	app_control_is_extra_data_array(reply, key, &array);
	if (!array) {
		char *value = NULL;
		if (app_control_get_extra_data(reply, key, &value) == APP_CONTROL_ERROR_NONE)
			printf("%s=%s\n", key, value);
		free(value);
		return true;
	}
	char **values = NULL;
	int n = 0;
	if (app_control_get_extra_data_array(reply, key, &values, &n) != APP_CONTROL_ERROR_NONE)
		return true;
	printf("%s=", key);
	for (int i = 0; i < n; i++) {
		printf("%s%s", i ? "," : "", values[i]);
		free(values[i]);
	}
	printf("\n");
	free(values);
	return true;
}

static void reply_cb(app_control_h request, app_control_h reply, app_control_result_e result, void *user_data)
{
	(void)request;
	reply_wait_s *wait = user_data;
	printf("result=%s\n", result_text(result));
	app_control_foreach_extra_data(reply, print_extra_cb, NULL);
	fflush(stdout);
	wait->done = true;
	wait->exit_code = result == APP_CONTROL_RESULT_SUCCEEDED ? EXIT_OK : EXIT_FAILED;
	if (result != APP_CONTROL_RESULT_SUCCEEDED)
		fprintf(stderr, "app_launcher: the app answered \"%s\"\n", result_text(result));
	ecore_main_loop_quit();
}

static Eina_Bool reply_timeout_cb(void *data)
{
	reply_wait_s *wait = data;
	wait->timer = NULL;
	ecore_main_loop_quit();
	return ECORE_CALLBACK_CANCEL;
}

/* ---- commands ---- */

/* "v1,v2,..." into the request's extra data array under key. */
static int add_array(app_control_h request, const char *key, const char *list)
{
	char *copy = strdup(list);
	const char **items = calloc(strlen(list) + 1, sizeof(char *));
	int n = 0;
	char *save = NULL;
	for (char *tok = copy ? strtok_r(copy, ",", &save) : NULL; tok && items; tok = strtok_r(NULL, ",", &save))
		items[n++] = tok;
	int ret =
	    items && n ? app_control_add_extra_data_array(request, key, items, n) : APP_CONTROL_ERROR_INVALID_PARAMETER;
	free(items);
	free(copy);
	return ret;
}

static int send_request(app_control_h request, const char *app_id, bool want_reply, double timeout)
{
	reply_wait_s wait = {false, EXIT_FAILED, NULL};
	int ret = app_control_send_launch_request(request, want_reply ? reply_cb : NULL, &wait);
	if (ret != APP_CONTROL_ERROR_NONE) {
		fprintf(stderr, "app_launcher: %s: %s\n", app_id, error_text(ret));
		return EXIT_FAILED;
	}
	if (!want_reply) {
		printf("launch request sent to %s\n", app_id);
		return EXIT_OK;
	}
	wait.timer = ecore_timer_add(timeout, reply_timeout_cb, &wait);
	ecore_main_loop_begin();
	if (wait.timer)
		ecore_timer_del(wait.timer);
	if (!wait.done) {
		fprintf(stderr, "app_launcher: %s: no reply within %.1f s\n", app_id, timeout);
		return EXIT_FAILED;
	}
	return wait.exit_code;
}

static int terminate_app(const char *app_id)
{
	app_control_h request = NULL;
	app_control_create(&request);
	app_control_set_app_id(request, app_id);
	int ret = app_control_send_terminate_request(request);
	app_control_destroy(request);
	if (ret != APP_CONTROL_ERROR_NONE) {
		fprintf(stderr, "app_launcher: %s: %s\n", app_id,
		        ret == APP_CONTROL_ERROR_APP_NOT_FOUND ? "not running" : error_text(ret));
		return EXIT_FAILED;
	}
	printf("asked %s to end\n", app_id);
	return EXIT_OK;
}

static bool list_cb(const char *app_id, const char *exec, void *user_data)
{
	(void)user_data;
	bool running = false;
	app_manager_is_running(app_id, &running);
	printf("%s\t%s\t%s\n", app_id, running ? "running" : "-", exec);
	return true;
}

int main(int argc, char **argv)
{
	/* A command-line tool needs none of the desktop bus services Ecore would probe. */
	setenv("ECORE_NO_SYSTEM_MODULES", "1", 0);
	ecore_init();

	app_control_h request = NULL;
	app_control_create(&request);
	const char *app_id = NULL, *terminate_id = NULL;
	bool list = false, want_reply = false;
	double timeout = DEFAULT_REPLY_TIMEOUT_SEC;
	int exit_code = EXIT_OK;
	int opt;
	while (exit_code == EXIT_OK && (opt = getopt(argc, argv, "+s:o:u:m:d:a:rt:k:lh")) != -1) {
		int ret = APP_CONTROL_ERROR_NONE;
		switch (opt) {
		case 's':
			app_id = optarg;
			ret = app_control_set_app_id(request, optarg);
			break;
		case 'o':
			ret = app_control_set_operation(request, optarg);
			break;
		case 'u':
			ret = app_control_set_uri(request, optarg);
			break;
		case 'm':
			ret = app_control_set_mime(request, optarg);
			break;
		case 'd':
			if (optind >= argc) {
				fprintf(stderr, "app_launcher: -d needs a key and a value\n");
				exit_code = EXIT_USAGE;
				break;
			}
			ret = app_control_add_extra_data(request, optarg, argv[optind++]);
			break;
		case 'a':
			if (optind >= argc) {
				fprintf(stderr, "app_launcher: -a needs a key and a list of values\n");
				exit_code = EXIT_USAGE;
				break;
			}
			ret = add_array(request, optarg, argv[optind++]);
			break;
		case 'r':
			want_reply = true;
			break;
		case 't': {
			char *end = NULL;
			timeout = strtod(optarg, &end);
			if (!end || end == optarg || *end || !(timeout > 0)) {
				fprintf(stderr, "app_launcher: bad timeout \"%s\"\n", optarg);
				exit_code = EXIT_USAGE;
			}
			break;
		}
		case 'k':
			terminate_id = optarg;
			break;
		case 'l':
			list = true;
			break;
		case 'h':
			usage(stdout);
			exit_code = -1;
			break;
		default:
			usage(stderr);
			exit_code = EXIT_USAGE;
			break;
		}
		if (ret != APP_CONTROL_ERROR_NONE) {
			fprintf(stderr, "app_launcher: -%c %s: %s\n", opt, optarg, error_text(ret));
			exit_code = EXIT_USAGE;
		}
	}
	if (exit_code == EXIT_OK && optind < argc) {
		fprintf(stderr, "app_launcher: unexpected argument \"%s\"\n", argv[optind]);
		exit_code = EXIT_USAGE;
	}
	if (exit_code == EXIT_OK) {
		if (list)
			desktop_app_registry_foreach(list_cb, NULL);
		else if (terminate_id)
			exit_code = terminate_app(terminate_id);
		else if (app_id)
			exit_code = send_request(request, app_id, want_reply, timeout);
		else {
			fprintf(stderr, "app_launcher: name the app with -s <appid> (or use -k or -l)\n");
			usage(stderr);
			exit_code = EXIT_USAGE;
		}
	}
	app_control_destroy(request);
	ecore_shutdown();
	return exit_code < 0 ? EXIT_OK : exit_code;
}
