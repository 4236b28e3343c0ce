/* Share target "Save to a folder": the shared text becomes "<title>.txt" in a folder the user picks, with
   copies of the shared files beside it. Answers with the paths written. */
#define _GNU_SOURCE
#include "companion.h"
#include "share_content.h"

#include <app.h>
#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#define TITLE_BYTES 60
#define SHOWN_SEC 2.0

static struct {
	Evas_Object *heading;
	Evas_Object *selector;
	Ecore_Timer *exit_timer;
	share_content_s content;
} self;

/* "<folder>/<stem><ext>", or with " (2)", " (3)" ... after the stem, the first that does not exist. */
static char *unique_path_new(const char *folder, const char *stem, const char *ext)
{
	char *path = NULL;
	for (int n = 1; n < 1000; n++) {
		free(path);
		int len = n == 1 ? asprintf(&path, "%s/%s%s", folder, stem, ext)
		                 : asprintf(&path, "%s/%s (%d)%s", folder, stem, n, ext);
		if (len < 0)
			return NULL;
		if (!ecore_file_exists(path))
			return path;
	}
	free(path);
	return NULL;
}

/* The title made fit for a file name: no slashes or control characters, no leading dot. */
static char *file_stem_new(void)
{
	char *stem = share_content_title_new(&self.content, TITLE_BYTES);
	if (!stem)
		return strdup("Shared text");
	for (char *p = stem; *p; p++)
		if (*p == '/' || (unsigned char)*p < 0x20)
			*p = ' ';
	if (stem[0] == '.')
		stem[0] = '_';
	return stem;
}

static char *text_save_new(const char *folder)
{
	const char *text = self.content.text ? self.content.text : "";
	const char *subject = self.content.subject;
	if (!*text && !(subject && *subject))
		return NULL;
	char *stem = file_stem_new();
	char *path = unique_path_new(folder, stem, ".txt");
	free(stem);
	FILE *f = path ? fopen(path, "w") : NULL;
	bool ok = f != NULL;
	if (f) {
		if (subject && *subject && strncmp(text, subject, strlen(subject)))
			ok = fprintf(f, "%s\n", subject) >= 0;
		ok = ok && fputs(text, f) >= 0;
		ok = fclose(f) == 0 && ok;
	}
	if (!ok) {
		LOGE("cannot write %s", path ? path : folder);
		free(path);
		return NULL;
	}
	return path;
}

static char *file_copy_new(const char *folder, const char *source)
{
	char *stem = strdup(ecore_file_file_get(source));
	char *dot = stem ? strrchr(stem, '.') : NULL;
	char *ext = strdup(dot && dot != stem ? dot : "");
	if (dot && dot != stem)
		*dot = '\0';
	char *path = stem && ext ? unique_path_new(folder, stem, ext) : NULL;
	free(stem);
	free(ext);
	if (path && !ecore_file_cp(source, path)) {
		LOGE("cannot copy %s to %s", source, path);
		free(path);
		path = NULL;
	}
	return path;
}

static Eina_Bool exit_cb(void *data)
{
	(void)data;
	self.exit_timer = NULL;
	ui_app_exit();
	return ECORE_CALLBACK_CANCEL;
}

static void save_into(const char *folder)
{
	const char **written = calloc(self.content.count + 1, sizeof(char *));
	int n = 0;
	char *text_path = text_save_new(folder);
	if (text_path)
		written[n++] = text_path;
	for (int i = 0; i < self.content.count; i++) {
		char *copy = file_copy_new(folder, self.content.paths[i]);
		if (copy)
			written[n++] = copy;
	}
	int expected = self.content.count + ((self.content.text && *self.content.text) ? 1 : 0);
	Eina_Strbuf *note = eina_strbuf_new();
	eina_strbuf_append_printf(note, n ? "Saved in %s:" : "Nothing could be saved in %s.", folder);
	for (int i = 0; i < n; i++)
		eina_strbuf_append_printf(note, "%s %s", i ? "," : "", ecore_file_file_get(written[i]));
	if (n && n < expected)
		eina_strbuf_append_printf(note, " (%d could not be saved)", expected - n);
	char *markup = elm_entry_utf8_to_markup(eina_strbuf_string_get(note));
	elm_object_text_set(self.heading, markup);
	free(markup);
	eina_strbuf_free(note);
	evas_object_hide(self.selector);
	LOGI("saved %d of %d in %s", n, expected, folder);
	companion_request_answer_paths(n ? APP_CONTROL_RESULT_SUCCEEDED : APP_CONTROL_RESULT_FAILED, COMPANION_KEY_PATH,
	                               written, n);
	for (int i = 0; i < n; i++)
		free((char *)written[i]);
	free(written);
	self.exit_timer = ecore_timer_add(SHOWN_SEC, exit_cb, NULL);
}

static void done_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	const char *folder = event_info;
	if (!folder) {
		companion_request_answer(APP_CONTROL_RESULT_CANCELED, NULL);
		ui_app_exit();
		return;
	}
	if (ecore_file_is_dir(folder) && !self.exit_timer)
		save_into(folder);
}

static void request(app_control_h request)
{
	share_content_clear(&self.content);
	if (!share_content_read(request, &self.content)) {
		LOGE("nothing to save");
		companion_request_answer(APP_CONTROL_RESULT_FAILED, NULL);
		ui_app_exit();
		return;
	}
	if (self.exit_timer)
		ecore_timer_del(self.exit_timer);
	self.exit_timer = NULL;
	char *title = share_content_title_new(&self.content, TITLE_BYTES);
	Eina_Strbuf *heading = eina_strbuf_new();
	eina_strbuf_append(heading, "Pick the folder for ");
	if (title)
		eina_strbuf_append_printf(heading, "“%s”%s", title, self.content.count ? " and " : "");
	if (self.content.count)
		eina_strbuf_append_printf(heading, "%d file%s", self.content.count, self.content.count > 1 ? "s" : "");
	char *markup = elm_entry_utf8_to_markup(eina_strbuf_string_get(heading));
	elm_object_text_set(self.heading, markup);
	free(markup);
	eina_strbuf_free(heading);
	free(title);

	const char *preset = getenv(COMPANION_TEST_SELECT_ENV);
	char *folder = preset && *preset ? strdup(preset) : companion_user_dir_get("DOCUMENTS", "Documents", false);
	elm_fileselector_path_set(self.selector, folder);
	free(folder);
	evas_object_show(self.selector);
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	self.heading = companion_label_add(box, "");
	self.selector = elm_fileselector_add(box);
	elm_fileselector_folder_only_set(self.selector, EINA_TRUE);
	elm_fileselector_expandable_set(self.selector, EINA_FALSE);
	elm_fileselector_buttons_ok_cancel_set(self.selector, EINA_TRUE);
	evas_object_size_hint_weight_set(self.selector, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(self.selector, EVAS_HINT_FILL, EVAS_HINT_FILL);
	evas_object_smart_callback_add(self.selector, "done", done_cb, NULL);
	elm_box_pack_end(box, self.selector);
	evas_object_show(self.selector);
	evas_object_resize(win, ELM_SCALE_SIZE(520), ELM_SCALE_SIZE(600));
	return true;
}

static void terminate(void)
{
	if (self.exit_timer)
		ecore_timer_del(self.exit_timer);
	self.exit_timer = NULL;
	share_content_clear(&self.content);
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {.name = "share-save",
	                                    .title = "Save to a folder",
	                                    .create = create,
	                                    .request = request,
	                                    .terminate = terminate};
	return companion_main(argc, argv, &app);
}
