// The box control answering its items: the shared budget, the Done state, the keypad hold, guide texts,
// taps and the star. Real key and pointer events throughout.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include <app_i18n.h>

#include "DataBase/MemoDbMgr.h"
#include "TestEnv.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

using BoxControlItemsTest = BoxControlFixture;

TEST_F(BoxControlItemsTest, AllBodyItemsShareOneBudgetAndDoneFollowsThemAndInNewMemosTheTitle)
{
	withBody(todoItem(0, false, std::string(4000, 'a')) + todoItem(0, false, ""));
	MemoBoxItem *big = items()[0];
	MemoBoxItem *small = items()[1];
	focusAt(small, -1);
	elm_entry_entry_insert(small->getEntry(), std::string(100, 'b').c_str());
	runFor(0.05);
	EXPECT_EQ(std::string(96, 'b'), text(small));
	typeText("c");
	EXPECT_EQ(std::string(96, 'b'), text(small));
	ASSERT_GE(desktop_toast_log_count(), 1);
	EXPECT_STREQ(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"),
	             desktop_toast_log_get(desktop_toast_log_count() - 1));

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
	EXPECT_EQ("Title", titleText());

	// Done follows the body, and in a new memo the title as well.
	remakeControl(nullptr, MODE_NEW);
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

	// The guide text shows only on an empty first text block, alone and editable.
	EXPECT_STRNE("", elm_object_part_text_get(body, "elm.guide"));
	first->insertText("x");
	first->showGuideText(true);
	EXPECT_STREQ("", elm_object_part_text_get(body, "elm.guide"));
	elm_entry_entry_set(body, "");
	control->onAddRequested(body, MEMO_BOX_ITEM_CHECK, "x", first);
	runFor(0.05);
	control->onCheckGuideText(first);
	EXPECT_STREQ("", elm_object_part_text_get(body, "elm.guide"));
	items()[1]->showGuideText(true);
	EXPECT_STREQ("", elm_object_part_text_get(items()[1]->getEntry(), "elm.guide"));

	// A tap asks for editing only in view mode, where the keypad is never held.
	tapOn(body);
	EXPECT_EQ(0, countKey("action,mode,change"));
	withBody(todoItem(0, false, ""), MODE_VIEW);
	items()[0]->showGuideText(true);
	EXPECT_STREQ("", elm_object_part_text_get(items()[0]->getEntry(), "elm.guide"));
	items()[0]->insertText("read only");
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
