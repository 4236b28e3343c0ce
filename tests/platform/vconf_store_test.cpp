// vconf store: types, errors, seeded device defaults and where the keys live.
#include <gtest/gtest.h>
#include <vconf.h>

#include <cstdlib>
#include <string>
#include <sys/stat.h>

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
