// What the platform and the sync service report, turned into keys on the broadcast bus.
#include "MemoApp.h"

#include <cstdlib>
#include <cstring>

#include <Elementary.h>
#include <app_preference.h>
#include <system_settings.h>

#include <WContentViewController.h>

#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"

using app_assist::WContentViewController;

static void __broadcast(const char *key)
{
	MemoBroadCaster::getInstance().emit(key, nullptr);
}

void MemoApp::__languageChangedCb(app_event_info_h eventInfo, void *data)
{
	(void)eventInfo;
	(void)data;
	char *language = nullptr;
	system_settings_get_value_string(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE, &language);
	if (language)
		elm_language_set(language);
	else
		MEMO_LOGE("no language setting");
	free(language);
	__broadcast("broadcast,language,changed");
}

// Rotation follows the window ("wm,rotation,changed"); the device event is only read.
void MemoApp::__orientationChangedCb(app_event_info_h eventInfo, void *data)
{
	(void)data;
	app_device_orientation_e orientation = APP_DEVICE_ORIENTATION_0;
	app_event_get_device_orientation(eventInfo, &orientation);
}

void MemoApp::__timeFormatChangedCb(keynode_t *node, void *data)
{
	(void)node;
	(void)data;
	__broadcast("broadcast,timeformat,changed");
}

void MemoApp::__rotationChangedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)data;
	(void)eventInfo;
	switch (elm_win_rotation_get(obj)) {
	case 0:
	case 180:
		gIsPortrait = 1;
		break;
	case 90:
	case 270:
		gIsPortrait = 0;
		break;
	default:
		break;
	}
	__broadcast("broadcast,orientation,changed");
}

void MemoApp::__memoSvcChangedCb(const char *key, void *data)
{
	(void)data;
	if (!key || strcmp(key, "MEMO_SVC_PROCESSING"))
		return;
	int state = 0;
	preference_get_int(key, &state);
	MEMO_LOGI("MEMO_SVC_PROCESSING is %d", state);
	if (state == 1)
		__broadcast("broadcast,sync,restore");
	else if (state == 2)
		__broadcast("broadcast,sync,backup");
	else
		__broadcast("broadcast,sync,idle");
}

void MemoApp::__cloudTriggeringChangedCb(const char *key, void *data)
{
	// The callback stays registered after onTerminate; an app that has gone has no pages to ask.
	if (!data || data != app_assist::WApp::getInstance()) {
		MEMO_LOGE("the app is gone");
		return;
	}
	MemoApp *self = static_cast<MemoApp *>(data);
	WContentViewController *top = self->__getTopView();
	const char *className = top ? top->getClassName() : nullptr;

	if (!key || strcmp(key, "CLOUD_TRIGGERING"))
		return;
	int trigger = -1;
	preference_get_int(key, &trigger);
	if (static_cast<unsigned int>(trigger) >= 2)
		return;
	MEMO_LOGI("CLOUD_TRIGGERING is %d", trigger);
	// The list reloads itself at once; any other page hears of it on the bus.
	if (className && !strcmp(className, "MemoListView"))
		top->onBecomeTop();
	else
		__broadcast("broadcast,sync,listupdate");
}
