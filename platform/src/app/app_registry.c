/* The launch registry: one "<id>.ini" file per app in the folders of TIZEN_APPS_DIR, the installed tree and the
   built-in one. */
#define _GNU_SOURCE
#include "app_private.h"

#include <desktop/app_install.h>
#include <desktop/app_registry.h>

#include <dirent.h>
#include <dlog.h>
#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#ifndef TIZEN_APPS_DIR_DEFAULT
#define TIZEN_APPS_DIR_DEFAULT "/usr/share/tizen-platform/apps"
#endif

/* The folders to search, in order (malloc'ed list of malloc'ed strings, NULL-terminated). */
static char **registry_dirs_get(void)
{
	const char *env = getenv("TIZEN_APPS_DIR");
	char *copy = strdup(env ? env : "");
	if (!copy)
		return NULL;
	size_t n = 3;
	for (const char *p = copy; *p; p++)
		n += *p == ':';
	char **dirs = calloc(n + 1, sizeof(char *));
	if (!dirs) {
		free(copy);
		return NULL;
	}
	size_t i = 0;
	char *save = NULL;
	for (char *tok = strtok_r(copy, ":", &save); tok; tok = strtok_r(NULL, ":", &save))
		if (*tok)
			dirs[i++] = strdup(tok);
	/* An installed tree's own entries, then those of the build. */
	char *installed = desktop_app_install_path_get("tizen-platform/apps");
	if (installed)
		dirs[i++] = installed;
	dirs[i++] = strdup(TIZEN_APPS_DIR_DEFAULT);
	free(copy);
	return dirs;
}

static void registry_dirs_free(char **dirs)
{
	for (size_t i = 0; dirs && dirs[i]; i++)
		free(dirs[i]);
	free(dirs);
}

static char *trim(char *s)
{
	while (*s == ' ' || *s == '\t')
		s++;
	size_t n = strlen(s);
	while (n && (s[n - 1] == ' ' || s[n - 1] == '\t' || s[n - 1] == '\n' || s[n - 1] == '\r'))
		s[--n] = '\0';
	return s;
}

static void set_value(app_registry_entry_s *e, const char *key, const char *value)
{
	char **field = NULL;
	if (!strcmp(key, "id"))
		field = &e->id;
	else if (!strcmp(key, "exec"))
		field = &e->exec;
	else if (!strcmp(key, "root"))
		field = &e->root;
	else if (!strcmp(key, "label"))
		field = &e->label;
	else if (!strcmp(key, "icon"))
		field = &e->icon;
	else if (!strcmp(key, "operation"))
		field = &e->operations;
	else if (!strcmp(key, "mime"))
		field = &e->mimes;
	if (!field)
		return;
	free(*field);
	*field = strdup(value);
}

/* Parses one ini file; NULL when it cannot be read or names no program. */
static app_registry_entry_s *entry_load(const char *path)
{
	FILE *f = fopen(path, "r");
	if (!f)
		return NULL;
	app_registry_entry_s *e = calloc(1, sizeof(*e));
	char line[4096];
	while (e && fgets(line, sizeof(line), f)) {
		char *s = trim(line);
		if (!*s || *s == '#' || *s == ';' || *s == '[')
			continue;
		char *eq = strchr(s, '=');
		if (!eq)
			continue;
		*eq = '\0';
		set_value(e, trim(s), trim(eq + 1));
	}
	fclose(f);
	if (e && (!e->id || !e->exec)) {
		LOGE("registry entry %s lacks id= or exec=", path);
		app_registry_entry_free(e);
		return NULL;
	}
	return e;
}

void app_registry_entry_free(app_registry_entry_s *entry)
{
	if (!entry)
		return;
	free(entry->id);
	free(entry->exec);
	free(entry->root);
	free(entry->label);
	free(entry->icon);
	free(entry->operations);
	free(entry->mimes);
	free(entry);
}

app_registry_entry_s *app_registry_find(const char *app_id)
{
	if (!app_id || !*app_id || strchr(app_id, '/'))
		return NULL;
	char **dirs = registry_dirs_get();
	app_registry_entry_s *found = NULL;
	for (size_t i = 0; dirs && dirs[i] && !found; i++) {
		char path[PATH_MAX];
		snprintf(path, sizeof(path), "%s/%s.ini", dirs[i], app_id);
		found = entry_load(path);
		if (found && strcmp(found->id, app_id)) {
			LOGE("registry entry %s names the id %s", path, found->id);
			app_registry_entry_free(found);
			found = NULL;
		}
	}
	registry_dirs_free(dirs);
	return found;
}

static bool has_ini_suffix(const char *name)
{
	size_t n = strlen(name);
	return n > 4 && !strcmp(name + n - 4, ".ini");
}

/* Ids met so far in a registry walk. */
typedef struct {
	char **ids;
	size_t count;
} seen_ids_s;

static bool seen_add(seen_ids_s *seen, const char *id)
{
	for (size_t i = 0; i < seen->count; i++)
		if (!strcmp(seen->ids[i], id))
			return false;
	char **ids = realloc(seen->ids, (seen->count + 1) * sizeof(char *));
	if (!ids)
		return false;
	seen->ids = ids;
	seen->ids[seen->count] = strdup(id);
	if (seen->ids[seen->count])
		seen->count++;
	return true;
}

void app_registry_foreach(bool (*cb)(const app_registry_entry_s *entry, void *data), void *data)
{
	if (!cb)
		return;
	char **dirs = registry_dirs_get();
	seen_ids_s seen = {NULL, 0};
	bool go_on = true;
	for (size_t i = 0; go_on && dirs && dirs[i]; i++) {
		DIR *d = opendir(dirs[i]);
		if (!d)
			continue;
		struct dirent *de;
		while (go_on && (de = readdir(d))) {
			if (!has_ini_suffix(de->d_name))
				continue;
			char path[PATH_MAX];
			snprintf(path, sizeof(path), "%s/%s", dirs[i], de->d_name);
			app_registry_entry_s *e = entry_load(path);
			if (e && seen_add(&seen, e->id))
				go_on = cb(e, data);
			app_registry_entry_free(e);
		}
		closedir(d);
	}
	for (size_t i = 0; i < seen.count; i++)
		free(seen.ids[i]);
	free(seen.ids);
	registry_dirs_free(dirs);
}

/* Calls match on each item of a comma-separated list until it answers true. */
static bool list_any(const char *list, bool (*match)(const char *item, size_t n, const char *what), const char *what)
{
	for (const char *p = list; *p;) {
		while (*p == ',' || *p == ' ')
			p++;
		const char *end = p + strcspn(p, ", ");
		if (end > p && match(p, (size_t)(end - p), what))
			return true;
		p = end;
	}
	return false;
}

static bool same_text(const char *item, size_t n, const char *what)
{
	return strlen(what) == n && !strncmp(item, what, n);
}

/* A wildcard subtype ("*" after the slash) takes every subtype of its type, on either side; a lone "*" takes all. */
static bool mime_matches(const char *item, size_t n, const char *mime)
{
	if ((n == 1 && item[0] == '*') || (n == 3 && !strncmp(item, "*/*", 3)) || !strcmp(mime, "*/*"))
		return true;
	const char *slash = strchr(mime, '/');
	const char *item_slash = memchr(item, '/', n);
	if (!slash || !item_slash)
		return same_text(item, n, mime);
	size_t item_type = (size_t)(item_slash - item);
	if ((size_t)(slash - mime) != item_type || strncmp(item, mime, item_type))
		return false;
	const char *sub = slash + 1;
	size_t item_sub = n - item_type - 1;
	return (item_sub == 1 && item_slash[1] == '*') || !strcmp(sub, "*") ||
	       (strlen(sub) == item_sub && !strncmp(item_slash + 1, sub, item_sub));
}

bool app_registry_entry_handles(const app_registry_entry_s *entry, const char *operation)
{
	if (!entry || !operation || !entry->operations)
		return false;
	return list_any(entry->operations, same_text, operation);
}

bool app_registry_entry_takes(const app_registry_entry_s *entry, const char *operation, const char *mime)
{
	if (!app_registry_entry_handles(entry, operation))
		return false;
	return !mime || !*mime || !entry->mimes || list_any(entry->mimes, mime_matches, mime);
}

/* Where a spawned app's standard output and error go: <runtime dir>/tizen-apps/<id>.log */
static int spawn_log_open(const char *app_id)
{
	char *dir = app_paths_runtime_dir_get();
	char path[PATH_MAX + 256];
	snprintf(path, sizeof(path), "%s/%s.log", dir ? dir : "/tmp", app_id);
	free(dir);
	int fd = open(path, O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600);
	return fd >= 0 ? fd : open("/dev/null", O_WRONLY | O_CLOEXEC);
}

pid_t app_registry_spawn(const app_registry_entry_s *entry)
{
	if (!entry || !entry->exec)
		return -1;
	int log_fd = spawn_log_open(entry->id);
	pid_t pid = fork();
	if (pid < 0) {
		LOGE("cannot start %s: %s", entry->id, strerror(errno));
		if (log_fd >= 0)
			close(log_fd);
		return -1;
	}
	if (pid == 0) {
		/* The app lives on its own: no terminal of the requester, nothing of its open files. */
		setsid();
		int null_fd = open("/dev/null", O_RDONLY);
		if (null_fd >= 0)
			dup2(null_fd, STDIN_FILENO);
		if (log_fd >= 0) {
			dup2(log_fd, STDOUT_FILENO);
			dup2(log_fd, STDERR_FILENO);
		}
		closefrom(3);
		setenv("TIZEN_APP_ID", entry->id, 1);
		setenv(APP_LAUNCH_WAIT_ENV, "1", 1);
		if (strchr(entry->exec, ' ')) {
			char cmd[PATH_MAX + 16];
			snprintf(cmd, sizeof(cmd), "exec %s", entry->exec);
			execl("/bin/sh", "sh", "-c", cmd, (char *)NULL);
		} else {
			execl(entry->exec, entry->exec, (char *)NULL);
		}
		fprintf(stderr, "cannot run %s: %s\n", entry->exec, strerror(errno));
		_exit(127);
	}
	if (log_fd >= 0)
		close(log_fd);
	LOGI("started %s (%s) as pid %d", entry->id, entry->exec, (int)pid);
	return pid;
}

typedef struct {
	desktop_app_registry_cb callback;
	void *user_data;
} public_walk_s;

static bool public_walk_cb(const app_registry_entry_s *entry, void *data)
{
	public_walk_s *walk = data;
	return walk->callback(entry->id, entry->exec, walk->user_data);
}

int desktop_app_registry_foreach(desktop_app_registry_cb callback, void *user_data)
{
	if (!callback)
		return TIZEN_ERROR_INVALID_PARAMETER;
	public_walk_s walk = {callback, user_data};
	app_registry_foreach(public_walk_cb, &walk);
	return TIZEN_ERROR_NONE;
}
