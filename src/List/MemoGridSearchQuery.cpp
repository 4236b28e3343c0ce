// The store's search of a search grid: on a worker thread, so that a key's frame does not wait for two scans
// of the memo table, with the texts typed meanwhile folded into the latest; and skipped where its result is
// known already.
#include "List/MemoGridControl.h"

#include <cstdlib>
#include <cstring>

#include "DataBase/MemoDbMgr.h"
#include "List/MemoItemList.h"
#include "MemoLog.h"

// What one search on a worker owns. The worker reads keyword and writes the result; the grid reads the result
// on the main loop once the worker has ended, or never when it has let go (owner null).
struct MemoGridSearchJob {
	MemoGridControl *owner;
	std::string keyword;
	std::pair<long long, long long> stamp;
	Ecore_Thread *thread = nullptr;
	char **uuids = nullptr;
	int count = 0;
	bool ok = false;
};

namespace
{
const double TEARDOWN_WAIT_SEC = 5.0;

void freeResult(MemoGridSearchJob *job)
{
	for (int i = 0; i < job->count && job->uuids; ++i)
		free(job->uuids[i]);
	free(job->uuids);
	job->uuids = nullptr;
	job->count = 0;
}
} // namespace

void MemoGridControl::searchGridLater(const char *keyword)
{
	if (!getEvasObj() || !keyword) {
		MEMO_LOGE("gengrid obj is NULL");
		return;
	}
	if (__searchJob) {
		__queuedKeyword = keyword;
		__hasQueuedKeyword = true;
		return;
	}
	if (__searchCannotMatch(keyword)) {
		int count = 0;
		searchGrid(keyword, &count);
		if (__searchDone)
			__searchDone(keyword, count);
		return;
	}
	__startSearchJob(keyword);
}

void MemoGridControl::__startSearchJob(const char *keyword)
{
	MemoGridSearchJob *job = new MemoGridSearchJob{nullptr, keyword, MemoDbMgr::getInstance()->getChangeStamp()};
	// The end comes on the main loop, after this; a failed start runs the cancel callback at once, which frees
	// the job (no owner yet) and leaves the search to this loop.
	Ecore_Thread *thread = ecore_thread_run(__searchJobCb, __searchJobEndCb, __searchJobEndCb, job);
	if (thread) {
		job->owner = this;
		job->thread = thread;
		__searchJob = job;
		return;
	}
	MEMO_LOGE("ecore_thread_run() is failed");
	int count = 0;
	const std::string text = keyword;
	searchGrid(text.c_str(), &count);
	if (__searchDone)
		__searchDone(text.c_str(), count);
}

void MemoGridControl::__searchJobCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	MemoGridSearchJob *job = static_cast<MemoGridSearchJob *>(data);
	job->ok = MemoDbMgr::getInstance()->getSearchReultN(job->keyword.c_str(), &job->uuids, &job->count);
}

// The end and the cancel of the worker, on the main loop.
void MemoGridControl::__searchJobEndCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	MemoGridSearchJob *job = static_cast<MemoGridSearchJob *>(data);
	if (job->owner)
		job->owner->__onSearchJobEnd(job);
	freeResult(job);
	delete job;
}

void MemoGridControl::__onSearchJobEnd(MemoGridSearchJob *job)
{
	__searchJob = nullptr;
	job->owner = nullptr;
	__keepSearch(job->keyword.c_str(), job->count, job->ok, job->stamp);
	// A newer text is waiting: this result would be replaced at once.
	if (__hasQueuedKeyword) {
		__hasQueuedKeyword = false;
		const std::string next = std::move(__queuedKeyword);
		searchGridLater(next.c_str());
		return;
	}
	Evas_Object *gengrid = getEvasObj();
	if (!gengrid)
		return;
	__setGridSize(gengrid);
	const int count = job->count;
	const int rows = __itemList ? __itemList->getCount() : 0;
	std::vector<int> shown = __rowsOfResult(job->uuids, job->count, rows);
	job->uuids = nullptr;
	job->count = 0;
	if (rows >= 1)
		__showRows(std::move(shown), job->keyword.c_str(), rows);
	if (__searchDone)
		__searchDone(job->keyword.c_str(), count);
}

void MemoGridControl::__dropSearchJob(bool wait)
{
	__hasQueuedKeyword = false;
	__queuedKeyword.clear();
	MemoGridSearchJob *job = __searchJob;
	if (!job)
		return;
	__searchJob = nullptr;
	job->owner = nullptr;
	Ecore_Thread *thread = job->thread;
	// A running search cannot be stopped; on teardown it is waited for, so that no statement outlives the
	// grid's owner (the store may be closed next).
	if (thread && !ecore_thread_cancel(thread) && wait)
		ecore_thread_wait(thread, TEARDOWN_WAIT_SEC);
}

// A text that holds the text of the last search, which matched nothing, matches nothing either while the
// store is unchanged: the pattern is '%text%' with "/" as the escape, so when the earlier text holds none of
// "%", "_" and "/" it stands for itself inside the new one, and whatever holds the new text holds the earlier
// one (case folding included). The quick memo's words cannot match the longer text when they did not match its
// part.
bool MemoGridControl::__searchCannotMatch(const char *keyword)
{
	if (!keyword || !__lastSearch.valid || __lastSearch.count != 0)
		return false;
	const std::string &before = __lastSearch.text;
	if (before.find_first_of("%_/") != std::string::npos || !strstr(keyword, before.c_str()))
		return false;
	return MemoDbMgr::getInstance()->getChangeStamp() == __lastSearch.stamp;
}

void MemoGridControl::__keepSearch(const char *keyword, int count, bool ok, std::pair<long long, long long> stamp)
{
	__lastSearch.valid = ok && keyword;
	__lastSearch.text = keyword ? keyword : "";
	__lastSearch.count = count;
	__lastSearch.stamp = stamp;
}
