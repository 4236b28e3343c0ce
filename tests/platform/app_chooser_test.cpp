// Requests that name an operation but no app: the registered apps that take it (operation and mime type)
// get it, one directly, several through the chooser window. The apps are the test callee under several ids.
#include <gtest/gtest.h>

#include <Elementary.h>
#include <app_control.h>
#include <app_manager.h>
#include <desktop/app_chooser.h>

#include <cstdlib>
#include <fstream>
#include <set>
#include <string>

#include "TestEnv.h"

namespace
{
class AppChooser : public ::testing::Test
{
protected:
	void SetUp() override
	{
		memo_test::initElementary();
		apps = memo_test::makeTempDir("chooser-apps");
		logs = memo_test::makeTempDir("chooser-logs");
		setenv("TIZEN_APPS_DIR", apps.c_str(), 1);
		setenv("TEST_CALLEE_DIR", logs.c_str(), 1);
	}

	void TearDown() override
	{
		for (const std::string &id : started) {
			app_control_h h = nullptr;
			app_control_create(&h);
			app_control_set_app_id(h, id.c_str());
			if (app_control_send_terminate_request(h) == APP_CONTROL_ERROR_NONE)
				memo_test::pump(10.0, [&] { return !running(id); });
			app_control_destroy(h);
		}
		unsetenv("TIZEN_APPS_DIR");
	}

	void registerApp(const std::string &id, const std::string &operation, const std::string &mime = "")
	{
		std::ofstream(apps + "/" + id + ".ini")
		    << "[app]\nid=" << id << "\nexec=" << memo_test::helperPath("test_callee") << "\nlabel=Label of " << id
		    << "\noperation=" << operation << "\n"
		    << (mime.empty() ? "" : "mime=" + mime + "\n");
		started.insert(id);
	}

	static bool running(const std::string &id)
	{
		bool is = false;
		app_manager_is_running(id.c_str(), &is);
		return is;
	}

	bool received(const std::string &id)
	{
		return memo_test::pump(10.0, [&] {
			return memo_test::readFile(logs + "/" + id + ".log").find("op=test/op/") != std::string::npos;
		});
	}

	static int send(const char *operation, const char *mime, app_control_reply_cb cb, void *data)
	{
		app_control_h h = nullptr;
		app_control_create(&h);
		app_control_set_operation(h, operation);
		if (mime)
			app_control_set_mime(h, mime);
		int ret = app_control_send_launch_request(h, cb, data);
		app_control_destroy(h);
		return ret;
	}

	std::string apps, logs;
	std::set<std::string> started;
};

// The ids offered by the open chooser, by the app ids its list items carry.
std::set<std::string> offeredIds(Elm_Object_Item **last)
{
	std::set<std::string> ids;
	Evas_Object *win = desktop_app_chooser_current_get();
	Evas_Object *list = win ? evas_object_name_find(evas_object_evas_get(win), DESKTOP_APP_CHOOSER_LIST_NAME) : nullptr;
	for (const Eina_List *l = list ? elm_list_items_get(list) : nullptr; l; l = l->next) {
		*last = static_cast<Elm_Object_Item *>(l->data);
		ids.insert(static_cast<const char *>(elm_object_item_data_get(*last)));
	}
	return ids;
}
} // namespace

TEST_F(AppChooser, OneTakerIsLaunchedDirectlySeveralAreOfferedAndTheChosenOneGetsTheRequest)
{
	// Nobody takes it.
	EXPECT_EQ(APP_CONTROL_ERROR_APP_NOT_FOUND, send("test/op/nobody", nullptr, nullptr, nullptr));

	// One taker: no chooser, the request arrives.
	registerApp("test.chooser.single", "test/op/single");
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, send("test/op/single", nullptr, nullptr, nullptr));
	EXPECT_EQ(nullptr, desktop_app_chooser_current_get());
	EXPECT_TRUE(received("test.chooser.single"));

	// Two take the operation and the mime type; one declares another mime type; one another operation.
	registerApp("test.chooser.a", "test/op/other, test/op/several", "image/*");
	registerApp("test.chooser.b", "test/op/several");
	registerApp("test.chooser.text", "test/op/several", "text/plain");
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, send("test/op/several", "image/png", nullptr, nullptr));
	Elm_Object_Item *item = nullptr;
	EXPECT_EQ((std::set<std::string>{"test.chooser.a", "test.chooser.b"}), offeredIds(&item));
	ASSERT_NE(nullptr, item);
	const std::string chosen = static_cast<const char *>(elm_object_item_data_get(item));
	elm_list_item_selected_set(item, EINA_TRUE);
	EXPECT_TRUE(received(chosen));
	EXPECT_EQ(nullptr, desktop_app_chooser_current_get());
	const std::string other = chosen == "test.chooser.a" ? "test.chooser.b" : "test.chooser.a";
	EXPECT_FALSE(running(other));

	// Closing the chooser answers a waiting requester with "canceled".
	app_control_result_e result = APP_CONTROL_RESULT_SUCCEEDED;
	auto replyCb = [](app_control_h, app_control_h, app_control_result_e r, void *data) {
		*static_cast<app_control_result_e *>(data) = r;
	};
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, send("test/op/several", nullptr, replyCb, &result));
	ASSERT_NE(nullptr, desktop_app_chooser_current_get());
	evas_object_del(desktop_app_chooser_current_get());
	EXPECT_TRUE(memo_test::pump(5.0, [&] { return result == APP_CONTROL_RESULT_CANCELED; }));
	EXPECT_FALSE(running("test.chooser.text"));
}
