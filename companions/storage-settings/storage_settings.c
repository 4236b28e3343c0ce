/* com.veltron.setting.storage: free and total space of the file system that holds the data folder, as
   apps see it through the storage API, with the free-space override of the device state (vconf) that
   stands in for a full disk. The window follows changes of the override. */
#define _GNU_SOURCE
#include "companion.h"

#include <app_common.h>
#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <storage.h>
#include <string.h>
#include <sys/statvfs.h>
#include <vconf.h>

#define FREE_OVERRIDE_KEY "db/desktop/storage/internal_free_bytes"

static struct {
	Evas_Object *figures;
	Evas_Object *bar;
	Evas_Object *override;
	Evas_Object *remove;
} ui;

/* "12.3 GB" and the like. */
static void size_format(unsigned long long bytes, char *out, size_t len)
{
	static const char *const units[] = {"bytes", "KB", "MB", "GB", "TB"};
	double value = (double)bytes;
	int unit = 0;
	while (value >= 1024.0 && unit < 4) {
		value /= 1024.0;
		unit++;
	}
	if (unit == 0)
		snprintf(out, len, "%llu bytes", bytes);
	else
		snprintf(out, len, "%.1f %s", value, units[unit]);
}

/* The override as set, or NULL when it is not (malloc'ed). */
static char *override_text_new(void)
{
	int type = VCONF_TYPE_NONE;
	if (vconf_get_type(FREE_OVERRIDE_KEY, &type) != VCONF_OK)
		return NULL;
	if (type == VCONF_TYPE_STRING)
		return vconf_get_str(FREE_OVERRIDE_KEY);
	int value = 0;
	char *text = NULL;
	if (type != VCONF_TYPE_INT || vconf_get_int(FREE_OVERRIDE_KEY, &value) != VCONF_OK ||
	    asprintf(&text, "%d", value) < 0)
		return NULL;
	return text;
}

static void refresh(void)
{
	char *data = app_get_data_path();
	struct statvfs fs;
	memset(&fs, 0, sizeof(fs));
	struct statvfs real;
	bool ok = storage_get_internal_memory_size(&fs) == STORAGE_ERROR_NONE;
	bool real_ok = data && statvfs(data, &real) == 0;
	unsigned long long total = (unsigned long long)fs.f_frsize * fs.f_blocks;
	unsigned long long avail = (unsigned long long)fs.f_bsize * fs.f_bavail;
	char total_text[32], free_text[32], real_text[32];
	size_format(total, total_text, sizeof(total_text));
	size_format(avail, free_text, sizeof(free_text));
	size_format(real_ok ? (unsigned long long)real.f_bsize * real.f_bavail : 0, real_text, sizeof(real_text));

	char *override = override_text_new();
	Eina_Strbuf *text = eina_strbuf_new();
	char *folder = elm_entry_utf8_to_markup(data ? data : "(none)");
	if (ok)
		eina_strbuf_append_printf(text, "<b>Internal storage</b><br>File system of %s<br>Total: %s<br>Free: %s", folder,
		                          total_text, free_text);
	else
		eina_strbuf_append_printf(text, "<b>Internal storage</b><br>The space of %s cannot be read.", folder);
	if (ok && override && real_ok)
		eina_strbuf_append_printf(text, " (really %s)", real_text);
	elm_object_text_set(ui.figures, eina_strbuf_string_get(text));
	elm_progressbar_value_set(ui.bar, ok && total ? 1.0 - (double)avail / (double)total : 0.0);

	eina_strbuf_reset(text);
	char *value = override ? elm_entry_utf8_to_markup(override) : NULL;
	if (override)
		eina_strbuf_append_printf(text, "Free-space override (vconf %s): %s bytes", FREE_OVERRIDE_KEY, value);
	else
		eina_strbuf_append_printf(text, "Free-space override (vconf %s): not set", FREE_OVERRIDE_KEY);
	elm_object_text_set(ui.override, eina_strbuf_string_get(text));
	elm_object_disabled_set(ui.remove, !override);
	eina_strbuf_free(text);
	free(value);
	free(folder);
	free(override);
	free(data);
}

static void override_changed_cb(keynode_t *node, void *data)
{
	(void)node;
	(void)data;
	refresh();
}

static void remove_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	if (vconf_unset(FREE_OVERRIDE_KEY) != VCONF_OK)
		LOGE("cannot remove the override");
	refresh();
}

static void request(app_control_h request)
{
	(void)request;
	refresh();
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	ui.figures = companion_label_add(box, "");
	ui.bar = elm_progressbar_add(box);
	elm_object_text_set(ui.bar, "Used");
	elm_progressbar_unit_format_set(ui.bar, "%.0f %%");
	evas_object_size_hint_align_set(ui.bar, EVAS_HINT_FILL, 0.5);
	evas_object_size_hint_weight_set(ui.bar, EVAS_HINT_EXPAND, 0.0);
	elm_box_pack_end(box, ui.bar);
	evas_object_show(ui.bar);
	ui.override = companion_label_add(box, "");
	ui.remove = companion_button_add(box, "Remove the override", remove_clicked_cb, NULL);
	vconf_notify_key_changed(FREE_OVERRIDE_KEY, override_changed_cb, NULL);
	evas_object_resize(win, ELM_SCALE_SIZE(480), ELM_SCALE_SIZE(300));
	return true;
}

static void terminate(void)
{
	vconf_ignore_key_changed(FREE_OVERRIDE_KEY, override_changed_cb);
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {
	    .name = "storage-settings", .title = "Storage", .create = create, .request = request, .terminate = terminate};
	return companion_main(argc, argv, &app);
}
