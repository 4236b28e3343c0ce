/* Typed key files: escaping, atomic writes, strict parsing. */
#define _GNU_SOURCE
#include "system/key_file_store.h"

#include <dirent.h>
#include <errno.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <dlog.h>

/* Longest file content read back; values are settings, not documents. */
#define KEY_FILE_MAX_SIZE (16 * 1024 * 1024)

static bool __isPlainChar(unsigned char c)
{
	return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_' || c == '-' ||
	       c == '.';
}

char *key_file_escape(const char *key)
{
	if (!key || !key[0])
		return NULL;
	size_t len = strlen(key);
	if (len > NAME_MAX)
		return NULL;
	char *name = malloc(len * 3 + 1);
	if (!name)
		return NULL;
	static const char hex[] = "0123456789ABCDEF";
	char *out = name;
	for (size_t i = 0; i < len; i++) {
		unsigned char c = (unsigned char)key[i];
		if (__isPlainChar(c) && !(i == 0 && c == '.')) {
			*out++ = (char)c;
		} else {
			*out++ = '%';
			*out++ = hex[c >> 4];
			*out++ = hex[c & 0xF];
		}
	}
	*out = '\0';
	if (out - name > NAME_MAX) {
		free(name);
		return NULL;
	}
	return name;
}

static int __hexValue(char c)
{
	if (c >= '0' && c <= '9')
		return c - '0';
	if (c >= 'A' && c <= 'F')
		return c - 'A' + 10;
	return -1;
}

char *key_file_unescape(const char *name)
{
	if (!name || !name[0] || name[0] == '.')
		return NULL;
	char *key = malloc(strlen(name) + 1);
	if (!key)
		return NULL;
	char *out = key;
	for (const char *p = name; *p; p++) {
		if (*p != '%') {
			*out++ = *p;
			continue;
		}
		int hi = __hexValue(p[1]);
		int lo = hi < 0 ? -1 : __hexValue(p[2]);
		if (lo < 0 || (hi == 0 && lo == 0)) {
			free(key);
			return NULL;
		}
		*out++ = (char)(hi << 4 | lo);
		p += 2;
	}
	*out = '\0';
	/* Only the canonical spelling names a key, so one key never has two files. */
	char *canonical = key_file_escape(key);
	bool ok = canonical && !strcmp(canonical, name);
	free(canonical);
	if (!ok) {
		free(key);
		return NULL;
	}
	return key;
}

int key_file_make_dirs(const char *dir)
{
	if (!dir || !dir[0])
		return -EINVAL;
	char *path = strdup(dir);
	if (!path)
		return -ENOMEM;
	int rc = 0;
	for (char *p = path + 1;; p++) {
		if (*p != '/' && *p != '\0')
			continue;
		char saved = *p;
		*p = '\0';
		if (mkdir(path, 0700) != 0 && errno != EEXIST) {
			rc = -errno;
			break;
		}
		*p = saved;
		if (saved == '\0')
			break;
	}
	free(path);
	return rc;
}

/* "<dir>/<escaped key>", malloc'ed; NULL for a bad key. */
static char *__keyPath(const char *dir, const char *key)
{
	char *name = key_file_escape(key);
	if (!name)
		return NULL;
	char *path = NULL;
	size_t dirLen = strlen(dir);
	const char *sep = (dirLen && dir[dirLen - 1] == '/') ? "" : "/";
	if (asprintf(&path, "%s%s%s", dir, sep, name) < 0)
		path = NULL;
	free(name);
	return path;
}

const char *key_file_type_name(key_file_type_e type)
{
	switch (type) {
	case KEY_FILE_TYPE_INT:
		return "int";
	case KEY_FILE_TYPE_BOOL:
		return "bool";
	case KEY_FILE_TYPE_DOUBLE:
		return "double";
	case KEY_FILE_TYPE_STRING:
		return "string";
	default:
		return "none";
	}
}

/* The file content of a value, malloc'ed, its length in *len. */
static char *__formatValue(const key_file_value_t *value, size_t *len)
{
	char *text = NULL;
	int n = -1;
	switch (value->type) {
	case KEY_FILE_TYPE_INT:
		n = asprintf(&text, "int\n%d", value->i);
		break;
	case KEY_FILE_TYPE_BOOL:
		n = asprintf(&text, "bool\n%d", value->i ? 1 : 0);
		break;
	case KEY_FILE_TYPE_DOUBLE:
		n = asprintf(&text, "double\n%.17g", value->d);
		break;
	case KEY_FILE_TYPE_STRING:
		n = asprintf(&text, "string\n%s", value->s ? value->s : "");
		break;
	default:
		return NULL;
	}
	if (n < 0)
		return NULL;
	*len = (size_t)n;
	return text;
}

static int __writeAll(int fd, const char *buf, size_t len)
{
	while (len > 0) {
		ssize_t n = write(fd, buf, len);
		if (n < 0) {
			if (errno == EINTR)
				continue;
			return -errno;
		}
		buf += n;
		len -= (size_t)n;
	}
	return 0;
}

/* Writes content to a temporary file in dir and renames it over path. */
static int __replaceFile(const char *dir, const char *path, const char *content, size_t len)
{
	char *tmp = NULL;
	size_t dirLen = strlen(dir);
	const char *sep = (dirLen && dir[dirLen - 1] == '/') ? "" : "/";
	if (asprintf(&tmp, "%s%s.tmp-XXXXXX", dir, sep) < 0)
		return -ENOMEM;
	int fd = mkstemp(tmp);
	if (fd < 0 && errno == ENOENT && key_file_make_dirs(dir) == 0) {
		/* mkstemp spoils the template when it fails. */
		strcpy(tmp + strlen(tmp) - 6, "XXXXXX");
		fd = mkstemp(tmp);
	}
	if (fd < 0) {
		int rc = -errno;
		free(tmp);
		return rc;
	}
	int rc = __writeAll(fd, content, len);
	if (close(fd) != 0 && rc == 0)
		rc = -errno;
	if (rc == 0 && rename(tmp, path) != 0)
		rc = -errno;
	if (rc != 0)
		unlink(tmp);
	free(tmp);
	return rc;
}

int key_file_write(const char *dir, const char *key, const key_file_value_t *value)
{
	if (!dir || !value)
		return -EINVAL;
	char *path = __keyPath(dir, key);
	if (!path)
		return -EINVAL;
	size_t len = 0;
	char *content = __formatValue(value, &len);
	if (!content) {
		free(path);
		return value->type == KEY_FILE_TYPE_NONE ? -EINVAL : -ENOMEM;
	}
	int rc = __replaceFile(dir, path, content, len);
	if (rc != 0)
		LOGE("cannot write %s: %s", path, strerror(-rc));
	free(content);
	free(path);
	return rc;
}

/* Reads a whole small file; NULL with errno set on failure. */
static char *__readSmallFile(const char *path, size_t *len)
{
	FILE *f = fopen(path, "rb");
	if (!f)
		return NULL;
	size_t cap = 256, used = 0;
	char *buf = malloc(cap);
	while (buf) {
		size_t n = fread(buf + used, 1, cap - used - 1, f);
		used += n;
		if (used < cap - 1)
			break;
		if (cap >= KEY_FILE_MAX_SIZE) {
			free(buf);
			buf = NULL;
			errno = EFBIG;
			break;
		}
		char *bigger = realloc(buf, cap * 2);
		if (!bigger) {
			free(buf);
			buf = NULL;
			errno = ENOMEM;
			break;
		}
		buf = bigger;
		cap *= 2;
	}
	if (buf && ferror(f)) {
		free(buf);
		buf = NULL;
		errno = EIO;
	}
	fclose(f);
	if (buf) {
		buf[used] = '\0';
		*len = used;
	}
	return buf;
}

static bool __parseInt(const char *text, int *out)
{
	char *end = NULL;
	errno = 0;
	long v = strtol(text, &end, 10);
	if (errno != 0 || end == text || *end != '\0' || v < INT_MIN || v > INT_MAX)
		return false;
	*out = (int)v;
	return true;
}

static bool __parseValue(const char *content, size_t len, key_file_value_t *value)
{
	const char *nl = memchr(content, '\n', len);
	if (!nl)
		return false;
	size_t typeLen = (size_t)(nl - content);
	const char *text = nl + 1;
	if (typeLen == 6 && !strncmp(content, "string", 6)) {
		value->s = strdup(text);
		if (!value->s)
			return false;
		value->type = KEY_FILE_TYPE_STRING;
		return true;
	}
	if (typeLen == 3 && !strncmp(content, "int", 3) && __parseInt(text, &value->i)) {
		value->type = KEY_FILE_TYPE_INT;
		return true;
	}
	if (typeLen == 4 && !strncmp(content, "bool", 4) && __parseInt(text, &value->i)) {
		value->i = value->i != 0;
		value->type = KEY_FILE_TYPE_BOOL;
		return true;
	}
	if (typeLen == 6 && !strncmp(content, "double", 6)) {
		char *end = NULL;
		value->d = strtod(text, &end);
		if (end != text && *end == '\0') {
			value->type = KEY_FILE_TYPE_DOUBLE;
			return true;
		}
	}
	return false;
}

int key_file_read(const char *dir, const char *key, key_file_value_t *value)
{
	if (!dir || !value)
		return -EINVAL;
	memset(value, 0, sizeof(*value));
	char *path = __keyPath(dir, key);
	if (!path)
		return -EINVAL;
	size_t len = 0;
	char *content = __readSmallFile(path, &len);
	int rc = 0;
	if (!content) {
		rc = errno == ENOENT ? -ENOENT : -EIO;
		if (rc != -ENOENT)
			LOGE("cannot read %s: %s", path, strerror(errno));
	} else if (!__parseValue(content, len, value)) {
		LOGE("malformed key file %s", path);
		key_file_value_clear(value);
		rc = -EIO;
	}
	free(content);
	free(path);
	return rc;
}

int key_file_remove(const char *dir, const char *key)
{
	if (!dir)
		return -EINVAL;
	char *path = __keyPath(dir, key);
	if (!path)
		return -EINVAL;
	int rc = unlink(path) == 0 ? 0 : -errno;
	free(path);
	return rc;
}

int key_file_foreach(const char *dir, bool (*fn)(const char *key, void *data), void *data)
{
	if (!dir || !fn)
		return -EINVAL;
	DIR *d = opendir(dir);
	if (!d)
		return errno == ENOENT ? 0 : -errno;
	struct dirent *entry;
	while ((entry = readdir(d)) != NULL) {
		char *key = key_file_unescape(entry->d_name);
		if (!key)
			continue;
		bool more = fn(key, data);
		free(key);
		if (!more)
			break;
	}
	closedir(d);
	return 0;
}

void key_file_value_clear(key_file_value_t *value)
{
	if (!value)
		return;
	free(value->s);
	memset(value, 0, sizeof(*value));
}
