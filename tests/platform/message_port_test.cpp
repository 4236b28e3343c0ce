// Message ports between processes: the indicator's port as a helper process registers it.
#include <gtest/gtest.h>

#include <Ecore.h>
#include <message_port.h>

#include <string>

#include "TestEnv.h"

namespace
{
const char *const kIndicator = "com.veltron.indicator";
const char *const kPort = "voicerecorder_indicator_port";

bool portOpen(const char *app, const char *port)
{
	bool exist = false;
	return message_port_check_remote_port(app, port, &exist) == MESSAGE_PORT_ERROR_NONE && exist;
}

int send(const char *value)
{
	bundle *b = bundle_create();
	bundle_add_str(b, "voicerecorder_indicator_data", value);
	int rc = message_port_send_message(kIndicator, kPort, b);
	bundle_free(b);
	return rc;
}

class MessagePort : public ::testing::Test
{
protected:
	static void SetUpTestSuite() { ecore_init(); }
	static void TearDownTestSuite() { ecore_shutdown(); }
};
} // namespace

TEST_F(MessagePort, TheIndicatorGetsEachMessageWithItsSender)
{
	EXPECT_FALSE(portOpen(kIndicator, kPort));
	EXPECT_EQ(MESSAGE_PORT_ERROR_PORT_NOT_FOUND, send("bg_recording_start"));

	std::string out = memo_test::makeTempDir("port") + "/listener.out";
	memo_test::runCommand(std::string("(TIZEN_APP_ID=") + kIndicator + " '" +
	                      memo_test::helperPath("test_port_listener") + "' " + kPort + " 2; echo exit=$?) > " + out +
	                      " 2>/dev/null &");
	ASSERT_TRUE(memo_test::pump(10, [] { return portOpen(kIndicator, kPort); }));
	ASSERT_EQ(MESSAGE_PORT_ERROR_NONE, send("bg_recording_start"));
	ASSERT_EQ(MESSAGE_PORT_ERROR_NONE, send("voicerecorder_none"));
	ASSERT_TRUE(memo_test::pump(10, [&] { return memo_test::countOf(memo_test::readFile(out), "exit=") == 1; }));
	EXPECT_EQ("com.veltron.memo voicerecorder_indicator_data=bg_recording_start\n"
	          "com.veltron.memo voicerecorder_indicator_data=voicerecorder_none\n"
	          "exit=0\n",
	          memo_test::readFile(out));
	EXPECT_FALSE(portOpen(kIndicator, kPort));
}

TEST_F(MessagePort, ALocalPortIsOpenUntilUnregistered)
{
	auto cb = [](int, const char *, const char *, bool, bundle *, void *) {};
	int id = message_port_register_local_port("local", cb, nullptr);
	ASSERT_GT(id, 0);
	EXPECT_EQ(id, message_port_register_local_port("local", cb, nullptr));
	EXPECT_TRUE(portOpen("com.veltron.memo", "local"));
	ASSERT_EQ(MESSAGE_PORT_ERROR_NONE, message_port_unregister_local_port(id));
	EXPECT_FALSE(portOpen("com.veltron.memo", "local"));
	EXPECT_EQ(MESSAGE_PORT_ERROR_PORT_NOT_FOUND, message_port_unregister_local_port(id));
}
