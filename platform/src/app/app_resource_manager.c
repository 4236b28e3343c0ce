/* Resource lookup: an id such as "edje/memo.edj" names the file "<resource path><id>". */
#include <app_common.h>
#include <app_resource_manager.h>

#include "app_private.h"

#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

static int open_count;

int app_resource_manager_init(void)
{
	open_count++;
	return APP_RESOURCE_ERROR_NONE;
}

int app_resource_manager_get(app_resource_e type, const char *id, char **path)
{
	if (type < APP_RESOURCE_TYPE_MIN || type > APP_RESOURCE_TYPE_MAX || !id || !*id || !path) {
		LOGE("invalid parameter");
		return APP_RESOURCE_ERROR_INVALID_PARAMETER;
	}
	*path = NULL;
	char *res = app_get_resource_path();
	if (!res) {
		LOGE("no resource folder");
		return APP_RESOURCE_ERROR_IO_ERROR;
	}
	size_t n = strlen(res) + strlen(id) + 1;
	char *full = malloc(n);
	if (!full) {
		free(res);
		return APP_RESOURCE_ERROR_OUT_OF_MEMORY;
	}
	snprintf(full, n, "%s%s", res, id);
	free(res);
	if (access(full, R_OK) != 0) {
		LOGE("resource %s not found (%s)", id, full);
		free(full);
		return APP_RESOURCE_ERROR_IO_ERROR;
	}
	*path = full;
	return APP_RESOURCE_ERROR_NONE;
}

int app_resource_manager_release(void)
{
	if (open_count > 0)
		open_count--;
	return APP_RESOURCE_ERROR_NONE;
}
