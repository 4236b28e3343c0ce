// Memo and file records: defaults, refusals, the colour text, derived file data, the owning list.
#include <gtest/gtest.h>

#include <cstring>
#include <stdexcept>

#include "DataBase/MemoDocInfo.h"
#include "DataBase/MemoFileInfo.h"
#include "List/MemoItemList.h"

#include <Eina.h>

TEST(MemoDocInfo, DefaultsMirrorANewRow)
{
	MemoDocInfo info;
	EXPECT_EQ(1, info.getIsDirty());
	EXPECT_EQ(0, info.getIsDeleted());
	EXPECT_EQ(1, info.getIsNeedUpsync());
	EXPECT_EQ(1ULL, info.getCreatedAt());
	EXPECT_EQ(1ULL, info.getLastModifiedAt());
	EXPECT_EQ(0, info.getFileCount());
	EXPECT_STREQ("228;235;235;255;", info.getBgColor());
	int r = 0, g = 0, b = 0, a = 0;
	info.getBgColorRgba(&r, &g, &b, &a);
	EXPECT_EQ(228, r);
	EXPECT_EQ(235, g);
	EXPECT_EQ(235, b);
	EXPECT_EQ(255, a);
}

TEST(MemoDocInfo, UuidIsMadeOnFirstAskAndKept)
{
	MemoDocInfo info;
	std::string first = info.getMemoUUID();
	EXPECT_EQ(36u, first.size());
	EXPECT_EQ(first, info.getMemoUUID());
	MemoDocInfo other;
	EXPECT_NE(first, other.getMemoUUID());
	// The setter stores but answers false, whatever it is given.
	EXPECT_FALSE(info.setMemoUUID("given"));
	EXPECT_STREQ("given", info.getMemoUUID());
	EXPECT_FALSE(info.setMemoUUID(nullptr));
	EXPECT_STREQ("given", info.getMemoUUID());
}

TEST(MemoDocInfo, RefusedValuesKeepTheField)
{
	MemoDocInfo info;
	ASSERT_TRUE(info.setIsDirty(0));
	EXPECT_FALSE(info.setIsDirty(2));
	EXPECT_FALSE(info.setIsDirty(-1));
	EXPECT_EQ(0, info.getIsDirty());
	EXPECT_FALSE(info.setIsDeleted(-1));
	EXPECT_FALSE(info.setIsNeedUpsync(7));
	EXPECT_EQ(1, info.getIsNeedUpsync());

	ASSERT_TRUE(info.setTitle("kept"));
	EXPECT_FALSE(info.setTitle(nullptr));
	EXPECT_STREQ("kept", info.getTitle());
	ASSERT_TRUE(info.setPhoneNum("123"));
	EXPECT_FALSE(info.setPhoneNum(nullptr));
	EXPECT_STREQ("123", info.getPhoneNum());

	ASSERT_TRUE(info.setFileCount(3));
	EXPECT_FALSE(info.setFileCount(-1));
	EXPECT_EQ(3, info.getFileCount());
}

TEST(MemoDocInfo, BgColorFallsBackOrStopsAsDocumented)
{
	MemoDocInfo info;
	ASSERT_TRUE(info.setBgColor("1;2;3;4;"));
	int r, g, b, a;
	info.getBgColorRgba(&r, &g, &b, &a);
	EXPECT_EQ(1, r);
	EXPECT_EQ(4, a);

	// Three numbers: replaced by the default colour.
	EXPECT_TRUE(info.setBgColor("10;20;30;"));
	EXPECT_STREQ("228;235;235;255;", info.getBgColor());
	info.getBgColorRgba(&r, &g, &b, &a);
	EXPECT_EQ(228, r);
	EXPECT_EQ(235, g);
	EXPECT_EQ(235, b);
	EXPECT_EQ(255, a);
	EXPECT_TRUE(info.setBgColor(""));
	EXPECT_STREQ("228;235;235;255;", info.getBgColor());

	// Sixteen characters skip the separator check: no ";" stops parsing at once.
	ASSERT_TRUE(info.setBgColor("9;8;7;6;"));
	EXPECT_FALSE(info.setBgColor("abcdefghijklmnop"));
	EXPECT_STREQ("abcdefghijklmnop", info.getBgColor());
	info.getBgColorRgba(&r, &g, &b, &a);
	EXPECT_EQ(9, r);
	EXPECT_EQ(6, a);

	// Two separators in 16 characters: the first field parses, then it stops.
	EXPECT_FALSE(info.setBgColor("100;200xxxxxxxxx"));
	info.getBgColorRgba(&r, &g, &b, &a);
	EXPECT_EQ(100, r);
	EXPECT_EQ(8, g);

	EXPECT_THROW(info.setBgColor("abc;def;ghi;jkl;"), std::invalid_argument);

	info.setBgColorRgba(252, 191, 169, 255);
	EXPECT_STREQ("252;191;169;255;", info.getBgColor());
}

TEST(MemoFileInfo, PathDerivesBlobData)
{
	MemoFileInfo file;
	EXPECT_EQ(0, file.getIsDirty());
	EXPECT_EQ(0, file.getIsNeedUpsync());
	file.setData("/set/before");
	ASSERT_TRUE(file.setPath("/opt/media/ab.jpg"));
	EXPECT_STREQ("/opt/media/ab.jpg", file.getPath());
	EXPECT_STREQ("/app_attach/a/b/ab.blob", file.getData());

	file.setPath("/x/3f2a9c10-1b2c-4d5e-8f90-a1b2c3d4e5f6.amr");
	EXPECT_STREQ("/app_attach/f/6/3f2a9c10-1b2c-4d5e-8f90-a1b2c3d4e5f6.blob", file.getData());

	EXPECT_FALSE(file.setSize(-1));
	EXPECT_TRUE(file.setSize(1LL << 40));
	EXPECT_EQ(1LL << 40, file.getSize());
	EXPECT_FALSE(file.setIsDeleted(2));
	EXPECT_FALSE(file.setMimeType(nullptr));
}

TEST(MemoDocInfo, CopyFileInfosTakesEveryFieldAndRederivesData)
{
	MemoFileInfo source[2];
	for (int i = 0; i < 2; ++i) {
		std::string id = "file" + std::to_string(i);
		source[i].setFileUUID(id.c_str());
		source[i].setIsDirty(1);
		source[i].setIsDeleted(1);
		source[i].setAccountType("type");
		source[i].setAccountName("name");
		source[i].setSync1(77);
		source[i].setSync2("s2");
		source[i].setIsNeedUpsync(1);
		source[i].setMemoUUID("memo");
		source[i].setMimeType("image/jpeg");
		source[i].setDisplayName("pic.jpg");
		source[i].setSize(1234 + i);
		source[i].setOrientation(90);
		source[i].setPath(("/m/" + id + ".jpg").c_str());
		source[i].setData("/stale");
	}
	MemoDocInfo info;
	info.setFileCount(2);
	info.copyFileInfos(source);
	const MemoFileInfo *files = info.getFiles();
	EXPECT_STREQ("file1", files[1].getFileUUID());
	EXPECT_EQ(1, files[1].getIsDeleted());
	EXPECT_STREQ("type", files[1].getAccountType());
	EXPECT_EQ(77ULL, files[1].getSync1());
	EXPECT_STREQ("image/jpeg", files[1].getMimeType());
	EXPECT_EQ(1235, files[1].getSize());
	EXPECT_EQ(90, files[1].getOrientation());
	EXPECT_STREQ("/app_attach/e/1/file1.blob", files[1].getData());
	// Entries past the count stay default.
	EXPECT_STREQ("", files[2].getFileUUID());
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
		EXPECT_EQ(0, list.getCount());
		EXPECT_EQ(nullptr, list.getItem(0));
		list.appendItem(nullptr);
		EXPECT_EQ(0, list.getCount());
		for (const char *title : {"a", "b", "c"}) {
			CountedDoc *doc = new CountedDoc();
			doc->setTitle(title);
			list.appendItem(doc);
		}
		ASSERT_EQ(3, list.getCount());
		EXPECT_STREQ("a", list.getItem(0)->getTitle());
		EXPECT_STREQ("c", list.getItem(2)->getTitle());
		EXPECT_EQ(nullptr, list.getItem(3));
		EXPECT_EQ(nullptr, list.getItem(-1));
	}
	EXPECT_EQ(3, gDeleted);
	eina_shutdown();
}
