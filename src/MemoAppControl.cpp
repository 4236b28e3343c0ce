// Launch requests: the first one decides the page the process begins with; text for the quick memo is taken
// whenever it comes. A running instance answers every other request only by coming to the front, which the
// platform does before the request reaches us.
#include "MemoApp.h"

#include <cstdlib>
#include <cstring>

#include <Elementary.h>
#include <app_control.h>

#include <WContentViewController.h>
#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"
#include "View/MemoEditView.h"
#include "View/MemoListView.h"

using app_assist::WContentViewController;
using app_assist::WNaviframeController;

static const char *const OPERATION_WIDGET_NEW = "widget_new";
static const char *const OPERATION_WIDGET_OPEN = "widget_open";
static const char *const OPERATION_QUICK_MEMO = "http://tizen.org/appcontrol/operation/send_text_quickmemo";
static const char *const EXTRA_UUID = "uuid";
// Far more than a person collects into the quick memo at once; a larger text from another program is
// refused rather than copied into every stored form of the memo.
static const size_t QUICK_TEXT_MAX_BYTES = 65536;

static bool isOperation(const char *operation, const char *name)
{
	return operation && !strcmp(operation, name);
}

void MemoApp::onAppControl(app_control_s *request, bool firstLaunch)
{
	char *operation = nullptr;
	app_control_get_operation(request, &operation);
	MEMO_LOGD("onAppControl %s (first launch %d)", operation ? operation : "(none)", firstLaunch);
	if (firstLaunch) {
		__pushFirstView(request, operation);
		WContentViewController *top = __getTopView();
		MEMO_LOGD("first page: %s", top ? top->getClassName() : "none");
	}
	if (isOperation(operation, OPERATION_QUICK_MEMO))
		__addQuickMemoText(request);
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
	const bool pick = isOperation(operation, APP_CONTROL_OPERATION_PICK);
	const bool share =
	    isOperation(operation, APP_CONTROL_OPERATION_SHARE_TEXT) || isOperation(operation, APP_CONTROL_OPERATION_SHARE);
	const bool widgetNew = isOperation(operation, OPERATION_WIDGET_NEW);
	const bool widgetOpen = isOperation(operation, OPERATION_WIDGET_OPEN);
	if (pick || share || widgetNew || widgetOpen)
		setExitOnLastPop(naviframe);

	if (share || widgetNew) {
		if (naviframe->push(new MemoEditView(nullptr, true, false)) && share)
			__fillSharedMemo(request, operation);
		return;
	}
	if (widgetOpen) {
		char *uuid = nullptr;
		if (app_control_get_extra_data(request, EXTRA_UUID, &uuid) == APP_CONTROL_ERROR_NONE && uuid) {
			delete __openedInfo;
			MemoDbMgr *db = MemoDbMgr::getInstance();
			__openedInfo = db ? db->getOneMemoN(uuid) : nullptr;
			free(uuid);
			// An unknown UUID gives an empty record, not null: the editor then shows an empty memo.
			if (!__openedInfo) {
				MEMO_LOGE("__openedInfo is null");
				return;
			}
			naviframe->push(new MemoEditView(__openedInfo, true, false));
			return;
		}
		free(uuid);
	}
	__pushListView(pick, request);
}

// A pick hands the list a clone of the request, which the list owns and answers; every other start shows
// the list plainly.
void MemoApp::__pushListView(bool pick, app_control_s *request)
{
	WNaviframeController *naviframe = __getNaviframe();
	app_control_h pickRequest = nullptr;
	if (!pick) {
		naviframe->push(new MemoListView());
	} else if (app_control_clone(&pickRequest, request) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("the pick request cannot be kept");
		naviframe->push(new MemoListView());
	} else {
		// The view owns the clone from its creation on, a failed push included.
		naviframe->push(new MemoListView(), nullptr, &pickRequest);
	}
}

void MemoApp::__addQuickMemoText(app_control_s *request)
{
	char *received = nullptr;
	if (app_control_get_extra_data(request, APP_CONTROL_DATA_TEXT, &received) != APP_CONTROL_ERROR_NONE || !received) {
		// Nothing to add, and nothing to answer.
		free(received);
		return;
	}
	const size_t length = strlen(received);
	if (length > QUICK_TEXT_MAX_BYTES) {
		MEMO_LOGE("quick memo text of %zu bytes refused (at most %zu)", length, QUICK_TEXT_MAX_BYTES);
		free(received);
		__replyToQuickMemo(request, APP_CONTROL_RESULT_FAILED);
		return;
	}
	char *text = MemoUtil::stripControlCharsN(received);
	free(received);
	if (!text)
		return;

	WContentViewController *top = __getTopView();
	const char *className = top ? top->getClassName() : nullptr;
	MemoEditView *editor =
	    className && !strcmp(className, "MemoEditView") ? dynamic_cast<MemoEditView *>(top) : nullptr;
	MemoDocInfo *info = editor ? editor->getCurrentDocInfo() : nullptr;
	if (info && info->getIsQuick() == 1) {
		// The quick memo is open: the text joins what the user sees there and is stored by the editor's save.
		// The entry takes markup, the store plain text.
		char *markup = elm_entry_utf8_to_markup(text);
		editor->insertTextToBody(markup ? markup : text);
		free(markup);
	} else if (MemoDbMgr *db = MemoDbMgr::getInstance()) {
		// A failed write is logged by the store; the requester hears of success all the same.
		db->addQuickMemo(text);
	}

	__replyToQuickMemo(request, APP_CONTROL_RESULT_SUCCEEDED);
	free(text);
}

void MemoApp::__replyToQuickMemo(app_control_s *request, int result)
{
	app_control_h reply = nullptr;
	int ret = app_control_create(&reply);
	if (ret != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("aexpp_control_create err code: %d", ret);
	} else {
		app_control_reply_to_launch_request(reply, request, static_cast<app_control_result_e>(result));
		app_control_destroy(reply);
	}
}
