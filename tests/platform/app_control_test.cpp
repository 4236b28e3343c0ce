// Request handles and bundles: field copies, extra data and its error codes, clones, the text form,
// plus the path, resource and registry lookups that need no second process.
#include <algorithm>
#include <gtest/gtest.h>

#include <app.h>
#include <app_manager.h>
#include <app_resource_manager.h>
#include <bundle.h>

#include <cstdlib>
#include <cstring>
#include <fstream>
#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
// Frees a malloc'ed string on scope exit.
struct CStr {
	char *p = nullptr;
	~CStr() { free(p); }
	std::string str() const { return p ? p : "(null)"; }
};

std::vector<std::string> takeArray(char **values, int n)
{
	std::vector<std::string> out;
	for (int i = 0; i < n; i++) {
		out.push_back(values[i]);
		free(values[i]);
	}
	free(values);
	return out;
}

class AppControl : public ::testing::Test
{
protected:
	void SetUp() override { ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_create(&h)); }
	void TearDown() override { app_control_destroy(h); }
	app_control_h h = nullptr;
};

bool collectKeyCb(app_control_h, const char *key, void *data)
{
	static_cast<std::vector<std::string> *>(data)->push_back(key);
	return true;
}

bool stopAfterFirstCb(app_control_h, const char *, void *data)
{
	++*static_cast<int *>(data);
	return false;
}
} // namespace

TEST_F(AppControl, FieldsAreCopiedInAndOutAndByCloneAndClearedByNull)
{
	CStr none;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_get_operation(h, &none.p));
	EXPECT_EQ(nullptr, none.p);
	std::string uri = "file:///tmp/a.txt";
	app_control_set_operation(h, APP_CONTROL_OPERATION_SHARE);
	app_control_set_uri(h, uri.c_str());
	app_control_set_mime(h, "text/plain");
	app_control_set_app_id(h, "com.example.target");
	app_control_add_extra_data(h, "k", "v");
	uri[0] = 'X'; // the handle keeps its own copy
	EXPECT_EQ(APP_CONTROL_ERROR_NONE, app_control_set_launch_mode(h, APP_CONTROL_LAUNCH_MODE_GROUP));
	EXPECT_EQ(APP_CONTROL_ERROR_INVALID_PARAMETER, app_control_set_launch_mode(h, (app_control_launch_mode_e)7));

	// A clone keeps every field and stays apart from its original.
	app_control_h clone = nullptr;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_clone(&clone, h));
	app_control_add_extra_data(h, "k", "changed");
	EXPECT_EQ(APP_CONTROL_ERROR_NONE, app_control_set_uri(h, nullptr));
	CStr cleared;
	app_control_get_uri(h, &cleared.p);
	EXPECT_EQ(nullptr, cleared.p);
	app_control_destroy(h);
	h = clone; // TearDown destroys the clone

	CStr op, gotUri, mime, id, k;
	app_control_get_operation(h, &op.p);
	app_control_get_uri(h, &gotUri.p);
	app_control_get_mime(h, &mime.p);
	app_control_get_app_id(h, &id.p);
	app_control_get_extra_data(h, "k", &k.p);
	EXPECT_EQ("http://tizen.org/appcontrol/operation/share|file:///tmp/a.txt|text/plain|com.example.target|v",
	          op.str() + "|" + gotUri.str() + "|" + mime.str() + "|" + id.str() + "|" + k.str());
	app_control_launch_mode_e mode = APP_CONTROL_LAUNCH_MODE_SINGLE;
	app_control_get_launch_mode(h, &mode);
	EXPECT_EQ(APP_CONTROL_LAUNCH_MODE_GROUP, mode);
}

TEST_F(AppControl, ExtraDataKeepsScalarsAndArraysApartInOrderWithTizenErrors)
{
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_add_extra_data(h, APP_CONTROL_DATA_TEXT, "héllo & more"));
	const char *paths[] = {"/a.jpg", "/b c.png", ""};
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_add_extra_data_array(h, APP_CONTROL_DATA_SELECTED, paths, 3));
	app_control_set_operation(h, "op"); // fields are not extra data
	app_control_add_extra_data(h, "b", "1");

	CStr text;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_get_extra_data(h, APP_CONTROL_DATA_TEXT, &text.p));
	EXPECT_EQ("héllo & more", text.str());
	char **values = nullptr;
	int n = 0;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_get_extra_data_array(h, APP_CONTROL_DATA_SELECTED, &values, &n));
	EXPECT_EQ((std::vector<std::string>{"/a.jpg", "/b c.png", ""}), takeArray(values, n));
	bool array = false;
	app_control_is_extra_data_array(h, APP_CONTROL_DATA_SELECTED, &array);
	EXPECT_TRUE(array);
	app_control_is_extra_data_array(h, APP_CONTROL_DATA_TEXT, &array);
	EXPECT_FALSE(array);

	std::vector<std::string> keys;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_foreach_extra_data(h, collectKeyCb, &keys));
	EXPECT_EQ((std::vector<std::string>{APP_CONTROL_DATA_TEXT, APP_CONTROL_DATA_SELECTED, "b"}), keys);
	int calls = 0;
	app_control_foreach_extra_data(h, stopAfterFirstCb, &calls);
	EXPECT_EQ(1, calls);

	// The three error codes: wrong getter, missing key, reserved key.
	CStr wrong;
	EXPECT_EQ(APP_CONTROL_ERROR_INVALID_DATA_TYPE, app_control_get_extra_data(h, APP_CONTROL_DATA_SELECTED, &wrong.p));
	EXPECT_EQ(APP_CONTROL_ERROR_INVALID_DATA_TYPE,
	          app_control_get_extra_data_array(h, APP_CONTROL_DATA_TEXT, &values, &n));
	EXPECT_EQ(APP_CONTROL_ERROR_KEY_NOT_FOUND, app_control_get_extra_data(h, "missing", &wrong.p));
	EXPECT_EQ(APP_CONTROL_ERROR_KEY_NOT_FOUND, app_control_get_extra_data_array(h, "missing", &values, &n));
	EXPECT_EQ(APP_CONTROL_ERROR_KEY_REJECTED, app_control_add_extra_data(h, "__APP_SVC_OPERATION__", "x"));
	EXPECT_EQ(APP_CONTROL_ERROR_KEY_REJECTED, app_control_get_extra_data(h, "__AUL_ANY", &wrong.p));
	EXPECT_EQ(APP_CONTROL_ERROR_INVALID_PARAMETER, app_control_add_extra_data(h, "k", ""));
	EXPECT_EQ(APP_CONTROL_ERROR_INVALID_PARAMETER, app_control_add_extra_data_array(h, "k", paths, 0));

	// Adding a present key replaces it, whatever its kind was.
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_add_extra_data(h, APP_CONTROL_DATA_SELECTED, "/only.jpg"));
	EXPECT_EQ(APP_CONTROL_ERROR_NONE, app_control_get_extra_data(h, APP_CONTROL_DATA_SELECTED, &wrong.p));
	EXPECT_EQ("/only.jpg", wrong.str());
	EXPECT_EQ(APP_CONTROL_ERROR_NONE, app_control_remove_extra_data(h, APP_CONTROL_DATA_SELECTED));
	EXPECT_EQ(APP_CONTROL_ERROR_KEY_NOT_FOUND, app_control_remove_extra_data(h, APP_CONTROL_DATA_SELECTED));
}

// Slips a caller can make: a terminate without app id, a reply to a handle that was never received, ...
TEST_F(AppControl, BadArgumentsAndRepliesToLocalHandlesAreRefused)
{
	const int inval = APP_CONTROL_ERROR_INVALID_PARAMETER;
	char *s = nullptr;
	bool b = true;
	EXPECT_EQ(inval, app_control_send_terminate_request(h));
	EXPECT_EQ(inval, app_control_clone(nullptr, h));
	EXPECT_EQ(inval, app_control_add_extra_data(h, "k", nullptr));
	EXPECT_EQ(APP_ERROR_INVALID_PARAMETER, ui_app_main(0, nullptr, nullptr, nullptr));
	EXPECT_EQ(APP_RESOURCE_ERROR_INVALID_PARAMETER, app_resource_manager_get((app_resource_e)9, "x", &s));
	EXPECT_EQ(nullptr, bundle_decode(nullptr, 3));
	EXPECT_EQ(inval, app_control_get_caller(h, &s));
	EXPECT_EQ(APP_CONTROL_ERROR_NONE, app_control_is_reply_requested(h, &b));
	EXPECT_FALSE(b);
	app_control_h reply = nullptr;
	app_control_create(&reply);
	EXPECT_EQ(inval, app_control_reply_to_launch_request(reply, h, APP_CONTROL_RESULT_APP_STARTED));
	EXPECT_EQ(inval, app_control_reply_to_launch_request(reply, h, APP_CONTROL_RESULT_SUCCEEDED));
	app_control_destroy(reply);
}

TEST(Bundle, AddRefusesPresentKeysAndGettersCheckTheType)
{
	bundle *b = bundle_create();
	ASSERT_NE(nullptr, b);
	EXPECT_EQ(BUNDLE_ERROR_NONE, bundle_add_str(b, "k", "v"));
	EXPECT_EQ(BUNDLE_ERROR_KEY_EXISTS, bundle_add_str(b, "k", "w"));
	const char *arr[] = {"a", "b"};
	EXPECT_EQ(BUNDLE_ERROR_NONE, bundle_add_str_array(b, "arr", arr, 2));
	EXPECT_EQ(BUNDLE_TYPE_STR_ARRAY, bundle_get_type(b, "arr"));
	char *s = nullptr;
	EXPECT_EQ(BUNDLE_ERROR_NONE, bundle_get_str(b, "k", &s));
	EXPECT_STREQ("v", s);
	EXPECT_EQ(BUNDLE_ERROR_INVALID_PARAMETER, bundle_get_str(b, "arr", &s));
	EXPECT_EQ(BUNDLE_ERROR_KEY_NOT_AVAILABLE, bundle_get_str(b, "none", &s));
	int len = 0;
	EXPECT_EQ(nullptr, bundle_get_str_array(b, "k", &len));
	EXPECT_EQ(BUNDLE_ERROR_NONE, bundle_del(b, "k"));
	EXPECT_EQ(BUNDLE_ERROR_KEY_NOT_AVAILABLE, bundle_del(b, "k"));
	EXPECT_EQ(BUNDLE_ERROR_NONE, bundle_add_str(b, "k", "again"));
	bundle_free(b);
}

TEST(Bundle, EncodeDecodeRoundTripKeepsOrderTypesAndBytes)
{
	bundle *b = bundle_create();
	bundle_raw *raw = nullptr;
	int len = 0;
	ASSERT_EQ(BUNDLE_ERROR_NONE, bundle_encode(b, &raw, &len));
	bundle *back = bundle_decode(raw, len);
	ASSERT_NE(nullptr, back);
	EXPECT_EQ(0, bundle_get_count(back));
	bundle_free_encoded_rawdata(&raw);
	bundle_free(back);

	bundle_add_str(b, "utf8", "Grüße, 世界 \"quoted\" = ;");
	bundle_add_str(b, "empty", "");
	const char *arr[] = {"one", "", "three,with,commas"};
	bundle_add_str_array(b, "arr", arr, 3);
	const unsigned char bytes[] = {0, 1, 255, 0, 7};
	bundle_add_byte(b, "bytes", bytes, sizeof(bytes));
	ASSERT_EQ(BUNDLE_ERROR_NONE, bundle_encode(b, &raw, &len));
	EXPECT_EQ(len, (int)strlen((const char *)raw)); // a text form
	back = bundle_decode(raw, len);
	ASSERT_NE(nullptr, back);
	EXPECT_EQ(4, bundle_get_count(back));
	EXPECT_STREQ("Grüße, 世界 \"quoted\" = ;", bundle_get_val(back, "utf8"));
	EXPECT_STREQ("", bundle_get_val(back, "empty"));
	int n = 0;
	const char **got = bundle_get_str_array(back, "arr", &n);
	ASSERT_EQ(3, n);
	EXPECT_STREQ("", got[1]);
	EXPECT_STREQ("three,with,commas", got[2]);
	void *gotBytes = nullptr;
	size_t size = 0;
	ASSERT_EQ(BUNDLE_ERROR_NONE, bundle_get_byte(back, "bytes", &gotBytes, &size));
	EXPECT_EQ(std::string((const char *)bytes, sizeof(bytes)), std::string((const char *)gotBytes, size));

	// Damaged text is refused, not half-read.
	std::string damaged((const char *)raw, len);
	EXPECT_EQ(nullptr, bundle_decode((const bundle_raw *)damaged.c_str(), len - 4));
	damaged[len / 2] = '*';
	EXPECT_EQ(nullptr, bundle_decode((const bundle_raw *)damaged.c_str(), len));
	bundle_free_encoded_rawdata(&raw);
	bundle_free(back);
	bundle_free(b);
}

TEST(AppPaths, FollowTheEnvironmentWithTrailingSlashAndCreateFolders)
{
	CStr id, data, shared, cache, res;
	ASSERT_EQ(APP_ERROR_NONE, app_get_id(&id.p));
	EXPECT_EQ(std::string(getenv("TIZEN_APP_ID")), id.str());
	data.p = app_get_data_path();
	shared.p = app_get_shared_data_path();
	cache.p = app_get_cache_path();
	res.p = app_get_resource_path();
	const std::string root = getenv("TIZEN_APP_ROOT");
	EXPECT_EQ(root + "/data/|" + root + "/shared/data/|" + root + "/cache/|" + getenv("TIZEN_APP_RES_DIR"),
	          data.str() + "|" + shared.str() + "|" + cache.str() + "|" + res.str());
	EXPECT_TRUE(std::ofstream(std::string(shared.p) + "probe").good());
}

TEST(AppResourceManager, ResolvesIdsUnderTheResourceFolderAndReportsMissingFiles)
{
	const std::string saved = getenv("TIZEN_APP_RES_DIR");
	const std::string res = memo_test::makeTempDir("res") + "/";
	setenv("TIZEN_APP_RES_DIR", res.c_str(), 1);
	memo_test::runCommand("mkdir -p '" + res + "edje' && touch '" + res + "edje/memo.edj'");
	ASSERT_EQ(APP_RESOURCE_ERROR_NONE, app_resource_manager_init());
	CStr path, missing;
	EXPECT_EQ(APP_RESOURCE_ERROR_NONE, app_resource_manager_get(APP_RESOURCE_TYPE_IMAGE, "edje/memo.edj", &path.p));
	EXPECT_EQ(res + "edje/memo.edj", path.str());
	EXPECT_EQ(APP_RESOURCE_ERROR_IO_ERROR,
	          app_resource_manager_get(APP_RESOURCE_TYPE_IMAGE, "table/memo_color_table.xml", &missing.p));
	EXPECT_EQ(nullptr, missing.p);
	EXPECT_EQ(APP_RESOURCE_ERROR_NONE, app_resource_manager_release());
	setenv("TIZEN_APP_RES_DIR", saved.c_str(), 1);
}

TEST(AppRegistry, InfoAndMatchingComeFromIniFilesInTheAppsFolders)
{
	const std::string dir = memo_test::makeTempDir("apps");
	std::ofstream(dir + "/com.example.viewer.ini")
	    << "[app]\nid=com.example.viewer\nexec=/bin/true\nroot=/opt/viewer\nlabel=Viewer\nicon=viewer.png\n"
	       "operation=test/op/view, test/op/show\n";
	const char *saved = getenv("TIZEN_APPS_DIR");
	const std::string savedDirs = saved ? saved : "";
	setenv("TIZEN_APPS_DIR", ("/nonexistent:" + dir).c_str(), 1);

	app_info_h info = nullptr;
	ASSERT_EQ(APP_MANAGER_ERROR_NONE, app_manager_get_app_info("com.example.viewer", &info));
	CStr icon, label;
	app_info_get_icon(info, &icon.p);
	app_info_get_label(info, &label.p);
	EXPECT_EQ("/opt/viewer/shared/res/viewer.png", icon.str());
	EXPECT_EQ("Viewer", label.str());
	app_info_destroy(info);
	EXPECT_EQ(APP_MANAGER_ERROR_NO_SUCH_APP, app_manager_get_app_info("com.example.none", &info));

	app_control_h h = nullptr;
	app_control_create(&h);
	// Operations of their own: the build's registry folder is searched too, and its apps take the usual ones.
	app_control_set_operation(h, "test/op/show");
	std::vector<std::string> matched;
	auto cb = [](app_control_h, const char *appid, void *data) {
		static_cast<std::vector<std::string> *>(data)->push_back(appid);
		return true;
	};
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_foreach_app_matched(h, cb, &matched));
	EXPECT_EQ(std::vector<std::string>{"com.example.viewer"}, matched);
	matched.clear();
	app_control_set_operation(h, "test/op/pick");
	app_control_foreach_app_matched(h, cb, &matched);
	EXPECT_TRUE(matched.empty());
	EXPECT_EQ(APP_CONTROL_ERROR_APP_NOT_FOUND, app_control_send_launch_request(h, nullptr, nullptr));
	app_control_destroy(h);
	setenv("TIZEN_APPS_DIR", savedDirs.c_str(), 1);
}
