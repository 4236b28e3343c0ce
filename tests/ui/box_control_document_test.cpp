// The box control built from a record and read back as a todolist document. The full memo is also
// rendered: the picture is saved under the test's temporary root, and with MEMO_UPDATE_SCREENSHOTS=1 it
// replaces docs/images/editor.png in the source tree.
#include <gtest/gtest.h>

#include <Ecore_File.h>
#include <app_i18n.h>
#include <libintl.h>

#include "Box/MemoTodoListDocument.h"
#include "Model/MemoBroadCaster.h"
#include "TestEnv.h"
#include "XmlWriteFailure.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

using BoxControlDocumentTest = BoxControlFixture;

TEST_F(BoxControlDocumentTest, NewOrUnreadableMemoIsATitleAndOneFirstTextItem)
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
	EXPECT_EQ("<null>", titleText());
	EXPECT_STRNE("", elm_object_part_text_get(items()[0]->getEntry(), "elm.guide"));

	// What cannot be read opens as one empty item as well.
	record.setTizenXmlContent("this is not xml");
	remakeControl(&record, MODE_UPDATE);
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
	EXPECT_EQ("", document(control));
}

TEST_F(BoxControlDocumentTest, StoredDocumentComesBackByteForByteAndRenders)
{
	const std::string lake = mediaDir() + "lake.jpg";
	const std::string dusk = mediaDir() + "dusk.jpg";
	ASSERT_TRUE(writePicture(lake, 1200, 520));
	ASSERT_TRUE(writePicture(dusk, 1200, 520, 0xb06a8a, 0x4a3b5e));
	// At scale 1.0 a text item shows pictures 628 wide: 520 * 628 / 1200 + 40 = 312.
	const std::string lines =
	    todoItem(0, false, "Friday at six &amp; meet at the pier.<br/>" + tag(628, 312, lake) + "<br/>") +
	    todoItem(1, true, "Sleeping bags") + todoItem(1, false, "Camera batteries") + todoItem(1, false, "Sunscreen") +
	    todoItem(0, false, "Sunset from the dock:<br/>" + tag(628, 312, dusk) + "<br/>see you");
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
	EXPECT_EQ("Weekend at the lake", titleText());
	EXPECT_EQ(todoList(lines), document(control));

	runFor(0.5);
	render();
	const std::string shot = memo_test::tempRoot() + "/editor.png";
	ASSERT_TRUE(memo_test::saveScreenshot(win, shot));
	// A blank canvas compresses to almost nothing; a real editor does not.
	EXPECT_GT(memo_test::readFile(shot).size(), 20000u);
	const char *update = getenv("MEMO_UPDATE_SCREENSHOTS");
	if (update && !strcmp(update, "1")) {
		ecore_file_mkpath((std::string(TEST_SOURCE_DIR) + "/docs/images").c_str());
		EXPECT_TRUE(ecore_file_cp(shot.c_str(), (std::string(TEST_SOURCE_DIR) + "/docs/images/editor.png").c_str()));
	}
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
	EXPECT_EQ(todoList(todoItem(0, false, "keep") + todoItem(1, true, "<br/>")), document(control));

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
	EXPECT_EQ("Read me", titleText());
	ASSERT_EQ(1u, items().size());
	EXPECT_FALSE(elm_entry_editable_get(items()[0]->getEntry()));
	EXPECT_EQ(todoList(todoItem(0, false, "body")), document(control));

	// The quick memo shows its translated header whatever its title; its empty body describes the quick
	// memo, again after a language change.
	std::string description =
	    i18n_get_text("IDS_MEMO_BODY_COLLECT_TEXT_FROM_ANY_APP_BY_SELECTING_IT_AND_TAPPING_QUICK_MEMO_MSG");
	for (size_t at; (at = description.find('\n')) != std::string::npos;)
		description.replace(at, 1, "<br/>");
	MemoBroadCaster::Signal &bus = MemoBroadCaster::getInstance();
	const size_t listeners = bus.getListenerCount();
	auto complaints = [] {
		return memo_test::countOf(memo_test::readFile(std::string(MemoUtil::getDataPath()) + "dlog.log"),
		                          "Already removed listener");
	};
	const size_t before = complaints();
	record.setIsQuick(1);
	record.setTizenXmlContent("");
	remakeControl(&record, MODE_VIEW);
	EXPECT_EQ(MEMO_BOX_ITEM_QUICK_TITLE, control->getTitleItem()->getType());
	EXPECT_STREQ(dgettext("memo-sub", "IDS_MEMO_HEADER_QUICK_MEMO"),
	             elm_object_part_text_get(control->getTitleItem()->getInnerLayout(), "title"));
	EXPECT_FALSE(control->getFavoriteStatus());
	ASSERT_EQ(1u, items().size());
	Evas_Object *body = items()[0]->getEntry();
	EXPECT_EQ(MEMO_BOX_ITEM_QUICK_TEXT, items()[0]->getType());
	EXPECT_EQ(description, elm_object_part_text_get(body, "elm.guide"));
	elm_object_part_text_set(body, "elm.guide", "");
	bus.emit("broadcast,language,changed", nullptr);
	EXPECT_EQ(description, elm_object_part_text_get(body, "elm.guide"));

	// Only that body listens to the bus, and it leaves it exactly once when the editor goes.
	EXPECT_EQ(listeners + 1, bus.getListenerCount());
	UiFixture::TearDown();
	EXPECT_EQ(listeners, bus.getListenerCount());
	EXPECT_EQ(before, complaints());
}
