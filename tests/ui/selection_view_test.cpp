// The selection page with real taps: deleting chosen memos from the list (outright signed out, tombstones
// signed in), select all and a card taken out again, and the choice of hidden memos.
#include "support/MemoPagesFixture.h"

#include <Ecore_File.h>
#include <sqlite3.h>

#include "DataBase/MemoDbMgr.h"
#include "View/MemoSelectionView.h"

using namespace memo_ui_test;

namespace
{

class SelectionViewTest : public PagesFixture
{
protected:
	MemoSelectionView *page() { return top<MemoSelectionView>(); }
	Evas_Object *grid() { return gridIn(elm_object_part_content_get(page()->getEvasObj(), "memo.grid")); }
	std::string title() { return elm_object_item_part_text_get(page()->getNaviItem(), "elm.text.title"); }
	Evas_Object *selectAllCheck()
	{
		return elm_object_part_content_get(elm_object_part_content_get(page()->getEvasObj(), "memo.selectall"),
		                                   "elm.icon");
	}
	// Taps the right button of the title and waits for the list.
	void act()
	{
		tapOn(titleContent("title_right_btn"));
		ASSERT_TRUE(waitFor([this] { return listView() != nullptr; }));
		runFor(0.3);
	}
	// isDeleted of the row, -1 when the row is gone.
	static int deletedFlag(const std::string &uuid)
	{
		sqlite3 *db = nullptr;
		sqlite3_open((dataPath() + "memo.db").c_str(), &db);
		sqlite3_stmt *stmt = nullptr;
		sqlite3_prepare_v2(db, ("SELECT isDeleted FROM memo WHERE UUID='" + uuid + "'").c_str(), -1, &stmt, nullptr);
		const int flag = sqlite3_step(stmt) == SQLITE_ROW ? sqlite3_column_int(stmt, 0) : -1;
		sqlite3_finalize(stmt);
		sqlite3_close(db);
		return flag;
	}
};

TEST_F(SelectionViewTest, deletesTheChosenOutrightSignedOutAndAsTombstonesSignedIn)
{
	const std::string kept = addMemo(TestMemo("Kept", "one"));
	const std::string older = addMemo(TestMemo("Older", "two"));
	const std::string newer = addMemo(TestMemo("Newer", "three"));
	const std::string media = dataPath() + "media/" + newer + "/";
	ecore_file_mkpath(media.c_str());
	startApp();
	chooseMoreMenu("Delete");
	ASSERT_NE(nullptr, page());
	EXPECT_EQ("Select memos", title());
	EXPECT_TRUE(elm_object_disabled_get(titleContent("title_right_btn")));

	tapCardIn(grid(), 0);
	tapCardIn(grid(), 1);
	EXPECT_EQ("2 selected", title());
	EXPECT_TRUE(elm_check_state_get(
	    elm_object_item_part_content_get(elm_gengrid_first_item_get(grid()), "selection_swallow_check")));
	act();
	EXPECT_EQ(-1, deletedFlag(newer));
	EXPECT_EQ(-1, deletedFlag(older));
	EXPECT_FALSE(ecore_file_exists(media.c_str()));
	EXPECT_EQ(0, deletedFlag(kept));
	EXPECT_EQ(1, listView()->getGridItemCount());

	// Signed in, the memo stays as a tombstone for the sync service.
	vconf_set_str("db/desktop/account/list", "com.veltron.veltronaccount|me|me@example.com");
	chooseMoreMenu("Delete");
	tapCardIn(grid(), 0);
	act();
	EXPECT_EQ(1, deletedFlag(kept));
	EXPECT_EQ(0, listView()->getGridItemCount());
}

TEST_F(SelectionViewTest, selectAllThenOneCardTakenOut)
{
	for (const char *name : {"A", "B", "C"})
		addMemo(TestMemo(name, "text"));
	startApp();
	chooseMoreMenu("Delete");
	tapOn(elm_object_part_content_get(page()->getEvasObj(), "memo.selectall"));
	EXPECT_EQ("3 selected", title());
	EXPECT_TRUE(elm_check_state_get(selectAllCheck()));

	tapCardIn(grid(), 1);
	EXPECT_EQ("2 selected", title());
	EXPECT_FALSE(elm_check_state_get(selectAllCheck()));
	act();
	EXPECT_EQ((std::vector<std::string>{"B"}), titlesIn(gengrid()));

	// Cleared again, nothing is chosen, yet Delete stays enabled and removes nothing.
	chooseMoreMenu("Delete");
	tapOn(elm_object_part_content_get(page()->getEvasObj(), "memo.selectall"));
	tapOn(elm_object_part_content_get(page()->getEvasObj(), "memo.selectall"));
	EXPECT_EQ("Select memos", title());
	EXPECT_FALSE(elm_object_disabled_get(titleContent("title_right_btn")));
	act();
	EXPECT_EQ(1, listView()->getGridItemCount());
}

TEST_F(SelectionViewTest, theChosenHiddenSetLeavesTheListAtOnce)
{
	addMemo(TestMemo("Diary", "secret").hidden());
	addMemo(TestMemo("Shopping", "milk"));
	addMemo(TestMemo("Plans", "trip"));
	startApp();
	ASSERT_EQ(2, listView()->getGridItemCount());
	// As the hidden view opens it: every normal memo, the hidden one ticked.
	ASSERT_TRUE(naviframe()->push(new MemoSelectionView(1)));
	runFor(0.5);
	EXPECT_EQ("1 selected", title());
	EXPECT_FALSE(elm_object_disabled_get(titleContent("title_right_btn")));
	EXPECT_EQ((std::vector<std::string>{"Plans", "Shopping", "Diary"}), titlesIn(grid()));

	tapCardIn(grid(), 0);
	EXPECT_EQ("2 selected", title());
	act();
	EXPECT_EQ((std::vector<std::string>{"Shopping"}), titlesIn(gengrid()));
	EXPECT_EQ(1, MemoDbMgr::getInstance()->getMemoCount() - MemoDbMgr::getInstance()->getHiddenMemoCount());
}

} // namespace
