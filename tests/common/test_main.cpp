// Test entry: a private temporary root for every store, a headless canvas, then GoogleTest.
#include "TestEnv.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <dirent.h>
#include <string>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

static void setDir(const char *var, const std::string &path)
{
	mkdir(path.c_str(), 0700);
	setenv(var, path.c_str(), 1);
}

// Elementary starts an efreetd for the process (in its private runtime folder). The daemon and the cache
// builders it starts keep our output open and write into the temporary root after we end: end them with us.
static void endChildren(pid_t parent, const char *onlyName)
{
	DIR *proc = opendir("/proc");
	for (dirent *e; proc && (e = readdir(proc));) {
		std::string dir = std::string("/proc/") + e->d_name;
		std::string stat = memo_test::readFile(dir + "/stat");
		int ppid = 0;
		size_t end = stat.rfind(')');
		if (end == std::string::npos || sscanf(stat.c_str() + end + 1, " %*c %d", &ppid) != 1 || ppid != parent ||
		    (onlyName && memo_test::readFile(dir + "/comm") != std::string(onlyName) + "\n"))
			continue;
		pid_t pid = atoi(e->d_name);
		endChildren(pid, nullptr);
		kill(pid, SIGKILL);
		waitpid(pid, nullptr, 0);
	}
	if (proc)
		closedir(proc);
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
	// Frames render on the main loop: a window resized while the render thread draws it can crash the
	// buffer engine, and tests gain nothing from the thread.
	setenv("ECORE_EVAS_FORCE_SYNC_RENDER", "1", 1);
	unsetenv("DISPLAY");
	unsetenv("WAYLAND_DISPLAY");
	// The media controls publish on a session bus only when a test starts its own.
	unsetenv("DBUS_SESSION_BUS_ADDRESS");

	testing::InitGoogleTest(&argc, argv);
	int rc = RUN_ALL_TESTS();
	endChildren(getpid(), "efreetd");
	if (!getenv("MEMO_TEST_KEEP"))
		memo_test::runCommand("rm -rf '" + r + "'");
	return rc;
}
