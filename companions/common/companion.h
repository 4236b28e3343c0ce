/* What the companion programs share: the app skeleton with its one window, the request being served and
   its answer, the user's folders, and the hooks that let tests drive a companion from outside. */
#ifndef COMPANIONS_COMMON_COMPANION_H
#define COMPANIONS_COMMON_COMPANION_H

#include <Elementary.h>
#include <app_control.h>
#include <stdbool.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Test hook: the label of a button that is pressed (by mouse events on its centre) once the window shows it
   after a request, e.g. "OK" or "Delete". */
#define COMPANION_TEST_CLICK_ENV "COMPANION_TEST_CLICK"
/* Test hook: a path that file selectors start with as their selection. */
#define COMPANION_TEST_SELECT_ENV "COMPANION_TEST_SELECT"

#define COMPANION_KEY_SELECTED "http://tizen.org/appcontrol/data/selected"
#define COMPANION_KEY_PATH "http://tizen.org/appcontrol/data/path"
#define COMPANION_KEY_TEXT "http://tizen.org/appcontrol/data/text"
#define COMPANION_KEY_SUBJECT "http://tizen.org/appcontrol/data/subject"

typedef struct {
	const char *name;  /* window name and class */
	const char *title; /* window title */
	/* Fills the window's vertical box once, at start; false ends the app. */
	bool (*create)(Evas_Object *win, Evas_Object *box);
	/* A request to serve; it stays kept (companion_request_get) until answered or replaced. */
	void (*request)(app_control_h request);
	/* The app ends; an unanswered request is answered "canceled" after this. May be NULL. */
	void (*terminate)(void);
	/* For the click test hook: true once the window is ready for the press (NULL: at once). */
	bool (*test_ready)(void);
} companion_app_s;

/* Runs the app: one window with a vertical box, each request kept and handed to app->request. */
int companion_main(int argc, char **argv, const companion_app_s *app);

/* The app's window, or NULL before create. */
Evas_Object *companion_window_get(void);

/* The request being served, or NULL. */
app_control_h companion_request_get(void);
/* True when the request being served asks for a reply. */
bool companion_request_wants_reply(void);
/* Answers the request being served, once, with the extra data of reply (NULL: none). False when there is
   nothing to answer. */
bool companion_request_answer(app_control_result_e result, app_control_h reply);
/* Answers with one array of paths under key. */
bool companion_request_answer_paths(app_control_result_e result, const char *key, const char **paths, int count);

/* The extra data of the request as text, or NULL (malloc'ed). */
char *companion_extra_get(app_control_h request, const char *key);
/* The request's paths: the array under key, or the single value, or NULL; *count set (malloc'ed, free with
   companion_strings_free). */
char **companion_extra_paths_get(app_control_h request, const char *key, int *count);
void companion_strings_free(char **strings, int count);

/* The path of a "file://" uri or of a plain absolute path (malloc'ed); NULL for other schemes. */
char *companion_path_from_uri(const char *uri);
/* The user's folder of a kind known to xdg-user-dir (e.g. "PICTURES"): its answer when that is an
   existing folder other than home, else "~/<fallback>" when it exists (or, with create, can be made),
   else home (malloc'ed). */
char *companion_user_dir_get(const char *kind, const char *fallback, bool create);

/* A centred label with the text in the box (markup allowed, lines wrap). */
Evas_Object *companion_label_add(Evas_Object *box, const char *text);
/* A button with the label in the box, calling cb with data when clicked. */
Evas_Object *companion_button_add(Evas_Object *box, const char *label, Evas_Smart_Cb cb, const void *data);

#ifdef __cplusplus
}
#endif

#endif /* COMPANIONS_COMMON_COMPANION_H */
