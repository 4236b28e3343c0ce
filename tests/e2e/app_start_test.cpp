// The memo binary as a user starts it: on an empty data folder, then again on the folder it left. Each run
// shows its first screen (saved as PNG), ends by itself, and leaves memo.db with its schema.
#include <gtest/gtest.h>

#include <string>

#include "support/E2e.h"

TEST(AppStartTest, firstStartOnAnEmptyFolderThenAgainOnTheSameFolder)
{
	memo_test::MemoLaunch app;
	// Runs the app headless until its first screen is saved as a PNG; true when both happened.
	auto runApp = [&app](const std::string &png) {
		return memo_test::runCommand(app.env + "TIZEN_SCREENSHOT='" + png +
		                             "' TIZEN_SCREENSHOT_EXIT=1 timeout 60 '" MEMO_BIN "' >/dev/null 2>&1") == 0 &&
		       memo_test::readFile(png).substr(0, 4) == "\x89PNG";
	};
	const char *objects = "SELECT group_concat(type || ' ' || name, ',') FROM (SELECT type, name FROM sqlite_master "
	                      "WHERE name NOT LIKE 'sqlite_%' ORDER BY rowid)";
	const char *everything = "SELECT group_concat(sql, ';') || (SELECT count(*) FROM memo) FROM sqlite_master";
	ASSERT_TRUE(runApp(app.root + "/first.png"));
	EXPECT_EQ("table memo,table category,table file,table android_metadata,table password,trigger delete_file",
	          app.query(objects));
	// The columns as the sync service knows them, spelling included.
	EXPECT_NE(
	    std::string::npos,
	    app.query("SELECT sql FROM sqlite_master WHERE name = 'memo'").find("isFavorite INTERGER NOT NULL DEFAULT 0"));
	std::string firstState = app.query(everything);

	// The lifecycle in order, and the first-run defaults written once.
	std::string firstLog = app.log();
	size_t at = 0;
	for (const char *step : {"> onCreate", "First run: writing the preference defaults", "> onAppControl",
	                         "> onTerminate", "> ~MemoApp"}) {
		at = firstLog.find(step, at);
		EXPECT_NE(at, std::string::npos) << step;
	}

	// The second start finds everything in place and changes nothing of it.
	ASSERT_TRUE(runApp(app.root + "/second.png"));
	EXPECT_EQ(firstState, app.query(everything));
	std::string secondLog = app.log().substr(firstLog.size());
	EXPECT_NE(secondLog.find("> ~MemoApp"), std::string::npos);
	EXPECT_EQ(secondLog.find("First run"), std::string::npos);
}
