// Pictures from other apps in the edit view: the insert popup, gallery and camera replies, the limit of ten,
// refused pictures, the image viewer's delete, pictures handed in at launch and the attach panel.
#include <app_i18n.h>

#include <fstream>

#include "box_control_fixture.h"
#include "support/EditViewAppsFixture.h"

using namespace memo_ui_test;

namespace
{
class EditViewImages : public EditViewAppsFixture
{
protected:
	void SetUp() override
	{
		EditViewAppsFixture::SetUp();
		pictures = memo_test::makeTempDir("pictures");
	}

	// The cells of the insert popup, opened from the more menu.
	std::vector<Evas_Object *> openInsertPopup()
	{
		openMenu();
		chooseMenu(i18n_get_text("IDS_MEMO_OPT_INSERT_IMAGE_ABB"));
		std::vector<Evas_Object *> cells;
		app_assist::WViewController *popup = MemoPopupMonitor::getInstance()->getPopup();
		Evas_Object *box = popup ? elm_object_content_get(popup->getEvasObj()) : nullptr;
		Eina_List *children = box ? elm_box_children_get(box) : nullptr;
		void *data = nullptr;
		EINA_LIST_FREE(children, data)
		cells.push_back(static_cast<Evas_Object *>(data));
		return cells;
	}
	std::string picture(const std::string &name, int w, int h)
	{
		const std::string path = pictures + "/" + name;
		EXPECT_TRUE(writePicture(path, w, h));
		return path;
	}
	// The first picture in the body of the page, and the files in its folder (the thumbnail folder aside).
	std::string firstPicture(MemoEditView *view)
	{
		const std::string text = body(view);
		const size_t at = text.find("href=file://") + 12;
		return at < 12 ? "" : text.substr(at, text.find('>', at) - at);
	}
	static std::vector<std::string> filesBeside(const std::string &file)
	{
		const std::string folder = file.substr(0, file.rfind('/') + 1);
		std::vector<std::string> files;
		Eina_List *entries = ecore_file_ls(folder.c_str());
		void *data = nullptr;
		EINA_LIST_FREE(entries, data)
		{
			if (strcmp(static_cast<char *>(data), "thumb"))
				files.push_back(folder + static_cast<char *>(data));
			free(data);
		}
		return files;
	}
	// Whether a copy is small enough to need no more shrinking.
	static bool fits(const std::string &file)
	{
		int w = 0, h = 0, error = 0;
		return !MemoUtil::getInsertImageSize(file.c_str(), &w, &h, &error) && error == 0;
	}
	// A file the app refuses as a picture.
	std::string refused()
	{
		const std::string path = pictures + "/refused.png";
		std::ofstream(path) << "not a picture";
		return path;
	}
	std::string body(MemoEditView *view) { return textOf(entryOf(items(view)[1])); }
	int toasts(const char *id)
	{
		char text[200];
		snprintf(text, sizeof(text), i18n_get_text(id), 10);
		int n = 0;
		for (int i = 0; i < desktop_toast_log_count(); i++)
			n += desktop_toast_log_get(i) && !strcmp(text, desktop_toast_log_get(i));
		return n;
	}

	std::string pictures;
};

} // namespace

TEST_F(EditViewImages, GalleryAndCameraLaunchOnceAndTheirPicturesComeInAtOnceOrThroughAWorker)
{
	const std::string icon = picture("icon.png", 64, 64);
	registerApp("com.veltron.gallery-lite", "", icon);
	registerApp("tizen.gallery");
	registerApp("test.camera", "http://tizen.org/appcontrol/operation/create_content");
	MemoEditView *view = openNew();
	typeInto(items(view)[1], "x");

	// An empty answer: nothing changes. Two quick touches make one request.
	setReply("tizen.gallery", "canceled\n");
	std::vector<Evas_Object *> cells = openInsertPopup();
	ASSERT_EQ(2u, cells.size());
	EXPECT_NE(nullptr, elm_object_part_content_get(cells[0], "app_icon"));
	tapObject(cells[0]);
	tapObject(cells[0]);
	ASSERT_TRUE(waitLog("tizen.gallery", "replied"));
	settle(0.3);
	std::string log = calleeLog("tizen.gallery");
	EXPECT_EQ(1u, memo_test::countOf(log, "request first"));
	EXPECT_NE(std::string::npos, log.find("op=http://tizen.org/appcontrol/operation/pick\n")) << log;
	EXPECT_NE(std::string::npos, log.find("mime=image/*\n")) << log;
	EXPECT_EQ(std::string::npos, body(view).find("<item"));

	// A second later the popup has gone and the gallery may be asked again: a small picture comes in as it is.
	ASSERT_TRUE(waitFor([] { return !MemoPopupMonitor::getInstance()->isPopupAlive(); }, 1.5));
	const std::string small = picture("small.jpg", 400, 300);
	setReply("tizen.gallery", "succeeded\n" + small + "\n");
	tapObject(openInsertPopup().at(0));
	ASSERT_TRUE(waitFor([&] { return body(view).find("<item") != std::string::npos; }, 10.0));
	const std::string copy = firstPicture(view);
	EXPECT_TRUE(eina_str_has_extension(copy.c_str(), ".jpg")) << copy;
	EXPECT_TRUE(memo_test::readFile(small) == memo_test::readFile(copy)); // not re-encoded

	// A large one from the camera is shrunk on a worker under the progress popup.
	const std::string large = picture("large.jpg", 1600, 1200);
	setReply("test.camera", "succeeded\n" + large + "\n");
	ASSERT_TRUE(waitFor([] { return !MemoPopupMonitor::getInstance()->isPopupAlive(); }, 1.5));
	tapObject(openInsertPopup().at(1));
	ASSERT_TRUE(waitFor([] { return desktop_app_chooser_current_get() != nullptr; }, 2.0));
	pickInChooser("test.camera");
	ASSERT_TRUE(waitFor([&] { return MemoEditViewTestAccess::isProcessing(view); }, 10.0));
	ASSERT_TRUE(waitFor([&] { return !MemoEditViewTestAccess::isProcessing(view); }, 10.0));
	log = calleeLog("test.camera");
	EXPECT_NE(std::string::npos, log.find("mime=image/jpg\nextra CALLER=message\nextra RESOLUTION=VGA\n")) << log;
	const std::vector<std::string> files = filesBeside(copy);
	ASSERT_EQ(2u, files.size());
	for (const std::string &file : files) {
		EXPECT_TRUE(fits(file)) << file;
		EXPECT_NE(std::string::npos, body(view).find(file)) << file;
	}
}

TEST_F(EditViewImages, TheTenthPictureShowsTheLimitAtOnceAndRefusedOrDotlessPicturesAreHandled)
{
	char *uuid = nullptr;
	ASSERT_TRUE(MemoUtil::createUUIDN(&uuid));
	const std::string folder = mediaDir(uuid);
	ecore_file_mkpath(folder.c_str());
	std::string tags;
	for (int i = 0; i < 9; i++) {
		const std::string path = folder + "picture" + std::to_string(i) + ".jpg";
		ASSERT_TRUE(writePicture(path, 200, 150));
		tags += tag(200, 150, path);
	}
	MemoEditView *view = openRecord(storedMemo("", todoList(todoItem(0, false, "nine" + tags)), uuid));
	free(uuid);
	pressUnderText(view, 0, 0);
	desktop_toast_log_clear();
	EXPECT_TRUE(view->insertImage(picture("tenth.jpg", 200, 150).c_str()));
	EXPECT_EQ(10u, memo_test::countOf(body(view), "<item"));
	EXPECT_EQ(1, toasts("IDS_MEMO_TPOP_CANT_INSERT_MORE_THAN_PD_IMAGES"));
	EXPECT_TRUE(openInsertPopup().empty());
	EXPECT_EQ(2, toasts("IDS_MEMO_TPOP_CANT_INSERT_MORE_THAN_PD_IMAGES"));

	// A picture the app refuses is not copied.
	MemoEditView *fresh = openNew();
	desktop_toast_log_clear();
	fresh->insertImage(refused().c_str());
	EXPECT_EQ(1, toasts("IDS_MEMO_TPOP_RESOLUTION_NOT_SUPPORTED_BY_MEMO"));
	EXPECT_EQ(std::string::npos, body(fresh).find("<item"));

	// A large picture named without a dot keeps no extension, and the worker's canvas path cannot save it.
	const std::string dotless = pictures + "/dotless";
	ASSERT_EQ(0, rename(picture("dotless.jpg", 1600, 1200).c_str(), dotless.c_str()));
	fresh->insertImage(dotless.c_str());
	ASSERT_TRUE(waitFor([&] { return body(fresh).find("<item") != std::string::npos; }, 10.0));
	const std::string copy = firstPicture(fresh);
	EXPECT_EQ(nullptr, strchr(ecore_file_file_get(copy.c_str()), '.')) << copy;
	EXPECT_TRUE(memo_test::readFile(dotless) == memo_test::readFile(copy));
	// The refused picture left nothing in the folder.
	EXPECT_EQ(1u, filesBeside(copy).size());
}

TEST_F(EditViewImages, ViewerDeleteInAnEditTakesThePictureOutAndTheFileGoesAtDone)
{
	registerApp("com.veltron.image-viewer");
	setReply("com.veltron.image-viewer", "succeeded\n"); // the reply carries "DeleteMenu" back
	char *uuid = nullptr;
	ASSERT_TRUE(MemoUtil::createUUIDN(&uuid));
	const std::string path = mediaDir(uuid) + "shown.jpg";
	ecore_file_mkpath(mediaDir(uuid).c_str());
	ASSERT_TRUE(writePicture(path, 600, 450));
	MemoEditView *view = openRecord(storedMemo("", todoList(todoItem(0, false, "a" + tag(600, 450, path))), uuid));
	free(uuid);
	pressUnderText(view, 0, 0);
	ASSERT_NE(std::string::npos, body(view).find("<item"));

	tapObject(entryOf(items(view)[1]));
	ASSERT_TRUE(waitLog("com.veltron.image-viewer", "replied"));
	const std::string log = calleeLog("com.veltron.image-viewer");
	EXPECT_NE(std::string::npos, log.find("op=http://tizen.org/appcontrol/operation/view\n")) << log;
	EXPECT_NE(std::string::npos, log.find("shared/data/view/shown.jpg\n")) << log;
	EXPECT_NE(std::string::npos, log.find("extra DeleteMenu=TRUE\n")) << log;
	ASSERT_TRUE(waitFor([&] { return body(view).find("<item") == std::string::npos; }));
	EXPECT_TRUE(ecore_file_exists(path.c_str()));

	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_FALSE(ecore_file_exists(path.c_str()));
}

TEST_F(EditViewImages, AttachPanelPicksAreCopiedShrunkAndInsertedTogether)
{
	MemoEditView *view = openNew();
	typeInto(items(view)[1], "x");
	const std::string picks = picture("small.jpg", 400, 300) + ":" + refused() + ":" + picture("large.png", 1200, 900);
	setenv("TIZEN_ATTACH_PANEL_AUTOSELECT", picks.c_str(), 1);
	desktop_toast_log_clear();
	MemoEditViewTestAccess::createAttachPanel(view);
	EXPECT_TRUE(MemoEditViewTestAccess::isAttachPanelOpened(view));
	ASSERT_TRUE(waitFor([&] { return memo_test::countOf(body(view), "<item") == 2; }, 10.0));
	unsetenv("TIZEN_ATTACH_PANEL_AUTOSELECT");
	EXPECT_TRUE(waitFor([&] { return toasts("IDS_MEMO_TPOP_RESOLUTION_NOT_SUPPORTED_BY_MEMO") == 1; }));

	const std::vector<std::string> files = filesBeside(firstPicture(view));
	ASSERT_EQ(2u, files.size());
	EXPECT_TRUE(fits(files[0]) && fits(files[1]));
	// The menu first takes the open panel down.
	openMenu();
	EXPECT_FALSE(MemoEditViewTestAccess::isAttachPanelOpened(view));
}
