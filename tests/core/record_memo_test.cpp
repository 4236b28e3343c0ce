// Memo and file records: refusals, the UUID, the colour text, derived file data, the owning list.
#include <gtest/gtest.h>

#include <cstring>
#include <sstream>
#include <stdexcept>

#include "DataBase/MemoDocInfo.h"
#include "DataBase/MemoFileInfo.h"
#include "List/MemoItemList.h"

#include <Eina.h>

namespace
{
std::string rgbaOf(MemoDocInfo &info)
{
	int r = -1, g = -1, b = -1, a = -1;
	info.getBgColorRgba(&r, &g, &b, &a);
	return std::to_string(r) + "," + std::to_string(g) + "," + std::to_string(b) + "," + std::to_string(a);
}
// Every field of a file record, in declaration order.
std::string describe(const MemoFileInfo &f)
{
	std::ostringstream out;
	out << f.getFileUUID() << "|" << f.getIsDirty() << "|" << f.getIsDeleted() << "|" << f.getAccountType() << "|"
	    << f.getAccountName() << "|" << f.getSync1() << "|" << f.getSync2() << "|" << f.getIsNeedUpsync() << "|"
	    << f.getMemoUUID() << "|" << f.getMimeType() << "|" << f.getDisplayName() << "|" << f.getSize() << "|"
	    << f.getOrientation() << "|" << f.getPath() << "|" << f.getData();
	return out.str();
}
} // namespace

TEST(MemoDocInfo, UuidIsMadeOnFirstAskAndRefusedValuesKeepTheField)
{
	MemoDocInfo info;
	std::string first = info.getMemoUUID();
	ASSERT_EQ(36u, first.size());
	EXPECT_EQ("----", std::string() + first[8] + first[13] + first[18] + first[23]);
	EXPECT_EQ(first, info.getMemoUUID());
	EXPECT_NE(first, MemoDocInfo().getMemoUUID());
	// The setter stores but answers false, whatever it is given.
	EXPECT_FALSE(info.setMemoUUID("given"));
	EXPECT_STREQ("given", info.getMemoUUID());

	// Refused values keep the field.
	ASSERT_TRUE(info.setIsDirty(0));
	EXPECT_FALSE(info.setIsDirty(2));
	EXPECT_EQ(0, info.getIsDirty());
	ASSERT_TRUE(info.setFileCount(3));
	EXPECT_FALSE(info.setFileCount(-1));
	EXPECT_EQ(3, info.getFileCount());
}

TEST(MemoDocInfo, BgColorFallsBackOrStopsAsDocumented)
{
	MemoDocInfo info;
	EXPECT_EQ("228,235,235,255", rgbaOf(info));
	ASSERT_TRUE(info.setBgColor("1;2;3;4;"));
	EXPECT_EQ("1,2,3,4", rgbaOf(info));

	// Three numbers or none: replaced by the default colour.
	for (const char *text : {"10;20;30;", ""}) {
		EXPECT_TRUE(info.setBgColor(text));
		EXPECT_STREQ("228;235;235;255;", info.getBgColor());
		EXPECT_EQ("228,235,235,255", rgbaOf(info));
	}

	// Sixteen characters skip the separator check: no ";" stops parsing at once.
	ASSERT_TRUE(info.setBgColor("9;8;7;6;"));
	EXPECT_FALSE(info.setBgColor("abcdefghijklmnop"));
	EXPECT_STREQ("abcdefghijklmnop", info.getBgColor());
	EXPECT_EQ("9,8,7,6", rgbaOf(info));
	// Two separators in 16 characters: the first field parses, then it stops.
	EXPECT_FALSE(info.setBgColor("100;200xxxxxxxxx"));
	EXPECT_EQ("100,8,7,6", rgbaOf(info));

	EXPECT_THROW(info.setBgColor("abc;def;ghi;jkl;"), std::invalid_argument);
	info.setBgColorRgba(252, 191, 169, 255);
	EXPECT_STREQ("252;191;169;255;", info.getBgColor());
}

TEST(MemoFileInfo, PathDerivesBlobData)
{
	MemoFileInfo file;
	file.setData("/set/before");
	ASSERT_TRUE(file.setPath("/opt/media/ab.jpg"));
	EXPECT_STREQ("/app_attach/a/b/ab.blob", file.getData());
	file.setPath("/x/3f2a9c10-1b2c-4d5e-8f90-a1b2c3d4e5f6.amr");
	EXPECT_STREQ("/app_attach/f/6/3f2a9c10-1b2c-4d5e-8f90-a1b2c3d4e5f6.blob", file.getData());

	EXPECT_FALSE(file.setSize(-1));
	EXPECT_TRUE(file.setSize(1LL << 40));
	EXPECT_EQ(1LL << 40, file.getSize());
}

TEST(MemoDocInfo, CopyFileInfosTakesEveryFieldAndRederivesData)
{
	MemoFileInfo source;
	source.setFileUUID("file1");
	source.setIsDirty(1);
	source.setIsDeleted(1);
	source.setAccountType("type");
	source.setAccountName("name");
	source.setSync1(77);
	source.setSync2("s2");
	source.setIsNeedUpsync(1);
	source.setMemoUUID("memo");
	source.setMimeType("image/jpeg");
	source.setDisplayName("pic.jpg");
	source.setSize(1235);
	source.setOrientation(90);
	source.setPath("/m/file1.jpg");
	source.setData("/stale");
	MemoDocInfo info;
	info.setFileCount(1);
	info.copyFileInfos(&source);
	EXPECT_EQ("file1|1|1|type|name|77|s2|1|memo|image/jpeg|pic.jpg|1235|90|/m/file1.jpg|/app_attach/e/1/file1.blob",
	          describe(info.getFiles()[0]));
	// Entries past the count stay default.
	EXPECT_STREQ("", info.getFiles()[1].getFileUUID());
}

namespace
{
int gDeleted = 0;
struct CountedDoc : MemoDocInfo {
	~CountedDoc() override { ++gDeleted; }
};
} // namespace

TEST(MemoItemList, KeepsOrderAndDeletesItsRecords)
{
	eina_init();
	gDeleted = 0;
	{
		MemoItemList list;
		for (const char *title : {"a", "b", "c"}) {
			CountedDoc *doc = new CountedDoc();
			doc->setTitle(title);
			list.appendItem(doc);
		}
		ASSERT_EQ(3, list.getCount());
		EXPECT_STREQ("a", list.getItem(0)->getTitle());
		EXPECT_STREQ("c", list.getItem(2)->getTitle());
		EXPECT_EQ(nullptr, list.getItem(3));
	}
	EXPECT_EQ(3, gDeleted);
	eina_shutdown();
}
