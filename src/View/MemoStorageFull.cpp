// The storage-full popup and the storage settings launch, shared by the list and the editor.
#include "View/MemoStorageFull.h"

#include <app_control.h>
#include <app_i18n.h>
#include <notification.h>

#include "MemoLog.h"
#include "Util/MemoUtil.h"

using app_assist::WPopupController;

WPopupController *memoStorageFullPopupN(const std::function<void()> &onCancel)
{
	if (MemoUtil::isPowerSavingMode()) {
		notification_status_message_post(i18n_get_text("IDS_ST_TPOP_NOT_ENOUGH_SPACE_IN_PHONE_STORAGE"));
		return nullptr;
	}
	WPopupController *popup = new WPopupController();
	popup->setTextTranslatable("memo");
	popup->setTitle("IDS_IDLE_HEADER_NOT_ENOUGH_SPACE_ABB2");
	popup->setContent("IDS_IDLE_POP_YOUR_DEVICE_STORAGE_DOESNT_HAVE_ENOUGH_SPACE_GO_TO_SETTINGS_STORAGE_AND_RAM_"
	                  "STORAGE_DETAILS_THEN_DELETE_SOME_FILES_AND_TRY_AGAIN");
	popup->addButton("IDS_MEMO_BUTTON_CANCEL", [onCancel](bool *close) {
		*close = true;
		if (onCancel)
			onCancel();
	});
	popup->addButton("IDS_MEMO_OPT_SETTINGS", [](bool *close) {
		*close = true;
		memoLaunchStorageSettings();
	});
	return popup;
}

void memoLaunchStorageSettings()
{
	app_control_h request = nullptr;
	if (app_control_create(&request) != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("Error app_control_create()");
	if (app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP) != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("Error app_control_set_launch_mode()");
	if (app_control_set_app_id(request, "com.veltron.setting.storage") != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("Error app_control_set_app_id()");
	if (app_control_add_extra_data(request, "viewtype", "storage_detail") != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("Error app_control_add_extra_data()");
	if (app_control_send_launch_request(request, nullptr, nullptr) != APP_CONTROL_ERROR_NONE)
		MEMO_LOGE("Error app_control_send_launch_request()");
	if (request)
		app_control_destroy(request);
}
