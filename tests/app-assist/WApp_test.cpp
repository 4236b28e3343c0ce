// The application object under the real platform loop: callback order, first launch, teardown, events.
#include <string>
#include <unistd.h>
#include <vector>

#include <vconf.h>

#include "TestEnv.h"
#include "WApp.h"
#include "WAppEventHandler.h"
#include "support/AppAssistFixture.h"

using aa_test::LoggingPage;
using app_assist::WApp;
using app_assist::WAppEventHandler;
using Log = std::vector<std::string>;

namespace
{

// Pushes a page in onCreate, changes the language once the first request came, then leaves.
class TestApp : public WApp
{
public:
	bool onCreate() override
	{
		log.push_back("onCreate");
		getInstanceSeen = WApp::getInstance() == this;
		auto *window = new app_assist::WWindowController("wapp-test", ELM_WIN_BASIC);
		attachWindowController(window);
		naviframe = new app_assist::WNaviframeController();
		window->attachBaseViewController(naviframe);
		languageHandler.addEventHandler(APP_EVENT_LANGUAGE_CHANGED, __languageCb, this);
		return naviframe->push(new LoggingPage("P", &log));
	}
	void onAppControl(app_control_s *request, bool firstLaunch) override
	{
		log.push_back(std::string("onAppControl:") + (firstLaunch ? "first" : "later") + (request ? "" : ":null"));
		if (firstLaunch)
			vconf_set_str(VCONFKEY_LANGSET, "ko_KR.UTF-8");
	}
	void onTerminate() override
	{
		log.push_back("onTerminate");
		pageAliveAtTerminate = naviframe->getTopContentViewController() != nullptr;
	}

	Log log;
	bool getInstanceSeen = false;
	bool pageAliveAtTerminate = false;
	int languageEvents = 0;
	app_assist::WNaviframeController *naviframe = nullptr;
	WAppEventHandler languageHandler;

private:
	static void __languageCb(app_event_info_h, void *data)
	{
		TestApp *app = static_cast<TestApp *>(data);
		app->log.push_back("language");
		// A second change must not arrive once the handler is gone.
		app->languageHandler.removeEventHandler();
		vconf_set_str(VCONFKEY_LANGSET, "en_US.UTF-8");
		ecore_timer_add(
		    0.3,
		    [](void *) -> Eina_Bool {
			    ui_app_exit();
			    return ECORE_CALLBACK_CANCEL;
		    },
		    nullptr);
	}
};

TEST(WAppTest, RunsCreateThenFirstRequestAndTearsViewsDownAfterTerminate)
{
	// An id of its own, so that no other test process takes this launch over.
	std::string appId = "org.example.wapp-test-" + std::to_string(getpid());
	setenv("TIZEN_APP_ID", appId.c_str(), 1);
	vconf_set_str(VCONFKEY_LANGSET, "en_US.UTF-8");

	char arg0[] = "wapp-test";
	char *argv[] = {arg0, nullptr};
	int ret;
	Log log;
	bool instanceSeen, pageAlive;
	{
		TestApp app;
		ret = app.start(1, argv);
		log = app.log;
		instanceSeen = app.getInstanceSeen;
		pageAlive = app.pageAliveAtTerminate;
		EXPECT_EQ(app.getWindowController(), nullptr);
	}
	EXPECT_EQ(WApp::getInstance(), nullptr);
	EXPECT_EQ(ret, APP_ERROR_NONE);
	EXPECT_TRUE(instanceSeen);
	EXPECT_TRUE(pageAlive);
	EXPECT_EQ(log, (Log{"onCreate", "P:constructor", "P:onCreateView", "P:onCreated", "P:onPushed",
	                    "onAppControl:first", "language", "onTerminate", "P:onPop", "P:onDestroy", "P:destructor"}));
	setenv("TIZEN_APP_ID", "com.veltron.memo", 1);
}

} // namespace
