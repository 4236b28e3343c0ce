// The application object: binds the platform lifecycle to the virtual operations of WApp.
#include "WApp.h"

#include "WDefine.h"
#include "WWindowController.h"

namespace app_assist
{

static WApp *gInstance = nullptr;

WApp::WApp() : __windowController(nullptr), __firstLaunch(true)
{
	if (gInstance)
		WERROR("Another WApp exists already");
	gInstance = this;
}

WApp::~WApp()
{
	__destroyWindow();
	if (gInstance == this)
		gInstance = nullptr;
}

WApp *WApp::getInstance()
{
	return gInstance;
}

int WApp::start(int argc, char *argv[])
{
	__firstLaunch = true;
	return onStart(argc, argv);
}

int WApp::onStart(int argc, char *argv[])
{
	ui_app_lifecycle_callback_s callbacks = {};
	callbacks.create = __createCb;
	callbacks.terminate = __terminateCb;
	callbacks.pause = __pauseCb;
	callbacks.resume = __resumeCb;
	callbacks.app_control = __appControlCb;
	int ret = ui_app_main(argc, argv, &callbacks, this);
	if (ret != APP_ERROR_NONE)
		WERROR("ui_app_main failed (%d)", ret);
	return ret;
}

bool WApp::onCreate()
{
	return true;
}

void WApp::onTerminate() {}

void WApp::onPause() {}

void WApp::onResume() {}

void WApp::onAppControl(app_control_s *, bool) {}

void WApp::attachWindowController(WWindowController *windowController)
{
	if (windowController == __windowController)
		return;
	__destroyWindow();
	__windowController = windowController;
}

WWindowController *WApp::getWindowController() const
{
	return __windowController;
}

void WApp::__destroyWindow()
{
	WWindowController *windowController = __windowController;
	__windowController = nullptr;
	delete windowController;
}

bool WApp::__createCb(void *data)
{
	WApp *app = static_cast<WApp *>(data);
	app->__firstLaunch = true;
	return app->onCreate();
}

// The views still exist during onTerminate; the window and every view in it go right after, while
// Elementary is still up.
void WApp::__terminateCb(void *data)
{
	WApp *app = static_cast<WApp *>(data);
	app->onTerminate();
	app->__destroyWindow();
}

void WApp::__pauseCb(void *data)
{
	static_cast<WApp *>(data)->onPause();
}

void WApp::__resumeCb(void *data)
{
	static_cast<WApp *>(data)->onResume();
}

void WApp::__appControlCb(app_control_h request, void *data)
{
	WApp *app = static_cast<WApp *>(data);
	bool firstLaunch = app->__firstLaunch;
	app->__firstLaunch = false;
	app->onAppControl(request, firstLaunch);
}

} // namespace app_assist
