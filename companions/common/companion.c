/* The companion skeleton: lifecycle, the kept request and its answer, folders, test hooks. */
#define _GNU_SOURCE
#include "companion.h"

#include <app.h>
#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>

#define TEST_CLICK_POLL_SEC 0.1
#define TEST_CLICK_TRIES 150

static struct {
	const companion_app_s *app;
	Evas_Object *win;
	Evas_Object *box;
	app_control_h request;
	bool answered;
	Ecore_Timer *click_timer;
	int click_tries;
} self;

Evas_Object *companion_window_get(void)
{
	return self.win;
}

app_control_h companion_request_get(void)
{
	return self.request;
}

bool companion_request_wants_reply(void)
{
	bool wanted = false;
	if (self.request && !self.answered)
		app_control_is_reply_requested(self.request, &wanted);
	return wanted;
}

bool companion_request_answer(app_control_result_e result, app_control_h reply)
{
	if (!self.request || self.answered)
		return false;
	self.answered = true;
	app_control_h empty = NULL;
	if (!reply && app_control_create(&empty) == APP_CONTROL_ERROR_NONE)
		reply = empty;
	int ret = app_control_reply_to_launch_request(reply, self.request, result);
	if (empty)
		app_control_destroy(empty);
	if (ret != APP_CONTROL_ERROR_NONE)
		LOGE("cannot answer the request (0x%08x)", (unsigned int)ret);
	return ret == APP_CONTROL_ERROR_NONE;
}

bool companion_request_answer_paths(app_control_result_e result, const char *key, const char **paths, int count)
{
	app_control_h reply = NULL;
	if (app_control_create(&reply) != APP_CONTROL_ERROR_NONE)
		return false;
	if (count > 0)
		app_control_add_extra_data_array(reply, key, paths, count);
	bool ok = companion_request_answer(result, reply);
	app_control_destroy(reply);
	return ok;
}

static void request_keep(app_control_h request)
{
	/* A request replaced before it was answered leaves its sender waiting otherwise. */
	companion_request_answer(APP_CONTROL_RESULT_CANCELED, NULL);
	if (self.request)
		app_control_destroy(self.request);
	self.request = NULL;
	self.answered = false;
	if (app_control_clone(&self.request, request) != APP_CONTROL_ERROR_NONE)
		LOGE("cannot keep the request");
}

char *companion_extra_get(app_control_h request, const char *key)
{
	char *value = NULL;
	if (!request || app_control_get_extra_data(request, key, &value) != APP_CONTROL_ERROR_NONE)
		return NULL;
	return value;
}

char **companion_extra_paths_get(app_control_h request, const char *key, int *count)
{
	*count = 0;
	bool array = false;
	if (!request || app_control_is_extra_data_array(request, key, &array) != APP_CONTROL_ERROR_NONE)
		return NULL;
	char **values = NULL;
	if (array) {
		if (app_control_get_extra_data_array(request, key, &values, count) != APP_CONTROL_ERROR_NONE)
			*count = 0;
		return values;
	}
	char *value = companion_extra_get(request, key);
	if (!value || !(values = malloc(sizeof(char *)))) {
		free(value);
		return NULL;
	}
	values[0] = value;
	*count = 1;
	return values;
}

void companion_strings_free(char **strings, int count)
{
	for (int i = 0; strings && i < count; i++)
		free(strings[i]);
	free(strings);
}

char *companion_path_from_uri(const char *uri)
{
	if (!uri)
		return NULL;
	if (!strncmp(uri, "file://", 7))
		uri += 7;
	return uri[0] == '/' ? strdup(uri) : NULL;
}

static bool is_dir(const char *path)
{
	struct stat st;
	return path && stat(path, &st) == 0 && S_ISDIR(st.st_mode);
}

/* What `xdg-user-dir <kind>` prints, without the line end (malloc'ed), or NULL. */
static char *xdg_user_dir_new(const char *kind)
{
	char cmd[128];
	snprintf(cmd, sizeof(cmd), "xdg-user-dir %s 2>/dev/null", kind);
	FILE *p = popen(cmd, "r");
	if (!p)
		return NULL;
	char line[4096] = "";
	char *got = fgets(line, sizeof(line), p);
	pclose(p);
	if (!got)
		return NULL;
	line[strcspn(line, "\n")] = '\0';
	return line[0] ? strdup(line) : NULL;
}

char *companion_user_dir_get(const char *kind, const char *fallback, bool create)
{
	const char *home = getenv("HOME");
	if (!home || !*home)
		home = "/";
	char *dir = xdg_user_dir_new(kind);
	if (dir && is_dir(dir) && strcmp(dir, home))
		return dir;
	free(dir);
	if (asprintf(&dir, "%s/%s", home, fallback) >= 0 && (is_dir(dir) || (create && ecore_file_mkpath(dir))))
		return dir;
	free(dir);
	return strdup(home);
}

Evas_Object *companion_label_add(Evas_Object *box, const char *text)
{
	Evas_Object *label = elm_label_add(box);
	elm_label_line_wrap_set(label, ELM_WRAP_WORD);
	elm_object_text_set(label, text);
	evas_object_size_hint_weight_set(label, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(label, EVAS_HINT_FILL, 0.5);
	elm_box_pack_end(box, label);
	evas_object_show(label);
	return label;
}

Evas_Object *companion_button_add(Evas_Object *box, const char *label, Evas_Smart_Cb cb, const void *data)
{
	Evas_Object *button = elm_button_add(box);
	elm_object_text_set(button, label);
	evas_object_smart_callback_add(button, "clicked", cb, data);
	elm_box_pack_end(box, button);
	evas_object_show(button);
	return button;
}

/* ---- test hooks ---- */

/* False for the plain canvas objects, which have no members to look into. */
static bool is_group(Evas_Object *obj)
{
	static const char *const plain[] = {"rectangle", "image",   "text",    "textblock", "textgrid",
	                                    "line",      "polygon", "vectors", "snapshot",  NULL};
	const char *type = evas_object_type_get(obj);
	for (int i = 0; type && plain[i]; i++)
		if (!strcmp(type, plain[i]))
			return false;
	return true;
}

/* The shown, enabled button labelled text among obj and its members. */
static Evas_Object *button_find(Evas_Object *obj, const char *text)
{
	if (!evas_object_visible_get(obj))
		return NULL;
	const char *type = elm_object_widget_check(obj) ? elm_object_widget_type_get(obj) : NULL;
	const char *label = type && strstr(type, "utton") ? elm_object_text_get(obj) : NULL;
	if (label && !strcmp(label, text) && !elm_object_disabled_get(obj))
		return obj;
	if (!is_group(obj))
		return NULL;
	Eina_List *members = evas_object_smart_members_get(obj);
	Evas_Object *child, *found = NULL;
	EINA_LIST_FREE(members, child)
	if (!found)
		found = button_find(child, text);
	return found;
}

static Eina_Bool test_click_cb(void *data)
{
	(void)data;
	const char *text = getenv(COMPANION_TEST_CLICK_ENV);
	Evas_Object *button = NULL;
	bool ready = !self.app->test_ready || self.app->test_ready();
	/* The window's content hangs off the canvas, not off the window object. */
	Evas *e = self.win ? evas_object_evas_get(self.win) : NULL;
	for (Evas_Object *o = e && ready ? evas_object_bottom_get(e) : NULL; o && !button && text;
	     o = evas_object_above_get(o))
		button = button_find(o, text);
	int x, y, w, h;
	if (button)
		evas_object_geometry_get(button, &x, &y, &w, &h);
	if (!button || w <= 0 || h <= 0) {
		if (++self.click_tries < TEST_CLICK_TRIES)
			return ECORE_CALLBACK_RENEW;
		LOGE("test hook: no button \"%s\" showed", text ? text : "");
		self.click_timer = NULL;
		return ECORE_CALLBACK_CANCEL;
	}
	self.click_timer = NULL;
	unsigned int ts = (unsigned int)(ecore_time_get() * 1000);
	LOGI("test hook: pressing \"%s\"", text);
	evas_event_feed_mouse_move(e, x + w / 2, y + h / 2, ts, NULL);
	evas_event_feed_mouse_down(e, 1, EVAS_BUTTON_NONE, ts + 1, NULL);
	evas_event_feed_mouse_up(e, 1, EVAS_BUTTON_NONE, ts + 2, NULL);
	return ECORE_CALLBACK_CANCEL;
}

static void test_click_schedule(void)
{
	const char *text = getenv(COMPANION_TEST_CLICK_ENV);
	if (!text || !*text || self.click_timer)
		return;
	self.click_tries = 0;
	self.click_timer = ecore_timer_add(TEST_CLICK_POLL_SEC, test_click_cb, NULL);
}

/* ---- lifecycle ---- */

static bool create_cb(void *data)
{
	(void)data;
	self.win = elm_win_util_standard_add(self.app->name, self.app->title);
	self.box = elm_box_add(self.win);
	evas_object_size_hint_weight_set(self.box, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_box_padding_set(self.box, 0, ELM_SCALE_SIZE(8));
	elm_win_resize_object_add(self.win, self.box);
	evas_object_show(self.box);
	if (self.app->create && !self.app->create(self.win, self.box))
		return false;
	evas_object_show(self.win);
	return true;
}

static void request_cb(app_control_h request, void *data)
{
	(void)data;
	request_keep(request);
	if (self.app->request)
		self.app->request(self.request);
	test_click_schedule();
}

static void terminate_cb(void *data)
{
	(void)data;
	if (self.app->terminate)
		self.app->terminate();
	companion_request_answer(APP_CONTROL_RESULT_CANCELED, NULL);
	if (self.click_timer)
		ecore_timer_del(self.click_timer);
	self.click_timer = NULL;
	if (self.request)
		app_control_destroy(self.request);
	self.request = NULL;
}

int companion_main(int argc, char **argv, const companion_app_s *app)
{
	self.app = app;
	ui_app_lifecycle_callback_s cb = {create_cb, terminate_cb, NULL, NULL, request_cb};
	return ui_app_main(argc, argv, &cb, NULL);
}
