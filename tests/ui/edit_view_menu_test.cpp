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

TEST_F(EditViewMenu, RowsFollowTheModePowerSavingAndTheQuickMemo)
{
	openNew();
	const std::vector<std::string> editing =
	    texts({"IDS_MEMO_OPT_ADD_CHECKLIST_ABB", "IDS_MEMO_OPT_INSERT_IMAGE_ABB", "IDS_MEMO_OPT_RECORD_AUDIO_ABB2",
	           "IDS_MEMO_OPT_CHANGE_MEMO_COLOUR_ABB"});
	EXPECT_EQ(editing, openMenu());
	pressKey("Escape");
	vconf_set_int("db/setting/psmode", 1); // no pictures and no recording in power saving
	EXPECT_EQ(std::vector<std::string>({editing[0], editing[3]}), openMenu());
	pressKey("Escape");
	vconf_set_int("db/setting/psmode", 0);

	// The quick memo is neither hidden nor coloured, even opened from the hidden memos.
	ASSERT_TRUE(MemoDbMgr::getInstance()->addQuickMemo("quick words"));
	records.emplace_back(
	    MemoDbMgr::getInstance()->getOneMemoN(query("SELECT UUID FROM memo WHERE isQuick = 1").c_str()));
	MemoEditView *quick = new MemoEditView(records.back().get(), false, false);
	quick->setHiddenMode(1);
	push(quick);
	EXPECT_EQ(texts({"IDS_MEMO_HEADER_EDIT_ABB2", "IDS_MEMO_OPT_DELETE", "IDS_MEMO_OPT_SHARE"}), openMenu());
	chooseMenu(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"));
	EXPECT_NE(nullptr, titleButton(quick, "title_right_btn"));
	EXPECT_EQ(std::vector<std::string>(editing.begin(), editing.end() - 1), openMenu());
}

TEST_F(EditViewMenu, HideIsWrittenAtOnceEvenWhenTheEditIsDiscarded)
{
	MemoDocInfo *record = storedMemo("Secret", todoList(todoItem(0, false, "words")));
	const std::string hidden = "SELECT isHidden FROM memo WHERE UUID = '" + std::string(record->getMemoUUID()) + "'";
	MemoEditView *view = new MemoEditView(record, false, false);
	view->setHiddenMode(1);
	push(view);
	EXPECT_EQ(i18n_get_text("IDS_MEMO_OPT_HIDE_MEMO"), openMenu().at(0));
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_HIDE_MEMO"));
	EXPECT_EQ("1", query(hidden));

	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"));
	typeInto(items(view)[1], " more");
	EXPECT_EQ(i18n_get_text("IDS_MEMO_OPT_SHOW_MEMO"), openMenu().at(0));
	pressKey("Escape"); // the menu
	pressKey("Escape"); // the page
	settle();
	tapObject(popupButton(2)); // Discard
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ("1", query(hidden));
}

TEST_F(EditViewMenu, ColourChosenShowsAtOnceAndIsSaved)
{
	MemoEditView *view = openNew();
	typeInto(items(view)[1], "blue");
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_CHANGE_MEMO_COLOUR_ABB"));
	Evas_Object *selector = elm_object_part_content_get(view->getEvasObj(), "colorselector");
	ASSERT_NE(selector, nullptr);
	tapItem(static_cast<Elm_Object_Item *>(eina_list_nth(elm_colorselector_palette_items_get(selector), 3)));
	settle();
	int rgb[3] = {0, 0, 0};
	elm_bg_color_get(elm_object_part_content_get(view->getEvasObj(), "changeable_bg"), &rgb[0], &rgb[1], &rgb[2]);
	EXPECT_EQ(std::vector<int>({145, 224, 242}), std::vector<int>(rgb, rgb + 3));
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ("145;224;242;255;", query("SELECT bgColor FROM memo WHERE isQuick = 0"));
}

TEST_F(EditViewMenu, ShareSendsTextWithThePathsOrTheFilesAlone)
{
	registerApp("test.share", std::string(SHARE_TEXT) + "," + MULTI_SHARE);
	// A memo of `lines` and a picture with its file row; the picture's copy for sharing.
	auto withPicture = [this](const char *name, const char *title, const std::string &lines) {
		const std::string uuid = std::string(name) + "-memo", picture = mediaDir(uuid.c_str()) + name + ".jpg";
		ecore_file_mkpath(mediaDir(uuid.c_str()).c_str());
		EXPECT_TRUE(writePicture(picture, 200, 150));
		MemoDocInfo *record =
		    storedMemo(title, todoList(lines + todoItem(0, false, tag(200, 150, picture))), uuid.c_str());
		MemoFileInfo file;
		file.setFileUUID(name);
		file.setMemoUUID(uuid.c_str());
		file.setPath(picture.c_str());
		EXPECT_TRUE(MemoDbMgr::getInstance()->addNewFile(&file));
		return record;
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
	pickInChooser("test.share");
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
	pickInChooser("test.share");
	ASSERT_TRUE(waitLog("test.share", "end\n", 2));
	log = calleeLog("test.share");
	log = log.substr(log.find("end\n") + 4);
	EXPECT_NE(std::string::npos, log.find(std::string("op=") + MULTI_SHARE + "\n")) << log;
	EXPECT_NE(std::string::npos, log.find("uri=file://" + sharedCopy(alone, "second-ab") + "\n")) << log;
	EXPECT_NE(std::string::npos, log.find("data/path=" + sharedCopy(alone, "second-ab") + "\n")) << log;
	EXPECT_EQ(std::string::npos, log.find("data/text=")) << log;
}
