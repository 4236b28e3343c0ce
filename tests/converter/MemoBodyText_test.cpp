// The saved markup of an item and the share texts made from display text.
#include "Box/MemoContentMarkup.h"
#include "Box/MemoShareText.h"
#include "Box/MemoTodoListDocument.h"
#include "Util/MemoUtil.h"
#include "todolist_fixture.h"

#include <Elementary.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

namespace
{
std::string saved(const char *markup)
{
	char *out = memoSavedMarkupN(markup);
	std::string result = out ? out : "(null)";
	free(out);
	return result;
}

class ShareText : public ::testing::Test
{
protected:
	// The markup conversion needs Evas only; a full Elementary start is not needed.
	static void SetUpTestSuite() { evas_init(); }
	static void TearDownTestSuite() { evas_shutdown(); }
};
} // namespace

TEST(SavedMarkup, RemovesFormatTagsOnly)
{
	const char *kept = "a &amp; b<br/><item size=240x180 vsize=full href=file:///m/a.jpg></item><br/>"
	                   "<font_size=20>f</font_size><b>b</b>";
	const char *cases[][2] = {
	    {"<color=#ff0000>red</color> bold", "red bold"},
	    {"<align=left>left</align>", "left"},
	    // "<u..." goes, its closing tag stays: the pass looks at the first letter only.
	    {"<underline=on>x</underline>", "x</underline>"},
	    {"<u>x</u>", "x</u>"},
	    {kept, kept},
	    // A "<" with fewer than two characters behind it ends the pass.
	    {"abc<", "abc"},
	    {"abc<x", "abc"},
	    {"abc<x<color>def", "abc<xdef"},
	    {"abc<br", "abc<br"},
	    // An unclosed format tag runs to the end.
	    {"abc<color=#fff", "abc"},
	    {"", ""},
	    {nullptr, ""},
	};
	for (const auto &c : cases)
		EXPECT_EQ(c[1], saved(c[0])) << (c[0] ? c[0] : "(null)");
}

TEST_F(ShareText, EditShareListShareAndPickText)
{
	// Each view keeps its own table of markers.
	const std::string display = "top\n<CHECK state=false>a</CHECK><CHECK state=true>b</CHECK>end";
	EXPECT_EQ("top\n[  ]a\n[v]b\nend", memoApplyEditShareMarkers(display));
	EXPECT_EQ("top\n[ ]a\n[V]b\nend", memoApplyListShareMarkers(display));
	EXPECT_EQ("<CHECK state=maybe>", memoApplyListShareMarkers("<CHECK state=maybe>"));

	using todolist_test::item;
	const std::string doc = todolist_test::compose(
	    {item(MEMO_BOX_ITEM_FIRST_TEXT, false,
	          "Fish &amp; chips&lt;3<br/><item size=240x180 vsize=full href=file:///m/a.jpg></item><br/>x"),
	     item(MEMO_BOX_ITEM_CHECK, true, "milk"), item(MEMO_BOX_ITEM_CHECK, false, "eggs")});
	const std::string text = memoComposeEditShareText("Title", doc.c_str(), "ignored");
	EXPECT_EQ("Title\nFish & chips\xEF\xBC\x9C"
	          "3\n\nx\n[v]milk\n[  ]eggs\n",
	          text);

	// Without a document the display content is shared, cut like a document.
	EXPECT_EQ("[  ]ab\n", memoComposeEditShareText("", "",
	                                               "<CHECK state=false>a\xC2\xA0"
	                                               "b</CHECK>"));
	EXPECT_EQ("T\n", memoComposeEditShareText("T", nullptr, nullptr));
	EXPECT_EQ("", memoComposeEditShareText(nullptr, nullptr, nullptr));
	const std::string longText(50000, 'a');
	EXPECT_EQ(40959u, memoComposeEditShareText(nullptr, nullptr, longText.c_str()).size());

	// A pick gives the title, and the display text only with a document.
	EXPECT_EQ("T\n[V]a\n[ ]b\n",
	          memoComposePickText("T", "<todolist>...", "<CHECK state=true>a</CHECK><CHECK state=false>b</CHECK>"));
	// A memo without a document contributes only its title.
	EXPECT_EQ("T\n", memoComposePickText("T", "", "stale"));
	EXPECT_EQ("body", memoComposePickText("", "<todolist>", "body"));
	EXPECT_EQ("", memoComposePickText(nullptr, nullptr, nullptr));
}

TEST(StorableText, ControlCharactersGoAndLineEndsStay)
{
	// What a share or another application hands in: the text must fit a stored document.
	char *text = MemoUtil::stripControlCharsN("a\x01"
	                                          "b\tc\r\nd\re\x7f\xEF\xBF\xBF\xC3\xA9\xFF\x1b");
	EXPECT_STREQ("ab\tc\nd\ne\x7f\xC3\xA9", text);
	free(text);
	EXPECT_EQ(nullptr, MemoUtil::stripControlCharsN(nullptr));
}
