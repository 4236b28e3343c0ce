// Launch requests to the real memo binary through app_launcher, on one private data root. Each cold start
// shows the page its request asks for, filled from the request; ending the app through the launcher saves
// an open new memo, so memo.db tells what the page held. A running app changes no page for a share, and
// takes text for the quick memo at any time.
#include <gtest/gtest.h>

#include <string>

#include "support/E2e.h"

namespace
{
const std::string OP = "-o http://tizen.org/appcontrol/operation/", SHARE = OP + "share ";
const std::string SHARE_TEXT = OP + "share_text", TEXT = " -d http://tizen.org/appcontrol/data/text ";
const std::string QUICK = OP + "send_text_quickmemo -r" + TEXT;
const std::string LIST = "MemoListView", EDIT = "MemoEditView";
const char *const COUNT = "SELECT count(*) FROM memo";

TEST(LaunchRoutingTest, EachRequestShowsAndFillsItsPage)
{
	memo_test::MemoLaunch app;
	EXPECT_EQ(LIST, app.start(""));
	ASSERT_TRUE(app.end());
	const char *quickState = "SELECT UUID || ' ' || lastModifiedAt FROM memo WHERE isQuick = 1";
	const std::string quick = app.query(quickState), dir = memo_test::makeTempDir("shared");
	memo_test::runCommand("cd '" + dir +
	                      "' && printf 'first\\nsecond & last' >notes.md && cp '" TEST_SOURCE_DIR
	                      "/res/icons/hicolor/16x16/apps/com.veltron.memo.png' Shot.PNG");

	// The request, its first page, a line of its log, and the memo saved when the app ends ("" for none).
	const std::string rows[][4] = {
	    {SHARE_TEXT + " -d http://tizen.org/appcontrol/data/subject 'Salt & pepper'" + TEXT + "'milk & eggs'", EDIT, "",
	     "Salt & pepper|milk & eggs"},
	    {SHARE_TEXT + TEXT + std::string(5000, 'x'), EDIT, "", "|" + std::string(4096, 'x')},
	    {SHARE_TEXT + TEXT + std::string(4096, 'x'), EDIT, "", "|" + std::string(4096, 'x')},
	    {SHARE + "-m text/plain -u 'file://" + dir + "/notes.md'", EDIT, "", "|first\nsecond & last"},
	    {SHARE + "-u 'file://" + dir + "/Shot.PNG'", EDIT, "", "|\n"}, // the picture alone
	    {SHARE + "-u file:///no/file", EDIT, "File open failed.", ""},
	    {SHARE + "-u abc", EDIT, "not a file URI", ""},
	    {"-o widget_new", EDIT, "", ""},
	    {"-o widget_open -d uuid " + quick.substr(0, quick.find(' ')), EDIT, "", ""},
	    {"-o widget_open -d uuid no-such-uuid", EDIT, "", ""},
	    {"-o widget_open", LIST, "", ""},
	};
	for (const auto &row : rows) {
		const std::string count = app.query(COUNT);
		EXPECT_EQ(row[1], app.start(row[0])) << row[0];
		EXPECT_NE(std::string::npos, app.log().find(row[2])) << row[0];
		ASSERT_TRUE(app.end());
		const char *newest = "SELECT title || '|' || content FROM memo WHERE isQuick = 0 ORDER BY _id DESC LIMIT 1";
		EXPECT_EQ(row[3].empty() ? count : row[3], app.query(row[3].empty() ? COUNT : newest)) << row[0];
	}
	// The quick memo was opened read only: nothing of it was written.
	EXPECT_EQ(quick, app.query(quickState));

	// Text for the quick memo on a cold start, then to the running app with another memo open: it goes to
	// the store, each request is answered, and a share changes no page.
	const char *quickContent = "SELECT content FROM memo WHERE isQuick = 1";
	EXPECT_EQ(LIST, app.start(QUICK + "'buy bread'"));
	EXPECT_EQ("buy bread", app.query(quickContent));
	ASSERT_TRUE(app.end());
	const std::string count = app.query(COUNT);
	EXPECT_EQ(EDIT, app.start("-o widget_new"));
	EXPECT_EQ(0, app.send(SHARE_TEXT + TEXT + "'not for this page'"));
	EXPECT_EQ(0, app.send(QUICK + "'call mum'"));
	EXPECT_EQ("buy bread\ncall mum", app.query(quickContent));
	EXPECT_EQ(1u, memo_test::countOf(app.log(), "first page:"));
	ASSERT_TRUE(app.end());
	EXPECT_EQ(count, app.query(COUNT));
}
} // namespace
