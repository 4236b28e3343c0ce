// Status messages: recorded always, shown as a toast in the window while there is one, gone on its timeout.
#include <desktop/toast_log.h>
#include <notification_status.h>

#include <Elementary.h>
#include <gtest/gtest.h>

#include "TestEnv.h"

TEST(ToastStatus, RecordedAlwaysShownInTheWindowWhileThereIsOne)
{
	memo_test::initElementary();
	EXPECT_EQ(NOTIFICATION_ERROR_NONE, notification_status_message_post("Saved"));
	ASSERT_EQ(1, desktop_toast_log_count());
	EXPECT_STREQ("Saved", desktop_toast_log_get(0));
	EXPECT_EQ(nullptr, desktop_toast_log_get(1));
	EXPECT_EQ(nullptr, desktop_toast_current_get()) << "no window, no toast";

	Evas_Object *win = memo_test::addShownWindow("toast-test");
	ASSERT_EQ(NOTIFICATION_ERROR_NONE, notification_status_message_post("First <b>&"));
	Evas_Object *first = desktop_toast_current_get();
	ASSERT_NE(nullptr, first);
	EXPECT_EQ(win, elm_object_top_widget_get(first));
	char *shown = elm_entry_markup_to_utf8(elm_object_text_get(first));
	EXPECT_STREQ("First <b>&", shown);
	free(shown);

	// A new message replaces the one on screen, which goes when its timeout comes.
	ASSERT_EQ(NOTIFICATION_ERROR_NONE, notification_status_message_post("Second"));
	Evas_Object *second = desktop_toast_current_get();
	ASSERT_NE(nullptr, second);
	EXPECT_NE(first, second);
	EXPECT_EQ(3, desktop_toast_log_count());
	EXPECT_STREQ("Second", desktop_toast_log_get(2));
	EXPECT_GT(elm_popup_timeout_get(second), 0.0);
	evas_object_smart_callback_call(second, "timeout", nullptr);
	EXPECT_TRUE(memo_test::pump(1.0, [] { return desktop_toast_current_get() == nullptr; }));
	evas_object_del(win);
}
