// Memo reads and writes against a real memo.db: round trips, orderings, flags, search,
// removal with and without the sync account, file reconciliation, paths.
#include "store_test_fixture.h"

#include <cstring>
#include <fstream>
#include <vector>

#include <Ecore_File.h>

using namespace store_test;

namespace
{
struct StringArray {
	char **items = nullptr;
	int count = -1;
	~StringArray()
	{
		for (int i = 0; items && i < count; ++i)
			free(items[i]);
		free(items);
	}
	std::vector<std::string> values() const
	{
		std::vector<std::string> out;
		for (int i = 0; i < count; ++i)
			out.push_back(items[i]);
		return out;
	}
};

void addFile(MemoDocInfo *info, const char *fileUUID, const char *mime, const char *path)
{
	int n = info->getFileCount();
	MemoFileInfo &file = info->getFiles()[n];
	file.setFileUUID(fileUUID);
	file.setMemoUUID(info->getMemoUUID());
	file.setMimeType(mime);
	file.setDisplayName("name");
	file.setSize(10);
	file.setPath(path);
	info->setFileCount(n + 1);
}

std::string addMemo(MemoDbMgr *db, const char *title, const char *body, unsigned long long at, int favourite = 0,
                    int hidden = 0)
{
	MemoDocInfo *info = makeMemo(title, body, at);
	info->setIsFavorite(favourite);
	info->setIsHidden(hidden);
	std::string uuid = info->getMemoUUID();
	EXPECT_TRUE(db->addMemo(info));
	delete info;
	return uuid;
}

std::vector<std::string> uuidsOf(MemoItemList *list)
{
	std::vector<std::string> out;
	for (int i = 0; i < list->getCount(); ++i)
		out.push_back(list->getItem(i)->getMemoUUID());
	delete list;
	return out;
}

int changeNotice()
{
	int value = -1;
	vconf_get_int("db/memo/data-change", &value);
	return value;
}

void signIn()
{
	vconf_set_str("db/desktop/account/list", "com.veltron.veltronaccount|me|me@example.com");
}

void makeMediaFolders(const std::string &uuid)
{
	ecore_file_mkpath((dataPath() + "media/" + uuid + "/thumb").c_str());
	ecore_file_mkpath((sharedDataPath() + "media/" + uuid).c_str());
}
} // namespace

using StoreMemo = StoreTest;

TEST_F(StoreMemo, AddThenReadGivesTheRecordBack)
{
	MemoDocInfo *info = makeMemo("Tom &amp; Jerry's <b>", "body text", 5000);
	info->setTizenXmlContent("<todolist></todolist>");
	info->setAndroidXmlContent("<memo/>");
	info->setAccountName("acc");
	info->setSync1(42);
	info->setSync2("tag");
	info->setVrfileUUID("vr");
	info->setData("/thumb.jpg");
	info->setIsFavorite(1);
	info->setBgColor("1;2;3;255;");
	info->setIsDirty(1);
	std::string uuid = info->getMemoUUID();
	ASSERT_TRUE(db()->addMemo(info));
	delete info;
	EXPECT_EQ(1, changeNotice());

	// Stored as plain text, read back as markup.
	EXPECT_EQ("Tom & Jerry's ", query("SELECT title FROM memo WHERE UUID = '" + uuid + "'"));
	EXPECT_EQ(0, queryInt("SELECT isSynced FROM memo WHERE UUID = '" + uuid + "'"));
	EXPECT_EQ(0, queryInt("SELECT isQuick FROM memo WHERE UUID = '" + uuid + "'"));

	MemoDocInfo *read = db()->getOneMemoN(uuid.c_str());
	ASSERT_NE(nullptr, read);
	EXPECT_EQ(uuid, read->getMemoUUID());
	EXPECT_STREQ("Tom &amp; Jerry&apos;s ", read->getTitle());
	EXPECT_STREQ("body text", read->getStrippedContent());
	EXPECT_STREQ("<todolist></todolist>", read->getTizenXmlContent());
	EXPECT_STREQ("<memo/>", read->getAndroidXmlContent());
	EXPECT_STREQ("acc", read->getAccountName());
	EXPECT_EQ(42ULL, read->getSync1());
	EXPECT_STREQ("tag", read->getSync2());
	EXPECT_STREQ("vr", read->getVrfileUUID());
	EXPECT_STREQ("/thumb.jpg", read->getData());
	EXPECT_EQ(5000ULL, read->getLastModifiedAt());
	EXPECT_EQ(1, read->getIsFavorite());
	EXPECT_STREQ("1;2;3;255;", read->getBgColor());
	delete read;
}

TEST_F(StoreMemo, UnknownUuidGivesADefaultRecord)
{
	ASSERT_NE(nullptr, db());
	EXPECT_EQ(nullptr, db()->getOneMemoN(nullptr));
	MemoDocInfo *info = db()->getOneMemoN("no-such-memo");
	ASSERT_NE(nullptr, info);
	EXPECT_EQ(1, info->getIsDirty());
	EXPECT_EQ(1ULL, info->getCreatedAt());
	EXPECT_STREQ("", info->getTitle());
	delete info;
}

TEST_F(StoreMemo, ListsFilterAndOrder)
{
	ASSERT_NE(nullptr, db());
	std::string quick = query("SELECT UUID FROM memo WHERE isQuick = 1");
	std::string old = addMemo(db(), "old", "", 1000);
	std::string recent = addMemo(db(), "recent", "", 3000);
	std::string fav = addMemo(db(), "fav", "", 2000, 1);
	std::string hidden = addMemo(db(), "hidden", "", 4000, 0, 1);
	std::string gone = addMemo(db(), "gone", "", 5000);
	db()->excuteSql("UPDATE memo SET isDeleted = 1 WHERE UUID = '%q'", gone.c_str());

	EXPECT_EQ((std::vector<std::string>{quick, fav, recent, old}), uuidsOf(db()->getVisibleMemoListN()));
	EXPECT_EQ((std::vector<std::string>{fav, recent, old}), uuidsOf(db()->getVisibleNormalMemoListN()));
	EXPECT_EQ((std::vector<std::string>{fav, hidden, recent, old}), uuidsOf(db()->getAllNormalMemoListN()));
	EXPECT_EQ((std::vector<std::string>{quick, fav, hidden, recent, old}), uuidsOf(db()->getAllMemoListN()));
	EXPECT_EQ(5, db()->getMemoCount());
	EXPECT_EQ(1, db()->getHiddenMemoCount());

	// Lists with colours carry the stored colour and markup titles; the others the default
	// colour, the stored title and isHidden.
	db()->excuteSql("UPDATE memo SET bgColor = '1;1;1;1;', title = 'a<b' WHERE UUID = '%q'", fav.c_str());
	MemoItemList *visible = db()->getVisibleNormalMemoListN();
	EXPECT_STREQ("1;1;1;1;", visible->getItem(0)->getBgColor());
	EXPECT_STREQ("a&lt;b", visible->getItem(0)->getTitle());
	delete visible;
	MemoItemList *all = db()->getAllMemoListN();
	EXPECT_EQ(1, all->getItem(0)->getIsQuick());
	EXPECT_STREQ("228;235;235;255;", all->getItem(1)->getBgColor());
	EXPECT_STREQ("a<b", all->getItem(1)->getTitle());
	EXPECT_EQ(1, all->getItem(2)->getIsHidden());
	delete all;

	// A single read does not know about hiding.
	MemoDocInfo *one = db()->getOneMemoN(hidden.c_str());
	EXPECT_EQ(0, one->getIsHidden());
	delete one;
	EXPECT_TRUE(db()->isMemoHidden(hidden.c_str()));
	EXPECT_FALSE(db()->isMemoHidden(old.c_str()));
	EXPECT_FALSE(db()->isMemoHidden("unknown"));
}

TEST_F(StoreMemo, FavouriteAndHidingLeaveTimeAndNotices)
{
	std::string uuid = addMemo(db(), "t", "", 7000);
	db()->excuteSql("UPDATE memo SET isDirty = 0, isSynced = 1 WHERE UUID = '%q'", uuid.c_str());
	vconf_set_int("db/memo/data-change", 0);
	ASSERT_TRUE(db()->setFavorite(uuid.c_str(), 1));
	EXPECT_EQ(1, changeNotice());
	std::string where = " FROM memo WHERE UUID = '" + uuid + "'";
	EXPECT_EQ(7000, queryInt("SELECT lastModifiedAt" + where));
	EXPECT_EQ(1, queryInt("SELECT isDirty" + where));
	EXPECT_EQ(0, queryInt("SELECT isSynced" + where));
	EXPECT_EQ(1, queryInt("SELECT isFavorite" + where));

	// Hiding changes nothing the other side sees.
	db()->excuteSql("UPDATE memo SET isDirty = 0 WHERE UUID = '%q'", uuid.c_str());
	vconf_set_int("db/memo/data-change", 0);
	const char *ids[] = {uuid.c_str()};
	ASSERT_TRUE(db()->setHiddenMemos(ids, 1));
	EXPECT_EQ(1, queryInt("SELECT isHidden" + where));
	EXPECT_EQ(0, queryInt("SELECT isDirty" + where));
	EXPECT_EQ(0, changeNotice());
	ASSERT_TRUE(db()->setUnhiddenMemos(ids, 1));
	EXPECT_EQ(0, queryInt("SELECT isHidden" + where));
	EXPECT_TRUE(db()->setHiddenMemos(nullptr, 0));
}

TEST_F(StoreMemo, SearchUsesLikeAsItStands)
{
	ASSERT_NE(nullptr, db());
	std::string quick = query("SELECT UUID FROM memo WHERE isQuick = 1");
	db()->excuteSql("UPDATE memo SET strippedContent = 'groceries' WHERE isQuick = 1");
	std::string quote = addMemo(db(), "Bob's list", "", 1000);
	std::string body = addMemo(db(), "plain", "a memo about cats", 2000);
	std::string fav = addMemo(db(), "cats", "", 500, 1);
	std::string hidden = addMemo(db(), "hidden cats", "", 3000, 0, 1);

	StringArray all;
	ASSERT_TRUE(db()->getSearchReultN("%", &all.items, &all.count));
	EXPECT_EQ(5, all.count); // every row, the quick memo through its body

	StringArray quoted;
	ASSERT_TRUE(db()->getSearchReultN("Bob's", &quoted.items, &quoted.count));
	EXPECT_EQ((std::vector<std::string>{quote}), quoted.values());

	// Favourites first, then newest; hidden rows are the caller's to filter.
	StringArray cats;
	ASSERT_TRUE(db()->getSearchReultN("cats", &cats.items, &cats.count));
	EXPECT_EQ((std::vector<std::string>{fav, hidden, body}), cats.values());

	StringArray none;
	none.items = reinterpret_cast<char **>(0x1);
	ASSERT_TRUE(db()->getSearchReultN("zebra", &none.items, &none.count));
	EXPECT_EQ(0, none.count);
	EXPECT_EQ(reinterpret_cast<char **>(0x1), none.items);
	none.items = nullptr;
}

TEST_F(StoreMemo, SearchFindsTheQuickMemoByItsHeaderWords)
{
	ASSERT_NE(nullptr, db());
	std::string quick = query("SELECT UUID FROM memo WHERE isQuick = 1");
	std::string body = addMemo(db(), "plain", "a memo about cats", 2000);
	const char *language = getenv("LANGUAGE");
	std::string saved = language ? language : "";

	// Whatever the language, "quick memo" names it; the quick memo stands first.
	setenv("LANGUAGE", "de", 1);
	StringArray memo;
	ASSERT_TRUE(db()->getSearchReultN("memo", &memo.items, &memo.count));
	EXPECT_EQ((std::vector<std::string>{quick, body}), memo.values());

	// The translated header counts as well.
	StringArray header;
	ASSERT_TRUE(db()->getSearchReultN("Schnell", &header.items, &header.count));
	EXPECT_EQ((std::vector<std::string>{quick}), header.values());

	// The header words match case-sensitively (LIKE itself does not).
	setenv("LANGUAGE", "en", 1);
	StringArray upper;
	ASSERT_TRUE(db()->getSearchReultN("Memo", &upper.items, &upper.count));
	EXPECT_EQ((std::vector<std::string>{body}), upper.values());
	StringArray english;
	ASSERT_TRUE(db()->getSearchReultN("Quick", &english.items, &english.count));
	EXPECT_EQ((std::vector<std::string>{quick}), english.values());
	StringArray capital;
	ASSERT_TRUE(db()->getSearchReultN("QUICK", &capital.items, &capital.count));
	EXPECT_EQ((std::vector<std::string>{quick}), capital.values());

	if (saved.empty())
		unsetenv("LANGUAGE");
	else
		setenv("LANGUAGE", saved.c_str(), 1);
}

TEST_F(StoreMemo, RemovalWithoutAccountTakesEverything)
{
	MemoDocInfo *info = makeMemo("t", "b");
	std::string uuid = info->getMemoUUID();
	addFile(info, "f1", "image/jpeg", "/p/f1.jpg");
	ASSERT_TRUE(db()->addMemo(info));
	delete info;
	makeMediaFolders(uuid);
	vconf_set_int("db/memo/data-change", 0);

	ASSERT_TRUE(db()->removeMemo(uuid.c_str()));
	EXPECT_EQ(0, queryInt("SELECT count(*) FROM memo WHERE UUID = '" + uuid + "'"));
	EXPECT_EQ(0, queryInt("SELECT count(*) FROM file"));
	EXPECT_FALSE(ecore_file_exists((dataPath() + "media/" + uuid).c_str()));
	EXPECT_FALSE(ecore_file_exists((sharedDataPath() + "media/" + uuid).c_str()));
	EXPECT_EQ(1, changeNotice());
}

TEST_F(StoreMemo, UnreachableAccountServiceMeansRemovalOutright)
{
	std::string uuid = addMemo(db(), "t", "", 1000);
	signIn();
	vconf_set_int("db/desktop/account/unavailable", 1);
	ASSERT_TRUE(db()->removeMemo(uuid.c_str()));
	EXPECT_EQ(0, queryInt("SELECT count(*) FROM memo WHERE UUID = '" + uuid + "'"));
}

TEST_F(StoreMemo, SoftDeleteThenSaveRevives)
{
	MemoDocInfo *info = makeMemo("t", "b", 1000);
	std::string uuid = info->getMemoUUID();
	addFile(info, "f1", "image/jpeg", "/p/f1.jpg");
	ASSERT_TRUE(db()->addMemo(info));
	makeMediaFolders(uuid);
	db()->excuteSql("UPDATE memo SET isDirty = 0 WHERE UUID = '%q'", uuid.c_str());

	signIn(); // a sign-in while running counts at once
	ASSERT_TRUE(db()->removeMemo(uuid.c_str()));
	std::string where = " FROM memo WHERE UUID = '" + uuid + "'";
	EXPECT_EQ(1, queryInt("SELECT isDeleted" + where));
	EXPECT_EQ(0, queryInt("SELECT isDirty" + where));
	EXPECT_GT(queryInt("SELECT lastModifiedAt" + where), 1000);
	EXPECT_EQ(1, queryInt("SELECT isDeleted FROM file WHERE UUID = 'f1'"));
	EXPECT_TRUE(ecore_file_is_dir((dataPath() + "media/" + uuid).c_str()));
	EXPECT_EQ(1, db()->getMemoCount()); // the quick memo only

	ASSERT_TRUE(db()->updateMemo(info));
	delete info;
	EXPECT_EQ(0, queryInt("SELECT isDeleted" + where));
	EXPECT_EQ(2, db()->getMemoCount());

	// removeMemos answers true whatever happened.
	const char *ids[] = {uuid.c_str(), "unknown"};
	vconf_unset("db/desktop/account/list");
	EXPECT_TRUE(db()->removeMemos(ids, 2));
	EXPECT_EQ(1, db()->getMemoCount());
}

TEST_F(StoreMemo, UpdateOfTheQuickMemoKeepsItsTitle)
{
	ASSERT_NE(nullptr, db());
	std::string quick = query("SELECT UUID FROM memo WHERE isQuick = 1");
	std::string title = query("SELECT title FROM memo WHERE isQuick = 1");
	MemoDocInfo *info = db()->getOneMemoN(quick.c_str());
	ASSERT_EQ(1, info->getIsQuick());
	info->setTitle("renamed");
	info->setCategoryUUID("cat");
	info->setStrippedContent("new body");
	ASSERT_TRUE(db()->updateMemo(info));
	delete info;
	EXPECT_EQ(title, query("SELECT title FROM memo WHERE isQuick = 1"));
	EXPECT_EQ("cat", query("SELECT categoryUUID FROM memo WHERE isQuick = 1"));
	EXPECT_EQ("new body", query("SELECT strippedContent FROM memo WHERE isQuick = 1"));

	// A normal memo's category is the other side's.
	std::string uuid = addMemo(db(), "t", "", 1000);
	db()->excuteSql("UPDATE memo SET categoryUUID = 'theirs' WHERE UUID = '%q'", uuid.c_str());
	MemoDocInfo *normal = db()->getOneMemoN(uuid.c_str());
	normal->setCategoryUUID("mine");
	normal->setTitle("renamed");
	ASSERT_TRUE(db()->updateMemo(normal));
	delete normal;
	EXPECT_EQ("theirs", query("SELECT categoryUUID FROM memo WHERE UUID = '" + uuid + "'"));
	EXPECT_EQ("renamed", query("SELECT title FROM memo WHERE UUID = '" + uuid + "'"));
}

TEST_F(StoreMemo, CheckUpdatedFilesAddsDeletesAndKeeps)
{
	MemoDocInfo *info = makeMemo("t", "");
	std::string uuid = info->getMemoUUID();
	ASSERT_TRUE(db()->addMemo(info));
	std::string rows =
	    "SELECT group_concat(UUID) FROM (SELECT UUID FROM file WHERE memoUUID = '" + uuid + "' ORDER BY _id)";

	// Nothing on either side.
	EXPECT_TRUE(db()->checkUpdatedFiles(info));
	EXPECT_EQ("<null>", query(rows));

	// Add into an empty table.
	addFile(info, "fa", "image/png", "/p/fa.png");
	addFile(info, "fb", "audio/amr", "/p/fb.amr");
	ASSERT_TRUE(db()->checkUpdatedFiles(info));
	EXPECT_EQ("fa,fb", query(rows));
	EXPECT_EQ("/app_attach/f/a/fa.blob", query("SELECT _data FROM file WHERE UUID = 'fa'"));
	long long idB = queryInt("SELECT _id FROM file WHERE UUID = 'fb'");

	// Identical sets change nothing.
	ASSERT_TRUE(db()->checkUpdatedFiles(info));
	EXPECT_EQ("fa,fb", query(rows));

	// Mixed: fa goes, fc comes, fb stays as stored even with changed fields.
	MemoDocInfo *next = makeMemo("t", "");
	next->setMemoUUID(uuid.c_str());
	addFile(next, "fb", "audio/amr", "/p/fb-changed.amr");
	addFile(next, "fc", "image/jpeg", "/p/fc.jpg");
	ASSERT_TRUE(db()->checkUpdatedFiles(next));
	EXPECT_EQ("fb,fc", query(rows));
	EXPECT_EQ(idB, queryInt("SELECT _id FROM file WHERE UUID = 'fb'"));
	EXPECT_EQ("/p/fb.amr", query("SELECT path FROM file WHERE UUID = 'fb'"));

	// No files in the record: every row goes.
	next->setFileCount(0);
	ASSERT_TRUE(db()->checkUpdatedFiles(next));
	EXPECT_EQ("<null>", query(rows));
	delete next;
	delete info;
}

TEST_F(StoreMemo, PathsComeInInsertionOrder)
{
	MemoDocInfo *info = makeMemo("t", "");
	std::string uuid = info->getMemoUUID();
	addFile(info, "i1", "image/jpeg", "/p/i1.jpg");
	addFile(info, "v1", "audio/amr", "/p/v1.amr");
	addFile(info, "i2", "image/png", "/p/i2.png");
	info->setData("x");
	ASSERT_TRUE(db()->addMemo(info));
	delete info;

	StringArray paths;
	ASSERT_TRUE(db()->getFilePathsN(uuid.c_str(), &paths.items, &paths.count));
	EXPECT_EQ((std::vector<std::string>{"/p/i1.jpg", "/p/v1.amr", "/p/i2.png"}), paths.values());
	StringArray images;
	ASSERT_TRUE(db()->getImageFilePathsN(uuid.c_str(), &images.items, &images.count));
	EXPECT_EQ((std::vector<std::string>{"/p/i1.jpg", "/p/i2.png"}), images.values());
	StringArray none;
	ASSERT_TRUE(db()->getFilePathsN("no-files", &none.items, &none.count));
	EXPECT_EQ(0, none.count);

	char *path = nullptr;
	ASSERT_TRUE(db()->getFilePathN("v1", &path));
	EXPECT_STREQ("/p/v1.amr", path);
	free(path);

	// A one-byte thumbnail is no thumbnail; the out path is left alone, unless the row is missing.
	char marker[] = "untouched";
	path = marker;
	EXPECT_FALSE(db()->getMemoThumbnailImageN(uuid.c_str(), &path));
	EXPECT_EQ(marker, path);
	EXPECT_FALSE(db()->getMemoThumbnailImageN("unknown", &path));
	EXPECT_EQ(nullptr, path);
	db()->excuteSql("UPDATE memo SET _data = '/t.jpg' WHERE UUID = '%q'", uuid.c_str());
	ASSERT_TRUE(db()->getMemoThumbnailImageN(uuid.c_str(), &path));
	EXPECT_STREQ("/t.jpg", path);
	free(path);
}
