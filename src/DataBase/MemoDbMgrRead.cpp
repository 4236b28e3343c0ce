// Reads of memo.db: counts, one memo, the four lists, paths, search.
#include "DataBase/MemoDbMgr.h"

#include <cstdlib>
#include <cstring>

#include <Elementary.h>
#include <app_i18n.h>
#include <sqlite3.h>

#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"
#include "MemoLog.h"
#include "MemoListRows.h"
#include "MemoSqlStmt.h"

// Every list read selects 23 columns.
#define MEMO_LIST_COLUMNS 23

#define MEMO_SQL_ONE_MEMO                                                                                              \
	"SELECT "                                                                                                          \
	"UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,isNeedUpsync,createdAt,lastModifiedAt,categoryUUID,"   \
	"title,content,xmlContent, "                                                                                       \
	"tizenXmlContent,display_Content,vrfileUUID,strippedContent,_data,_phoneNum,isFavorite, "                          \
	"isQuick,bgColor FROM memo WHERE UUID = '%q'"
#define MEMO_SQL_VISIBLE_NORMAL_LIST                                                                                   \
	"SELECT "                                                                                                          \
	"UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,isNeedUpsync,createdAt,lastModifiedAt,categoryUUID,"   \
	"title,content,xmlContent, "                                                                                       \
	"tizenXmlContent,display_Content,vrfileUUID,strippedContent,_data,_phoneNum,isFavorite, "                          \
	"isQuick, bgColor FROM memo WHERE isDeleted = 0 AND isHidden = 0 AND isQuick = 0 ORDER BY isFavorite DESC, "       \
	"lastModifiedAt DESC"
#define MEMO_SQL_VISIBLE_LIST                                                                                          \
	"SELECT "                                                                                                          \
	"UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,isNeedUpsync,createdAt,lastModifiedAt,categoryUUID,"   \
	"title,content,xmlContent, "                                                                                       \
	"tizenXmlContent,display_Content,vrfileUUID,strippedContent,_data,_phoneNum,isFavorite, "                          \
	"isQuick, bgColor FROM memo WHERE isDeleted = 0 AND isHidden = 0 ORDER BY isQuick DESC, isFavorite DESC, "         \
	"lastModifiedAt DESC"
#define MEMO_SQL_ALL_NORMAL_LIST                                                                                       \
	"SELECT "                                                                                                          \
	"UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,isNeedUpsync,createdAt,lastModifiedAt,categoryUUID,"   \
	"title,content,xmlContent,tizenXmlContent,display_Content,vrfileUUID,strippedContent,_data,_phoneNum,isFavorite,"  \
	"isHidden , isQuick FROM memo WHERE isDeleted = 0 AND isQuick = 0 ORDER BY isFavorite DESC, lastModifiedAt DESC"
#define MEMO_SQL_ALL_LIST                                                                                              \
	"SELECT "                                                                                                          \
	"UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,isNeedUpsync,createdAt,lastModifiedAt,categoryUUID,"   \
	"title,content,xmlContent,tizenXmlContent,display_Content,vrfileUUID,strippedContent,_data,_phoneNum,isFavorite,"  \
	"isHidden, isQuick  FROM memo WHERE isDeleted = 0 ORDER BY isQuick DESC, isFavorite DESC, lastModifiedAt DESC"

#define MEMO_SQL_SEARCH_COUNT_WITH_QUICK                                                                               \
	"SELECT count(UUID) FROM memo WHERE (title like '%%%q%%' escape '/') OR (strippedContent like '%%%q%%' escape "    \
	"'/') OR isQuick=1 ORDER BY isQuick, isFavorite DESC"
#define MEMO_SQL_SEARCH_COUNT                                                                                          \
	"SELECT count(UUID) FROM memo WHERE ((title like '%%%q%%' escape '/') AND isQuick != 1) OR (strippedContent "      \
	"like '%%%q%%' escape '/') ORDER BY isFavorite DESC"
#define MEMO_SQL_SEARCH_WITH_QUICK                                                                                     \
	"SELECT distinct(UUID) FROM memo WHERE (title like '%%%q%%' escape '/') OR (strippedContent like '%%%q%%' "        \
	"escape '/') OR isQuick=1 ORDER BY isQuick DESC, isFavorite DESC, lastModifiedAt DESC"
#define MEMO_SQL_SEARCH                                                                                                \
	"SELECT distinct(UUID) FROM memo WHERE ((title like '%%%q%%' escape '/') AND isQuick != 1) OR (strippedContent "   \
	"like '%%%q%%' escape '/') ORDER BY isFavorite DESC, lastModifiedAt DESC"

// Fills a record from a row of one of the memo reads. The reads that select bgColor hold
// isQuick and bgColor in columns 21 and 22 and keep titles as markup; the others hold
// isHidden and isQuick there and keep titles as stored.
// True when text is its own markup: printable ASCII with none of the characters that the markup
// conversion turns into entities or tags (it also names most letters beyond ASCII).
static bool __isOwnMarkup(const char *text)
{
	if (!text)
		return false;
	for (const unsigned char *p = reinterpret_cast<const unsigned char *>(text); *p; ++p)
		if (*p < 0x20 || *p > 0x7e || *p == '<' || *p == '>' || *p == '&' || *p == '"' || *p == '\'')
			return false;
	return true;
}

// The characters of a column's text, null for SQL NULL, from a statement or from kept rows.
static const char *__chars(const char *text)
{
	return text;
}

static const char *__chars(const MemoText &text)
{
	return text.isNull() ? nullptr : text.c_str();
}

template <typename Row> static void __fillRecord(Row &stmt, MemoDocInfo *info, bool withColor)
{
	info->setMemoUUID(stmt.text(0));
	info->setIsDirty(stmt.integer(1));
	info->setIsDeleted(stmt.integer(2));
	info->setAccountType(stmt.text(3));
	info->setAccountName(stmt.text(4));
	info->setSync1(stmt.u64(5));
	info->setSync2(stmt.text(6));
	info->setIsNeedUpsync(stmt.integer(7));
	info->setCreatedAt(stmt.u64(8));
	info->setLastModifiedAt(stmt.u64(9));
	info->setCategoryUUID(stmt.text(10));
	if (withColor) {
		const auto &plain = stmt.text(11);
		if (__isOwnMarkup(__chars(plain))) {
			info->setTitle(plain);
		} else {
			char *title = elm_entry_utf8_to_markup(__chars(plain));
			info->setTitle(title);
			free(title);
		}
	} else {
		info->setTitle(stmt.text(11));
	}
	info->setContent(stmt.text(12));
	info->setAndroidXmlContent(stmt.text(13));
	info->setTizenXmlContent(stmt.text(14));
	info->setDisplayContent(stmt.text(15));
	info->setVrfileUUID(stmt.text(16));
	info->setStrippedContent(stmt.text(17));
	info->setData(stmt.text(18));
	info->setPhoneNum(stmt.text(19));
	info->setIsFavorite(stmt.integer(20));
	if (withColor) {
		info->setIsQuick(stmt.integer(21));
		info->setBgColor(stmt.text(22));
	} else {
		info->setIsHidden(stmt.integer(21));
		info->setIsQuick(stmt.integer(22));
	}
}

int MemoDbMgr::__getCount(const char *sql)
{
	MemoSqlStmt stmt(__createSqliteStmt(sql));
	if (!stmt)
		return -1;
	int ret = stmt.step();
	if (ret != SQLITE_ROW) {
		MEMO_LOGE("ERROR(%d).", ret);
		return -1;
	}
	return stmt.integer(0);
}

int MemoDbMgr::getMemoCount()
{
	return __getCount("SELECT count(*) FROM memo WHERE isDeleted = 0");
}

int MemoDbMgr::getHiddenMemoCount()
{
	return __getCount("SELECT count(*) FROM memo WHERE isDeleted = 0 and isHidden=1 and isQuick=0");
}

MemoDocInfo *MemoDbMgr::getOneMemoN(const char *uuid)
{
	if (!uuid) {
		MEMO_LOGE("uuid is NULL");
		return nullptr;
	}
	MemoDocInfo *info = new MemoDocInfo();
	MemoSqlStmt stmt(__createSqliteStmt(MEMO_SQL_ONE_MEMO, uuid));
	if (stmt && stmt.step() == SQLITE_ROW)
		__fillRecord(stmt, info, true);
	return info;
}

MemoItemList *MemoDbMgr::__getMemoListN(const char *sql, bool withColor)
{
	MemoItemList *list = new MemoItemList();
	std::shared_ptr<const MemoListRows> rows = MemoListRows::find(__handle, sql);
	if (!rows) {
		MemoSqlStmt stmt(__createSqliteStmt(sql));
		if (!stmt)
			return list;
		rows = std::make_shared<MemoListRows>(stmt, MEMO_LIST_COLUMNS);
		MemoListRows::keep(__handle, sql, rows);
	}
	for (int row = 0; row < rows->count(); ++row) {
		MemoDocInfo *info = new MemoDocInfo();
		info->keepTexts(rows->texts());
		MemoListRowReader reader(*rows, row);
		__fillRecord(reader, info, withColor);
		list->appendItem(info);
	}
	return list;
}

MemoItemList *MemoDbMgr::getVisibleNormalMemoListN()
{
	return __getMemoListN(MEMO_SQL_VISIBLE_NORMAL_LIST, true);
}

MemoItemList *MemoDbMgr::getVisibleMemoListN()
{
	return __getMemoListN(MEMO_SQL_VISIBLE_LIST, true);
}

MemoItemList *MemoDbMgr::getAllNormalMemoListN()
{
	return __getMemoListN(MEMO_SQL_ALL_NORMAL_LIST, false);
}

MemoItemList *MemoDbMgr::getAllMemoListN()
{
	return __getMemoListN(MEMO_SQL_ALL_LIST, false);
}

bool MemoDbMgr::isMemoHidden(const char *uuid)
{
	if (!uuid) {
		MEMO_LOGE("uuid is NULL");
		return false;
	}
	MemoSqlStmt stmt(__createSqliteStmt("SELECT isHidden FROM memo WHERE UUID = '%q'", uuid));
	if (!stmt)
		return false;
	bool hidden = false;
	while (stmt.step() == SQLITE_ROW)
		hidden = stmt.integer(0) != 0;
	return hidden;
}

bool MemoDbMgr::__getOnePathN(const char *sql, const char *uuid, char **path, bool clearOnShort)
{
	if (!uuid) {
		MEMO_LOGE("uuid is NULL");
		return false;
	}
	MemoSqlStmt stmt(__createSqliteStmt(sql, uuid));
	int ret = stmt ? stmt.step() : SQLITE_ERROR;
	if (ret != SQLITE_ROW) {
		if (path)
			*path = nullptr;
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	const char *value = stmt.text(0);
	if (value && strlen(value) >= 2) {
		if (path)
			*path = strdup(value);
		return true;
	}
	if (clearOnShort && path)
		*path = nullptr;
	return false;
}

bool MemoDbMgr::getMemoThumbnailImageN(const char *uuid, char **path)
{
	return __getOnePathN("SELECT _data FROM memo WHERE UUID = '%q'", uuid, path, false);
}

bool MemoDbMgr::getFilePathN(const char *fileUUID, char **path)
{
	return __getOnePathN("SELECT path FROM file WHERE UUID = '%q'", fileUUID, path, true);
}

// Reads one text column of every row into a new array of at most capacity strings.
static int __readTexts(MemoSqlStmt &stmt, char **array, int capacity)
{
	int count = 0;
	do {
		const char *value = stmt.text(0);
		array[count++] = strdup(value ? value : "");
	} while (count < capacity && stmt.step() == SQLITE_ROW);
	return count;
}

bool MemoDbMgr::__getPathsN(const char *countSql, const char *listSql, const char *uuid, char ***paths, int *count)
{
	if (!uuid || !paths || !count) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	int total = 0;
	{
		MemoSqlStmt stmt(__createSqliteStmt(countSql, uuid));
		if (!stmt || stmt.step() != SQLITE_ROW) {
			*count = 0;
			return false;
		}
		total = stmt.integer(0);
	}
	if (total < 1) {
		*count = 0;
		return true;
	}
	MemoSqlStmt stmt(__createSqliteStmt(listSql, uuid));
	if (!stmt || stmt.step() != SQLITE_ROW) {
		*count = 0;
		return false;
	}
	char **array = static_cast<char **>(calloc(total, sizeof(char *)));
	*count = __readTexts(stmt, array, total);
	*paths = array;
	return true;
}

bool MemoDbMgr::getFilePathsN(const char *uuid, char ***paths, int *count)
{
	return __getPathsN("SELECT count(*) FROM file WHERE memoUUID = '%q'",
	                   "SELECT path FROM file WHERE memoUUID = '%q' ORDER BY _id", uuid, paths, count);
}

bool MemoDbMgr::getImageFilePathsN(const char *uuid, char ***paths, int *count)
{
	return __getPathsN("SELECT count(*) FROM file WHERE memoUUID = '%q' AND mime_type Like '%%image%%' ",
	                   "SELECT path FROM file WHERE memoUUID = '%q' AND mime_type Like '%%image%%'ORDER BY _id", uuid,
	                   paths, count);
}

// The quick memo's stored title is a translated header, so its words are matched here
// against the header texts instead (case-sensitively; an empty text matches).
static bool __matchesQuickMemoWords(const char *text)
{
	const char *header = i18n_get_text("IDS_MEMO_HEADER_QUICK_MEMO");
	return (header && strstr(header, text)) || strstr("quick memo", text) || strstr("QUICK MEMO", text);
}

bool MemoDbMgr::getSearchReultN(const char *text, char ***uuids, int *count)
{
	if (!text || !uuids || !count) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	bool withQuick = __matchesQuickMemoWords(text);
	int total = 0;
	{
		MemoSqlStmt stmt(
		    __createSqliteStmt(withQuick ? MEMO_SQL_SEARCH_COUNT_WITH_QUICK : MEMO_SQL_SEARCH_COUNT, text, text));
		int ret = stmt ? stmt.step() : SQLITE_ERROR;
		if (ret != SQLITE_ROW) {
			*count = 0;
			MEMO_LOGE("ERROR(%d).", ret);
			return false;
		}
		total = stmt.integer(0);
	}
	if (total < 1) {
		*count = 0;
		return true;
	}
	MemoSqlStmt stmt(__createSqliteStmt(withQuick ? MEMO_SQL_SEARCH_WITH_QUICK : MEMO_SQL_SEARCH, text, text));
	int ret = stmt ? stmt.step() : SQLITE_ERROR;
	if (ret != SQLITE_ROW) {
		*count = 0;
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	char **array = static_cast<char **>(calloc(total, sizeof(char *)));
	*count = __readTexts(stmt, array, total);
	*uuids = array;
	return true;
}

std::pair<long long, long long> MemoDbMgr::getChangeStamp()
{
	// data_version moves with the commits of other connections, the change count with this one's.
	long long version = -1;
	sqlite3_stmt *stmt = nullptr;
	if (__handle && sqlite3_prepare_v2(__handle, "PRAGMA data_version", -1, &stmt, nullptr) == SQLITE_OK &&
	    sqlite3_step(stmt) == SQLITE_ROW)
		version = sqlite3_column_int64(stmt, 0);
	sqlite3_finalize(stmt);
	return {version, __handle ? sqlite3_total_changes64(__handle) : -1};
}
