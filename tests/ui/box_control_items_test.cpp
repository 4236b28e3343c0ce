// The box control answering its items: adding and removing items, focus and the shared budget, the
// Done state, the star, taps and the keypad hold. Real key and pointer events throughout.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "DataBase/MemoDbMgr.h"
#include "TestEnv.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

namespace
{
class BoxControlItemsTest : public BoxControlFixture
{
protected:
	// Focuses the item's entry and puts the cursor at `pos` (-1: the end).
	void focusAt(MemoBoxItem *item, int pos)
	{
		focus(item->getEntry());
		if (pos < 0)
			elm_entry_cursor_end_set(item->getEntry());
		else
			elm_entry_cursor_pos_set(item->getEntry(), pos);
		runFor(0.03);
	}

	// BackSpace at the start of the item: the first press only notes the cursor at 0, the second acts.
	void backSpaceAtStart(MemoBoxItem *item)
	{
		focusAt(item, 0);
		pressKey("BackSpace", "\b");
		pressKey("BackSpace", "\b");
	}

	void tapOn(Evas_Object *obj)
	{
		int x = 0, y = 0;
		centreOf(obj, &x, &y);
		tap(x, y);
	}
};
} // namespace

TEST_F(BoxControlItemsTest, BackSpaceMergesIntoTheNeighbourAndKeepsEverything)
{
	withBody(todoItem(0, false, "one") + todoItem(1, true, "two") + todoItem(0, false, std::string(2500, 'a')) +
	         todoItem(0, false, std::string(1500, 'b')));
	MemoBoxItem *second = items()[1];
	focusAt(items()[0], 0);
	pressKey("BackSpace", "\b");
	ASSERT_EQ(4u, items().size());
	pressKey("BackSpace", "\b");
	// The next item takes over the head, and the removed text goes behind its own.
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
		tags[i < 2 ? 0 : i < 4 ? 1 : 2] += escapedTag(628, 354, mediaDir() + std::to_string(i) + ".png");
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

TEST_F(BoxControlItemsTest, ReturnOnACheckLineAddsTheNewLineRightBehindItAndNextLeavesTheTitle)
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
	EXPECT_EQ(added->getEntry(), elm_object_focused_object_get(win));
	EXPECT_EQ(4, elm_entry_cursor_pos_get(added->getEntry()));
}

TEST_F(BoxControlItemsTest, AllBodyItemsShareOneBudget)
{
	withBody(todoItem(0, false, std::string(4000, 'a')) + todoItem(0, false, ""));
	MemoBoxItem *big = items()[0];
	MemoBoxItem *small = items()[1];
	focusAt(small, -1);
	clearToasts();
	elm_entry_entry_insert(small->getEntry(), std::string(100, 'b').c_str());
	runFor(0.05);
	EXPECT_EQ(std::string(96, 'b'), text(small));
	typeText("c");
	EXPECT_EQ(std::string(96, 'b'), text(small));
	EXPECT_GE(toastCount(), 1);

	// Moving focus computes the limit again: the big item is full as well.
	focusAt(big, -1);
	typeText("d");
	EXPECT_EQ(4000u, text(big).size());

	// Freeing room in one item gives it to the other.
	elm_entry_entry_set(small->getEntry(), "");
	focusAt(big, -1);
	typeText("dd");
	EXPECT_EQ(4002u, text(big).size());
	// The title stands outside the budget.
	focus(control->getTitleItem()->getEntry());
	typeText("Title");
	char *title = control->getTitleTextN();
	EXPECT_STREQ("Title", title);
	free(title);
}

TEST_F(BoxControlItemsTest, DoneFollowsTheBodyAndInNewModesTheTitle)
{
	makeControl(nullptr, MODE_NEW);
	focus(items()[0]->getEntry());
	typeText("hi");
	EXPECT_EQ("action,done,enable", lastKey());
	elm_entry_entry_set(items()[0]->getEntry(), "");
	runFor(0.05);
	EXPECT_EQ("action,done,disable", lastKey());
	focus(control->getTitleItem()->getEntry());
	typeText("T");
	EXPECT_EQ("action,done,enable", lastKey());
	// The view asks again with no entry.
	keys.clear();
	control->onEntryChanged(nullptr, nullptr);
	EXPECT_EQ("action,done,enable", lastKey());

	// Updating the quick memo, the title counts for nothing.
	record.setIsQuick(1);
	record.setTitle("Quick");
	withBody(todoItem(0, false, "x"));
	focusAt(items()[0], -1);
	pressKey("BackSpace", "\b");
	EXPECT_EQ("action,done,disable", lastKey());
	typeText("y");
	EXPECT_EQ("action,done,enable", lastKey());
}

TEST_F(BoxControlItemsTest, KeypadHoldGuideTextAndTapsFollowTheModeAndTheItems)
{
	makeControl(nullptr, MODE_NEW);
	MemoBoxItem *first = items()[0];
	Evas_Object *body = first->getEntry();
	Evas_Object *title = control->getTitleItem()->getEntry();
	focus(body);
	control->suspendKeypad();
	EXPECT_FALSE(elm_entry_input_panel_enabled_get(body));
	control->resumeKeypad();
	EXPECT_TRUE(elm_entry_input_panel_enabled_get(body));
	focus(title);
	control->suspendKeypad();
	EXPECT_FALSE(elm_entry_input_panel_enabled_get(title));
	EXPECT_TRUE(elm_entry_input_panel_enabled_get(body));
	control->resumeKeypad();
	EXPECT_TRUE(elm_entry_input_panel_enabled_get(title));

	EXPECT_STRNE("", elm_object_part_text_get(body, "elm.guide"));
	control->onAddRequested(body, MEMO_BOX_ITEM_CHECK, "x", first);
	runFor(0.05);
	control->onCheckGuideText(first);
	EXPECT_STREQ("", elm_object_part_text_get(body, "elm.guide"));

	// A tap asks for editing only in view mode, where the keypad is never held.
	tapOn(body);
	EXPECT_EQ(0, countKey("action,mode,change"));
	withBody(todoItem(0, false, "read only"), MODE_VIEW);
	control->suspendKeypad();
	EXPECT_TRUE(elm_entry_input_panel_enabled_get(items()[0]->getEntry()));
	tapOn(items()[0]->getEntry());
	EXPECT_EQ(1, countKey("action,mode,change"));
}

TEST_F(BoxControlItemsTest, StarIsStoredAtOnceOnlyInViewMode)
{
	MemoDocInfo stored;
	stored.setTitle("Starred");
	stored.setTizenXmlContent(todoList(todoItem(0, false, "x")).c_str());
	ASSERT_TRUE(MemoDbMgr::getInstance()->addMemo(&stored));
	const std::string uuid = stored.getMemoUUID();
	std::unique_ptr<MemoDocInfo> viewed(MemoDbMgr::getInstance()->getOneMemoN(uuid.c_str()));
	ASSERT_NE(nullptr, viewed);
	auto star = [this] {
		Evas_Object *edje = elm_layout_edje_get(control->getTitleItem()->getInnerLayout());
		return const_cast<Evas_Object *>(edje_object_part_object_get(edje, "favourite.touch"));
	};
	auto storedStar = [&] {
		std::unique_ptr<MemoDocInfo> after(MemoDbMgr::getInstance()->getOneMemoN(uuid.c_str()));
		return after ? after->getIsFavorite() : -1;
	};

	makeControl(viewed.get(), MODE_VIEW, uuid.c_str());
	ASSERT_NE(nullptr, star());
	int x = 0, y = 0, bx = 0, by = 0;
	centreOf(star(), &x, &y);
	EXPECT_TRUE(control->isFavoriteArea(x, y));
	EXPECT_TRUE(control->isTitleArea(x, y));
	centreOf(items()[0]->getLayout(), &bx, &by);
	EXPECT_FALSE(control->isFavoriteArea(bx, by));
	EXPECT_FALSE(control->isTitleArea(bx, by));
	tap(x, y);
	EXPECT_TRUE(control->getFavoriteStatus());
	EXPECT_EQ(1, storedStar());

	// While editing the star waits for the save.
	remakeControl(viewed.get(), MODE_UPDATE, uuid.c_str());
	ASSERT_NE(nullptr, star());
	tapOn(star());
	EXPECT_FALSE(control->getFavoriteStatus());
	EXPECT_EQ(1, storedStar());
	UiFixture::TearDown();
}
