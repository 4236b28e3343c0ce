/* The UI application lifecycle: create, requests, pause/resume from the windows, terminate. */
#include <Elementary.h>
#include <app.h>

#include "app_private.h"
#include "dlog_private.h"

#include <dlog.h>
#include <stdlib.h>
#include <string.h>

/* How long a started app waits for the request that started it before it falls back to argv. */
#define FIRST_REQUEST_WAIT_SEC 5.0

static struct {
	bool running;
	bool exit_requested;
	bool first_done;
	bool paused;
	ui_app_lifecycle_callback_s callback;
	void *user_data;
	app_control_h argv_request;
	Ecore_Timer *wait_timer;
	Ecore_Event_Handler *signal_exit_handler;
	Eina_List *hooked_windows;
} app;

/* ---- argv -> request ---- */

/* "k=v" into the extra data of request. */
static void argv_extra_add(app_control_h request, const char *pair, bool array)
{
	const char *eq = strchr(pair, '=');
	if (!eq || eq == pair) {
		LOGE("ignored argument \"%s\": expected key=value", pair);
		return;
	}
	char *key = strndup(pair, eq - pair);
	if (!array) {
		app_control_add_extra_data(request, key, eq + 1);
		free(key);
		return;
	}
	char *values = strdup(eq + 1);
	const char **items = NULL;
	int n = 0;
	char *save = NULL;
	for (char *tok = strtok_r(values, ",", &save); tok; tok = strtok_r(NULL, ",", &save)) {
		const char **grown = realloc(items, (n + 1) * sizeof(char *));
		if (!grown)
			break;
		items = grown;
		items[n++] = tok;
	}
	if (n)
		app_control_add_extra_data_array(request, key, items, n);
	free(items);
	free(values);
	free(key);
}

/* The request given on the command line: --operation, --uri, --mime, --extra k=v, --extra-array k=a,b. */
static app_control_h argv_request_new(int argc, char **argv)
{
	app_control_h request = NULL;
	if (app_control_create(&request) != APP_CONTROL_ERROR_NONE)
		return NULL;
	app_control_set_operation(request, APP_CONTROL_OPERATION_MAIN);
	for (int i = 1; i + 1 < argc; i++) {
		const char *opt = argv[i];
		const char *value = argv[i + 1];
		if (!strcmp(opt, "--operation"))
			app_control_set_operation(request, value);
		else if (!strcmp(opt, "--uri"))
			app_control_set_uri(request, value);
		else if (!strcmp(opt, "--mime"))
			app_control_set_mime(request, value);
		else if (!strcmp(opt, "--extra"))
			argv_extra_add(request, value, false);
		else if (!strcmp(opt, "--extra-array"))
			argv_extra_add(request, value, true);
		else
			continue;
		i++;
	}
	return request;
}

/* ---- pause / resume ---- */

static void lifecycle_pause(void)
{
	if (app.paused || !app.first_done)
		return;
	app.paused = true;
	if (app.callback.pause)
		app.callback.pause(app.user_data);
}

static void lifecycle_resume(void)
{
	if (!app.paused || !app.first_done)
		return;
	app.paused = false;
	if (app.callback.resume)
		app.callback.resume(app.user_data);
}

static void win_iconified_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	lifecycle_pause();
}

static void win_shown_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	lifecycle_resume();
}

static void win_delete_request_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	LOGI("main window closed");
	ui_app_exit();
}

static void win_unhook(Evas_Object *win);

static void win_del_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)e;
	(void)event_info;
	win_unhook(obj);
}

/* Follows each window's state; closing a window that existed right after create ends the app. */
static void windows_hook(bool main_windows)
{
	Eina_List *windows = app_window_list_get();
	Evas_Object *win;
	EINA_LIST_FREE(windows, win)
	{
		if (eina_list_data_find(app.hooked_windows, win))
			continue;
		app.hooked_windows = eina_list_append(app.hooked_windows, win);
		evas_object_smart_callback_add(win, "iconified", win_iconified_cb, NULL);
		evas_object_smart_callback_add(win, "normal", win_shown_cb, NULL);
		evas_object_smart_callback_add(win, "focused", win_shown_cb, NULL);
		if (main_windows)
			evas_object_smart_callback_add(win, "delete,request", win_delete_request_cb, NULL);
		evas_object_event_callback_add(win, EVAS_CALLBACK_DEL, win_del_cb, NULL);
	}
}

static void win_unhook(Evas_Object *win)
{
	app.hooked_windows = eina_list_remove(app.hooked_windows, win);
	evas_object_smart_callback_del_full(win, "iconified", win_iconified_cb, NULL);
	evas_object_smart_callback_del_full(win, "normal", win_shown_cb, NULL);
	evas_object_smart_callback_del_full(win, "focused", win_shown_cb, NULL);
	evas_object_smart_callback_del_full(win, "delete,request", win_delete_request_cb, NULL);
	evas_object_event_callback_del_full(win, EVAS_CALLBACK_DEL, win_del_cb, NULL);
}

static void windows_unhook_all(void)
{
	while (app.hooked_windows)
		win_unhook(eina_list_data_get(app.hooked_windows));
}

/* SIGTERM, SIGINT and SIGQUIT end the app like a closed window: terminate runs, so nothing open is lost. */
static Eina_Bool signal_exit_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	(void)event;
	LOGI("asked to end by a signal");
	ui_app_exit();
	return ECORE_CALLBACK_PASS_ON;
}

/* ---- requests ---- */

bool app_main_is_running(void)
{
	return app.running;
}

void app_main_raise(void)
{
	if (app.running)
		app_window_raise_all();
}

void app_main_deliver_request(app_control_h request)
{
	if (!app.running || app.exit_requested)
		return;
	bool first = !app.first_done;
	if (app.wait_timer) {
		ecore_timer_del(app.wait_timer);
		app.wait_timer = NULL;
	}
	if (!first)
		app_main_raise();
	if (app.callback.app_control)
		app.callback.app_control(request, app.user_data);
	if (first) {
		app.first_done = true;
		windows_hook(false);
		lifecycle_resume();
		app_screenshot_schedule();
	}
}

static Eina_Bool first_request_timeout_cb(void *data)
{
	(void)data;
	app.wait_timer = NULL;
	LOGE("the request that started the app did not come: using the command line");
	app_main_deliver_request(app.argv_request);
	return ECORE_CALLBACK_CANCEL;
}

/* ---- main ---- */

/* Hands the command-line request to the running instance of app_id; false when there is none. */
static bool forward_to_running(const char *app_id)
{
	if (app_launch_forward(app.argv_request, app_id) != APP_CONTROL_ERROR_NONE)
		return false;
	LOGI("%s is running already: request handed over", app_id);
	return true;
}

static void app_state_reset(void)
{
	if (app.argv_request)
		app_control_destroy(app.argv_request);
	memset(&app, 0, sizeof(app));
}

/* Runs create, the first request and the main loop; false when create refused. */
static bool app_run(void)
{
	/* The lines of create and of the first request wait with those of the loop's first steps. */
	dlog_gather_main_thread(true);
	app_event_language_apply();
	app_event_watch_start();
	app.signal_exit_handler = ecore_event_handler_add(ECORE_EVENT_SIGNAL_EXIT, signal_exit_cb, NULL);
	bool created = !app.callback.create || app.callback.create(app.user_data);
	if (created && !app.exit_requested) {
		windows_hook(true);
		app_event_rotation_apply();
		const char *wait = getenv(APP_LAUNCH_WAIT_ENV);
		bool wait_for_request = wait && !strcmp(wait, "1");
		/* Apps this one starts must not inherit the mark. */
		unsetenv(APP_LAUNCH_WAIT_ENV);
		if (wait_for_request)
			app.wait_timer = ecore_timer_add(FIRST_REQUEST_WAIT_SEC, first_request_timeout_cb, NULL);
		else
			app_main_deliver_request(app.argv_request);
		if (!app.exit_requested)
			elm_run();
	}
	if (app.wait_timer)
		ecore_timer_del(app.wait_timer);
	app.wait_timer = NULL;
	app_screenshot_cancel();
	if (created) {
		lifecycle_pause();
		if (app.callback.terminate)
			app.callback.terminate(app.user_data);
	}
	windows_unhook_all();
	app_event_watch_stop();
	ecore_event_handler_del(app.signal_exit_handler);
	app.signal_exit_handler = NULL;
	dlog_gather_main_thread(false);
	return created;
}

int ui_app_main(int argc, char **argv, ui_app_lifecycle_callback_s *callback, void *user_data)
{
	if (!callback || argc < 0 || (argc > 0 && !argv)) {
		LOGE("invalid parameter");
		return APP_ERROR_INVALID_PARAMETER;
	}
	if (app.running) {
		LOGE("the application is running already");
		return APP_ERROR_ALREADY_RUNNING;
	}
	char *app_id = app_paths_app_id_get();
	if (!app_id) {
		LOGE("no app id");
		return APP_ERROR_INVALID_CONTEXT;
	}
	ecore_init();
	app.argv_request = argv_request_new(argc, argv);
	app.callback = *callback;
	app.user_data = user_data;
	app.paused = true;

	/* One instance per app id: a second one hands its request over and ends. The owner may be
	   ending right now, so a failed hand-over retries once for the socket. */
	bool owner = app_server_start(app_id);
	if (!owner && forward_to_running(app_id)) {
		app_state_reset();
		ecore_shutdown();
		free(app_id);
		return APP_ERROR_NONE;
	}
	if (!owner && !app_server_start(app_id))
		LOGE("cannot take launch requests for %s: running without them", app_id);

	elm_init(argc, argv);
	app.running = true;
	LOGI("%s starts", app_id);
	bool created = app_run();
	LOGI("%s ends", app_id);
	app_server_stop();
	app_state_reset();
	elm_shutdown();
	ecore_shutdown();
	free(app_id);
	return created ? APP_ERROR_NONE : APP_ERROR_INVALID_CONTEXT;
}

void ui_app_exit(void)
{
	if (!app.running) {
		LOGE("the application is not running");
		return;
	}
	app.exit_requested = true;
	/* Before the main loop starts, the flag alone keeps it from starting. */
	if (ecore_main_loop_nested_get() > 0)
		elm_exit();
}
