#ifndef TESTS_CORE_STORE_TEST_FIXTURE_H
#define TESTS_CORE_STORE_TEST_FIXTURE_H

// A fresh memo.db in the test's private data folder for every test, and a second, plain
// SQLite connection to look at what the store really wrote.
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

#include <Elementary.h>
#include <app_common.h>
#include <sqlite3.h>
#include <vconf.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"
#include "TestEnv.h"

namespace store_test
{
inline std::string dataPath()
{
	char *path = app_get_data_path();
	std::string result = path ? path : "";
	free(path);
	return result;
}

inline std::string sharedDataPath()
{
	char *path = app_get_shared_data_path();
	std::string result = path ? path : "";
	free(path);
	return result;
}

inline std::string dbPath()
{
	return dataPath() + "memo.db";
}
inline std::string logPath()
{
	return dataPath() + "dlog.log";
}

// First column of the first row as text: "<null>" for SQL NULL, "<none>" without a row.
inline std::string query(const std::string &sql)
{
	sqlite3 *db = nullptr;
	std::string result = "<none>";
	if (sqlite3_open_v2(dbPath().c_str(), &db, SQLITE_OPEN_READONLY, nullptr) == SQLITE_OK) {
		sqlite3_stmt *stmt = nullptr;
		if (sqlite3_prepare_v2(db, sql.c_str(), -1, &stmt, nullptr) == SQLITE_OK && sqlite3_step(stmt) == SQLITE_ROW) {
			const unsigned char *text = sqlite3_column_text(stmt, 0);
			result = text ? reinterpret_cast<const char *>(text) : "<null>";
		}
		sqlite3_finalize(stmt);
	}
	sqlite3_close(db);
	return result;
}

inline long long queryInt(const std::string &sql)
{
	return atoll(query(sql).c_str());
}

inline void clearLog()
{
	memo_test::runCommand("rm -f '" + logPath() + "'");
}
inline bool logContains(const std::string &text)
{
	return memo_test::readFile(logPath()).find(text) != std::string::npos;
}

// A memo as the edit view would save it.
inline MemoDocInfo *makeMemo(const char *title, const char *body, unsigned long long modifiedAt = 1000)
{
	MemoDocInfo *info = new MemoDocInfo();
	info->setTitle(title);
	info->setStrippedContent(body);
	info->setDisplayContent(body);
	info->setContent(body);
	info->setCreatedAt(modifiedAt);
	info->setLastModifiedAt(modifiedAt);
	return info;
}

// Every test starts from no database, no media and the device keys unset.
class StoreTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		// Once per process: Elementary does not come back cleanly from a shutdown.
		static bool initialised = elm_init(0, nullptr) > 0;
		(void)initialised;
	}
	static void TearDownTestSuite() { MemoDbMgr::destroy(); }

	void SetUp() override
	{
		MemoDbMgr::destroy();
		memo_test::runCommand("rm -rf '" + dbPath() + "' '" + dataPath() + "media' '" + sharedDataPath() + "media'");
		for (const char *key : {"db/desktop/account/list", "db/desktop/account/unavailable",
		                        "db/desktop/csc/feature_92", "db/memo/data-change"})
			vconf_unset(key);
		clearLog();
	}

	MemoDbMgr *db() { return MemoDbMgr::getInstance(); }
};
} // namespace store_test

#endif
