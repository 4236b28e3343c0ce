// The connection to memo.db: opening, first-run schema, the two statement helpers and the
// busy handler that waits out the sync service's locks.
#include "DataBase/MemoDbMgr.h"

#include <cstdarg>
#include <cstdlib>
#include <new>
#include <string>

#include <sqlite3.h>
#include <unistd.h>

#include <Ecore_File.h>
#include <app_common.h>

#include "MemoListRows.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

// A writer waits at most this many retries of this many milliseconds for the other side.
#define MEMO_DB_BUSY_RETRY_LIMIT 100
#define MEMO_DB_BUSY_SLEEP_MS 100
// Page cache (KiB) and memory map (bytes) of the connection.
#define MEMO_DB_CACHE_KIB "32768"
#define MEMO_DB_MMAP_BYTES "268435456"

// The schema as the sync service knows it, typos included: both sides must agree on it.
static const char *const gSchema[] = {
    "CREATE TABLE memo(_id\tINTEGER PRIMARY KEY AUTOINCREMENT,UUID TEXT NOT NULL UNIQUE,isDirty INTEGER NOT NULL "
    "DEFAULT 0,isDeleted\tINTEGER NOT NULL DEFAULT 0,\taccountType TEXT,\taccountName TEXT DEFAULT '', sync1 "
    "INTEGER,sync2 TEXT,isNeedUpsync\tINTEGER NOT NULL DEFAULT 0,\tcreatedAt INTEGER NOT NULL,\tlastModifiedAt "
    "INTEGER NOT NULL,\tcategoryUUID\tTEXT NOT NULL DEFAULT '',title TEXT NOT NULL DEFAULT '',content TEXT NOT NULL "
    "DEFAULT '',tizenXmlContent TEXT NOT NULL DEFAULT '',xmlContent TEXT DEFAULT '',display_Content TEXT NOT NULL "
    "DEFAULT '',vrfileUUID TEXT NOT NULL DEFAULT '',strippedContent TEXT NOT NULL DEFAULT '',_data TEXT NOT NULL "
    "DEFAULT '',_phoneNum TEXT,isFavorite INTERGER NOT NULL DEFAULT 0,isHidden INTERGER DEFAULT 0,isQuick INTERGER "
    "DEFAULT 0,isSynced INTERGER DEFAULT 0,bgColor TEXT NOT NULL DEFAULT '');",
    "CREATE TABLE category (_id INTEGER PRIMARY KEY AUTOINCREMENT,UUID TEXT NOT NULL UNIQUE,\tisDirty INTEGER NOT "
    "NULL DEFAULT 0,isDeleted INTEGERNOT NULL DEFAULT 0,accountType TEXT,accountName TEXT DEFAULT '',\tsync1 "
    "INTEGER,\tsync2 TEXT,\tisNeedUpsync INTEGER NOT NULL DEFAULT 0, orderBy INTEGER NOT NULL DEFAULT "
    "999999,_display_name TEXT NOT NULL);",
    "CREATE TABLE file (_id INTEGER PRIMARY KEY AUTOINCREMENT,UUID TEXT NOT NULL UNIQUE,isDirty INTEGER NOT NULL "
    "DEFAULT 0,isDeleted INTEGER NOT NULL DEFAULT 0,accountType TEXT,accountName TEXT DEFAULT '',sync1 INTEGER,sync2 "
    "TEXT,isNeedUpsync INTEGER NOT NULL DEFAULT 0,memoUUID TEXT NOT NULL DEFAULT '',mime_type TEXT NOT NULL DEFAULT "
    "'application/octet-stream',\t_display_name TEXT NOT NULL DEFAULT '',\t_size INTEGER NOT NULL DEFAULT "
    "0,\torientation INTEGER NOT NULL DEFAULT 0,\tpath TEXT NOT NULL, _data TEXT NOT NULL);",
    "CREATE TABLE android_metadata (locale TEXT);",
    "CREATE TABLE password (hiddenPass TEXT);",
    "CREATE TRIGGER delete_file DELETE ON memo BEGIN DELETE FROM file WHERE memoUUID = old.UUID; END;",
};

sqlite3 *MemoDbMgr::__handle = nullptr;
MemoDbMgr *MemoDbMgr::__instance = nullptr;
MemoDbBusyInfo MemoDbMgr::__busyInfo = {0, 0, 0};

MemoDbMgr::MemoDbMgr() {}

MemoDbMgr::~MemoDbMgr() {}

MemoDbMgr *MemoDbMgr::getInstance()
{
	if (!__instance) {
		__instance = new (std::nothrow) MemoDbMgr();
		if (!__instance)
			return nullptr;
		__busyInfo.pid = getpid();
		__busyInfo.retryLimit = MEMO_DB_BUSY_RETRY_LIMIT;
		__busyInfo.sleepMs = MEMO_DB_BUSY_SLEEP_MS;
		if (!__instance->construct()) {
			MEMO_LOGE("Failed to Create Table");
			delete __instance;
			__instance = nullptr;
			return nullptr;
		}
	}
	return __instance;
}

void MemoDbMgr::destroy()
{
	// Kept rows belong to this connection's view of the file.
	MemoListRows::forget();
	if (__handle) {
		sqlite3_close_v2(__handle);
		__handle = nullptr;
	}
	delete __instance;
	__instance = nullptr;
}

bool MemoDbMgr::construct()
{
	char *dataPath = app_get_data_path();
	if (!dataPath)
		MEMO_LOGE("Failed to get resource path=NULL!!!");
	std::string path = std::string(dataPath ? dataPath : "") + "memo.db";
	free(dataPath);

	// Only the file's presence counts: an existing file is taken as complete.
	bool exists = ecore_file_exists(path.c_str());
	int ret = sqlite3_open_v2(path.c_str(), &__handle, SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, nullptr);
	if (ret == SQLITE_OK)
		ret = sqlite3_busy_handler(__handle, __busyHandlerCb, &__busyInfo);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("DB busy (%d).", ret);
		// Later statements then fail to prepare and say so; the process goes on.
		sqlite3_close(__handle);
		__handle = nullptr;
		return true;
	}
	__tuneConnection();
	if (!exists)
		__createSchema();
	return true;
}

void MemoDbMgr::__tuneConnection()
{
	// The list reads sort every visible memo with all its body columns (several KB each): keep
	// that sort and the pages it reads in memory instead of spilling to temporary files.
	// Connection settings only; the file and its schema are untouched.
	sqlite3_exec(__handle, "PRAGMA temp_store = MEMORY", nullptr, nullptr, nullptr);
	sqlite3_exec(__handle, "PRAGMA cache_size = -" MEMO_DB_CACHE_KIB, nullptr, nullptr, nullptr);
	sqlite3_exec(__handle, "PRAGMA mmap_size = " MEMO_DB_MMAP_BYTES, nullptr, nullptr, nullptr);
}

void MemoDbMgr::__createSchema()
{
	for (const char *statement : gSchema)
		excuteSql(statement);
	if (excuteSql("INSERT INTO android_metadata(locale) VALUES('TempDataForQ7')") != SQLITE_OK)
		MEMO_LOGE("android_metadata can`t be created");
	if (excuteSql("INSERT INTO password(hiddenPass) VALUES('')") != SQLITE_OK)
		MEMO_LOGE("password can`t be created");
	// Being the first row of memo, the quick memo gets _id 1.
	if (MemoUtil::isQuickMemoFeatureEnabled() && !__createQuickMemo())
		MEMO_LOGE("createQuickMemo  can`t be created");
}

int MemoDbMgr::__busyHandlerCb(void *data, int count)
{
	MemoDbBusyInfo *info = static_cast<MemoDbBusyInfo *>(data);
	if (!info || count >= info->retryLimit)
		return 0;
	sqlite3_sleep(info->sleepMs);
	return 1;
}

int MemoDbMgr::excuteSql(char *sql)
{
	sqlite3_stmt *stmt = nullptr;
	// Prepared only to validate the text before running it.
	int ret = (__handle && sql) ? sqlite3_prepare_v2(__handle, sql, -1, &stmt, nullptr) : SQLITE_MISUSE;
	if (ret != SQLITE_OK) {
		MEMO_LOGE("[excute_sql]ERROR(%d).", ret);
		sqlite3_finalize(stmt);
		return -1;
	}
	char *message = nullptr;
	ret = sqlite3_exec(__handle, sql, nullptr, nullptr, &message);
	if (message) {
		MEMO_LOGE("%s\n", message);
		sqlite3_free(message);
	}
	sqlite3_finalize(stmt);
	return ret;
}

int MemoDbMgr::excuteSql(const char *format, ...)
{
	if (!format)
		return excuteSql(static_cast<char *>(nullptr));
	va_list args;
	va_start(args, format);
	char *sql = sqlite3_vmprintf(format, args);
	va_end(args);
	int ret = excuteSql(sql);
	sqlite3_free(sql);
	return ret;
}

sqlite3_stmt *MemoDbMgr::__createSqliteStmt(const char *format, ...)
{
	char *sql = nullptr;
	if (format) {
		va_list args;
		va_start(args, format);
		sql = sqlite3_vmprintf(format, args);
		va_end(args);
	}
	sqlite3_stmt *stmt = nullptr;
	int ret = (__handle && sql) ? sqlite3_prepare_v2(__handle, sql, -1, &stmt, nullptr) : SQLITE_MISUSE;
	sqlite3_free(sql);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("[createSqliteStmt]ERROR(%d).", ret);
		sqlite3_finalize(stmt);
		return nullptr;
	}
	return stmt;
}
