/* A small app for the launch tests. Each request it gets is written to "$TEST_CALLEE_DIR/<app id>.log":
   "request first=<0|1> op=<operation>", "caller=<id>", "uri=<uri>" and "mime=<type>" when set, then
   "extra <key>=<value>" (arrays "a,b"), then "end".
   The request's extra data steer it: "reply" = succeeded|failed answers with the request's extra data
   plus "echo"="<app id>"; "die" = 1 ends the process at once without answering; "quit" = 1 ends it
   normally. Events are logged too ("pause", "resume", "terminate").
   Requests whose extra data the test cannot choose are answered from "$TEST_CALLEE_DIR/<app id>.reply" when
   it exists: its first line is the result ("succeeded" or "canceled"), the lines after it the paths of the
   array ".../data/selected"; the request's extra data go back too. */
#include <Elementary.h>
#include <app.h>

#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

static int requests_seen;

/* "$TEST_CALLEE_DIR/<app id><suffix>" */
static void callee_path(char *path, size_t size, const char *suffix)
{
	const char *dir = getenv("TEST_CALLEE_DIR");
	char *id = NULL;
	app_get_id(&id);
	snprintf(path, size, "%s/%s%s", dir ? dir : "/tmp", id ? id : "unknown", suffix);
	free(id);
}

static void log_line(const char *fmt, const char *a, const char *b)
{
	char path[4096];
	callee_path(path, sizeof(path), ".log");
	FILE *f = fopen(path, "a");
	if (!f)
		return;
	fprintf(f, fmt, a ? a : "", b ? b : "");
	fputc('\n', f);
	fclose(f);
}

static bool log_extra_cb(app_control_h request, const char *key, void *user_data)
{
	(void)user_data;
	bool array = false;
	app_control_is_extra_data_array(request, key, &array);
	if (!array) {
		char *value = NULL;
		app_control_get_extra_data(request, key, &value);
		log_line("extra %s=%s", key, value);
		free(value);
		return true;
	}
	char **values = NULL;
	int n = 0;
	app_control_get_extra_data_array(request, key, &values, &n);
	char joined[4096] = "";
	for (int i = 0; i < n; i++) {
		if (i)
			strncat(joined, ",", sizeof(joined) - strlen(joined) - 1);
		strncat(joined, values[i], sizeof(joined) - strlen(joined) - 1);
		free(values[i]);
	}
	free(values);
	log_line("extra %s=%s", key, joined);
	return true;
}

static bool copy_extra_cb(app_control_h request, const char *key, void *user_data)
{
	app_control_h reply = user_data;
	bool array = false;
	app_control_is_extra_data_array(request, key, &array);
	if (array) {
		char **values = NULL;
		int n = 0;
		app_control_get_extra_data_array(request, key, &values, &n);
		app_control_add_extra_data_array(reply, key, (const char **)values, n);
		for (int i = 0; i < n; i++)
			free(values[i]);
		free(values);
	} else {
		char *value = NULL;
		app_control_get_extra_data(request, key, &value);
		app_control_add_extra_data(reply, key, value);
		free(value);
	}
	return true;
}

static bool extra_is(app_control_h request, const char *key, const char *expected)
{
	char *value = NULL;
	bool match = app_control_get_extra_data(request, key, &value) == APP_CONTROL_ERROR_NONE && !strcmp(value, expected);
	free(value);
	return match;
}

static void answer(app_control_h request, app_control_result_e result, const char **selected, int count)
{
	app_control_h reply = NULL;
	app_control_create(&reply);
	app_control_foreach_extra_data(request, copy_extra_cb, reply);
	if (count > 0)
		app_control_add_extra_data_array(reply, APP_CONTROL_DATA_SELECTED, selected, count);
	char *id = NULL;
	app_get_id(&id);
	app_control_add_extra_data(reply, "echo", id);
	free(id);
	int ret = app_control_reply_to_launch_request(reply, request, result);
	char code[16];
	snprintf(code, sizeof(code), "%d", ret);
	log_line("replied %s%s", code, NULL);
	app_control_destroy(reply);
}

static void answer_from_file(app_control_h request)
{
	char path[4096], line[4096];
	callee_path(path, sizeof(path), ".reply");
	FILE *f = fopen(path, "r");
	if (!f)
		return;
	bool canceled = fgets(line, sizeof(line), f) && !strncmp(line, "canceled", 8);
	char *selected[16];
	int n = 0;
	while (n < 16 && fgets(line, sizeof(line), f)) {
		line[strcspn(line, "\n")] = '\0';
		selected[n++] = strdup(line);
	}
	fclose(f);
	answer(request, canceled ? APP_CONTROL_RESULT_CANCELED : APP_CONTROL_RESULT_SUCCEEDED, (const char **)selected, n);
	while (n > 0)
		free(selected[--n]);
}

static void request_cb(app_control_h request, void *user_data)
{
	(void)user_data;
	char *op = NULL, *caller = NULL;
	app_control_get_operation(request, &op);
	app_control_get_caller(request, &caller);
	char head[64];
	snprintf(head, sizeof(head), "request first=%d", requests_seen++ == 0);
	log_line("%s op=%s", head, op);
	log_line("caller=%s%s", caller ? caller : "-", NULL);
	char *uri = NULL, *mime = NULL;
	if (app_control_get_uri(request, &uri) == APP_CONTROL_ERROR_NONE && uri)
		log_line("uri=%s%s", uri, NULL);
	if (app_control_get_mime(request, &mime) == APP_CONTROL_ERROR_NONE && mime)
		log_line("mime=%s%s", mime, NULL);
	free(uri);
	free(mime);
	free(op);
	free(caller);
	app_control_foreach_extra_data(request, log_extra_cb, NULL);
	log_line("end%s%s", NULL, NULL);

	if (extra_is(request, "die", "1"))
		_exit(3);
	if (extra_is(request, "reply", "succeeded"))
		answer(request, APP_CONTROL_RESULT_SUCCEEDED, NULL, 0);
	else if (extra_is(request, "reply", "failed"))
		answer(request, APP_CONTROL_RESULT_FAILED, NULL, 0);
	else
		answer_from_file(request);
	if (extra_is(request, "quit", "1"))
		ui_app_exit();
}

static bool create_cb(void *user_data)
{
	(void)user_data;
	Evas_Object *win = elm_win_util_standard_add("test_callee", "test_callee");
	evas_object_resize(win, 120, 80);
	evas_object_show(win);
	log_line("create%s%s", NULL, NULL);
	return true;
}

static void pause_cb(void *user_data)
{
	(void)user_data;
	log_line("pause%s%s", NULL, NULL);
}

static void resume_cb(void *user_data)
{
	(void)user_data;
	log_line("resume%s%s", NULL, NULL);
}

static void terminate_cb(void *user_data)
{
	(void)user_data;
	log_line("terminate%s%s", NULL, NULL);
}

int main(int argc, char **argv)
{
	ui_app_lifecycle_callback_s cb = {create_cb, terminate_cb, pause_cb, resume_cb, request_cb};
	return ui_app_main(argc, argv, &cb, NULL);
}
