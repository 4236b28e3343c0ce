// Launch requests: the first one decides the page the process begins with.
#include "MemoApp.h"

#include <cstdlib>

#include <app_control.h>

#include "MemoLog.h"

void MemoApp::onAppControl(app_control_s *request, bool firstLaunch)
{
	char *operation = nullptr;
	app_control_get_operation(request, &operation);
	MEMO_LOGD("onAppControl %s (first launch %d)", operation ? operation : "(none)", firstLaunch);
	free(operation);
}
