// The box control built from a record and read back as a todolist document.
#include <gtest/gtest.h>

#include "Box/MemoTodoListDocument.h"
#include "XmlWriteFailure.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

namespace
{
class BoxControlDocumentTest : public BoxControlFixture
{
};
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

TEST_F(BoxControlDocumentTest, StoredDocumentComesBackByteForByte)
{
	const std::string dir = mediaDir();
	const std::string picture = dir + "stored.png";
	ASSERT_TRUE(writePicture(picture, 1000, 500));
	// At scale 1.0 a text item shows pictures 628 wide: 500 * 628 / 1000 + 40 = 354.
	const std::string xml =
	    todoList(todoItem(0, false, "Shopping &amp;amp; more&lt;br/&gt;second line") + todoItem(1, true, "milk") +
	             todoItem(1, false, "bread") + todoItem(0, false, "see " + escapedTag(628, 354, picture) + "end"));
	MemoDocInfo doc;
	doc.setMemoUUID("box-test-memo");
	doc.setTitle("Weekend");
	doc.setTizenXmlContent(xml.c_str());
	doc.setIsFavorite(1);
	makeControl(&doc, MODE_UPDATE);

	ASSERT_EQ(4u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
	EXPECT_EQ(MEMO_BOX_ITEM_CHECK, items()[1]->getType());
	EXPECT_TRUE(items()[1]->getCheckStatus());
	EXPECT_FALSE(items()[2]->getCheckStatus());
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, items()[3]->getType());
	EXPECT_EQ("Shopping &amp; more<br/>second line", text(items()[0]));
	// The first text block takes focus once the body is built.
	EXPECT_EQ(items()[0], control->getFocusedItem());
	EXPECT_TRUE(control->getFavoriteStatus());
	char *title = control->getTitleTextN();
	EXPECT_STREQ("Weekend", title);
	free(title);

	EXPECT_EQ(xml, document(control));
}

TEST_F(BoxControlDocumentTest, FirstCheckAndUnknownTypes)
{
	MemoDocInfo doc;
	doc.setTizenXmlContent(
	    todoList(todoItem(2, false, "dropped") + todoItem(1, false, "a") + todoItem(0, false, "b")).c_str());
	makeControl(&doc, MODE_UPDATE);
	ASSERT_EQ(2u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_CHECK, items()[0]->getType());
	EXPECT_EQ(MEMO_BOX_ITEM_TEXT, items()[1]->getType());
}

TEST_F(BoxControlDocumentTest, UnreadableDocumentGivesOneEmptyItem)
{
	MemoDocInfo doc;
	doc.setTizenXmlContent("this is not xml");
	makeControl(&doc, MODE_UPDATE);
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items()[0]->getType());
	EXPECT_EQ("", document(control));
}

TEST_F(BoxControlDocumentTest, OnlyTextThatShowsIsWrittenAndAlwaysReadable)
{
	MemoDocInfo doc;
	doc.setTizenXmlContent(todoList(todoItem(0, false, "keep") + todoItem(1, true, "x")).c_str());
	makeControl(&doc, MODE_UPDATE);
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

TEST_F(BoxControlDocumentTest, QuickMemoWithoutDocumentHasAQuickBody)
{
	MemoDocInfo doc;
	doc.setIsQuick(1);
	makeControl(&doc, MODE_VIEW);
	EXPECT_EQ(MEMO_BOX_ITEM_QUICK_TITLE, control->getTitleItem()->getType());
	ASSERT_EQ(1u, items().size());
	EXPECT_EQ(MEMO_BOX_ITEM_QUICK_TEXT, items()[0]->getType());
	EXPECT_FALSE(control->getFavoriteStatus());
}

TEST_F(BoxControlDocumentTest, ViewModeItemsAreReadOnly)
{
	MemoDocInfo doc;
	doc.setTitle("Read me");
	doc.setTizenXmlContent(todoList(todoItem(0, false, "body")).c_str());
	makeControl(&doc, MODE_VIEW);
	// A title that cannot be edited has no entry; its text still reads back.
	EXPECT_EQ(nullptr, control->getTitleItem()->getEntry());
	char *title = control->getTitleTextN();
	EXPECT_STREQ("Read me", title);
	free(title);
	ASSERT_EQ(1u, items().size());
	EXPECT_FALSE(elm_entry_editable_get(items()[0]->getEntry()));
	EXPECT_EQ(todoList(todoItem(0, false, "body")), document(control));
}
