// The memo binary as a user starts it: on an empty data folder, then again on the folder it left. Each run
// shows its first screen (saved as PNG), ends by itself, and leaves memo.db with its schema.
#include <gtest/gtest.h>

#include <sqlite3.h>

#include <string>
#include <sys/stat.h>
#include <utility>
#include <vector>

#include "TestEnv.h"

namespace
{

class AppStartTest : public ::testing::Test
{
protected:
	void SetUp() override { root = memo_test::makeTempDir("memo-app"); }

	// Runs the app headless until its first screen is saved; returns the exit status.
	int runApp(const std::string &png)
	{
		std::string cmd = "TIZEN_APP_ROOT='" + root + "' TIZEN_SCREENSHOT='" + png +
		                  "' TIZEN_SCREENSHOT_EXIT=1 timeout 60 '" MEMO_BIN "' >/dev/null 2>&1";
		return memo_test::runCommand(cmd);
	}

	std::string dbPath() const { return root + "/data/memo.db"; }
	std::string log() const { return memo_test::readFile(root + "/data/dlog.log"); }

	// (type, name, sql) of every object in memo.db, in creation order.
	std::vector<std::vector<std::string>> schema() const
	{
		std::vector<std::vector<std::string>> rows;
		sqlite3 *db = nullptr;
		if (sqlite3_open_v2(dbPath().c_str(), &db, SQLITE_OPEN_READONLY, nullptr) == SQLITE_OK) {
			sqlite3_stmt *stmt = nullptr;
			sqlite3_prepare_v2(
			    db, "SELECT type, name, sql FROM sqlite_master WHERE name NOT LIKE 'sqlite_%' ORDER BY rowid", -1,
			    &stmt, nullptr);
			while (stmt && sqlite3_step(stmt) == SQLITE_ROW) {
				std::vector<std::string> row;
				for (int i = 0; i < 3; i++) {
					const unsigned char *text = sqlite3_column_text(stmt, i);
					row.push_back(text ? reinterpret_cast<const char *>(text) : "");
				}
				rows.push_back(row);
			}
			sqlite3_finalize(stmt);
		}
		sqlite3_close(db);
		return rows;
	}

	int memoRows() const
	{
		sqlite3 *db = nullptr;
		int count = -1;
		if (sqlite3_open_v2(dbPath().c_str(), &db, SQLITE_OPEN_READONLY, nullptr) == SQLITE_OK) {
			sqlite3_stmt *stmt = nullptr;
			sqlite3_prepare_v2(db, "SELECT count(*) FROM memo", -1, &stmt, nullptr);
			if (stmt && sqlite3_step(stmt) == SQLITE_ROW)
				count = sqlite3_column_int(stmt, 0);
			sqlite3_finalize(stmt);
		}
		sqlite3_close(db);
		return count;
	}

	static size_t find(const std::string &text, const std::string &what, size_t from = 0)
	{
		return text.find(what, from);
	}

	static bool isPng(const std::string &path)
	{
		std::string data = memo_test::readFile(path);
		return data.size() > 8 && data.compare(1, 3, "PNG") == 0;
	}

	std::string root;
};

TEST_F(AppStartTest, firstStartOnAnEmptyFolderThenAgainOnTheSameFolder)
{
	ASSERT_EQ(runApp(root + "/first.png"), 0);
	EXPECT_TRUE(isPng(root + "/first.png"));

	std::vector<std::vector<std::string>> objects = schema();
	std::vector<std::pair<std::string, std::string>> names;
	for (const std::vector<std::string> &row : objects)
		names.emplace_back(row[0], row[1]);
	EXPECT_EQ(names, (std::vector<std::pair<std::string, std::string>>{{"table", "memo"},
	                                                                   {"table", "category"},
	                                                                   {"table", "file"},
	                                                                   {"table", "android_metadata"},
	                                                                   {"table", "password"},
	                                                                   {"trigger", "delete_file"}}));
	// The columns as the sync service knows them, spelling included.
	ASSERT_FALSE(objects.empty());
	EXPECT_NE(find(objects[0][2], "isFavorite INTERGER NOT NULL DEFAULT 0"), std::string::npos);
	int firstRows = memoRows();
	EXPECT_GE(firstRows, 0);

	// The lifecycle in order, and the first-run defaults written once.
	std::string firstLog = log();
	size_t create = find(firstLog, "> onCreate");
	size_t firstRun = find(firstLog, "First run: writing the preference defaults");
	size_t control = find(firstLog, "> onAppControl");
	size_t terminate = find(firstLog, "> onTerminate");
	size_t destructor = find(firstLog, "> ~MemoApp");
	ASSERT_NE(destructor, std::string::npos);
	EXPECT_LT(create, firstRun);
	EXPECT_LT(firstRun, control);
	EXPECT_LT(control, terminate);
	EXPECT_LT(terminate, destructor);

	// The second start finds everything in place and changes nothing of it.
	ASSERT_EQ(runApp(root + "/second.png"), 0);
	EXPECT_TRUE(isPng(root + "/second.png"));
	EXPECT_EQ(schema(), objects);
	EXPECT_EQ(memoRows(), firstRows);
	std::string secondLog = log().substr(firstLog.size());
	EXPECT_NE(find(secondLog, "> ~MemoApp"), std::string::npos);
	EXPECT_EQ(find(secondLog, "First run"), std::string::npos);
}

} // namespace
