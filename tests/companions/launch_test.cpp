// The companion programs as launch requests meet them: real processes started from the build's launch
// registry, driven by their test hooks (a button pressed by label, a file selector's starting selection,
// the camera's test pattern, the e-mail command).
#include <gtest/gtest.h>

#include <Ecore.h>
#include <Ecore_File.h>
#include <app_control.h>
#include <app_manager.h>
#include <image_util.h>
#include <vconf.h>

#include <cstdlib>
#include <fstream>
#include <map>
#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
const char *const SELECTED = "http://tizen.org/appcontrol/data/selected";
const char *const PATH = "http://tizen.org/appcontrol/data/path";
const char *const TEXT = "http://tizen.org/appcontrol/data/text";
const char *const CAMERA = "com.veltron.camera-app-lite";

struct Reply {
	bool arrived = false;
	app_control_result_e result = APP_CONTROL_RESULT_APP_STARTED;
	std::map<std::string, std::vector<std::string>> extras;
};

bool copyExtraCb(app_control_h reply, const char *key, void *data)
{
	std::vector<std::string> &values = static_cast<Reply *>(data)->extras[key];
	char **array = nullptr;
	int n = 0;
	char *value = nullptr;
	bool isArray = false;
	app_control_is_extra_data_array(reply, key, &isArray);
	if (isArray && app_control_get_extra_data_array(reply, key, &array, &n) == APP_CONTROL_ERROR_NONE) {
		for (int i = 0; i < n; i++) {
			values.push_back(array[i]);
			free(array[i]);
		}
		free(array);
	} else if (app_control_get_extra_data(reply, key, &value) == APP_CONTROL_ERROR_NONE) {
		values.push_back(value);
		free(value);
	}
	return true;
}

void replyCb(app_control_h, app_control_h reply, app_control_result_e result, void *data)
{
	Reply *r = static_cast<Reply *>(data);
	r->arrived = true;
	r->result = result;
	app_control_foreach_extra_data(reply, copyExtraCb, r);
}

// What a launch request carries besides its operation.
struct Request {
	std::string appId, mime, uri;
	std::map<std::string, std::string> extras;
	std::map<std::string, std::vector<std::string>> arrays;
};

class Companions : public ::testing::Test
{
protected:
	static void SetUpTestSuite() { ecore_init(); }
	static void TearDownTestSuite() { ecore_shutdown(); }

	void TearDown() override
	{
		for (const std::string &id : used)
			end(id);
		for (const char *var : {"COMPANION_TEST_CLICK", "COMPANION_TEST_SELECT", "COMPANION_CAMERA_TEST_SOURCE",
		                        "COMPANION_CAMERA_DEVICE", "COMPANION_EMAIL_COMMAND"})
			unsetenv(var);
	}

	static bool running(const std::string &id)
	{
		bool is = false;
		app_manager_is_running(id.c_str(), &is);
		return is;
	}

	// Sends the request with a reply callback; the reply is filled in when it comes.
	void send(const std::string &operation, const Request &req, Reply *reply)
	{
		app_control_h h = nullptr;
		app_control_create(&h);
		app_control_set_operation(h, operation.c_str());
		if (!req.appId.empty())
			app_control_set_app_id(h, req.appId.c_str());
		if (!req.mime.empty())
			app_control_set_mime(h, req.mime.c_str());
		if (!req.uri.empty())
			app_control_set_uri(h, req.uri.c_str());
		for (const auto &e : req.extras)
			app_control_add_extra_data(h, e.first.c_str(), e.second.c_str());
		for (const auto &a : req.arrays) {
			std::vector<const char *> values;
			for (const std::string &v : a.second)
				values.push_back(v.c_str());
			app_control_add_extra_data_array(h, a.first.c_str(), values.data(), (int)values.size());
		}
		EXPECT_EQ(APP_CONTROL_ERROR_NONE, app_control_send_launch_request(h, replyCb, reply));
		app_control_destroy(h);
		if (!req.appId.empty())
			used.push_back(req.appId);
	}

	Reply launch(const std::string &operation, const Request &req)
	{
		Reply reply;
		send(operation, req, &reply);
		EXPECT_TRUE(memo_test::pump(20.0, [&] { return reply.arrived; })) << operation;
		return reply;
	}

	// Waits until the app has ended by itself.
	bool gone(const std::string &id, double seconds = 10.0)
	{
		return memo_test::pump(seconds, [&] { return !running(id); });
	}

	// Ends the app when it still runs after grace seconds, so that the next start reads the environment anew.
	// An app that ends by itself is left to it: a terminate request crossing its exit is not answered.
	void end(const std::string &id, double grace = 3.0)
	{
		if (gone(id, grace))
			return;
		app_control_h h = nullptr;
		app_control_create(&h);
		app_control_set_app_id(h, id.c_str());
		app_control_send_terminate_request(h);
		app_control_destroy(h);
		EXPECT_TRUE(gone(id)) << id;
	}

	// Requests the app has received so far, by its log (its standard error, which the platform keeps).
	static size_t requestsSeen(const std::string &id)
	{
		const std::string log = std::string(getenv("XDG_RUNTIME_DIR")) + "/tizen-apps/" + id + ".log";
		return memo_test::countOf(memo_test::readFile(log), "launch request from");
	}

	static std::string writePicture(const std::string &path, int width, int height)
	{
		std::vector<unsigned char> rgb(width * height * 3, 0x80);
		EXPECT_EQ(IMAGE_UTIL_ERROR_NONE,
		          image_util_encode_jpeg(rgb.data(), width, height, IMAGE_UTIL_COLORSPACE_RGB888, 90, path.c_str()));
		return path;
	}

	static bool jpegSize(const std::string &path, int *width, int *height)
	{
		unsigned char *buffer = nullptr;
		unsigned int size = 0;
		int ret = image_util_decode_jpeg(path.c_str(), IMAGE_UTIL_COLORSPACE_RGB888, &buffer, width, height, &size);
		free(buffer);
		return ret == IMAGE_UTIL_ERROR_NONE;
	}

	std::vector<std::string> used;
};
} // namespace

TEST_F(Companions, CameraTakesAJpegOfTheAskedSizeAndFailsWithoutACamera)
{
	setenv("COMPANION_CAMERA_TEST_SOURCE", "1", 1);
	used.push_back(CAMERA);
	// As the editor asks: no app id, the registry's taker of create_content for JPEG pictures.
	Reply r = launch("http://tizen.org/appcontrol/operation/create_content",
	                 {"", "image/jpg", "", {{"CALLER", "message"}, {"RESOLUTION", "VGA"}}, {}});
	ASSERT_EQ(APP_CONTROL_RESULT_SUCCEEDED, r.result);
	ASSERT_EQ(1u, r.extras[SELECTED].size());
	int width = 0, height = 0;
	ASSERT_TRUE(jpegSize(r.extras[SELECTED][0], &width, &height)) << r.extras[SELECTED][0];
	EXPECT_EQ(640, width);
	EXPECT_EQ(480, height);
	end(CAMERA);

	r = launch("http://tizen.org/appcontrol/operation/create_content",
	           {CAMERA, "", "", {{"RESOLUTION", "176x144"}}, {}});
	ASSERT_EQ(APP_CONTROL_RESULT_SUCCEEDED, r.result);
	ASSERT_TRUE(jpegSize(r.extras[SELECTED].at(0), &width, &height));
	EXPECT_EQ(176, width);
	EXPECT_EQ(144, height);
	end(CAMERA);

	unsetenv("COMPANION_CAMERA_TEST_SOURCE");
	setenv("COMPANION_CAMERA_DEVICE", "/nonexistent/video0", 1);
	r = launch("http://tizen.org/appcontrol/operation/create_content", {CAMERA, "", "", {}, {}});
	EXPECT_EQ(APP_CONTROL_RESULT_FAILED, r.result);
	EXPECT_TRUE(r.extras[SELECTED].empty());
}

TEST_F(Companions, GalleryRepliesThePickedPathOrCanceled)
{
	const std::string picture = writePicture(memo_test::makeTempDir("pictures") + "/beach.jpg", 32, 24);
	setenv("COMPANION_TEST_SELECT", picture.c_str(), 1);
	setenv("COMPANION_TEST_CLICK", "OK", 1);
	Reply r = launch("http://tizen.org/appcontrol/operation/pick", {"tizen.gallery", "image/*", "", {}, {}});
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, r.result);
	EXPECT_EQ(std::vector<std::string>{picture}, r.extras[SELECTED]);
	end("tizen.gallery");

	// Closed without a pick.
	unsetenv("COMPANION_TEST_CLICK");
	Reply canceled;
	const size_t before = requestsSeen("tizen.gallery");
	send("http://tizen.org/appcontrol/operation/pick", {"tizen.gallery", "image/*", "", {}, {}}, &canceled);
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return requestsSeen("tizen.gallery") > before; }));
	end("tizen.gallery", 0.0);
	ASSERT_TRUE(memo_test::pump(5.0, [&] { return canceled.arrived; }));
	EXPECT_EQ(APP_CONTROL_RESULT_CANCELED, canceled.result);
	EXPECT_TRUE(canceled.extras[SELECTED].empty());
}

TEST_F(Companions, ViewerDeleteRepliesDeleteMenuAndLeavesTheFile)
{
	const std::string picture = writePicture(memo_test::makeTempDir("view") + "/shot.jpg", 64, 48);
	setenv("COMPANION_TEST_CLICK", "Delete", 1);
	Reply r = launch("http://tizen.org/appcontrol/operation/view",
	                 {"com.veltron.image-viewer", "", "file://" + picture, {{"DeleteMenu", "TRUE"}}, {}});
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, r.result);
	EXPECT_EQ(std::vector<std::string>{"TRUE"}, r.extras["DeleteMenu"]);
	EXPECT_TRUE(ecore_file_exists(picture.c_str()));
}

TEST_F(Companions, ShareTargetsSaveMailAndCopyTheSharedTextAndFiles)
{
	const std::string pictures = memo_test::makeTempDir("shared");
	const std::string picture = writePicture(pictures + "/my beach.jpg", 16, 16);
	const Request share{"", "", "", {{TEXT, "Groceries\nmilk"}}, {{PATH, {picture}}}};

	// Save: "<first line>.txt" beside copies of the files, in the folder picked.
	const std::string folder = memo_test::makeTempDir("saved");
	setenv("COMPANION_TEST_SELECT", folder.c_str(), 1);
	setenv("COMPANION_TEST_CLICK", "OK", 1);
	Request save = share;
	save.appId = "com.veltron.share-save";
	Reply r = launch("http://tizen.org/appcontrol/operation/share_text", save);
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, r.result);
	EXPECT_EQ("Groceries\nmilk", memo_test::readFile(folder + "/Groceries.txt"));
	EXPECT_EQ(memo_test::readFile(picture), memo_test::readFile(folder + "/my beach.jpg"));
	unsetenv("COMPANION_TEST_SELECT");
	unsetenv("COMPANION_TEST_CLICK");

	// E-mail: subject from the first line, the text as body, the files attached.
	const std::string args = pictures + "/args";
	const std::string fake = pictures + "/fake-xdg-email";
	std::ofstream(fake) << "#!/bin/sh\nfor a in \"$@\"; do printf '%s\\n' \"$a\"; done > '" << args << "'\n";
	memo_test::runCommand("chmod +x '" + fake + "'");
	setenv("COMPANION_EMAIL_COMMAND", fake.c_str(), 1);
	Request mail = share;
	mail.appId = "com.veltron.share-email";
	r = launch("http://tizen.org/appcontrol/operation/share_text", mail);
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, r.result);
	EXPECT_EQ("--utf8\n--subject\nGroceries\n--body\nGroceries\nmilk\n--attach\n" + picture + "\n",
	          memo_test::readFile(args));

	// Clipboard: on a private X display, read back by another process.
	if (memo_test::runCommand("command -v xvfb-run >/dev/null") != 0)
		GTEST_SKIP() << "xvfb-run is not installed";
	const std::string script = pictures + "/copy.sh";
	std::ofstream(script) << "export ELM_ENGINE=software_x11; unset ELM_DISPLAY ECORE_EVAS_ENGINE\n"
	                      << "'" TEST_BIN_DIR "/app_launcher' -s com.veltron.share-clipboard -r -o "
	                      << "http://tizen.org/appcontrol/operation/share_text -d " << TEXT << " 'Groceries\nmilk' -a "
	                      << PATH << " '" << picture << "' >/dev/null 2>&1 || exit 1\n"
	                      << "'" << memo_test::helperPath("clipboard_read") << "' 2>/dev/null; rc=$?\n"
	                      << "'" TEST_BIN_DIR "/app_launcher' -k com.veltron.share-clipboard >/dev/null 2>&1\n"
	                      << "exit $rc\n";
	std::string clip;
	EXPECT_EQ(0, memo_test::runCommand("xvfb-run -a sh '" + script + "'", &clip)) << clip;
	EXPECT_EQ("Groceries\nmilk\nfile://" + pictures + "/my%20beach.jpg", clip);
}

TEST_F(Companions, AccountConfirmationAnswersByTheDesktopPassword)
{
	const char *const ACCOUNT = "com.veltron.veltronaccount";
	const char *const CONFIRM = "http://tizen.org/appcontrol/operation/confirmpassword";
	used.push_back(ACCOUNT);
	setenv("VELTRON_ACCOUNT_TEST_PASSWORD", "s3cret", 1);
	setenv("COMPANION_TEST_TYPE", "s3cret", 1);
	setenv("COMPANION_TEST_CLICK", "OK", 1);
	// No account signed in: nothing to confirm, whatever the password.
	vconf_unset("db/desktop/account/list");
	Reply r = launch(CONFIRM, {ACCOUNT, "", "", {{"service_category", "account_verify"}}, {}});
	EXPECT_EQ(APP_CONTROL_RESULT_FAILED, r.result);
	EXPECT_EQ(std::vector<std::string>{"No account is signed in"}, r.extras["errorMessage"]);
	ASSERT_TRUE(gone(ACCOUNT));

	vconf_set_str("db/desktop/account/list", "com.veltron.veltronaccount|alice|alice@example.com");
	setenv("COMPANION_TEST_TYPE", "guess", 1);
	r = launch(CONFIRM, {ACCOUNT, "", "", {}, {}});
	EXPECT_EQ(APP_CONTROL_RESULT_FAILED, r.result);
	EXPECT_EQ(std::vector<std::string>{"Authentication failure"}, r.extras["errorMessage"]);
	ASSERT_TRUE(gone(ACCOUNT));
	// The operation alone finds it in the registry.
	setenv("COMPANION_TEST_TYPE", "s3cret", 1);
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, launch(CONFIRM, {}).result);
	ASSERT_TRUE(gone(ACCOUNT));
	setenv("COMPANION_TEST_CLICK", "Cancel", 1);
	EXPECT_EQ(APP_CONTROL_RESULT_CANCELED, launch(CONFIRM, {ACCOUNT, "", "", {}, {}}).result);
	vconf_unset("db/desktop/account/list");
	unsetenv("VELTRON_ACCOUNT_TEST_PASSWORD");
	unsetenv("COMPANION_TEST_TYPE");
}
