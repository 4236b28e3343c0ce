// The connection: first-run schema and rows, what counts as an existing file, the two statement helpers,
// and another process's write lock, waited out for up to 100 retries of 100 ms.
#include "store_test_fixture.h"

#include <csignal>
#include <fstream>
#include <sys/stat.h>

#include <Ecore.h>
#include <Ecore_File.h>

using namespace store_test;

namespace
{
// Starts the lock holder in the background; returns its pid once it holds the lock, or -1.
pid_t holdLock(const char *seconds)
{
	std::string ready = memo_test::makeTempDir("lock") + "/ready", pid;
	memo_test::runCommand(memo_test::helperPath("test_dblock") + " '" + dbPath() + "' " + seconds + " '" + ready +
	                          "' >/dev/null 2>&1 & echo $!",
	                      &pid);
	if (memo_test::pump(10.0, [&] { return ecore_file_exists(ready.c_str()) == EINA_TRUE; }))
		return atoi(pid.c_str());
	kill(atoi(pid.c_str()), SIGKILL);
	return -1;
}
} // namespace

using DbSchema = StoreTest;

TEST_F(DbSchema, FirstRunCreatesExactSchemaAndRows)
{
	ASSERT_NE(nullptr, db());
	// The sync service reads the same file: the schema text stays as it is, tabs and typos included. Any change
	// shows as a new checksum of the six statements.
	std::string schema = query("SELECT group_concat(sql, ';') || ';' || count(*) FROM (SELECT sql FROM sqlite_master "
	                           "WHERE sql IS NOT NULL AND name NOT LIKE 'sqlite_%' ORDER BY rowid)");
	unsigned long long fnv1a = 14695981039346656037ULL;
	for (unsigned char c : schema)
		fnv1a = (fnv1a ^ c) * 1099511628211ULL;
	EXPECT_EQ(6080062169928107833ULL, fnv1a) << schema;

	EXPECT_EQ("TempDataForQ7", query("SELECT group_concat(locale) FROM android_metadata"));
	EXPECT_EQ("1:", query("SELECT count(*) || ':' || max(hiddenPass) FROM password"));

	// The quick memo row is the first memo, clean, with its colour, times in whole seconds and media folder.
	EXPECT_EQ(1, queryInt("SELECT count(*) FROM memo"));
	EXPECT_EQ("1|0|252;191;169;255;", quickColumn("_id || '|' || isDirty || '|' || bgColor"));
	EXPECT_NE("", quickColumn("title"));
	EXPECT_EQ("0|1", quickColumn("(createdAt % 1000) || '|' || (createdAt = lastModifiedAt)"));
	EXPECT_TRUE(ecore_file_is_dir((dataPath() + "media/" + quickColumn("UUID")).c_str()));
}

TEST_F(DbSchema, InstanceIsBuiltOnceAndARemovedFileRunsFirstRunAgain)
{
	MemoDbMgr *first = db();
	ASSERT_NE(nullptr, first);
	EXPECT_EQ(first, db());
	std::string quick = quickColumn("UUID");
	ASSERT_EQ(36u, quick.size());
	MemoDbMgr::destroy();
	MemoDbMgr::destroy(); // twice is harmless
	ASSERT_EQ(0, unlink(dbPath().c_str()));
	ASSERT_NE(nullptr, db());
	std::string again = quickColumn("UUID");
	EXPECT_EQ(36u, again.size());
	EXPECT_NE(quick, again);
	EXPECT_EQ(1, queryInt("SELECT count(*) FROM memo"));
}

TEST_F(DbSchema, ExistingFileIsNeverCompleted)
{
	// A zero-length file counts as a database: nothing is created, every query fails to prepare.
	std::ofstream(dbPath()).close();
	ASSERT_NE(nullptr, db());
	EXPECT_EQ(-1, db()->getMemoCount());
	MemoItemList *list = db()->getVisibleMemoListN();
	ASSERT_NE(nullptr, list);
	EXPECT_EQ(0, list->getCount());
	delete list;
	EXPECT_FALSE(db()->addQuickMemo("x"));
	EXPECT_EQ(-1, db()->excuteSql("UPDATE memo SET isFavorite = 1"));
	MemoDbMgr::destroy();
	EXPECT_EQ(0, queryInt("SELECT count(*) FROM sqlite_master"));

	// A folder where the file should be: opening fails, later queries fail and say so.
	unlink(dbPath().c_str());
	ASSERT_EQ(0, mkdir(dbPath().c_str(), 0700));
	ASSERT_NE(nullptr, db());
	EXPECT_EQ(-1, db()->getMemoCount());
	delete db()->getOneMemoN("any");
	MemoDbMgr::destroy();
	rmdir(dbPath().c_str());
}

TEST_F(DbSchema, ExcuteSqlFormatsQuotesAndReportsCodes)
{
	ASSERT_NE(nullptr, db());
	EXPECT_EQ(SQLITE_OK, db()->excuteSql("INSERT INTO android_metadata(locale) VALUES('%q')", "it's 100%"));
	EXPECT_EQ(1, queryInt("SELECT count(*) FROM android_metadata WHERE locale = 'it''s 100%'"));
	char plain[] = "INSERT INTO android_metadata(locale) VALUES('50%')";
	EXPECT_EQ(SQLITE_OK, db()->excuteSql(plain));
	EXPECT_EQ(1, queryInt("SELECT count(*) FROM android_metadata WHERE locale = '50%'"));
	// Prepares but fails to run: the code of the run comes back.
	EXPECT_EQ(SQLITE_CONSTRAINT, db()->excuteSql("INSERT INTO memo(UUID) VALUES('x')"));
	char broken[] = "SELEKT 1";
	EXPECT_EQ(-1, db()->excuteSql(broken));
}

TEST_F(DbSchema, ShortLockIsWaitedOutALongOneGivesBusyAfterTheRetries)
{
	ASSERT_NE(nullptr, db());
	pid_t holder = holdLock("0.5");
	ASSERT_GT(holder, 0);
	EXPECT_TRUE(db()->setFavorite(quickColumn("UUID").c_str(), 1));
	EXPECT_EQ("1", quickColumn("isFavorite"));

	holder = holdLock("60");
	ASSERT_GT(holder, 0);
	double start = ecore_time_get();
	char sql[] = "UPDATE memo SET isFavorite = 0";
	int ret = db()->excuteSql(sql);
	double waited = ecore_time_get() - start;
	kill(holder, SIGTERM);
	EXPECT_EQ(SQLITE_BUSY, ret);
	EXPECT_GE(waited, 9.0); // the whole retry budget, not a quick give-up
	EXPECT_EQ("1", quickColumn("isFavorite"));
}
