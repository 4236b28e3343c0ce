// One platform application event registration that ends with its owner.
#include "WAppEventHandler.h"

#include "WDefine.h"

namespace app_assist
{

WAppEventHandler::WAppEventHandler() : __handle(nullptr) {}

WAppEventHandler::~WAppEventHandler()
{
	removeEventHandler();
}

bool WAppEventHandler::addEventHandler(app_event_type_e eventType,
                                       void (*eventFunc)(app_event_info_h eventInfo, void *data), void *data)
{
	if (!eventFunc) {
		WERROR("eventFunc is null");
		return false;
	}
	removeEventHandler();
	int ret = ui_app_add_event_handler(&__handle, eventType, eventFunc, data);
	if (ret != APP_ERROR_NONE) {
		WERROR("ui_app_add_event_handler failed (%d) for event %d", ret, (int)eventType);
		__handle = nullptr;
		return false;
	}
	return true;
}

void WAppEventHandler::removeEventHandler()
{
	if (!__handle)
		return;
	int ret = ui_app_remove_event_handler(__handle);
	if (ret != APP_ERROR_NONE)
		WERROR("ui_app_remove_event_handler failed (%d)", ret);
	__handle = nullptr;
}

} // namespace app_assist
