// Launch requests to the real memo binary through app_launcher, on one private data root. Each cold start
// shows the page its request asks for, filled from the request; ending the app through the launcher saves
// an open new memo, so memo.db tells what the page held. A running app changes no page for a share, and
// takes text for the quick memo at any time.
#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "support/MemoLaunch.h"
#include "TestEnv.h"

namespace
{
const std::string OP = "-o http://tizen.org/appcontrol/operation/";
const std::string TEXT = " -d http://tizen.org/appcontrol/data/text ";
const std::string QUICK = OP + "send_text_quickmemo -r" + TEXT;
const char *const NEWEST = "SELECT title || '|' || content FROM memo WHERE isQuick = 0 ORDER BY _id DESC LIMIT 1";
const char *const QUICK_CONTENT = "SELECT content FROM memo WHERE isQuick = 1";
const char *const LIST = memo_test::LIST_PAGE;

TEST(LaunchRoutingTest, ColdStartsShowAndFillTheirPage)
{
	memo_test::MemoLaunch app;
	EXPECT_EQ(LIST, app.start(""));
	ASSERT_TRUE(app.end());

	EXPECT_EQ("MemoEditView", app.start(OP + "share_text -d http://tizen.org/appcontrol/data/subject 'Salt & pepper'" +
	                                    TEXT + "'milk & eggs'"));
	ASSERT_TRUE(app.end());
	EXPECT_EQ("Salt & pepper|milk & eggs", app.query(NEWEST));
	const std::string saved = app.query("SELECT UUID || ' ' || lastModifiedAt FROM memo WHERE _id = 2");

	for (size_t length : {5000, 4096}) {
		app.start(OP + "share_text" + TEXT + std::string(length, 'x'));
		ASSERT_TRUE(app.end());
		EXPECT_EQ("4096", app.query("SELECT length(content) FROM memo ORDER BY _id DESC LIMIT 1"));
	}

	const std::string notes = memo_test::makeTempDir("shared") + "/notes.md";
	memo_test::runCommand("printf 'first\\nsecond & last' > '" + notes + "'");
	app.start(OP + "share -m text/plain -u 'file://" + notes + "'");
	ASSERT_TRUE(app.end());
	EXPECT_EQ("|first\nsecond & last", app.query(NEWEST));

	// A picture goes in as a picture; a missing file and a URI that is no file URI give an empty memo.
	const std::string count = app.query("SELECT count(*) FROM memo");
	const std::string picture = memo_test::makeTempDir("picture") + "/Shot.PNG";
	memo_test::runCommand("cp '" TEST_SOURCE_DIR "/res/icons/hicolor/16x16/apps/com.veltron.memo.png' '" + picture +
	                      "'");
	const std::pair<std::string, std::string> shares[] = {
	    {"file://" + picture, "image " + picture}, {"file:///no/file", "File open failed."}, {"abc", "not a file URI"}};
	for (const auto &share : shares) {
		EXPECT_EQ("MemoEditView", app.start(OP + "share -u '" + share.first + "'"));
		EXPECT_NE(std::string::npos, app.log().find(share.second)) << share.first;
		ASSERT_TRUE(app.end());
	}
	EXPECT_EQ(count, app.query("SELECT count(*) FROM memo"));

	// The widget: a new memo, a stored one read only (nothing written at the end), an unknown one empty.
	EXPECT_EQ("MemoEditView", app.start("-o widget_new"));
	ASSERT_TRUE(app.end());
	for (const std::string &uuid : {saved.substr(0, saved.find(' ')), std::string("no-such-uuid")}) {
		EXPECT_EQ("MemoEditView", app.start("-o widget_open -d uuid " + uuid));
		ASSERT_TRUE(app.end());
	}
	EXPECT_EQ(count, app.query("SELECT count(*) FROM memo"));
	EXPECT_EQ(saved, app.query("SELECT UUID || ' ' || lastModifiedAt FROM memo WHERE _id = 2"));
	EXPECT_EQ(LIST, app.start("-o widget_open"));
	ASSERT_TRUE(app.end());
}

TEST(LaunchRoutingTest, RunningAppKeepsItsPageAndTakesQuickMemoText)
{
	memo_test::MemoLaunch app;
	std::string reply;
	EXPECT_EQ(LIST, app.start(QUICK + "'buy bread'", &reply));
	EXPECT_NE(std::string::npos, reply.find("result=succeeded"));
	EXPECT_EQ("buy bread", app.query(QUICK_CONTENT));
	ASSERT_TRUE(app.end());

	// With another memo open the text goes to the store and the editor stays as it was.
	EXPECT_EQ("MemoEditView", app.start("-o widget_new"));
	EXPECT_EQ(0, app.send(OP + "share_text" + TEXT + "'not for this page'"));
	EXPECT_EQ(0, app.send(QUICK + "'call mum'"));
	EXPECT_EQ("buy bread\ncall mum", app.query(QUICK_CONTENT));
	EXPECT_EQ(1u, memo_test::countOf(app.log(), "first page:"));
	ASSERT_TRUE(app.end());
	EXPECT_EQ("1", app.query("SELECT count(*) FROM memo"));
}
} // namespace
