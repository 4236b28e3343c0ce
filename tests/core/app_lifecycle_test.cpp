// MemoApp run for real through WApp::start in this process: the order of the lifecycle, what onCreate builds,
// and the device changes (rotation, language, time format, theme) that reach the bus while the loop runs.
#include "app_test_fixture.h"

#include <Ecore.h>
#include <Ecore_File.h>
#include <app_common.h>
#include <app_i18n.h>
#include <app_preference.h>
#include <libintl.h>
#include <vconf.h>

#include <functional>

#include "DataBase/MemoDbMgr.h"
#include "MemoApp.h"

using app_test::BusRecorder;

namespace
{

// One step of a scenario: an action, then a condition to wait for before the next step.
struct Step {
	std::function<void()> action;
	std::function<bool()> until;
};

std::vector<std::string> gCalls;

// Records the lifecycle and, once the first request is in, plays the scenario on the running loop (a poll
// timer, so that no step nests a main loop), then asks the app to end.
class ScriptedApp : public MemoApp
{
public:
	explicit ScriptedApp(std::vector<Step> steps) : __steps(std::move(steps)) {}
	~ScriptedApp() override
	{
		if (__timer)
			ecore_timer_del(__timer);
		gCalls.push_back("destructor");
	}

	bool onCreate() override
	{
		gCalls.push_back("onCreate");
		return MemoApp::onCreate();
	}
	void onResume() override
	{
		gCalls.push_back("onResume");
		MemoApp::onResume();
	}
	void onTerminate() override
	{
		gCalls.push_back("onTerminate");
		MemoApp::onTerminate();
	}
	void onAppControl(app_control_s *request, bool firstLaunch) override
	{
		gCalls.push_back(firstLaunch ? "onAppControl(first)" : "onAppControl");
		MemoApp::onAppControl(request, firstLaunch);
		if (firstLaunch && !__timer)
			__timer = ecore_timer_add(0.01, __stepCb, this);
	}

	bool finished = false;
	// How the scenario ends the app; ui_app_exit() when empty.
	std::function<void()> closer;

private:
	// One step a tick: its action once, then its condition until it holds or five seconds pass.
	static Eina_Bool __stepCb(void *data)
	{
		ScriptedApp *self = static_cast<ScriptedApp *>(data);
		if (self->__index < self->__steps.size()) {
			Step &step = self->__steps[self->__index];
			if (!self->__deadline && step.action)
				step.action();
			if (!self->__deadline)
				self->__deadline = ecore_time_get() + 5.0;
			bool done = !step.until || step.until();
			if (!done && ecore_time_get() < self->__deadline)
				return ECORE_CALLBACK_RENEW;
			EXPECT_TRUE(done) << "step " << self->__index << " timed out";
			self->__index = done ? self->__index + 1 : self->__steps.size();
			self->__deadline = 0;
			if (self->__index < self->__steps.size())
				return ECORE_CALLBACK_RENEW;
		}
		self->finished = true;
		self->__timer = nullptr;
		self->closer ? self->closer() : ui_app_exit();
		return ECORE_CALLBACK_CANCEL;
	}

	std::vector<Step> __steps;
	size_t __index = 0;
	double __deadline = 0;
	Ecore_Timer *__timer = nullptr;
};

class AppLifecycleTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		// Held for the whole suite, so that each run of the app starts on an Elementary that stays up.
		static char arg0[] = "app-lifecycle-test";
		static char *argv[] = {arg0, nullptr};
		elm_init(1, argv);
	}

	void SetUp() override { gCalls.clear(); }

	// Runs the app with the scenario; returns start()'s result.
	int run(std::vector<Step> steps, std::function<void()> closer = nullptr)
	{
		static char arg0[] = "memo";
		static char *argv[] = {arg0, nullptr};
		int rc;
		{
			ScriptedApp app(std::move(steps));
			app.closer = std::move(closer);
			current = &app;
			rc = app.start(1, argv);
			EXPECT_TRUE(app.finished);
			current = nullptr;
		}
		// Each run stands for a process of its own; its preference callbacks stay behind otherwise.
		preference_unset_changed_cb("MEMO_SVC_PROCESSING");
		preference_unset_changed_cb("CLOUD_TRIGGERING");
		return rc;
	}

	Evas_Object *window() const { return current->getWindowController()->getEvasObj(); }

	ScriptedApp *current = nullptr;
	BusRecorder bus;
};

static bool colorClassIs(const char *name, int r, int g, int b)
{
	int cr = -1, cg = -1, cb = -1, ca, r2, g2, b2, a2, r3, g3, b3, a3;
	edje_color_class_get(name, &cr, &cg, &cb, &ca, &r2, &g2, &b2, &a2, &r3, &g3, &b3, &a3);
	return cr == r && cg == g && cb == b;
}

// One run as a user has it: the first page, then device changes while the loop runs (rotation, language,
// time format, theme), each told on the bus once, then the window's close request.
TEST_F(AppLifecycleTest, startShowsOneFirstPageCarriesDeviceChangesToTheBusAndEndsInOrder)
{
	auto checkFirstScreen = [this] {
		Evas_Object *win = window();
		ASSERT_NE(win, nullptr);
		// The window manager shows the app's name; the window keeps the app id as its name.
		EXPECT_STREQ(elm_win_title_get(win), "Memo");
		EXPECT_STREQ(current->getWindowController()->getName(), "com.veltron.memo");
		app_assist::WNaviframeController *naviframe = app_test::naviframeOf(current);
		ASSERT_NE(naviframe, nullptr);
		// The first request pushed the one first page, the memo list.
		EXPECT_EQ(naviframe->getContentViewCount(), 1);
		ASSERT_NE(naviframe->getTopContentViewController(), nullptr);
		EXPECT_STREQ(naviframe->getTopContentViewController()->getClassName(), "MemoListView");

		// The app's theme: its base layout holding the naviframe, its tables applied.
		Evas_Object *baseLayout = current->getWindowController()->getBaseLayoutEvasObj();
		const char *group = nullptr;
		elm_layout_file_get(baseLayout, nullptr, &group);
		EXPECT_STREQ(group, "memo/app/base");
		EXPECT_EQ(elm_object_part_content_get(baseLayout, "elm.swallow.content"), naviframe->getEvasObj());
		EXPECT_TRUE(colorClassIs("AO011", 245, 180, 0));

		EXPECT_TRUE(ecore_file_exists((std::string(getenv("TIZEN_APP_ROOT")) + "/data/memo.db").c_str()));
	};
	const char *rotated = "broadcast,orientation,changed";
	auto rotateTo = [this, rotated](int degree, unsigned char portrait, size_t count) {
		return Step{
		    [degree] { vconf_set_int("memory/desktop/rotation", degree); },
		    [this, rotated, portrait, count] { return bus.countOf(rotated) == count && gIsPortrait == portrait; }};
	};
	auto told = [this](const char *key, size_t count) {
		return [this, key, count] { return bus.countOf(key) == count; };
	};
	auto closeWindow = [this] { evas_object_smart_callback_call(window(), "delete,request", nullptr); };
	int rc = run(
	    {{[this] { bus.attach(); }, nullptr},
	     {checkFirstScreen, nullptr},
	     rotateTo(90, 0, 1),
	     rotateTo(180, 1, 2),
	     rotateTo(270, 0, 3),
	     rotateTo(0, 1, 4),
	     // An angle the window manager would never report keeps the flag, and is still told.
	     {[this] {
		      gIsPortrait = 0;
		      elm_win_rotation_set(window(), 45);
		      evas_object_smart_callback_call(window(), "wm,rotation,changed", nullptr);
	      },
	      told(rotated, 5)},
	     {[] {
		      EXPECT_EQ(gIsPortrait, 0);
		      gIsPortrait = 1;
		      vconf_set_str("db/menu_widget/language", "de_DE.UTF-8");
	      },
	      told("broadcast,language,changed", 1)},
	     // The views' own text domains follow the language.
	     {[] {
		      EXPECT_STREQ(dgettext("memo-sub", "IDS_MEMO_BUTTON_DELETE"), "Löschen");
		      EXPECT_STREQ(dgettext("memo", "IDS_MEMO_OPT_SEARCH"), "Suchen");
		      vconf_set_str("db/menu_widget/language", "en_US.UTF-8");
	      },
	      told("broadcast,language,changed", 2)},
	     {[] {
		      EXPECT_STREQ(i18n_get_text("IDS_MEMO_BUTTON_DELETE"), "Delete");
		      vconf_set_int("db/menu_widget/regionformat_time1224", 2);
	      },
	      told("broadcast,timeformat,changed", 1)},
	     {[] { vconf_set_str("db/setting/timezone_id", "Europe/Berlin"); }, told("broadcast,timeformat,changed", 2)},
	     // A theme change sets both tables again, a text class changed behind the app's back included.
	     {[] {
		      EXPECT_TRUE(colorClassIs("AO010", 250, 248, 242));
		      edje_text_class_set("ATO001", "Sans", 99);
		      vconf_set_int("db/setting/change_ui/theme", 1);
	      },
	      [] { return colorClassIs("AO010", 30, 29, 27); }},
	     {[] {
		      const char *font = nullptr;
		      Evas_Font_Size size = 0;
		      edje_text_class_get("ATO001", &font, &size);
		      EXPECT_EQ(size, 26);
		      vconf_set_int("db/setting/change_ui/theme", 0);
	      },
	      [] { return colorClassIs("AO010", 250, 248, 242); }}},
	    closeWindow);
	EXPECT_EQ(rc, APP_ERROR_NONE);
	EXPECT_EQ(gCalls,
	          (std::vector<std::string>{"onCreate", "onAppControl(first)", "onResume", "onTerminate", "destructor"}));
	// Nothing else was said but the pause of the way out, before onTerminate took the bus and its listener.
	std::vector<std::string> expected(5, rotated);
	expected.insert(expected.end(),
	                {"broadcast,language,changed", "broadcast,language,changed", "broadcast,timeformat,changed",
	                 "broadcast,timeformat,changed", "broadcast,memo,app,pause"});
	EXPECT_EQ(bus.keys, expected);
	EXPECT_EQ(MemoBroadCaster::getInstance().getListenerCount(), 0u);
	MemoBroadCaster::destroy();
}

} // namespace
