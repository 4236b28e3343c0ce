// The list read of the main screen over 10,000 memos whose sync columns are NULL, as the sync service leaves
// them: getVisibleMemoListN with the two log lines each row gives, beside the bare statement and the
// building of the records without the store.
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"

#include "BenchEnv.h"

#include <Elementary.h>
#include <app_common.h>
#include <benchmark/benchmark.h>
#include <sqlite3.h>

#include <cstdio>
#include <cstdlib>
#include <string>

namespace
{
const int MEMO_COUNT = 10000;
const char *const VISIBLE_LIST =
    "SELECT UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,isNeedUpsync,createdAt,lastModifiedAt,"
    "categoryUUID,title,content,xmlContent, tizenXmlContent,display_Content,vrfileUUID,strippedContent,_data,"
    "_phoneNum,isFavorite, isQuick, bgColor FROM memo WHERE isDeleted = 0 AND isHidden = 0 ORDER BY isQuick DESC, "
    "isFavorite DESC, lastModifiedAt DESC";

std::string gRoot;

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

// The statement alone, every column read, on a connection of its own.
void BM_bareStatement(benchmark::State &state)
{
	char *data = app_get_data_path();
	sqlite3 *db = nullptr;
	sqlite3_open_v2((std::string(data) + "memo.db").c_str(), &db, SQLITE_OPEN_READONLY, nullptr);
	free(data);
	int rows = 0;
	for (auto _ : state) {
		sqlite3_stmt *stmt = nullptr;
		sqlite3_prepare_v2(db, VISIBLE_LIST, -1, &stmt, nullptr);
		size_t bytes = 0;
		rows = 0;
		while (sqlite3_step(stmt) == SQLITE_ROW) {
			for (int c = 0; c < sqlite3_column_count(stmt); ++c)
				bytes += sqlite3_column_bytes(stmt, c) + (sqlite3_column_text(stmt, c) ? 1 : 0);
			++rows;
		}
		benchmark::DoNotOptimize(bytes);
		sqlite3_finalize(stmt);
	}
	sqlite3_close(db);
	state.counters["rows"] = rows;
}

// Records as the read builds them, without the store and without the two NULL setters' lines.
void BM_recordsOnly(benchmark::State &state)
{
	for (auto _ : state) {
		MemoItemList *list = new MemoItemList();
		for (int i = 0; i < MEMO_COUNT; ++i) {
			MemoDocInfo *info = new MemoDocInfo();
			info->setMemoUUID("0b9c6c4e-4a55-4f5a-9d8e-3c1f0f7a2b11");
			char *title = elm_entry_utf8_to_markup("book review notes");
			info->setTitle(title);
			free(title);
			info->setDisplayContent("<CHECK state=false>milk bread</CHECK><CHECK state=true>plan</CHECK>");
			info->setTizenXmlContent("<todolist>\n<todolist_item todo_item_type=\"1\"/></todolist>\n");
			info->setBgColor("228;235;235;255;");
			list->appendItem(info);
		}
		delete list;
	}
}
} // namespace

BENCHMARK(BM_getVisibleMemoListN)->Unit(benchmark::kMillisecond)->MinTime(2.0);
BENCHMARK(BM_bareStatement)->Unit(benchmark::kMillisecond)->MinTime(2.0);
BENCHMARK(BM_recordsOnly)->Unit(benchmark::kMillisecond)->MinTime(2.0);

int main(int argc, char **argv)
{
	gRoot = memo_bench::setUpPrivateRoot("list-read");
	if (gRoot.empty())
		return 1;
	// Every log line is written, as in the app.
	unsetenv("DLOG_LEVEL");
	if (system((memo_bench::helperPath("memo_seed") + " fill " + std::to_string(MEMO_COUNT) + " >/dev/null 2>&1")
	               .c_str()) != 0) {
		fprintf(stderr, "memo_seed failed\n");
		return 1;
	}
	elm_init(argc, argv);
	benchmark::Initialize(&argc, argv);
	benchmark::RunSpecifiedBenchmarks();
	MemoDbMgr::destroy();
	system(("rm -rf '" + gRoot + "'").c_str());
	return 0;
}
