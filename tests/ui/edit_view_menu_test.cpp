// The edit view's more menu: its rows in each mode and state, hiding, the memo colour, and sharing to a
// registered target.
#include <app_common.h>
#include <app_i18n.h>

#include "DataBase/MemoFileInfo.h"
#include "box_control_fixture.h"
#include "support/EditViewAppsFixture.h"

using namespace memo_ui_test;

namespace
{
using EditViewMenu = EditViewAppsFixture;

std::vector<std::string> texts(std::initializer_list<const char *> ids)
{
	std::vector<std::string> result;
	for (const char *id : ids)
		result.push_back(i18n_get_text(id));
	return result;
}

const char *const SHARE_TEXT = "http://tizen.org/appcontrol/operation/share_text";
const char *const MULTI_SHARE = "http://tizen.org/appcontrol/operation/multi_share";
} // namespace

TEST_F(EditViewMenu, RowsFollowTheModeAndPowerSaving)
{
	MemoEditView *view = openNew();
	EXPECT_EQ(texts({"IDS_MEMO_OPT_ADD_CHECKLIST_ABB", "IDS_MEMO_OPT_INSERT_IMAGE_ABB",
	                 "IDS_MEMO_OPT_RECORD_AUDIO_ABB2", "IDS_MEMO_OPT_CHANGE_MEMO_COLOUR_ABB"}),
	          openMenu());
	pressKey("Escape");
	settle();
	ASSERT_TRUE(isTop(view));

	// Power saving takes the picture row away.
	vconf_set_int("db/setting/psmode", 1);
	EXPECT_EQ(texts({"IDS_MEMO_OPT_ADD_CHECKLIST_ABB", "IDS_MEMO_OPT_RECORD_AUDIO_ABB2",
	                 "IDS_MEMO_OPT_CHANGE_MEMO_COLOUR_ABB"}),
	          openMenu());
	pressKey("Escape");
	settle();

	// Reading a memo with text: edit, delete, share, and Edit turns it into an edit.
	MemoEditView *reading = openRecord(storedMemo("Read", todoList(todoItem(0, false, "words"))));
	EXPECT_EQ(texts({"IDS_MEMO_HEADER_EDIT_ABB2", "IDS_MEMO_OPT_DELETE", "IDS_MEMO_OPT_SHARE"}), openMenu());
	chooseMenu(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"));
	EXPECT_NE(nullptr, titleButton(reading, "title_right_btn"));
	EXPECT_EQ(i18n_get_text("IDS_MEMO_OPT_ADD_CHECKLIST_ABB"), openMenu().at(0));
}

TEST_F(EditViewMenu, HideIsWrittenAtOnceEvenWhenTheEditIsDiscardedAndTheQuickMemoHasNeither)
{
	MemoDocInfo *record = storedMemo("Secret", todoList(todoItem(0, false, "words")));
	const std::string uuid = record->getMemoUUID();
	MemoEditView *view = new MemoEditView(record, false, false);
	view->setHiddenMode(1);
	push(view);
	EXPECT_EQ(
	    texts({"IDS_MEMO_OPT_HIDE_MEMO", "IDS_MEMO_HEADER_EDIT_ABB2", "IDS_MEMO_OPT_DELETE", "IDS_MEMO_OPT_SHARE"}),
	    openMenu());
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_HIDE_MEMO"));
	EXPECT_EQ("1", query("SELECT isHidden FROM memo WHERE UUID = '" + uuid + "'"));

	EXPECT_EQ(i18n_get_text("IDS_MEMO_OPT_SHOW_MEMO"), openMenu().at(0));
	chooseMenu(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"));
	typeInto(items(view)[1], " more");
	EXPECT_EQ(i18n_get_text("IDS_MEMO_OPT_SHOW_MEMO"), openMenu().at(0));
	pressKey("Escape"); // the menu
	settle();
	pressKey("Escape"); // the page
	settle();
	tapObject(popupButton(2)); // Discard
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ("1", query("SELECT isHidden FROM memo WHERE UUID = '" + uuid + "'"));
	EXPECT_EQ(std::string::npos, query("SELECT tizenXmlContent FROM memo WHERE UUID = '" + uuid + "'").find("more"));

	// The quick memo is neither hidden nor coloured.
	ASSERT_TRUE(MemoDbMgr::getInstance()->addQuickMemo("quick words"));
	const std::string quickUuid = query("SELECT UUID FROM memo WHERE isQuick = 1");
	records.emplace_back(MemoDbMgr::getInstance()->getOneMemoN(quickUuid.c_str()));
	MemoEditView *quick = new MemoEditView(records.back().get(), false, false);
	quick->setHiddenMode(1);
	push(quick);
	EXPECT_EQ(texts({"IDS_MEMO_HEADER_EDIT_ABB2", "IDS_MEMO_OPT_DELETE", "IDS_MEMO_OPT_SHARE"}), openMenu());
	chooseMenu(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"));
	EXPECT_EQ(
	    texts({"IDS_MEMO_OPT_ADD_CHECKLIST_ABB", "IDS_MEMO_OPT_INSERT_IMAGE_ABB", "IDS_MEMO_OPT_RECORD_AUDIO_ABB2"}),
	    openMenu());
}

TEST_F(EditViewMenu, ColourChosenShowsAtOnceAndIsSaved)
{
	MemoEditView *view = openNew();
	typeInto(items(view)[1], "blue");
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_CHANGE_MEMO_COLOUR_ABB"));
	Evas_Object *selector = elm_object_part_content_get(view->getEvasObj(), "colorselector");
	ASSERT_NE(selector, nullptr);
	Elm_Object_Item *swatch =
	    static_cast<Elm_Object_Item *>(eina_list_nth(elm_colorselector_palette_items_get(selector), 3));
	ASSERT_NE(swatch, nullptr);
	tapItem(swatch);
	settle();

	int r = 0, g = 0, b = 0;
	elm_bg_color_get(elm_object_part_content_get(view->getEvasObj(), "changeable_bg"), &r, &g, &b);
	EXPECT_EQ(145, r);
	EXPECT_EQ(224, g);
	EXPECT_EQ(242, b);
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ("145;224;242;255;", query("SELECT bgColor FROM memo WHERE isQuick = 0"));
}

TEST_F(EditViewMenu, ShareSendsTextWithThePathsOrTheFilesAlone)
{
	registerApp("test.share", std::string(SHARE_TEXT) + "," + MULTI_SHARE);
	// A memo with a title, two check lines and a picture with its file row.
	auto withPicture = [this](const char *name, const char *title, const std::string &lines) {
		char *uuid = nullptr;
		MemoUtil::createUUIDN(&uuid);
		const std::string picture = mediaDir(uuid) + name + ".jpg";
		ecore_file_mkpath(mediaDir(uuid).c_str());
		EXPECT_TRUE(writePicture(picture, 200, 150));
		MemoFileInfo file;
		file.setFileUUID(name);
		file.setMemoUUID(uuid);
		file.setMimeType("image/jpeg");
		file.setPath(picture.c_str());
		MemoDocInfo record;
		record.setMemoUUID(uuid);
		record.setTitle(title);
		record.setTizenXmlContent(todoList(lines + todoItem(0, false, escapedTag(200, 150, picture))).c_str());
		record.setFileCount(1);
		record.copyFileInfos(&file);
		EXPECT_TRUE(MemoDbMgr::getInstance()->addMemo(&record));
		records.emplace_back(MemoDbMgr::getInstance()->getOneMemoN(uuid));
		free(uuid);
		return records.back().get();
	};
	auto sharedCopy = [](MemoDocInfo *record, const char *name) {
		char *shared = app_get_shared_data_path();
		const std::string copy =
		    std::string(shared) + "media/" + record->getMemoUUID() + "/" + name + "/memo_media_ab.jpg";
		free(shared);
		return copy;
	};

	MemoDocInfo *listed =
	    withPicture("first-ab", "Trip", todoItem(1, false, "tickets") + todoItem(1, true, "passport"));
	openRecord(listed);
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_SHARE"));
	ASSERT_TRUE(waitLog("test.share", "end\n"));
	std::string log = calleeLog("test.share");
	EXPECT_NE(std::string::npos, log.find(std::string("op=") + SHARE_TEXT + "\n")) << log;
	EXPECT_NE(std::string::npos, log.find("data/text=Trip\n[  ]tickets\n[v]passport\n")) << log;
	EXPECT_NE(std::string::npos, log.find("data/path=" + sharedCopy(listed, "first-ab") + "\n")) << log;
	EXPECT_TRUE(ecore_file_exists(sharedCopy(listed, "first-ab").c_str()));

	// A picture alone goes out as files, named by the first one.
	MemoDocInfo *alone = withPicture("second-ab", "", "");
	openRecord(alone);
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_SHARE"));
	ASSERT_TRUE(waitLog("test.share", "end\n", 2));
	log = calleeLog("test.share");
	log = log.substr(log.find("end\n") + 4);
	EXPECT_NE(std::string::npos, log.find(std::string("op=") + MULTI_SHARE + "\n")) << log;
	EXPECT_NE(std::string::npos, log.find("uri=file://" + sharedCopy(alone, "second-ab") + "\n")) << log;
	EXPECT_NE(std::string::npos, log.find("data/path=" + sharedCopy(alone, "second-ab") + "\n")) << log;
	EXPECT_EQ(std::string::npos, log.find("data/text=")) << log;
}
