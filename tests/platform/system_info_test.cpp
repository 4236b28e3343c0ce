// Platform features of the desktop device and the feedback calls' state checks.
#include <feedback.h>
#include <gtest/gtest.h>
#include <system_info.h>

#include <cstdlib>
#include <string>

namespace
{
const std::string kFeature = "http://tizen.org/feature/";

// The value, or -1 with the error code in *rc.
int featureInt(const std::string &name, int *rc = nullptr)
{
	int value = -1, r = system_info_get_platform_int((kFeature + name).c_str(), &value);
	if (rc)
		*rc = r;
	return r == SYSTEM_INFO_ERROR_NONE ? value : -1;
}
} // namespace

TEST(SystemInfo, PhoneProfileWithOverridesAndStrictKeys)
{
	// The profile's values are a table; its reading is what matters here.
	EXPECT_EQ(720, featureInt("screen.width"));
	bool large = true;
	ASSERT_EQ(SYSTEM_INFO_ERROR_NONE, system_info_get_platform_bool((kFeature + "screen.size.large").c_str(), &large));
	EXPECT_FALSE(large);
	char *version = nullptr;

	int rc = 0;
	setenv("TIZEN_SYSTEM_INFO_SCREEN_WIDTH", "1080", 1);
	EXPECT_EQ(1080, featureInt("screen.width"));
	setenv("TIZEN_SYSTEM_INFO_SCREEN_WIDTH", "wide", 1);
	featureInt("screen.width", &rc);
	EXPECT_EQ(SYSTEM_INFO_ERROR_IO_ERROR, rc);
	unsetenv("TIZEN_SYSTEM_INFO_SCREEN_WIDTH");

	// An unknown key, or a key read as another type.
	for (const char *name : {"screen.depth", "platform.version"}) {
		featureInt(name, &rc);
		EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER, rc) << name;
	}
	EXPECT_EQ(SYSTEM_INFO_ERROR_INVALID_PARAMETER,
	          system_info_get_platform_string((kFeature + "screen.width").c_str(), &version));
}

TEST(Feedback, PlayNeedsInitialize)
{
	EXPECT_EQ(FEEDBACK_ERROR_NOT_INITIALIZED, feedback_play(FEEDBACK_PATTERN_TAP));
	EXPECT_EQ(FEEDBACK_ERROR_NOT_INITIALIZED, feedback_deinitialize());
	ASSERT_EQ(FEEDBACK_ERROR_NONE, feedback_initialize());
	EXPECT_EQ(FEEDBACK_ERROR_NONE, feedback_play(FEEDBACK_PATTERN_TAP));
	EXPECT_EQ(FEEDBACK_ERROR_INVALID_PARAMETER, feedback_play(FEEDBACK_PATTERN_END));
	ASSERT_EQ(FEEDBACK_ERROR_NONE, feedback_deinitialize());
	EXPECT_EQ(FEEDBACK_ERROR_NOT_INITIALIZED, feedback_play(FEEDBACK_PATTERN_TAP));
}
