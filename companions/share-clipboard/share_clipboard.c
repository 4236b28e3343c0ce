/* Share target "Copy to clipboard": the shared text, then the shared files as "file://" URIs, one per
   line, go to the clipboard. The clipboard lives in its owner, so the program stays in the background
   (its window hidden) until something else is copied. */
#include "companion.h"
#include "share_content.h"

#include <app.h>
#include <dlog.h>
#include <stdlib.h>
#include <string.h>

/* How long the note stays on screen. */
#define NOTE_SEC 2.0
#define PREVIEW_BYTES 300

static struct {
	Evas_Object *win;
	Evas_Object *note;
	Ecore_Timer *hide_timer;
	char *clip; /* what the clipboard holds */
	int own_losses; /* losses that our own setting of the clipboard may still report */
} self;

static Eina_Bool hide_cb(void *data)
{
	(void)data;
	self.hide_timer = NULL;
	evas_object_hide(self.win);
	return ECORE_CALLBACK_CANCEL;
}

static void selection_lost_cb(void *data, Elm_Sel_Type type)
{
	(void)data;
	(void)type;
	/* Setting the clipboard may report the loss of what this program held before: not a real loss. */
	if (self.own_losses > 0) {
		self.own_losses--;
		return;
	}
	LOGI("the clipboard went to another owner");
	ui_app_exit();
}

static void show_note(const char *clip)
{
	char preview[PREVIEW_BYTES + 8];
	size_t len = strlen(clip);
	if (len > PREVIEW_BYTES) {
		len = PREVIEW_BYTES;
		while (len > 0 && ((unsigned char)clip[len] & 0xC0) == 0x80)
			len--;
	}
	memcpy(preview, clip, len);
	strcpy(preview + len, len < strlen(clip) ? "…" : "");
	char *markup = elm_entry_utf8_to_markup(preview);
	Eina_Strbuf *text = eina_strbuf_new();
	eina_strbuf_append_printf(text, "<b>Copied to the clipboard</b><br>%s", markup ? markup : "");
	elm_object_text_set(self.note, eina_strbuf_string_get(text));
	eina_strbuf_free(text);
	free(markup);
	evas_object_show(self.win);
	if (self.hide_timer)
		ecore_timer_reset(self.hide_timer);
	else
		self.hide_timer = ecore_timer_add(NOTE_SEC, hide_cb, NULL);
}

static void request(app_control_h request)
{
	share_content_s content;
	if (!share_content_read(request, &content)) {
		LOGE("nothing to copy");
		share_content_clear(&content);
		companion_request_answer(APP_CONTROL_RESULT_FAILED, NULL);
		return;
	}
	char *clip = share_content_clip_text_new(&content);
	share_content_clear(&content);
	/* Taking the clipboard again from ourselves is no loss (Elementary calls a loss callback even when
	   it is unset, so one that knows is always in place). */
	self.own_losses++;
	elm_cnp_selection_loss_callback_set(self.note, ELM_SEL_TYPE_CLIPBOARD, selection_lost_cb, NULL);
	bool ok = elm_cnp_selection_set(self.note, ELM_SEL_TYPE_CLIPBOARD, ELM_SEL_FORMAT_TEXT, clip, strlen(clip));
	if (!ok) {
		LOGE("the clipboard refused the text");
		free(clip);
		companion_request_answer(APP_CONTROL_RESULT_FAILED, NULL);
		return;
	}
	free(self.clip);
	self.clip = clip;
	LOGI("copied %zu bytes to the clipboard", strlen(clip));
	show_note(clip);
	companion_request_answer(APP_CONTROL_RESULT_SUCCEEDED, NULL);
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	self.win = win;
	self.note = companion_label_add(box, "");
	evas_object_size_hint_weight_set(self.note, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_resize(win, ELM_SCALE_SIZE(400), ELM_SCALE_SIZE(200));
	return true;
}

static void terminate(void)
{
	if (self.hide_timer)
		ecore_timer_del(self.hide_timer);
	self.hide_timer = NULL;
	free(self.clip);
	self.clip = NULL;
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {.name = "share-clipboard",
	                                    .title = "Copy to clipboard",
	                                    .create = create,
	                                    .request = request,
	                                    .terminate = terminate};
	return companion_main(argc, argv, &app);
}
