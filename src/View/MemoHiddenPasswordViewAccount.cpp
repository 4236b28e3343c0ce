// A forgotten PIN: whether the sync account is signed in, and its confirmation by the account app, whose
// "succeeded" alone lets a new PIN be made.
#include "View/MemoHiddenPasswordView.h"

#include <cstdlib>
#include <cstring>

#include <account.h>

#include "MemoLog.h"

namespace
{
const char ACCOUNT_APP_ID[] = "com.veltron.veltronaccount";
const char CONFIRM_OPERATION[] = "http://tizen.org/appcontrol/operation/confirmpassword";
// The memo app's own registration with the account service.
const char CLIENT_ID[] = "memo-desktop";
const char CLIENT_SECRET[] = "com.veltron.memo";

bool __accountCb(account_h account, void *userData)
{
	(void)userData;
	if (!account)
		MEMO_LOGE("----------------------- account is NULL");
	return true;
}
} // namespace

bool MemoHiddenPasswordView::checkAccount()
{
	if (account_connect() != ACCOUNT_ERROR_NONE)
		return false;
	const int query = account_query_account_by_package_name(__accountCb, ACCOUNT_APP_ID, nullptr);
	switch (query) {
	case ACCOUNT_ERROR_NONE:
		break;
	case ACCOUNT_ERROR_INVALID_PARAMETER:
		MEMO_LOGE("ACCOUNT_ERROR_INVALID_PARAMETER");
		break;
	case ACCOUNT_ERROR_DB_FAILED:
		MEMO_LOGE("ACCOUNT_ERROR_DB_FAILED");
		break;
	case ACCOUNT_ERROR_PERMISSION_DENIED:
		MEMO_LOGE("ACCOUNT_ERROR_PERMISSION_DENIED");
		break;
	case ACCOUNT_ERROR_RECORD_NOT_FOUND:
		MEMO_LOGE("ACCOUNT_ERROR_RECORD_NOT_FOUND");
		break;
	default:
		MEMO_LOGE("UNKNOWN ERROR: %d", query);
		break;
	}
	const int disconnect = account_disconnect();
	if (disconnect != ACCOUNT_ERROR_NONE)
		MEMO_LOGE("----------------------- error[%d]", disconnect);
	return query == ACCOUNT_ERROR_NONE && disconnect == ACCOUNT_ERROR_NONE;
}

void MemoHiddenPasswordView::__forgottenPinCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoHiddenPasswordView *self = static_cast<MemoHiddenPasswordView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->veltronAccountLaunch();
}

void MemoHiddenPasswordView::veltronAccountLaunch()
{
	app_control_h request = nullptr;
	if (app_control_create(&request) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("Create service handle failed");
		return;
	}
	app_control_set_app_id(request, ACCOUNT_APP_ID);
	app_control_set_operation(request, CONFIRM_OPERATION);
	app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP);
	const int ret = app_control_add_extra_data(request, "client_id", CLIENT_ID) +
	                app_control_add_extra_data(request, "client_secret", CLIENT_SECRET) +
	                app_control_add_extra_data(request, "service_category", "account_verify") +
	                app_control_add_extra_data(request, "z_order", "highest");
	if (ret != 0)
		MEMO_LOGE("Failed to add extra service data : ret is [%d]", ret);
	// The answer may come after the page has gone: it finds the page through a weak reference.
	app_assist::WViewControllerWeakPtr *page = new app_assist::WViewControllerWeakPtr(getWeakPtr());
	if (app_control_send_launch_request(request, __accountReplyCb, page) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("Failed to send launch request");
		delete page;
	}
	app_control_destroy(request);
}

void MemoHiddenPasswordView::__accountReplyCb(app_control_h request, app_control_h reply, app_control_result_e result,
                                              void *data)
{
	(void)request;
	app_assist::WViewControllerWeakPtr *page = static_cast<app_assist::WViewControllerWeakPtr *>(data);
	MemoHiddenPasswordView *self = page ? dynamic_cast<MemoHiddenPasswordView *>(page->lock().get()) : nullptr;
	delete page;
	if (result == APP_CONTROL_RESULT_FAILED) {
		char *message = nullptr;
		app_control_get_extra_data(reply, "errorMessage", &message);
		MEMO_LOGI("account confirmation failed: %s; the PIN stays", message ? message : "(no message)");
		free(message);
		return;
	}
	// Only a confirmed account clears the PIN: a cancelled confirmation would let anyone holding the device do
	// it.
	if (result != APP_CONTROL_RESULT_SUCCEEDED) {
		MEMO_LOGI("account confirmation ended with result %d; the PIN stays", static_cast<int>(result));
		return;
	}
	if (!self) {
		MEMO_LOGE("self is NULL");
		return;
	}
	MEMO_LOGI("account confirmed: a new PIN may be created");
	elm_object_signal_emit(self->__layout, "hide,button", "");
	self->resetPINView();
}
