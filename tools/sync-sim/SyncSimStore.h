#ifndef TOOLS_SYNC_SIM_SYNCSIMSTORE_H
#define TOOLS_SYNC_SIM_SYNCSIMSTORE_H

#include <string>
#include <vector>

struct sqlite3;

// The sync service's writes to memo.db: memos that arrive from the cloud or change there, rows marked
// as uploaded, tombstones. The caller chooses the transactions, so that a sync run can hold the write
// lock across several writes.
class SyncSimStore
{
public:
	~SyncSimStore();
	// Opens an existing memo.db; waits up to ten seconds for a lock, as the app does.
	bool open(const std::string &path);
	// BEGIN IMMEDIATE: the write lock, taken now; false when the app held it past the wait.
	bool begin();
	bool commit();
	void rollback();

	// A new memo with the text as its one item, as a download leaves it (clean, synced); its UUID, or
	// empty when the insert failed.
	std::string addMemo(const std::string &text);
	// The memo's body becomes the text, as a change made elsewhere.
	bool changeMemo(const std::string &uuid, const std::string &text);
	// The soft delete of a memo deleted elsewhere.
	bool tombstone(const std::string &uuid);
	// Every changed row counts as uploaded; the number of memo rows marked, -1 on failure.
	int markSynced();
	// The newest live memos other than the quick memo, at most n.
	std::vector<std::string> newestMemos(int n);

	static const char *const ACCOUNT_NAME;

private:
	bool __exec(char *sql);
	sqlite3 *__db = nullptr;
};

#endif
