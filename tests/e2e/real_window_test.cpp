// The memo binary in a real X11 window on a private display (scripts/xshot): the window manager shows the
// app's name as the window's title, and the screen is saved as PNG. Skipped where Xvfb is not installed.
#include <gtest/gtest.h>

#include <string>

#include "TestEnv.h"

TEST(RealWindowTest, WindowTitledWithTheAppsNameIsSavedAsPng)
{
	if (memo_test::runCommand("command -v Xvfb >/dev/null") != 0)
		GTEST_SKIP() << "Xvfb is not installed";
	std::string dir = memo_test::makeTempDir("xshot");
	// Everything that xshot starts gets the log file, never this process's pipe.
	std::string cmd = "'" TEST_SOURCE_DIR "/scripts/xshot' --out '" + dir +
	                  "/memo.png' --name '^Memo$' --timeout 60 -- '" + MEMO_BIN "' >'" + dir + "/xshot.log' 2>&1";
	EXPECT_EQ(0, memo_test::runCommand(cmd)) << memo_test::readFile(dir + "/xshot.log");
	EXPECT_EQ("\x89PNG", memo_test::readFile(dir + "/memo.png").substr(0, 4));
}
