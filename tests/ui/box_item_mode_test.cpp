// changeMode and the split at the cursor: which item keeps which text, and the image tags on the way;
// ticking a check line.
#include <gtest/gtest.h>

#include "box_control_fixture.h"

using namespace memo_ui_test;

using BoxItemModeTest = BoxControlFixture;

TEST_F(BoxItemModeTest, SplitsAtTheCursor)
{
	const std::string one = picture("one.png", 200, 100), two = picture("two.png", 200, 100);
	const struct {
		int type;
		std::string markup;
		int cursor;
		std::string shape;
	} cases[] = {
	    // The start of the middle line: text, check, text.
	    {0, "l1<br/>l2<br/>l3", 3, "5:l1 1:l2 0:l3"},
	    // Inside a word the word is split.
	    {0, "abcd", 2, "5:ab 1:cd"},
	    // The start or the end of several lines takes the first or the last line.
	    {0, "l1<br/>l2", 0, "2:l1 0:l2"},
	    {0, "l1<br/>l2", 5, "5:l1 1:l2"},
	    // Format tags are lost, entities kept.
	    {0, "a&amp;b<br/>c&lt;d", 4, "5:a&amp;b 1:c&lt;d"},
	    // One line with the cursor at either edge turns whole, either way.
	    {0, "abcd", 4, "2:abcd"},
	    {0, "abcd", 0, "2:abcd"},
	    {1, "abcd", 4, "5:abcd"},
	    // Each part keeps its own picture; a check line's is narrower, fitted by the filter on the way in.
	    {0, "x" + tag(628, 354, one) + "<br/>y" + tag(628, 354, two), 3,
	     "5:x" + tag(628, 354, one) + " 1:y" + tag(521, 300, two)},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.markup);
		withBody(todoItem(c.type, false, c.markup));
		elm_entry_cursor_pos_set(items()[0]->getEntry(), c.cursor);
		items()[0]->changeMode();
		runFor(0.05);
		EXPECT_EQ(c.shape, shape());
	}

	// The empty body of the quick memo becomes a plain check line.
	record.setIsQuick(1);
	record.setTizenXmlContent("");
	remakeControl(&record, MODE_UPDATE);
	ASSERT_EQ(MEMO_BOX_ITEM_QUICK_TEXT, items()[0]->getType());
	items()[0]->insertText("note");
	items()[0]->changeMode();
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, items()[0]->getType());
}

TEST_F(BoxItemModeTest, TickingAStrikesTheTextAndKeepsTheCursor)
{
	withBody(todoItem(0, false, "text") + todoItem(1, false, "done"));
	MemoBoxItem *item = items()[1];
	focusAt(item, 2);
	EXPECT_FALSE(item->getCheckStatus());
	EXPECT_STREQ("DEFAULT='color=#000000ff'", elm_entry_text_style_user_peek(item->getEntry()));
	item->setCheckStatus(true);
	EXPECT_TRUE(item->getCheckStatus());
	EXPECT_STREQ("DEFAULT='strikethrough=on strikethrough_color=#00000050 color=#00000064'",
	             elm_entry_text_style_user_peek(item->getEntry()));
	// Text items have no check state.
	items()[0]->setCheckStatus(true);
	EXPECT_FALSE(items()[0]->getCheckStatus());

	// A tap on the box goes through the widget's own toggle and the "changed" callback; the keypad is held
	// meanwhile, and the line keeps the focus and its cursor.
	Evas_Object *check = elm_object_part_content_get(item->getInnerLayout(), "check");
	ASSERT_NE(nullptr, check);
	tapOn(check);
	runFor(0.05);
	EXPECT_FALSE(item->getCheckStatus());
	EXPECT_STREQ("DEFAULT='color=#000000ff'", elm_entry_text_style_user_peek(item->getEntry()));
	EXPECT_EQ(2, elm_entry_cursor_pos_get(item->getEntry()));
	EXPECT_EQ(item->getEntry(), elm_object_focused_object_get(win));
	EXPECT_TRUE(elm_entry_input_panel_enabled_get(item->getEntry()));
	EXPECT_EQ(todoList(todoItem(0, false, "text") + todoItem(1, false, "done")), document(control));
}
