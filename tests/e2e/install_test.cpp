// cmake --install into a temporary prefix: the installed tree starts from its own launch registry entry and
// resources, keeps its data under the user's data folder, and "Open with Memo" of a text file, run as the
// desktop entry runs it, makes a memo of the file.
#include <gtest/gtest.h>

#include <string>

#include "support/E2e.h"

TEST(InstallTest, InstalledTreeStartsAndOpensAFileFromTheDesktop)
{
	const std::string prefix = memo_test::makeTempDir("prefix"), home = memo_test::makeTempDir("user-data");
	ASSERT_EQ(0, memo_test::runCommand("cmake --install '" TEST_BIN_DIR "/..' --prefix '" + prefix + "' >/dev/null"));
	const std::string root = prefix + "/lib/com.veltron.memo";
	memo_test::MemoLaunch app("env -u TIZEN_APP_ROOT -u TIZEN_APP_ID -u TIZEN_APP_RES_DIR XDG_DATA_HOME='" + home + "'",
	                          home + "/com.veltron.memo", prefix + "/bin/app_launcher");
	EXPECT_EQ("MemoListView", app.start(""));
	EXPECT_NE(std::string::npos, app.log().find("messages of com.veltron.memo from " + root + "/res/locale"));
	for (const char *missing : {"not found", "cannot load"})
		EXPECT_EQ(std::string::npos, app.log().find(missing)) << missing;
	ASSERT_TRUE(app.end());

	const std::string open = root + "/bin/memo-open", notes = home + "/shopping list";
	EXPECT_NE(std::string::npos, memo_test::readFile(prefix + "/share/applications/com.veltron.memo.desktop")
	                                 .find("\nExec=\"" + open + "\" %f\n"));
	memo_test::runCommand("printf 'bread\\nbutter' > '" + notes + "'");
	EXPECT_EQ("MemoEditView", app.start("'" + open + "' '" + notes + "'"));
	ASSERT_TRUE(app.end());
	EXPECT_EQ("bread\nbutter", app.query("SELECT content FROM memo WHERE isQuick = 0"));
}
