#ifndef TESTS_UI_SUPPORT_EDITVIEWAPPSFIXTURE_H
#define TESTS_UI_SUPPORT_EDITVIEWAPPSFIXTURE_H

// The edit view with its more menu, and the apps it launches played by the test callee
// (tests/helpers/test_callee), registered under their ids in a private launch registry.

#include <desktop/app_chooser.h>
#include <app_control.h>
#include <app_manager.h>
#include <vconf.h>

#include <fstream>
#include <set>
#include <string>
#include <vector>

#include <WMenuPopupController.h>

#include "EditViewFixture.h"
#include "TestEnv.h"

// What only shows for a moment, and what no user action starts.
struct MemoEditViewTestAccess {
	static bool isProcessing(MemoEditView *view) { return view->__processingPopup != nullptr; }
	static void createAttachPanel(MemoEditView *view) { view->__createAttachPanel(); }
	static bool isAttachPanelOpened(MemoEditView *view) { return view->__isAttachPanelOpened(); }
	static MemoRecorder *recorder(MemoEditView *view) { return view->__recorder; }
	static MemoPlayer *player(MemoEditView *view) { return view->__player; }
	static const char *uuid(MemoEditView *view) { return view->__UUID; }
};

namespace memo_ui_test
{

class EditViewAppsFixture : public EditViewFixture
{
protected:
	void SetUp() override
	{
		static const std::string apps = memo_test::makeTempDir("apps"), logs = memo_test::makeTempDir("callees");
		appsDir = apps;
		logDir = logs;
		setenv("TIZEN_APPS_DIR", appsDir.c_str(), 1);
		setenv("TEST_CALLEE_DIR", logDir.c_str(), 1);
		EditViewFixture::SetUp();
	}

	void TearDown() override
	{
		// Callees end first: requests still waiting on them are answered as cancelled.
		for (const std::string &id : registered) {
			app_control_h h = nullptr;
			app_control_create(&h);
			app_control_set_app_id(h, id.c_str());
			if (app_control_send_terminate_request(h) == APP_CONTROL_ERROR_NONE)
				waitFor(
				    [&] {
					    bool running = false;
					    app_manager_is_running(id.c_str(), &running);
					    return !running;
				    },
				    10.0);
			app_control_destroy(h);
			unlink((logDir + "/" + id + ".log").c_str());
			unlink((logDir + "/" + id + ".reply").c_str());
		}
		vconf_set_int("db/setting/psmode", 0);
		EditViewFixture::TearDown();
	}

	// Registers the callee as `id`, taking `operations` (comma separated) when a request names no app.
	void registerApp(const std::string &id, const std::string &operations = "", const std::string &icon = "")
	{
		std::ofstream(appsDir + "/" + id + ".ini")
		    << "[app]\nid=" << id << "\nexec=" << memo_test::helperPath("test_callee") << "\noperation=" << operations
		    << "\nicon=" << icon << "\n";
		registered.insert(id);
	}
	// The answer of the callee `id` to every request from now on (see test_callee.c).
	void setReply(const std::string &id, const std::string &lines)
	{
		std::ofstream(logDir + "/" + id + ".reply") << lines;
	}
	std::string calleeLog(const std::string &id) { return memo_test::readFile(logDir + "/" + id + ".log"); }
	bool waitLog(const std::string &id, const std::string &text, size_t times = 1)
	{
		return waitFor([&] { return memo_test::countOf(calleeLog(id), text) >= times; }, 10.0);
	}

	std::vector<std::string> openMenu() { return openMenuOf(naviframe); }
	void chooseMenu(const std::string &text) { chooseMenuOf(naviframe, text); }

	std::string appsDir, logDir;
	std::set<std::string> registered;
};

// The build's registry holds real apps too (the companions, the memo app itself): when a chooser comes
// up for a request without an app id, the test's app is picked in it.
inline void pickInChooser(const char *appId)
{
	Evas_Object *win = desktop_app_chooser_current_get();
	Evas_Object *list = win ? evas_object_name_find(evas_object_evas_get(win), DESKTOP_APP_CHOOSER_LIST_NAME) : nullptr;
	for (Elm_Object_Item *it = list ? elm_list_first_item_get(list) : nullptr; it; it = elm_list_item_next(it)) {
		const char *id = static_cast<const char *>(elm_object_item_data_get(it));
		if (id && !strcmp(id, appId))
			elm_list_item_selected_set(it, EINA_TRUE);
	}
}

} // namespace memo_ui_test

#endif
