// Launch sockets and message ports take data from other processes: malformed, oversized and truncated
// messages are refused with a log line, the receiver goes on, and other users cannot reach them.
#define EFL_BETA_API_SUPPORT 1
#include <gtest/gtest.h>

#include <Ecore.h>
#include <Eina.h>
#include <app_manager.h>
#include <bundle.h>
#include <message_port.h>

#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdint>
#include <fstream>
#include <string>

#include "TestEnv.h"

namespace
{
std::string socketPath(const std::string &id)
{
	char path[sizeof(sockaddr_un::sun_path)];
	eina_vpath_resolve_snprintf(path, sizeof(path), "(:usr.run:)/tizen-app/%s", id.c_str());
	return path;
}

// Connects, writes the bytes and closes; the connect's errno, or 0. The receiver may have dropped the
// connection before the write: that is no failure of the connect.
int sendRaw(const std::string &path, const std::string &bytes)
{
	sockaddr_un addr = {};
	addr.sun_family = AF_UNIX;
	snprintf(addr.sun_path, sizeof(addr.sun_path), "%s", path.c_str());
	int fd = socket(AF_UNIX, SOCK_STREAM, 0);
	int err = connect(fd, reinterpret_cast<sockaddr *>(&addr), sizeof(addr)) == 0 ? 0 : errno;
	if (!err)
		send(fd, bytes.data(), bytes.size(), MSG_NOSIGNAL);
	close(fd);
	return err;
}

std::string frame(uint32_t major, const std::string &payload, uint32_t size)
{
	const uint32_t header[5] = {0x54415050u, major, 1, 0, size};
	return std::string(reinterpret_cast<const char *>(header), sizeof(header)) + payload;
}

std::string launchFrame(bundle *b)
{
	bundle_raw *raw = nullptr;
	int len = 0;
	bundle_encode(b, &raw, &len);
	const std::string payload(reinterpret_cast<char *>(raw), len);
	bundle_free_encoded_rawdata(&raw);
	bundle_free(b);
	return frame(1, payload, payload.size());
}

bool logged(const std::string &text)
{
	const std::string log = std::string(getenv("TIZEN_APP_ROOT")) + "/data/dlog.log";
	return memo_test::pump(10, [&] { return memo_test::readFile(log).find(text) != std::string::npos; });
}

// Runs fn as the user nobody in a child process; its exit status, or -1 when this process may not.
int asNobody(const std::function<int()> &fn)
{
	if (geteuid() != 0)
		return -1;
	pid_t pid = fork();
	if (pid == 0)
		_exit(setgid(65534) == 0 && setuid(65534) == 0 ? fn() : 99);
	int status = 0;
	waitpid(pid, &status, 0);
	return WEXITSTATUS(status);
}

class HostileSockets : public ::testing::Test
{
protected:
	void SetUp() override
	{
		ecore_init();
		const std::string apps = memo_test::makeTempDir("apps");
		setenv("TIZEN_APPS_DIR", apps.c_str(), 1);
		setenv("TEST_CALLEE_DIR", memo_test::makeTempDir("callee-logs").c_str(), 1);
		std::ofstream(apps + "/" + id + ".ini")
		    << "[app]\nid=" << id << "\nexec=" << memo_test::helperPath("test_callee") << "\n";
	}
	void TearDown() override
	{
		launcher("-k " + id);
		ecore_shutdown();
	}
	static int launcher(const std::string &args)
	{
		return memo_test::runCommand(std::string("'") + TEST_BIN_DIR + "/app_launcher' " + args + " >/dev/null 2>&1");
	}
	// A request that the test callee answers (starting it when needed): true when the answer came.
	bool answered() const { return launcher("-s " + id + " -d reply succeeded -r") == 0; }

	const std::string id = std::string("test.") + ::testing::UnitTest::GetInstance()->current_test_info()->name();
};
} // namespace

TEST_F(HostileSockets, MalformedMessagesAreRefusedAndTheAppGoesOn)
{
	ASSERT_TRUE(answered());
	const std::string path = socketPath(id);

	bundle *wrongType = bundle_create();
	const char *ops[] = {"a", "b"};
	bundle_add_str_array(wrongType, "__APP_SVC_OPERATION__", ops, 2);
	bundle *longMime = bundle_create();
	bundle_add_str(longMime, "__APP_SVC_MIME__", std::string(10000, 'x').c_str());
	bundle *manyKeys = bundle_create();
	for (int i = 0; i < 2000; ++i)
		bundle_add_str(manyKeys, ("k" + std::to_string(i)).c_str(), "v");
	const std::pair<std::string, std::string> cases[] = {
	    {"GET / HTTP/1.0\r\nHost: memo\r\n\r\n", "a stream that is not made of launch messages"},
	    {frame(1, "", 0xfffffff0u), "a message of 4294967280 bytes refused"},
	    {frame(1, "QkRMMQ", 100), "the sender left a message unfinished"},
	    {frame(1, "!!!!", 4), "bundle text is not valid base64"},
	    {launchFrame(wrongType), "launch request refused: __APP_SVC_OPERATION__ is not a text"},
	    {launchFrame(longMime), "launch request refused: __APP_SVC_MIME__ of 10000 bytes"},
	    {launchFrame(manyKeys), "bundle of 2000 keys refused"},
	};
	for (const auto &c : cases) {
		ASSERT_EQ(0, sendRaw(path, c.first));
		EXPECT_TRUE(logged(c.second)) << c.second;
	}
	EXPECT_TRUE(answered()) << "the app stopped taking requests";

	// A message port drops the same kinds of message and still takes the next good one.
	int got = 0;
	auto cb = [](int, const char *, const char *, bool, bundle *, void *data) { ++*static_cast<int *>(data); };
	const int port = message_port_register_local_port("hostile", cb, &got);
	ASSERT_GT(port, 0);
	const std::string portPath = socketPath("com.veltron.memo@hostile");
	ASSERT_EQ(0, sendRaw(portPath, frame(5, "xyz", 3)));
	ASSERT_EQ(0, sendRaw(portPath, frame(5, "", 1u << 30)));
	bundle *b = bundle_create();
	bundle_add_str(b, "k", "v");
	ASSERT_EQ(MESSAGE_PORT_ERROR_NONE, message_port_send_message("com.veltron.memo", "hostile", b));
	bundle_free(b);
	EXPECT_TRUE(memo_test::pump(10, [&] { return got == 1; }));
	EXPECT_TRUE(logged("malformed message on port com.veltron.memo@hostile dropped"));
	message_port_unregister_local_port(port);
}

TEST_F(HostileSockets, OnlyTheUserCanReachTheSockets)
{
	// A folder left open by someone is closed again when the app starts listening.
	const std::string path = socketPath(id), dir = path.substr(0, path.rfind('/'));
	mkdir(dir.c_str(), 0700);
	chmod(dir.c_str(), 0755);
	ASSERT_TRUE(answered());
	struct stat st = {};
	ASSERT_EQ(0, stat(dir.c_str(), &st));
	EXPECT_EQ(0700u, st.st_mode & 0777);

	const std::string hello = frame(3, "", 0);
	if (asNobody([] { return 0; }) < 0)
		GTEST_SKIP() << "acting as another user needs root";
	// The test's own folders above are private too: open them for the way in, so that ours is what stops.
	const std::string runtime = getenv("XDG_RUNTIME_DIR");
	chmod(memo_test::tempRoot().c_str(), 0711);
	chmod(runtime.c_str(), 0711);
	EXPECT_EQ(EACCES, asNobody([&] { return sendRaw(path, hello); }));
	// Even with the folder and the socket opened up, the app refuses the other user's connection.
	chmod(dir.c_str(), 0711);
	chmod(path.c_str(), 0777);
	EXPECT_EQ(0, asNobody([&] { return sendRaw(path, hello); }));
	EXPECT_TRUE(logged("a connection from user 65534"));
	for (const std::string &d : {dir, runtime, memo_test::tempRoot()})
		chmod(d.c_str(), 0700);
	bool running = false;
	EXPECT_TRUE(app_manager_is_running(id.c_str(), &running) == APP_MANAGER_ERROR_NONE && running)
	    << "the other user's terminate message was obeyed";
}
