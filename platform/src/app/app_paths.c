/* Application identity and folders. Nothing here logs: dlog itself asks for the data path. */
#include <app_common.h>
#include <desktop/app_install.h>

#include "app_private.h"

#include <dlog.h>
#include <errno.h>
#include <libgen.h>
#include <limits.h>
#include <pthread.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <libxml/parser.h>
#include <libxml/tree.h>

/* What the manifest beside the executable says, read once. */
typedef struct {
	char *exe_dir; /* folder of the executable, without trailing "/" */
	char *exe_name;
	char *app_id;
	char *label;
	char *icon;
	char *version;
} manifest_info_s;

static manifest_info_s manifest;
static pthread_once_t manifest_once = PTHREAD_ONCE_INIT;

static char *xml_prop_dup(xmlNode *node, const char *name)
{
	xmlChar *v = xmlGetProp(node, (const xmlChar *)name);
	if (!v)
		return NULL;
	char *copy = strdup((const char *)v);
	xmlFree(v);
	return copy;
}

static char *xml_child_text_dup(xmlNode *node, const char *name)
{
	for (xmlNode *c = node->children; c; c = c->next) {
		if (c->type != XML_ELEMENT_NODE || strcmp((const char *)c->name, name))
			continue;
		xmlChar *text = xmlNodeGetContent(c);
		char *copy = text ? strdup((const char *)text) : NULL;
		xmlFree(text);
		return copy;
	}
	return NULL;
}

/* The manifest's app element, or NULL when it names another program: tools installed beside the app's
   program are not the app. */
static xmlNode *manifest_app_node(xmlNode *root)
{
	for (xmlNode *c = root->children; c; c = c->next) {
		if (c->type != XML_ELEMENT_NODE || strcmp((const char *)c->name, "ui-application"))
			continue;
		char *exec = xml_prop_dup(c, "exec");
		bool other = exec && manifest.exe_name && strcmp(exec, manifest.exe_name);
		free(exec);
		return other ? NULL : c;
	}
	return root;
}

static void manifest_parse(const char *path)
{
	xmlDoc *doc = xmlReadFile(path, NULL, XML_PARSE_NOERROR | XML_PARSE_NOWARNING | XML_PARSE_NONET);
	if (!doc)
		return;
	xmlNode *root = xmlDocGetRootElement(doc);
	xmlNode *app_node = root && !strcmp((const char *)root->name, "manifest") ? manifest_app_node(root) : NULL;
	if (app_node) {
		manifest.version = xml_prop_dup(root, "version");
		if (app_node != root) {
			manifest.app_id = xml_prop_dup(app_node, "appid");
			manifest.label = xml_child_text_dup(app_node, "label");
			manifest.icon = xml_child_text_dup(app_node, "icon");
		}
		if (!manifest.app_id)
			manifest.app_id = xml_prop_dup(root, "package");
	}
	xmlFreeDoc(doc);
}

static void manifest_load(void)
{
	char exe[PATH_MAX];
	ssize_t n = readlink("/proc/self/exe", exe, sizeof(exe) - 1);
	if (n <= 0)
		return;
	exe[n] = '\0';
	char *slash = strrchr(exe, '/');
	if (!slash)
		return;
	manifest.exe_name = strdup(slash + 1);
	*slash = '\0';
	manifest.exe_dir = strdup(exe);

	char path[PATH_MAX + 32];
	snprintf(path, sizeof(path), "%s/../tizen-manifest.xml", exe);
	if (access(path, R_OK) == 0)
		manifest_parse(path);
}

static const manifest_info_s *manifest_get(void)
{
	pthread_once(&manifest_once, manifest_load);
	return &manifest;
}

char *app_paths_app_id_get(void)
{
	const char *env = getenv("TIZEN_APP_ID");
	if (env && *env)
		return strdup(env);
	const manifest_info_s *m = manifest_get();
	if (m->app_id)
		return strdup(m->app_id);
	return m->exe_name ? strdup(m->exe_name) : NULL;
}

char *app_paths_manifest_value_get(const char *what)
{
	const manifest_info_s *m = manifest_get();
	const char *v = NULL;
	if (!strcmp(what, "label"))
		v = m->label;
	else if (!strcmp(what, "icon"))
		v = m->icon;
	else if (!strcmp(what, "version"))
		v = m->version;
	return v ? strdup(v) : NULL;
}

bool app_paths_mkdir_p(const char *path)
{
	if (!path || !*path)
		return false;
	char buf[PATH_MAX];
	if (strlen(path) >= sizeof(buf))
		return false;
	strcpy(buf, path);
	for (char *p = buf + 1; *p; p++) {
		if (*p != '/')
			continue;
		*p = '\0';
		if (mkdir(buf, 0700) != 0 && errno != EEXIST)
			return false;
		*p = '/';
	}
	if (mkdir(buf, 0700) != 0 && errno != EEXIST)
		return false;
	struct stat st;
	return stat(buf, &st) == 0 && S_ISDIR(st.st_mode);
}

bool app_paths_dir_is_private(const char *dir)
{
	struct stat st;
	if (lstat(dir, &st) != 0 || !S_ISDIR(st.st_mode)) {
		LOGE("%s is not a folder: refused", dir);
		return false;
	}
	if (st.st_uid != geteuid()) {
		LOGE("%s belongs to user %u: refused", dir, (unsigned int)st.st_uid);
		return false;
	}
	if ((st.st_mode & 0077) && chmod(dir, 0700) != 0) {
		LOGE("%s is open to other users and cannot be closed (%s)", dir, strerror(errno));
		return false;
	}
	return true;
}

char *app_paths_runtime_dir_get(void)
{
	const char *rt = getenv("XDG_RUNTIME_DIR");
	char dir[PATH_MAX];
	if (rt && *rt)
		snprintf(dir, sizeof(dir), "%s/tizen-apps", rt);
	else
		snprintf(dir, sizeof(dir), "/tmp/tizen-apps-%u", (unsigned int)getuid());
	return app_paths_mkdir_p(dir) && app_paths_dir_is_private(dir) ? strdup(dir) : NULL;
}

/* "<a><b>/" with a single trailing slash, or NULL. */
static char *join_dir(const char *a, const char *b)
{
	size_t la = strlen(a);
	size_t lb = b ? strlen(b) : 0;
	char *out = malloc(la + lb + 3);
	if (!out)
		return NULL;
	memcpy(out, a, la);
	size_t n = la;
	if (lb) {
		if (n && out[n - 1] != '/' && b[0] != '/')
			out[n++] = '/';
		memcpy(out + n, b, lb);
		n += lb;
	}
	if (!n || out[n - 1] != '/')
		out[n++] = '/';
	out[n] = '\0';
	return out;
}

/* Root of the app's private tree: $TIZEN_APP_ROOT, else $XDG_DATA_HOME/<app id>. */
static char *app_root_get(void)
{
	const char *root = getenv("TIZEN_APP_ROOT");
	if (root && *root)
		return join_dir(root, NULL);

	char *id = app_paths_app_id_get();
	if (!id)
		return NULL;
	char base[PATH_MAX];
	const char *xdg = getenv("XDG_DATA_HOME");
	const char *home = getenv("HOME");
	if (xdg && *xdg)
		snprintf(base, sizeof(base), "%s", xdg);
	else
		snprintf(base, sizeof(base), "%s/.local/share", home && *home ? home : "/tmp");
	char *out = join_dir(base, id);
	free(id);
	return out;
}

/* <app root><sub>, created on demand. */
static char *app_sub_path_get(const char *sub)
{
	char *root = app_root_get();
	if (!root)
		return NULL;
	char *path = join_dir(root, sub);
	free(root);
	if (path && !app_paths_mkdir_p(path)) {
		free(path);
		return NULL;
	}
	return path;
}

char *app_get_data_path(void)
{
	return app_sub_path_get("data");
}

char *app_get_cache_path(void)
{
	return app_sub_path_get("cache");
}

char *app_get_shared_data_path(void)
{
	return app_sub_path_get("shared/data");
}

char *app_get_shared_trusted_path(void)
{
	return app_sub_path_get("shared/trusted");
}

char *app_get_external_data_path(void)
{
	return app_sub_path_get("external/data");
}

char *app_get_external_cache_path(void)
{
	return app_sub_path_get("external/cache");
}

char *app_get_external_shared_data_path(void)
{
	return app_sub_path_get("external/shared/data");
}

/* Read-only folders beside the executable: <exe dir>/../<sub>/ */
static char *install_path_get(const char *sub)
{
	const manifest_info_s *m = manifest_get();
	if (!m->exe_dir)
		return NULL;
	char path[PATH_MAX];
	snprintf(path, sizeof(path), "%s/../%s", m->exe_dir, sub);
	char real[PATH_MAX];
	return join_dir(realpath(path, real) ? real : path, NULL);
}

char *app_get_resource_path(void)
{
	const char *env = getenv("TIZEN_APP_RES_DIR");
	if (env && *env)
		return join_dir(env, NULL);
	return install_path_get("res");
}

char *app_get_shared_resource_path(void)
{
	return install_path_get("shared/res");
}

int app_get_id(char **id)
{
	if (!id)
		return APP_ERROR_INVALID_PARAMETER;
	*id = app_paths_app_id_get();
	return *id ? APP_ERROR_NONE : APP_ERROR_INVALID_CONTEXT;
}

int app_get_name(char **name)
{
	if (!name)
		return APP_ERROR_INVALID_PARAMETER;
	*name = app_paths_manifest_value_get("label");
	if (!*name)
		*name = app_paths_app_id_get();
	return *name ? APP_ERROR_NONE : APP_ERROR_INVALID_CONTEXT;
}

int app_get_version(char **version)
{
	if (!version)
		return APP_ERROR_INVALID_PARAMETER;
	*version = app_paths_manifest_value_get("version");
	if (!*version)
		*version = strdup("1.0.0");
	return *version ? APP_ERROR_NONE : APP_ERROR_OUT_OF_MEMORY;
}

char *desktop_app_install_path_get(const char *sub)
{
	const manifest_info_s *m = manifest_get();
	if (!m->exe_dir || !sub)
		return NULL;
	char path[PATH_MAX];
	snprintf(path, sizeof(path), "%s/../share/%s", m->exe_dir, sub);
	char real[PATH_MAX];
	return realpath(path, real) ? strdup(real) : NULL;
}
