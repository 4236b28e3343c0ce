// changeMode and the split at the cursor: which item keeps which text, and the image tags on the way.
#include <gtest/gtest.h>

#include <Ecore_File.h>

#include "Util/MemoUtil.h"
#include "support/BoxItemFixture.h"

using namespace memo_ui_test;

namespace
{
class BoxItemModeTest : public BoxItemFixture
{
protected:
	MemoBoxItem *itemWith(_MemoBoxItemType type, const char *markup, int cursor)
	{
		MemoBoxItem *item = owner->addItem(type);
		item->insertText(markup);
		elm_entry_cursor_pos_set(item->getEntry(), cursor);
		return item;
	}

	// The kinds and texts of the owner's items, e.g. "0:l1 1:l2 0:l3".
	std::string shape() const
	{
		std::string out;
		for (MemoBoxItem *item : owner->items)
			out += (out.empty() ? "" : " ") + std::to_string(item->getType()) + ":" + text(item);
		return out;
	}
};
} // namespace

TEST_F(BoxItemModeTest, SplitsAtTheCursor)
{
	struct Case {
		_MemoBoxItemType type;
		const char *markup;
		int cursor;
		const char *shape;
	};
	const Case cases[] = {
	    // The start of the middle line: text, check, text.
	    {MEMO_BOX_ITEM_FIRST_TEXT, "l1<br/>l2<br/>l3", 3, "5:l1 1:l2 0:l3"},
	    // Inside a word the word is split.
	    {MEMO_BOX_ITEM_TEXT, "abcd", 2, "0:ab 1:cd"},
	    // The start or the end of several lines takes the first or the last line.
	    {MEMO_BOX_ITEM_TEXT, "l1<br/>l2", 0, "1:l1 0:l2"},
	    {MEMO_BOX_ITEM_TEXT, "l1<br/>l2", 5, "0:l1 1:l2"},
	    // Format tags are lost, entities kept.
	    {MEMO_BOX_ITEM_TEXT, "a&amp;b<br/>c&lt;d", 4, "0:a&amp;b 1:c&lt;d"},
	};
	for (const Case &c : cases) {
		SCOPED_TRACE(c.markup);
		delete owner;
		owner = new FakeBoxOwner(box);
		itemWith(c.type, c.markup, c.cursor)->changeMode();
		runFor(0.05);
		EXPECT_EQ(c.shape, shape());
	}
}

TEST_F(BoxItemModeTest, OneLineWithTheCursorAtAnEdgeTurnsWhole)
{
	MemoBoxItem *atEnd = itemWith(MEMO_BOX_ITEM_FIRST_TEXT, "abcd", 4);
	atEnd->changeMode();
	EXPECT_EQ("2:abcd", shape());

	atEnd->changeMode();
	EXPECT_EQ("5:abcd", shape());

	elm_entry_cursor_pos_set(atEnd->getEntry(), 0);
	atEnd->changeMode();
	EXPECT_EQ("2:abcd", shape());
}

TEST_F(BoxItemModeTest, QuickMemoBodyBecomesAPlainCheck)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_QUICK_TEXT, "note", 4);
	item->changeMode();
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, item->getType());
}

TEST_F(BoxItemModeTest, ImageTagsGoBackWhereTheyStood)
{
	const std::string folder = std::string(MemoUtil::getDataPath()) + "media/test-memo/";
	ecore_file_mkpath(folder.c_str());
	const std::string one = folder + "one.png", two = folder + "two.png";
	ASSERT_TRUE(writePicture(one, 200, 100));
	ASSERT_TRUE(writePicture(two, 200, 100));
	int width = 0;
	{
		// Tags at this display's width, so that the filter leaves them as they are.
		MemoBoxItem *probe = owner->addItem(MEMO_BOX_ITEM_TEXT);
		probe->insertText(("<item absize=240x180 href=file://" + one + "></item>").c_str());
		sscanf(text(probe).c_str(), "<item size=%dx", &width);
		owner->removeItem(probe);
	}
	ASSERT_GT(width, 0);
	char tag1[512], tag2[512];
	snprintf(tag1, sizeof(tag1), "<item size=%dx140 vsize=full href=file://%s></item>", width, one.c_str());
	snprintf(tag2, sizeof(tag2), "<item size=%dx140 vsize=full href=file://%s></item>", width, two.c_str());

	// "x" image "<br/>" "y" image: the cursor after the break, so each part keeps its own image.
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_TEXT, (std::string("x") + tag1 + "<br/>y" + tag2).c_str(), 3);
	item->changeMode();
	runFor(0.05);
	ASSERT_EQ(2u, owner->items.size());
	EXPECT_EQ(std::string("x") + tag1, text(owner->items[0]));
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, owner->items[1]->getType());
	// The check line is narrower: the filter fits the tag to it on the way in.
	const std::string check = text(owner->items[1]);
	EXPECT_EQ(0u, check.find("y<item size="));
	EXPECT_NE(std::string::npos, check.find("href=file://" + two + "></item>"));
	int checkWidth = 0;
	sscanf(check.c_str(), "y<item size=%dx", &checkWidth);
	EXPECT_LT(checkWidth, width);
}

TEST_F(BoxItemModeTest, TickingAStrikesTheTextAndKeepsTheCursor)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_CHECK, "done", 2);
	EXPECT_FALSE(item->getCheckStatus());
	EXPECT_STREQ("DEFAULT='color=#000000ff'", elm_entry_text_style_user_peek(item->getEntry()));

	item->setCheckStatus(true);
	EXPECT_TRUE(item->getCheckStatus());
	EXPECT_STREQ("DEFAULT='strikethrough=on strikethrough_color=#00000050 color=#00000064'",
	             elm_entry_text_style_user_peek(item->getEntry()));

	// A tap on the box goes through the widget's own toggle and the "changed" callback.
	Evas_Object *check = elm_object_part_content_get(item->getInnerLayout(), "check");
	ASSERT_NE(nullptr, check);
	int x = 0, y = 0;
	centreOf(check, &x, &y);
	tap(x, y);
	runFor(0.05);
	EXPECT_FALSE(item->getCheckStatus());
	EXPECT_STREQ("DEFAULT='color=#000000ff'", elm_entry_text_style_user_peek(item->getEntry()));
	EXPECT_EQ(2, elm_entry_cursor_pos_get(item->getEntry()));
	EXPECT_EQ(1, owner->count("suspend"));
	EXPECT_EQ(1, owner->count("resume"));
	EXPECT_EQ(1, owner->count("focuscurrent"));
}

TEST_F(BoxItemModeTest, TextItemsHaveNoCheckState)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_TEXT, "x", 0);
	EXPECT_FALSE(item->getCheckStatus());
	item->setCheckStatus(true);
	EXPECT_FALSE(item->getCheckStatus());
}
