// The converter's stored forms and a huge item; the quick memo append is checked through the store.
#include "MemoCvt.h"
#include "todolist_fixture.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

using namespace todolist_test;

namespace
{
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
