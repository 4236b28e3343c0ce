// Identifiers, resource and data paths, date texts.
#include "Util/MemoUtil.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <uuid/uuid.h>

#include <app_common.h>
#include <app_resource_manager.h>
#include <uxt_util.h>
#include <vconf.h>

#include "MemoLog.h"

// Filled once, on first use, and never refreshed.
static std::string gResourcePath;
static std::string gEdjePath;
static std::string gImagePath;
static std::string gDataPath;

bool MemoUtil::createUUIDN(char **out)
{
	if (!out)
		return false;
	uuid_t value;
	char text[37];
	memset(text, 0, sizeof(text));
	uuid_generate(value);
	uuid_unparse(value, text);

	size_t len = strlen(text);
	*out = static_cast<char *>(malloc(len + 1));
	if (!*out) {
		MEMO_LOGE("Malloc Error");
		return false;
	}
	memcpy(*out, text, len + 1);
	return true;
}

const char *MemoUtil::getResourcePath()
{
	if (gResourcePath.empty()) {
		char *path = app_get_resource_path();
		if (path) {
			gResourcePath = path;
			free(path);
		}
	}
	return gResourcePath.c_str();
}

// A path from the resource manager, or empty.
static std::string __getManagedResource(const char *id)
{
	std::string result;
	app_resource_manager_init();
	char *path = nullptr;
	if (app_resource_manager_get(APP_RESOURCE_TYPE_IMAGE, id, &path) == APP_RESOURCE_ERROR_NONE && path)
		result = path;
	free(path);
	app_resource_manager_release();
	return result;
}

const char *MemoUtil::getEdjePath()
{
	if (gEdjePath.empty())
		gEdjePath = __getManagedResource("edje/memo.edj");
	return gEdjePath.c_str();
}

const char *MemoUtil::getImagePath()
{
	if (gImagePath.empty()) {
		const char *res = getResourcePath();
		if (*res)
			gImagePath = std::string(res) + "images/";
	}
	return gImagePath.c_str();
}

const char *MemoUtil::getDataPath()
{
	if (gDataPath.empty()) {
		char *path = app_get_data_path();
		if (path) {
			gDataPath = path;
			free(path);
		}
	}
	return gDataPath.c_str();
}

char *MemoUtil::getDataFilePathN(const char *name)
{
	if (!name)
		return nullptr;
	std::string path = std::string(getDataPath()) + name;
	return strdup(path.c_str());
}

char *MemoUtil::getImageResourcePathN(const char *name)
{
	if (!name)
		return nullptr;
	if (gImagePath.empty())
		gImagePath = __getManagedResource("images/");
	if (gImagePath.empty())
		return nullptr;
	return strdup((gImagePath + name).c_str());
}

char *MemoUtil::getDateTimeTextN(time_t seconds)
{
	struct tm local;
	memset(&local, 0, sizeof(local));
	localtime_r(&seconds, &local);

	int clock = 1; // 12 hours unless the device says otherwise
	vconf_get_int(VCONFKEY_REGIONFORMAT_TIME1224, &clock);
	int format = clock == 1 ? 0x77 : 0x37;

	char *locale = vconf_get_str(VCONFKEY_REGIONFORMAT);
	char *text = uxt_util_get_date_time_text_by_locale(format, locale, &local);
	free(locale);
	return text;
}
