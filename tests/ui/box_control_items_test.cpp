// The box control answering its items: adding and removing items, focus and the shared budget, the
// Done state, the star, taps and the keypad hold. Real key and pointer events throughout.
#include <gtest/gtest.h>

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
	// A control in `mode` on a record whose body is `lines` (todolist items).
	MemoBoxControl *withBody(const std::string &lines, int mode = MODE_UPDATE)
	{
		doc.setMemoUUID("box-test-memo");
		doc.setTizenXmlContent(todoList(lines).c_str());
		return makeControl(&doc, mode);
	}

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

	MemoDocInfo doc;
};
} // namespace

TEST_F(BoxControlItemsTest, RemovingTheFirstOfTwoItemsHandsTheHeadOnAndAppendsItsText)
{
	withBody(todoItem(0, false, "one") + todoItem(1, true, "two"));
	ASSERT_EQ(2u, items().size());
	MemoBoxItem *second = items()[1];
	focusAt(items()[0], 0);
	// The first press only notes that the cursor is at 0; the second removes the item.
	pressKey("BackSpace", "\b");
	ASSERT_EQ(2u, items().size());
	pressKey("BackSpace", "\b");

	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(second, items()[0]);
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, second->getType());
	EXPECT_EQ("twoone", text(second));
	EXPECT_EQ(3, elm_entry_cursor_pos_get(second->getEntry()));
	EXPECT_EQ(second, control->getFocusedItem());
	EXPECT_EQ(2u, packed().size());
	EXPECT_EQ(todoList(todoItem(1, true, "twoone")), document(control));
}

TEST_F(BoxControlItemsTest, RemovingALaterItemMergesIntoTheOneBefore)
{
	withBody(todoItem(0, false, "alpha") + todoItem(0, false, "beta") + todoItem(1, false, "gamma"));
	MemoBoxItem *first = items()[0];
	MemoBoxItem *third = items()[2];
	focusAt(items()[1], 0);
	pressKey("BackSpace", "\b");
	pressKey("BackSpace", "\b");
	ASSERT_EQ(2u, items().size());
	EXPECT_EQ(first, items()[0]);
	EXPECT_EQ(third, items()[1]);
	EXPECT_EQ("alphabeta", text(first));
	EXPECT_EQ(5, elm_entry_cursor_pos_get(first->getEntry()));
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, first->getType());
}

TEST_F(BoxControlItemsTest, MergingKeepsEveryCharacterAndCountsPicturesOnce)
{
	// 2,500 and 1,500 characters fit the shared 4,096 together: the merge keeps them all.
	withBody(todoItem(0, false, std::string(2500, 'a')) + todoItem(0, false, std::string(1500, 'b')));
	focusAt(items()[1], 0);
	pressKey("BackSpace", "\b");
	pressKey("BackSpace", "\b");
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(4000u, text(items()[0]).size());

	// Pictures of the removed item count once: merging 2 into 2, then 6 into those 4, keeps all 10.
	std::string tags[3];
	for (int i = 0; i < 10; i++)
		tags[i < 2 ? 0 : i < 4 ? 1 : 2] += escapedTag(628, 354, mediaDir() + std::to_string(i) + ".png");
	evas_object_del(win);
	UiFixture::SetUp();
	withBody(todoItem(0, false, tags[0]) + todoItem(0, false, tags[1]) + todoItem(0, false, tags[2]));
	for (int merge = 0; merge < 2; merge++) {
		focusAt(items()[1], 0);
		pressKey("BackSpace", "\b");
		pressKey("BackSpace", "\b");
		EXPECT_EQ(10, control->onEntryCheckImageCount()) << merge;
	}
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(10u, memo_test::countOf(text(items()[0]), "<item"));
}

TEST_F(BoxControlItemsTest, TheOnlyItemIsNeverRemoved)
{
	withBody(todoItem(0, false, "alone"));
	focusAt(items()[0], 0);
	pressKey("BackSpace", "\b");
	pressKey("BackSpace", "\b");
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ("alone", text(items()[0]));

	// A lone check line asked to go turns into text instead.
	MemoBoxControl *other = control;
	elm_entry_entry_set(items()[0]->getEntry(), "");
	items()[0]->changeMode();
	ASSERT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, items()[0]->getType());
	other->onUnpackRequested(items()[0]->getEntry(), items()[0]);
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
}

TEST_F(BoxControlItemsTest, ReturnOnACheckLineAddsTheNewLineRightBehindIt)
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
}

TEST_F(BoxControlItemsTest, NextAtTheTitleMovesToTheBody)
{
	withBody(todoItem(0, false, "body"));
	focus(control->getTitleItem()->getEntry());
	typeText("Title");
	pressKey("Return", "\r");
	runFor(0.05);
	EXPECT_EQ(1u, items().size());
	EXPECT_EQ(items()[0]->getEntry(), elm_object_focused_object_get(win));
	EXPECT_EQ(4, elm_entry_cursor_pos_get(items()[0]->getEntry()));
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
}

TEST_F(BoxControlItemsTest, DoneInUpdateModeOfTheQuickMemoIgnoresTheTitle)
{
	doc.setIsQuick(1);
	doc.setTitle("Quick");
	withBody(todoItem(0, false, "x"));
	focusAt(items()[0], -1);
	pressKey("BackSpace", "\b");
	EXPECT_EQ("action,done,disable", lastKey());
	typeText("y");
	EXPECT_EQ("action,done,enable", lastKey());
}

TEST_F(BoxControlItemsTest, GuideTextOnlyForALoneFirstItem)
{
	makeControl(nullptr, MODE_NEW);
	MemoBoxItem *first = items()[0];
	EXPECT_STRNE("", elm_object_part_text_get(first->getEntry(), "elm.guide"));
	control->onAddRequested(first->getEntry(), MEMO_BOX_ITEM_CHECK, "x", first);
	runFor(0.05);
	control->onCheckGuideText(first);
	EXPECT_STREQ("", elm_object_part_text_get(first->getEntry(), "elm.guide"));
}

TEST_F(BoxControlItemsTest, KeypadHoldFollowsTheFocusedItem)
{
	makeControl(nullptr, MODE_NEW);
	Evas_Object *body = items()[0]->getEntry();
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
}

TEST_F(BoxControlItemsTest, TapsAskForEditingOnlyInViewMode)
{
	withBody(todoItem(0, false, "read only"), MODE_VIEW);
	control->suspendKeypad();
	EXPECT_TRUE(elm_entry_input_panel_enabled_get(items()[0]->getEntry()));
	int x = 0, y = 0;
	centreOf(items()[0]->getEntry(), &x, &y);
	tap(x, y);
	EXPECT_EQ(1, countKey("action,mode,change"));
}

TEST_F(BoxControlItemsTest, TapInEditModeAsksNothing)
{
	withBody(todoItem(0, false, "editable"));
	int x = 0, y = 0;
	centreOf(items()[0]->getEntry(), &x, &y);
	tap(x, y);
	EXPECT_EQ(0, countKey("action,mode,change"));
}

TEST_F(BoxControlItemsTest, StarIsStoredAtOnceOnlyInViewMode)
{
	MemoDocInfo stored;
	stored.setTitle("Starred");
	stored.setTizenXmlContent(todoList(todoItem(0, false, "x")).c_str());
	ASSERT_TRUE(MemoDbMgr::getInstance()->addMemo(&stored));
	const std::string uuid = stored.getMemoUUID();
	MemoDocInfo *viewed = MemoDbMgr::getInstance()->getOneMemoN(uuid.c_str());
	ASSERT_NE(nullptr, viewed);
	makeControl(viewed, MODE_VIEW, uuid.c_str());

	Evas_Object *titleEdje = elm_layout_edje_get(control->getTitleItem()->getInnerLayout());
	Evas_Object *touch = const_cast<Evas_Object *>(edje_object_part_object_get(titleEdje, "favourite.touch"));
	ASSERT_NE(nullptr, touch);
	int x = 0, y = 0;
	centreOf(touch, &x, &y);
	EXPECT_TRUE(control->isFavoriteArea(x, y));
	EXPECT_TRUE(control->isTitleArea(x, y));
	int bx = 0, by = 0;
	centreOf(items()[0]->getLayout(), &bx, &by);
	EXPECT_FALSE(control->isFavoriteArea(bx, by));
	EXPECT_FALSE(control->isTitleArea(bx, by));

	tap(x, y);
	EXPECT_TRUE(control->getFavoriteStatus());
	MemoDocInfo *after = MemoDbMgr::getInstance()->getOneMemoN(uuid.c_str());
	ASSERT_NE(nullptr, after);
	EXPECT_EQ(1, after->getIsFavorite());
	delete after;

	// While editing the star waits for the save.
	evas_object_del(win);
	win = nullptr;
	UiFixture::SetUp();
	keys.clear();
	makeControl(viewed, MODE_UPDATE, uuid.c_str());
	titleEdje = elm_layout_edje_get(control->getTitleItem()->getInnerLayout());
	touch = const_cast<Evas_Object *>(edje_object_part_object_get(titleEdje, "favourite.touch"));
	ASSERT_NE(nullptr, touch);
	centreOf(touch, &x, &y);
	tap(x, y);
	EXPECT_FALSE(control->getFavoriteStatus());
	after = MemoDbMgr::getInstance()->getOneMemoN(uuid.c_str());
	EXPECT_EQ(1, after->getIsFavorite());
	delete after;
	evas_object_del(win);
	win = nullptr;
	runFor(0.02);
	delete viewed;
}
