#ifndef APP_ASSIST_INCLUDE_WAPP_H
#define APP_ASSIST_INCLUDE_WAPP_H

#include <app.h>

namespace app_assist
{

class WWindowController;

// The process's application object: derive from it, build one (normally on main's stack) and call start().
// The platform's lifecycle reaches the derived class through the virtual operations below.
class WApp
{
public:
	WApp();
	// Deletes the window controller if start() has not done so already.
	virtual ~WApp();
	WApp(const WApp &) = delete;
	WApp &operator=(const WApp &) = delete;

	// Called by start(); runs the platform main loop (ui_app_main) and returns its result.
	virtual int onStart(int argc, char *argv[]);
	// First callback of the loop; false ends the application. Default: true.
	virtual bool onCreate();
	// Last callback of the loop, while the window and its views still exist. The window is torn down after it.
	virtual void onTerminate();
	virtual void onPause();
	virtual void onResume();
	// A launch request: firstLaunch is true on the call that follows onCreate, false on later requests.
	// The request belongs to the platform and lives for the call only.
	virtual void onAppControl(app_control_s *request, bool firstLaunch);

	// Runs the application through onStart(); returns the platform's exit code (APP_ERROR_NONE on success).
	int start(int argc, char *argv[]);

	// Takes ownership of the one window controller; a previous one is deleted.
	void attachWindowController(WWindowController *windowController);
	// The window controller, or null before attachWindowController.
	WWindowController *getWindowController() const;

	// The one live WApp of the process, or null.
	static WApp *getInstance();

private:
	static bool __createCb(void *data);
	static void __terminateCb(void *data);
	static void __pauseCb(void *data);
	static void __resumeCb(void *data);
	static void __appControlCb(app_control_h request, void *data);
	void __destroyWindow();

	WWindowController *__windowController;
	bool __firstLaunch;
};

} // namespace app_assist

#endif
