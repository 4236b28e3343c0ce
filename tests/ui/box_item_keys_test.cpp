// Return and BackSpace on every kind of box item, with real key events.
#include <gtest/gtest.h>

#include "support/BoxItemFixture.h"

using namespace memo_ui_test;

namespace
{
class BoxItemKeysTest : public BoxItemFixture
{
protected:
	// An item with `markup` in it, focused, the cursor at `cursor` (-1: the end).
	MemoBoxItem *itemWith(_MemoBoxItemType type, const char *markup, int cursor = -1)
	{
		MemoBoxItem *item = owner->addItem(type);
		if (markup && *markup)
			item->insertText(markup);
		focus(item->getEntry());
		if (cursor < 0)
			elm_entry_cursor_end_set(item->getEntry());
		else
			elm_entry_cursor_pos_set(item->getEntry(), cursor);
		runFor(0.05);
		owner->calls.clear();
		return item;
	}
};
} // namespace

TEST_F(BoxItemKeysTest, ReturnOnEmptyCheckLineLeavesTheList)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_CHECK, "");
	pressKey("Return", "\r");
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, item->getType());
	EXPECT_EQ("", text(item));
	EXPECT_EQ(0, owner->count("add:"));
	EXPECT_EQ(1u, owner->items.size());
}

TEST_F(BoxItemKeysTest, ReturnOnEmptyFirstCheckLineGivesFirstText)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_FIRST_CHECK, "");
	pressKey("Return", "\r");
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, item->getType());
}

TEST_F(BoxItemKeysTest, ReturnAfterTextStartsANewCheckLine)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_CHECK, "milk");
	pressKey("Return", "\r");
	EXPECT_EQ("milk", text(item));
	ASSERT_EQ(1, owner->count("add:1:"));
	ASSERT_EQ(2u, owner->items.size());
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, owner->items[1]->getType());
	EXPECT_EQ("", text(owner->items[1]));
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, item->getType());
}

TEST_F(BoxItemKeysTest, ReturnMidLineMovesTheRestWithoutABreak)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_CHECK, "milkbread", 4);
	pressKey("Return", "\r");
	EXPECT_EQ("milk", text(item));
	ASSERT_EQ(2u, owner->items.size());
	EXPECT_EQ("bread", text(owner->items[1]));
	EXPECT_EQ(1, owner->count("add:1:bread"));
}

TEST_F(BoxItemKeysTest, ReturnInATextBlockIsALineBreak)
{
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_FIRST_TEXT, "ab");
	pressKey("Return", "\r");
	EXPECT_EQ("ab<br/>", text(item));
	EXPECT_EQ(0, owner->count("add:"));
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, item->getType());
}

TEST_F(BoxItemKeysTest, ReturnInTheTitleAsksForTheBody)
{
	MemoBoxItem *title = itemWith(MEMO_BOX_ITEM_TITLE, "Shopping");
	pressKey("Return", "\r");
	EXPECT_EQ(1, owner->count("add:3:(null)"));
	EXPECT_EQ("Shopping", text(title));
}

TEST_F(BoxItemKeysTest, BackSpaceTwiceAtTheStartOfACheckLine)
{
	MemoBoxItem *first = itemWith(MEMO_BOX_ITEM_FIRST_TEXT, "first");
	MemoBoxItem *check = itemWith(MEMO_BOX_ITEM_CHECK, "milk");
	// The cursor arrives at 0 by a key that is not a BackSpace: the first press only notes the place.
	pressKey("Home");
	pressKey("BackSpace", "\b");
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, check->getType());

	pressKey("BackSpace", "\b");
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, check->getType());
	EXPECT_EQ("milk", text(check));
	EXPECT_EQ(0, owner->count("unpack"));

	// The line is text now, the cursor still at its start: the next press merges it upwards.
	runFor(0.05);
	EXPECT_EQ(0, elm_entry_cursor_pos_get(check->getEntry()));
	pressKey("BackSpace", "\b");
	EXPECT_EQ(1, owner->count("unpack"));
	ASSERT_EQ(1u, owner->items.size());
	EXPECT_EQ("firstmilk", text(first));
}

TEST_F(BoxItemKeysTest, BackSpaceThatEmptiesALineDoesNotActUntilTheNextPress)
{
	MemoBoxItem *check = itemWith(MEMO_BOX_ITEM_CHECK, "");
	typeText("a");
	pressKey("BackSpace", "\b");
	EXPECT_EQ("", text(check));
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, check->getType());

	pressKey("BackSpace", "\b");
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, check->getType());
	EXPECT_EQ(0, owner->count("unpack"));
}

TEST_F(BoxItemKeysTest, TheOnlyTextItemTakesOneRequestThenNoMore)
{
	owner->allowUnpack = false;
	MemoBoxItem *item = itemWith(MEMO_BOX_ITEM_FIRST_TEXT, "");
	pressKey("BackSpace", "\b");
	EXPECT_EQ(1, owner->count("unpack"));
	pressKey("BackSpace", "\b");
	pressKey("BackSpace", "\b");
	EXPECT_EQ(1, owner->count("unpack"));
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, item->getType());
}

TEST_F(BoxItemKeysTest, BackSpaceInsideALineOnlyDeletes)
{
	MemoBoxItem *check = itemWith(MEMO_BOX_ITEM_CHECK, "abc");
	pressKey("BackSpace", "\b");
	pressKey("BackSpace", "\b");
	EXPECT_EQ("a", text(check));
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, check->getType());
	EXPECT_EQ(0, owner->count("unpack"));
}
