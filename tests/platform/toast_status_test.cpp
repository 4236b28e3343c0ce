// Status messages: recorded always, shown as a toast in the window while there is one, gone after the timeout.
#include <desktop/toast_log.h>
#include <notification_status.h>

#include <Elementary.h>
#include <gtest/gtest.h>

#include <string>

#include "TestEnv.h"

namespace
{
class ToastStatus : public ::testing::Test
{
protected:
	static void SetUpTestSuite() { elm_init(0, nullptr); }
	void SetUp() override { desktop_toast_log_clear(); }
};

TEST_F(ToastStatus, NullMessageIsRejected)
{
	EXPECT_EQ(NOTIFICATION_ERROR_INVALID_PARAMETER, notification_status_message_post(nullptr));
	EXPECT_EQ(0, desktop_toast_log_count());
}

TEST_F(ToastStatus, WithoutWindowOnlyTheRecordRemains)
{
	EXPECT_EQ(NOTIFICATION_ERROR_NONE, notification_status_message_post("Saved"));
	ASSERT_EQ(1, desktop_toast_log_count());
	EXPECT_STREQ("Saved", desktop_toast_log_get(0));
	EXPECT_EQ(nullptr, desktop_toast_log_get(1));
	EXPECT_EQ(nullptr, desktop_toast_log_get(-1));
	EXPECT_EQ(nullptr, desktop_toast_current_get());
}

TEST_F(ToastStatus, ToastShowsInTheWindowAndGoesAfterItsTimeout)
{
	Evas_Object *win = elm_win_add(nullptr, "toast-test", ELM_WIN_BASIC);
	evas_object_resize(win, 480, 800);
	evas_object_show(win);

	ASSERT_EQ(NOTIFICATION_ERROR_NONE, notification_status_message_post("First <b>&"));
	Evas_Object *first = desktop_toast_current_get();
	ASSERT_NE(nullptr, first);
	EXPECT_EQ(win, elm_object_top_widget_get(first));
	char *shown = elm_entry_markup_to_utf8(elm_object_text_get(first));
	EXPECT_STREQ("First <b>&", shown);
	free(shown);

	// A new message replaces the one on screen.
	ASSERT_EQ(NOTIFICATION_ERROR_NONE, notification_status_message_post("Second"));
	Evas_Object *second = desktop_toast_current_get();
	ASSERT_NE(nullptr, second);
	EXPECT_NE(first, second);
	EXPECT_EQ(2, desktop_toast_log_count());
	EXPECT_STREQ("Second", desktop_toast_log_get(1));

	EXPECT_TRUE(memo_test::pump(10.0, [] { return desktop_toast_current_get() == nullptr; }));
	evas_object_del(win);
}
} // namespace
