// A writer waits out another process's write lock for up to 100 retries of 100 ms.
#include "store_test_fixture.h"

#include <csignal>
#include <spawn.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <Ecore_File.h>

extern char **environ;

using namespace store_test;

namespace
{
double now()
{
	struct timespec ts;
	clock_gettime(CLOCK_MONOTONIC, &ts);
	return ts.tv_sec + ts.tv_nsec / 1e9;
}

// Starts the lock holder and returns once it holds the lock (or -1).
pid_t holdLock(int seconds)
{
	std::string ready = memo_test::makeTempDir("lock") + "/ready";
	std::string helper = memo_test::helperPath("test_dblock");
	std::string secs = std::to_string(seconds);
	std::string path = dbPath();
	char *argv[] = {const_cast<char *>(helper.c_str()), const_cast<char *>(path.c_str()),
	                const_cast<char *>(secs.c_str()), const_cast<char *>(ready.c_str()), nullptr};
	pid_t pid = -1;
	if (posix_spawn(&pid, helper.c_str(), nullptr, nullptr, argv, environ) != 0)
		return -1;
	if (!memo_test::pump(10.0, [&] { return ecore_file_exists(ready.c_str()) == EINA_TRUE; })) {
		kill(pid, SIGKILL);
		waitpid(pid, nullptr, 0);
		return -1;
	}
	return pid;
}

void reap(pid_t pid)
{
	kill(pid, SIGTERM);
	waitpid(pid, nullptr, 0);
}
} // namespace

using DbLock = StoreTest;

TEST_F(DbLock, ShortLockIsWaitedOut)
{
	ASSERT_NE(nullptr, db());
	std::string uuid = query("SELECT UUID FROM memo WHERE isQuick = 1");
	pid_t holder = holdLock(2);
	ASSERT_GT(holder, 0);
	EXPECT_TRUE(db()->setFavorite(uuid.c_str(), 1));
	EXPECT_EQ(1, queryInt("SELECT isFavorite FROM memo WHERE isQuick = 1"));
	reap(holder);
}

TEST_F(DbLock, LongLockGivesBusyAfterTheRetries)
{
	ASSERT_NE(nullptr, db());
	pid_t holder = holdLock(15);
	ASSERT_GT(holder, 0);
	double start = now();
	char sql[] = "UPDATE memo SET isFavorite = 1";
	int ret = db()->excuteSql(sql);
	double waited = now() - start;
	reap(holder);
	EXPECT_EQ(SQLITE_BUSY, ret);
	EXPECT_GE(waited, 9.0);
}
