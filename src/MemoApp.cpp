// The process's life: start-up of the stores, watches, window and theme, and their release on the way out.
#include "MemoApp.h"

#include <cstdlib>
#include <cstring>
#include <libintl.h>
#include <string>

#include <Elementary.h>
#include <app_common.h>
#include <app_preference.h>
#include <app_resource_manager.h>

#include <WContentViewController.h>
#include <WNaviframeController.h>
#include <WWindowController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"
#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Model/MemoPopupMonitor.h"
#include "View/MemoEditView.h"

using app_assist::WContentViewController;
using app_assist::WNaviframeController;
using app_assist::WWindowController;

unsigned char gIsPortrait = 1;

static const char *const APP_WINDOW_NAME = "com.veltron.memo";
static const char *const BASE_LAYOUT_GROUP = "memo/app/base";
static const double APP_BASE_SCALE = 2.6;

static const char *const PREF_MEMO_SVC_PROCESSING = "MEMO_SVC_PROCESSING";
static const char *const PREF_CLOUD_TRIGGERING = "CLOUD_TRIGGERING";
static const char *const PREF_QUICK_MEMO_ORIGINAL_DATA = "QUICK_MEMO_ORIGINAL_DATA";
static const char *const PREF_QUICK_MEMO_ADD_DATA = "QUICK_MEMO_ADD_DATA";
static const char *const PREF_QUICK_MEMO_STATE = "QUICK_MEMO_STATE";

static const char *const VCONF_TIMEZONE_ID = "db/setting/timezone_id";
static const char *const VCONF_TIME1224 = "db/menu_widget/regionformat_time1224";

MemoApp::MemoApp() : __colorTable(nullptr), __fontTable(nullptr), __openedInfo(nullptr)
{
	__bindTextDomains();
}

MemoApp::~MemoApp()
{
	MEMO_LOGD("~MemoApp");
	// Only a close: asking for the instance here would open (on a first run even create) a database that was
	// never opened or is closed already, just to close it again.
	MemoDbMgr::destroy();
	delete __openedInfo;
	__openedInfo = nullptr;
	MemoPopupMonitor::destroy();
	__orientationEventHandler.removeEventHandler();
	__regionEventHandler.removeEventHandler();
	__languageEventHandler.removeEventHandler();
}

bool MemoApp::onCreate()
{
	MEMO_LOGD("onCreate");

	// The test is on the result of the read, never on the value: a process killed in the middle of a sync run
	// keeps the service's state as it stood.
	int svcState = -1;
	if (preference_get_int(PREF_MEMO_SVC_PROCESSING, &svcState) != PREFERENCE_ERROR_NONE) {
		MEMO_LOGI("First run: writing the preference defaults");
		preference_set_int(PREF_MEMO_SVC_PROCESSING, 0);
		preference_set_int(PREF_CLOUD_TRIGGERING, 0);
		preference_set_string(PREF_QUICK_MEMO_ORIGINAL_DATA, "");
		preference_set_string(PREF_QUICK_MEMO_ADD_DATA, "");
		preference_set_int(PREF_QUICK_MEMO_STATE, 0);
	}
	// Installed after the defaults, so that writing them raises no broadcast.
	preference_set_changed_cb(PREF_MEMO_SVC_PROCESSING, __memoSvcChangedCb, this);
	preference_set_changed_cb(PREF_CLOUD_TRIGGERING, __cloudTriggeringChangedCb, this);

	__languageEventHandler.addEventHandler(APP_EVENT_LANGUAGE_CHANGED, __languageChangedCb, this);
	__orientationEventHandler.addEventHandler(APP_EVENT_DEVICE_ORIENTATION_CHANGED, __orientationChangedCb, this);

	vconf_notify_key_changed(VCONF_TIMEZONE_ID, __timeFormatChangedCb, this);
	vconf_notify_key_changed(VCONF_TIME1224, __timeFormatChangedCb, this);

	MemoDbMgr::getInstance();

	elm_app_base_scale_set(APP_BASE_SCALE);

	WWindowController *windowController = new WWindowController(APP_WINDOW_NAME, ELM_WIN_DIALOG_BASIC);
	// The window manager shows the app's name; the window's name and class stay the app id.
	windowController->setTitle("IDS_MEMO_BODY_MEMO", "memo");
	attachWindowController(windowController);
	Evas_Object *win = windowController->getEvasObj();

	uxt_theme_set_changeable_ui_enabled(EINA_TRUE);
	__changeableTableCreate();

	WNaviframeController *naviframe = new WNaviframeController();
	if (!windowController->attachBaseViewController(naviframe)) {
		// A naviframe that got no object is still ours.
		if (!naviframe->getEvasObj())
			naviframe->destroy();
		naviframe = nullptr;
	}

	if (win) {
		elm_win_indicator_mode_set(win, ELM_WIN_INDICATOR_SHOW);
		elm_win_indicator_opacity_set(win, ELM_WIN_INDICATOR_TRANSPARENT);
	}
	if (naviframe)
		elm_naviframe_prev_btn_auto_pushed_set(naviframe->getEvasObj(), EINA_TRUE);
	if (win)
		evas_object_smart_callback_add(win, "wm,rotation,changed", __rotationChangedCb, this);

	char *edjPath = __getResourcePathN("edje/memo.edj");
	if (edjPath) {
		elm_theme_extension_add(nullptr, edjPath);
		__setBaseLayout(edjPath);
		free(edjPath);
	}
	return true;
}

void MemoApp::onTerminate()
{
	MEMO_LOGD("onTerminate");
	__saveOpenEditor();

	if (__colorTable) {
		uxt_theme_delete_color_table(__colorTable);
		uxt_theme_delete_changed_callback(UXT_THEME_CHANGED_TYPE_COLOR, __themeChangedCb);
		__colorTable = nullptr;
	}
	if (__fontTable) {
		uxt_theme_delete_font_table(__fontTable);
		uxt_theme_delete_changed_callback(UXT_THEME_CHANGED_TYPE_FONT, __themeChangedCb);
		__fontTable = nullptr;
	}

	MemoBroadCaster::destroy();

	vconf_ignore_key_changed(VCONF_TIMEZONE_ID, __timeFormatChangedCb);
	vconf_ignore_key_changed(VCONF_TIME1224, __timeFormatChangedCb);

	WWindowController *windowController = getWindowController();
	Evas_Object *win = windowController ? windowController->getEvasObj() : nullptr;
	if (win)
		evas_object_smart_callback_del(win, "wm,rotation,changed", __rotationChangedCb);
}

void MemoApp::onPause()
{
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,pause", nullptr);
}

void MemoApp::onResume()
{
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,resume", nullptr);

	WContentViewController *top = __getTopView();
	if (!top)
		return;
	const char *className = top->getClassName();
	if (!className)
		return;
	if (!strcmp(className, "MemoListView")) {
		// The list read here is dropped unread; the view reads its own in onBecomeTop.
		MemoDbMgr *dbMgr = MemoDbMgr::getInstance();
		MemoItemList *list = dbMgr ? dbMgr->getVisibleMemoListN() : nullptr;
		top->onBecomeTop();
		delete list;
	} else if (!strcmp(className, "MemoSearchView")) {
		top->onBecomeTop();
	}
}

void MemoApp::__changeableTableCreate()
{
	if (!__colorTable) {
		uxt_theme_set_changeable_ui_enabled(EINA_TRUE);
		char *path = __getResourcePathN("table/memo_color_table.xml");
		__colorTable = uxt_theme_add_color_table(path);
		uxt_theme_set_color_table(__colorTable);
		free(path);
		uxt_theme_add_changed_callback(UXT_THEME_CHANGED_TYPE_COLOR, __themeChangedCb, this);
	} else {
		MEMO_LOGI("Color table already created.");
	}

	if (!__fontTable) {
		char *path = __getResourcePathN("table/memo_font_table.xml");
		__fontTable = uxt_theme_add_font_table(path);
		uxt_theme_set_font_table(__fontTable);
		free(path);
		uxt_theme_add_changed_callback(UXT_THEME_CHANGED_TYPE_FONT, __themeChangedCb, this);
	} else {
		MEMO_LOGI("Font table already created.");
	}
}

void MemoApp::__themeChangedCb(void *eventInfo, void *data)
{
	(void)eventInfo;
	MemoApp *self = static_cast<MemoApp *>(data);
	if (!self) {
		MEMO_LOGE("data is NULL");
		return;
	}
	uxt_theme_set_color_table(self->__colorTable);
	uxt_theme_set_font_table(self->__fontTable);
}

// The window controller's base layout takes the app's own look: the brand band and emblem stand under the
// naviframe until a page covers them. Its swallow parts keep their contents.
void MemoApp::__setBaseLayout(const char *edjPath)
{
	WWindowController *windowController = getWindowController();
	Evas_Object *layout = windowController ? windowController->getBaseLayoutEvasObj() : nullptr;
	if (!layout)
		return;
	if (!elm_layout_file_set(layout, edjPath, BASE_LAYOUT_GROUP)) {
		MEMO_LOGE("group %s not found in %s", BASE_LAYOUT_GROUP, edjPath);
		return;
	}
	elm_object_domain_translatable_part_text_set(layout, "header.title", "memo", "IDS_MEMO_BODY_MEMO");
}

WNaviframeController *MemoApp::__getNaviframe() const
{
	WWindowController *windowController = getWindowController();
	if (!windowController)
		return nullptr;
	return dynamic_cast<WNaviframeController *>(windowController->getBaseViewController());
}

WContentViewController *MemoApp::__getTopView() const
{
	WNaviframeController *naviframe = __getNaviframe();
	return naviframe ? naviframe->getTopContentViewController() : nullptr;
}

// An editor left open at exit keeps what was typed: it saves unless the user discarded the changes.
void MemoApp::__saveOpenEditor()
{
	WContentViewController *top = __getTopView();
	const char *className = top ? top->getClassName() : nullptr;
	if (!className || strcmp(className, "MemoEditView"))
		return;
	// The name says which page it is; the cast makes sure of the type before the call.
	MemoEditView *editView = dynamic_cast<MemoEditView *>(top);
	if (editView && !editView->isDiscarded())
		editView->saveOnExit();
}

// The views name the domains "memo" and "memo-sub" for their translatable texts; both are catalogues of the
// package beside the app id's own.
void MemoApp::__bindTextDomains()
{
	char *res = app_get_resource_path();
	if (!res) {
		MEMO_LOGE("no resource path: texts stay untranslated");
		return;
	}
	std::string localeDir = std::string(res) + "locale";
	free(res);
	for (const char *domain : {"memo", "memo-sub"}) {
		bindtextdomain(domain, localeDir.c_str());
		bind_textdomain_codeset(domain, "UTF-8");
	}
}

char *MemoApp::__getResourcePathN(const char *resourceId)
{
	char *path = nullptr;
	app_resource_manager_init();
	int ret = app_resource_manager_get(APP_RESOURCE_TYPE_IMAGE, resourceId, &path);
	app_resource_manager_release();
	if (ret != APP_RESOURCE_ERROR_NONE || !path) {
		MEMO_LOGE("resource %s not found (%d)", resourceId, ret);
		free(path);
		return nullptr;
	}
	return path;
}
