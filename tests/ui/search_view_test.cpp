// The search page as the app opens it from the list's more menu, with real keys typed into its field: the
// grid narrowing per key, the highlight, the wildcards of the store's statement, hidden memos, no results,
// and the way to the editor and back.
#include "support/MemoPagesFixture.h"

#include "View/MemoEditView.h"
#include "View/MemoSearchView.h"

using namespace memo_ui_test;

namespace
{

class SearchViewTest : public PagesFixture
{
protected:
	// Plan, Planet and Planetarium (hidden) match "plane" step by step; Zebra and Yak never match, so that the
	// store's count (hidden rows too) never equals the rows of the list by chance.
	void addMemos()
	{
		for (const char *title : {"Yak", "Zebra", "Planet", "Plan", "Plum", "Pick"})
			addMemo(TestMemo(title, "body"));
		addMemo(TestMemo("Planetarium", "body").hidden());
	}
	void openSearch()
	{
		startApp();
		chooseMoreMenu("Search");
		ASSERT_NE(nullptr, top<MemoSearchView>());
		focus(entry());
	}
	Evas_Object *entry() { return elm_object_part_content_get(titleContent("title"), "elm.swallow.searchbar"); }
	std::vector<std::string> shown() { return titlesIn(gridIn(top<MemoSearchView>()->getEvasObj())); }
	// The text of part of the first result's card, after a render.
	std::string cardPart(const char *part)
	{
		render();
		const char *text = elm_object_item_part_text_get(
		    elm_gengrid_first_item_get(gridIn(top<MemoSearchView>()->getEvasObj())), part);
		return text ? text : "";
	}
	// The colour tag in front of `word` in markup.
	static std::string tagBefore(const std::string &markup, const std::string &word)
	{
		size_t at = markup.find(">" + word + "</color>");
		size_t open = at == std::string::npos ? at : markup.rfind("<color=", at);
		return open == std::string::npos ? "" : markup.substr(open, at - open);
	}
};

TEST_F(SearchViewTest, eachKeyNarrowsBackSpaceWidensAndHiddenMemosStayOut)
{
	addMemos();
	openSearch();
	EXPECT_EQ(6u, shown().size());
	// The back button keeps its style's name and takes the app's look from the app's file.
	const char *file = nullptr, *group = nullptr;
	edje_object_file_get(elm_layout_edje_get(elm_object_part_content_get(titleContent("title"), "prev_btn")), &file,
	                     &group);
	EXPECT_NE(std::string::npos, std::string(file ? file : "").find("memo.edj"));
	EXPECT_STREQ("elm/button/base/naviframe/back_btn/default", group);
	// Newest first, as the search orders them.
	const std::vector<std::vector<std::string>> steps = {{"Pick", "Plum", "Plan", "Planet"},
	                                                     {"Plum", "Plan", "Planet"},
	                                                     {"Plan", "Planet"},
	                                                     {"Plan", "Planet"},
	                                                     {"Planet"}};
	const char *keys = "plane";
	for (size_t i = 0; i < steps.size(); ++i) {
		typeText(std::string(1, keys[i]).c_str());
		EXPECT_EQ(steps[i], shown()) << "after " << i + 1 << " keys";
	}
	for (int i = 3; i >= 0; --i) {
		pressKey("BackSpace");
		EXPECT_EQ(steps[i], shown()) << "after BackSpace to " << i + 1 << " keys";
	}
	// Emptied, the field lists every visible memo again.
	pressKey("BackSpace");
	EXPECT_EQ(6u, shown().size());

	// From the hidden view (grid mode 5) the hidden memo is a result too.
	MemoSearchView *hiddenSearch = new MemoSearchView();
	hiddenSearch->gridMode = 5;
	ASSERT_TRUE(naviframe()->push(hiddenSearch));
	runFor(0.5);
	focus(entry());
	typeText("plane");
	EXPECT_EQ((std::vector<std::string>{"Planetarium", "Planet"}), shown());
}

TEST_F(SearchViewTest, matchesAreHighlightedAndWildcardsActAsTheStatementSays)
{
	addMemo(TestMemo("cab Abby bread", "grab\nABle"));
	addMemo(TestMemo("Tom's list", "milk"));
	addMemo(TestMemo("Other", "nothing here"));
	openSearch();

	typeText("AB");
	ASSERT_EQ((std::vector<std::string>{"cab Abby bread"}), shown());
	const std::string title = cardPart("title"), body = cardPart("text");
	const std::string mark = tagBefore(title, "ab");
	EXPECT_FALSE(mark.empty()) << title;
	EXPECT_EQ(mark, tagBefore(title, "Ab")) << title;
	EXPECT_NE(mark, tagBefore(title, "by")) << title;
	EXPECT_EQ(mark, tagBefore(body, "ab")) << body;
	EXPECT_EQ(mark, tagBefore(body, "AB")) << body;
	EXPECT_NE(std::string::npos, body.find("<br/>")) << body;

	// In the body a match would fall inside the line break only: it stays whole and unmarked.
	pressKey("BackSpace");
	pressKey("BackSpace");
	typeText("br");
	EXPECT_EQ(std::string::npos, cardPart("text").find(mark)) << cardPart("text");
	EXPECT_NE(std::string::npos, cardPart("text").find("<br/>"));

	// "%" and "_" are wildcards of the pattern; a quote is doubled and matches itself.
	pressKey("BackSpace");
	pressKey("BackSpace");
	typeText("%");
	EXPECT_EQ(3u, shown().size());
	pressKey("BackSpace");
	typeText("_");
	EXPECT_EQ(3u, shown().size());
	pressKey("BackSpace");
	typeText("'");
	EXPECT_EQ((std::vector<std::string>{"Tom's list"}), shown());
}

TEST_F(SearchViewTest, noResultLayoutAndTheEditorKeepTheQuery)
{
	addMemos();
	openSearch();
	typeText("qqq");
	Evas_Object *content = elm_object_part_content_get(top<MemoSearchView>()->getEvasObj(), "contents");
	const char *group = nullptr;
	elm_layout_file_get(content, nullptr, &group);
	ASSERT_NE(nullptr, group);
	EXPECT_NE(std::string::npos, std::string(group).find("nocontents"));
	EXPECT_NE(std::string::npos, std::string(elm_object_part_text_get(content, "elm.text")).find("No results found"));

	for (int i = 0; i < 3; ++i)
		pressKey("BackSpace");
	typeText("planet");
	tapCardIn(gridIn(top<MemoSearchView>()->getEvasObj()), 0);
	MemoEditView *editor = nullptr;
	ASSERT_TRUE(waitFor([&] { return (editor = top<MemoEditView>()) != nullptr; }));
	EXPECT_STREQ("Planet", editor->getCurrentDocInfo()->getTitle());
	runFor(0.3);
	pressKey("Escape");
	ASSERT_TRUE(waitFor([&] { return top<MemoSearchView>() != nullptr; }));
	runFor(0.3);
	EXPECT_STREQ("planet", elm_entry_entry_get(entry()));
	EXPECT_EQ((std::vector<std::string>{"Planet"}), shown());
}

} // namespace
