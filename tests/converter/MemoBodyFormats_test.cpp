// The widget-free body formats: the todolist document as the editor writes and reads it, the converter's
// stored forms, the saved markup of an item, share and pick texts, and text made fit for storing. The
// quick memo append is checked through the store, malformed documents by the fuzz target.
#include "Box/MemoContentMarkup.h"
#include "Box/MemoShareText.h"
#include "Box/MemoTodoListDocument.h"
#include "MemoCvt.h"
#include "Util/MemoUtil.h"
#include "XmlWriteFailure.h"

#include <Elementary.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

namespace
{
MemoTodoListItem item(_MemoBoxItemType type, bool checked, const std::string &content)
{
	MemoTodoListItem i;
	i.type = type;
	i.checked = checked;
	i.content = content;
	return i;
}

std::string compose(const std::vector<MemoTodoListItem> &items)
{
	char *xml = memoComposeTodoListXmlN(items);
	std::string result = xml;
	free(xml);
	return result;
}

std::vector<MemoTodoListItem> parse(const std::string &xml, bool *ok = nullptr, size_t existing = 0)
{
	std::vector<MemoTodoListItem> items;
	const bool result = memoParseTodoListXml(xml.c_str(), items, existing);
	if (ok)
		*ok = result;
	return items;
}

const std::string MIXED = compose({
    item(MEMO_BOX_ITEM_FIRST_TEXT, false,
         "Tom &amp; Jerry &lt;3<br/>line2<br/><item size=240x180 vsize=full href=file:///m/a b.jpg></item><br/>tail"),
    item(MEMO_BOX_ITEM_CHECK, true, "milk &amp; eggs"),
    item(MEMO_BOX_ITEM_CHECK, false, "bread<br/>butter"),
    item(MEMO_BOX_ITEM_TEXT, false, "bye"),
});

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

TEST(MemoCvtForms, EveryFormOfAMixedMemo)
{
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, MIXED);
	EXPECT_EQ("Tom & Jerry \xEF\xBC\x9C"
	          "3\nline2\n\ntail\n<CHECK state=true>milk & eggs</CHECK><CHECK state=false>bread butter</CHECK>bye",
	          cvt.getDisplayContent());
	EXPECT_EQ("Tom & Jerry <3\nline2\n\ntail\nmilk & eggs\nbread\nbutter\nbye", cvt.getStrippedContent());
	EXPECT_EQ("Tom & Jerry <3\nline2\n\ntail\n[x] milk & eggs\n[ ] bread butter\nbye", cvt.getContent());
	// The document of an unchanged body is the editor's own document, byte for byte. Other programs read
	// the exchange document, so it is compared byte for byte as well.
	EXPECT_EQ(MIXED, cvt.getTizenXmlContent());
	EXPECT_EQ("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<memo version=\"1\">\n"
	          "<item type=\"text\" checked=\"false\">Tom &amp; Jerry &lt;3<br/>line2<br/>"
	          "<image href=\"/m/a b.jpg\" width=\"240\" height=\"180\"/><br/>tail</item>\n"
	          "<item type=\"check\" checked=\"true\">milk &amp; eggs</item>\n"
	          "<item type=\"check\" checked=\"false\">bread<br/>butter</item>\n"
	          "<item type=\"text\" checked=\"false\">bye</item>\n</memo>\n",
	          cvt.getXmlContent());

	// An empty body, a root without items included, gives empty forms.
	for (const char *source : {"", "<todolist></todolist>"}) {
		MemoCvt empty(MEMO_CVT_SRC_TODOLIST, source);
		EXPECT_EQ("", empty.getContent() + empty.getDisplayContent() + empty.getStrippedContent() +
		                  empty.getTizenXmlContent());
		EXPECT_NE(std::string::npos, empty.getXmlContent().find("<memo version=\"1\"/>")) << empty.getXmlContent();
	}
}

// Malformed documents are the fuzz target's: its corpus holds the known ones, each checked for valid text
// and well-formed documents on every fuzz run.
TEST(MemoCvtRobustness, HugeItemGivesEveryForm)
{
	// An item bigger than the editor ever stores, so made by hand.
	const std::string big(2 * 1024 * 1024, 'w');
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, "<todolist><todolist_item todo_item_type=\"0\" todo_item_content=\"" + big +
	                                       "&amp;amp;&lt;br/&gt;\"/></todolist>");
	EXPECT_TRUE(cvt.getStrippedContent() == big + "&\n"); // not EXPECT_EQ: no 2 MB failure text
	EXPECT_EQ(big.size() + 2, cvt.getContent().size());
	EXPECT_GT(cvt.getTizenXmlContent().size(), big.size());
}

TEST(TodoListWriter, LayoutAndEscaping)
{
	const std::string xml =
	    compose({item(MEMO_BOX_ITEM_FIRST_CHECK, true, "a &amp; b<br/>c"), item(MEMO_BOX_ITEM_TEXT, true, "x \"q\""),
	             item(MEMO_BOX_ITEM_QUICK_TEXT, false, "q")});
	EXPECT_EQ("<todolist>\n"
	          "<todolist_item todo_item_type=\"1\" todo_item_state=\"true\" "
	          "todo_item_content=\"a &amp;amp; b&lt;br/&gt;c\"/>\n"
	          "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"x &quot;q&quot;\"/>\n"
	          "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"q\"/>\n"
	          "</todolist>\n",
	          xml);
	EXPECT_EQ("", compose({}));
	// A failed write gives no document at all rather than an empty one.
	{
		memo_test::XmlWriteFailure failure;
		EXPECT_EQ(nullptr, memoComposeTodoListXmlN({item(MEMO_BOX_ITEM_TEXT, false, "x")}));
	}
	// Empty items are skipped, a ticked one included: its tick is lost.
	EXPECT_EQ("", compose({item(MEMO_BOX_ITEM_FIRST_CHECK, true, ""), item(MEMO_BOX_ITEM_TEXT, false, "")}));
}

TEST(TodoListWriter, LongDocumentIsCutAndReaderKeepsItemsBeforeTheCut)
{
	std::vector<MemoTodoListItem> items;
	for (int i = 0; i < 60; ++i)
		items.push_back(item(i == 0 ? MEMO_BOX_ITEM_FIRST_TEXT : MEMO_BOX_ITEM_TEXT, false,
		                     "item " + std::to_string(i) + " " + std::string(1000, 'x')));
	const std::string xml = compose(items);
	ASSERT_EQ(40959u, xml.size());
	EXPECT_EQ(std::string::npos, xml.find("</todolist>"));

	bool ok = false;
	const std::vector<MemoTodoListItem> back = parse(xml, &ok);
	EXPECT_TRUE(ok);
	// Each item takes a little over 1000 bytes, so about 39 survive whole.
	ASSERT_GE(back.size(), 30u);
	ASSERT_LT(back.size(), 60u);
	for (size_t i = 0; i < back.size(); ++i)
		EXPECT_EQ(items[i].content, back[i].content) << i;
}

TEST(TodoListRoundTrip, ContentTypesStatesAndTheFirstItem)
{
	const std::vector<MemoTodoListItem> items = {
	    item(MEMO_BOX_ITEM_FIRST_TEXT, false,
	         "Tom &amp; Jerry &lt;3 &gt;<br/><item size=240x180 vsize=full href=file:///data/media/U/a "
	         "b.jpg></item><br/>end"),
	    item(MEMO_BOX_ITEM_CHECK, true, "done &amp; dusted"),
	    item(MEMO_BOX_ITEM_CHECK, false, "open<br/>pasted"),
	    item(MEMO_BOX_ITEM_TEXT, false, "\xE2\x9C\x93 \"quoted\" 'single'"),
	};
	bool ok = false;
	std::vector<MemoTodoListItem> back = parse(compose(items), &ok);
	EXPECT_TRUE(ok);
	ASSERT_EQ(items.size(), back.size());
	for (size_t i = 0; i < items.size(); ++i) {
		EXPECT_EQ(items[i].type, back[i].type) << i;
		EXPECT_EQ(items[i].checked, back[i].checked) << i;
		EXPECT_EQ(items[i].content, back[i].content) << i;
	}

	// The empty head is dropped at save, so the check item behind it comes back first.
	back = parse(compose({item(MEMO_BOX_ITEM_FIRST_TEXT, false, ""), item(MEMO_BOX_ITEM_CHECK, true, "a"),
	                      item(MEMO_BOX_ITEM_TEXT, false, "b")}));
	ASSERT_EQ(2u, back.size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, back[0].type);
	EXPECT_TRUE(back[0].checked);
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, back[1].type);
	// Items read behind existing body items are never first.
	back = parse(compose({item(MEMO_BOX_ITEM_FIRST_TEXT, false, "x")}), nullptr, 1);
	ASSERT_EQ(1u, back.size());
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, back[0].type);
}

TEST(TodoListReader, StatedSlipsAndDocumentsWithoutItems)
{
	const std::string xml =
	    "<todolist>\n"
	    "<todolist_item todo_item_type=\"2\" todo_item_state=\"false\" todo_item_content=\"gone\"/>\n"
	    "<todolist_item todo_item_type=\"1\" todo_item_state=\"TRUE\" todo_item_content=\"a\"/>\n"
	    "<todolist_item todo_item_type=\"1\" todo_item_content=\"b\"/>\n"
	    "<todolist_item todo_item_type=\"1\" todo_item_state=\"false\" todo_item_content=\"c\"/>\n"
	    "<todolist_item todo_item_state=\"false\" todo_item_content=\"no type\"/>\n"
	    "<todolist_item todo_item_type=\"0\" todo_item_state=\"true\"/>\n"
	    "</todolist>\n";
	const std::vector<MemoTodoListItem> back = parse(xml);
	ASSERT_EQ(4u, back.size());
	// Type "2" made nothing, so "a" is the first item; "TRUE" and a missing state tick.
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, back[0].type);
	EXPECT_TRUE(back[0].checked);
	EXPECT_TRUE(back[1].checked);
	EXPECT_FALSE(back[2].checked);
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, back[3].type);
	EXPECT_FALSE(back[3].checked);
	EXPECT_EQ("", back[3].content);

	// A root without items gives none; an unreadable document gives one empty first item.
	bool ok = false;
	EXPECT_TRUE(parse("<todolist></todolist>", &ok).empty());
	EXPECT_TRUE(ok);
	EXPECT_TRUE(parse("<todolist/>", &ok).empty());
	EXPECT_TRUE(ok);
	// A written-out item is read once, not again at its closing tag.
	EXPECT_EQ(1u, parse("<todolist><todolist_item todo_item_type=\"0\" todo_item_content=\"x\"></todolist_item>"
	                    "</todolist>")
	                  .size());

	for (const char *bad : {"", "not xml", "<"}) {
		const std::vector<MemoTodoListItem> empty = parse(bad, &ok);
		EXPECT_FALSE(ok) << bad;
		ASSERT_EQ(1u, empty.size()) << bad;
		EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, empty[0].type);
		EXPECT_EQ("", empty[0].content);
	}
}

TEST(TodoListReader, ErrorAfterFirstNodeKeepsItemsSoFar)
{
	// An unescaped quote behind earlier items, as the quick memo append can leave it. The reader
	// parses ahead, so the error must lie well behind the first node to be met after it.
	std::string head = "<todolist>\n";
	for (int i = 0; i < 4; ++i)
		head += "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"one " +
		        std::string(1000, 'x') + "\"/>\n";
	const std::string broken =
	    "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"say \"hi\"\"/></todolist>";
	bool ok = false;
	std::vector<MemoTodoListItem> back = parse(head + broken, &ok);
	EXPECT_TRUE(ok);
	ASSERT_GE(back.size(), 1u);
	ASSERT_LE(back.size(), 4u);
	for (const MemoTodoListItem &i : back)
		EXPECT_EQ(0u, i.content.find("one x"));

	// In a short document the error is met at once: the memo opens empty.
	back = parse("<todolist>\n" + broken, &ok);
	EXPECT_FALSE(ok);
	ASSERT_EQ(1u, back.size());
	EXPECT_EQ("", back[0].content);
}

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
	};
	for (const auto &c : cases)
		EXPECT_EQ(c[1], saved(c[0])) << c[0];
}

TEST_F(ShareText, EditShareListShareAndPickText)
{
	// Each view keeps its own table of markers.
	const std::string display = "top\n<CHECK state=false>a</CHECK><CHECK state=true>b</CHECK>end";
	EXPECT_EQ("top\n[  ]a\n[v]b\nend", memoApplyEditShareMarkers(display));
	EXPECT_EQ("top\n[ ]a\n[V]b\nend", memoApplyListShareMarkers(display));
	EXPECT_EQ("<CHECK state=maybe>", memoApplyListShareMarkers("<CHECK state=maybe>"));

	const std::string doc =
	    compose({item(MEMO_BOX_ITEM_FIRST_TEXT, false,
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
	const std::string longText(50000, 'a');
	EXPECT_EQ(40959u, memoComposeEditShareText(nullptr, nullptr, longText.c_str()).size());

	// A pick gives the title, and the display text only with a document.
	EXPECT_EQ("T\n[V]a\n[ ]b\n",
	          memoComposePickText("T", "<todolist>...", "<CHECK state=true>a</CHECK><CHECK state=false>b</CHECK>"));
	// A memo without a document contributes only its title.
	EXPECT_EQ("T\n", memoComposePickText("T", "", "stale"));
	EXPECT_EQ("body", memoComposePickText("", "<todolist>", "body"));
}

TEST(StorableText, ControlCharactersGoAndLineEndsStay)
{
	// What a share or another application hands in: the text must fit a stored document.
	char *text = MemoUtil::stripControlCharsN("a\x01"
	                                          "b\tc\r\nd\re\x7f\xEF\xBF\xBF\xC3\xA9\xFF\x1b");
	EXPECT_STREQ("ab\tc\nd\ne\x7f\xC3\xA9", text);
	free(text);
}
