// Starts made for one job, in a real X11 window: the process ends when the back key (Escape) closes its
// page. The quick memo open in the editor takes text sent for the quick memo into its page, and the store
// has the text only once the editor saves it. Skipped without Xvfb, openbox and xdotool.
#include <gtest/gtest.h>

#include <string>

#include "support/E2e.h"

TEST(LaunchExitTest, SingleJobStartsEndWithTheirPage)
{
	memo_test::X11Display x11;
	if (!x11.ok)
		GTEST_SKIP() << "Xvfb, openbox and xdotool are needed";
	memo_test::MemoLaunch app(x11.env());
	const std::string window = "search --sync --onlyvisible --classname '^com\\.veltron\\.memo$' ";
	const std::string share = "-o http://tizen.org/appcontrol/operation/share -u file:///no/file";
	for (const std::string &request : {std::string("-o widget_new"), share, std::string("-o widget_open -d uuid ")}) {
		const std::string uuid = app.query("SELECT UUID FROM memo WHERE isQuick = 1");
		EXPECT_EQ("MemoEditView", app.start(request + (request.back() == ' ' ? uuid : "")));
		EXPECT_EQ(0, x11.xdotool(window + "windowactivate --sync key --delay 100 Escape"));
		EXPECT_TRUE(app.waitForLog("> ~MemoApp")) << request;
	}

	// The quick memo, read and then turned into an edit by a tap under its text.
	app.start("-o widget_open -d uuid " + app.query("SELECT UUID FROM memo WHERE isQuick = 1"));
	ASSERT_EQ(0, x11.xdotool(window + "mousemove --window %1 240 700 click 1"));
	EXPECT_EQ(0, app.send("-o http://tizen.org/appcontrol/operation/send_text_quickmemo -r -d "
	                      "http://tizen.org/appcontrol/data/text 'Tom & Jerry' >/dev/null"));
	EXPECT_EQ("", app.query("SELECT content FROM memo WHERE isQuick = 1"));
	ASSERT_TRUE(app.end());
	EXPECT_EQ("Tom & Jerry", app.query("SELECT content FROM memo WHERE isQuick = 1"));
}
