// The memo binary in a real X11 window: a new memo from the widget's request, typed with real key presses,
// then the app asked to end through the launcher; the memo is in memo.db afterwards.
#include <gtest/gtest.h>

#include <string>

#include "support/E2e.h"

TEST(EditorEndToEnd, TypedMemoIsSavedWhenTheLauncherEndsTheApp)
{
	memo_test::X11Display x11;
	if (!x11.ok)
		GTEST_SKIP() << "Xvfb, openbox and xdotool are needed";
	memo_test::MemoLaunch app(x11.env());
	ASSERT_EQ("MemoEditView", app.start("-o widget_new"));
	const std::string window = "search --sync --onlyvisible --classname '^com\\.veltron\\.memo$' ";
	ASSERT_EQ(0, x11.xdotool(window + ">/dev/null"));
	memo_test::pumpFor(1.0);

	// The title field, then the body under it.
	ASSERT_EQ(0,
	          x11.xdotool(window + "mousemove --window %1 150 135 click 1 sleep 0.3 type --delay 30 'Camping trip'"));
	ASSERT_EQ(0,
	          x11.xdotool(window + "mousemove --window %1 150 228 click 1 sleep 0.3 type --delay 30 'pack the tent'"));
	memo_test::pumpFor(0.5);

	ASSERT_TRUE(app.end());
	EXPECT_EQ("Camping trip", app.query("SELECT title FROM memo WHERE isQuick = 0"));
	EXPECT_EQ("pack the tent", app.query("SELECT content FROM memo WHERE isQuick = 0"));
}
