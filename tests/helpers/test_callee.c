/* A small app for the launch tests. Each request it gets is written to "$TEST_CALLEE_DIR/<app id>.log":
   "request first=<0|1> op=<operation>", "caller=<id>", "uri=<uri>" and "mime=<type>" when set, then
   "extra <key>=<value>" (arrays "a,b"), then "end".
   The request's extra data steer it: "reply" = succeeded|failed answers with the request's extra data
   plus "echo"="<app id>"; "die" = 1 ends the process at once without answering; "quit" = 1 ends it
   normally. Events are logged too ("pause", "resume", "terminate").
   A file "$TEST_CALLEE_DIR/<app id>.reply" answers every request as well, for requests whose extra data the
   test cannot choose: a line "result=succeeded|failed|canceled", lines "extra <key>=<value>" and
   "array <key>=<a>,<b>" (an empty value gives no entry); the reply also carries the request's extra data. */
#include <Elementary.h>
#include <app.h>

#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

static int requests_seen;

static void log_line(const char *fmt, const char *a, const char *b)
{
	const char *dir = getenv("TEST_CALLEE_DIR");
	char *id = NULL;
	app_get_id(&id);
	char path[4096];
	snprintf(path, sizeof(path), "%s/%s.log", dir ? dir : "/tmp", id ? id : "unknown");
	free(id);
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

static void answer(app_control_h request, app_control_result_e result)
{
	app_control_h reply = NULL;
	app_control_create(&reply);
	app_control_foreach_extra_data(request, copy_extra_cb, reply);
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

/* Answers from the reply file, if the test left one. */
static void answer_from_file(app_control_h request)
{
	const char *dir = getenv("TEST_CALLEE_DIR");
	char *id = NULL;
	app_get_id(&id);
	char path[4096];
	snprintf(path, sizeof(path), "%s/%s.reply", dir ? dir : "/tmp", id ? id : "unknown");
	free(id);
	FILE *f = fopen(path, "r");
	if (!f)
		return;
	app_control_h reply = NULL;
	app_control_create(&reply);
	app_control_foreach_extra_data(request, copy_extra_cb, reply);
	app_control_result_e result = APP_CONTROL_RESULT_SUCCEEDED;
	char line[4096];
	while (fgets(line, sizeof(line), f)) {
		line[strcspn(line, "\n")] = '\0';
		char *eq = strchr(line, '=');
		if (!eq)
			continue;
		*eq = '\0';
		const char *value = eq + 1;
		if (!strcmp(line, "result")) {
			result = !strcmp(value, "failed")     ? APP_CONTROL_RESULT_FAILED
			         : !strcmp(value, "canceled") ? APP_CONTROL_RESULT_CANCELED
			                                      : APP_CONTROL_RESULT_SUCCEEDED;
		} else if (!strncmp(line, "extra ", 6)) {
			app_control_add_extra_data(reply, line + 6, value);
		} else if (!strncmp(line, "array ", 6)) {
			const char *items[64];
			int n = 0;
			char *save = NULL;
			for (char *tok = strtok_r((char *)value, ",", &save); tok && n < 64; tok = strtok_r(NULL, ",", &save))
				items[n++] = tok;
			app_control_add_extra_data_array(reply, line + 6, items, n);
		}
	}
	fclose(f);
	int ret = app_control_reply_to_launch_request(reply, request, result);
	char code[16];
	snprintf(code, sizeof(code), "%d", ret);
	log_line("replied %s%s", code, NULL);
	app_control_destroy(reply);
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
	app_control_get_uri(request, &uri);
	app_control_get_mime(request, &mime);
	if (uri)
		log_line("uri=%s%s", uri, NULL);
	if (mime)
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
		answer(request, APP_CONTROL_RESULT_SUCCEEDED);
	else if (extra_is(request, "reply", "failed"))
		answer(request, APP_CONTROL_RESULT_FAILED);
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
