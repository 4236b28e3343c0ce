// Reading and editing: a stored memo opens read only, the empty area turns it into an edit, and leaving asks
// before work is thrown away.
#include "box_control_fixture.h"
#include "support/EditViewFixture.h"

using namespace memo_ui_test;

namespace
{
using EditViewModes = EditViewFixture;

size_t mediaFolderCount()
{
	Eina_List *entries = ecore_file_ls((std::string(MemoUtil::getDataPath()) + "media").c_str());
	const size_t count = eina_list_count(entries);
	void *data = nullptr;
	EINA_LIST_FREE(entries, data)
	free(data);
	return count;
}
} // namespace

TEST_F(EditViewModes, RecordReadsUntilATapAndAnUntouchedEditWritesNothing)
{
	MemoEditView *view = openRecord(storedMemo("Read me", todoList(todoItem(0, false, "some text"))));
	EXPECT_EQ(nullptr, titleButton(view, "title_right_btn"));
	const char *time = elm_object_part_text_get(view->getEvasObj(), "time");
	EXPECT_TRUE(time && *time);

	countWrites();
	pressUnderText(view, 21, 0); // a drag
	EXPECT_EQ(nullptr, titleButton(view, "title_right_btn"));
	pressUnderText(view, 20, 0); // still a tap
	Evas_Object *done = titleButton(view, "title_right_btn");
	ASSERT_NE(done, nullptr);
	EXPECT_FALSE(elm_object_disabled_get(done));
	EXPECT_NE(nullptr, entryOf(items(view)[1]));

	// The baseline came from the editor's own composition: nothing reads as changed.
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ(0, memoWrites());
}

TEST_F(EditViewModes, BackClosesTheColourSelectorThenDiscardRemovesTheNewMemoFolder)
{
	const size_t folders = mediaFolderCount();
	MemoEditView *view = openNew();
	EXPECT_EQ(folders + 1, mediaFolderCount());
	typeInto(items(view)[1], "colour");

	pressKey("F2");
	settle();
	app_assist::WViewController *menu = view->getPopup();
	ASSERT_NE(menu, nullptr);
	// The menu's items stand in a list inside it; the colour item is the last.
	Evas_Object *list = elm_object_content_get(menu->getEvasObj());
	ASSERT_NE(list, nullptr);
	Elm_Object_Item *colourItem = static_cast<Elm_Object_Item *>(eina_list_last_data_get(elm_list_items_get(list)));
	ASSERT_NE(colourItem, nullptr);
	Evas_Object *track = elm_object_item_track(colourItem);
	tapObject(track);
	elm_object_item_untrack(colourItem);
	settle();
	ASSERT_NE(nullptr, elm_object_part_content_get(view->getEvasObj(), "colorselector"));

	pressKey("Escape");
	settle();
	EXPECT_EQ(nullptr, elm_object_part_content_get(view->getEvasObj(), "colorselector"));
	EXPECT_FALSE(MemoPopupMonitor::getInstance()->isPopupAlive());
	EXPECT_TRUE(isTop(view));

	pressKey("Escape");
	settle();
	ASSERT_TRUE(MemoPopupMonitor::getInstance()->isPopupAlive());
	tapObject(popupButton(2)); // Discard
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ(folders, mediaFolderCount());
	EXPECT_EQ("", query("SELECT UUID FROM memo WHERE isQuick = 0"));
}

TEST_F(EditViewModes, DiscardingAnEditKeepsTheMemoAndItsFolder)
{
	MemoDocInfo *record = storedMemo("Keep", todoList(todoItem(0, false, "as it was")));
	const std::string picture = mediaDir(record->getMemoUUID()) + "added.jpg";
	MemoEditView *view = openRecord(record);
	pressUnderText(view, 0, 0);
	ASSERT_TRUE(writePicture(picture, 64, 64)); // as if added during the edit
	typeInto(items(view)[1], " and more");

	tapObject(titleButton(view, "title_left_btn")); // Cancel
	settle();
	tapObject(popupButton(2));
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_TRUE(ecore_file_exists(picture.c_str()));
	const std::string stored =
	    query(std::string("SELECT tizenXmlContent FROM memo WHERE UUID = '") + record->getMemoUUID() + "'");
	EXPECT_NE(stored.find("as it was"), std::string::npos);
	EXPECT_EQ(stored.find("and more"), std::string::npos);
}
