// Launch requests: the first one decides the page the process begins with.
#include "MemoApp.h"

#include <cstdlib>
#include <cstring>

#include <Elementary.h>
#include <app_control.h>

#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "View/MemoEditView.h"
#include "View/MemoListView.h"

using app_assist::WNaviframeController;

static const char *const OPERATION_WIDGET_NEW = "widget_new";
static const char *const OPERATION_WIDGET_OPEN = "widget_open";
static const char *const EXTRA_UUID = "uuid";

void MemoApp::onAppControl(app_control_s *request, bool firstLaunch)
{
	char *operation = nullptr;
	app_control_get_operation(request, &operation);
	MEMO_LOGD("onAppControl %s (first launch %d)", operation ? operation : "(none)", firstLaunch);
	if (firstLaunch)
		__pushFirstView(request, operation);
	free(operation);
}

// A process started for one job ends when its last page goes, rather than showing the app's home.
static void setExitOnLastPop(WNaviframeController *naviframe)
{
	naviframe->setOnLastItemPop([](bool *popping) {
		*popping = false;
		elm_exit();
	});
}

void MemoApp::__pushFirstView(app_control_s *request, const char *operation)
{
	WNaviframeController *naviframe = __getNaviframe();
	if (!naviframe) {
		MEMO_LOGE("no naviframe to push on");
		return;
	}
	if (operation && !strcmp(operation, OPERATION_WIDGET_NEW)) {
		setExitOnLastPop(naviframe);
		naviframe->push(new MemoEditView(nullptr, true, false));
		return;
	}
	if (operation && !strcmp(operation, OPERATION_WIDGET_OPEN)) {
		setExitOnLastPop(naviframe);
		char *uuid = nullptr;
		if (app_control_get_extra_data(request, EXTRA_UUID, &uuid) == APP_CONTROL_ERROR_NONE && uuid) {
			delete __openedInfo;
			MemoDbMgr *db = MemoDbMgr::getInstance();
			__openedInfo = db ? db->getOneMemoN(uuid) : nullptr;
			free(uuid);
			if (!__openedInfo) {
				MEMO_LOGE("__openedInfo is null");
				return;
			}
			naviframe->push(new MemoEditView(__openedInfo, true, false));
			return;
		}
		free(uuid);
	}
	// Every other start shows the memo list.
	__pushListView(request, operation);
}

// A pick request gets a clone of itself to the list, which answers it; the process then ends with the list's
// page. Every other operation shows the list plainly.
void MemoApp::__pushListView(app_control_s *request, const char *operation)
{
	WNaviframeController *naviframe = __getNaviframe();
	if (!naviframe) {
		MEMO_LOGE("no naviframe to show the list on");
		return;
	}
	if (!operation || strcmp(operation, APP_CONTROL_OPERATION_PICK)) {
		naviframe->push(new MemoListView());
		return;
	}
	setExitOnLastPop(naviframe);
	app_control_h pickRequest = nullptr;
	if (app_control_clone(&pickRequest, request) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("the pick request cannot be kept");
		naviframe->push(new MemoListView());
		return;
	}
	// The view owns the clone from its creation on, a failed push included.
	naviframe->push(new MemoListView(), nullptr, &pickRequest);
}
