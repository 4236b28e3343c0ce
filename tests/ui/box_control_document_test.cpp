// The box control built from a record and read back as a todolist document. The full memo is also
// rendered: the picture is saved under the test's temporary root, and with MEMO_UPDATE_SCREENSHOTS=1 it
// replaces docs/images/editor.png in the source tree.
#include <gtest/gtest.h>

#include <Ecore_Evas.h>
#include <Ecore_File.h>

#include <cmath>
#include <cstdint>

#include "Box/MemoTodoListDocument.h"
#include "TestEnv.h"
#include "XmlWriteFailure.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

namespace
{
class BoxControlDocumentTest : public BoxControlFixture
{
};

// A small landscape, sky over a hill, so that the screenshot shows a picture and not a test card.
bool writeLandscape(const std::string &path, int w, int h, uint32_t sky, uint32_t hill)
{
	Ecore_Evas *ee = ecore_evas_buffer_new(1, 1);
	Evas_Object *img = ee ? evas_object_image_add(ecore_evas_get(ee)) : nullptr;
	if (!img)
		return false;
	evas_object_image_size_set(img, w, h);
	uint32_t *px = static_cast<uint32_t *>(evas_object_image_data_get(img, EINA_TRUE));
	const int stride = evas_object_image_stride_get(img) / 4;
	for (int y = 0; y < h; y++) {
		for (int x = 0; x < w; x++) {
			const bool ground = y > h * (0.62 + 0.08 * std::sin(x * 5.0 / w));
			const uint32_t shade = ground ? 0 : static_cast<uint32_t>(50 * y / h) * 0x010100;
			px[y * stride + x] = 0xff000000u | ((ground ? hill : sky) + shade);
		}
	}
	evas_object_image_data_set(img, px);
	const Eina_Bool ok = evas_object_image_save(img, path.c_str(), nullptr, "quality=92");
	ecore_evas_free(ee);
	return ok;
}
} // namespace

TEST_F(BoxControlDocumentTest, NewMemoIsATitleAndOneFirstTextItem)
{
	makeControl(nullptr, MODE_NEW);
	ASSERT_NE(nullptr, control->getTitleItem());
	EXPECT_EQ(MEMO_BOX_ITEM_TITLE, control->getTitleItem()->getType());
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
	EXPECT_EQ(items()[0], control->getFocusedItem());
	EXPECT_EQ(items()[0], control->getLastItem());
	// The title is on top, the body item below it.
	ASSERT_EQ(2u, packed().size());
	EXPECT_EQ(control->getTitleItem()->getLayout(), packed()[0]);
	EXPECT_EQ("", document(control));
	EXPECT_EQ(nullptr, control->getTitleTextN());
	EXPECT_STRNE("", elm_object_part_text_get(items()[0]->getEntry(), "elm.guide"));
}

TEST_F(BoxControlDocumentTest, StoredDocumentComesBackByteForByteAndRenders)
{
	const std::string lake = mediaDir() + "lake.jpg";
	const std::string dusk = mediaDir() + "dusk.jpg";
	ASSERT_TRUE(writeLandscape(lake, 1200, 520, 0x7fb6e0, 0x3f7a4a));
	ASSERT_TRUE(writeLandscape(dusk, 1200, 520, 0xb06a8a, 0x4a3b5e));
	// At scale 1.0 a text item shows pictures 628 wide: 520 * 628 / 1200 + 40 = 312.
	const std::string lines =
	    todoItem(0, false, "Friday at six &amp;amp; meet at the pier.&lt;br/&gt;" + escapedTag(628, 312, lake)) +
	    todoItem(1, true, "Sleeping bags") + todoItem(1, false, "Camera batteries") + todoItem(1, false, "Sunscreen") +
	    todoItem(0, false, "Sunset from the dock:&lt;br/&gt;" + escapedTag(628, 312, dusk) + "see you");
	record.setTitle("Weekend at the lake");
	record.setIsFavorite(1);
	withBody(lines);

	ASSERT_EQ(5u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, items()[1]->getType());
	EXPECT_TRUE(items()[1]->getCheckStatus());
	EXPECT_FALSE(items()[2]->getCheckStatus());
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, items()[4]->getType());
	EXPECT_EQ(0u, text(items()[0]).find("Friday at six &amp; meet at the pier.<br/><item size=628x312 "));
	// The first text block takes focus once the body is built.
	EXPECT_EQ(items()[0], control->getFocusedItem());
	EXPECT_TRUE(control->getFavoriteStatus());
	char *title = control->getTitleTextN();
	EXPECT_STREQ("Weekend at the lake", title);
	free(title);
	EXPECT_EQ(todoList(lines), document(control));

	runFor(0.5);
	render();
	const std::string shot = memo_test::tempRoot() + "/editor.png";
	ASSERT_TRUE(screenshot(shot));
	// A blank canvas compresses to almost nothing; a real editor does not.
	EXPECT_GT(memo_test::readFile(shot).size(), 20000u);
	const char *update = getenv("MEMO_UPDATE_SCREENSHOTS");
	if (update && !strcmp(update, "1")) {
		ecore_file_mkpath((std::string(TEST_SOURCE_DIR) + "/docs/images").c_str());
		EXPECT_TRUE(ecore_file_cp(shot.c_str(), (std::string(TEST_SOURCE_DIR) + "/docs/images/editor.png").c_str()));
	}
}

TEST_F(BoxControlDocumentTest, UnknownTypesAndUnreadableDocuments)
{
	withBody(todoItem(2, false, "dropped") + todoItem(1, false, "a") + todoItem(0, false, "b"));
	ASSERT_EQ(2u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, items()[0]->getType());
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, items()[1]->getType());

	// What cannot be read opens as one empty item.
	record.setTizenXmlContent("this is not xml");
	remakeControl(&record, MODE_UPDATE);
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
	EXPECT_EQ("", document(control));
}

TEST_F(BoxControlDocumentTest, OnlyTextThatShowsIsWrittenAndAlwaysReadable)
{
	withBody(todoItem(0, false, "keep") + todoItem(1, true, "x"));
	ASSERT_EQ(2u, items().size());
	Evas_Object *first = items()[0]->getEntry();
	Evas_Object *second = items()[1]->getEntry();
	// Format tags left behind by deleted text show nothing, for the entry as for the document; a
	// ticked empty line loses its tick.
	for (const char *markup : {"", "<color=#ff0000ff></color>", "<underline=on></underline>"}) {
		elm_entry_entry_set(second, markup);
		EXPECT_TRUE(elm_entry_is_empty(second)) << markup;
		EXPECT_EQ(todoList(todoItem(0, false, "keep")), document(control)) << markup;
	}
	elm_entry_entry_set(second, "<br/>");
	EXPECT_EQ(todoList(todoItem(0, false, "keep") + todoItem(1, true, "&lt;br/&gt;")), document(control));

	// Control characters, pasted or set, never reach the document: it reads back with the text.
	elm_entry_entry_set(first, "");
	items()[0]->insertText("a\x01"
	                       "b");
	elm_entry_entry_set(second, "c\x02"
	                            "d");
	std::vector<MemoTodoListItem> back;
	ASSERT_TRUE(memoParseTodoListXml(document(control).c_str(), back));
	ASSERT_EQ(2u, back.size());
	EXPECT_EQ("ab", back[0].content);
	EXPECT_EQ("cd", back[1].content);

	// A failed write gives no document, so that no save stores an empty body.
	{
		memo_test::XmlWriteFailure failure;
		EXPECT_EQ("<null>", document(control));
	}
	elm_entry_entry_set(first, "");
	elm_entry_entry_set(second, "");
	EXPECT_EQ("", document(control));
}

TEST_F(BoxControlDocumentTest, ViewModeItemsAreReadOnlyAndAnEmptyQuickMemoHasAQuickBody)
{
	record.setTitle("Read me");
	withBody(todoItem(0, false, "body"), MODE_VIEW);
	// A title that cannot be edited has no entry; its text still reads back.
	EXPECT_EQ(nullptr, control->getTitleItem()->getEntry());
	char *title = control->getTitleTextN();
	EXPECT_STREQ("Read me", title);
	free(title);
	ASSERT_EQ(1u, items().size());
	EXPECT_FALSE(elm_entry_editable_get(items()[0]->getEntry()));
	EXPECT_EQ(todoList(todoItem(0, false, "body")), document(control));

	record.setIsQuick(1);
	record.setTizenXmlContent("");
	remakeControl(&record, MODE_VIEW);
	EXPECT_EQ(MEMO_BOX_ITEM_QUICK_TITLE, control->getTitleItem()->getType());
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_QUICK_TEXT, items()[0]->getType());
	EXPECT_FALSE(control->getFavoriteStatus());
}
