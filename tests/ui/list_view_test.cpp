// The first screen as the app shows it (MemoApp on the buffer engine, real key and pointer events): the empty
// state and the floating button, cards that open the editor, reloads on return and on the sync service's
// word, the storage checks, and the more menu.
#include "support/MemoListFixture.h"

#include <sqlite3.h>
#include <vconf.h>

#include <WContentViewController.h>
#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"
#include "Model/MemoPopupMonitor.h"
#include "TestEnv.h"
#include "View/MemoEditView.h"
#include "View/MemoListView.h"

using namespace memo_ui_test;

namespace
{

// A page pushed over the list, standing for whatever view the list goes on to.
class CoverPage : public app_assist::WContentViewController
{
protected:
	Evas_Object *onCreateView(Evas_Object *parent, void *) override { return elm_bg_add(parent); }
};

class ListViewTest : public ListViewFixture
{
protected:
	void withoutQuickMemo() { vconf_set_int("db/desktop/csc/feature_92", 0); }
	bool showsEmptyState()
	{
		Evas_Object *content = elm_object_part_content_get(listView()->getEvasObj(), "contents");
		const char *group = nullptr;
		if (content)
			elm_layout_file_get(content, nullptr, &group);
		return content && !gengrid() && group && std::string(group).find("nocontents") != std::string::npos;
	}
	void tapFloatingButton()
	{
		int x = 0, y = 0;
		centreOf(floatingButton(), &x, &y);
		tap(x, y);
		runFor(0.05);
	}
	// Pushes a page over the list, runs change, then goes back to the list with the back key.
	void coverAndComeBack(const std::function<void()> &change)
	{
		ASSERT_TRUE(naviframe()->push(new CoverPage()));
		runFor(0.4);
		change();
		pressKey("Escape");
		ASSERT_TRUE(waitFor([this] { return listView() != nullptr; }));
		runFor(0.4);
	}
	// The editor once it is on top and settled, else null.
	MemoEditView *editorOnTop()
	{
		MemoEditView *editor = nullptr;
		waitFor([&] { return (editor = dynamic_cast<MemoEditView *>(naviframe()->getTopContentViewController())); });
		runFor(0.3);
		render();
		return editor;
	}
	Evas_Object *doneButton(MemoEditView *editor)
	{
		return elm_object_item_part_content_get(editor->getNaviItem(), "title_right_btn");
	}
	// Taps the body item of a new memo (the one after the title) and types text into it.
	void typeIntoBody(MemoEditView *editor, const char *text)
	{
		Evas_Object *scroller = elm_object_part_content_get(editor->getEvasObj(), "edit_view_contents");
		Eina_List *items = elm_box_children_get(elm_object_content_get(scroller));
		Evas_Object *body = static_cast<Evas_Object *>(eina_list_nth(items, 1));
		eina_list_free(items);
		ASSERT_NE(nullptr, body);
		tapOn(elm_object_part_content_get(elm_object_part_content_get(body, "content"), "entry"));
		typeText(text);
		runFor(0.2);
	}
	void backToList()
	{
		pressKey("Escape");
		ASSERT_TRUE(waitFor([this] { return listView() != nullptr; }));
		runFor(0.4);
	}
};

TEST_F(ListViewTest, emptyStoreShowsEmptyStateThenTheNewMemoAfterTheEditor)
{
	withoutQuickMemo();
	startApp();
	ASSERT_NE(nullptr, listView());
	EXPECT_TRUE(showsEmptyState());
	EXPECT_EQ(0, listView()->getGridItemCount());
	ASSERT_NE(nullptr, floatingButton());
	EXPECT_EQ(std::string("Memo"), elm_object_part_text_get(listView()->getEvasObj(), "naviframe.title"));

	// The button starts a new memo; what is typed there and saved by Done shows as the one card on return.
	tapFloatingButton();
	MemoEditView *editor = editorOnTop();
	ASSERT_NE(nullptr, editor);
	EXPECT_EQ(nullptr, editor->getCurrentDocInfo());
	EXPECT_EQ(nullptr, floatingButton());
	typeIntoBody(editor, "milk and bread");
	ASSERT_NE(nullptr, doneButton(editor));
	tapOn(doneButton(editor));
	ASSERT_TRUE(waitFor([this] { return listView() != nullptr; }));
	runFor(0.4);
	ASSERT_NE(nullptr, gengrid());
	EXPECT_EQ(1, listView()->getGridItemCount());
	EXPECT_EQ(1u, elm_gengrid_items_count(gengrid()));
	EXPECT_NE(nullptr, floatingButton());

	// A tap on the card opens it read-only (no Done); a memo written meanwhile shows after back.
	tapCard(0);
	editor = editorOnTop();
	ASSERT_NE(nullptr, editor);
	ASSERT_NE(nullptr, editor->getCurrentDocInfo());
	EXPECT_NE(std::string::npos, std::string(editor->getCurrentDocInfo()->getContent()).find("milk and bread"));
	EXPECT_EQ(nullptr, doneButton(editor));
	addMemo(TestMemo("Groceries", "eggs"));
	backToList();
	EXPECT_EQ(2, listView()->getGridItemCount());
	EXPECT_EQ(2u, elm_gengrid_items_count(gengrid()));

	// Emptied elsewhere: the return shows the empty state again.
	coverAndComeBack([&] {
		MemoItemList *memos = MemoDbMgr::getInstance()->getVisibleMemoListN();
		for (int i = 0; i < memos->getCount(); ++i)
			MemoDbMgr::getInstance()->removeMemo(memos->getItem(i)->getMemoUUID());
		delete memos;
	});
	EXPECT_TRUE(showsEmptyState());
	EXPECT_EQ(0, listView()->getGridItemCount());
}

TEST_F(ListViewTest, syncIdleAfterAnotherWriterReloadsTheList)
{
	addMemo(TestMemo("First", "one"));
	startApp();
	ASSERT_EQ(2, listView()->getGridItemCount()); // the quick memo and the first memo

	// The sync service writes a memo and says it is idle again.
	sqlite3 *db = nullptr;
	ASSERT_EQ(SQLITE_OK, sqlite3_open((dataPath() + "memo.db").c_str(), &db));
	ASSERT_EQ(SQLITE_OK, sqlite3_exec(db,
	                                  "INSERT INTO memo(UUID, title, display_Content, tizenXmlContent, "
	                                  "lastModifiedAt, createdAt) VALUES('from-sync', 'Synced', 'text', "
	                                  "'<todolist></todolist>', 9999999999999, 1)",
	                                  nullptr, nullptr, nullptr));
	sqlite3_close(db);
	std::string writer = memo_test::helperPath("test_writer") + " pref-int MEMO_SVC_PROCESSING ";
	ASSERT_EQ(0, memo_test::runCommand(writer + "1"));
	ASSERT_EQ(0, memo_test::runCommand(writer + "0"));
	EXPECT_TRUE(waitFor([this] { return listView()->getGridItemCount() == 3; }, 5.0));
}

TEST_F(ListViewTest, storageBelowTheLimitGivesThePopupOrAToast)
{
	withoutQuickMemo();
	vconf_set_int("db/desktop/storage/internal_free_bytes", 1000);
	startApp();
	tapFloatingButton();
	EXPECT_TRUE(MemoPopupMonitor::getInstance()->isPopupAlive());
	EXPECT_EQ(std::string::npos, logSince().find("open the editor"));
	// Cancel closes it.
	MemoPopupMonitor::getInstance()->getPopup()->destroy();
	runFor(0.05);
	EXPECT_FALSE(MemoPopupMonitor::getInstance()->isPopupAlive());

	// In power saving a status message stands for the popup.
	vconf_set_int("db/setting/psmode", 1);
	desktop_toast_log_clear();
	tapFloatingButton();
	EXPECT_FALSE(MemoPopupMonitor::getInstance()->isPopupAlive());
	ASSERT_EQ(1, desktop_toast_log_count());
	EXPECT_STREQ("Not enough space in phone storage.", desktop_toast_log_get(0));
}

TEST_F(ListViewTest, moreMenuOffersDeleteAndSearchOnlyWithMemos)
{
	withoutQuickMemo();
	startApp();
	pressKey("F2");
	EXPECT_NE(std::string::npos, logSince().find("There is no memo. More button skipped."));
	EXPECT_EQ(nullptr, listView()->getPopup());

	coverAndComeBack([] { addMemo(TestMemo("Plan", "steps")); });
	pressKey("F2");
	ASSERT_NE(nullptr, listView()->getPopup());
	EXPECT_STREQ("WMenuPopupController", listView()->getPopup()->getClassName());
	Evas_Object *menu = listView()->getPopup()->getEvasObj();
	Elm_Object_Item *first = elm_ctxpopup_first_item_get(menu);
	ASSERT_NE(nullptr, first);
	EXPECT_STREQ("Delete", elm_object_item_text_get(first));
	EXPECT_STREQ("Search", elm_object_item_text_get(elm_ctxpopup_item_next_get(first)));
}

} // namespace
