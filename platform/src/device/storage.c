/* Internal storage figures: the file system of the app's data folder, with an optional
   free-space override so that a full disk can be simulated. */
#include <storage.h>

#include <dlog.h>
#include <errno.h>
#include <stdlib.h>
#include <string.h>

#include <app_common.h>
#include <vconf.h>

#define STORAGE_FREE_OVERRIDE_KEY "db/desktop/storage/internal_free_bytes"

/* The override in bytes, as an int or a decimal string; false when unset or unreadable. */
static bool __free_override(unsigned long long *bytes)
{
	int type = VCONF_TYPE_NONE;
	if (vconf_get_type(STORAGE_FREE_OVERRIDE_KEY, &type) != VCONF_OK)
		return false;
	if (type == VCONF_TYPE_INT) {
		int value = 0;
		if (vconf_get_int(STORAGE_FREE_OVERRIDE_KEY, &value) != VCONF_OK || value < 0)
			return false;
		*bytes = (unsigned long long)value;
		return true;
	}
	if (type != VCONF_TYPE_STRING)
		return false;
	char *text = vconf_get_str(STORAGE_FREE_OVERRIDE_KEY);
	if (!text)
		return false;
	char *end = NULL;
	errno = 0;
	unsigned long long value = strtoull(text, &end, 10);
	bool ok = errno == 0 && end != text && *end == '\0' && text[0] != '-';
	free(text);
	if (ok)
		*bytes = value;
	return ok;
}

static int __internal_size(struct statvfs *buf)
{
	if (!buf)
		return STORAGE_ERROR_INVALID_PARAMETER;
	char *data = app_get_data_path();
	int ret = statvfs(data ? data : "/", buf);
	free(data);
	if (ret != 0) {
		LOGE("statvfs failed: %s", strerror(errno));
		return STORAGE_ERROR_OPERATION_FAILED;
	}
	unsigned long long bytes = 0;
	if (__free_override(&bytes)) {
		buf->f_bsize = 1;
		buf->f_bavail = (fsblkcnt_t)bytes;
		buf->f_bfree = (fsblkcnt_t)bytes;
	}
	return STORAGE_ERROR_NONE;
}

/* Both names are exported: which one a caller links to depends on its _FILE_OFFSET_BITS. */
#undef storage_get_internal_memory_size
int storage_get_internal_memory_size(struct statvfs *buf)
{
	return __internal_size(buf);
}

int storage_get_internal_memory_size64(struct statvfs *buf)
{
	return __internal_size(buf);
}

/* The free (`total` false) or total bytes of the internal storage. */
static int __space(int storage_id, unsigned long long *bytes, bool total)
{
	if (!bytes)
		return STORAGE_ERROR_INVALID_PARAMETER;
	if (storage_id != STORAGE_TYPE_INTERNAL)
		return STORAGE_ERROR_NOT_SUPPORTED;
	struct statvfs buf;
	int ret = __internal_size(&buf);
	if (ret == STORAGE_ERROR_NONE)
		*bytes =
		    total ? (unsigned long long)buf.f_frsize * buf.f_blocks : (unsigned long long)buf.f_bsize * buf.f_bavail;
	return ret;
}

int storage_get_available_space(int storage_id, unsigned long long *bytes)
{
	return __space(storage_id, bytes, false);
}

int storage_get_total_space(int storage_id, unsigned long long *bytes)
{
	return __space(storage_id, bytes, true);
}
