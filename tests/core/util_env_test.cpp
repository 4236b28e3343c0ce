// Environment queries of MemoUtil, driven through the desktop device keys.
#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <string>

#include <app_common.h>
#include <vconf.h>

#include "TestEnv.h"
#include "Util/MemoUtil.h"

namespace
{
const char *kFreeBytes = "db/desktop/storage/internal_free_bytes";

std::string dataLog()
{
	char *path = app_get_data_path();
	std::string log = memo_test::readFile(std::string(path) + "dlog.log");
	free(path);
	return log;
}
} // namespace

TEST(MemoUtilEnv, UuidsAreCanonicalAndFresh)
{
	char *a = nullptr;
	char *b = nullptr;
	ASSERT_TRUE(MemoUtil::createUUIDN(&a));
	ASSERT_TRUE(MemoUtil::createUUIDN(&b));
	ASSERT_EQ(36u, strlen(a));
	for (int dash : {8, 13, 18, 23})
		EXPECT_EQ('-', a[dash]);
	EXPECT_STRNE(a, b);
	free(a);
	free(b);
}

TEST(MemoUtilEnv, FreeSpaceThresholdIs105MiBExclusive)
{
	vconf_set_int(kFreeBytes, 110100480);
	EXPECT_FALSE(MemoUtil::getMemorySpaceStatusGet());
	EXPECT_NE(std::string::npos, dataLog().find("avail : 110100480.000000"));
	vconf_set_int(kFreeBytes, 110100481);
	EXPECT_TRUE(MemoUtil::getMemorySpaceStatusGet());
	vconf_set_str(kFreeBytes, "0");
	EXPECT_FALSE(MemoUtil::getMemorySpaceStatusGet());
	vconf_unset(kFreeBytes);
}

TEST(MemoUtilEnv, SignInIsAskedEveryTime)
{
	// Only the sync account's package counts; a reachable service is needed.
	vconf_set_str("db/desktop/account/list", "com.example.other|someone");
	EXPECT_FALSE(MemoUtil::checkVeltronAccountLogIn());
	vconf_set_str("db/desktop/account/list", "com.example.other|someone;com.veltron.veltronaccount|me");
	EXPECT_TRUE(MemoUtil::checkVeltronAccountLogIn());
	vconf_set_int("db/desktop/account/unavailable", 1);
	EXPECT_FALSE(MemoUtil::checkVeltronAccountLogIn());
	vconf_unset("db/desktop/account/unavailable");
	vconf_unset("db/desktop/account/list");
}

TEST(MemoUtilEnv, CallStatusFollowsTheCallState)
{
	EXPECT_FALSE(MemoUtil::getCallStatus());
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_CONNECTING);
	EXPECT_TRUE(MemoUtil::getCallStatus());
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VIDEO_ACTIVE);
	EXPECT_TRUE(MemoUtil::getCallStatus());
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
	EXPECT_FALSE(MemoUtil::getCallStatus());
}

TEST(MemoUtilEnv, PowerSavingSalesCodeAndFeature)
{
	vconf_unset("db/setting/psmode");
	EXPECT_EQ(0, MemoUtil::isPowerSavingMode());
	vconf_set_int("db/setting/psmode", 2);
	EXPECT_EQ(1, MemoUtil::isPowerSavingMode());
	vconf_set_int("db/setting/psmode", 4);
	EXPECT_EQ(4, MemoUtil::isPowerSavingMode());
	vconf_set_int("db/setting/psmode", 0);

	EXPECT_FALSE(MemoUtil::isSalesCodeKTC());
	vconf_set_str("db/csc/salescode", "KTC");
	EXPECT_TRUE(MemoUtil::isSalesCodeKTC());
	vconf_set_str("db/csc/salescode", "KTCX");
	EXPECT_FALSE(MemoUtil::isSalesCodeKTC());
	vconf_unset("db/csc/salescode");

	EXPECT_TRUE(MemoUtil::isQuickMemoFeatureEnabled());
	vconf_set_int("db/desktop/csc/feature_92", 0);
	EXPECT_FALSE(MemoUtil::isQuickMemoFeatureEnabled());
	vconf_unset("db/desktop/csc/feature_92");
}

TEST(MemoUtilEnv, DateTextFollowsTheClockSetting)
{
	// 2020-01-02 15:04:00 in local time.
	struct tm when = {};
	when.tm_year = 120;
	when.tm_mon = 0;
	when.tm_mday = 2;
	when.tm_hour = 15;
	when.tm_min = 4;
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
