// The sync service beside the editor, played by memo-sync-sim as a real second process: a save waits out a
// short sync and lands; a sync that holds the lock past the busy handler fails it, the editor keeps the
// text and saves once the lock is gone; a service writing all along and a person editing lose nothing.
// MEMO_LONG=1 makes the service write for a full minute.
#include <app_i18n.h>

#include <csignal>
#include <map>
#include <sstream>

#include "TestEnv.h"
#include "support/EditViewFixture.h"

using namespace memo_ui_test;

namespace
{
// The simulator running with the given options; its output is read back line by line.
struct SyncSim {
	explicit SyncSim(const std::string &options)
	{
		const std::string dir = memo_test::makeTempDir("sync-sim");
		out = dir + "/out";
		std::string pidText;
		memo_test::runCommand(std::string("'") + TEST_BIN_DIR + "/memo-sync-sim' --db '" + MemoUtil::getDataPath() +
		                          "memo.db' --ready '" + dir + "/ready' " + options + " >'" + out + "' 2>&1 & echo $!",
		                      &pidText);
		pid = atoi(pidText.c_str());
		ready = memo_test::pump(10, [&] { return ecore_file_exists((dir + "/ready").c_str()) == EINA_TRUE; });
	}
	~SyncSim() { kill(pid, SIGKILL); }
	std::string output() const { return memo_test::readFile(out); }
	bool finish() const
	{
		return memo_test::pump(30, [&] { return output().find("sync-sim: done") != std::string::npos; });
	}
	// The last text the service wrote into each memo it added or changed.
	std::map<std::string, std::string> written() const
	{
		std::map<std::string, std::string> texts;
		std::istringstream in(output());
		for (std::string word, uuid, text; in >> word;) {
			if (word != "added" && word != "changed")
				continue;
			in >> uuid;
			std::getline(in >> std::ws, text);
			texts[uuid] = text;
		}
		return texts;
	}

	std::string out;
	pid_t pid = -1;
	bool ready = false;
};

using SyncService = EditViewFixture;
} // namespace

TEST_F(SyncService, ASaveWaitsOutAShortSyncAndFailsPastTheBusyHandler)
{
	MemoEditView *view = openNew();
	typeInto(items(view)[1], "after the backup");
	SyncSim backup("--backup --lock 2 --add 1");
	ASSERT_TRUE(backup.ready);
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }, 10.0)) << "the save did not wait for the lock";
	EXPECT_EQ("1", query("SELECT count(*) FROM memo WHERE content = 'after the backup'"));
	ASSERT_TRUE(backup.finish());
	EXPECT_NE(std::string::npos, backup.output().find("state backup\nsync-sim: lock held for 2.0 s\nsync-sim: added "));
	ASSERT_EQ(1u, backup.written().size());
	EXPECT_EQ(backup.written().begin()->second,
	          query("SELECT content FROM memo WHERE UUID = '" + backup.written().begin()->first + "'"));
	int state = -1;
	preference_get_int("MEMO_SVC_PROCESSING", &state);
	EXPECT_EQ(0, state);

	// Ten seconds of retries are all the busy handler waits: the save fails and the text stays.
	lastPagePopped = false;
	view = openNew();
	typeInto(items(view)[1], "locked out");
	SyncSim restore("--restore --lock 15");
	ASSERT_TRUE(restore.ready);
	desktop_toast_log_clear();
	pressDone(view);
	EXPECT_TRUE(waitFor([] { return desktop_toast_log_count() > 0; }, 15.0));
	EXPECT_STREQ(i18n_get_text("IDS_MEMO_TPOP_UNABLE_TO_SAVE_MEMO_TRY_AGAIN"), desktop_toast_log_get(0));
	EXPECT_TRUE(isTop(view));
	EXPECT_EQ("locked out", textOf(entryOf(items(view)[1])));
	kill(restore.pid, SIGTERM); // the sync ends early and lets go
	ASSERT_TRUE(restore.finish());
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	const int lost = (query("SELECT count(*) FROM memo WHERE content = 'locked out'") != "1") +
	                 (query("SELECT count(*) FROM memo WHERE content = 'after the backup'") != "1");
	printf("sync lock waits: 2 (a 2 s lock waited out, a 15 s lock refused with the text kept), lost=%d\n", lost);
	EXPECT_EQ(0, lost);
}

TEST_F(SyncService, AServiceWritingAllAlongAndAPersonEditingLoseNothing)
{
	const std::string seconds = getenv("MEMO_LONG") ? "60" : "5";
	SyncSim sim("--continuous " + seconds + " --interval 100 --hold 50");
	ASSERT_TRUE(sim.ready);
	std::map<std::string, std::string> saved; // the editor's memos and their last text
	std::string last;
	for (int round = 0; sim.output().find("sync-sim: done") == std::string::npos; ++round) {
		// A new memo, then a change of it, as a person types them.
		lastPagePopped = false;
		const std::string text = "edit " + std::to_string(round);
		MemoEditView *view = nullptr;
		if (round % 2 == 0) {
			view = openNew();
			typeInto(items(view)[1], text.c_str());
		} else {
			records.emplace_back(MemoDbMgr::getInstance()->getOneMemoN(last.c_str()));
			view = openRecord(records.back().get());
			pressUnderText(view, 0, 0);
			typeInto(items(view)[1], (" " + text).c_str());
		}
		pressDone(view);
		ASSERT_TRUE(waitFor([this] { return lastPagePopped; }, 15.0)) << "a save failed in round " << round;
		if (round % 2 == 0) {
			last = query("SELECT UUID FROM memo WHERE content = '" + text + "'");
			saved[last] = text;
		} else {
			saved[last] += " " + text;
		}
	}
	ASSERT_TRUE(sim.finish());
	int lost = 0;
	for (const auto &memo : sim.written())
		lost += query("SELECT content FROM memo WHERE UUID = '" + memo.first + "'") != memo.second;
	for (const auto &memo : saved)
		lost += query("SELECT content FROM memo WHERE UUID = '" + memo.first + "'") != memo.second;
	std::string summary = sim.output().substr(sim.output().find("sync-sim: done") + 10);
	summary.pop_back();
	printf("sync beside the editor: service %s, editor memos %zu, lost=%d\n", summary.c_str(), saved.size(), lost);
	EXPECT_EQ(0, lost);
	EXPECT_GT(sim.written().size(), 3u);
}
