#include <dlog.h>
#include <gtest/gtest.h>
TEST(Dlog, InvalidArguments)
{
	EXPECT_EQ(DLOG_ERROR_INVALID_PARAMETER, __dlog_print(LOG_ID_MAX, DLOG_INFO, "T", "x"));
}
