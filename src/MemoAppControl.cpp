// Launch requests: the first one decides the page the process begins with.
#include "MemoApp.h"

#include <cstdlib>
#include <cstring>

#include <Elementary.h>
#include <app_control.h>

#include <WNaviframeController.h>

#include "MemoLog.h"
#include "View/MemoListView.h"

void MemoApp::onAppControl(app_control_s *request, bool firstLaunch)
{
	char *operation = nullptr;
	app_control_get_operation(request, &operation);
	MEMO_LOGD("onAppControl %s (first launch %d)", operation ? operation : "(none)", firstLaunch);
	if (firstLaunch)
		__pushListView(request, operation);
	free(operation);
}

// A pick request gets a clone of itself to the list, which answers it; the process then ends with the list's
// page. Every other operation shows the list plainly.
void MemoApp::__pushListView(app_control_s *request, const char *operation)
{
	app_assist::WNaviframeController *naviframe = __getNaviframe();
	if (!naviframe) {
		MEMO_LOGE("no naviframe to show the list on");
		return;
	}
	if (!operation || strcmp(operation, APP_CONTROL_OPERATION_PICK)) {
		naviframe->push(new MemoListView());
		return;
	}
	naviframe->setOnLastItemPop([](bool *pop) {
		*pop = false;
		elm_exit();
	});
	app_control_h pickRequest = nullptr;
	if (app_control_clone(&pickRequest, request) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("the pick request cannot be kept");
		naviframe->push(new MemoListView());
		return;
	}
	// The view owns the clone from its creation on, a failed push included.
	naviframe->push(new MemoListView(), nullptr, &pickRequest);
}
