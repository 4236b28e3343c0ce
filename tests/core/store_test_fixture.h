#ifndef TESTS_CORE_STORE_TEST_FIXTURE_H
#define TESTS_CORE_STORE_TEST_FIXTURE_H

// A fresh memo.db in the test's private data folder for every test, and a second, plain
// SQLite connection to look at what the store really wrote.
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

#include <Elementary.h>
#include <app_common.h>
#include <sqlite3.h>
#include <vconf.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"
#include "TestEnv.h"
#include "Util/MemoUtil.h"

namespace store_test
{
inline std::string dataPath()
{
	return MemoUtil::getDataPath();
}

inline std::string sharedDataPath()
{
	char *path = app_get_shared_data_path();
	std::string result = path;
	free(path);
	return result;
}

inline std::string dbPath()
{
	return dataPath() + "memo.db";
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

inline std::string memoColumn(const std::string &uuid, const char *column)
{
	return query(std::string("SELECT ") + column + " FROM memo WHERE UUID = '" + uuid + "'");
}

inline std::string quickColumn(const char *column)
{
	return query(std::string("SELECT ") + column + " FROM memo WHERE isQuick = 1");
}

inline int changeNotice()
{
	int value = -1;
	vconf_get_int("db/memo/data-change", &value);
	return value;
}

// Runs one of the store's (key, &array, &count) reads and takes the array over.
inline std::vector<std::string> listOf(bool (MemoDbMgr::*read)(const char *, char ***, int *), const char *key)
{
	char **items = nullptr;
	int count = 0;
	EXPECT_TRUE((MemoDbMgr::getInstance()->*read)(key, &items, &count)) << key;
	std::vector<std::string> out;
	for (int i = 0; i < count; ++i) {
		out.push_back(items[i]);
		free(items[i]);
	}
	free(items);
	return out;
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

// Adds a memo through the store; returns its UUID.
inline std::string addMemo(const char *title, const char *body, unsigned long long at, int favourite = 0,
                           int hidden = 0)
{
	MemoDocInfo *info = makeMemo(title, body, at);
	info->setIsFavorite(favourite);
	info->setIsHidden(hidden);
	std::string uuid = info->getMemoUUID();
	EXPECT_TRUE(MemoDbMgr::getInstance()->addMemo(info));
	delete info;
	return uuid;
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
	}

	MemoDbMgr *db() { return MemoDbMgr::getInstance(); }
};
} // namespace store_test

#endif
