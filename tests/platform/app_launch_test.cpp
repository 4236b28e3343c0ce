// Launch requests between processes: the launcher tool and the API against a real callee app
// (tests/helpers/test_callee), found through an ini registry in a temporary apps folder.
#include <gtest/gtest.h>

#include <Ecore.h>
#include <app.h>
#include <app_manager.h>

#include <csignal>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <map>
#include <string>
#include <unistd.h>

#include "TestEnv.h"

namespace
{
struct Reply {
	bool arrived = false;
	app_control_result_e result = APP_CONTROL_RESULT_FAILED;
	std::map<std::string, std::string> extras;
};

bool copyExtraCb(app_control_h reply, const char *key, void *data)
{
	char *value = nullptr;
	if (app_control_get_extra_data(reply, key, &value) == APP_CONTROL_ERROR_NONE)
		static_cast<Reply *>(data)->extras[key] = value;
	free(value);
	return true;
}

void replyCb(app_control_h, app_control_h reply, app_control_result_e result, void *data)
{
	Reply *r = static_cast<Reply *>(data);
	r->arrived = true;
	r->result = result;
	app_control_foreach_extra_data(reply, copyExtraCb, r);
}

// Ends the process with a named failure when a test does not return in time: a send that hangs must not
// cost the whole run its time limit and hide where it stuck. A callee the test stopped is killed with it.
struct Watchdog {
	static inline char message[256];
	static inline volatile pid_t stopped = -1;
	explicit Watchdog(unsigned seconds)
	{
		snprintf(message, sizeof(message), "\nwatchdog: %s did not return within %u s\n",
		         ::testing::UnitTest::GetInstance()->current_test_info()->name(), seconds);
		signal(SIGALRM, [](int) {
			if (stopped > 0)
				kill(stopped, SIGKILL);
			_exit(write(STDERR_FILENO, message, strlen(message)) > 0 ? 124 : 125);
		});
		alarm(seconds);
	}
	~Watchdog() { alarm(0); }
};

class AppLaunch : public ::testing::Test
{
protected:
	static inline std::string appsDir, logDir;

	static void SetUpTestSuite()
	{
		ecore_init();
		appsDir = memo_test::makeTempDir("apps");
		logDir = memo_test::makeTempDir("callee-logs");
		setenv("TIZEN_APPS_DIR", appsDir.c_str(), 1);
		setenv("TEST_CALLEE_DIR", logDir.c_str(), 1);
	}
	static void TearDownTestSuite() { ecore_shutdown(); }

	// A fresh app id per test, registered to start the test callee.
	void SetUp() override
	{
		id = std::string("test.callee.") + ::testing::UnitTest::GetInstance()->current_test_info()->name();
		std::ofstream(appsDir + "/" + id + ".ini")
		    << "[app]\nid=" << id << "\nexec=" << memo_test::helperPath("test_callee") << "\n";
	}

	void TearDown() override
	{
		if (terminate() == APP_CONTROL_ERROR_NONE)
			waitRunning(false);
	}

	bool waitRunning(bool expected)
	{
		return memo_test::pump(10.0, [&] {
			bool running = false;
			app_manager_is_running(id.c_str(), &running);
			return running == expected;
		});
	}

	std::string calleeLog() { return memo_test::readFile(logDir + "/" + id + ".log"); }

	bool waitLog(const std::string &text)
	{
		return memo_test::pump(10.0, [&] { return calleeLog().find(text) != std::string::npos; });
	}

	// Starts the callee as a user would, not through the registry.
	void startDirectly(const std::string &args = "")
	{
		memo_test::runCommand("TIZEN_APP_ID=" + id + " '" + memo_test::helperPath("test_callee") + "' " + args +
		                      " >/dev/null 2>&1 &");
		ASSERT_TRUE(waitRunning(true));
	}

	int launcher(const std::string &args, std::string *out)
	{
		return memo_test::runCommand(std::string("'") + TEST_BIN_DIR + "/app_launcher' " + args + " 2>&1", out);
	}

	app_control_h request(const char *operation = nullptr)
	{
		app_control_h h = nullptr;
		app_control_create(&h);
		app_control_set_app_id(h, id.c_str());
		app_control_set_operation(h, operation);
		return h;
	}

	int terminate()
	{
		app_control_h h = request();
		int ret = app_control_send_terminate_request(h);
		app_control_destroy(h);
		return ret;
	}

	pid_t calleePid()
	{
		app_context_h context = nullptr;
		pid_t pid = -1;
		if (app_manager_get_app_context(id.c_str(), &context) == APP_MANAGER_ERROR_NONE)
			app_context_get_pid(context, &pid);
		app_context_destroy(context);
		return pid;
	}

	size_t countInLog(const std::string &text)
	{
		const std::string log = calleeLog();
		size_t n = 0;
		for (size_t at = log.find(text); at != std::string::npos; at = log.find(text, at + 1))
			n++;
		return n;
	}

	Watchdog watchdog{30};
	std::string id;
};
} // namespace

TEST_F(AppLaunch, RunningCalleeTakesRequestsFromTheLauncherAndFromASecondInstance)
{
	startDirectly();
	std::string out;
	int rc = launcher("-s " + id + " -o test/op -d key 'two words' -a list a,b,c -d reply succeeded -r", &out);
	EXPECT_EQ(0, rc) << out;
	for (const std::string &line : {std::string("result=succeeded\n"), std::string("key=two words\n"),
	                                std::string("list=a,b,c\n"), "echo=" + id + "\n"})
		EXPECT_NE(std::string::npos, out.find(line)) << out;
	// The argv request came first, so this one is not the first launch; the callee notes its reply after it.
	ASSERT_TRUE(waitLog("replied 0\n"));
	std::string log = calleeLog();
	EXPECT_NE(std::string::npos, log.find("request first=1 op=http://tizen.org/appcontrol/operation/main"));
	EXPECT_NE(std::string::npos, log.find("request first=0 op=test/op\ncaller=com.veltron.memo\n"));
	EXPECT_NE(std::string::npos, log.find("extra list=a,b,c\n"));

	// A second instance hands its command-line request to the first and ends.
	rc = memo_test::runCommand("TIZEN_APP_ID=" + id + " '" + memo_test::helperPath("test_callee") +
	                               "' --operation test/second --extra b=2 --extra-array arr=x,y 2>&1",
	                           &out);
	EXPECT_EQ(0, rc) << out;
	ASSERT_TRUE(waitLog("request first=0 op=test/second\n"));
	log = calleeLog();
	EXPECT_NE(std::string::npos, log.find("extra b=2\nextra arr=x,y\n")) << log;
	EXPECT_EQ(1u, countInLog("create")) << "a second app was created:\n" << log;
}

TEST_F(AppLaunch, RequestToAStoppedAppStartsItWithThatRequestFirst)
{
	app_control_h h = request("test/start");
	app_control_add_extra_data(h, "reply", "succeeded");
	app_control_add_extra_data(h, "payload", "from the test");
	Reply reply;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_send_launch_request(h, replyCb, &reply));
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return reply.arrived; }));
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, reply.result);
	EXPECT_EQ("from the test", reply.extras["payload"]);
	EXPECT_EQ(id, reply.extras["echo"]);
	EXPECT_EQ(0u, calleeLog().find("create\nrequest first=1 op=test/start\n")) << calleeLog();
	EXPECT_EQ(std::string::npos, calleeLog().find("operation/main")) << calleeLog();

	// A second request goes to the same process.
	app_control_set_operation(h, "test/again");
	Reply again;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_send_launch_request(h, replyCb, &again));
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return again.arrived; }));
	EXPECT_NE(std::string::npos, calleeLog().find("request first=0 op=test/again\n"));
	EXPECT_EQ(1u, countInLog("create"));
	app_control_destroy(h);
}

TEST_F(AppLaunch, UnknownOrBrokenAppsFailWithTizenErrors)
{
	std::string out;
	EXPECT_NE(0, launcher("-s no.such.app -o x", &out));
	EXPECT_NE(std::string::npos, out.find("no registered app has this id")) << out;

	app_control_h h = request("x");
	app_control_set_app_id(h, "no.such.app");
	EXPECT_EQ(APP_CONTROL_ERROR_APP_NOT_FOUND, app_control_send_launch_request(h, nullptr, nullptr));
	std::ofstream(appsDir + "/test.broken.ini") << "[app]\nid=test.broken\nexec=/nonexistent/program\n";
	app_control_set_app_id(h, "test.broken");
	EXPECT_EQ(APP_CONTROL_ERROR_LAUNCH_FAILED, app_control_send_launch_request(h, nullptr, nullptr));
	app_control_destroy(h);

	for (const char *args : {" -d onlykey", " -t soon", " -t nan", " -x", " -a list ''"})
		EXPECT_EQ(2, launcher("-s " + id + args, &out)) << args << ": " << out;
	EXPECT_EQ(2, launcher("-o x -d key value", &out)) << out;
	EXPECT_NE(std::string::npos, out.find("name the app with -s")) << out;
}

// No send waits on a peer for ever: one that ends, or one that is stopped and reads nothing, gives a result
// at once or within the send deadline, and the caller goes on.
TEST_F(AppLaunch, SendsToAnEndedOrStoppedCalleeGiveAResultInTime)
{
	app_control_h h = request("test/die");
	app_control_add_extra_data(h, "die", "1");
	Reply reply;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_send_launch_request(h, replyCb, &reply));
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return reply.arrived; }));
	EXPECT_EQ(APP_CONTROL_RESULT_CANCELED, reply.result);
	app_control_destroy(h);
	// The callee may still be on its way out: the send meets its socket open, closing or gone.
	int ret = terminate();
	EXPECT_TRUE(ret == APP_CONTROL_ERROR_NONE || ret == APP_CONTROL_ERROR_APP_NOT_FOUND ||
	            ret == APP_CONTROL_ERROR_IO_ERROR)
	    << ret;
	ASSERT_TRUE(waitRunning(false));
	EXPECT_EQ(APP_CONTROL_ERROR_APP_NOT_FOUND, terminate());

	// Stopped: a request larger than its socket can hold is not taken; a small one waits in the socket.
	startDirectly();
	Watchdog::stopped = calleePid();
	ASSERT_GT(Watchdog::stopped, 0);
	ASSERT_EQ(0, kill(Watchdog::stopped, SIGSTOP));
	h = request("test/big");
	app_control_add_extra_data(h, "blob", std::string(4 << 20, 'x').c_str());
	Reply never;
	EXPECT_EQ(APP_CONTROL_ERROR_TIMED_OUT, app_control_send_launch_request(h, replyCb, &never));
	EXPECT_EQ(APP_CONTROL_ERROR_TIMED_OUT, app_control_send_launch_request(h, nullptr, nullptr));
	app_control_destroy(h);
	EXPECT_EQ(APP_CONTROL_ERROR_NONE, terminate());
	ASSERT_EQ(0, kill(Watchdog::stopped, SIGCONT));
	Watchdog::stopped = -1;
	ASSERT_TRUE(waitRunning(false));
	EXPECT_FALSE(never.arrived);
	EXPECT_EQ(std::string::npos, calleeLog().find("test/big")) << calleeLog();
	EXPECT_TRUE(waitLog("terminate\n"));
}

TEST_F(AppLaunch, ManagerSeesResumesAndTerminatesTheRunningApp)
{
	app_context_h context = nullptr;
	EXPECT_EQ(APP_MANAGER_ERROR_NO_SUCH_APP, app_manager_get_app_context(id.c_str(), &context));
	std::string out;
	ASSERT_EQ(0, launcher("-s " + id, &out)) << out;
	ASSERT_TRUE(waitRunning(true));
	ASSERT_EQ(APP_MANAGER_ERROR_NONE, app_manager_get_app_context(id.c_str(), &context));
	EXPECT_EQ(APP_MANAGER_ERROR_NONE, app_manager_resume_app(context));
	app_context_destroy(context);
	EXPECT_GT(calleePid(), 0);

	ASSERT_EQ(0, launcher("-k " + id, &out)) << out;
	ASSERT_TRUE(waitRunning(false));
	EXPECT_TRUE(waitLog("request first=1 op=http://tizen.org/appcontrol/operation/default\n"));
	EXPECT_TRUE(waitLog("pause\nterminate\n"));
	EXPECT_NE(0, launcher("-k " + id, &out));

	// SIGTERM and SIGINT end it the same way, through its terminate callback.
	for (int sig : {SIGTERM, SIGINT}) {
		startDirectly();
		size_t ended = countInLog("pause\nterminate\n");
		ASSERT_EQ(0, kill(calleePid(), sig));
		ASSERT_TRUE(waitRunning(false)) << sig;
		EXPECT_TRUE(memo_test::pump(5.0, [&] { return countInLog("pause\nterminate\n") > ended; })) << sig;
	}
}
