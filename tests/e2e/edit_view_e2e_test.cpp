// The memo binary in real X11 windows, started by launch requests. A new memo from the widget's request,
// typed with real key presses, is in memo.db once the launcher has ended the app. A start made for one job
// ends when the back key (Escape) closes its page. The quick memo open in the editor takes text sent for
// the quick memo into its page, and the store has the text only once the editor saves it. Skipped without
// Xvfb, openbox and xdotool.
#include <gtest/gtest.h>

#include <string>

#include "support/E2e.h"

TEST(EditorEndToEnd, TypedMemoIsSavedSingleJobStartsEndWithTheirPageQuickMemoTextReachesTheOpenEditor)
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

	const std::string quick = "-o widget_open -d uuid " + app.query("SELECT UUID FROM memo WHERE isQuick = 1");
	for (const char *request :
	     {"-o widget_new", "-o http://tizen.org/appcontrol/operation/share -u file:///no/file", quick.c_str()}) {
		EXPECT_EQ("MemoEditView", app.start(request));
		EXPECT_EQ(0, x11.xdotool(window + "windowactivate --sync key --delay 100 Escape"));
		EXPECT_TRUE(app.waitForLog("> ~MemoApp")) << request;
	}

	// The quick memo, read and then turned into an edit by a tap under its text.
	// The page may still be laying itself out when the window shows: tap until it answers.
	app.start(quick);
	bool editing = false;
	for (int tap = 0; tap < 5 && !editing; ++tap) {
		ASSERT_EQ(0, x11.xdotool(window + "mousemove --window %1 240 700 click 1"));
		editing =
		    memo_test::pump(3.0, [&] { return app.log().find("read view turned into an edit") != std::string::npos; });
	}
	ASSERT_TRUE(editing);
	EXPECT_EQ(0, app.send("-o http://tizen.org/appcontrol/operation/send_text_quickmemo -r -d "
	                      "http://tizen.org/appcontrol/data/text 'Tom & Jerry' >/dev/null"));
	EXPECT_EQ("", app.query("SELECT content FROM memo WHERE isQuick = 1"));
	ASSERT_TRUE(app.end());
	EXPECT_EQ("Tom & Jerry", app.query("SELECT content FROM memo WHERE isQuick = 1"));
}
