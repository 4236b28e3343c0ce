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
// cost the whole run its time limit and hide where it stuck.
struct Watchdog {
	explicit Watchdog(unsigned seconds)
	{
		snprintf(name, sizeof(name), "\nwatchdog: %s did not return within %u s\n",
		         ::testing::UnitTest::GetInstance()->current_test_info()->name(), seconds);
		struct sigaction sa = {};
		sa.sa_handler = fireCb;
		sigaction(SIGALRM, &sa, &saved);
		alarm(seconds);
	}
	~Watchdog()
	{
		alarm(0);
		sigaction(SIGALRM, &saved, nullptr);
	}
	static void fireCb(int)
	{
		ssize_t n = write(STDERR_FILENO, name, strlen(name));
		(void)n;
		_exit(124);
	}
	static char name[256];
	struct sigaction saved = {};
};
char Watchdog::name[256];

class AppLaunch : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		ecore_init();
		appsDir() = memo_test::makeTempDir("apps");
		logDir() = memo_test::makeTempDir("callee-logs");
		setenv("TIZEN_APPS_DIR", appsDir().c_str(), 1);
		setenv("TEST_CALLEE_DIR", logDir().c_str(), 1);
	}
	static void TearDownTestSuite() { ecore_shutdown(); }

	static std::string &appsDir()
	{
		static std::string dir;
		return dir;
	}
	static std::string &logDir()
	{
		static std::string dir;
		return dir;
	}

	// A fresh app id per test, registered to start the test callee.
	void SetUp() override
	{
		id = std::string("test.callee.") + ::testing::UnitTest::GetInstance()->current_test_info()->name();
		std::ofstream(appsDir() + "/" + id + ".ini")
		    << "[app]\nid=" << id << "\nexec=" << memo_test::helperPath("test_callee") << "\n";
	}

	void TearDown() override
	{
		if (terminate() == APP_CONTROL_ERROR_NONE)
			waitRunning(false);
	}

	bool isRunning()
	{
		bool running = false;
		app_manager_is_running(id.c_str(), &running);
		return running;
	}

	bool waitRunning(bool expected)
	{
		return memo_test::pump(10.0, [&] { return isRunning() == expected; });
	}

	std::string calleeLog() { return memo_test::readFile(logDir() + "/" + id + ".log"); }

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

	app_control_h request(const std::string &operation)
	{
		app_control_h h = nullptr;
		app_control_create(&h);
		app_control_set_app_id(h, id.c_str());
		app_control_set_operation(h, operation.c_str());
		return h;
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

	int terminate()
	{
		app_control_h h = nullptr;
		app_control_create(&h);
		app_control_set_app_id(h, id.c_str());
		int ret = app_control_send_terminate_request(h);
		app_control_destroy(h);
		return ret;
	}

	Watchdog watchdog{60};
	std::string id;
};
} // namespace

TEST_F(AppLaunch, LauncherRequestReachesTheRunningCalleeAndPrintsItsReply)
{
	startDirectly();
	std::string out;
	int rc = launcher("-s " + id + " -o test/op -d key 'two words' -a list a,b,c -d reply succeeded -r", &out);
	EXPECT_EQ(0, rc) << out;
	EXPECT_NE(std::string::npos, out.find("result=succeeded\n")) << out;
	EXPECT_NE(std::string::npos, out.find("key=two words\n")) << out;
	EXPECT_NE(std::string::npos, out.find("list=a,b,c\n")) << out;
	EXPECT_NE(std::string::npos, out.find("echo=" + id + "\n")) << out;

	const std::string log = calleeLog();
	// The argv request came first, so this one is not the first launch.
	EXPECT_NE(std::string::npos, log.find("request first=1 op=http://tizen.org/appcontrol/operation/main"));
	EXPECT_NE(std::string::npos, log.find("request first=0 op=test/op\ncaller=com.veltron.memo\n"));
	EXPECT_NE(std::string::npos, log.find("extra list=a,b,c\n"));
	// The callee notes its reply after sending it.
	EXPECT_TRUE(waitLog("replied 0\n"));
}

TEST_F(AppLaunch, RequestToAStoppedAppStartsItWithThatRequestFirst)
{
	ASSERT_FALSE(isRunning());
	app_control_h h = request("test/start");
	app_control_add_extra_data(h, "reply", "succeeded");
	app_control_add_extra_data(h, "payload", "from the test");
	Reply reply;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_send_launch_request(h, replyCb, &reply));
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return reply.arrived; }));
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, reply.result);
	EXPECT_EQ("from the test", reply.extras["payload"]);
	EXPECT_EQ(id, reply.extras["echo"]);
	EXPECT_TRUE(isRunning());

	const std::string log = calleeLog();
	EXPECT_EQ(0u, log.find("create\nrequest first=1 op=test/start\n")) << log;
	EXPECT_EQ(std::string::npos, log.find("operation/main")) << log;

	// A second request goes to the same process.
	app_control_set_operation(h, "test/again");
	Reply again;
	ASSERT_EQ(APP_CONTROL_ERROR_NONE, app_control_send_launch_request(h, replyCb, &again));
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return again.arrived; }));
	EXPECT_NE(std::string::npos, calleeLog().find("request first=0 op=test/again\n"));
	EXPECT_EQ(calleeLog().find("create"), calleeLog().rfind("create"));
	app_control_destroy(h);
}

TEST_F(AppLaunch, SecondInstanceHandsItsRequestToTheFirstAndEnds)
{
	startDirectly();
	std::string out;
	int rc = memo_test::runCommand("TIZEN_APP_ID=" + id + " '" + memo_test::helperPath("test_callee") +
	                                   "' --operation test/second --extra b=2 --extra-array arr=x,y 2>&1",
	                               &out);
	EXPECT_EQ(0, rc) << out;
	ASSERT_TRUE(waitLog("request first=0 op=test/second\n"));
	const std::string log = calleeLog();
	EXPECT_NE(std::string::npos, log.find("extra b=2\nextra arr=x,y\n")) << log;
	EXPECT_EQ(log.find("create"), log.rfind("create")) << "a second app was created:\n" << log;
}

TEST_F(AppLaunch, UnknownOrBrokenAppsFailWithTizenErrors)
{
	std::string out;
	EXPECT_NE(0, launcher("-s no.such.app -o x", &out));
	EXPECT_NE(std::string::npos, out.find("no registered app has this id")) << out;

	app_control_h h = request("x");
	app_control_set_app_id(h, "no.such.app");
	EXPECT_EQ(APP_CONTROL_ERROR_APP_NOT_FOUND, app_control_send_launch_request(h, nullptr, nullptr));

	std::ofstream(appsDir() + "/test.broken.ini") << "[app]\nid=test.broken\nexec=/nonexistent/program\n";
	app_control_set_app_id(h, "test.broken");
	EXPECT_EQ(APP_CONTROL_ERROR_LAUNCH_FAILED, app_control_send_launch_request(h, nullptr, nullptr));
	app_control_destroy(h);

	EXPECT_EQ(2, launcher("-s " + id + " -d onlykey", &out)) << out;
	EXPECT_EQ(2, launcher("-s " + id + " -t soon", &out)) << out;
	EXPECT_EQ(2, launcher("-s " + id + " -t nan", &out)) << out;
	EXPECT_EQ(2, launcher("-o x -d key value", &out)) << out;
	EXPECT_NE(std::string::npos, out.find("name the app with -s")) << out;
	EXPECT_EQ(2, launcher("-s " + id + " -x", &out)) << out;
	EXPECT_EQ(2, launcher("-s " + id + " -a list ''", &out)) << out;
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
	// The callee may still be on its way out: the send meets its closing socket.
	int ret = terminate();
	EXPECT_TRUE(ret == APP_CONTROL_ERROR_NONE || ret == APP_CONTROL_ERROR_APP_NOT_FOUND) << ret;
	ASSERT_TRUE(waitRunning(false));
	EXPECT_EQ(APP_CONTROL_ERROR_APP_NOT_FOUND, terminate());

	std::string out;
	EXPECT_EQ(1, launcher("-s " + id + " -d die 1 -r", &out));
	EXPECT_NE(std::string::npos, out.find("result=canceled\n")) << out;
	ret = terminate();
	EXPECT_TRUE(ret == APP_CONTROL_ERROR_NONE || ret == APP_CONTROL_ERROR_APP_NOT_FOUND) << ret;
	ASSERT_TRUE(waitRunning(false));

	// Stopped: a request larger than the socket can hold cannot be handed over; small ones wait in the socket.
	startDirectly();
	pid_t pid = calleePid();
	ASSERT_GT(pid, 0);
	ASSERT_EQ(0, kill(pid, SIGSTOP));
	h = request("test/big");
	app_control_add_extra_data(h, "blob", std::string(4 << 20, 'x').c_str());
	Reply never;
	EXPECT_EQ(APP_CONTROL_ERROR_TIMED_OUT, app_control_send_launch_request(h, replyCb, &never));
	EXPECT_EQ(APP_CONTROL_ERROR_TIMED_OUT, app_control_send_launch_request(h, nullptr, nullptr));
	app_control_destroy(h);
	EXPECT_EQ(APP_CONTROL_ERROR_NONE, terminate());
	ASSERT_EQ(0, kill(pid, SIGCONT));
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
	pid_t pid = -1;
	app_context_get_pid(context, &pid);
	EXPECT_GT(pid, 0);
	EXPECT_EQ(APP_MANAGER_ERROR_NONE, app_manager_resume_app(context));
	app_context_destroy(context);

	ASSERT_EQ(0, launcher("-k " + id, &out)) << out;
	ASSERT_TRUE(waitRunning(false));
	ASSERT_TRUE(waitLog("terminate\n"));
	EXPECT_NE(std::string::npos, calleeLog().find("pause\nterminate\n"));
	EXPECT_NE(0, launcher("-k " + id, &out));

	// SIGTERM and SIGINT end it the same way, through its terminate callback.
	for (int sig : {SIGTERM, SIGINT}) {
		startDirectly();
		std::string::size_type seen = calleeLog().rfind("terminate\n");
		ASSERT_EQ(0, kill(calleePid(), sig));
		ASSERT_TRUE(waitRunning(false)) << sig;
		EXPECT_TRUE(memo_test::pump(5.0, [&] { return calleeLog().rfind("pause\nterminate\n") > seen; })) << sig;
	}
}
