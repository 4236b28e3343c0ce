// Device settings read through vconf, their change callbacks, and keys of the wrong type or unsupported.
#include <gtest/gtest.h>
#include <system_settings.h>
#include <vconf.h>

#include <Ecore.h>

#include <cstdlib>
#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
// The value as text, or "<error code>" when the read fails.
std::string getString(system_settings_key_e key)
{
	char *value = nullptr;
	int rc = system_settings_get_value_string(key, &value);
	std::string s = rc == SYSTEM_SETTINGS_ERROR_NONE ? value : "<" + std::to_string(rc) + ">";
	free(value);
	return s;
}

std::string getBool(system_settings_key_e key)
{
	bool value = false;
	int rc = system_settings_get_value_bool(key, &value);
	return rc == SYSTEM_SETTINGS_ERROR_NONE ? (value ? "true" : "false") : "<" + std::to_string(rc) + ">";
}

const std::string kInvalid = "<" + std::to_string(SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER) + ">",
                  kNotSupported = "<" + std::to_string(SYSTEM_SETTINGS_ERROR_NOT_SUPPORTED) + ">";

void changedCb(system_settings_key_e key, void *data)
{
	static_cast<std::vector<int> *>(data)->push_back(key);
}
} // namespace

TEST(SystemSettings, LocaleKeysComeFromVconfWithoutCodesetOthersAreRefused)
{
	ASSERT_EQ(VCONF_OK, vconf_set_str(VCONFKEY_LANGSET, "de_DE.UTF-8"));
	ASSERT_EQ(VCONF_OK, vconf_set_str(VCONFKEY_REGIONFORMAT, "ko_KR.UTF-8"));
	EXPECT_EQ("de_DE", getString(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE));
	EXPECT_EQ("ko_KR", getString(SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY));

	ASSERT_EQ(VCONF_OK, vconf_set_int(VCONFKEY_REGIONFORMAT_TIME1224, VCONFKEY_TIME_FORMAT_12));
	EXPECT_EQ("false", getBool(SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR));
	ASSERT_EQ(SYSTEM_SETTINGS_ERROR_NONE,
	          system_settings_set_value_bool(SYSTEM_SETTINGS_KEY_LOCALE_TIMEFORMAT_24HOUR, true));
	int format = 0;
	ASSERT_EQ(VCONF_OK, vconf_get_int(VCONFKEY_REGIONFORMAT_TIME1224, &format));
	EXPECT_EQ(VCONFKEY_TIME_FORMAT_24, format);

	ASSERT_EQ(VCONF_OK, vconf_set_str(VCONFKEY_SETAPPL_TIMEZONE_ID, "Asia/Seoul"));
	EXPECT_EQ("Asia/Seoul", getString(SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE));
	ASSERT_EQ(VCONF_OK, vconf_unset(VCONFKEY_SETAPPL_TIMEZONE_ID));
	EXPECT_NE("", getString(SYSTEM_SETTINGS_KEY_LOCALE_TIMEZONE)) << "the host's zone";

	ASSERT_EQ(SYSTEM_SETTINGS_ERROR_NONE,
	          system_settings_set_value_string(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE, "fr_FR"));
	char *langset = vconf_get_str(VCONFKEY_LANGSET);
	EXPECT_STREQ("fr_FR.UTF-8", langset);
	free(langset);

	int size = -1;
	ASSERT_EQ(SYSTEM_SETTINGS_ERROR_NONE, system_settings_get_value_int(SYSTEM_SETTINGS_KEY_FONT_SIZE, &size));
	EXPECT_EQ(SYSTEM_SETTINGS_FONT_SIZE_NORMAL, size);
	ASSERT_EQ(VCONF_OK, vconf_set_bool(VCONFKEY_SETAPPL_SOUND_STATUS_BOOL, 1));
	EXPECT_EQ("false", getBool(SYSTEM_SETTINGS_KEY_SOUND_SILENT_MODE));

	// Wrong types and unsupported keys.
	EXPECT_EQ(kInvalid, getString(SYSTEM_SETTINGS_KEY_FONT_SIZE));
	EXPECT_EQ(SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER,
	          system_settings_get_value_int(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE, &size));
	EXPECT_EQ(kInvalid, getString(SYSTEM_SETTINGS_KEY_MAX));
	EXPECT_EQ(kInvalid, getString(static_cast<system_settings_key_e>(-1)));
	EXPECT_EQ(kNotSupported, getString(SYSTEM_SETTINGS_KEY_INCOMING_CALL_RINGTONE));
	EXPECT_EQ(kNotSupported, getBool(SYSTEM_SETTINGS_KEY_LOCK_STATE));
	EXPECT_EQ(SYSTEM_SETTINGS_ERROR_INVALID_PARAMETER, system_settings_set_value_int(SYSTEM_SETTINGS_KEY_FONT_SIZE, 9));
}

TEST(SystemSettings, ChangedCallbackFollowsTheVconfKeyUntilUnset)
{
	ecore_init(); // for the change notices
	std::vector<int> seen;
	ASSERT_EQ(SYSTEM_SETTINGS_ERROR_NONE,
	          system_settings_set_changed_cb(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE, changedCb, &seen));
	ASSERT_EQ(VCONF_OK, vconf_set_str(VCONFKEY_LANGSET, "ko_KR.UTF-8"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.size() == 1; }));
	ASSERT_EQ(SYSTEM_SETTINGS_ERROR_NONE, system_settings_unset_changed_cb(SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE));
	// Notices come in order: the one of the later key marks that the unset one was passed over.
	ASSERT_EQ(SYSTEM_SETTINGS_ERROR_NONE,
	          system_settings_set_changed_cb(SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY, changedCb, &seen));
	ASSERT_EQ(VCONF_OK, vconf_set_str(VCONFKEY_LANGSET, "en_US.UTF-8"));
	ASSERT_EQ(VCONF_OK, vconf_set_str(VCONFKEY_REGIONFORMAT, "en_US.UTF-8"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.size() == 2; }));
	EXPECT_EQ((std::vector<int>{SYSTEM_SETTINGS_KEY_LOCALE_LANGUAGE, SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY}), seen);
	system_settings_unset_changed_cb(SYSTEM_SETTINGS_KEY_LOCALE_COUNTRY);
}
