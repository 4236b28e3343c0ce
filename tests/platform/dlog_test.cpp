// Log lines gathered on the main loop reach the log file when the loop goes idle and however the process
// ends: by leaving main, by a crash, by a fatal line and an abort.
#include <sys/wait.h>

#include <gtest/gtest.h>

#include <app_common.h>

#include "TestEnv.h"

namespace
{

std::string logFile()
{
	char *dir = app_get_data_path();
	std::string path = std::string(dir ? dir : "") + "dlog.log";
	free(dir);
	return path;
}

TEST(Dlog, gatheredLinesReachTheFileOnIdleAndAtEveryEnd)
{
	const std::string helper = memo_test::helperPath("test_log_end");
	EXPECT_EQ(0, memo_test::runCommand(helper + " idle 2>/dev/null"));

	struct End {
		const char *mode;
		int signal; // 0: a normal exit
	};
	for (const End &end : {End{"exit", 0}, End{"crash", SIGSEGV}, End{"fatal", SIGABRT}}) {
		unlink(logFile().c_str());
		// Run directly rather than through the shell, which would report a signal as a status.
		const pid_t child = fork();
		if (child == 0) {
			freopen("/dev/null", "w", stderr);
			// Under the sanitizer the crash must reach the log's own handler, not the sanitizer's.
			setenv("ASAN_OPTIONS", "handle_segv=0:handle_abort=0:detect_leaks=0", 1);
			execl(helper.c_str(), helper.c_str(), end.mode, static_cast<char *>(nullptr));
			_exit(127);
		}
		int status = 0;
		ASSERT_EQ(child, waitpid(child, &status, 0));
		if (end.signal)
			EXPECT_TRUE(WIFSIGNALED(status) && WTERMSIG(status) == end.signal) << end.mode;
		else
			EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << end.mode;
		const std::string log = memo_test::readFile(logFile());
		EXPECT_NE(std::string::npos, log.find("E/TEST(")) << end.mode;
		EXPECT_LT(log.find("gathered error"), log.find("gathered info")) << end.mode;
		EXPECT_NE(std::string::npos, log.find("gathered info")) << end.mode;
	}
	EXPECT_NE(std::string::npos, memo_test::readFile(logFile()).find("F/TEST("));
}

} // namespace
