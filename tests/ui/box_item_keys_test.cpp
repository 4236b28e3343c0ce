// Return and BackSpace in the editor, with real key events: what each kind of item does with the key,
// and how the box control adds the new line, merges a removed item and keeps its last one.
#include <gtest/gtest.h>

#include "TestEnv.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

using BoxItemKeysTest = BoxControlFixture;

TEST_F(BoxItemKeysTest, ReturnOnEachKindOfLine)
{
	const struct {
		std::string body;
		int item, cursor; // where Return is pressed (-1: the end)
		const char *shape;
	} cases[] = {
	    // An empty check line leaves the list, the first one as the first text block.
	    {todoItem(0, false, "a") + todoItem(1, false, ""), 1, -1, "5:a 0:"},
	    {todoItem(1, false, ""), 0, -1, "5:"},
	    // Mid-line the rest moves into the new check line, without a break.
	    {todoItem(1, false, "milkbread"), 0, 4, "2:milk 1:bread"},
	    // The split puts pictures back where no-break spaces stood: the filter took a pasted one out.
	    {todoItem(1, false, "a&nbsp;b" + tag(521, 392, "/nowhere/p.png")), 0, -1,
	     "2:ab<item size=521x392 vsize=full href=file:///nowhere/p.png></item> 1:"},
	    // A text block takes the break.
	    {todoItem(0, false, "ab"), 0, -1, "5:ab<br/>"},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.body);
		withBody(c.body);
		focusAt(items()[c.item], c.cursor);
		pressKey("Return", "\r");
		runFor(0.05);
		EXPECT_EQ(c.shape, shape());
	}
}

TEST_F(BoxItemKeysTest, ReturnOnACheckLineAddsTheNewLineRightBehindItAndNextLeavesTheTitle)
{
	withBody(todoItem(1, false, "eggs") + todoItem(1, false, "flour"));
	MemoBoxItem *eggs = items()[0];
	MemoBoxItem *flour = items()[1];
	focusAt(eggs, -1);
	pressKey("Return", "\r");
	runFor(0.05);

	ASSERT_EQ(3u, items().size());
	EXPECT_EQ(eggs, items()[0]);
	EXPECT_EQ(flour, items()[2]);
	MemoBoxItem *added = items()[1];
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, added->getType());
	EXPECT_EQ(added, control->getFocusedItem());
	EXPECT_EQ(added->getEntry(), elm_object_focused_object_get(win));
	EXPECT_TRUE(elm_entry_input_panel_enabled_get(eggs->getEntry()));
	// Title, then the items in list order.
	ASSERT_EQ(4u, packed().size());
	EXPECT_EQ(added->getLayout(), packed()[2]);
	typeText("milk");
	EXPECT_EQ(todoList(todoItem(1, false, "eggs") + todoItem(1, false, "milk") + todoItem(1, false, "flour")),
	          document(control));

	// Next at the title goes back to the current item, at its end, and adds nothing.
	focus(control->getTitleItem()->getEntry());
	typeText("Title");
	pressKey("Return", "\r");
	runFor(0.05);
	EXPECT_EQ(3u, items().size());
	EXPECT_EQ("Title", titleText());
	EXPECT_EQ(added->getEntry(), elm_object_focused_object_get(win));
	EXPECT_EQ(4, elm_entry_cursor_pos_get(added->getEntry()));
}

TEST_F(BoxItemKeysTest, BackSpaceTurnsCheckLinesIntoTextThenMergesKeepingEverything)
{
	withBody(todoItem(0, false, "first") + todoItem(1, false, "milk") + todoItem(1, false, "abc"));
	// Inside a line BackSpace only deletes; the press that empties a line does not act on it as well.
	focusAt(items()[2], -1);
	for (int i = 0; i < 3; i++)
		pressKey("BackSpace", "\b");
	EXPECT_EQ("5:first 1:milk 1:", shape());
	pressKey("BackSpace", "\b");
	EXPECT_EQ("5:first 1:milk 0:", shape());

	// At the start of a line reached by another key, the first press only notes the place, the next one
	// turns the check line into text, and the one after merges it into the line before.
	focusAt(items()[1], -1);
	pressKey("Home");
	pressKey("BackSpace", "\b");
	EXPECT_EQ("5:first 1:milk 0:", shape());
	pressKey("BackSpace", "\b");
	EXPECT_EQ("5:first 0:milk 0:", shape());
	runFor(0.05);
	EXPECT_EQ(0, elm_entry_cursor_pos_get(items()[1]->getEntry()));
	pressKey("BackSpace", "\b");
	EXPECT_EQ("5:firstmilk 0:", shape());
	EXPECT_EQ(5, elm_entry_cursor_pos_get(items()[0]->getEntry()));

	// BackSpace at the start of an item: the first press only notes the cursor at 0, the second acts.
	auto backSpaceAtStart = [this](MemoBoxItem *item) {
		focusAt(item, 0);
		pressKey("BackSpace", "\b");
		pressKey("BackSpace", "\b");
	};
	// The first item merges into the next one, which takes over the head.
	withBody(todoItem(0, false, "one") + todoItem(1, true, "two") + todoItem(0, false, std::string(2500, 'a')) +
	         todoItem(0, false, std::string(1500, 'b')));
	MemoBoxItem *second = items()[1];
	backSpaceAtStart(items()[0]);
	// The removed text goes behind the neighbour's own.
	ASSERT_EQ(3u, items().size());
	EXPECT_EQ(second, items()[0]);
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, second->getType());
	EXPECT_EQ("twoone", text(second));
	EXPECT_EQ(3, elm_entry_cursor_pos_get(second->getEntry()));
	EXPECT_EQ(second, control->getFocusedItem());
	EXPECT_EQ(4u, packed().size());

	// A later item goes into the one before; 2,500 and 1,500 characters fit the shared 4,096 and all stay.
	MemoBoxItem *big = items()[1];
	backSpaceAtStart(items()[2]);
	ASSERT_EQ(2u, items().size());
	EXPECT_EQ(big, items()[1]);
	EXPECT_EQ(4000u, text(big).size());
	EXPECT_EQ(2500, elm_entry_cursor_pos_get(big->getEntry()));
	EXPECT_EQ(todoList(todoItem(1, true, "twoone") + todoItem(0, false, text(big))), document(control));

	// Pictures of the removed item count once: merging 2 into 2, then 6 into those 4, keeps all 10.
	std::string tags[3];
	for (int i = 0; i < 10; i++)
		tags[i < 2 ? 0 : i < 4 ? 1 : 2] += tag(628, 354, mediaDir() + std::to_string(i) + ".png") + "<br/>";
	withBody(todoItem(0, false, tags[0]) + todoItem(0, false, tags[1]) + todoItem(0, false, tags[2]));
	for (int merge = 0; merge < 2; merge++) {
		backSpaceAtStart(items()[1]);
		EXPECT_EQ(10, control->onEntryCheckImageCount()) << merge;
	}
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(10u, memo_test::countOf(text(items()[0]), "<item"));

	// The only item is never removed; a lone check line asked to go turns into text instead.
	backSpaceAtStart(items()[0]);
	ASSERT_EQ(1u, items().size());
	elm_entry_entry_set(items()[0]->getEntry(), "");
	items()[0]->changeMode();
	ASSERT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, items()[0]->getType());
	control->onUnpackRequested(items()[0]->getEntry(), items()[0]);
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
}
