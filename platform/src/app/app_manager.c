/* app_manager: running apps (their launch sockets) and registered apps (the registry). */
#include <app_common.h>
#include <app_manager.h>

#include "app_private.h"

#include <dlog.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

struct app_context_s {
	char *app_id;
	pid_t pid;
};

struct app_info_s {
	char *app_id;
	char *exec;
	char *label;
	char *icon; /* full path, "" when none */
};

static int manager_error(int code, const char *func, const char *what)
{
	LOGE("[%s] %s (0x%08x)", func, what, (unsigned int)code);
	return code;
}

#define INVALID_PARAMETER() manager_error(APP_MANAGER_ERROR_INVALID_PARAMETER, __func__, "invalid parameter")

int app_manager_is_running(const char *app_id, bool *running)
{
	if (!app_id || !running)
		return INVALID_PARAMETER();
	*running = app_channel_is_running(app_id);
	return APP_MANAGER_ERROR_NONE;
}

static struct app_context_s *context_new(const char *app_id, pid_t pid)
{
	struct app_context_s *c = calloc(1, sizeof(*c));
	if (c)
		c->app_id = strdup(app_id);
	if (!c || !c->app_id) {
		free(c);
		return NULL;
	}
	c->pid = pid;
	return c;
}

int app_manager_get_app_context(const char *app_id, app_context_h *app_context)
{
	if (!app_id || !app_context)
		return INVALID_PARAMETER();
	if (!app_channel_is_running(app_id))
		return manager_error(APP_MANAGER_ERROR_NO_SUCH_APP, __func__, "the app is not running");
	*app_context = context_new(app_id, app_channel_owner_pid(app_id));
	return *app_context ? APP_MANAGER_ERROR_NONE : APP_MANAGER_ERROR_OUT_OF_MEMORY;
}

int app_manager_resume_app(app_context_h app_context)
{
	if (!app_context)
		return INVALID_PARAMETER();
	int ret = app_channel_send_resume(app_context->app_id);
	if (ret == APP_CONTROL_ERROR_APP_NOT_FOUND)
		return manager_error(APP_MANAGER_ERROR_APP_NO_RUNNING, __func__, "the app is not running");
	if (ret != APP_CONTROL_ERROR_NONE)
		return manager_error(APP_MANAGER_ERROR_REQUEST_FAILED, __func__, "cannot reach the app");
	return APP_MANAGER_ERROR_NONE;
}

int app_manager_get_app_id(pid_t pid, char **app_id)
{
	if (!app_id || pid <= 0)
		return INVALID_PARAMETER();
	if (pid != getpid())
		return manager_error(APP_MANAGER_ERROR_NO_SUCH_APP, __func__, "only this process is known");
	*app_id = app_paths_app_id_get();
	return *app_id ? APP_MANAGER_ERROR_NONE : APP_MANAGER_ERROR_NO_SUCH_APP;
}

int app_context_destroy(app_context_h app_context)
{
	if (!app_context)
		return INVALID_PARAMETER();
	free(app_context->app_id);
	free(app_context);
	return APP_MANAGER_ERROR_NONE;
}

int app_context_get_app_id(app_context_h app_context, char **app_id)
{
	if (!app_context || !app_id)
		return INVALID_PARAMETER();
	*app_id = strdup(app_context->app_id);
	return *app_id ? APP_MANAGER_ERROR_NONE : APP_MANAGER_ERROR_OUT_OF_MEMORY;
}

int app_context_get_pid(app_context_h app_context, pid_t *pid)
{
	if (!app_context || !pid)
		return INVALID_PARAMETER();
	*pid = app_context->pid;
	return APP_MANAGER_ERROR_NONE;
}

int app_context_clone(app_context_h *clone, app_context_h app_context)
{
	if (!clone || !app_context)
		return INVALID_PARAMETER();
	*clone = context_new(app_context->app_id, app_context->pid);
	return *clone ? APP_MANAGER_ERROR_NONE : APP_MANAGER_ERROR_OUT_OF_MEMORY;
}

/* ---- app_info ---- */

/* The icon as a path: absolute as given, else under "<root>/shared/res/". */
static char *icon_path_new(const app_registry_entry_s *e)
{
	if (!e->icon || !*e->icon)
		return strdup("");
	if (e->icon[0] == '/' || !e->root)
		return strdup(e->icon);
	char path[PATH_MAX];
	snprintf(path, sizeof(path), "%s/shared/res/%s", e->root, e->icon);
	return strdup(path);
}

static void info_free(struct app_info_s *info)
{
	if (!info)
		return;
	free(info->app_id);
	free(info->exec);
	free(info->label);
	free(info->icon);
	free(info);
}

static struct app_info_s *info_new(const char *app_id, const char *exec, const char *label, char *icon)
{
	struct app_info_s *info = calloc(1, sizeof(*info));
	if (!info) {
		free(icon);
		return NULL;
	}
	info->app_id = strdup(app_id);
	info->exec = strdup(exec ? exec : "");
	info->label = strdup(label ? label : app_id);
	info->icon = icon;
	if (!info->app_id || !info->exec || !info->label || !info->icon) {
		info_free(info);
		return NULL;
	}
	return info;
}

int app_manager_get_app_info(const char *app_id, app_info_h *app_info)
{
	if (!app_id || !app_info)
		return INVALID_PARAMETER();
	app_registry_entry_s *e = app_registry_find(app_id);
	if (!e)
		return manager_error(APP_MANAGER_ERROR_NO_SUCH_APP, __func__, "no registered app has this id");
	*app_info = info_new(e->id, e->exec, e->label, icon_path_new(e));
	app_registry_entry_free(e);
	return *app_info ? APP_MANAGER_ERROR_NONE : APP_MANAGER_ERROR_OUT_OF_MEMORY;
}

int app_info_destroy(app_info_h app_info)
{
	if (!app_info)
		return INVALID_PARAMETER();
	info_free(app_info);
	return APP_MANAGER_ERROR_NONE;
}

int app_info_clone(app_info_h *clone, app_info_h app_info)
{
	if (!clone || !app_info)
		return INVALID_PARAMETER();
	*clone = info_new(app_info->app_id, app_info->exec, app_info->label, strdup(app_info->icon));
	return *clone ? APP_MANAGER_ERROR_NONE : APP_MANAGER_ERROR_OUT_OF_MEMORY;
}

static int info_text(const char *field, char **out, const char *func)
{
	if (!out)
		return manager_error(APP_MANAGER_ERROR_INVALID_PARAMETER, func, "invalid parameter");
	*out = strdup(field);
	return *out ? APP_MANAGER_ERROR_NONE : APP_MANAGER_ERROR_OUT_OF_MEMORY;
}

int app_info_get_app_id(app_info_h app_info, char **app_id)
{
	return app_info ? info_text(app_info->app_id, app_id, __func__) : INVALID_PARAMETER();
}

int app_info_get_exec(app_info_h app_info, char **exec)
{
	return app_info ? info_text(app_info->exec, exec, __func__) : INVALID_PARAMETER();
}

int app_info_get_label(app_info_h app_info, char **label)
{
	return app_info ? info_text(app_info->label, label, __func__) : INVALID_PARAMETER();
}

int app_info_get_icon(app_info_h app_info, char **path)
{
	return app_info ? info_text(app_info->icon, path, __func__) : INVALID_PARAMETER();
}
