/* com.veltron.veltronaccount: confirms the signed-in account for "/appcontrol/operation/confirmpassword". The
   window names the account of the package com.veltron.veltronaccount from the account store (the vconf key
   "db/desktop/account/list") and asks for the password of the desktop user, which PAM checks through the
   service "com.veltron.veltronaccount". The answer: "succeeded" for the right password, "failed" with
   "errorMessage" for a wrong one or no signed-in account, "canceled" when the user cancels or closes the window.
   VELTRON_ACCOUNT_TEST_PASSWORD, when set, is the one right password and PAM is not asked. */
#define _GNU_SOURCE
#include "companion.h"

#include <account.h>
#include <app.h>
#include <desktop/app_install.h>
#include <dlog.h>
#include <pwd.h>
#include <security/pam_appl.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#define SERVICE_NAME "com.veltron.veltronaccount"
#define CONFIRM_OPERATION "http://tizen.org/appcontrol/operation/confirmpassword"
#define TEST_PASSWORD_ENV "VELTRON_ACCOUNT_TEST_PASSWORD"
/* Test hook: text typed (as key events) into the password field once the window shows a request. */
#define TEST_TYPE_ENV "COMPANION_TEST_TYPE"
#define ERROR_KEY "errorMessage"

static struct {
	Evas_Object *account;
	Evas_Object *entry;
	Evas_Object *ok;
	Evas_Object *cancel;
	char *account_name; /* NULL when no account is signed in */
	bool checking;
	bool typed;
} ui;

/* One password check, run off the main loop: PAM may wait a while after a wrong password. */
typedef struct {
	char *user;
	char *password;
	char *test_password;
	char *confdir; /* NULL: the system's PAM folder */
	bool ok;
	char *error;
} check_job_s;

static bool account_found_cb(account_h account, void *data)
{
	char **name = data;
	char *user = NULL, *email = NULL;
	account_get_user_name(account, &user);
	account_get_email_address(account, &email);
	char *joined = NULL;
	free(*name);
	if (email && *email && user && *user && asprintf(&joined, "%s (%s)", user, email) >= 0)
		*name = joined;
	else
		*name = strdup(email && *email ? email : user ? user : "");
	free(user);
	free(email);
	return false;
}

/* The signed-in account as "user (email)", or NULL (malloc'ed). */
static char *account_name_new(void)
{
	char *name = NULL;
	if (account_connect() != ACCOUNT_ERROR_NONE)
		return NULL;
	if (account_query_account_by_package_name(account_found_cb, SERVICE_NAME, &name) != ACCOUNT_ERROR_NONE) {
		free(name);
		name = NULL;
	}
	account_disconnect();
	return name;
}

/* The folder of the service file: none (the system's) when the system has it, else the one installed beside
   this program. */
static char *pam_confdir_new(void)
{
	if (access("/etc/pam.d/" SERVICE_NAME, R_OK) == 0)
		return NULL;
	return desktop_app_install_path_get("pam.d");
}

static int pam_conversation_cb(int count, const struct pam_message **messages, struct pam_response **responses,
                               void *data)
{
	const check_job_s *job = data;
	struct pam_response *answers = calloc((size_t)count, sizeof(*answers));
	if (!answers)
		return PAM_BUF_ERR;
	for (int i = 0; i < count; i++) {
		int style = messages[i]->msg_style;
		if (style == PAM_PROMPT_ECHO_OFF || style == PAM_PROMPT_ECHO_ON)
			answers[i].resp = strdup(job->password);
	}
	*responses = answers;
	return PAM_SUCCESS;
}

static void check_run_cb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	check_job_s *job = data;
	if (job->test_password) {
		job->ok = !strcmp(job->password, job->test_password);
		if (!job->ok)
			job->error = strdup("Authentication failure");
		return;
	}
	struct pam_conv conversation = {pam_conversation_cb, job};
	pam_handle_t *pam = NULL;
	int ret = job->confdir ? pam_start_confdir(SERVICE_NAME, job->user, &conversation, job->confdir, &pam)
	                       : pam_start(SERVICE_NAME, job->user, &conversation, &pam);
	if (ret == PAM_SUCCESS)
		ret = pam_authenticate(pam, PAM_DISALLOW_NULL_AUTHTOK);
	if (ret == PAM_SUCCESS)
		ret = pam_acct_mgmt(pam, 0);
	job->ok = ret == PAM_SUCCESS;
	if (!job->ok)
		job->error = strdup(pam ? pam_strerror(pam, ret) : "PAM could not start");
	if (pam)
		pam_end(pam, ret);
}

static void check_job_free(check_job_s *job)
{
	if (job->password)
		memset(job->password, 0, strlen(job->password));
	free(job->user);
	free(job->password);
	free(job->test_password);
	free(job->confdir);
	free(job->error);
	free(job);
}

static void answer_failed(const char *message)
{
	app_control_h reply = NULL;
	app_control_create(&reply);
	app_control_add_extra_data(reply, ERROR_KEY, message);
	companion_request_answer(APP_CONTROL_RESULT_FAILED, reply);
	app_control_destroy(reply);
}

static void check_end_cb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	check_job_s *job = data;
	LOGI("password check for %s: %s", job->user, job->ok ? "right" : job->error);
	if (job->ok)
		companion_request_answer(APP_CONTROL_RESULT_SUCCEEDED, NULL);
	else
		answer_failed(job->error ? job->error : "Authentication failure");
	check_job_free(job);
	ui_app_exit();
}

static void check_cancel_cb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	check_job_free(data);
}

static void ok_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	if (ui.checking || !companion_request_get())
		return;
	if (!ui.account_name) {
		answer_failed("No account is signed in");
		ui_app_exit();
		return;
	}
	struct passwd *pw = getpwuid(getuid());
	check_job_s *job = calloc(1, sizeof(*job));
	if (!job || !pw) {
		free(job);
		answer_failed("The desktop user is unknown");
		ui_app_exit();
		return;
	}
	const char *test_password = getenv(TEST_PASSWORD_ENV);
	job->user = strdup(pw->pw_name);
	job->password = elm_entry_markup_to_utf8(elm_entry_entry_get(ui.entry));
	job->test_password = test_password ? strdup(test_password) : NULL;
	job->confdir = pam_confdir_new();
	if (!job->password)
		job->password = strdup("");
	ui.checking = true;
	elm_object_disabled_set(ui.ok, EINA_TRUE);
	elm_entry_entry_set(ui.entry, "");
	ecore_thread_run(check_run_cb, check_end_cb, check_cancel_cb, job);
}

static void cancel_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	if (ui.checking)
		return;
	companion_request_answer(APP_CONTROL_RESULT_CANCELED, NULL);
	ui_app_exit();
}

static void request(app_control_h request)
{
	char *operation = NULL;
	app_control_get_operation(request, &operation);
	bool known = operation && !strcmp(operation, CONFIRM_OPERATION);
	free(operation);
	if (!known) {
		answer_failed("Unsupported operation");
		return;
	}
	free(ui.account_name);
	ui.account_name = account_name_new();
	char *user = ui.account_name ? elm_entry_utf8_to_markup(ui.account_name) : NULL;
	struct passwd *pw = getpwuid(getuid());
	char *text = NULL;
	if (user && asprintf(&text, "<b>%s</b><br>To confirm this account, enter the password of %s.", user,
	                     pw ? pw->pw_name : "this user") < 0)
		text = NULL;
	elm_object_text_set(ui.account, text ? text : "<b>No account is signed in.</b>");
	elm_object_disabled_set(ui.entry, !ui.account_name);
	free(text);
	free(user);
	ui.typed = false;
	elm_object_focus_set(ui.entry, EINA_TRUE);
}

/* The test hook's typing: the text goes in as key presses on the focused field, then the click may follow. */
static bool test_ready(void)
{
	const char *text = getenv(TEST_TYPE_ENV);
	if (!text || !ui.entry || elm_object_disabled_get(ui.entry))
		return true;
	if (ui.typed) {
		char *now = elm_entry_markup_to_utf8(elm_entry_entry_get(ui.entry));
		bool done = now && !strcmp(now, text);
		free(now);
		return done;
	}
	Evas *e = evas_object_evas_get(ui.entry);
	evas_focus_in(e);
	elm_object_focus_set(ui.entry, EINA_TRUE);
	unsigned int ts = (unsigned int)(ecore_time_get() * 1000);
	for (const char *p = text; *p; p++) {
		char typed[2] = {*p, '\0'};
		evas_event_feed_key_down(e, typed, typed, typed, typed, ts++, NULL);
		evas_event_feed_key_up(e, typed, typed, typed, typed, ts++, NULL);
	}
	ui.typed = true;
	return false;
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	ui.account = companion_label_add(box, "");
	ui.entry = elm_entry_add(box);
	elm_entry_single_line_set(ui.entry, EINA_TRUE);
	elm_entry_password_set(ui.entry, EINA_TRUE);
	elm_entry_scrollable_set(ui.entry, EINA_TRUE);
	elm_object_part_text_set(ui.entry, "elm.guide", "Password");
	evas_object_size_hint_weight_set(ui.entry, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(ui.entry, EVAS_HINT_FILL, 0.5);
	evas_object_smart_callback_add(ui.entry, "activated", ok_clicked_cb, NULL);
	elm_box_pack_end(box, ui.entry);
	evas_object_show(ui.entry);
	ui.ok = companion_button_add(box, "OK", ok_clicked_cb, NULL);
	ui.cancel = companion_button_add(box, "Cancel", cancel_clicked_cb, NULL);
	evas_object_resize(win, ELM_SCALE_SIZE(420), ELM_SCALE_SIZE(240));
	return true;
}

static void terminate(void)
{
	free(ui.account_name);
	ui.account_name = NULL;
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {.name = "veltronaccount",
	                                    .title = "Confirm account",
	                                    .create = create,
	                                    .request = request,
	                                    .terminate = terminate,
	                                    .test_ready = test_ready};
	return companion_main(argc, argv, &app);
}
