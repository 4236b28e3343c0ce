// Writes to memo.db: memos, their file rows, flags and removal with the media folders.
#include "DataBase/MemoDbMgr.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include <Ecore_File.h>
#include <Elementary.h>
#include <app_common.h>
#include <sqlite3.h>

#include "DataBase/MemoDocInfo.h"
#include "MemoDbSupport.h"
#include "MemoLog.h"
#include "MemoSqlStmt.h"
#include "Util/MemoUtil.h"

#define MEMO_SQL_INSERT_MEMO                                                                                           \
	"INSERT INTO memo(xmlContent,tizenXmlContent, content, title,accountName,sync2,accountType,strippedContent,"       \
	"display_Content,UUID, categoryUUID, vrfileUUID, _data, lastModifiedAt, isDirty, isDeleted, createdAt, sync1, "    \
	"isFavorite, isHidden,isSynced,bgColor) "                                                                          \
	"VALUES('%q','%q','%q','%q','%q','%q','%q','%q','%q','%q','%q','%q','%q',%llu,%d,%d, %llu,%llu,%d,%d,%d,'%q')"
#define MEMO_SQL_INSERT_FILE                                                                                           \
	"INSERT INTO file(UUID,accountType,accountName,sync2,memoUUID,mime_type,_display_name, "                           \
	"_data,isDirty,isDeleted,sync1,isNeedUpsync,_size,orientation, path)VALUES('%q','%q','%q','%q','%q','%q','%q','%"  \
	"q',%d, %d, %llu, %d, %lld, %d, '%q')"
// The same insert as addMemo's, as addNewFile has always spelled it.
#define MEMO_SQL_INSERT_NEW_FILE                                                                                       \
	"INSERT INTO file(UUID,accountType,accountName,sync2,memoUUID,mime_type,_display_name, "                           \
	"_data,isDirty,isDeleted,sync1,isNeedUpsync,_size,orientation, path)VALUES('%q','%q','%q','%q','%q','%q','%q','%"  \
	"q',%d, %d, %llu, %d, %lld, %d, '%q' )"
#define MEMO_SQL_UPDATE_MEMO                                                                                           \
	"UPDATE memo SET xmlContent='%q', tizenXmlContent='%q', content = '%q', title = '%q', accountName = '%q', sync2 "  \
	"= '%q',accountType = '%q',strippedContent = '%q', display_Content = '%q',  vrfileUUID='%q', _data = '%q', "       \
	"lastModifiedAt = %llu, isDirty = %d , isDeleted = %d,sync1 = %llu, isFavorite = %d, isSynced = 0 , bgColor = "    \
	"'%q' WHERE UUID = '%q'"
// The quick memo keeps its stored title; its category is written instead.
#define MEMO_SQL_UPDATE_QUICK_MEMO                                                                                     \
	"UPDATE memo SET xmlContent='%q', tizenXmlContent='%q', content = '%q',  accountName = '%q', sync2 = "             \
	"'%q',accountType = '%q',strippedContent = '%q', display_Content = '%q', categoryUUID = '%q', vrfileUUID='%q', "   \
	"_data = '%q', lastModifiedAt = %llu, isDirty = %d , isDeleted = %d,sync1 = %llu, isFavorite = %d, isSynced = "    \
	"0,bgColor = '%q' WHERE UUID = '%q'"

// Runs the file insert for one attachment.
static int __insertFile(MemoDbMgr *db, const char *sql, const MemoFileInfo &file)
{
	return db->excuteSql(sql, file.getFileUUID(), file.getAccountType(), file.getAccountName(), file.getSync2(),
	                     file.getMemoUUID(), file.getMimeType(), file.getDisplayName(), file.getData(),
	                     file.getIsDirty(), file.getIsDeleted(), file.getSync1(), file.getIsNeedUpsync(),
	                     file.getSize(), file.getOrientation(), file.getPath());
}

bool MemoDbMgr::addMemo(MemoDocInfo *info)
{
	if (!info) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	// Titles are stored as plain text.
	char *title = elm_entry_markup_to_utf8(info->getTitle());
	const char *uuid = info->getMemoUUID();
	int ret = excuteSql(MEMO_SQL_INSERT_MEMO, info->getAndroidXmlContent(), info->getTizenXmlContent(),
	                    info->getContent(), title ? title : "", info->getAccountName(), info->getSync2(),
	                    info->getAccountType(), info->getStrippedContent(), info->getDisplayContent(), uuid,
	                    info->getCategoryUUID(), info->getVrfileUUID(), info->getData(), info->getLastModifiedAt(),
	                    info->getIsDirty(), 0, info->getCreatedAt(), info->getSync1(), info->getIsFavorite(),
	                    info->getIsHidden(), 0, info->getBgColor());
	free(title);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	const MemoFileInfo *files = info->getFiles();
	for (int i = 0; i < info->getFileCount() && i < MEMO_MAX_FILE_COUNT; ++i) {
		ret = __insertFile(this, MEMO_SQL_INSERT_FILE, files[i]);
		if (ret != SQLITE_OK) {
			MEMO_LOGE("ERROR(%d).", ret);
			return false;
		}
	}
	memoDbNotifyChange();
	return true;
}

bool MemoDbMgr::updateMemo(MemoDocInfo *info)
{
	if (!info) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	int ret;
	// Saving always writes isDeleted 0: a save revives a tombstone.
	if (info->getIsQuick() == 0) {
		char *title = elm_entry_markup_to_utf8(info->getTitle());
		ret = excuteSql(MEMO_SQL_UPDATE_MEMO, info->getAndroidXmlContent(), info->getTizenXmlContent(),
		                info->getContent(), title ? title : "", info->getAccountName(), info->getSync2(),
		                info->getAccountType(), info->getStrippedContent(), info->getDisplayContent(),
		                info->getVrfileUUID(), info->getData(), info->getLastModifiedAt(), info->getIsDirty(), 0,
		                info->getSync1(), info->getIsFavorite(), info->getBgColor(), info->getMemoUUID());
		free(title);
	} else {
		ret = excuteSql(MEMO_SQL_UPDATE_QUICK_MEMO, info->getAndroidXmlContent(), info->getTizenXmlContent(),
		                info->getContent(), info->getAccountName(), info->getSync2(), info->getAccountType(),
		                info->getStrippedContent(), info->getDisplayContent(), info->getCategoryUUID(),
		                info->getVrfileUUID(), info->getData(), info->getLastModifiedAt(), info->getIsDirty(), 0,
		                info->getSync1(), info->getIsFavorite(), info->getBgColor(), info->getMemoUUID());
	}
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	checkUpdatedFiles(info);
	memoDbNotifyChange();
	return true;
}

bool MemoDbMgr::checkUpdatedFiles(MemoDocInfo *info)
{
	if (!info) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	const char *uuid = info->getMemoUUID();
	int recordCount = info->getFileCount() < MEMO_MAX_FILE_COUNT ? info->getFileCount() : MEMO_MAX_FILE_COUNT;
	const MemoFileInfo *files = info->getFiles();

	int storedCount = 0;
	{
		MemoSqlStmt stmt(__createSqliteStmt("SELECT count(*) FROM file WHERE memoUUID = '%q'", uuid));
		int ret = stmt ? stmt.step() : SQLITE_ERROR;
		if (ret != SQLITE_ROW) {
			MEMO_LOGE("ERROR(%d).", ret);
			return false;
		}
		storedCount = stmt.integer(0);
	}
	if (recordCount == 0 && storedCount == 0)
		return true;
	if (storedCount == 0) {
		for (int i = 0; i < recordCount; ++i)
			if (!addNewFile(&files[i]))
				return false;
		return true;
	}

	std::vector<std::string> stored;
	{
		MemoSqlStmt stmt(__createSqliteStmt("SELECT UUID FROM file WHERE memoUUID = '%q'", uuid));
		while (stmt && stmt.step() == SQLITE_ROW) {
			const char *fileUUID = stmt.text(0);
			stored.push_back(fileUUID ? fileUUID : "");
		}
	}
	std::vector<std::string> wanted;
	for (int i = 0; i < recordCount; ++i)
		wanted.push_back(files[i].getFileUUID());

	auto contains = [](const std::vector<std::string> &list, const std::string &value) {
		for (const std::string &item : list)
			if (item == value)
				return true;
		return false;
	};
	for (const std::string &fileUUID : stored)
		if (!contains(wanted, fileUUID) && !setDeleteFile(fileUUID.c_str()))
			return false;
	for (int i = 0; i < recordCount; ++i)
		if (!contains(stored, wanted[i]) && !addNewFile(&files[i]))
			return false;
	return true;
}

bool MemoDbMgr::setDeleteFile(const char *fileUUID)
{
	if (!fileUUID) {
		MEMO_LOGE("uuid is NULL");
		return false;
	}
	int ret = excuteSql("DELETE FROM file WHERE UUID = '%q'", fileUUID);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d)", ret);
		return false;
	}
	return true;
}

bool MemoDbMgr::addNewFile(const MemoFileInfo *file)
{
	if (!file) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	int ret = __insertFile(this, MEMO_SQL_INSERT_NEW_FILE, *file);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	return true;
}

bool MemoDbMgr::__setHiddenFlag(const char *sql, const char *const *uuids, int count)
{
	if (count < 1)
		return true;
	if (!uuids) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	for (int i = 0; i < count; ++i) {
		int ret = excuteSql(sql, uuids[i]);
		if (ret != SQLITE_OK) {
			MEMO_LOGE("ERROR(%d,%d).", ret, i);
			return false;
		}
	}
	return true;
}

bool MemoDbMgr::setHiddenMemos(const char *const *uuids, int count)
{
	return __setHiddenFlag("UPDATE memo SET isHidden = 1 WHERE UUID = '%q'", uuids, count);
}

bool MemoDbMgr::setUnhiddenMemos(const char *const *uuids, int count)
{
	return __setHiddenFlag("UPDATE memo SET isHidden = 0 WHERE UUID = '%q'", uuids, count);
}

bool MemoDbMgr::setFavorite(const char *uuid, int isFavorite)
{
	if (!uuid) {
		MEMO_LOGE("uuid is NULL");
		return false;
	}
	int ret =
	    excuteSql("UPDATE memo SET isFavorite = %d, isDirty = 1, isSynced = 0 WHERE UUID = '%q'", isFavorite, uuid);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	memoDbNotifyChange();
	return true;
}

bool MemoDbMgr::removeMemo(const char *uuid)
{
	if (!uuid) {
		MEMO_LOGE("uuid is NULL");
		return false;
	}
	// While the sync account is signed in, the other side must learn of the removal.
	if (MemoUtil::checkVeltronAccountLogIn())
		return __removeMemoSoftly(uuid);
	return __removeMemoOutright(uuid);
}

void MemoDbMgr::__removeMediaFolders(const char *uuid)
{
	char *dataPath = app_get_data_path();
	char path[1024];
	memset(path, 0, sizeof(path));
	snprintf(path, sizeof(path), "%smedia/%s/", dataPath ? dataPath : "", uuid);
	ecore_file_recursive_rm(path);
	free(dataPath);

	// The copy handed out to other applications lives under the shared data folder.
	std::string shared = path;
	size_t at = shared.find("data/media");
	if (at != std::string::npos) {
		shared.replace(at, strlen("data/media"), "shared/data/media");
		ecore_file_recursive_rm(shared.c_str());
	}
}

bool MemoDbMgr::__removeMemoOutright(const char *uuid)
{
	// The delete_file trigger takes the file rows along.
	int ret = excuteSql("DELETE FROM memo WHERE UUID = '%q'", uuid);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	__removeMediaFolders(uuid);
	ret = excuteSql("DELETE FROM file WHERE memoUUID = '%q'", uuid);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	memoDbNotifyChange();
	return true;
}

bool MemoDbMgr::__removeMemoSoftly(const char *uuid)
{
	char stamp[32];
	snprintf(stamp, sizeof(stamp), "%llu", memoDbTimeStamp());
	std::string sql = std::string("UPDATE memo SET isDeleted = 1,lastModifiedAt = ") + stamp + " WHERE UUID = '%q'";
	int ret = excuteSql(sql.c_str(), uuid);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d)", ret);
		return false;
	}
	ret = excuteSql("UPDATE file SET isDeleted = 1 WHERE memoUUID = '%q'", uuid);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d)", ret);
		return false;
	}
	memoDbNotifyChange();
	return true;
}

bool MemoDbMgr::removeMemos(const char *const *uuids, int count)
{
	for (int i = 0; uuids && i < count; ++i)
		removeMemo(uuids[i]);
	memoDbNotifyChange();
	return true;
}
