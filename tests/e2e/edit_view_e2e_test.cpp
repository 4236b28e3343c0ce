// The memo binary in a real X11 window: a new memo from the widget's request, typed with real key presses,
// then the app asked to end through the launcher; the memo is in memo.db afterwards.
#include <gtest/gtest.h>

#include <sqlite3.h>
#include <sys/stat.h>
#include <unistd.h>

#include <csignal>
#include <string>

#include "TestEnv.h"

namespace
{

bool running(int pid)
{
	return pid > 0 && kill(pid, 0) == 0;
}

class EditorEndToEnd : public ::testing::Test
{
protected:
	void SetUp() override
	{
		if (memo_test::runCommand("command -v Xvfb && command -v openbox && command -v xdotool") != 0)
			GTEST_SKIP() << "Xvfb, openbox and xdotool are needed";
		root = memo_test::makeTempDir("memo-e2e");
		for (display = 60 + getpid() % 30;; display++) {
			struct stat st;
			if (stat(("/tmp/.X11-unix/X" + std::to_string(display)).c_str(), &st) != 0)
				break;
		}
		xvfb = start("Xvfb :" + std::to_string(display) + " -screen 0 1024x900x24 -nolisten tcp");
		ASSERT_TRUE(memo_test::pump(
		    10.0, [this] { return memo_test::runCommand(x11("xdotool getmouselocation") + " >/dev/null 2>&1") == 0; }));
		openbox = start(x11("openbox"));
	}

	void TearDown() override
	{
		// Each by its own process id, the app first.
		for (int pid : {memo, openbox, xvfb})
			if (running(pid))
				kill(pid, SIGTERM);
	}

	std::string x11(const std::string &cmd) const { return "DISPLAY=:" + std::to_string(display) + " " + cmd; }

	static int start(const std::string &cmd)
	{
		std::string pid;
		memo_test::runCommand(cmd + " >/dev/null 2>&1 & echo $!", &pid);
		return atoi(pid.c_str());
	}

	std::string query(const char *sql) const
	{
		std::string result;
		sqlite3 *db = nullptr;
		sqlite3_stmt *stmt = nullptr;
		if (sqlite3_open_v2((root + "/data/memo.db").c_str(), &db, SQLITE_OPEN_READONLY, nullptr) == SQLITE_OK &&
		    sqlite3_prepare_v2(db, sql, -1, &stmt, nullptr) == SQLITE_OK && sqlite3_step(stmt) == SQLITE_ROW &&
		    sqlite3_column_text(stmt, 0))
			result = reinterpret_cast<const char *>(sqlite3_column_text(stmt, 0));
		sqlite3_finalize(stmt);
		sqlite3_close(db);
		return result;
	}

	std::string root;
	int display = 0;
	int xvfb = -1;
	int openbox = -1;
	int memo = -1;
};

TEST_F(EditorEndToEnd, TypedMemoIsSavedWhenTheLauncherEndsTheApp)
{
	memo = start(x11("TIZEN_APP_ROOT='" + root +
	                 "' ELM_DISPLAY=x11 ELM_ENGINE=software_x11 ECORE_EVAS_ENGINE=software_x11 '" MEMO_BIN
	                 "' --operation widget_new"));
	std::string window;
	ASSERT_EQ(0, memo_test::runCommand(
	                 x11("timeout 20 xdotool search --sync --onlyvisible --pid " + std::to_string(memo) + " | head -1"),
	                 &window));
	window = window.substr(0, window.find('\n'));
	memo_test::pumpFor(1.0);

	// The title field, then the body under it.
	const std::string w = "--window " + window;
	ASSERT_EQ(0, memo_test::runCommand(x11("xdotool mousemove " + w +
	                                       " 150 135 click 1 sleep 0.3 type --delay 30 "
	                                       "'Camping trip'")));
	ASSERT_EQ(0, memo_test::runCommand(x11("xdotool mousemove " + w +
	                                       " 150 228 click 1 sleep 0.3 type --delay 30 "
	                                       "'pack the tent'")));
	memo_test::pumpFor(0.5);

	ASSERT_EQ(0, memo_test::runCommand("'" TEST_BIN_DIR "/app_launcher' -k com.veltron.memo >/dev/null 2>&1"));
	EXPECT_TRUE(memo_test::pump(10.0, [this] { return !running(memo); }));
	EXPECT_EQ("Camping trip", query("SELECT title FROM memo WHERE isQuick = 0"));
	EXPECT_EQ("pack the tent", query("SELECT content FROM memo WHERE isQuick = 0"));
}

} // namespace
