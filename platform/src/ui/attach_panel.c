/* The attach panel: a sheet docked over the lower half of a conformant, holding a file selector filtered to the
 * categories the app added. A pick goes back to the app's result callback as an app_control with the chosen
 * paths, capped by the count in the category's extra data. */
#include <attach_panel.h>

#include <Ecore_File.h>
#include <Elementary.h>
#include <dlog.h>
#include <stdlib.h>
#include <string.h>

#define PANEL_KEY "tizen.attach_panel"
#define AUTOSELECT_ENV "TIZEN_ATTACH_PANEL_AUTOSELECT"
#define CATEGORY_COUNT (ATTACH_PANEL_CONTENT_CATEGORY_VIDEO_RECORDER + 1)
/* The sheet takes this share of the conformant's height. */
#define PANEL_HEIGHT_SHARE 0.5

struct _attach_panel {
	Evas_Object *conformant;
	Evas_Object *sheet;
	Evas_Object *selector;
	bool added[CATEGORY_COUNT];
	bundle *extra[CATEGORY_COUNT];
	attach_panel_result_cb result_cb;
	void *user_data;
	bool visible;
	Ecore_Job *autoselect_job;
};

static int panel_error(int code, const char *func, const char *what)
{
	LOGE("[%s] %s (0x%08x)", func, what, (unsigned int)code);
	return code;
}

#define INVALID_PARAMETER() panel_error(ATTACH_PANEL_ERROR_INVALID_PARAMETER, __func__, "invalid parameter")

static bool category_valid(attach_panel_content_category_e c)
{
	return c >= ATTACH_PANEL_CONTENT_CATEGORY_IMAGE && c < CATEGORY_COUNT;
}

/* What a file selector can offer on a desktop, and the type filter of each. */
static const char *category_mime(attach_panel_content_category_e c)
{
	switch (c) {
	case ATTACH_PANEL_CONTENT_CATEGORY_IMAGE:
		return "image/*";
	case ATTACH_PANEL_CONTENT_CATEGORY_VIDEO:
		return "video/*";
	case ATTACH_PANEL_CONTENT_CATEGORY_AUDIO:
		return "audio/*";
	case ATTACH_PANEL_CONTENT_CATEGORY_MYFILES:
		return "*";
	default:
		return NULL;
	}
}

/* The first offered category: the one a pick is reported under. */
static attach_panel_content_category_e first_category(attach_panel_h panel)
{
	for (int c = ATTACH_PANEL_CONTENT_CATEGORY_IMAGE; c < CATEGORY_COUNT; c++)
		if (panel->added[c])
			return (attach_panel_content_category_e)c;
	return (attach_panel_content_category_e)0;
}

/* How many items one pick may return: the extra data's total count, else no cap (0). */
static int pick_cap(attach_panel_h panel, attach_panel_content_category_e c)
{
	char *value = NULL;
	if (!panel->extra[c])
		return 0;
	if (bundle_get_str(panel->extra[c], APP_CONTROL_DATA_TOTAL_COUNT, &value) != BUNDLE_ERROR_NONE &&
	    bundle_get_str(panel->extra[c], "max-count", &value) != BUNDLE_ERROR_NONE)
		return 0;
	return value ? atoi(value) : 0;
}

static void deliver(attach_panel_h panel, const char **paths, int count)
{
	attach_panel_content_category_e c = first_category(panel);
	if (!panel->result_cb || !c)
		return;
	int cap = pick_cap(panel, c);
	if (cap > 0 && count > cap)
		count = cap;
	app_control_h result = NULL;
	if (app_control_create(&result) != APP_CONTROL_ERROR_NONE)
		return;
	app_control_add_extra_data_array(result, APP_CONTROL_DATA_SELECTED, paths, count);
	app_control_add_extra_data_array(result, APP_CONTROL_DATA_PATH, paths, count);
	LOGI("attach panel picked %d item(s)", count);
	panel->result_cb(panel, c, result, APP_CONTROL_RESULT_SUCCEEDED, panel->user_data);
	app_control_destroy(result);
}

static void autoselect_job_cb(void *data)
{
	attach_panel_h panel = data;
	panel->autoselect_job = NULL;
	char *list = strdup(getenv(AUTOSELECT_ENV) ? getenv(AUTOSELECT_ENV) : "");
	const char *paths[64];
	int n = 0;
	char *save = NULL;
	for (char *tok = list ? strtok_r(list, ":", &save) : NULL; tok && n < 64; tok = strtok_r(NULL, ":", &save))
		paths[n++] = tok;
	deliver(panel, paths, n);
	free(list);
}

static void selector_done_cb(void *data, Evas_Object *obj, void *event_info)
{
	attach_panel_h panel = data;
	const Eina_List *selected = elm_fileselector_selected_paths_get(obj);
	int n = (int)eina_list_count(selected);
	if (!event_info || n == 0) {
		/* Cancel: the sheet goes down with nothing picked. */
		attach_panel_hide(panel);
		return;
	}
	const char **paths = calloc((size_t)n, sizeof(char *));
	if (!paths)
		return;
	int i = 0;
	const Eina_List *l;
	const char *path;
	EINA_LIST_FOREACH(selected, l, path)
	paths[i++] = path;
	deliver(panel, paths, n);
	free(paths);
	attach_panel_hide(panel);
}

/* The sheet follows the conformant's lower half. */
static void place_sheet(attach_panel_h panel)
{
	Evas_Coord x = 0, y = 0, w = 0, h = 0;
	evas_object_geometry_get(panel->conformant, &x, &y, &w, &h);
	Evas_Coord sheet_h = (Evas_Coord)(h * PANEL_HEIGHT_SHARE);
	evas_object_move(panel->sheet, x, y + h - sheet_h);
	evas_object_resize(panel->sheet, w, sheet_h);
}

static void conformant_geometry_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	place_sheet(data);
}

static void sheet_build(attach_panel_h panel)
{
	if (panel->sheet)
		return;
	/* A background and the selector in one cell. */
	panel->sheet = elm_table_add(panel->conformant);
	Evas_Object *bg = elm_bg_add(panel->sheet);
	evas_object_size_hint_weight_set(bg, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(bg, EVAS_HINT_FILL, EVAS_HINT_FILL);
	evas_object_show(bg);
	elm_table_pack(panel->sheet, bg, 0, 0, 1, 1);
	panel->selector = elm_fileselector_add(panel->sheet);
	evas_object_size_hint_weight_set(panel->selector, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(panel->selector, EVAS_HINT_FILL, EVAS_HINT_FILL);
	elm_fileselector_multi_select_set(panel->selector, EINA_TRUE);
	elm_fileselector_is_save_set(panel->selector, EINA_FALSE);
	elm_fileselector_buttons_ok_cancel_set(panel->selector, EINA_TRUE);
	for (int c = ATTACH_PANEL_CONTENT_CATEGORY_IMAGE; c < CATEGORY_COUNT; c++) {
		const char *mime = panel->added[c] ? category_mime((attach_panel_content_category_e)c) : NULL;
		if (mime && strcmp(mime, "*"))
			elm_fileselector_mime_types_filter_append(panel->selector, mime, mime);
	}
	char start[4096];
	const char *home = getenv("HOME");
	snprintf(start, sizeof(start), "%s/Pictures", home ? home : "/");
	elm_fileselector_path_set(panel->selector, ecore_file_is_dir(start) ? start : (home ? home : "/"));
	evas_object_smart_callback_add(panel->selector, "done", selector_done_cb, panel);
	evas_object_show(panel->selector);
	elm_table_pack(panel->sheet, panel->selector, 0, 0, 1, 1);
	evas_object_event_callback_add(panel->conformant, EVAS_CALLBACK_RESIZE, conformant_geometry_cb, panel);
	evas_object_event_callback_add(panel->conformant, EVAS_CALLBACK_MOVE, conformant_geometry_cb, panel);
	place_sheet(panel);
}

/* The conformant may go first (the window closes): the sheet goes with it, and the panel lives on empty. */
static void conformant_del_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	attach_panel_h panel = data;
	panel->conformant = NULL;
	panel->sheet = NULL;
	panel->selector = NULL;
	panel->visible = false;
}

int attach_panel_create(Evas_Object *conformant, attach_panel_h *attach_panel)
{
	if (!conformant || !attach_panel)
		return INVALID_PARAMETER();
	if (evas_object_data_get(conformant, PANEL_KEY))
		return panel_error(ATTACH_PANEL_ERROR_ALREADY_EXISTS, __func__, "the conformant has a panel");
	attach_panel_h panel = calloc(1, sizeof(*panel));
	if (!panel)
		return panel_error(ATTACH_PANEL_ERROR_OUT_OF_MEMORY, __func__, "out of memory");
	panel->conformant = conformant;
	evas_object_data_set(conformant, PANEL_KEY, panel);
	evas_object_event_callback_add(conformant, EVAS_CALLBACK_DEL, conformant_del_cb, panel);
	*attach_panel = panel;
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_destroy(attach_panel_h attach_panel)
{
	if (!attach_panel)
		return INVALID_PARAMETER();
	if (attach_panel->autoselect_job)
		ecore_job_del(attach_panel->autoselect_job);
	Evas_Object *conformant = attach_panel->conformant;
	if (conformant) {
		evas_object_event_callback_del_full(conformant, EVAS_CALLBACK_RESIZE, conformant_geometry_cb, attach_panel);
		evas_object_event_callback_del_full(conformant, EVAS_CALLBACK_MOVE, conformant_geometry_cb, attach_panel);
		evas_object_event_callback_del_full(conformant, EVAS_CALLBACK_DEL, conformant_del_cb, attach_panel);
		evas_object_data_del(conformant, PANEL_KEY);
	}
	if (attach_panel->sheet)
		evas_object_del(attach_panel->sheet);
	for (int c = 0; c < CATEGORY_COUNT; c++)
		if (attach_panel->extra[c])
			bundle_free(attach_panel->extra[c]);
	free(attach_panel);
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_add_content_category(attach_panel_h attach_panel, attach_panel_content_category_e content_category,
                                      bundle *extra_data)
{
	if (!attach_panel || !category_valid(content_category))
		return INVALID_PARAMETER();
	if (!category_mime(content_category))
		return panel_error(ATTACH_PANEL_ERROR_UNSUPPORTED_CONTENT_CATEGORY, __func__,
		                   "the desktop offers no such content");
	if (attach_panel->added[content_category])
		return panel_error(ATTACH_PANEL_ERROR_ALREADY_EXISTS, __func__, "the category is there already");
	attach_panel->added[content_category] = true;
	attach_panel->extra[content_category] = extra_data ? bundle_dup(extra_data) : NULL;
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_remove_content_category(attach_panel_h attach_panel, attach_panel_content_category_e content_category)
{
	if (!attach_panel || !category_valid(content_category) || !attach_panel->added[content_category])
		return INVALID_PARAMETER();
	attach_panel->added[content_category] = false;
	if (attach_panel->extra[content_category])
		bundle_free(attach_panel->extra[content_category]);
	attach_panel->extra[content_category] = NULL;
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_set_extra_data(attach_panel_h attach_panel, attach_panel_content_category_e content_category,
                                bundle *extra_data)
{
	if (!attach_panel || !extra_data || !category_valid(content_category) || !attach_panel->added[content_category])
		return INVALID_PARAMETER();
	if (attach_panel->extra[content_category])
		bundle_free(attach_panel->extra[content_category]);
	attach_panel->extra[content_category] = bundle_dup(extra_data);
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_set_result_cb(attach_panel_h attach_panel, attach_panel_result_cb result_cb, void *user_data)
{
	if (!attach_panel || !result_cb)
		return INVALID_PARAMETER();
	attach_panel->result_cb = result_cb;
	attach_panel->user_data = user_data;
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_unset_result_cb(attach_panel_h attach_panel)
{
	if (!attach_panel)
		return INVALID_PARAMETER();
	attach_panel->result_cb = NULL;
	attach_panel->user_data = NULL;
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_show(attach_panel_h attach_panel)
{
	if (!attach_panel)
		return INVALID_PARAMETER();
	attach_panel->visible = true;
	if (getenv(AUTOSELECT_ENV)) {
		/* The pick arrives after the call, as a user's would. */
		if (!attach_panel->autoselect_job)
			attach_panel->autoselect_job = ecore_job_add(autoselect_job_cb, attach_panel);
		return ATTACH_PANEL_ERROR_NONE;
	}
	if (!attach_panel->conformant)
		return panel_error(ATTACH_PANEL_ERROR_ALREADY_DESTROYED, __func__, "the conformant has gone");
	sheet_build(attach_panel);
	evas_object_show(attach_panel->sheet);
	evas_object_raise(attach_panel->sheet);
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_hide(attach_panel_h attach_panel)
{
	if (!attach_panel)
		return INVALID_PARAMETER();
	attach_panel->visible = false;
	if (attach_panel->sheet)
		evas_object_hide(attach_panel->sheet);
	return ATTACH_PANEL_ERROR_NONE;
}

int attach_panel_get_visibility(attach_panel_h attach_panel, bool *visible)
{
	if (!attach_panel || !visible)
		return INVALID_PARAMETER();
	*visible = attach_panel->visible;
	return ATTACH_PANEL_ERROR_NONE;
}
