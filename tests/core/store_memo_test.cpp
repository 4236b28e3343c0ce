// Memo reads and writes against a real memo.db: round trips, orderings, flags, search,
// removal with and without the sync account, file reconciliation, paths.
#include "store_test_fixture.h"

#include <Ecore_File.h>

#include <sstream>

using namespace store_test;
using Strings = std::vector<std::string>;

namespace
{
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

Strings uuidsOf(MemoItemList *list)
{
	Strings out;
	for (int i = 0; i < list->getCount(); ++i)
		out.push_back(list->getItem(i)->getMemoUUID());
	delete list;
	return out;
}

Strings search(const char *text)
{
	return listOf(&MemoDbMgr::getSearchReultN, text);
}

// A memo with one file and both media folders, as the editor leaves it.
MemoDocInfo *addMemoWithMedia()
{
	MemoDocInfo *info = makeMemo("t", "b", 1000);
	addFile(info, "f1", "image/jpeg", "/p/f1.jpg");
	EXPECT_TRUE(MemoDbMgr::getInstance()->addMemo(info));
	ecore_file_mkpath((dataPath() + "media/" + info->getMemoUUID() + "/thumb").c_str());
	ecore_file_mkpath((sharedDataPath() + "media/" + info->getMemoUUID()).c_str());
	return info;
}

void signIn()
{
	vconf_set_str("db/desktop/account/list", "com.veltron.veltronaccount|me|me@example.com");
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
	std::string uuid = info->getMemoUUID();
	ASSERT_TRUE(db()->addMemo(info));
	delete info;
	EXPECT_EQ(1, changeNotice());

	// Stored as plain text, read back as markup.
	EXPECT_EQ("Tom & Jerry's ", memoColumn(uuid, "title"));
	EXPECT_EQ("0", memoColumn(uuid, "isSynced"));
	EXPECT_EQ("0", memoColumn(uuid, "isQuick"));

	MemoDocInfo *read = db()->getOneMemoN(uuid.c_str());
	ASSERT_NE(nullptr, read);
	std::ostringstream fields;
	fields << read->getMemoUUID() << "|" << read->getTitle() << "|" << read->getStrippedContent() << "|"
	       << read->getTizenXmlContent() << "|" << read->getAndroidXmlContent() << "|" << read->getAccountName() << "|"
	       << read->getSync1() << "|" << read->getSync2() << "|" << read->getVrfileUUID() << "|" << read->getData()
	       << "|" << read->getLastModifiedAt() << "|" << read->getIsFavorite() << "|" << read->getBgColor();
	EXPECT_EQ(uuid + "|Tom &amp; Jerry&apos;s |body text|<todolist></todolist>|<memo/>|acc|42|tag|vr|/thumb.jpg|5000|1|"
	                 "1;2;3;255;",
	          fields.str());
	delete read;

	// An unknown UUID gives a default record.
	MemoDocInfo *unknown = db()->getOneMemoN("no-such-memo");
	ASSERT_NE(nullptr, unknown);
	EXPECT_EQ(1ULL, unknown->getCreatedAt());
	EXPECT_STREQ("", unknown->getTitle());
	delete unknown;
}

TEST_F(StoreMemo, ListsFilterAndOrder)
{
	ASSERT_NE(nullptr, db()); // made before it is read behind its back
	std::string quick = quickColumn("UUID");
	std::string old = addMemo("old", "", 1000);
	std::string recent = addMemo("recent", "", 3000);
	std::string fav = addMemo("fav", "", 2000, 1);
	std::string hidden = addMemo("hidden", "", 4000, 0, 1);
	std::string gone = addMemo("gone", "", 5000);
	db()->excuteSql("UPDATE memo SET isDeleted = 1 WHERE UUID = '%q'", gone.c_str());

	EXPECT_EQ((Strings{quick, fav, recent, old}), uuidsOf(db()->getVisibleMemoListN()));
	EXPECT_EQ((Strings{fav, recent, old}), uuidsOf(db()->getVisibleNormalMemoListN()));
	EXPECT_EQ((Strings{fav, hidden, recent, old}), uuidsOf(db()->getAllNormalMemoListN()));
	EXPECT_EQ((Strings{quick, fav, hidden, recent, old}), uuidsOf(db()->getAllMemoListN()));
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
	// Reads of the same rows share their texts: a record changed, or kept past the lists and the store, is
	// its own.
	MemoItemList *again = db()->getAllMemoListN();
	MemoDocInfo kept(*again->getItem(1));
	all->getItem(1)->setTitle("changed");
	EXPECT_STREQ("a<b", again->getItem(1)->getTitle());
	delete all;
	delete again;
	MemoDbMgr::destroy();
	EXPECT_STREQ("a<b", kept.getTitle());

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
	std::string uuid = addMemo("t", "", 7000);
	db()->excuteSql("UPDATE memo SET isDirty = 0, isSynced = 1 WHERE UUID = '%q'", uuid.c_str());
	vconf_set_int("db/memo/data-change", 0);
	ASSERT_TRUE(db()->setFavorite(uuid.c_str(), 1));
	EXPECT_EQ(1, changeNotice());
	EXPECT_EQ("7000", memoColumn(uuid, "lastModifiedAt"));
	EXPECT_EQ("1|0|1", memoColumn(uuid, "isDirty || '|' || isSynced || '|' || isFavorite"));

	// Hiding changes nothing the other side sees.
	db()->excuteSql("UPDATE memo SET isDirty = 0 WHERE UUID = '%q'", uuid.c_str());
	vconf_set_int("db/memo/data-change", 0);
	const char *ids[] = {uuid.c_str()};
	ASSERT_TRUE(db()->setHiddenMemos(ids, 1));
	EXPECT_EQ("1|0", memoColumn(uuid, "isHidden || '|' || isDirty"));
	EXPECT_EQ(0, changeNotice());
	ASSERT_TRUE(db()->setUnhiddenMemos(ids, 1));
	EXPECT_EQ("0", memoColumn(uuid, "isHidden"));
	EXPECT_TRUE(db()->setHiddenMemos(nullptr, 0));
}

TEST_F(StoreMemo, SearchUsesLikeAsItStandsAndFindsTheQuickMemoByItsHeaderWords)
{
	ASSERT_NE(nullptr, db()); // made before it is read behind its back
	std::string quick = quickColumn("UUID");
	db()->excuteSql("UPDATE memo SET strippedContent = 'groceries' WHERE isQuick = 1");
	std::string quote = addMemo("Bob's list", "", 1000);
	std::string body = addMemo("plain", "a memo about cats", 2000);
	std::string fav = addMemo("cats", "", 500, 1);
	std::string hidden = addMemo("hidden cats", "", 3000, 0, 1);

	EXPECT_EQ(5u, search("%").size()); // every row, the quick memo through its body
	EXPECT_EQ((Strings{quote}), search("Bob's"));
	// Favourites first, then newest; hidden rows are the caller's to filter.
	EXPECT_EQ((Strings{fav, hidden, body}), search("cats"));
	EXPECT_EQ((Strings{}), search("zebra"));

	// Whatever the language, "quick memo" names it, and the quick memo stands first; the translated header
	// counts as well. The header words match case-sensitively (LIKE itself does not).
	const char *language = getenv("LANGUAGE");
	std::string saved = language ? language : "";
	struct {
		const char *language, *text;
		Strings found;
	} cases[] = {{"de", "memo", {quick, body}},
	             {"de", "Schnell", {quick}},
	             {"en", "Memo", {body}},
	             {"en", "Quick", {quick}},
	             {"en", "QUICK", {quick}}};
	for (const auto &c : cases) {
		setenv("LANGUAGE", c.language, 1);
		EXPECT_EQ(c.found, search(c.text)) << c.language << " " << c.text;
	}
	if (saved.empty())
		unsetenv("LANGUAGE");
	else
		setenv("LANGUAGE", saved.c_str(), 1);
}

// Without a reachable sign-in the memo, its files and its media go at once.
TEST_F(StoreMemo, RemovalWithoutUsableAccountTakesEverything)
{
	for (bool signedInButUnreachable : {false, true}) {
		SCOPED_TRACE(signedInButUnreachable);
		if (signedInButUnreachable) {
			signIn();
			vconf_set_int("db/desktop/account/unavailable", 1);
		}
		MemoDocInfo *info = addMemoWithMedia();
		std::string uuid = info->getMemoUUID();
		delete info;
		vconf_set_int("db/memo/data-change", 0);

		ASSERT_TRUE(db()->removeMemo(uuid.c_str()));
		EXPECT_EQ("<none>", memoColumn(uuid, "UUID"));
		EXPECT_EQ(0, queryInt("SELECT count(*) FROM file"));
		EXPECT_FALSE(ecore_file_exists((dataPath() + "media/" + uuid).c_str()));
		EXPECT_FALSE(ecore_file_exists((sharedDataPath() + "media/" + uuid).c_str()));
		EXPECT_EQ(1, changeNotice());
	}
}

TEST_F(StoreMemo, SoftDeleteThenSaveRevives)
{
	MemoDocInfo *info = addMemoWithMedia();
	std::string uuid = info->getMemoUUID();
	db()->excuteSql("UPDATE memo SET isDirty = 0 WHERE UUID = '%q'", uuid.c_str());

	signIn(); // a sign-in while running counts at once
	ASSERT_TRUE(db()->removeMemo(uuid.c_str()));
	EXPECT_EQ("1|0", memoColumn(uuid, "isDeleted || '|' || isDirty"));
	EXPECT_GT(atoll(memoColumn(uuid, "lastModifiedAt").c_str()), 1000);
	EXPECT_EQ(1, queryInt("SELECT isDeleted FROM file WHERE UUID = 'f1'"));
	EXPECT_TRUE(ecore_file_is_dir((dataPath() + "media/" + uuid).c_str()));
	EXPECT_EQ(1, db()->getMemoCount()); // the quick memo only

	ASSERT_TRUE(db()->updateMemo(info));
	delete info;
	EXPECT_EQ("0", memoColumn(uuid, "isDeleted"));
	EXPECT_EQ(2, db()->getMemoCount());

	// removeMemos answers true whatever happened.
	const char *ids[] = {uuid.c_str(), "unknown"};
	vconf_unset("db/desktop/account/list");
	EXPECT_TRUE(db()->removeMemos(ids, 2));
	EXPECT_EQ(1, db()->getMemoCount());
}

TEST_F(StoreMemo, UpdateOfTheQuickMemoKeepsItsTitle)
{
	ASSERT_NE(nullptr, db()); // made before it is read behind its back
	std::string title = quickColumn("title");
	MemoDocInfo *info = db()->getOneMemoN(quickColumn("UUID").c_str());
	ASSERT_EQ(1, info->getIsQuick());
	info->setTitle("renamed");
	info->setCategoryUUID("cat");
	info->setStrippedContent("new body");
	ASSERT_TRUE(db()->updateMemo(info));
	delete info;
	EXPECT_EQ(title, quickColumn("title"));
	EXPECT_EQ("cat", quickColumn("categoryUUID"));
	EXPECT_EQ("new body", quickColumn("strippedContent"));

	// A normal memo's category is the other side's.
	std::string uuid = addMemo("t", "", 1000);
	db()->excuteSql("UPDATE memo SET categoryUUID = 'theirs' WHERE UUID = '%q'", uuid.c_str());
	MemoDocInfo *normal = db()->getOneMemoN(uuid.c_str());
	normal->setCategoryUUID("mine");
	normal->setTitle("renamed");
	ASSERT_TRUE(db()->updateMemo(normal));
	delete normal;
	EXPECT_EQ("theirs", memoColumn(uuid, "categoryUUID"));
	EXPECT_EQ("renamed", memoColumn(uuid, "title"));
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

	EXPECT_EQ((Strings{"/p/i1.jpg", "/p/v1.amr", "/p/i2.png"}), listOf(&MemoDbMgr::getFilePathsN, uuid.c_str()));
	EXPECT_EQ((Strings{"/p/i1.jpg", "/p/i2.png"}), listOf(&MemoDbMgr::getImageFilePathsN, uuid.c_str()));
	EXPECT_EQ((Strings{}), listOf(&MemoDbMgr::getFilePathsN, "no-files"));
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
