// The memo store with 10,000 realistic memos: the list read of the main screen, search for a
// common and a rare word, one-memo read, and the three writes. Raw SQLite scans over the same
// statements are measured beside them, so that the table shows how much of a read is the
// database and how much is building records.
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"
#include "MemoCvt.h"

#include "BenchEnv.h"

#include <Elementary.h>
#include <app_common.h>
#include <benchmark/benchmark.h>
#include <sqlite3.h>

#include <cstdio>
#include <cstdlib>
#include <random>
#include <string>
#include <vector>

namespace
{
const int MEMO_COUNT = 10000;
const char *RARE_WORD = "xylophone"; // in about one memo of a thousand
const char *COMMON_WORD = "meeting"; // in about one memo of four

std::string gRoot;
std::vector<std::string> gUuids;
std::mt19937 gRandom(20240611);

const char *const WORDS[] = {"the",     "and",    "call",  "buy",    "milk",    "bread",   "project", "plan",
                             "review",  "notes",  "idea",  "garden", "travel",  "train",   "ticket",  "birthday",
                             "gift",    "recipe", "flour", "sugar",  "budget",  "invoice", "doctor",  "appointment",
                             "book",    "film",   "music", "run",    "weekend", "family",  "school",  "homework",
                             "report",  "draft",  "email", "reply",  "phone",   "repair",  "car",     "insurance",
                             "holiday", "beach",  "hotel", "flight", "paint",   "kitchen"};

std::string words(int count)
{
	std::string text;
	for (int i = 0; i < count; ++i) {
		if (i)
			text += ' ';
		text += WORDS[gRandom() % (sizeof(WORDS) / sizeof(WORDS[0]))];
	}
	return text;
}

// A todolist document of 1 to 40 lines; about a third are checklists.
std::string document(int index)
{
	int lines = 1 + static_cast<int>(gRandom() % 40);
	bool checklist = gRandom() % 3 == 0;
	std::string doc = "<todolist>\n";
	std::string text;
	for (int i = 0; i < lines; ++i) {
		std::string line = words(3 + static_cast<int>(gRandom() % 8));
		if (i == 0 && index % 4 == 0)
			line += std::string(" ") + COMMON_WORD;
		if (i == lines - 1 && index % 1000 == 7)
			line += std::string(" ") + RARE_WORD;
		if (checklist) {
			doc += std::string("<todolist_item todo_item_type=\"1\" todo_item_state=\"") +
			       (gRandom() % 2 ? "true" : "false") + "\" todo_item_content=\"" + line + "\"/>\n";
		} else {
			text += (i ? "&lt;br/&gt;" : "") + line;
		}
	}
	if (!checklist)
		doc += "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"" + text + "\"/>\n";
	return doc + "</todolist>\n";
}

// A record as the edit view saves it: every body column derived by the converter.
MemoDocInfo *makeMemo(int index, unsigned long long at)
{
	MemoDocInfo *info = new MemoDocInfo();
	std::string title = words(1 + static_cast<int>(gRandom() % 5));
	info->setTitle(title.c_str());
	std::string doc = document(index);
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, doc);
	info->setDisplayContent(cvt.getDisplayContent().c_str());
	info->setStrippedContent(cvt.getStrippedContent().c_str());
	info->setContent(cvt.getContent().c_str());
	info->setAndroidXmlContent(cvt.getXmlContent().c_str());
	info->setTizenXmlContent(doc.c_str());
	info->setCreatedAt(at);
	info->setLastModifiedAt(at);
	info->setIsFavorite(gRandom() % 10 == 0);
	info->setIsHidden(gRandom() % 20 == 0);
	if (gRandom() % 5 == 0)
		info->setBgColorRgba(252, 191, 169, 255);
	return info;
}

void fillStore()
{
	MemoDbMgr *db = MemoDbMgr::getInstance();
	// One transaction for the fill only; the measured writes each run on their own as in the app.
	db->excuteSql("BEGIN");
	for (int i = 0; i < MEMO_COUNT; ++i) {
		MemoDocInfo *info = makeMemo(i, 1600000000000ULL + i * 1000ULL);
		gUuids.push_back(info->getMemoUUID());
		db->addMemo(info);
		delete info;
	}
	db->excuteSql("COMMIT");
}

void freeStrings(char **items, int count)
{
	for (int i = 0; i < count; ++i)
		free(items[i]);
	free(items);
}

void BM_getVisibleMemoListN(benchmark::State &state)
{
	int rows = 0;
	for (auto _ : state) {
		MemoItemList *list = MemoDbMgr::getInstance()->getVisibleMemoListN();
		rows = list->getCount();
		delete list;
	}
	state.counters["rows"] = rows;
}

// A second connection tuned like the store's, for the raw reference scans.
sqlite3 *openRaw()
{
	char *data = app_get_data_path();
	std::string path = std::string(data) + "memo.db";
	free(data);
	sqlite3 *db = nullptr;
	sqlite3_open_v2(path.c_str(), &db, SQLITE_OPEN_READONLY, nullptr);
	sqlite3_exec(db, "PRAGMA temp_store = MEMORY; PRAGMA cache_size = -32768; PRAGMA mmap_size = 268435456", nullptr,
	             nullptr, nullptr);
	return db;
}

// Steps through a statement touching every column: the database's share of a read.
void rawScan(benchmark::State &state, const char *sql)
{
	sqlite3 *db = openRaw();
	int rows = 0;
	for (auto _ : state) {
		sqlite3_stmt *stmt = nullptr;
		sqlite3_prepare_v2(db, sql, -1, &stmt, nullptr);
		rows = 0;
		size_t bytes = 0;
		int columns = sqlite3_column_count(stmt);
		while (sqlite3_step(stmt) == SQLITE_ROW) {
			for (int c = 0; c < columns; ++c)
				bytes += sqlite3_column_bytes(stmt, c);
			++rows;
		}
		benchmark::DoNotOptimize(bytes);
		sqlite3_finalize(stmt);
	}
	sqlite3_close(db);
	state.counters["rows"] = rows;
}

void BM_raw_visibleListStatement(benchmark::State &state)
{
	rawScan(state, "SELECT "
	               "UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,isNeedUpsync,createdAt,"
	               "lastModifiedAt,categoryUUID,title,content,xmlContent, tizenXmlContent,display_Content,"
	               "vrfileUUID,strippedContent,_data,_phoneNum,isFavorite, isQuick, bgColor FROM memo WHERE "
	               "isDeleted = 0 AND isHidden = 0 ORDER BY isQuick DESC, isFavorite DESC, lastModifiedAt DESC");
}

// One of the two scans a search makes (the count); the other scans the same rows again.
void BM_raw_searchCountStatement(benchmark::State &state)
{
	rawScan(state, "SELECT count(UUID) FROM memo WHERE ((title like '%meeting%' escape '/') AND isQuick != 1) OR "
	               "(strippedContent like '%meeting%' escape '/') ORDER BY isFavorite DESC");
}

void search(benchmark::State &state, const char *word)
{
	int count = 0;
	for (auto _ : state) {
		char **uuids = nullptr;
		count = 0;
		MemoDbMgr::getInstance()->getSearchReultN(word, &uuids, &count);
		freeStrings(uuids, count);
	}
	state.counters["hits"] = count;
}

void BM_getSearchReultN_common(benchmark::State &state)
{
	search(state, COMMON_WORD);
}
void BM_getSearchReultN_rare(benchmark::State &state)
{
	search(state, RARE_WORD);
}

void BM_getOneMemoN(benchmark::State &state)
{
	size_t i = 0;
	for (auto _ : state) {
		MemoDocInfo *info = MemoDbMgr::getInstance()->getOneMemoN(gUuids[(i++ * 7919) % gUuids.size()].c_str());
		delete info;
	}
}

void BM_addMemo(benchmark::State &state)
{
	int index = MEMO_COUNT;
	for (auto _ : state) {
		state.PauseTiming();
		MemoDocInfo *info = makeMemo(index++, 1700000000000ULL);
		state.ResumeTiming();
		MemoDbMgr::getInstance()->addMemo(info);
		state.PauseTiming();
		gUuids.push_back(info->getMemoUUID());
		delete info;
		state.ResumeTiming();
	}
}

void BM_updateMemo(benchmark::State &state)
{
	size_t i = 0;
	for (auto _ : state) {
		state.PauseTiming();
		MemoDocInfo *info = MemoDbMgr::getInstance()->getOneMemoN(gUuids[(i++ * 104729) % gUuids.size()].c_str());
		info->setStrippedContent("edited text");
		info->setLastModifiedAt(1800000000000ULL);
		state.ResumeTiming();
		MemoDbMgr::getInstance()->updateMemo(info);
		state.PauseTiming();
		delete info;
		state.ResumeTiming();
	}
}

void BM_removeMemo(benchmark::State &state)
{
	for (auto _ : state) {
		state.PauseTiming();
		std::string uuid = gUuids.back();
		gUuids.pop_back();
		state.ResumeTiming();
		MemoDbMgr::getInstance()->removeMemo(uuid.c_str());
	}
}
} // namespace

BENCHMARK(BM_getVisibleMemoListN)->Unit(benchmark::kMillisecond)->MinTime(2.0);
BENCHMARK(BM_raw_visibleListStatement)->Unit(benchmark::kMillisecond)->MinTime(2.0);
BENCHMARK(BM_getSearchReultN_common)->Unit(benchmark::kMillisecond)->MinTime(2.0);
BENCHMARK(BM_getSearchReultN_rare)->Unit(benchmark::kMillisecond)->MinTime(2.0);
BENCHMARK(BM_raw_searchCountStatement)->Unit(benchmark::kMillisecond)->MinTime(2.0);
BENCHMARK(BM_getOneMemoN)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_addMemo)->Unit(benchmark::kMillisecond)->Iterations(50);
BENCHMARK(BM_updateMemo)->Unit(benchmark::kMillisecond)->Iterations(50);
BENCHMARK(BM_removeMemo)->Unit(benchmark::kMillisecond)->Iterations(50);

int main(int argc, char **argv)
{
	// A private store: the user's memos are never touched.
	gRoot = memo_bench::setUpPrivateRoot("store");
	if (gRoot.empty())
		return 1;
	elm_init(argc, argv);

	benchmark::Initialize(&argc, argv);
	fprintf(stderr, "filling %d memos...\n", MEMO_COUNT);
	fillStore();
	benchmark::RunSpecifiedBenchmarks();
	benchmark::Shutdown();

	MemoDbMgr::destroy();
	if (getenv("MEMO_BENCH_KEEP")) {
		fprintf(stderr, "store kept in %s\n", gRoot.c_str());
		return 0;
	}
	std::string rm = "rm -rf '" + gRoot + "'";
	int rc = system(rm.c_str());
	(void)rc;
	return 0;
}
