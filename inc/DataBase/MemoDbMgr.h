#ifndef INC_DATABASE_MEMODBMGR_H
#define INC_DATABASE_MEMODBMGR_H

#include <utility>

// SQLite stays out of this header: callers see only the opaque types.
struct sqlite3;
struct sqlite3_stmt;

class MemoDocInfo;
class MemoFileInfo;
class MemoItemList;

// Retry policy of the busy handler: the owner process, how many retries, how long each sleep.
struct MemoDbBusyInfo {
	int pid;
	int retryLimit;
	int sleepMs;
};

// The process's one door to "memo.db" in the app's data folder, which the sync service
// shares. Main loop only. Every statement is formatted with sqlite3_vmprintf and %q;
// nothing binds parameters, nothing opens a transaction, and a lock held by the other
// side is waited for up to 100 retries of 100 ms.
//
// Failures come back as a false/null/-1 result with an error line; multi-statement
// operations do not roll back. Arrays of strings returned through "N" operations are
// malloc'ed arrays of malloc'ed strings: the caller frees each string and the array.
// Every write that announces a change sets the vconf key "db/memo/data-change" to 1
// after its statements.
class MemoDbMgr
{
public:
	// Returns the instance, opening (and on first run creating) the database the first time.
	static MemoDbMgr *getInstance();
	// Closes the database and deletes the instance; a later getInstance opens it anew.
	static void destroy();

	// Runs one finished statement; returns the SQLite result code, -1 if it does not prepare.
	int excuteSql(char *sql);
	// Formats with sqlite3_vmprintf (%q quotes text) and runs the result as above.
	int excuteSql(const char *format, ...);

	// ---- Reads ----

	// Number of live memos (hidden and quick included), -1 on failure.
	int getMemoCount();
	// Number of live hidden normal memos, -1 on failure.
	int getHiddenMemoCount();
	// New record of the memo; an unknown UUID gives a record with its defaults (empty UUID),
	// a null uuid gives null. isHidden and the files are not read. Caller deletes.
	MemoDocInfo *getOneMemoN(const char *uuid);
	// New lists of live memos in display order; the caller deletes the list (and so its records).
	MemoItemList *getVisibleNormalMemoListN(); // not hidden, not quick
	MemoItemList *getVisibleMemoListN();       // not hidden; the quick memo first
	MemoItemList *getAllNormalMemoListN();     // hidden too, not quick; colours not read
	MemoItemList *getAllMemoListN();           // everything live; colours not read
	// True if the memo's isHidden is non-zero.
	bool isMemoHidden(const char *uuid);
	// Copies the memo's thumbnail path into *path (caller frees) when it is longer than 1 byte.
	bool getMemoThumbnailImageN(const char *uuid, char **path);
	// Copies the file row's path into *path (caller frees) when it is longer than 1 byte.
	bool getFilePathN(const char *fileUUID, char **path);
	// All file paths of the memo in insertion order; true with count 0 when it has none.
	bool getFilePathsN(const char *uuid, char ***paths, int *count);
	// The image file paths of the memo in insertion order; as getFilePathsN.
	bool getImageFilePathsN(const char *uuid, char ***paths, int *count);
	// UUIDs of the memos whose title or body holds text ("%", "_" and "/" act as LIKE
	// wildcards/escape). Deleted and hidden rows are included: the caller filters.
	bool getSearchReultN(const char *text, char ***uuids, int *count);
	// Where the stored rows stand: equal stamps mean that no connection has written in between.
	std::pair<long long, long long> getChangeStamp();

	// ---- Writes ----

	// Inserts the memo (giving it a UUID if it has none) and its files.
	bool addMemo(MemoDocInfo *info);
	// Rewrites the memo's row (reviving a tombstone) and reconciles its files.
	bool updateMemo(MemoDocInfo *info);
	// Makes the file rows of the memo match the record's files: deletes rows whose UUID the
	// record lacks, inserts record files the table lacks; known rows are never rewritten.
	bool checkUpdatedFiles(MemoDocInfo *info);
	// Deletes one file row.
	bool setDeleteFile(const char *fileUUID);
	// Inserts one file row.
	bool addNewFile(const MemoFileInfo *file);
	// Set or clear isHidden of each memo; stop at the first failure. No change notice.
	bool setHiddenMemos(const char *const *uuids, int count);
	bool setUnhiddenMemos(const char *const *uuids, int count);
	// Sets the favourite flag (marks the memo dirty; lastModifiedAt stays).
	bool setFavorite(const char *uuid, int isFavorite);
	// Removes the memo with its files and media folders, or, while the sync account is
	// signed in, marks it and its files deleted.
	bool removeMemo(const char *uuid);
	// removeMemo for each; always true.
	bool removeMemos(const char *const *uuids, int count);

	// ---- Quick memo and PIN ----

	// Appends text as a last plain text item (type 0, not a check item) of the quick memo, control
	// characters left out; false when there is not exactly one quick memo, or when the document could
	// not be written (logged; the stored memo stays as it was). No change notice.
	bool addQuickMemo(const char *text);
	// Empties the body of the row with _id 1 (the quick memo when the feature was on at first run).
	bool initQuickMemo();
	// Copies a non-empty PIN into buffer (sized by the caller); false when none is set.
	bool getHiddenMemoPassword(char *buffer);
	// Stores the PIN text.
	bool setHiddenMemoPassword(const char *text);

private:
	MemoDbMgr();
	~MemoDbMgr();
	MemoDbMgr(const MemoDbMgr &) = delete;
	MemoDbMgr &operator=(const MemoDbMgr &) = delete;

	bool construct();
	void __tuneConnection();
	void __createSchema();
	bool __createQuickMemo();
	// Prepared statement of the formatted text, or null (logged); the caller finalises it.
	sqlite3_stmt *__createSqliteStmt(const char *format, ...);
	static int __busyHandlerCb(void *data, int count);

	int __getCount(const char *sql);
	MemoItemList *__getMemoListN(const char *sql, bool withColor);
	bool __getOnePathN(const char *sql, const char *uuid, char **path, bool clearOnShort);
	bool __getPathsN(const char *countSql, const char *listSql, const char *uuid, char ***paths, int *count);
	bool __setHiddenFlag(const char *sql, const char *const *uuids, int count);
	bool __removeMemoOutright(const char *uuid);
	bool __removeMemoSoftly(const char *uuid);
	void __removeMediaFolders(const char *uuid);

	static sqlite3 *__handle;
	static MemoDbMgr *__instance;
	static MemoDbBusyInfo __busyInfo;
};

#endif
