/* Shared internals of the application layer: registry, launch channel, lifecycle hooks. */
#ifndef PLATFORM_SRC_APP_APP_PRIVATE_H
#define PLATFORM_SRC_APP_APP_PRIVATE_H

#include <app_control.h>
#include <bundle.h>
#include <stdbool.h>
#include <sys/types.h>

#include <Ecore.h>
#include <Evas.h>

#ifdef __cplusplus
extern "C" {
#endif

/* ---- paths (app_paths.c) ---- */

/* The app id of this process (malloc'ed) or NULL; never logs. */
char *app_paths_app_id_get(void);
/* Creates every missing folder of path (mode 0700); true when it exists afterwards. Never logs. */
bool app_paths_mkdir_p(const char *path);
/* True when the folder belongs to this user and only this user may open it: a looser mode is mended,
   another user's folder is refused. Logs a refusal. */
bool app_paths_dir_is_private(const char *dir);
/* Folder of per-user run-time files (pid files, logs of started apps), created; malloc'ed, no trailing "/". */
char *app_paths_runtime_dir_get(void);
/* Label and icon of the manifest beside the executable, malloc'ed, or NULL. */
char *app_paths_manifest_value_get(const char *what);

/* ---- registry (app_registry.c) ---- */

/* Set in a spawned app's environment: its first request comes over the launch socket, not argv. */
#define APP_LAUNCH_WAIT_ENV "TIZEN_APP_LAUNCH_WAIT"

/* One "<id>.ini" entry of the launch registry. */
typedef struct {
	char *id;
	char *exec;
	char *root;
	char *label;
	char *icon;
	char *operations; /* comma-separated, may be NULL */
	char *mimes;      /* comma-separated, may be NULL: then any */
} app_registry_entry_s;

/* Looks the id up in TIZEN_APPS_DIR (colon-separated), the installed tree's folder and then the built-in one;
   NULL if absent. */
app_registry_entry_s *app_registry_find(const char *app_id);
/* Calls cb for every entry (first folder wins for a duplicate id); cb returns false to stop. */
void app_registry_foreach(bool (*cb)(const app_registry_entry_s *entry, void *data), void *data);
/* True when the entry handles the operation (an entry without operations takes none). */
bool app_registry_entry_handles(const app_registry_entry_s *entry, const char *operation);
/* True when the entry handles the operation and, for a request with a mime type, declares no mime types
   or one that matches it (a "*" subtype matches every subtype of its type, either way round). */
bool app_registry_entry_takes(const app_registry_entry_s *entry, const char *operation, const char *mime);
void app_registry_entry_free(app_registry_entry_s *entry);
/* Starts the entry's program with TIZEN_APP_ID=<id> and the "wait for the request" mark; pid or -1 (logged). */
pid_t app_registry_spawn(const app_registry_entry_s *entry);

/* ---- requests without an app id (app_chooser.c) ---- */

/* Sends a request that names an operation but no app: to the one registered app that takes it, or,
   when several do, to the one the user picks in a chooser window (the reply callback then answers
   "canceled" when the chooser is closed). APP_CONTROL_ERROR_APP_NOT_FOUND when none takes it. */
int app_chooser_send(app_control_h request, app_control_reply_cb callback, void *user_data);

/* ---- handle internals (app_control.c) ---- */

struct app_control_s {
	char *operation;
	char *uri;
	char *mime;
	char *category;
	char *app_id;
	app_control_launch_mode_e launch_mode;
	bundle *data; /* extra data only */
	/* Set on requests received from another process. */
	char *caller;
	bool reply_requested;
	unsigned int reply_token; /* 0: not a received request */
};

/* Serialises every field and the extra data into one bundle text (malloc'ed, caller frees). */
bool app_control_encode_internal(app_control_h app_control, const char *caller, bool reply_requested, bundle_raw **raw,
                                 int *len);
/* Rebuilds a handle (with caller and reply flag) from app_control_encode_internal's text; NULL if malformed. */
app_control_h app_control_decode_internal(const bundle_raw *raw, int len);
/* True for keys the platform keeps for itself. */
bool app_control_key_is_reserved(const char *key);

/* ---- messages on launch sockets (app_message.c) ---- */

/* How long one message may take to be handed over before its receiver counts as stopped or gone. */
#define APP_MESSAGE_SEND_TIMEOUT_SEC 2.0

/* Message kinds on an app's launch socket. */
enum {
	APP_CHANNEL_MSG_LAUNCH = 1, /* ref: request number, response: 1 if a reply is wanted, data: request */
	APP_CHANNEL_MSG_REPLY = 2,  /* ref: the request answered, response: result, data: reply */
	APP_CHANNEL_MSG_TERMINATE = 3,
	APP_CHANNEL_MSG_RESUME = 4,
	APP_CHANNEL_MSG_PORT = 5, /* on a message port's socket, data: message_port.c's message */
};

typedef struct {
	int major;
	int ref;
	int response;
	int size;
	const void *data;
} app_message_s;

/* Writes one message on a connected socket without blocking for longer than timeout_sec:
   APP_CONTROL_ERROR_NONE once the receiver's socket holds all of it, TIMED_OUT when it took nothing
   more for that long (stopped or hung), IO_ERROR when it is gone. After a failure the connection
   is unusable (a message may be cut): the caller closes it. Logs failures. */
int app_message_send(int fd, const app_message_s *msg, double timeout_sec);

typedef struct app_message_reader_s app_message_reader_s;
/* Gets each whole message, then NULL once when the connection ends; the reader is freed after that call. */
typedef void (*app_message_cb)(void *data, app_message_reader_s *reader, const app_message_s *msg);

/* Reads messages from fd, which it owns; NULL (fd closed) on failure. With watch, it reads whenever data
   comes on the main loop; without, only when its owner calls app_message_reader_read. */
app_message_reader_s *app_message_reader_add(int fd, bool watch, app_message_cb callback, void *data);
/* Reads what has come and hands whole messages over; false when the connection ended (reader freed). */
bool app_message_reader_read(app_message_reader_s *reader);
int app_message_reader_fd_get(const app_message_reader_s *reader);
/* Closes the connection; allowed inside the reader's own callback. */
void app_message_reader_del(app_message_reader_s *reader);

/* ---- launch channel (app_channel.c) ---- */

/* Connects to the launch socket of a running app: APP_CONTROL_ERROR_NONE with a non-blocking *fd,
   APP_NOT_FOUND when nobody listens there, TIMED_OUT when the app takes no connection in time. */
int app_channel_connect(const char *app_id, int *fd);
/* True when an app with this id listens on its launch socket. */
bool app_channel_is_running(const char *app_id);
/* This app's listening launch socket (non-blocking), or -1 when another instance owns it. */
int app_channel_listen(const char *app_id);
/* Closes the listening socket and gives up the ownership taken by app_channel_listen. */
void app_channel_unlisten(const char *app_id, int fd);
/* The socket id of an app's message port, "<app id>@<port>" (malloc'ed); app_channel_connect and
   app_channel_is_running take it like an app id. */
char *app_channel_port_id_get(const char *app_id, const char *port);
/* Listens on a message port's socket (non-blocking); -1 when another process listens there. */
int app_channel_port_listen(const char *port_id);
void app_channel_port_unlisten(const char *port_id, int fd);
/* True when the process at the other end of a connected socket runs as this user; logs a refusal. */
bool app_channel_peer_allowed(int fd);
/* Pid of the process that owns app_id's launch socket, or -1. */
pid_t app_channel_owner_pid(const char *app_id);
/* Asks a running app to bring its windows to the front; APP_CONTROL_ERROR_* (APP_NOT_FOUND if not running). */
int app_channel_send_resume(const char *app_id);
/* Sends a request to an already running app_id, never starting it; APP_CONTROL_ERROR_*. */
int app_launch_forward(app_control_h request, const char *app_id);

/* ---- the running app's side (app_server.c) ---- */

/* Opens this app's launch socket; false when another instance owns it. */
bool app_server_start(const char *app_id);
void app_server_stop(void);
/* Sends the reply of a received request; APP_CONTROL_ERROR_* */
int app_server_reply(unsigned int reply_token, app_control_h reply, app_control_result_e result);

/* ---- lifecycle hooks (app_main.c) ---- */

/* Delivers a request to the app's app_control callback (raising its windows when not the first). */
void app_main_deliver_request(app_control_h request);
/* Brings the app's windows to the front. */
void app_main_raise(void);
/* True while ui_app_main runs. */
bool app_main_is_running(void);

/* ---- events (app_event.c) ---- */

/* Device rotation in degrees (0, 90, 180, 270); a desktop has no sensor, so this vconf key stands in. */
#define APP_ROTATION_VCONF_KEY "memory/desktop/rotation"

/* Starts and stops the device-state watches behind the app events (language, rotation, region ...). */
void app_event_watch_start(void);
void app_event_watch_stop(void);
/* Applies the language of the device (vconf) to gettext and the C library's locale. */
void app_event_language_apply(void);
/* Applies the stored rotation to the windows (after create, when it is not 0). */
void app_event_rotation_apply(void);

/* ---- windows (app_window.c) ---- */

/* Every top-level Elementary window of this process but the minicontrol windows, which their viewers
   place, show and rotate. The list is freed by the caller (eina_list_free). */
Eina_List *app_window_list_get(void);
/* True for a window of minicontrol_create_window (ui/minicontrol.c). */
bool app_window_is_minicontrol(Evas_Object *win);
/* The first visible window (else the first one), or NULL. */
Evas_Object *app_window_main_get(void);
/* De-iconifies, raises and activates every window. */
void app_window_raise_all(void);
/* Rotates every window that takes the rotation, and announces it with "wm,rotation,changed". */
void app_window_rotate_all(int degree);

/* ---- screenshot hook (app_screenshot.c) ---- */

/* With TIZEN_SCREENSHOT=<png> set, saves the main window's canvas a moment after the first request
   (and ends the app with TIZEN_SCREENSHOT_EXIT=1). */
void app_screenshot_schedule(void);
void app_screenshot_cancel(void);

#ifdef __cplusplus
}
#endif

#endif /* PLATFORM_SRC_APP_APP_PRIVATE_H */
