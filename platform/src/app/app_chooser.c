/* Requests that name an operation but no app: the registered apps that take it, one launched at once,
   several offered in a chooser window of the requesting process. */
#include <Elementary.h>
#include <app_control.h>
#include <app_manager.h>

#include "app_private.h"

#include <desktop/app_chooser.h>

#include <dlog.h>
#include <stdlib.h>
#include <string.h>

/* One open chooser: the request waits in it until the user picks an app or closes the window. */
typedef struct {
	Evas_Object *win;
	app_control_h request;
	app_control_reply_cb callback;
	void *user_data;
	Eina_List *ids; /* malloc'ed app ids, the list items' data */
	char *chosen;   /* set by a pick */
} chooser_s;

static Eina_List *choosers;

typedef struct {
	app_control_h request;
	Eina_List *ids;
} collect_s;

static bool collect_cb(const app_registry_entry_s *entry, void *data)
{
	collect_s *c = data;
	if (app_registry_entry_takes(entry, c->request->operation, c->request->mime))
		c->ids = eina_list_append(c->ids, strdup(entry->id));
	return true;
}

static void ids_free(Eina_List *ids)
{
	char *id;
	EINA_LIST_FREE(ids, id)
	free(id);
}

/* Sends a copy of the request to app_id. */
static int send_to(app_control_h request, const char *app_id, app_control_reply_cb callback, void *user_data)
{
	app_control_h target = NULL;
	if (app_control_clone(&target, request) != APP_CONTROL_ERROR_NONE)
		return APP_CONTROL_ERROR_OUT_OF_MEMORY;
	app_control_set_app_id(target, app_id);
	int ret = app_control_send_launch_request(target, callback, user_data);
	app_control_destroy(target);
	return ret;
}

static void answer_without_target(chooser_s *c, app_control_result_e result)
{
	if (!c->callback)
		return;
	app_control_h empty = NULL;
	app_control_create(&empty);
	c->callback(c->request, empty, result, c->user_data);
	app_control_destroy(empty);
}

/* Runs after the window is gone: nothing of the chooser is on the stack any more. */
static void finish_job_cb(void *data)
{
	chooser_s *c = data;
	if (c->chosen) {
		LOGI("chooser: %s picked", c->chosen);
		if (send_to(c->request, c->chosen, c->callback, c->user_data) != APP_CONTROL_ERROR_NONE)
			answer_without_target(c, APP_CONTROL_RESULT_FAILED);
	} else {
		LOGI("chooser closed without a pick");
		answer_without_target(c, APP_CONTROL_RESULT_CANCELED);
	}
	app_control_destroy(c->request);
	ids_free(c->ids);
	free(c->chosen);
	free(c);
	elm_shutdown();
}

static void win_del_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	chooser_s *c = data;
	choosers = eina_list_remove(choosers, c);
	c->win = NULL;
	ecore_job_add(finish_job_cb, c);
}

static void win_del_job_cb(void *data)
{
	chooser_s *c = data;
	if (c->win)
		evas_object_del(c->win);
}

/* The window goes after the callback that closes it has returned. */
static void close_soon(chooser_s *c)
{
	evas_object_hide(c->win);
	ecore_job_add(win_del_job_cb, c);
}

static void item_selected_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)obj;
	chooser_s *c = data;
	const char *id = elm_object_item_data_get(event_info);
	if (c->chosen || !id)
		return;
	c->chosen = strdup(id);
	close_soon(c);
}

static void cancel_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)obj;
	(void)event_info;
	close_soon(data);
}

/* The app's icon from the registry, or NULL. */
static Evas_Object *icon_new(Evas_Object *parent, const char *path)
{
	if (!path || !*path)
		return NULL;
	Evas_Object *icon = elm_icon_add(parent);
	if (!elm_image_file_set(icon, path, NULL)) {
		evas_object_del(icon);
		return NULL;
	}
	evas_object_size_hint_min_set(icon, ELM_SCALE_SIZE(32), ELM_SCALE_SIZE(32));
	return icon;
}

static void list_add_app(Evas_Object *list, char *id)
{
	app_info_h info = NULL;
	char *label = NULL, *icon_path = NULL;
	if (app_manager_get_app_info(id, &info) == APP_MANAGER_ERROR_NONE) {
		app_info_get_label(info, &label);
		app_info_get_icon(info, &icon_path);
		app_info_destroy(info);
	}
	elm_list_item_append(list, label ? label : id, icon_new(list, icon_path), NULL, NULL, id);
	free(label);
	free(icon_path);
}

static bool is_share(const char *operation)
{
	return operation && strstr(operation, "share") != NULL;
}

static void chooser_show(chooser_s *c)
{
	const char *title = is_share(c->request->operation) ? "Share with" : "Complete the action with";

	c->win = elm_win_util_standard_add("app-chooser", title);
	elm_win_autodel_set(c->win, EINA_TRUE);
	evas_object_event_callback_add(c->win, EVAS_CALLBACK_DEL, win_del_cb, c);

	Evas_Object *box = elm_box_add(c->win);
	evas_object_size_hint_weight_set(box, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_box_padding_set(box, 0, ELM_SCALE_SIZE(8));
	elm_win_resize_object_add(c->win, box);

	Evas_Object *heading = elm_label_add(box);
	elm_object_text_set(heading, title);
	elm_box_pack_end(box, heading);
	evas_object_show(heading);

	Evas_Object *list = elm_list_add(box);
	evas_object_name_set(list, DESKTOP_APP_CHOOSER_LIST_NAME);
	evas_object_size_hint_weight_set(list, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(list, EVAS_HINT_FILL, EVAS_HINT_FILL);
	Eina_List *l;
	char *id;
	EINA_LIST_FOREACH(c->ids, l, id)
	list_add_app(list, id);
	evas_object_smart_callback_add(list, "selected", item_selected_cb, c);
	elm_list_go(list);
	elm_box_pack_end(box, list);
	evas_object_show(list);

	Evas_Object *cancel = elm_button_add(box);
	elm_object_text_set(cancel, "Cancel");
	evas_object_smart_callback_add(cancel, "clicked", cancel_clicked_cb, c);
	elm_box_pack_end(box, cancel);
	evas_object_show(cancel);

	evas_object_show(box);
	evas_object_resize(c->win, ELM_SCALE_SIZE(360), ELM_SCALE_SIZE(80 + 48 * eina_list_count(c->ids)));
	evas_object_show(c->win);
	elm_win_activate(c->win);
}

int app_chooser_send(app_control_h request, app_control_reply_cb callback, void *user_data)
{
	collect_s collect = {request, NULL};
	/* The lists need Eina even in a program that never started Elementary; one hold for the process. */
	static bool eina_held;
	if (!eina_held)
		eina_held = eina_init() > 0;
	app_registry_foreach(collect_cb, &collect);
	unsigned int count = eina_list_count(collect.ids);
	if (count == 0) {
		LOGE("no registered app takes the operation %s", request->operation);
		return APP_CONTROL_ERROR_APP_NOT_FOUND;
	}
	if (count == 1) {
		int ret = send_to(request, eina_list_data_get(collect.ids), callback, user_data);
		ids_free(collect.ids);
		return ret;
	}
	chooser_s *c = calloc(1, sizeof(*c));
	if (!c || app_control_clone(&c->request, request) != APP_CONTROL_ERROR_NONE) {
		free(c);
		ids_free(collect.ids);
		return APP_CONTROL_ERROR_OUT_OF_MEMORY;
	}
	c->ids = eina_list_sort(collect.ids, 0, EINA_COMPARE_CB(strcmp));
	c->callback = callback;
	c->user_data = user_data;
	/* A process that has no windows of its own gets the toolkit for the chooser's life. */
	elm_init(0, NULL);
	chooser_show(c);
	choosers = eina_list_append(choosers, c);
	LOGI("%u apps take %s: chooser shown", count, request->operation);
	return APP_CONTROL_ERROR_NONE;
}

Evas_Object *desktop_app_chooser_current_get(void)
{
	chooser_s *c = eina_list_last_data_get(choosers);
	return c ? c->win : NULL;
}
