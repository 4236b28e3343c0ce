// Test entry: a private temporary root for every store, a headless canvas, then GoogleTest.
#include "TestEnv.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

static void setDir(const char *var, const std::string &path)
{
	mkdir(path.c_str(), 0700);
	setenv(var, path.c_str(), 1);
}

int main(int argc, char **argv)
{
	const std::string &r = memo_test::tempRoot();
	if (r.empty()) {
		perror("mkdtemp");
		return 2;
	}
	setDir("HOME", r + "/home");
	setDir("XDG_DATA_HOME", r + "/xdg-data");
	setDir("XDG_CONFIG_HOME", r + "/xdg-config");
	setDir("XDG_RUNTIME_DIR", r + "/xdg-runtime");
	setDir("TIZEN_APP_ROOT", r + "/app");
	setDir("TIZEN_VCONF_DIR", r + "/vconf");
	// The app id and resources of the memo app; spawned helpers get their own id from the registry.
	setenv("TIZEN_APP_ID", "com.veltron.memo", 1);
	setenv("TIZEN_APP_RES_DIR", MEMO_APP_ROOT "/res/", 1);
	setenv("ELM_ENGINE", "buffer", 1);
	setenv("ELM_DISPLAY", "buffer", 1);
	setenv("ECORE_EVAS_ENGINE", "buffer", 1);
	setenv("ECORE_NO_SYSTEM_MODULES", "1", 1);
	setenv("EINA_LOG_BACKTRACE", "0", 1);
	unsetenv("DISPLAY");
	unsetenv("WAYLAND_DISPLAY");

	testing::InitGoogleTest(&argc, argv);
	int rc = RUN_ALL_TESTS();
	if (!getenv("MEMO_TEST_KEEP"))
		memo_test::runCommand("rm -rf '" + r + "'");
	return rc;
}
