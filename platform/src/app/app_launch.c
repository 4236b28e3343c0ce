/* The requester's side of launch requests: find or start the target, send, wait for its reply. */
#include <app_control.h>

#include "app_private.h"

#include <desktop/app_launch.h>

#include <dlog.h>
#include <errno.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#define LAUNCH_TIMEOUT_SEC 5.0
#define LAUNCH_POLL_USEC 20000
/* How long a sent message may wait for its receiver to take it. */
#define DELIVERY_TIMEOUT_SEC 5.0

/* A sent request that waits for its reply on its own connection. */
typedef struct {
	Ecore_Ipc_Server *server;
	int ref;
	app_control_h request;
	app_control_reply_cb callback;
	void *user_data;
} pending_reply_s;

static Eina_List *pending_replies;

/* A connection that carried a message needing no answer. It stays open until the receiver closes
   it: closing it here first could lose the message on the way. */
typedef struct {
	Ecore_Ipc_Server *server;
	Ecore_Timer *timer;
} closing_s;

static Eina_List *closing_connections;
static Ecore_Event_Handler *data_handler;
static Ecore_Event_Handler *del_handler;
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

static void pending_free(pending_reply_s *p)
{
	app_control_destroy(p->request);
	free(p);
}

/* The connection is closed once nothing waits on it any more. */
static void server_release_if_unused(Ecore_Ipc_Server *server)
{
	Eina_List *l;
	pending_reply_s *p;
	EINA_LIST_FOREACH(pending_replies, l, p)
	if (p->server == server)
		return;
	ecore_ipc_server_del(server);
}

static pending_reply_s *pending_take(Ecore_Ipc_Server *server, int ref)
{
	Eina_List *l;
	pending_reply_s *p;
	EINA_LIST_FOREACH(pending_replies, l, p)
	{
		if (p->server == server && (ref < 0 || p->ref == ref)) {
			pending_replies = eina_list_remove_list(pending_replies, l);
			return p;
		}
	}
	return NULL;
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
	pending_free(p);
}

/* The event handlers live only while a connection of ours is open. */
static void handlers_release_if_idle(void)
{
	if (pending_replies || closing_connections || !data_handler)
		return;
	ecore_event_handler_del(data_handler);
	ecore_event_handler_del(del_handler);
	data_handler = NULL;
	del_handler = NULL;
}

static Eina_Bool server_data_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	Ecore_Ipc_Event_Server_Data *ev = event;
	if (ev->major != APP_CHANNEL_MSG_REPLY)
		return ECORE_CALLBACK_PASS_ON;
	pending_reply_s *p = pending_take(ev->server, ev->ref_to);
	if (!p)
		return ECORE_CALLBACK_PASS_ON;
	app_control_h reply = ev->size > 0 ? app_control_decode_internal(ev->data, ev->size) : NULL;
	if (ev->size > 0 && !reply)
		LOGE("malformed reply from the callee");
	Ecore_Ipc_Server *server = p->server;
	pending_answer(p, reply, (app_control_result_e)ev->response);
	if (reply)
		app_control_destroy(reply);
	server_release_if_unused(server);
	handlers_release_if_idle();
	return ECORE_CALLBACK_DONE;
}

static void closing_free(closing_s *c)
{
	closing_connections = eina_list_remove(closing_connections, c);
	if (c->timer)
		ecore_timer_del(c->timer);
	ecore_ipc_server_del(c->server);
	free(c);
}

static closing_s *closing_find(Ecore_Ipc_Server *server)
{
	Eina_List *l;
	closing_s *c;
	EINA_LIST_FOREACH(closing_connections, l, c)
	if (c->server == server)
		return c;
	return NULL;
}

static Eina_Bool closing_timeout_cb(void *data)
{
	closing_s *c = data;
	c->timer = NULL;
	LOGE("the receiver did not take a message in time");
	closing_free(c);
	handlers_release_if_idle();
	return ECORE_CALLBACK_CANCEL;
}

static Eina_Bool server_del_cb(void *data, int type, void *event)
{
	(void)data;
	(void)type;
	Ecore_Ipc_Event_Server_Del *ev = event;
	closing_s *c = closing_find(ev->server);
	if (c) {
		closing_free(c);
		handlers_release_if_idle();
		return ECORE_CALLBACK_DONE;
	}
	pending_reply_s *p;
	bool ours = false;
	while ((p = pending_take(ev->server, -1))) {
		LOGI("the callee closed the request without replying");
		ours = true;
		pending_answer(p, NULL, APP_CONTROL_RESULT_CANCELED);
	}
	if (!ours)
		return ECORE_CALLBACK_PASS_ON;
	ecore_ipc_server_del(ev->server);
	handlers_release_if_idle();
	return ECORE_CALLBACK_DONE;
}

static void handlers_install(void)
{
	if (data_handler)
		return;
	data_handler = ecore_event_handler_add(ECORE_IPC_EVENT_SERVER_DATA, server_data_cb, NULL);
	del_handler = ecore_event_handler_add(ECORE_IPC_EVENT_SERVER_DEL, server_del_cb, NULL);
}

bool app_launch_send_and_release(Ecore_Ipc_Server *server, int major, int ref, const void *data, int size)
{
	int sent = ecore_ipc_server_send(server, major, 0, ref, 0, 0, data, size);
	if (sent <= 0) {
		ecore_ipc_server_del(server);
		return false;
	}
	ecore_ipc_server_flush(server);
	closing_s *c = calloc(1, sizeof(*c));
	if (!c) {
		ecore_ipc_server_del(server);
		return true;
	}
	handlers_install();
	c->server = server;
	c->timer = ecore_timer_add(DELIVERY_TIMEOUT_SEC, closing_timeout_cb, c);
	closing_connections = eina_list_append(closing_connections, c);
	return true;
}

int desktop_app_launch_drain(double timeout_sec)
{
	double end = monotonic_now() + timeout_sec;
	while (closing_connections && monotonic_now() < end) {
		ecore_main_loop_iterate();
		usleep(1000);
	}
	return closing_connections ? APP_CONTROL_ERROR_TIMED_OUT : APP_CONTROL_ERROR_NONE;
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

/* Starts the app and waits until it listens; APP_CONTROL_ERROR_NONE with *server set. */
static int start_and_connect(const char *app_id, Ecore_Ipc_Server **server)
{
	app_registry_entry_s *entry = app_registry_find(app_id);
	if (!entry)
		return launch_error(APP_CONTROL_ERROR_APP_NOT_FOUND, "no registered app has this id", app_id);
	pid_t pid = app_registry_spawn(entry);
	app_registry_entry_free(entry);
	if (pid < 0)
		return launch_error(APP_CONTROL_ERROR_LAUNCH_FAILED, "cannot start the app", app_id);

	double end = monotonic_now() + LAUNCH_TIMEOUT_SEC;
	while (!(*server = app_channel_connect(app_id))) {
		int status;
		pid_t r = waitpid(pid, &status, WNOHANG);
		if (r == pid || (r < 0 && errno == ECHILD))
			return launch_error(APP_CONTROL_ERROR_LAUNCH_FAILED, "the app ended before it took requests", app_id);
		if (monotonic_now() > end)
			return launch_error(APP_CONTROL_ERROR_TIMED_OUT, "the app did not take requests in time", app_id);
		usleep(LAUNCH_POLL_USEC);
	}
	return APP_CONTROL_ERROR_NONE;
}

/* A connection to the running target, starting it when needed. */
static int target_connect(const char *app_id, Ecore_Ipc_Server **server)
{
	*server = app_channel_connect(app_id);
	if (*server)
		return APP_CONTROL_ERROR_NONE;
	return start_and_connect(app_id, server);
}

int app_control_send_launch_request(app_control_h app_control, app_control_reply_cb callback, void *user_data)
{
	if (!app_control)
		return launch_error(APP_CONTROL_ERROR_INVALID_PARAMETER, "invalid parameter", NULL);
	char *app_id = target_resolve(app_control);
	if (!app_id)
		return launch_error(APP_CONTROL_ERROR_APP_NOT_FOUND, "no registered app takes the operation",
		                    app_control->operation);

	/* A request without operation is a default launch, and says so from now on. */
	if (!app_control->operation)
		app_control_set_operation(app_control, APP_CONTROL_OPERATION_DEFAULT);

	Ecore_Ipc_Server *server = NULL;
	int ret = target_connect(app_id, &server);
	bundle_raw *raw = NULL;
	int len = 0;
	char *caller = NULL;
	if (ret == APP_CONTROL_ERROR_NONE) {
		caller = app_paths_app_id_get();
		if (!app_control_encode_internal(app_control, caller, callback != NULL, &raw, &len))
			ret = launch_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, "cannot encode the request", app_id);
	}
	int ref = ++last_ref;
	if (ret == APP_CONTROL_ERROR_NONE && !callback) {
		if (!app_launch_send_and_release(server, APP_CHANNEL_MSG_LAUNCH, ref, raw, len))
			ret = launch_error(APP_CONTROL_ERROR_IO_ERROR, "cannot send the request", app_id);
		server = NULL;
	} else if (ret == APP_CONTROL_ERROR_NONE) {
		pending_reply_s *p = calloc(1, sizeof(*p));
		if (!p || app_control_clone(&p->request, app_control) != APP_CONTROL_ERROR_NONE) {
			free(p);
			ret = launch_error(APP_CONTROL_ERROR_OUT_OF_MEMORY, "cannot keep the request", app_id);
		} else if (ecore_ipc_server_send(server, APP_CHANNEL_MSG_LAUNCH, 0, ref, 0, 1, raw, len) <= 0) {
			pending_free(p);
			ret = launch_error(APP_CONTROL_ERROR_IO_ERROR, "cannot send the request", app_id);
		} else {
			ecore_ipc_server_flush(server);
			p->server = server;
			p->ref = ref;
			p->callback = callback;
			p->user_data = user_data;
			handlers_install();
			pending_replies = eina_list_append(pending_replies, p);
			server = NULL; /* kept until the reply */
		}
	}
	if (server)
		ecore_ipc_server_del(server);
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
	Ecore_Ipc_Server *server = app_channel_connect(app_id);
	if (!server)
		return APP_CONTROL_ERROR_APP_NOT_FOUND;
	return app_launch_send_and_release(server, major, 0, NULL, 0) ? APP_CONTROL_ERROR_NONE : APP_CONTROL_ERROR_IO_ERROR;
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
	Ecore_Ipc_Server *server = app_channel_connect(app_id);
	if (!server)
		return APP_CONTROL_ERROR_APP_NOT_FOUND;
	char *caller = app_paths_app_id_get();
	bundle_raw *raw = NULL;
	int len = 0;
	int ret = APP_CONTROL_ERROR_NONE;
	if (!app_control_encode_internal(request, caller, false, &raw, &len)) {
		ecore_ipc_server_del(server);
		ret = APP_CONTROL_ERROR_OUT_OF_MEMORY;
	} else if (!app_launch_send_and_release(server, APP_CHANNEL_MSG_LAUNCH, ++last_ref, raw, len)) {
		ret = APP_CONTROL_ERROR_IO_ERROR;
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
