/* tizen.gallery: picks one picture with Elementary's file selector, starting in the user's Pictures
   folder, and answers with its path in /appcontrol/data/selected, or "canceled". */
#include "companion.h"

#include <app.h>
#include <dlog.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>

static const char *const picture_extensions[] = {"jpg", "jpeg", "png", "gif", "bmp", "webp", "tif", "tiff", NULL};

static Evas_Object *selector;

static bool is_picture(const char *path)
{
	const char *dot = path ? strrchr(path, '.') : NULL;
	if (!dot || strchr(dot, '/'))
		return false;
	for (int i = 0; picture_extensions[i]; i++)
		if (!strcasecmp(dot + 1, picture_extensions[i]))
			return true;
	return false;
}

static Eina_Bool picture_filter_cb(const char *path, Eina_Bool dir, void *data)
{
	(void)data;
	return dir || is_picture(path);
}

static void done_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	const char *path = event_info;
	if (!path) {
		LOGI("picking canceled");
		companion_request_answer(APP_CONTROL_RESULT_CANCELED, NULL);
		ui_app_exit();
		return;
	}
	/* OK on a folder or a stray file keeps the selector open. */
	if (!is_picture(path) || !ecore_file_exists(path) || ecore_file_is_dir(path))
		return;
	LOGI("picked %s", path);
	companion_request_answer_paths(APP_CONTROL_RESULT_SUCCEEDED, COMPANION_KEY_SELECTED, &path, 1);
	ui_app_exit();
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	selector = elm_fileselector_add(box);
	elm_fileselector_is_save_set(selector, EINA_FALSE);
	elm_fileselector_expandable_set(selector, EINA_FALSE);
	elm_fileselector_buttons_ok_cancel_set(selector, EINA_TRUE);
	elm_fileselector_custom_filter_append(selector, picture_filter_cb, NULL, "Pictures");
	evas_object_size_hint_weight_set(selector, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(selector, EVAS_HINT_FILL, EVAS_HINT_FILL);
	evas_object_smart_callback_add(selector, "done", done_cb, NULL);
	elm_box_pack_end(box, selector);
	evas_object_show(selector);
	evas_object_resize(win, ELM_SCALE_SIZE(520), ELM_SCALE_SIZE(640));
	return true;
}

/* The test hook's press waits until the selector holds the preset file (it lists folders asynchronously). */
static bool test_ready(void)
{
	const char *preset = getenv(COMPANION_TEST_SELECT_ENV);
	const char *selected = elm_fileselector_selected_get(selector);
	return !preset || !*preset || (selected && !strcmp(selected, preset));
}

/* Each request starts over in the Pictures folder (or on the test hook's file). */
static void request(app_control_h request)
{
	(void)request;
	const char *preset = getenv(COMPANION_TEST_SELECT_ENV);
	if (preset && *preset) {
		elm_fileselector_selected_set(selector, preset);
		return;
	}
	char *dir = companion_user_dir_get("PICTURES", "Pictures", false);
	elm_fileselector_path_set(selector, dir);
	free(dir);
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {
	    .name = "gallery", .title = "Gallery", .create = create, .request = request, .test_ready = test_ready};
	return companion_main(argc, argv, &app);
}
