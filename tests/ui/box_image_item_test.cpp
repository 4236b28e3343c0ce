// Pictures inside box items: tag sizes by scale, load errors, the objects that stand for tags, taps on
// them, removal and counting.
#include <gtest/gtest.h>

#include <algorithm>

#include "TestEnv.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

namespace
{
class BoxImageItemTest : public BoxControlFixture
{
protected:
	// The objects the entries made for image tags (they carry their path), anywhere in the window.
	std::vector<Evas_Object *> imageObjects()
	{
		render();
		// Every object of the canvas: the top-level ones and, inside them, the smart members.
		std::vector<Evas_Object *> found;
		for (Evas_Object *obj = evas_object_bottom_get(evas()); obj; obj = evas_object_above_get(obj))
			collect(obj, found);
		return found;
	}

	static void collect(Evas_Object *obj, std::vector<Evas_Object *> &found)
	{
		if (evas_object_data_get(obj, "path"))
			found.push_back(obj);
		Eina_List *members = evas_object_smart_members_get(obj);
		void *data = nullptr;
		EINA_LIST_FREE(members, data)
		collect(static_cast<Evas_Object *>(data), found);
	}

	static std::string groupOf(Evas_Object *layout)
	{
		const char *group = nullptr;
		elm_layout_file_get(layout, nullptr, &group);
		return group ? group : "";
	}
};
} // namespace

TEST_F(BoxImageItemTest, InsertedPicturesTakeTheWidthOfTheirLineUnreadableOnesAreRefused)
{
	// At scale 1.8 a picture of 1000 x 500 gets 603 x 341 in a text block, 506 x 293 on a check line.
	elm_config_scale_set(1.8);
	const std::string path = picture("wide.png");
	withBody(todoItem(0, false, "") + todoItem(1, false, ""));
	focusAt(items()[0]);
	ASSERT_TRUE(control->insertImage(path.c_str()));
	runFor(0.05);
	// At the line's start no break goes in front.
	EXPECT_EQ(tag(603, 341, path) + "<br/>", text(items()[0]));
	typeText("abc");
	ASSERT_TRUE(control->insertImage(path.c_str()));
	runFor(0.05);
	EXPECT_EQ(tag(603, 341, path) + "<br/>abc<br/>" + tag(603, 341, path) + "<br/>", text(items()[0]));
	focusAt(items()[1]);
	ASSERT_TRUE(control->insertImage(path.c_str()));
	runFor(0.05);
	EXPECT_EQ(tag(506, 293, path) + "<br/>", text(items()[1]));

	// Several pictures go in as one insertion: 100 * 603 / 200 + 40 = 341 and 200 * 603 / 100 + 40 = 1246.
	const std::string a = picture("a.png", 200, 100), b = picture("b.png", 100, 200);
	withBody(todoItem(0, false, "x"));
	focusAt(items()[0]);
	Eina_List *list = eina_list_append(eina_list_append(nullptr, a.c_str()), b.c_str());
	ASSERT_TRUE(control->insertImages(list));
	eina_list_free(list);
	runFor(0.05);
	EXPECT_EQ("x<br/>" + tag(603, 341, a) + "<br/>" + tag(603, 1246, b) + "<br/>", text(items()[0]));

	// A picture that cannot be read is refused with a toast, and removed.
	const std::string broken = mediaDir() + "broken.jpg";
	memo_test::runCommand("echo 'not a picture' > '" + broken + "'");
	EXPECT_FALSE(control->insertImage(broken.c_str()));
	EXPECT_EQ(1, desktop_toast_log_count());
	EXPECT_FALSE(ecore_file_exists(broken.c_str()));
	EXPECT_EQ(0u, text(items()[0]).find("x<br/>"));
	EXPECT_EQ(2u, memo_test::countOf(text(items()[0]), "<item"));
}

// A missing file shows the default layout and keeps its tag; a large picture is decoded in the background
// and no larger than its place, so that opening a memo never decodes a whole camera picture on the main
// loop; the pictures of ticked lines are faded.
TEST_F(BoxImageItemTest, StoredPicturesShowAsTheyCan)
{
	const std::string camera = picture("camera.jpg", 2400, 1600), faded = picture("faded.png", 300, 200);
	const std::string missing = mediaDir() + "gone.jpg";
	const std::string lines =
	    todoItem(0, false, "a" + tag(628, 458, camera) + "<br/>b" + tag(628, 354, missing) + "<br/>") +
	    todoItem(1, true, tag(521, 387, faded) + "<br/>");
	withBody(lines);
	EXPECT_EQ(todoList(lines), document(control));
	Eina_List *images = control->getImageList();
	ASSERT_EQ(3u, eina_list_count(images));
	EXPECT_EQ(missing, static_cast<const char *>(eina_list_nth(images, 1)));
	EXPECT_EQ(3, control->onEntryCheckImageCount());

	std::vector<Evas_Object *> objects = imageObjects();
	ASSERT_EQ(3u, objects.size());
	for (Evas_Object *obj : objects) {
		const std::string path = static_cast<const char *>(evas_object_data_get(obj, "path"));
		EXPECT_EQ(path == missing ? "default_image_layout" : "image_layout", groupOf(obj)) << path;
		if (path == missing)
			continue;
		Evas_Object *image = elm_object_part_content_get(obj, "image.swallow");
		ASSERT_NE(nullptr, image) << path;
		int w = 0, h = 0, r, g, b, alpha;
		evas_object_color_get(image, &r, &g, &b, &alpha);
		EXPECT_EQ(path == faded ? 100 : 255, alpha) << path;
		evas_object_image_load_size_get(image, &w, &h);
		if (path == camera) {
			EXPECT_GT(w, 0);
			EXPECT_LE(w, 628);
			EXPECT_LE(h, 1600 * 628 / 2400 + 1);
		}
	}
}

// A tap on a picture selects it; pictures go by path, or by the name the image viewer gives (the file name
// without extension).
TEST_F(BoxImageItemTest, TapSelectsAPictureAndRemovalTakesItOut)
{
	const std::string one = picture("11111111-aaaa.png", 100, 100);
	const std::string two = picture("22222222-bbbb.png", 100, 100);
	withBody(todoItem(0, false, "x" + tag(628, 668, one) + "<br/>y" + tag(628, 668, two) + "<br/>"));
	MemoBoxItem *item = items()[0];
	ASSERT_EQ(2, control->onEntryCheckImageCount());
	focus(item->getEntry());
	std::vector<Evas_Object *> objects = imageObjects();
	ASSERT_EQ(2u, objects.size());
	Evas_Object *first =
	    static_cast<const char *>(evas_object_data_get(objects[0], "path")) == one ? objects[0] : objects[1];
	int x = 0, y = 0;
	centreOf(first, &x, &y);
	EXPECT_STREQ(one.c_str(), control->getSelectedImagePath(x, y));
	EXPECT_EQ(nullptr, control->getSelectedImagePath(-1, y));
	tap(x, y);
	runFor(0.05);
	ASSERT_EQ(1, countKey("action,image,selected"));
	EXPECT_EQ(one, payloads[std::find(keys.begin(), keys.end(), "action,image,selected") - keys.begin()]);
	// The keypad stays down while the picture is being looked at.
	EXPECT_FALSE(elm_entry_input_panel_enabled_get(item->getEntry()));
	EXPECT_EQ(0, countKey("action,mode,change"));

	EXPECT_TRUE(item->removeImageByPath(one.c_str()));
	EXPECT_EQ("x<br/>y" + tag(628, 668, two) + "<br/>", text(item));
	EXPECT_FALSE(item->removeImageByPath(one.c_str()));
	EXPECT_TRUE(control->deleteImage("22222222-bbbb"));
	EXPECT_EQ("x<br/>y<br/>", text(item));
	EXPECT_FALSE(control->deleteImage("22222222-bbbb"));
	EXPECT_EQ(nullptr, control->getImageList());
	EXPECT_EQ(-1, control->onEntryCheckImageCount());
	EXPECT_TRUE(imageObjects().empty());
}
