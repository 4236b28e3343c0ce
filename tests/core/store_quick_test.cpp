// The quick memo row and the PIN row.
#include "Box/MemoTodoListDocument.h"
#include "XmlWriteFailure.h"
#include "store_test_fixture.h"

using namespace store_test;

using StoreQuick = StoreTest;

TEST_F(StoreQuick, AppendedTextsKeepTheirOrder)
{
	ASSERT_NE(nullptr, db());
	db()->excuteSql("UPDATE memo SET lastModifiedAt = 1000 WHERE isQuick = 1");
	vconf_set_int("db/memo/data-change", 0);

	ASSERT_TRUE(db()->addQuickMemo("first text"));
	ASSERT_TRUE(db()->addQuickMemo("say \"hi\" & <bye>"));
	EXPECT_TRUE(db()->addQuickMemo(""));

	std::string document = quickColumn("tizenXmlContent");
	size_t first = document.find("first text");
	size_t second = document.find("say");
	ASSERT_NE(std::string::npos, first);
	ASSERT_NE(std::string::npos, second);
	EXPECT_LT(first, second);
	EXPECT_EQ(std::string::npos, document.find("first text", first + 1)); // each once
	EXPECT_NE(std::string::npos, quickColumn("strippedContent").find("\"hi\""));
	EXPECT_NE(std::string::npos, quickColumn("content").find("first text"));
	EXPECT_NE("", quickColumn("xmlContent"));
	EXPECT_EQ("1", quickColumn("isDirty"));
	EXPECT_GT(atoll(quickColumn("lastModifiedAt").c_str()), 1000);
	EXPECT_EQ(0, changeNotice()); // no change notice for quick memo text

	// A body without the closing root tag is replaced.
	db()->excuteSql("UPDATE memo SET tizenXmlContent = 'old loose text' WHERE isQuick = 1");
	ASSERT_TRUE(db()->addQuickMemo("fresh"));
	document = quickColumn("tizenXmlContent");
	EXPECT_EQ(std::string::npos, document.find("old loose text"));
	EXPECT_NE(std::string::npos, document.find("fresh"));
}

TEST_F(StoreQuick, TextFromOutsideNeverBreaksTheMemo)
{
	ASSERT_NE(nullptr, db());
	// A control character is left out: the document still reads back, with the text.
	ASSERT_TRUE(db()->addQuickMemo("one\x01two"));
	std::vector<MemoTodoListItem> items;
	ASSERT_TRUE(memoParseTodoListXml(quickColumn("tizenXmlContent").c_str(), items));
	ASSERT_EQ(1u, items.size());
	EXPECT_EQ("onetwo", items[0].content);

	// A failed write stores nothing: the memo stays as it was.
	const std::string before = quickColumn("tizenXmlContent") + quickColumn("strippedContent");
	{
		memo_test::XmlWriteFailure failure;
		EXPECT_FALSE(db()->addQuickMemo("lost"));
	}
	EXPECT_EQ(before, quickColumn("tizenXmlContent") + quickColumn("strippedContent"));
}

TEST_F(StoreQuick, NoQuickMemoRowDropsTheText)
{
	vconf_set_int("db/desktop/csc/feature_92", 0);
	ASSERT_NE(nullptr, db());
	EXPECT_FALSE(db()->addQuickMemo("lost"));

	// Removed like any memo, it is not made again.
	vconf_unset("db/desktop/csc/feature_92");
	MemoDbMgr::destroy();
	unlink(dbPath().c_str());
	ASSERT_NE(nullptr, db());
	ASSERT_TRUE(db()->removeMemo(quickColumn("UUID").c_str()));
	EXPECT_FALSE(db()->addQuickMemo("lost"));
}

TEST_F(StoreQuick, InitEmptiesRowOneOnly)
{
	ASSERT_NE(nullptr, db());
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

	// With the feature off at first run, row one is a normal memo, and it is the one emptied.
	MemoDbMgr::destroy();
	unlink(dbPath().c_str());
	vconf_set_int("db/desktop/csc/feature_92", 0);
	addMemo("normal", "precious words", 1000);
	ASSERT_TRUE(db()->initQuickMemo());
	EXPECT_EQ("", query("SELECT strippedContent FROM memo WHERE _id = 1"));
	EXPECT_EQ("normal", query("SELECT title FROM memo WHERE _id = 1"));
}

TEST_F(StoreQuick, PinIsStoredInItsOneRow)
{
	ASSERT_NE(nullptr, db());
	char buffer[64] = "unchanged";
	EXPECT_FALSE(db()->getHiddenMemoPassword(buffer));
	EXPECT_STREQ("unchanged", buffer);
	EXPECT_FALSE(db()->setHiddenMemoPassword(nullptr));

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
