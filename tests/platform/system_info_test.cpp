// Platform features of the desktop device, and the feedback calls' state checks.
#include <feedback.h>
#include <gtest/gtest.h>
#include <system_info.h>

#include <cstdlib>

TEST(SystemInfo, PhoneProfileWithOverridesAndStrictKeys)
{
	int width = 0, height = 0, dpi = 0;
	ASSERT_EQ(SYSTEM_INFO_ERROR_NONE, system_info_get_platform_int("http://tizen.org/feature/screen.width", &width));
	ASSERT_EQ(SYSTEM_INFO_ERROR_NONE, system_info_get_platform_int("http://tizen.org/feature/screen.height", &height));
	ASSERT_EQ(SYSTEM_INFO_ERROR_NONE, system_info_get_platform_int("http://tizen.org/feature/screen.dpi", &dpi));
	EXPECT_EQ(720, width);
	EXPECT_EQ(1280, height);
	EXPECT_EQ(320, dpi);
	char *version = nullptr;
	ASSERT_EQ(SYSTEM_INFO_ERROR_NONE,
	          system_info_get_platform_string("http://tizen.org/feature/platform.version", &version));
	EXPECT_STREQ("2.4.0", version);
	free(version);
	bool large = true;
	ASSERT_EQ(SYSTEM_INFO_ERROR_NONE,
	          system_info_get_platform_bool("http://tizen.org/feature/screen.size.large", &large));
	EXPECT_FALSE(large);

	setenv("TIZEN_SYSTEM_INFO_SCREEN_WIDTH", "1080", 1);
	ASSERT_EQ(SYSTEM_INFO_ERROR_NONE, system_info_get_platform_int("http://tizen.org/feature/screen.width", &width));
	EXPECT_EQ(1080, width);
	setenv("TIZEN_SYSTEM_INFO_SCREEN_WIDTH", "wide", 1);
	EXPECT_EQ(SYSTEM_INFO_ERROR_IO_ERROR,
	          system_info_get_platform_int("http://tizen.org/feature/screen.width", &width));
	unsetenv("TIZEN_SYSTEM_INFO_SCREEN_WIDTH");

	EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER,
	          system_info_get_platform_int("http://tizen.org/feature/screen.depth", &width));
	EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER,
	          system_info_get_platform_int("http://tizen.org/feature/platform.version", &width));
	EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER,
	          system_info_get_platform_string("http://tizen.org/feature/screen.width", &version));
	EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER, system_info_get_platform_int(nullptr, &width));
	EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER,
	          system_info_get_platform_int("http://tizen.org/feature/screen.width", nullptr));
	EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER, system_info_get_platform_bool(nullptr, nullptr));
}

TEST(Feedback, PlayNeedsInitialize)
{
	EXPECT_EQ(static_cast<int>(TIZEN_ERROR_SYSTEM_CLASS | 0x52), FEEDBACK_ERROR_NOT_INITIALIZED);
	EXPECT_EQ(FEEDBACK_ERROR_NOT_INITIALIZED, feedback_play(FEEDBACK_PATTERN_TAP));
	EXPECT_EQ(FEEDBACK_ERROR_NOT_INITIALIZED, feedback_deinitialize());
	ASSERT_EQ(FEEDBACK_ERROR_NONE, feedback_initialize());
	EXPECT_EQ(FEEDBACK_ERROR_NONE, feedback_play(FEEDBACK_PATTERN_TAP));
	EXPECT_EQ(FEEDBACK_ERROR_INVALID_PARAMETER, feedback_play(FEEDBACK_PATTERN_END));
	EXPECT_EQ(FEEDBACK_ERROR_INVALID_PARAMETER,
	          feedback_is_supported_pattern(FEEDBACK_TYPE_SOUND, FEEDBACK_PATTERN_TAP, nullptr));
	ASSERT_EQ(FEEDBACK_ERROR_NONE, feedback_deinitialize());
	EXPECT_EQ(FEEDBACK_ERROR_NOT_INITIALIZED, feedback_play(FEEDBACK_PATTERN_TAP));
}
