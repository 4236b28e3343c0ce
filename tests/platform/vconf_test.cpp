// The vconf store: types, errors, seeded device defaults and where the keys live; change notices across
// processes, and the vconftool command line.
#include <gtest/gtest.h>
#include <vconf.h>

#include <Ecore.h>

#include <cstdlib>
#include <string>
#include <sys/stat.h>
#include <vector>

#include "TestEnv.h"

namespace
{
std::string getStr(const char *key)
{
	char *s = vconf_get_str(key);
	std::string r = s ? s : "<null>";
	free(s);
	return r;
}

// The value, or -999 when the read fails.
int getInt(const char *key)
{
	int v = -999;
	return vconf_get_int(key, &v) == VCONF_OK ? v : -999;
}

struct Seen {
	std::vector<std::string> events; // "<tag>:<key>=<value>"
};

std::string describe(keynode_t *node)
{
	std::string s = std::string(vconf_keynode_get_name(node)) + "=";
	switch (vconf_keynode_get_type(node)) {
	case VCONF_TYPE_INT:
		return s + std::to_string(vconf_keynode_get_int(node));
	case VCONF_TYPE_BOOL:
		return s + (vconf_keynode_get_bool(node) ? "true" : "false");
	case VCONF_TYPE_STRING:
		return s + "'" + vconf_keynode_get_str(node) + "'";
	default:
		return s + "?";
	}
}

void firstCb(keynode_t *node, void *data)
{
	static_cast<Seen *>(data)->events.push_back("1:" + describe(node));
}

void secondCb(keynode_t *node, void *data)
{
	static_cast<Seen *>(data)->events.push_back("2:" + describe(node));
}

class VconfNotify : public testing::Test
{
protected:
	static void SetUpTestSuite() { ecore_init(); }

	static int vconftool(const std::string &args, std::string *out = nullptr)
	{
		return memo_test::runCommand(std::string(TEST_BIN_DIR "/vconftool ") + args + " 2>/dev/null", out);
	}
};
} // namespace

TEST(VconfStore, TypedValuesAndMismatches)
{
	int b = 0;
	double d = 0;
	ASSERT_EQ(VCONF_OK, vconf_set_int("db/test/int", -42));
	EXPECT_EQ(-42, getInt("db/test/int"));
	ASSERT_EQ(VCONF_OK, vconf_set_bool("memory/test/bool", 7));
	ASSERT_EQ(VCONF_OK, vconf_get_bool("memory/test/bool", &b));
	EXPECT_EQ(1, b);
	ASSERT_EQ(VCONF_OK, vconf_set_dbl("file/test/dbl", 2.5));
	ASSERT_EQ(VCONF_OK, vconf_get_dbl("file/test/dbl", &d));
	EXPECT_EQ(2.5, d);
	ASSERT_EQ(VCONF_OK, vconf_set_str("db/test/str", "Europe/Berlin"));
	EXPECT_EQ("Europe/Berlin", getStr("db/test/str"));
	int type = 0;
	ASSERT_EQ(VCONF_OK, vconf_get_type("db/test/str", &type));
	EXPECT_EQ(VCONF_TYPE_STRING, type);

	// A read of another type fails and leaves the output alone; a write replaces the type.
	int i = 5;
	EXPECT_EQ(VCONF_ERROR, vconf_get_int("db/test/str", &i));
	EXPECT_EQ(5, i);
	EXPECT_EQ(VCONF_ERROR, vconf_get_bool("db/test/int", &b));
	EXPECT_EQ("<null>", getStr("db/test/int"));
	ASSERT_EQ(VCONF_OK, vconf_set_str("db/test/int", "now a string"));
	EXPECT_EQ("now a string", getStr("db/test/int"));

	EXPECT_EQ(VCONF_OK, vconf_unset("db/test/int"));
	EXPECT_EQ(VCONF_ERROR, vconf_unset("db/test/int"));
	EXPECT_EQ("<null>", getStr("db/test/int"));
	EXPECT_EQ(-999, getInt("db/test/never"));
	// Keys live under db/, file/ or memory/ and have a name there.
	EXPECT_EQ(VCONF_ERROR, vconf_set_int("nodb/x", 1));
	EXPECT_EQ(VCONF_ERROR, vconf_set_int("db/", 1));
}

TEST(VconfStore, DeviceKeysReadAsDefaultsUntilSet)
{
	setenv("LANG", "de_DE.utf8", 1);
	EXPECT_EQ("de_DE.UTF-8", getStr(VCONFKEY_LANGSET));
	EXPECT_EQ("de_DE.UTF-8", getStr(VCONFKEY_REGIONFORMAT));
	setenv("LANG", "C.UTF-8", 1);
	EXPECT_EQ("en_US.UTF-8", getStr(VCONFKEY_LANGSET));
	unsetenv("LANG");
	EXPECT_EQ("en_US.UTF-8", getStr(VCONFKEY_LANGSET));
	EXPECT_EQ(VCONFKEY_TIME_FORMAT_12, getInt(VCONFKEY_REGIONFORMAT_TIME1224));
	EXPECT_EQ(VCONFKEY_CALL_OFF, getInt(VCONFKEY_CALL_STATE));
	EXPECT_EQ(0, getInt(VCONFKEY_SETAPPL_PSMODE));

	// A stored value wins; unsetting it brings the default back.
	ASSERT_EQ(VCONF_OK, vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_ACTIVE));
	EXPECT_EQ(VCONFKEY_CALL_VOICE_ACTIVE, getInt(VCONFKEY_CALL_STATE));
	ASSERT_EQ(VCONF_OK, vconf_unset(VCONFKEY_CALL_STATE));
	EXPECT_EQ(VCONFKEY_CALL_OFF, getInt(VCONFKEY_CALL_STATE));
}

TEST(VconfStore, StoreFolderFollowsTheEnvironment)
{
	const std::string vconfDir = getenv("TIZEN_VCONF_DIR");
	ASSERT_EQ(VCONF_OK, vconf_set_int("db/memo/data-change", 1));
	EXPECT_EQ("int\n1", memo_test::readFile(vconfDir + "/db%2Fmemo%2Fdata-change"));

	// Without TIZEN_VCONF_DIR the user's configuration folder holds the store.
	unsetenv("TIZEN_VCONF_DIR");
	ASSERT_EQ(VCONF_OK, vconf_set_str("db/test/where", "xdg"));
	struct stat st;
	EXPECT_EQ(0,
	          stat((std::string(getenv("XDG_CONFIG_HOME")) + "/tizen-platform/vconf/db%2Ftest%2Fwhere").c_str(), &st));
	setenv("TIZEN_VCONF_DIR", vconfDir.c_str(), 1);
	EXPECT_EQ("<null>", getStr("db/test/where"));
}

TEST_F(VconfNotify, ChangesOfAnotherProcessReachEveryCallbackUntilIgnored)
{
	Seen seen;
	// Watching a key that nobody has set yet is allowed.
	ASSERT_EQ(VCONF_OK, vconf_notify_key_changed("db/setting/timezone_id", firstCb, &seen));
	ASSERT_EQ(VCONF_OK, vconf_notify_key_changed("db/setting/timezone_id", secondCb, &seen));
	ASSERT_EQ(VCONF_OK, vconf_notify_key_changed(VCONFKEY_REGIONFORMAT_TIME1224, firstCb, &seen));

	std::string writer = memo_test::helperPath("test_writer");
	ASSERT_EQ(0, memo_test::runCommand(writer + " vconf-str db/setting/timezone_id Asia/Seoul"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.events.size() == 2; }));
	EXPECT_EQ("1:db/setting/timezone_id='Asia/Seoul'", seen.events[0]);
	EXPECT_EQ("2:db/setting/timezone_id='Asia/Seoul'", seen.events[1]);

	ASSERT_EQ(0, memo_test::runCommand(writer + " vconf-int db/menu_widget/regionformat_time1224 2"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.events.size() == 3; }));
	EXPECT_EQ("1:db/menu_widget/regionformat_time1224=2", seen.events[2]);

	ASSERT_EQ(VCONF_OK, vconf_ignore_key_changed("db/setting/timezone_id", firstCb));
	EXPECT_EQ(VCONF_ERROR, vconf_ignore_key_changed("db/setting/timezone_id", firstCb));
	// The same value again is still a change.
	ASSERT_EQ(VCONF_OK, vconf_set_str("db/setting/timezone_id", "Asia/Seoul"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.events.size() == 4; }));
	EXPECT_EQ("2:db/setting/timezone_id='Asia/Seoul'", seen.events[3]);

	ASSERT_EQ(VCONF_OK, vconf_ignore_key_changed("db/setting/timezone_id", secondCb));
	// Notices come in order: the one of the last key marks that the ignored ones were passed over.
	ASSERT_EQ(0, memo_test::runCommand(writer + " vconf-str db/setting/timezone_id UTC"));
	ASSERT_EQ(0, memo_test::runCommand(writer + " vconf-int db/menu_widget/regionformat_time1224 1"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.events.size() == 5; }));
	EXPECT_EQ("1:db/menu_widget/regionformat_time1224=1", seen.events[4]);
	ASSERT_EQ(VCONF_OK, vconf_ignore_key_changed(VCONFKEY_REGIONFORMAT_TIME1224, firstCb));
}

// The command line writes through the same store as test_writer, so its notices need no second test.
TEST_F(VconfNotify, VconftoolRoundTrip)
{
	// Tizen's argument order, with its ignored install flag; an unset brings the seeded default back.
	const char *steps[][3] = {
	    {"set -t int db/setting/psmode 2 -f", "db/setting/psmode", "2 (int)"},
	    {"set -t string db/csc/salescode 'K T C'", "db/csc/salescode", "K T C (string)"},
	    {"set -t int memory/call/state -1", "memory/call/state", "-1 (int)"},
	    {"unset memory/call/state", "memory/call/state", "0 (int)"},
	};
	std::string out;
	for (const auto &step : steps) {
		ASSERT_EQ(0, vconftool(step[0])) << step[0];
		ASSERT_EQ(0, vconftool(std::string("get ") + step[1], &out));
		EXPECT_EQ(std::string(step[1]) + ", value = " + step[2] + "\n", out);
	}
	ASSERT_EQ(0, vconftool("-t bool set db/setting/sound/sound_on false"));
	int b = 1;
	ASSERT_EQ(VCONF_OK, vconf_get_bool("db/setting/sound/sound_on", &b));
	EXPECT_EQ(0, b);

	// 1 for a missing key, 2 for a wrong command line.
	EXPECT_EQ(1, vconftool("unset db/test/missing"));
	for (const char *wrong : {"set db/x 1", "set -t int db/x one", "get nodb/x", ""})
		EXPECT_EQ(2, vconftool(wrong)) << wrong;
}
