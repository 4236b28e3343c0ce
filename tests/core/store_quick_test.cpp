// The quick memo row and the PIN row.
#include "Box/MemoTodoListDocument.h"
#include "XmlWriteFailure.h"
#include "store_test_fixture.h"

using namespace store_test;

using StoreQuick = StoreTest;

TEST_F(StoreQuick, AppendedTextsKeepTheirOrderAndNothingBreaksTheMemo)
{
	db()->excuteSql("UPDATE memo SET lastModifiedAt = 1000 WHERE isQuick = 1");
	vconf_set_int("db/memo/data-change", 0);

	ASSERT_TRUE(db()->addQuickMemo("first\ntext"));
	ASSERT_TRUE(db()->addQuickMemo("say \"hi\" & <bye>\x01"));
	EXPECT_TRUE(db()->addQuickMemo(""));
	// Each text once, in order; the control character is left out, so the memo reads back.
	std::vector<MemoTodoListItem> items;
	ASSERT_TRUE(memoParseTodoListXml(quickColumn("tizenXmlContent").c_str(), items));
	ASSERT_EQ(3u, items.size());
	EXPECT_EQ("first<br/>text", items[0].content);
	EXPECT_EQ("say \"hi\" &amp; &lt;bye&gt;", items[1].content);
	EXPECT_EQ("", items[2].content);
	EXPECT_NE(std::string::npos, quickColumn("strippedContent").find("\"hi\""));
	EXPECT_NE(std::string::npos, quickColumn("content").find("first\ntext"));
	EXPECT_NE(std::string::npos, quickColumn("display_Content")
	                                 .find("say \"hi\" & \xEF\xBC\x9C"
	                                       "bye\xEF\xBC\x9E"));
	EXPECT_NE("", quickColumn("xmlContent"));
	EXPECT_EQ("1", quickColumn("isDirty"));
	EXPECT_GT(atoll(quickColumn("lastModifiedAt").c_str()), 1000);
	EXPECT_EQ(0, changeNotice()); // no change notice for quick memo text

	// A failed write stores nothing: the memo stays as it was.
	const std::string before = quickColumn("tizenXmlContent") + quickColumn("strippedContent");
	{
		memo_test::XmlWriteFailure failure;
		EXPECT_FALSE(db()->addQuickMemo("lost"));
	}
	EXPECT_EQ(before, quickColumn("tizenXmlContent") + quickColumn("strippedContent"));

	// A body without the closing root tag is replaced.
	db()->excuteSql("UPDATE memo SET tizenXmlContent = 'old loose text' WHERE isQuick = 1");
	ASSERT_TRUE(db()->addQuickMemo("fresh"));
	EXPECT_EQ(std::string::npos, quickColumn("tizenXmlContent").find("old loose text"));
	EXPECT_NE(std::string::npos, quickColumn("tizenXmlContent").find("fresh"));

	// An earlier tick survives, and what stands behind the first root is no part of the body: the text is
	// there once.
	db()->excuteSql("UPDATE memo SET tizenXmlContent = '%q' WHERE isQuick = 1",
	                "<todolist><todolist_item todo_item_type=\"1\" todo_item_state=\"true\" todo_item_content=\"a\"/>"
	                "</todolist><todolist></todolist>");
	ASSERT_TRUE(db()->addQuickMemo("once"));
	items.clear();
	ASSERT_TRUE(memoParseTodoListXml(quickColumn("tizenXmlContent").c_str(), items));
	ASSERT_EQ(2u, items.size());
	EXPECT_TRUE(items[0].checked);
	EXPECT_EQ("once", items[1].content);
	EXPECT_EQ(1u, memo_test::countOf(quickColumn("strippedContent"), "once"));
}

TEST_F(StoreQuick, InitEmptiesRowOneOnlyAndWithoutTheRowTextIsDropped)
{
	ASSERT_TRUE(db()->addQuickMemo("some text"));
	db()->excuteSql("UPDATE memo SET _data = '/thumb.jpg' WHERE _id = 1");
	std::string uuid = quickColumn("UUID");
	std::string title = quickColumn("title");
	ASSERT_TRUE(db()->initQuickMemo());
	for (const char *column :
	     {"content", "display_Content", "strippedContent", "xmlContent", "tizenXmlContent", "_data"})
		EXPECT_EQ("", quickColumn(column)) << column;
	EXPECT_EQ(uuid, quickColumn("UUID"));
	EXPECT_EQ(title, quickColumn("title"));
	EXPECT_EQ("252;191;169;255;", quickColumn("bgColor"));
	EXPECT_EQ("1", quickColumn("isDirty"));
	// Removed like any memo, the row is not made again, and text for it is dropped.
	ASSERT_TRUE(db()->removeMemo(uuid.c_str()));
	EXPECT_FALSE(db()->addQuickMemo("lost"));

	// With the feature off at first run there is no quick memo: row one is a normal memo, the one emptied.
	MemoDbMgr::destroy();
	unlink(dbPath().c_str());
	vconf_set_int("db/desktop/csc/feature_92", 0);
	addMemo("normal", "precious words", 1000);
	EXPECT_FALSE(db()->addQuickMemo("lost"));
	ASSERT_TRUE(db()->initQuickMemo());
	EXPECT_EQ("", query("SELECT strippedContent FROM memo WHERE _id = 1"));
	EXPECT_EQ("normal", query("SELECT title FROM memo WHERE _id = 1"));
}

TEST_F(StoreQuick, PinIsStoredInItsOneRow)
{
	char buffer[64] = "unchanged";
	EXPECT_FALSE(db()->getHiddenMemoPassword(buffer));
	EXPECT_STREQ("unchanged", buffer);

	for (const char *pin : {"it's a hash", "second"}) {
		ASSERT_TRUE(db()->setHiddenMemoPassword(pin));
		ASSERT_TRUE(db()->getHiddenMemoPassword(buffer));
		EXPECT_STREQ(pin, buffer);
	}
	EXPECT_EQ(1, queryInt("SELECT count(*) FROM password"));

	// Without the row, setting makes it.
	db()->excuteSql("DELETE FROM password");
	EXPECT_FALSE(db()->getHiddenMemoPassword(buffer));
	ASSERT_TRUE(db()->setHiddenMemoPassword("third"));
	EXPECT_EQ("third", query("SELECT hiddenPass FROM password"));
}
