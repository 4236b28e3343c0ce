// Pointer and text events of box items: the title's filter and back key, the star, taps versus drags,
// long presses, guide texts and the character limit.
#include <gtest/gtest.h>

#include <Ecore_File.h>
#include <app_i18n.h>
#include <efl_extension.h>
#include <libintl.h>

#include "Model/MemoBroadCaster.h"
#include "TestEnv.h"
#include "Util/MemoUtil.h"
#include "support/BoxItemFixture.h"

using namespace memo_ui_test;

namespace
{
class BoxItemEventsTest : public BoxItemFixture
{
protected:
	static std::string guide(MemoBoxItem *item)
	{
		const char *t = elm_object_part_text_get(item->getEntry(), "elm.guide");
		return t ? t : "";
	}
};
} // namespace

TEST_F(BoxItemEventsTest, CreateNeedsAParent)
{
	MemoBoxItem item(MEMO_BOX_ITEM_TEXT, "x", true);
	EXPECT_EQ(nullptr, item.create(nullptr, nullptr, owner));
	EXPECT_EQ(nullptr, item.getEntry());
}

TEST_F(BoxItemEventsTest, TitleTakesOneLineWithoutFormat)
{
	MemoBoxItem *title = owner->addItem(MEMO_BOX_ITEM_TITLE);
	title->insertText("<font_size=40>Shop</font_size><br/>ping&amp;co");
	EXPECT_EQ("Shopping&amp;co", text(title));
}

// Records what the filters before it let through.
static void recordFilteredCb(void *data, Evas_Object *, char **text)
{
	static_cast<std::vector<std::string> *>(data)->push_back(*text ? *text : "(null)");
}

TEST_F(BoxItemEventsTest, TitleLeavesCompositionTextAlone)
{
	MemoBoxItem *title = owner->addItem(MEMO_BOX_ITEM_TITLE);
	std::vector<std::string> seen;
	elm_entry_markup_filter_append(title->getEntry(), recordFilteredCb, &seen);
	elm_entry_entry_insert(title->getEntry(), "<preedit><b>a</b>&amp;</preedit>");
	elm_entry_entry_insert(title->getEntry(), "<preedit><b>a</b>&amp;");
	ASSERT_EQ(2u, seen.size());
	EXPECT_EQ("<preedit><b>a</b>&amp;</preedit>", seen[0]);
	// Without its closing tag it is plain input: the tags go, the entity stays.
	EXPECT_EQ("a&amp;", seen[1]);
}

TEST_F(BoxItemEventsTest, TitleStopsAt128Characters)
{
	MemoBoxItem *title = owner->addItem(MEMO_BOX_ITEM_TITLE);
	title->insertText(std::string(200, 'x').c_str());
	EXPECT_EQ(std::string(128, 'x'), text(title));
}

TEST_F(BoxItemEventsTest, FirstBackKeyDuringTitleSelectionOnlyEndsIt)
{
	MemoBoxItem *title = owner->addItem(MEMO_BOX_ITEM_TITLE);
	title->insertText("Groceries");
	focus(title->getEntry());
	evas_object_smart_callback_call(title->getEntry(), "selection,start", nullptr);
	elm_entry_select_all(title->getEntry());
	render();
	ASSERT_NE(nullptr, evas_object_data_get(title->getEntry(), "eext_entry"));
	ASSERT_NE(nullptr, elm_entry_selection_get(title->getEntry()));

	pressKey("Escape");
	EXPECT_EQ(nullptr, elm_entry_selection_get(title->getEntry()));
	EXPECT_EQ(nullptr, evas_object_data_get(title->getEntry(), "eext_entry"));
	EXPECT_EQ("Groceries", text(title));
}

TEST_F(BoxItemEventsTest, ClearedSelectionDropsTheBackHandler)
{
	MemoBoxItem *title = owner->addItem(MEMO_BOX_ITEM_TITLE);
	evas_object_smart_callback_call(title->getEntry(), "selection,start", nullptr);
	evas_object_smart_callback_call(title->getEntry(), "selection,start", nullptr);
	evas_object_smart_callback_call(title->getEntry(), "selection,cleared", nullptr);
	EXPECT_EQ(nullptr, evas_object_data_get(title->getEntry(), "eext_entry"));
}

TEST_F(BoxItemEventsTest, StarToggledByItsTouchArea)
{
	MemoBoxItem *title = owner->addItem(MEMO_BOX_ITEM_TITLE);
	render();
	Evas_Object *touch = const_cast<Evas_Object *>(
	    edje_object_part_object_get(elm_layout_edje_get(title->getInnerLayout()), "favourite.touch"));
	ASSERT_NE(nullptr, touch);
	int x = 0, y = 0;
	centreOf(touch, &x, &y);

	tap(x, y);
	EXPECT_TRUE(title->getFavoriteStatus());
	EXPECT_EQ(1, owner->count("favorite:1"));
	tap(x, y);
	EXPECT_FALSE(title->getFavoriteStatus());
	EXPECT_EQ(1, owner->count("favorite:0"));

	title->setFavoriteStatus(true);
	EXPECT_TRUE(title->getFavoriteStatus());
	EXPECT_EQ(2, owner->count("favorite:"));
}

TEST_F(BoxItemEventsTest, TitlesWhenReadingHaveNoEntry)
{
	MemoBoxItem *title = owner->addItem(MEMO_BOX_ITEM_TITLE, false);
	EXPECT_EQ(nullptr, title->getEntry());
	title->insertText("Plan");
	EXPECT_STREQ("Plan", elm_object_part_text_get(title->getInnerLayout(), "title"));

	MemoBoxItem *quick = owner->addItem(MEMO_BOX_ITEM_QUICK_TITLE, false);
	quick->insertText("ignored");
	EXPECT_STREQ(dgettext("memo-sub", "IDS_MEMO_HEADER_QUICK_MEMO"),
	             elm_object_part_text_get(quick->getInnerLayout(), "title"));
	EXPECT_FALSE(quick->getFavoriteStatus());
}

TEST_F(BoxItemEventsTest, TapAsksForEditingAndADragDoesNot)
{
	MemoBoxItem *item = owner->addItem(MEMO_BOX_ITEM_FIRST_TEXT);
	item->insertText("some text to tap on");
	int x = 0, y = 0;
	centreOf(item->getEntry(), &x, &y);
	owner->calls.clear();

	mouseDown(x, y);
	mouseUp(x + 21, y);
	mouseDown(x, y);
	mouseUp(x, y + 21);
	EXPECT_EQ(0, owner->count("mode"));

	mouseDown(x, y);
	mouseUp(x + 20, y);
	EXPECT_EQ(1, owner->count("mode"));
	mouseDown(x, y);
	mouseUp(x - 20, y - 20);
	EXPECT_EQ(2, owner->count("mode"));
}

TEST_F(BoxItemEventsTest, LongPressIsNoTap)
{
	MemoBoxItem *item = owner->addItem(MEMO_BOX_ITEM_TEXT, false);
	item->insertText("hold me");
	int x = 0, y = 0;
	centreOf(item->getEntry(), &x, &y);
	owner->calls.clear();

	mouseDown(x, y);
	runFor(0.6);
	mouseUp(x, y);
	EXPECT_EQ(0, owner->count("mode"));
	// The next tap counts again.
	tap(x, y);
	EXPECT_EQ(1, owner->count("mode"));
}

TEST_F(BoxItemEventsTest, IgnoredMouseUpIsSkippedOnce)
{
	MemoBoxItem *item = owner->addItem(MEMO_BOX_ITEM_TEXT, false);
	item->insertText("x");
	int x = 0, y = 0;
	centreOf(item->getEntry(), &x, &y);
	owner->calls.clear();
	item->setIgnoreMouseUp(true);
	tap(x, y);
	EXPECT_EQ(0, owner->count("mode"));
	tap(x, y);
	EXPECT_EQ(1, owner->count("mode"));
}

TEST_F(BoxItemEventsTest, TapOnAnImageSelectsIt)
{
	const std::string folder = std::string(MemoUtil::getDataPath()) + "media/test-memo/";
	ecore_file_mkpath(folder.c_str());
	const std::string picture = folder + "tap.png";
	ASSERT_TRUE(writePicture(picture, 400, 300));
	MemoBoxItem *item = owner->addItem(MEMO_BOX_ITEM_FIRST_TEXT);
	item->insertText(("<item absize=240x180 href=file://" + picture + "></item>").c_str());
	render();
	Evas_Coord ex = 0, ey = 0;
	evas_object_geometry_get(item->getEntry(), &ex, &ey, nullptr, nullptr);
	owner->calls.clear();

	tap(ex + 60, ey + 60);
	ASSERT_TRUE(waitFor([&] { return owner->count("image:") == 1; }));
	EXPECT_EQ(0, owner->count("mode"));
	EXPECT_EQ(1, owner->count("suspend"));
	EXPECT_EQ(0u, owner->calls.back().find("image:" + folder));
}

TEST_F(BoxItemEventsTest, GuideTextOnlyOnAnEmptyEditableFirstText)
{
	const std::string memo = dgettext("memo-sub", "IDS_MEMO_BODY_MEMO");
	MemoBoxItem *first = owner->addItem(MEMO_BOX_ITEM_FIRST_TEXT);
	first->showGuideText(true);
	EXPECT_EQ(memo, guide(first));
	first->showGuideText(false);
	EXPECT_EQ("", guide(first));
	first->insertText("x");
	first->showGuideText(true);
	EXPECT_EQ("", guide(first));

	MemoBoxItem *text = owner->addItem(MEMO_BOX_ITEM_TEXT);
	text->showGuideText(true);
	EXPECT_EQ("", guide(text));
	MemoBoxItem *reading = owner->addItem(MEMO_BOX_ITEM_FIRST_TEXT, false);
	reading->showGuideText(true);
	EXPECT_EQ("", guide(reading));
}

TEST_F(BoxItemEventsTest, QuickMemoBodyDescribesItselfAndFollowsTheBus)
{
	std::string expected =
	    i18n_get_text("IDS_MEMO_BODY_COLLECT_TEXT_FROM_ANY_APP_BY_SELECTING_IT_AND_TAPPING_QUICK_MEMO_MSG");
	for (size_t at; (at = expected.find('\n')) != std::string::npos;)
		expected.replace(at, 1, "<br/>");
	MemoBoxItem *quick = owner->addItem(MEMO_BOX_ITEM_QUICK_TEXT, false);
	EXPECT_EQ(expected, guide(quick));

	elm_object_part_text_set(quick->getEntry(), "elm.guide", "");
	MemoBroadCaster::getInstance().emit("broadcast,language,changed", nullptr);
	EXPECT_EQ(expected, guide(quick));
}

namespace
{
int countInLog(const std::string &needle)
{
	const std::string log = memo_test::readFile(std::string(MemoUtil::getDataPath()) + "dlog.log");
	int n = 0;
	for (size_t at = log.find(needle); at != std::string::npos; at = log.find(needle, at + 1))
		n++;
	return n;
}
} // namespace

// Only a quick memo body being read listens to the bus, and each item leaves it exactly once, whether
// the item or its layout goes first.
TEST_F(BoxItemEventsTest, ItemsLeaveTheBusOnceWhicheverGoesFirst)
{
	MemoBroadCaster::Signal &bus = MemoBroadCaster::getInstance();
	const size_t listeners = bus.getListenerCount();
	const int complaints = countInLog("Already removed listener");
	MemoBoxItem *plain = owner->addItem(MEMO_BOX_ITEM_TEXT);
	MemoBoxItem *quick = owner->addItem(MEMO_BOX_ITEM_QUICK_TEXT, false);
	MemoBoxItem *other = owner->addItem(MEMO_BOX_ITEM_QUICK_TEXT, false);
	EXPECT_EQ(listeners + 2, bus.getListenerCount());

	owner->removeItem(plain);
	owner->removeItem(quick);
	EXPECT_EQ(listeners + 1, bus.getListenerCount());

	Evas_Object *layout = other->getLayout();
	elm_box_unpack(box, layout);
	evas_object_del(layout);
	EXPECT_EQ(listeners, bus.getListenerCount());
	owner->removeItem(other);
	EXPECT_EQ(complaints, countInLog("Already removed listener"));
}

TEST_F(BoxItemEventsTest, TypingAndFocusReachTheOwner)
{
	MemoBoxItem *item = owner->addItem(MEMO_BOX_ITEM_FIRST_TEXT);
	focus(item->getEntry());
	EXPECT_GE(owner->count("focus"), 1);
	owner->calls.clear();
	typeText("hi");
	EXPECT_EQ("hi", text(item));
	EXPECT_GE(owner->count("changed"), 1);
}

TEST_F(BoxItemEventsTest, FullBudgetRefusesWithAToast)
{
	MemoBoxItem *item = owner->addItem(MEMO_BOX_ITEM_FIRST_TEXT);
	focus(item->getEntry());
	item->setLimit(3);
	clearToasts();
	typeText("abcd");
	EXPECT_EQ("abc", text(item));
	EXPECT_EQ(1, owner->count("maxlength"));
	ASSERT_GE(toastCount(), 1);
	EXPECT_EQ(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"), toastAt(toastCount() - 1));

	// A new limit replaces the old one rather than adding a second.
	item->setLimit(5);
	focus(item->getEntry()); // the toast took the keyboard
	elm_entry_cursor_end_set(item->getEntry());
	typeText("xyz");
	EXPECT_EQ("abcxy", text(item));
}
