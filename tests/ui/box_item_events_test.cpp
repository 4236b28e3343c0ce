// Text and pointer events of box items: the title's filter and back key, taps versus drags and long
// presses on a memo being read.
#include <gtest/gtest.h>

#include "box_control_fixture.h"

using namespace memo_ui_test;

using BoxItemEventsTest = BoxControlFixture;

TEST_F(BoxItemEventsTest, TitleTakesOneLineOf128CharactersWithoutFormat)
{
	makeControl(nullptr, MODE_NEW);
	MemoBoxItem *title = control->getTitleItem();
	title->insertText("<font_size=40>Shop</font_size><br/>ping&amp;co");
	EXPECT_EQ("Shopping&amp;co", text(title));
	elm_entry_entry_set(title->getEntry(), "");
	title->insertText(std::string(200, 'x').c_str());
	EXPECT_EQ(std::string(128, 'x'), text(title));

	// Composition text is left alone; without its closing tag it is plain input: the tags go, the entity stays.
	elm_entry_entry_set(title->getEntry(), "");
	std::vector<std::string> seen;
	// A filter behind the title's records what the title's filter let through.
	elm_entry_markup_filter_append(
	    title->getEntry(),
	    [](void *data, Evas_Object *, char **text) {
		    static_cast<std::vector<std::string> *>(data)->push_back(*text ? *text : "(null)");
	    },
	    &seen);
	elm_entry_entry_insert(title->getEntry(), "<preedit><b>a</b>&amp;</preedit>");
	elm_entry_entry_insert(title->getEntry(), "<preedit><b>a</b>&amp;");
	EXPECT_EQ((std::vector<std::string>{"<preedit><b>a</b>&amp;</preedit>", "a&amp;"}), seen);
}

TEST_F(BoxItemEventsTest, FirstBackKeyDuringTitleSelectionOnlyEndsIt)
{
	makeControl(nullptr, MODE_NEW);
	Evas_Object *title = control->getTitleItem()->getEntry();
	// A cleared selection takes its back handler along.
	evas_object_smart_callback_call(title, "selection,start", nullptr);
	evas_object_smart_callback_call(title, "selection,start", nullptr);
	evas_object_smart_callback_call(title, "selection,cleared", nullptr);
	EXPECT_EQ(nullptr, evas_object_data_get(title, "eext_entry"));

	control->getTitleItem()->insertText("Groceries");
	focus(title);
	evas_object_smart_callback_call(title, "selection,start", nullptr);
	elm_entry_select_all(title);
	render();
	ASSERT_NE(nullptr, evas_object_data_get(title, "eext_entry"));
	ASSERT_NE(nullptr, elm_entry_selection_get(title));
	pressKey("Escape");
	EXPECT_EQ(nullptr, elm_entry_selection_get(title));
	EXPECT_EQ(nullptr, evas_object_data_get(title, "eext_entry"));
	EXPECT_EQ("Groceries", titleText());
}

// A tap on a memo being read asks for editing; a move of more than 20 pixels, a long press or a press
// whose release was to be ignored does not.
TEST_F(BoxItemEventsTest, TapAsksForEditingAndDragsOrLongPressesDoNot)
{
	withBody(todoItem(0, false, "some text to tap on"), MODE_VIEW);
	int x = 0, y = 0;
	centreOf(items()[0]->getEntry(), &x, &y);
	const struct {
		int dx, dy;
		double hold;
		int edits;
	} presses[] = {{21, 0, 0, 0}, {0, 21, 0, 0}, {20, 0, 0, 1}, {-20, -20, 0, 2}, {0, 0, 0.6, 2}, {0, 0, 0, 3}};
	for (const auto &p : presses) {
		mouseDown(x, y);
		runFor(p.hold);
		mouseUp(x + p.dx, y + p.dy);
		EXPECT_EQ(p.edits, countKey("action,mode,change")) << p.dx << "," << p.dy << " held " << p.hold;
	}
	// An ignored release is skipped once.
	items()[0]->setIgnoreMouseUp(true);
	tap(x, y);
	EXPECT_EQ(3, countKey("action,mode,change"));
	tap(x, y);
	EXPECT_EQ(4, countKey("action,mode,change"));
}
