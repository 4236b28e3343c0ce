// The application lifecycle in this process: callback order, the command-line request, events driven
// by vconf (language, rotation) and pause/resume de-duplication. The screenshot hook is run end to end
// by the e2e test.
#include <gtest/gtest.h>

#include <Elementary.h>
#include <app.h>
#include <vconf.h>

#include <cstdlib>
#include <libintl.h>
#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
// What one run of ui_app_main saw. Each test sets the hooks it needs.
struct AppRun {
	std::vector<std::string> calls;
	Evas_Object *win = nullptr;
	bool createResult = true;
	void (*onRequest)(AppRun *run, app_control_h request) = nullptr;
	std::string lang;
	int orientation = -1;
	std::vector<int> winRotations;
	int removedHandlerCalls = 0;
	app_event_handler_h langHandler = nullptr;
	app_event_handler_h removedHandler = nullptr;
	app_event_handler_h orientationHandler = nullptr;
	Ecore_Timer *guard = nullptr;
};

Eina_Bool guardCb(void *data)
{
	static_cast<AppRun *>(data)->guard = nullptr;
	ADD_FAILURE() << "the app did not end in time";
	ui_app_exit();
	return ECORE_CALLBACK_CANCEL;
}

bool createCb(void *data)
{
	AppRun *run = static_cast<AppRun *>(data);
	run->calls.push_back("create");
	run->win = elm_win_util_standard_add("lifecycle", "lifecycle");
	evas_object_resize(run->win, 200, 120);
	evas_object_show(run->win);
	run->guard = ecore_timer_add(10.0, guardCb, run);
	return run->createResult;
}

void terminateCb(void *data)
{
	AppRun *run = static_cast<AppRun *>(data);
	run->calls.push_back("terminate");
	if (run->guard)
		ecore_timer_del(run->guard);
	run->guard = nullptr;
	if (run->win)
		evas_object_del(run->win);
	run->win = nullptr;
}

void requestCb(app_control_h request, void *data)
{
	AppRun *run = static_cast<AppRun *>(data);
	char *op = nullptr;
	app_control_get_operation(request, &op);
	run->calls.push_back(std::string("request ") + (op ? op : "(null)"));
	free(op);
	if (run->onRequest)
		run->onRequest(run, request);
}

int runApp(AppRun &run, std::vector<const char *> args = {})
{
	args.insert(args.begin(), "lifecycle_test");
	ui_app_lifecycle_callback_s cb = {
	    createCb, terminateCb, [](void *data) { static_cast<AppRun *>(data)->calls.push_back("pause"); },
	    [](void *data) { static_cast<AppRun *>(data)->calls.push_back("resume"); }, requestCb};
	return ui_app_main((int)args.size(), const_cast<char **>(args.data()), &cb, &run);
}

class AppLifecycle : public ::testing::Test
{
protected:
	// Elementary stays up between runs: a full shutdown and new init in one process is not supported.
	static void SetUpTestSuite() { elm_init(0, nullptr); }
	static void TearDownTestSuite() { elm_shutdown(); }
};
} // namespace

TEST_F(AppLifecycle, CallbacksComeInOrderWithTheArgvRequestAndFollowTheWindow)
{
	AppRun run;
	static std::string extras;
	run.onRequest = [](AppRun *, app_control_h request) {
		char *v = nullptr;
		char **arr = nullptr;
		int n = 0;
		app_control_get_extra_data(request, "k", &v);
		app_control_get_extra_data_array(request, "list", &arr, &n);
		extras = std::string(v ? v : "-") + "|" + std::to_string(n) + (n == 2 ? std::string(arr[0]) + arr[1] : "");
		free(v);
		for (int i = 0; i < n; i++)
			free(arr[i]);
		free(arr);
		ui_app_exit(); // before the main loop: it must not start
	};
	EXPECT_EQ(APP_ERROR_NONE,
	          runApp(run, {"--operation", "test/op", "--extra", "k=v=w", "--extra-array", "list=a,b", "--unknown"}));
	EXPECT_EQ((std::vector<std::string>{"create", "request test/op", "resume", "pause", "terminate"}), run.calls);
	EXPECT_EQ("v=w|2ab", extras);

	// Window changes count once the app runs, that is after its first request, and each state once.
	AppRun windowed;
	windowed.onRequest = [](AppRun *r, app_control_h) {
		ecore_timer_add(
		    0.0,
		    [](void *data) -> Eina_Bool {
			    Evas_Object *win = static_cast<AppRun *>(data)->win;
			    for (const char *event : {"iconified", "iconified", "normal", "focused"})
				    evas_object_smart_callback_call(win, event, nullptr);
			    ui_app_exit();
			    return ECORE_CALLBACK_CANCEL;
		    },
		    r);
	};
	EXPECT_EQ(APP_ERROR_NONE, runApp(windowed));
	EXPECT_EQ((std::vector<std::string>{"create", "request " APP_CONTROL_OPERATION_MAIN, "resume", "pause", "resume",
	                                    "pause", "terminate"}),
	          windowed.calls);

	AppRun refused;
	refused.createResult = false;
	EXPECT_EQ(APP_ERROR_INVALID_CONTEXT, runApp(refused));
	EXPECT_EQ(std::vector<std::string>{"create"}, refused.calls);
	ecore_timer_del(refused.guard);
	evas_object_del(refused.win);
}

// Two text domains of the app, each with a German and a French catalogue.
static void bindTwoDomains()
{
	std::string dir = memo_test::makeTempDir("lifecycle-locale");
	const char *catalogues[][3] = {{"de", "lifecycle-a", "Hallo"},
	                               {"de", "lifecycle-b", "Tschuess"},
	                               {"fr", "lifecycle-a", "Bonjour"},
	                               {"fr", "lifecycle-b", "Salut"}};
	for (const auto &c : catalogues) {
		std::string msgs = dir + "/" + c[0] + "/LC_MESSAGES";
		ASSERT_EQ(0, memo_test::runCommand("mkdir -p '" + msgs + "' && printf 'msgid \"IDS_HELLO\"\\nmsgstr \"" + c[2] +
		                                   "\"\\n' | msgfmt -o '" + msgs + "/" + c[1] + ".mo' -"));
	}
	bindtextdomain("lifecycle-a", dir.c_str());
	bindtextdomain("lifecycle-b", dir.c_str());
}

TEST_F(AppLifecycle, LanguageChangeInVconfReachesHandlersAndEveryTextDomain)
{
	bindTwoDomains();
	AppRun run;
	run.onRequest = [](AppRun *r, app_control_h) {
		auto langCb = [](app_event_info_h info, void *data) {
			AppRun *self = static_cast<AppRun *>(data);
			char *lang = nullptr;
			EXPECT_EQ(APP_ERROR_NONE, app_event_get_language(info, &lang));
			app_device_orientation_e o;
			EXPECT_EQ(APP_ERROR_INVALID_CONTEXT, app_event_get_device_orientation(info, &o));
			std::string l = lang ? lang : "";
			free(lang);
			self->lang +=
			    l + ":" + dgettext("lifecycle-a", "IDS_HELLO") + "," + dgettext("lifecycle-b", "IDS_HELLO") + "|";
			// The locale name stays the same between these two languages: only a dropped cache shows French.
			if (l == "de_DE.UTF-8")
				vconf_set_str(VCONFKEY_LANGSET, "fr_FR.UTF-8");
			else
				ui_app_exit();
		};
		auto removedCb = [](app_event_info_h, void *data) { static_cast<AppRun *>(data)->removedHandlerCalls++; };
		ASSERT_EQ(APP_ERROR_NONE, ui_app_add_event_handler(&r->langHandler, APP_EVENT_LANGUAGE_CHANGED, langCb, r));
		ASSERT_EQ(APP_ERROR_NONE,
		          ui_app_add_event_handler(&r->removedHandler, APP_EVENT_LANGUAGE_CHANGED, removedCb, r));
		EXPECT_EQ(APP_ERROR_NONE, ui_app_remove_event_handler(r->removedHandler));
		vconf_set_str(VCONFKEY_LANGSET, "de_DE.UTF-8");
	};
	EXPECT_EQ(APP_ERROR_NONE, runApp(run));
	EXPECT_EQ("de_DE.UTF-8:Hallo,Tschuess|fr_FR.UTF-8:Bonjour,Salut|", run.lang);
	EXPECT_EQ(0, run.removedHandlerCalls);
	EXPECT_STREQ("fr_FR.UTF-8", getenv("LANGUAGE"));
	EXPECT_EQ(APP_ERROR_NONE, ui_app_remove_event_handler(run.langHandler));
	EXPECT_EQ(APP_ERROR_INVALID_PARAMETER, ui_app_remove_event_handler(run.langHandler));
	vconf_set_str(VCONFKEY_LANGSET, "en_US.UTF-8");
}

TEST_F(AppLifecycle, RotationKeyRotatesTheWindowsAndAnnouncesIt)
{
	AppRun run;
	run.onRequest = [](AppRun *r, app_control_h) {
		auto wmCb = [](void *data, Evas_Object *win, void *) {
			static_cast<AppRun *>(data)->winRotations.push_back(elm_win_rotation_get(win));
		};
		evas_object_smart_callback_add(r->win, "wm,rotation,changed", wmCb, r);
		// The windows turn first; the event then ends the run.
		auto orientationCb = [](app_event_info_h info, void *data) {
			app_device_orientation_e o = APP_DEVICE_ORIENTATION_0;
			EXPECT_EQ(APP_ERROR_NONE, app_event_get_device_orientation(info, &o));
			static_cast<AppRun *>(data)->orientation = o;
			ui_app_exit();
		};
		ui_app_add_event_handler(&r->orientationHandler, APP_EVENT_DEVICE_ORIENTATION_CHANGED, orientationCb, r);
		vconf_set_int("memory/desktop/rotation", 45); // not a rotation: ignored
		vconf_set_int("memory/desktop/rotation", 90);
	};
	EXPECT_EQ(APP_ERROR_NONE, runApp(run));
	EXPECT_EQ(90, run.orientation);
	EXPECT_EQ(std::vector<int>{90}, run.winRotations);
	EXPECT_EQ(APP_DEVICE_ORIENTATION_90, app_get_device_orientation());
	ui_app_remove_event_handler(run.orientationHandler);
	vconf_set_int("memory/desktop/rotation", 0);
}
