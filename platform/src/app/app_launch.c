/* The requester's side of launch requests: find or start the target, send, wait for its reply. */
#include <app_control.h>

#include "app_private.h"

#include <dlog.h>
#include <errno.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#define LAUNCH_TIMEOUT_SEC 5.0
#define LAUNCH_POLL_USEC 20000

/* A sent request that waits for its reply on its own connection. */
typedef struct {
	int ref;
	app_control_h request;
	app_control_reply_cb callback;
	void *user_data;
} pending_reply_s;

static int last_ref;

static int launch_error(int code, const char *what, const char *app_id)
{
	LOGE("launch request to %s: %s (0x%08x)", app_id ? app_id : "(any)", what, (unsigned int)code);
	return code;
}

static double monotonic_now(void)
{
	struct timespec ts;
	clock_gettime(CLOCK_MONOTONIC, &ts);
	return ts.tv_sec + ts.tv_nsec / 1e9;
}

static void pending_answer(pending_reply_s *p, app_control_h reply, app_control_result_e result)
{
	app_control_h empty = NULL;
	if (!reply && app_control_create(&empty) == APP_CONTROL_ERROR_NONE)
		reply = empty;
	if (p->callback)
		p->callback(p->request, reply, result, p->user_data);
	if (empty)
		app_control_destroy(empty);
}

static void pending_free(pending_reply_s *p)
{
	app_control_destroy(p->request);
	free(p);
}

static void reply_message_cb(void *data, app_message_reader_s *reader, const app_message_s *msg)
{
	pending_reply_s *p = data;
	if (!msg) {
		LOGI("the callee closed the request without replying");
		pending_answer(p, NULL, APP_CONTROL_RESULT_CANCELED);
		pending_free(p);
		return;
	}
	if (msg->major != APP_CHANNEL_MSG_REPLY || msg->ref != p->ref)
		return;
	app_control_h reply = msg->size > 0 ? app_control_decode_internal(msg->data, msg->size) : NULL;
	if (msg->size > 0 && !reply)
		LOGE("malformed reply from the callee");
	pending_answer(p, reply, (app_control_result_e)msg->response);
	if (reply)
		app_control_destroy(reply);
	/* One reply per request: the connection ends here, and with it this call's last use of p. */
	app_message_reader_del(reader);
	pending_free(p);
}

/* Sends one message on fd and closes it; what the receiver still has to read stays in its socket. */
static int send_and_close(int fd, int major, int ref, const void *data, int size)
{
	app_message_s msg = {major, ref, 0, size, data};
	int ret = app_message_send(fd, &msg, APP_MESSAGE_SEND_TIMEOUT_SEC);
	close(fd);
	return ret;
}

typedef struct {
	const char *operation;
	char *found;
} match_first_s;

static bool match_first_cb(const app_registry_entry_s *entry, void *data)
{
	match_first_s *m = data;
	if (!app_registry_entry_handles(entry, m->operation))
		return true;
	m->found = strdup(entry->id);
	return false;
}

/* The id the request goes to: its app id, or the first registered app taking its operation. */
static char *target_resolve(app_control_h app_control)
{
	if (app_control->app_id)
		return strdup(app_control->app_id);
	match_first_s m = {app_control->operation, NULL};
	if (m.operation)
		app_registry_foreach(match_first_cb, &m);
	return m.found;
}

/* Starts the app and waits until it listens; APP_CONTROL_ERROR_NONE with *fd set. */
static int start_and_connect(const char *app_id, int *fd)
{
	app_registry_entry_s *entry = app_registry_find(app_id);
	if (!entry)
		return launch_error(APP_CONTROL_ERROR_APP_NOT_FOUND, "no registered app has this id", app_id);
	pid_t pid = app_registry_spawn(entry);
	app_registry_entry_free(entry);
	if (pid < 0)
		return launch_error(APP_CONTROL_ERROR_LAUNCH_FAILED, "cannot start the app", app_id);

	double end = monotonic_now() + LAUNCH_TIMEOUT_SEC;
	for (;;) {
		int ret = app_channel_connect(app_id, fd);
		if (ret != APP_CONTROL_ERROR_APP_NOT_FOUND)
			return ret == APP_CONTROL_ERROR_NONE ? ret : launch_error(ret, "the app takes no connection", app_id);
		int status;
		pid_t r = waitpid(pid, &status, WNOHANG);
		if (r == pid || (r < 0 && errno == ECHILD))
			return launch_error(APP_CONTROL_ERROR_LAUNCH_FAILED, "the app ended before it took requests", app_id);
		if (monotonic_now() > end)
			return launch_error(APP_CONTROL_ERROR_TIMED_OUT, "the app did not take requests in time", app_id);
		usleep(LAUNCH_POLL_USEC);
	}
}

/* A connection to the running target, starting it when needed. */
static int target_connect(const char *app_id, int *fd)
{
	int ret = app_channel_connect(app_id, fd);
	if (ret != APP_CONTROL_ERROR_APP_NOT_FOUND)
		return ret == APP_CONTROL_ERROR_NONE ? ret : launch_error(ret, "the app takes no connection", app_id);
	return start_and_connect(app_id, fd);
}

int app_control_send_launch_request(app_control_h app_control, app_control_reply_cb callback, void *user_data)
{
	if (!app_control)
		return launch_error(APP_CONTROL_ERROR_INVALID_PARAMETER, "invalid parameter", NULL);
	/* No app named: the registered apps that take the operation, picked by the user when several do. */
	if (!app_control->app_id && app_control->operation)
		return app_chooser_send(app_control, callback, user_data);
	char *app_id = target_resolve(app_control);
	if (!app_id)
		return launch_error(APP_CONTROL_ERROR_APP_NOT_FOUND, "no registered app takes the operation",
		                    app_control->operation);

	/* A request without operation is a default launch, and says so from now on. */
	if (!app_control->operation)
		app_control_set_operation(app_control, APP_CONTROL_OPERATION_DEFAULT);

	int fd = -1;
	int ret = target_connect(app_id, &fd);
	bundle_raw *raw = NULL;
	int len = 0;
	char *caller = NULL;
	if (ret == APP_CONTROL_ERROR_NONE) {
		caller = app_paths_app_id_get();
		if (!app_control_encode_internal(app_control, caller, callback != NULL, &raw, &len))
			ret = launch_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, "cannot encode the request", app_id);
	}
	int ref = ++last_ref;
	pending_reply_s *p = NULL;
	if (ret == APP_CONTROL_ERROR_NONE && callback) {
		p = calloc(1, sizeof(*p));
		if (!p || app_control_clone(&p->request, app_control) != APP_CONTROL_ERROR_NONE) {
			free(p);
			p = NULL;
			ret = launch_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, "cannot keep the request", app_id);
		}
	}
	if (ret == APP_CONTROL_ERROR_NONE) {
		app_message_s msg = {APP_CHANNEL_MSG_LAUNCH, ref, callback ? 1 : 0, len, raw};
		ret = app_message_send(fd, &msg, APP_MESSAGE_SEND_TIMEOUT_SEC);
		if (ret != APP_CONTROL_ERROR_NONE)
			launch_error(ret, "the app did not take the request", app_id);
	}
	if (ret == APP_CONTROL_ERROR_NONE && p) {
		/* The reply comes back on this connection. */
		p->ref = ref;
		p->callback = callback;
		p->user_data = user_data;
		app_message_reader_s *reader = app_message_reader_add(fd, true, reply_message_cb, p);
		fd = -1;
		if (!reader) {
			pending_free(p);
			ret = launch_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, "cannot wait for the reply", app_id);
		}
	} else if (p) {
		pending_free(p);
	}
	if (fd >= 0)
		close(fd);
	if (ret == APP_CONTROL_ERROR_NONE)
		LOGI("launch request sent to %s (%s)", app_id,
		     app_control->operation ? app_control->operation : "no operation");
	free(raw);
	free(caller);
	free(app_id);
	return ret;
}

/* Sends a message without payload to a running app. */
static int send_simple(const char *app_id, int major)
{
	int fd = -1;
	int ret = app_channel_connect(app_id, &fd);
	return ret == APP_CONTROL_ERROR_NONE ? send_and_close(fd, major, 0, NULL, 0) : ret;
}

int app_control_send_terminate_request(app_control_h app_control)
{
	if (!app_control || !app_control->app_id)
		return launch_error(APP_CONTROL_ERROR_INVALID_PARAMETER, "terminate needs an app id", NULL);
	int ret = send_simple(app_control->app_id, APP_CHANNEL_MSG_TERMINATE);
	if (ret != APP_CONTROL_ERROR_NONE)
		return launch_error(ret, "cannot ask the app to end (not running?)", app_control->app_id);
	LOGI("asked %s to end", app_control->app_id);
	return APP_CONTROL_ERROR_NONE;
}

int app_channel_send_resume(const char *app_id)
{
	return send_simple(app_id, APP_CHANNEL_MSG_RESUME);
}

int app_launch_forward(app_control_h request, const char *app_id)
{
	int fd = -1;
	int ret = app_channel_connect(app_id, &fd);
	if (ret != APP_CONTROL_ERROR_NONE)
		return ret;
	char *caller = app_paths_app_id_get();
	bundle_raw *raw = NULL;
	int len = 0;
	if (app_control_encode_internal(request, caller, false, &raw, &len)) {
		ret = send_and_close(fd, APP_CHANNEL_MSG_LAUNCH, ++last_ref, raw, len);
	} else {
		close(fd);
		ret = APP_CONTROL_ERROR_OUT_OF_MEMORY;
	}
	free(raw);
	free(caller);
	return ret;
}

typedef struct {
	app_control_h app_control;
	app_control_app_matched_cb callback;
	void *user_data;
} match_all_s;

static bool match_all_cb(const app_registry_entry_s *entry, void *data)
{
	match_all_s *m = data;
	if (m->app_control->app_id && strcmp(m->app_control->app_id, entry->id))
		return true;
	if (!m->app_control->app_id && !app_registry_entry_handles(entry, m->app_control->operation))
		return true;
	return m->callback(m->app_control, entry->id, m->user_data);
}

int app_control_foreach_app_matched(app_control_h app_control, app_control_app_matched_cb callback, void *user_data)
{
	if (!app_control || !callback)
		return launch_error(APP_CONTROL_ERROR_INVALID_PARAMETER, "invalid parameter", NULL);
	match_all_s m = {app_control, callback, user_data};
	app_registry_foreach(match_all_cb, &m);
	return APP_CONTROL_ERROR_NONE;
}
