#ifndef APP_ASSIST_INCLUDE_WAPPEVENTHANDLER_H
#define APP_ASSIST_INCLUDE_WAPPEVENTHANDLER_H

#include <app.h>

namespace app_assist
{

// One registration of a platform application event (language, orientation, ...). Unregisters when destroyed.
class WAppEventHandler
{
public:
	WAppEventHandler();
	virtual ~WAppEventHandler();
	WAppEventHandler(const WAppEventHandler &) = delete;
	WAppEventHandler &operator=(const WAppEventHandler &) = delete;

	// Registers eventFunc with data for eventType, replacing this object's previous registration.
	// Returns false and logs when the platform refuses.
	bool addEventHandler(app_event_type_e eventType, void (*eventFunc)(app_event_info_h eventInfo, void *data),
	                     void *data);
	// Unregisters; nothing happens when nothing is registered.
	void removeEventHandler();
	// The platform handle, or null when nothing is registered.
	app_event_handler_h getHandle() const { return __handle; }

private:
	app_event_handler_h __handle;
};

} // namespace app_assist

#endif
