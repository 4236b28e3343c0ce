// The memo grid and its cards on a real gengrid (buffer engine): what each layout draws from the record,
// which rows each grid mode reads, and the scroll position across a rotation.
#include "support/MemoListFixture.h"

#include <cstring>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridItem.h"
#include "List/MemoGridText.h"
#include "List/MemoItemList.h"
#include "TestEnv.h"

using namespace memo_ui_test;

namespace
{

class GridTest : public GridFixture
{
protected:
	Elm_Object_Item *cardOf(const std::string &uuid)
	{
		render();
		for (Elm_Object_Item *item = elm_gengrid_first_item_get(grid->getEvasObj()); item;
		     item = elm_gengrid_item_next_get(item)) {
			MemoGridItem *card = static_cast<MemoGridItem *>(elm_object_item_data_get(item));
			if (card && uuid == card->getDocInfo()->getMemoUUID())
				return item;
		}
		return nullptr;
	}
	int typeOf(Elm_Object_Item *item)
	{
		return static_cast<MemoGridItem *>(elm_object_item_data_get(item))->getItemType();
	}
	static std::string groupOf(Evas_Object *layout)
	{
		const char *group = nullptr;
		if (layout)
			elm_layout_file_get(layout, nullptr, &group);
		return group ? group : "";
	}
	static std::string labelIn(Evas_Object *table)
	{
		// The label among the children of the Evas table inside the widget.
		std::string text;
		Eina_List *members = table ? evas_object_smart_members_get(table) : nullptr;
		void *member;
		EINA_LIST_FREE(members, member)
		{
			Eina_List *children = evas_object_table_children_get(static_cast<Evas_Object *>(member));
			void *child;
			EINA_LIST_FREE(children, child)
			{
				const char *type = elm_object_widget_type_get(static_cast<Evas_Object *>(child));
				if (type && strstr(type, "Label"))
					text = elm_object_text_get(static_cast<Evas_Object *>(child));
			}
		}
		return text;
	}
	// The uuids of the grid's cards in order.
	std::vector<std::string> shown()
	{
		std::vector<std::string> uuids;
		Eina_List *l;
		void *data;
		EINA_LIST_FOREACH(grid->getGridItems(), l, data)
		uuids.push_back(static_cast<MemoGridItem *>(data)->getDocInfo()->getMemoUUID());
		return uuids;
	}
};

TEST_F(GridTest, cardsDrawTitleTextChecksAndPicturesByLayout)
{
	std::string picture = memo_test::makeTempDir("grid-pictures") + "/thumb.jpg";
	ASSERT_TRUE(writePicture(picture, 120, 90));
	std::string longLine(260, 'x');
	std::string titleOnly = addMemo(TestMemo("Tea & cake").color("250;220;160;255;"));
	std::string bodyOnly = addMemo(TestMemo("", "Call the garage\nabout the tyres"));
	std::string oneTicked = addMemo(TestMemo("", checkLines({"+eggs"})));
	std::string two = addMemo(TestMemo("Bakery", checkLines({"+bread", "-butter"})));
	std::string three = addMemo(TestMemo("Trip", checkLines({"-tickets", "pack light", "+hotel"})));
	std::string six = addMemo(TestMemo("", checkLines({"-a", "-b", "-c", "+d", "-e", "-f"})));
	std::string five = addMemo(TestMemo("Week", checkLines({"+mon", "-tue", "-" + longLine, "-thu", "-fri"})));
	std::string withPicture = addMemo(TestMemo("Lake").picture(picture));
	std::string pictureGone = addMemo(TestMemo("Old").picture(picture + ".gone"));
	std::string voice = addMemo(TestMemo("", "recorded at the pier").voice("vr-1"));
	std::string favouriteVoice = addMemo(TestMemo("", "recorded twice").voice("vr-2").favourite());
	makeGrid();
	elm_scroller_region_show(grid->getEvasObj(), 0, 0, 480, 4000);
	resizeWindow(480, 4000);

	Elm_Object_Item *card = cardOf(titleOnly);
	EXPECT_EQ(1, typeOf(card));
	EXPECT_EQ("Tea &amp; cake", cardText(card, "title"));
	// The card's surface takes the memo's own colour.
	int r = 0, g = 0, b = 0;
	edje_object_color_class_get(evas_object_smart_parent_get(cardContent(card, "card.bg")), "AO001", &r, &g, &b,
	                            nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr);
	EXPECT_EQ(250 + 220 + 160, r + g + b);

	card = cardOf(bodyOnly);
	EXPECT_EQ(0, typeOf(card));
	EXPECT_EQ("Call the garage<br/>about the tyres", cardText(card, "text"));

	Evas_Object *lines = cardContent(cardOf(oneTicked), "one_checklist_swallow");
	EXPECT_EQ("memo_one_checkist", groupOf(lines));
	EXPECT_EQ("eggs", layoutText(lines, "text_strikethrough"));
	EXPECT_NE(nullptr, elm_object_part_content_get(lines, "checkbox_image"));

	card = cardOf(two);
	EXPECT_EQ(10, typeOf(card));
	lines = cardContent(card, "one_checklist_swallow");
	EXPECT_EQ("memo_two_checkist", groupOf(lines));
	EXPECT_EQ("bread", layoutText(lines, "text_strikethrough_check_second"));
	EXPECT_EQ("butter", layoutText(lines, "text_2_c"));
	EXPECT_EQ("", layoutText(lines, "text_2_c_second"));

	lines = cardContent(cardOf(three), "one_checklist_swallow");
	EXPECT_EQ("memo_three_checkist", groupOf(lines));
	EXPECT_EQ("tickets", layoutText(lines, "text_2_c_second"));
	EXPECT_EQ("pack light", layoutText(lines, "text_2_under_check"));
	EXPECT_EQ(nullptr, elm_object_part_content_get(lines, "checkbox_image2"));
	EXPECT_EQ("hotel", layoutText(lines, "text_strikethrough_check_3"));

	card = cardOf(six);
	EXPECT_EQ(9, typeOf(card));
	lines = cardContent(card, "one_checklist_swallow");
	EXPECT_EQ("memo_four_checkist", groupOf(lines));
	EXPECT_EQ("d", layoutText(lines, "text_strikethrough_check_4"));

	// A titled checklist of five: three single lines, the long one cut in the label's 200-byte buffer.
	card = cardOf(five);
	EXPECT_EQ(nullptr, cardContent(card, "one_checklist_swallow"));
	EXPECT_NE(std::string::npos, labelIn(cardContent(card, "check_swallow_line_one")).find("strikethrough=on"));
	EXPECT_NE(std::string::npos, labelIn(cardContent(card, "check_swallow_line_two")).find(">tue<"));
	std::string cut = labelIn(cardContent(card, "check_swallow_line_three"));
	EXPECT_LT(cut.size(), 200u);
	EXPECT_NE(std::string::npos, cut.find("xxxx"));

	card = cardOf(withPicture);
	EXPECT_EQ(4, typeOf(card));
	EXPECT_STREQ("Elm_Image", elm_object_widget_type_get(cardContent(card, "image_swallow")));
	EXPECT_EQ("default_image_layout_small", groupOf(cardContent(cardOf(pictureGone), "image_swallow")));

	card = cardOf(voice);
	EXPECT_EQ(7, typeOf(card));
	EXPECT_NE(nullptr, cardContent(card, "voice.image"));
	EXPECT_EQ("recorded at the pier", cardText(card, "text"));
	// A favourite draws its voice mark in the theme.
	EXPECT_EQ(nullptr, cardContent(cardOf(favouriteVoice), "voice.image"));

	// The quick memo leads, under its header and with the guide while empty.
	card = cardAt(0);
	EXPECT_EQ(1, static_cast<MemoGridItem *>(elm_object_item_data_get(card))->getDocInfo()->getIsQuick());
	EXPECT_EQ("Quick memo", cardText(card, "title"));
	EXPECT_NE(std::string::npos, cardText(card, "text").find("Collect text"));
	EXPECT_EQ(12, grid->getItemCount());
}

TEST_F(GridTest, keywordsAreHighlightedOutsideTags)
{
	const MemoGridColor match = {1, 2, 3, 255}, other = {9, 9, 9, 255};
	const std::string on = "<color=#010203ff>", off = "<color=#090909ff>", end = "</color>";
	EXPECT_EQ(on + "Ab" + end + off + "c" + end, memoGridHighlight("Abc", "ab", match, other));
	EXPECT_EQ(off + "x" + end + on + "AB" + end + off + "y" + end + on + "ab" + end,
	          memoGridHighlight("xAByab", "aB", match, other));
	// "br" inside "<br/>" is skipped, the one in the text is not.
	EXPECT_EQ(off + "a<br/>" + end + on + "br" + end, memoGridHighlight("a<br/>br", "br", match, other));
	EXPECT_EQ(off + "nothing" + end, memoGridHighlight("nothing", "zz", match, other));
	EXPECT_EQ("as it is", memoGridHighlight("as it is", "", match, other));

	// Through a search grid: the keyword reaches the title and the body of the matching card.
	std::string uuid = addMemo(TestMemo("Lake trip", "swim in the lake"));
	addMemo(TestMemo("Other", "nothing here"));
	makeGrid();
	int count = -1;
	grid->searchGrid("lake", &count);
	EXPECT_EQ(1, count);
	Elm_Object_Item *card = cardAt(0);
	ASSERT_NE(nullptr, card);
	EXPECT_EQ(uuid, static_cast<MemoGridItem *>(elm_object_item_data_get(card))->getDocInfo()->getMemoUUID());
	EXPECT_NE(std::string::npos, cardText(card, "title").find(">Lake</color>"));
	EXPECT_NE(std::string::npos, cardText(card, "text").find(">lake</color>"));
}

// The search grid makes cards for the first matches and the rest as the view nears them; a key that keeps a
// match keeps its card and changes its highlight in place (texts and check lines); a text that holds a
// no-result text is not searched, with the store's own result, until the store has changed.
TEST_F(GridTest, searchCardsComeAsNeededStayAcrossKeysAndFollowTheStore)
{
	for (int i = 0; i < 70; ++i)
		addMemo(TestMemo("bread " + std::to_string(i), "text"));
	const std::string week = addMemo(TestMemo("Week", checkLines({"+brew", "-bread", "-tea", "-jam"})));
	resizeWindow(480, 800);
	int mode = 0;
	makeGrid(&mode);
	Evas_Object *gengrid = grid->getEvasObj();
	int count = -1;
	grid->searchGrid("br", &count);
	EXPECT_EQ(71, count);
	EXPECT_LT(elm_gengrid_items_count(gengrid), 71u);
	MemoGridItem *card = static_cast<MemoGridItem *>(elm_object_item_data_get(cardAt(0)));
	ASSERT_EQ(week, card->getDocInfo()->getMemoUUID());
	EXPECT_NE(std::string::npos, labelIn(cardContent(cardAt(0), "check_swallow_line_two")).find(">br</color>"));

	grid->searchGrid("bre", &count);
	EXPECT_EQ(71, count);
	EXPECT_EQ(card, elm_object_item_data_get(cardAt(0)));
	EXPECT_NE(std::string::npos, cardText(cardAt(0), "title").find("Week"));
	EXPECT_NE(std::string::npos, labelIn(cardContent(cardAt(0), "check_swallow_line_two")).find(">bre</color>"));

	Evas_Coord w = 0, h = 0;
	for (int i = 0; i < 40 && elm_gengrid_items_count(gengrid) < 71; ++i) {
		elm_scroller_region_get(gengrid, nullptr, nullptr, &w, &h);
		elm_scroller_region_show(gengrid, 0, 1000000, w, h);
		render();
	}
	EXPECT_EQ(71u, elm_gengrid_items_count(gengrid));

	// "a/" ends in an escape and matches nothing; "a/b" is no longer its part and does match.
	addMemo(TestMemo("cab", "x"));
	grid->reloadItems();
	grid->searchGrid("a/", &count);
	EXPECT_EQ(0, count);
	grid->searchGrid("a/b", &count);
	EXPECT_EQ(1, count);
	// "qq" matches nothing; "qqz" would match nothing either, until a memo holding it is stored.
	grid->searchGrid("qq", &count);
	EXPECT_EQ(0, count);
	grid->searchGrid("qqz", &count);
	EXPECT_EQ(0, count);
	EXPECT_EQ(0u, elm_gengrid_items_count(gengrid));
	addMemo(TestMemo("qqz", "x"));
	grid->reloadItems();
	grid->searchGrid("qqz", &count);
	EXPECT_EQ(1, count);
	EXPECT_EQ(1u, elm_gengrid_items_count(gengrid));
}

TEST_F(GridTest, eachGridModeReadsItsRows)
{
	MemoItemList *list = MemoDbMgr::getInstance()->getVisibleMemoListN();
	std::string quick = list->getItem(0)->getMemoUUID();
	delete list;
	std::string normal = addMemo(TestMemo("Normal", "text"));
	std::string hidden = addMemo(TestMemo("Hidden", "text").hidden());
	std::string deleted = addMemo(TestMemo("Deleted", "text"));
	MemoDbMgr::getInstance()->excuteSql("UPDATE memo SET isDeleted = 1 WHERE UUID = '%q'", deleted.c_str());
	const std::vector<std::string> visible = {quick, normal};
	const std::vector<std::string> all = {quick, hidden, normal};
	const std::vector<std::string> allNormal = {hidden, normal};

	makeGrid();
	EXPECT_EQ(visible, shown());
	int mode = 0;
	grid->destroy();
	makeGrid(&mode);
	EXPECT_EQ(visible, shown());
	for (int value : {1, 2, 3, 5}) {
		mode = value;
		grid->updateGrid();
		EXPECT_EQ(value == 1 ? visible : (value == 3 ? allNormal : all), shown()) << "mode " << value;
	}
	EXPECT_EQ(3, grid->getItemCount());

	// A reload over the same rows within one step keeps the cards, bound to the new records.
	mode = 0;
	grid->updateGrid();
	Elm_Object_Item *first = elm_gengrid_first_item_get(grid->getEvasObj());
	grid->updateGrid();
	EXPECT_EQ(first, elm_gengrid_first_item_get(grid->getEvasObj()));
	EXPECT_EQ(visible, shown());
	// A search over the rebound cards keeps the card of a match and leaves no other; a reload after it builds
	// the cards again.
	Elm_Object_Item *second = elm_gengrid_item_next_get(first);
	int count = -1;
	grid->searchGrid("Normal", &count);
	EXPECT_EQ(1, count);
	EXPECT_EQ(1u, elm_gengrid_items_count(grid->getEvasObj()));
	EXPECT_EQ(second, elm_gengrid_first_item_get(grid->getEvasObj()));
	grid->updateGrid();
	EXPECT_EQ(2u, elm_gengrid_items_count(grid->getEvasObj()));
	EXPECT_EQ(visible, shown());
}

TEST_F(GridTest, rotationKeepsTheScrollPosition)
{
	for (int i = 0; i < 60; ++i)
		addMemo(TestMemo("Memo " + std::to_string(i), "line"));
	makeGrid();
	Evas_Object *gengrid = grid->getEvasObj();
	// Scrolled by the user: each step raises the grid's "scroll".
	for (int y = 100; y <= 700; y += 100) {
		elm_scroller_region_show(gengrid, 0, y, 480, 800);
		render();
	}
	int y = 0;
	elm_scroller_region_get(gengrid, nullptr, &y, nullptr, nullptr);
	ASSERT_EQ(700, y);

	gIsPortrait = 0;
	resizeWindow(800, 480);
	grid->updateGrid(true);
	render();
	grid->restoreScrollPosition();
	render();
	elm_scroller_region_get(gengrid, nullptr, &y, nullptr, nullptr);
	// Landscape shows more columns: two landscape rows of 305 less a third, plus the rest,
	// (700 / 305) * 2 / 3 * 305 + 700 % 305.
	EXPECT_EQ(395, y);
	gIsPortrait = 1;
}

} // namespace
