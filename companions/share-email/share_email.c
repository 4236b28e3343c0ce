/* Share target "Send by e-mail": hands subject, body and attachments to the desktop's mail program
   through xdg-email (from xdg-utils). The subject is the request's, else the text's first line. */
#define _GNU_SOURCE
#include "companion.h"
#include "share_content.h"

#include <app.h>
#include <dlog.h>
#include <stdlib.h>
#include <string.h>

/* The program to run instead of xdg-email, e.g. for tests. */
#define EMAIL_COMMAND_ENV "COMPANION_EMAIL_COMMAND"
#define SUBJECT_BYTES 100
#define SHOWN_SEC 1.5
#define EXIT_NOT_FOUND 127

static struct {
	Evas_Object *note;
	Evas_Object *close;
	Ecore_Exe *exe;
	Ecore_Event_Handler *exe_del;
	Ecore_Timer *exit_timer;
} self;

/* The text in single quotes for sh, each inner quote as '\'' */
static void quoted_append(Eina_Strbuf *cmd, const char *text)
{
	eina_strbuf_append(cmd, " '");
	for (const char *p = text; *p; p++) {
		if (*p == '\'')
			eina_strbuf_append(cmd, "'\\''");
		else
			eina_strbuf_append_char(cmd, *p);
	}
	eina_strbuf_append_char(cmd, '\'');
}

static char *command_new(const share_content_s *content)
{
	const char *program = getenv(EMAIL_COMMAND_ENV);
	Eina_Strbuf *cmd = eina_strbuf_new();
	eina_strbuf_append(cmd, program && *program ? program : "xdg-email");
	eina_strbuf_append(cmd, " --utf8");
	char *subject = share_content_title_new(content, SUBJECT_BYTES);
	if (subject) {
		eina_strbuf_append(cmd, " --subject");
		quoted_append(cmd, subject);
	}
	free(subject);
	if (content->text && *content->text) {
		eina_strbuf_append(cmd, " --body");
		quoted_append(cmd, content->text);
	}
	for (int i = 0; i < content->count; i++) {
		eina_strbuf_append(cmd, " --attach");
		quoted_append(cmd, content->paths[i]);
	}
	return eina_strbuf_release(cmd);
}

static Eina_Bool exit_cb(void *data)
{
	(void)data;
	self.exit_timer = NULL;
	ui_app_exit();
	return ECORE_CALLBACK_CANCEL;
}

static void fail(const char *message)
{
	LOGE("%s", message);
	elm_object_text_set(self.note, message);
	evas_object_show(self.close);
	companion_request_answer(APP_CONTROL_RESULT_FAILED, NULL);
}

static Eina_Bool exe_del_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	Ecore_Exe_Event_Del *ev = event;
	if (!self.exe || ev->exe != self.exe)
		return ECORE_CALLBACK_PASS_ON;
	self.exe = NULL;
	if (ev->exited && ev->exit_code == 0) {
		LOGI("the mail program took the message");
		elm_object_text_set(self.note, "The message is in your e-mail program.");
		companion_request_answer(APP_CONTROL_RESULT_SUCCEEDED, NULL);
		self.exit_timer = ecore_timer_add(SHOWN_SEC, exit_cb, NULL);
	} else if (ev->exited && ev->exit_code == EXIT_NOT_FOUND) {
		fail("xdg-email was not found. Install xdg-utils to send e-mail.");
	} else {
		char message[160];
		snprintf(message, sizeof(message), "No e-mail program could be opened (xdg-email ended with %d).",
		         ev->exited ? ev->exit_code : -1);
		fail(message);
	}
	return ECORE_CALLBACK_DONE;
}

static void close_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	ui_app_exit();
}

static void request(app_control_h request)
{
	if (self.exe)
		return; /* the running hand-over answers the newest request */
	share_content_s content;
	bool any = share_content_read(request, &content);
	char *cmd = any ? command_new(&content) : NULL;
	share_content_clear(&content);
	if (!cmd) {
		fail("There is nothing to send.");
		return;
	}
	evas_object_hide(self.close);
	elm_object_text_set(self.note, "Opening your e-mail program…");
	self.exe = ecore_exe_run(cmd, NULL);
	free(cmd);
	if (!self.exe)
		fail("xdg-email could not be started.");
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	self.note = companion_label_add(box, "");
	evas_object_size_hint_weight_set(self.note, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	self.close = companion_button_add(box, "Close", close_clicked_cb, NULL);
	evas_object_hide(self.close);
	self.exe_del = ecore_event_handler_add(ECORE_EXE_EVENT_DEL, exe_del_cb, NULL);
	evas_object_resize(win, ELM_SCALE_SIZE(400), ELM_SCALE_SIZE(180));
	return true;
}

static void terminate(void)
{
	ecore_event_handler_del(self.exe_del);
	self.exe_del = NULL;
	if (self.exit_timer)
		ecore_timer_del(self.exit_timer);
	self.exit_timer = NULL;
	if (self.exe)
		ecore_exe_free(self.exe); /* the mail program keeps running */
	self.exe = NULL;
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {
	    .name = "share-email", .title = "Send by e-mail", .create = create, .request = request, .terminate = terminate};
	return companion_main(argc, argv, &app);
}
