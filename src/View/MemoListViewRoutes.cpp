// The list's ways to the search, the selection, the hidden memos and the settings, and the account settings that
// the hidden memos need.
#include "View/MemoListView.h"

#include <app_control.h>

#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"
#include "View/MemoSearchView.h"
#include "View/MemoSelectionView.h"
#include "View/MemoHiddenFirstAccess.h"
#include "View/MemoHiddenPasswordView.h"
#include "View/MemoSettingsView.h"

namespace
{
const int HIDDEN_GESTURE_LIMIT = 76;
} // namespace

// The search serves the list's own pick request when asked to, so a tap there answers the requester.
void MemoListView::__pushSearchView(bool servePick)
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!naviframe)
		return;
	__hideFloatingButton();
	__isTopView = false;
	naviframe->push(new MemoSearchView(), nullptr, servePick ? &__pickRequest : nullptr);
}

void MemoListView::__pushSelectionView()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!naviframe)
		return;
	__hideFloatingButton();
	__isTopView = false;
	naviframe->push(new MemoSelectionView(0));
}

void MemoListView::__pushHiddenView(bool hasPassword)
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!naviframe) {
		MEMO_LOGE("Naviframe is NULL");
		return;
	}
	if (hasPassword)
		naviframe->push(new MemoHiddenPasswordView(this));
	else
		naviframe->push(new MemoHiddenFirstAccess(this));
}

void MemoListView::__pushSettingsView()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!naviframe) {
		MEMO_LOGE("Naviframe is NULL");
		return;
	}
	__hideFloatingButton();
	__isTopView = false;
	naviframe->push(new MemoSettingsView(this));
}

bool MemoListView::__openHiddenMemos(void *event)
{
	const int *values = static_cast<const int *>(event);
	if (!values || values[1] >= HIDDEN_GESTURE_LIMIT || !__isTopView)
		return true;
	__hideFloatingButton();
	__isTopView = false;
	char password[MemoHiddenPasswordView::PIN_DIGEST_BUFFER_SIZE] = {};
	__pushHiddenView(MemoDbMgr::getInstance()->getHiddenMemoPassword(password));
	return true;
}

void MemoListView::__launchAccountSettings()
{
	app_control_h request = nullptr;
	if (app_control_create(&request) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("Error app_control_create()");
		return;
	}
	if (MemoUtil::checkVeltronAccountLogIn()) {
		app_control_set_operation(request, "http://tizen.org/appcontrol/operation/account/configure");
		app_control_set_app_id(request, "com.veltron.veltron-account-front");
	} else {
		app_control_add_extra_data(request, "mode", "account_list");
		app_control_add_extra_data(request, "capability_filter", "http://tizen.org/account/capability/memo");
		app_control_set_operation(request, APP_CONTROL_OPERATION_PICK);
		app_control_set_app_id(request, "setting-myaccount-efl");
		app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP);
	}
	if (app_control_send_launch_request(request, nullptr, nullptr) != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("Error app_control_send_launch_request()");
	app_control_destroy(request);
}
