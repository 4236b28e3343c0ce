// A writer waits out another process's write lock for up to 100 retries of 100 ms, then gives up.
#include "store_test_fixture.h"

#include <csignal>

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

using DbLock = StoreTest;

TEST_F(DbLock, ShortLockIsWaitedOutALongOneGivesBusyAfterTheRetries)
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
