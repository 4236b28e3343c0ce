// The converter's stored forms, the quick memo append, and a huge item.
#include "MemoCvt.h"
#include "TestEnv.h"
#include "todolist_fixture.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

using namespace todolist_test;

namespace
{
// The quick memo append as the store runs it against the stored document.
std::string quickDocument(std::string stored, const std::string &text)
{
	if (stored.find("</todolist>") == std::string::npos)
		stored = "<todolist></todolist>";
	const size_t end = stored.find("</todolist>");
	return stored.replace(end, 11,
	                      "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"" + text +
	                          "\"/></todolist>");
}

std::string quickAppend(const std::string &stored, const std::string &text, std::string *display = nullptr)
{
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, quickDocument(stored, text));
	cvt.addQuickMemoItem(text);
	if (display)
		*display = cvt.getDisplayContent();
	return cvt.getTizenXmlContent();
}

const std::string MIXED = compose({
    item(MEMO_BOX_ITEM_FIRST_TEXT, false,
         "Tom &amp; Jerry &lt;3<br/>line2<br/><item size=240x180 vsize=full href=file:///m/a b.jpg></item><br/>tail"),
    item(MEMO_BOX_ITEM_CHECK, true, "milk &amp; eggs"),
    item(MEMO_BOX_ITEM_CHECK, false, "bread<br/>butter"),
    item(MEMO_BOX_ITEM_TEXT, false, "bye"),
});
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

TEST(MemoCvtQuickMemo, EachTextOnceInOrderWhateverItHolds)
{
	const std::string text = "say \"hi\" &amp; <b>\nnext";
	std::string display;
	const std::string first = quickAppend("", text, &display);
	EXPECT_EQ("say \"hi\" & \xEF\xBC\x9C"
	          "b\xEF\xBC\x9E\nnext",
	          display);
	std::vector<MemoTodoListItem> items = parse(first);
	ASSERT_EQ(1u, items.size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items[0].type);
	EXPECT_EQ("say \"hi\" &amp; &lt;b&gt;<br/>next", items[0].content);

	// Earlier items, check states included, survive; each text is there once, in order.
	const std::string stored = compose({item(MEMO_BOX_ITEM_FIRST_CHECK, true, "a"), parse(first)[0]});
	const std::string second = quickAppend(stored, "two & \"more\"");
	items = parse(second);
	ASSERT_EQ(3u, items.size());
	EXPECT_TRUE(items[0].checked);
	EXPECT_EQ("two &amp; \"more\"", items[2].content);
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, second);
	EXPECT_EQ(1u, memo_test::countOf(cvt.getStrippedContent(), "say \"hi\""));
	EXPECT_EQ(1u, memo_test::countOf(cvt.getStrippedContent(), "two & \"more\""));

	// Content behind the first root is no part of the body, and the text is there once.
	items = parse(quickAppend(stored + "<todolist>\n</todolist>\n", "c"));
	ASSERT_EQ(3u, items.size());
	EXPECT_EQ("c", items[2].content);

	// A source that does not end with the appended item still gets the text once, at the end.
	MemoCvt plain(MEMO_CVT_SRC_TODOLIST, stored);
	plain.addQuickMemoItem("z");
	items = parse(plain.getTizenXmlContent());
	ASSERT_EQ(3u, items.size());
	EXPECT_EQ("z", items[2].content);
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
