// Environment queries of MemoUtil, driven through the desktop device keys.
#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <functional>
#include <string>

#include <vconf.h>

#include "Util/MemoUtil.h"

// Each query reads its device key at the time of asking; unset keys give the normal device.
TEST(MemoUtilEnv, QueriesFollowTheDeviceKeys)
{
	const char *kFree = "db/desktop/storage/internal_free_bytes", *kAccounts = "db/desktop/account/list";
	struct {
		const char *key;
		int intValue;
		const char *strValue;
		std::function<int()> query;
		int expected;
	} cases[] = {
	    // Free space must exceed 105 MiB.
	    {kFree, 110100480, nullptr, MemoUtil::getMemorySpaceStatusGet, 0},
	    {kFree, 110100481, nullptr, MemoUtil::getMemorySpaceStatusGet, 1},
	    {kFree, 0, "0", MemoUtil::getMemorySpaceStatusGet, 0},
	    // Only the sync account's package counts, and only with a reachable service.
	    {kAccounts, 0, "com.example.other|someone", MemoUtil::checkVeltronAccountLogIn, 0},
	    {kAccounts, 0, "com.example.other|someone;com.veltron.veltronaccount|me", MemoUtil::checkVeltronAccountLogIn,
	     1},
	    {"db/desktop/account/unavailable", 1, nullptr, MemoUtil::checkVeltronAccountLogIn, 0},
	    {VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF, nullptr, MemoUtil::getCallStatus, 0},
	    {VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_CONNECTING, nullptr, MemoUtil::getCallStatus, 1},
	    {VCONFKEY_CALL_STATE, VCONFKEY_CALL_VIDEO_ACTIVE, nullptr, MemoUtil::getCallStatus, 1},
	    {"db/setting/psmode", 0, nullptr, MemoUtil::isPowerSavingMode, 0},
	    {"db/setting/psmode", 2, nullptr, MemoUtil::isPowerSavingMode, 1},
	    {"db/setting/psmode", 4, nullptr, MemoUtil::isPowerSavingMode, 4},
	    {"db/csc/salescode", 0, "KTC", MemoUtil::isSalesCodeKTC, 1},
	    {"db/csc/salescode", 0, "KTCX", MemoUtil::isSalesCodeKTC, 0},
	    {"db/desktop/csc/feature_92", 0, nullptr, MemoUtil::isQuickMemoFeatureEnabled, 0},
	};
	EXPECT_FALSE(MemoUtil::getCallStatus());
	EXPECT_EQ(0, MemoUtil::isPowerSavingMode());
	EXPECT_FALSE(MemoUtil::isSalesCodeKTC());
	EXPECT_TRUE(MemoUtil::isQuickMemoFeatureEnabled());
	for (const auto &c : cases) {
		if (c.strValue)
			vconf_set_str(c.key, c.strValue);
		else
			vconf_set_int(c.key, c.intValue);
		EXPECT_EQ(c.expected, c.query()) << c.key << " = " << (c.strValue ? c.strValue : std::to_string(c.intValue));
	}
	for (const auto &c : cases)
		vconf_unset(c.key);
}

TEST(MemoUtilEnv, DateTextFollowsTheClockSetting)
{
	struct tm when = {};
	strptime("2020-01-02 15:04", "%Y-%m-%d %H:%M", &when);
	when.tm_isdst = -1;
	time_t seconds = mktime(&when);
	vconf_set_str(VCONFKEY_REGIONFORMAT, "en_US");

	vconf_set_int(VCONFKEY_REGIONFORMAT_TIME1224, 2);
	char *text24 = MemoUtil::getDateTimeTextN(seconds);
	ASSERT_NE(nullptr, text24);
	EXPECT_NE(nullptr, strstr(text24, "15"));
	free(text24);

	vconf_set_int(VCONFKEY_REGIONFORMAT_TIME1224, 1);
	char *text12 = MemoUtil::getDateTimeTextN(seconds);
	ASSERT_NE(nullptr, text12);
	EXPECT_EQ(nullptr, strstr(text12, "15"));
	EXPECT_NE(nullptr, strstr(text12, "3"));
	free(text12);
}
