// Pictures inside box items: tag sizes by scale, load errors, the objects that stand for tags, taps on
// them, removal and counting.
#include <gtest/gtest.h>

#include <Ecore_File.h>

#include <algorithm>
#include <cstdio>

#include "TestEnv.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

namespace
{
class BoxImageItemTest : public BoxControlFixture
{
protected:
	std::string picture(const char *name, int w = 1000, int h = 500)
	{
		const std::string path = mediaDir() + name;
		EXPECT_TRUE(writePicture(path, w, h));
		return path;
	}

	static std::string tag(int w, int h, const std::string &path)
	{
		return "<item size=" + std::to_string(w) + "x" + std::to_string(h) + " vsize=full href=file://" + path +
		       "></item>";
	}

	static std::string escaped(const std::string &markup)
	{
		std::string out;
		for (char c : markup)
			out += c == '<' ? "&lt;" : c == '>' ? "&gt;" : std::string(1, c);
		return out;
	}

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

	MemoDocInfo doc;
};
} // namespace

TEST_F(BoxImageItemTest, AtScale18APictureOf1000By500Gets603By341)
{
	elm_config_scale_set(1.8);
	const std::string path = picture("wide.png");
	makeControl(nullptr, MODE_NEW);
	focus(items()[0]->getEntry());
	ASSERT_TRUE(control->insertImage(path.c_str()));
	runFor(0.05);
	// At the line's start no break goes in front.
	EXPECT_EQ(tag(603, 341, path) + "<br/>", text(items()[0]));

	typeText("abc");
	ASSERT_TRUE(control->insertImage(path.c_str()));
	runFor(0.05);
	EXPECT_EQ(tag(603, 341, path) + "<br/>abc<br/>" + tag(603, 341, path) + "<br/>", text(items()[0]));
}

TEST_F(BoxImageItemTest, CheckLinesUseTheNarrowerSize)
{
	elm_config_scale_set(1.8);
	const std::string path = picture("check.png");
	doc.setTizenXmlContent(todoList(todoItem(1, false, "")).c_str());
	makeControl(&doc, MODE_UPDATE);
	focus(items()[0]->getEntry());
	ASSERT_TRUE(control->insertImage(path.c_str()));
	runFor(0.05);
	EXPECT_EQ(tag(506, 293, path) + "<br/>", text(items()[0]));
}

TEST_F(BoxImageItemTest, SeveralPicturesGoInAsOneInsertion)
{
	const std::string a = picture("a.png", 200, 100);
	const std::string b = picture("b.png", 100, 200);
	makeControl(nullptr, MODE_NEW);
	focus(items()[0]->getEntry());
	typeText("x");
	Eina_List *list = eina_list_append(nullptr, a.c_str());
	list = eina_list_append(list, b.c_str());
	ASSERT_TRUE(control->insertImages(list));
	eina_list_free(list);
	runFor(0.05);
	// Scale 1.0: 628 wide; 100 * 628 / 200 + 40 = 354 and 200 * 628 / 100 + 40 = 1296.
	EXPECT_EQ("x<br/>" + tag(628, 354, a) + "<br/>" + tag(628, 1296, b) + "<br/>", text(items()[0]));
	EXPECT_FALSE(control->insertImages(nullptr));
}

TEST_F(BoxImageItemTest, APictureThatCannotBeReadIsRefusedAndRemoved)
{
	const std::string path = mediaDir() + "broken.jpg";
	FILE *f = fopen(path.c_str(), "w");
	ASSERT_NE(nullptr, f);
	fputs("not a picture at all", f);
	fclose(f);
	makeControl(nullptr, MODE_NEW);
	clearToasts();
	EXPECT_FALSE(control->insertImage(path.c_str()));
	EXPECT_EQ(1, toastCount());
	EXPECT_FALSE(ecore_file_exists(path.c_str()));
	EXPECT_EQ("", text(items()[0]));
}

TEST_F(BoxImageItemTest, AMissingFileShowsTheDefaultLayoutAndKeepsItsTag)
{
	const std::string present = picture("present.png");
	const std::string missing = mediaDir() + "gone.jpg";
	ecore_file_unlink(missing.c_str());
	const std::string content =
	    "a" + escaped(tag(628, 354, missing) + "<br/>") + "b" + escaped(tag(628, 354, present) + "<br/>");
	const std::string xml = todoList(todoItem(0, false, escaped(content)));
	doc.setTizenXmlContent(xml.c_str());
	makeControl(&doc, MODE_UPDATE);

	std::vector<Evas_Object *> objects = imageObjects();
	ASSERT_EQ(2u, objects.size());
	for (Evas_Object *obj : objects) {
		const std::string path = static_cast<const char *>(evas_object_data_get(obj, "path"));
		EXPECT_EQ(path == missing ? "default_image_layout" : "image_layout", groupOf(obj)) << path;
	}
	EXPECT_EQ(xml, document(control));
	Eina_List *images = control->getImageList();
	ASSERT_EQ(2u, eina_list_count(images));
	EXPECT_EQ(missing, static_cast<const char *>(eina_list_nth(images, 0)));
	EXPECT_EQ(2, control->onEntryCheckImageCount());
}

// A large picture is decoded in the background and no larger than its place in the entry, so that
// opening a memo never decodes a whole camera picture on the main loop.
TEST_F(BoxImageItemTest, LargePicturesAreDecodedAtTheirDisplaySize)
{
	const std::string path = picture("camera.jpg", 2400, 1600);
	doc.setTizenXmlContent(todoList(todoItem(0, false, escaped(tag(628, 458, path) + "<br/>"))).c_str());
	makeControl(&doc, MODE_UPDATE);
	std::vector<Evas_Object *> objects = imageObjects();
	ASSERT_EQ(1u, objects.size());
	Evas_Object *image = elm_object_part_content_get(objects[0], "image.swallow");
	ASSERT_NE(nullptr, image);
	int w = 0, h = 0;
	evas_object_image_load_size_get(image, &w, &h);
	EXPECT_GT(w, 0);
	EXPECT_LE(w, 628);
	EXPECT_LE(h, 1600 * 628 / 2400 + 1);
}

TEST_F(BoxImageItemTest, TapOnAPictureSelectsItsPath)
{
	const std::string path = picture("tap.png", 400, 300);
	doc.setTizenXmlContent(todoList(todoItem(0, false, escaped("top<br/>" + tag(628, 511, path)))).c_str());
	makeControl(&doc, MODE_UPDATE);
	focus(items()[0]->getEntry());
	std::vector<Evas_Object *> objects = imageObjects();
	ASSERT_EQ(1u, objects.size());
	int x = 0, y = 0;
	centreOf(objects[0], &x, &y);
	EXPECT_STREQ(path.c_str(), control->getSelectedImagePath(x, y));
	EXPECT_EQ(nullptr, control->getSelectedImagePath(-1, y));

	tap(x, y);
	runFor(0.05);
	ASSERT_EQ(1, countKey("action,image,selected"));
	for (size_t i = 0; i < keys.size(); i++) {
		if (keys[i] == "action,image,selected") {
			EXPECT_EQ(path, payloads[i]);
		}
	}
	// The keypad stays down while the picture is being looked at.
	EXPECT_FALSE(elm_entry_input_panel_enabled_get(items()[0]->getEntry()));
	EXPECT_EQ(0, countKey("action,mode,change"));
}

TEST_F(BoxImageItemTest, TickedLinesShowTheirPicturesFaded)
{
	const std::string path = picture("faded.png", 300, 200);
	const std::string content = escaped(tag(521, 387, path) + "<br/>");
	doc.setTizenXmlContent(todoList(todoItem(1, true, content) + todoItem(1, false, content)).c_str());
	makeControl(&doc, MODE_UPDATE);
	std::vector<Evas_Object *> objects = imageObjects();
	ASSERT_EQ(2u, objects.size());
	std::vector<int> alphas;
	for (Evas_Object *obj : objects) {
		Evas_Object *image = elm_object_part_content_get(obj, "image.swallow");
		ASSERT_NE(nullptr, image);
		int r, g, b, a;
		evas_object_color_get(image, &r, &g, &b, &a);
		alphas.push_back(a);
	}
	std::sort(alphas.begin(), alphas.end());
	EXPECT_EQ(100, alphas[0]);
	EXPECT_EQ(255, alphas[1]);
}

TEST_F(BoxImageItemTest, RemovingPicturesByPathAndByName)
{
	const std::string one = picture("11111111-aaaa.png", 100, 100);
	const std::string two = picture("22222222-bbbb.png", 100, 100);
	doc.setTizenXmlContent(
	    todoList(todoItem(0, false, escaped("x" + tag(628, 668, one) + "<br/>y" + tag(628, 668, two) + "<br/>")))
	        .c_str());
	makeControl(&doc, MODE_UPDATE);
	MemoBoxItem *item = items()[0];
	ASSERT_EQ(2, control->onEntryCheckImageCount());

	EXPECT_TRUE(item->removeImageByPath(one.c_str()));
	EXPECT_EQ("x<br/>y" + tag(628, 668, two) + "<br/>", text(item));
	EXPECT_FALSE(item->removeImageByPath(one.c_str()));

	// The image viewer names the picture by its file name without extension.
	EXPECT_TRUE(control->deleteImage("22222222-bbbb"));
	EXPECT_EQ("x<br/>y<br/>", text(item));
	EXPECT_FALSE(control->deleteImage("22222222-bbbb"));
	EXPECT_EQ(nullptr, control->getImageList());
	EXPECT_EQ(-1, control->onEntryCheckImageCount());
	EXPECT_TRUE(imageObjects().empty());
}

TEST_F(BoxImageItemTest, TenPicturesAcrossItemsAreCounted)
{
	const std::string path = picture("ten.png", 50, 50);
	std::string five;
	for (int i = 0; i < 5; i++)
		five += escaped(tag(628, 668, path) + "<br/>");
	doc.setTizenXmlContent(todoList(todoItem(0, false, five) + todoItem(1, false, five)).c_str());
	makeControl(&doc, MODE_UPDATE);
	EXPECT_EQ(10, control->onEntryCheckImageCount());
	Eina_List *images = control->getImageList();
	EXPECT_EQ(10u, eina_list_count(images));
	control->freeImageList();
}
