// Saving from the edit view: what Done writes, what it refuses, and the save at application exit.
#include <app_i18n.h>

#include "TestEnv.h"
#include "box_control_fixture.h"
#include "support/EditViewFixture.h"

using namespace memo_ui_test;

namespace
{
const char *const STORAGE_KEY = "db/desktop/storage/internal_free_bytes";

using EditViewSave = EditViewFixture;
} // namespace

TEST_F(EditViewSave, NewMemoSavedByDoneIsOneRowWithEveryFormAndItsPicture)
{
	countWrites();
	MemoEditView *view = openNew();
	std::vector<Evas_Object *> layouts = items(view);
	ASSERT_GE(layouts.size(), 2u);
	Evas_Object *done = titleButton(view, "title_right_btn");
	ASSERT_NE(done, nullptr);
	EXPECT_TRUE(elm_object_disabled_get(done)); // nothing to save yet

	typeInto(layouts[0], "Trip");
	typeInto(layouts[1], "pack the tent");
	const std::string picture = memo_test::makeTempDir("pictures") + "/lake.jpg";
	ASSERT_TRUE(writePicture(picture, 320, 240));
	view->insertTextToBody(("<item size=240x180 vsize=full href=file://" + picture + "></item>").c_str());
	settle(0.5);
	EXPECT_FALSE(elm_object_disabled_get(done));

	// A second press inside the 0.2 s before the save adds nothing.
	pressDone(view);
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ(1, memoWrites());

	const std::string uuid = query("SELECT UUID FROM memo WHERE isQuick = 0");
	const std::string row = "FROM memo WHERE UUID = '" + uuid + "'";
	EXPECT_EQ("Trip", query("SELECT title " + row));
	EXPECT_NE(query("SELECT content " + row).find("pack the tent"), std::string::npos);
	for (const char *column : {"tizenXmlContent", "xmlContent", "display_Content", "strippedContent"})
		EXPECT_NE(query(std::string("SELECT ") + column + " " + row).find("pack the tent"), std::string::npos)
		    << column;
	EXPECT_EQ("1", query("SELECT count(*) FROM file WHERE memoUUID = '" + uuid + "'"));
	const std::string copy = query("SELECT path FROM file WHERE memoUUID = '" + uuid + "'");
	EXPECT_EQ(0u, copy.find(mediaDir(uuid.c_str())));
	EXPECT_TRUE(ecore_file_exists(copy.c_str()));
	EXPECT_TRUE(ecore_file_exists(query("SELECT _data " + row).c_str())); // the thumbnail
}

TEST_F(EditViewSave, TitleAloneSavesNothingAndLeavesTheQuickMemo)
{
	ASSERT_TRUE(MemoDbMgr::getInstance()->addQuickMemo("keep me"));
	countWrites();
	MemoEditView *view = openNew();
	typeInto(items(view)[0], "Only a title");
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ(0, memoWrites());
	EXPECT_NE(query("SELECT content FROM memo WHERE _id = 1").find("keep me"), std::string::npos);
}

TEST_F(EditViewSave, FullStorageStopsDoneWithItsPopupUntilThereIsRoom)
{
	MemoEditView *view = openNew();
	typeInto(items(view)[1], "note");
	countWrites();
	vconf_set_int(STORAGE_KEY, 1000);
	pressDone(view);
	settle();
	EXPECT_TRUE(MemoPopupMonitor::getInstance()->isPopupAlive());
	EXPECT_TRUE(isTop(view));
	EXPECT_EQ(0, memoWrites());

	tapObject(popupButton(1)); // Cancel
	settle();
	EXPECT_FALSE(MemoPopupMonitor::getInstance()->isPopupAlive());
	vconf_unset(STORAGE_KEY);
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ(1, memoWrites());
}

TEST_F(EditViewSave, EndingTheAppSavesTheOpenEdit)
{
	MemoDocInfo *record = storedMemo("Plan", todoList(todoItem(0, false, "first")));
	MemoEditView *view = openRecord(record);
	pressUnderText(view, 0, 0);
	typeInto(items(view)[1], " and second");
	terminated = true;
	app->onTerminate();
	EXPECT_EQ("first and second",
	          query(std::string("SELECT content FROM memo WHERE UUID = '") + record->getMemoUUID() + "'"));
}
