// memo-sync-sim: a stand-in for the sync service that shares memo.db, the preference store and the
// change key with the memo app. It runs one sync as chosen on the command line, or keeps writing for a
// while, and prints a line for every write that landed, so that whoever watches can check that nothing
// was lost on either side.
#include <app_common.h>
#include <app_preference.h>
#include <vconf.h>

#include <getopt.h>
#include <signal.h>
#include <time.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include "SyncSimStore.h"

namespace
{
struct Options {
	std::string db;
	int state = 0; // 1 restore, 2 backup: "MEMO_SVC_PROCESSING" while the sync runs
	double lock = 0;
	int add = 0, change = 0, tombstones = 0;
	bool markSynced = false;
	double continuous = 0;
	int intervalMs = 200, holdMs = 50;
	int trigger = -1;
	std::string ready, tag = "sim";
};

volatile sig_atomic_t stopRequested = 0;
int writes = 0, busy = 0;

void usage(FILE *out)
{
	fprintf(out, "Usage: memo-sync-sim [options]\n"
	             "  --db PATH           memo.db (default: the memo app's data folder)\n"
	             "  --restore|--backup  MEMO_SVC_PROCESSING is 1 (restore) or 2 (backup) during the run, then idle\n"
	             "  --lock SECONDS      hold the write lock that long, the run's writes inside it\n"
	             "  --add N             N memos arrive from the cloud\n"
	             "  --change N          the N newest memos change in the cloud\n"
	             "  --tombstone N       the N newest memos are deleted in the cloud (soft delete)\n"
	             "  --mark-synced       every changed row counts as uploaded (isDirty 0, isSynced 1)\n"
	             "  --continuous SEC    keep adding and changing memos of its own for that long\n"
	             "  --interval MS       time between writes in --continuous (default 200)\n"
	             "  --hold MS           how long each continuous write holds the lock (default 50)\n"
	             "  --trigger VALUE     CLOUD_TRIGGERING at the end (default: toggled between 0 and 1 after writes)\n"
	             "  --ready FILE        created once the run has started (the lock held, with --lock)\n"
	             "  --tag TEXT          put in the text of every memo written (default \"sim\")\n");
}

bool parse(int argc, char **argv, Options &o)
{
	enum { DB = 1, RESTORE, BACKUP, LOCK, ADD, CHANGE, TOMB, SYNCED, CONT, INTERVAL, HOLD, TRIGGER, READY, TAG, HELP };
	const option longOptions[] = {{"db", 1, nullptr, DB},           {"restore", 0, nullptr, RESTORE},
	                              {"backup", 0, nullptr, BACKUP},   {"lock", 1, nullptr, LOCK},
	                              {"add", 1, nullptr, ADD},         {"change", 1, nullptr, CHANGE},
	                              {"tombstone", 1, nullptr, TOMB},  {"mark-synced", 0, nullptr, SYNCED},
	                              {"continuous", 1, nullptr, CONT}, {"interval", 1, nullptr, INTERVAL},
	                              {"hold", 1, nullptr, HOLD},       {"trigger", 1, nullptr, TRIGGER},
	                              {"ready", 1, nullptr, READY},     {"tag", 1, nullptr, TAG},
	                              {"help", 0, nullptr, HELP},       {nullptr, 0, nullptr, 0}};
	int c;
	while ((c = getopt_long(argc, argv, "", longOptions, nullptr)) != -1) {
		switch (c) {
		case DB:
			o.db = optarg;
			break;
		case RESTORE:
			o.state = 1;
			break;
		case BACKUP:
			o.state = 2;
			break;
		case LOCK:
			o.lock = atof(optarg);
			break;
		case ADD:
			o.add = atoi(optarg);
			break;
		case CHANGE:
			o.change = atoi(optarg);
			break;
		case TOMB:
			o.tombstones = atoi(optarg);
			break;
		case SYNCED:
			o.markSynced = true;
			break;
		case CONT:
			o.continuous = atof(optarg);
			break;
		case INTERVAL:
			o.intervalMs = atoi(optarg);
			break;
		case HOLD:
			o.holdMs = atoi(optarg);
			break;
		case TRIGGER:
			o.trigger = atoi(optarg);
			break;
		case READY:
			o.ready = optarg;
			break;
		case TAG:
			o.tag = optarg;
			break;
		case HELP:
			usage(stdout);
			exit(0);
		default:
			return false;
		}
	}
	return optind == argc;
}

void sleepFor(double seconds)
{
	timespec ts{static_cast<time_t>(seconds), static_cast<long>((seconds - static_cast<time_t>(seconds)) * 1e9)};
	while (!stopRequested && nanosleep(&ts, &ts) != 0) {
	}
}

double now()
{
	timespec ts;
	clock_gettime(CLOCK_MONOTONIC, &ts);
	return ts.tv_sec + ts.tv_nsec / 1e9;
}

std::string textFor(const Options &o, const char *what)
{
	static int counter = 0;
	return o.tag + " " + what + " " + std::to_string(getpid()) + "-" + std::to_string(++counter);
}

void say(const char *what, const std::string &uuid, const std::string &text)
{
	printf("sync-sim: %s %s%s%s\n", what, uuid.c_str(), text.empty() ? "" : " ", text.c_str());
	fflush(stdout);
}

// The run's writes, inside the caller's transaction; false at the first that failed.
bool syncWrites(SyncSimStore &store, const Options &o, std::vector<std::pair<std::string, std::string>> &done)
{
	for (int i = 0; i < o.add; ++i) {
		const std::string text = textFor(o, "added"), uuid = store.addMemo(text);
		if (uuid.empty())
			return false;
		done.emplace_back("added " + uuid, text);
	}
	for (const std::string &uuid : store.newestMemos(o.change)) {
		const std::string text = textFor(o, "changed");
		if (!store.changeMemo(uuid, text))
			return false;
		done.emplace_back("changed " + uuid, text);
	}
	for (const std::string &uuid : store.newestMemos(o.tombstones)) {
		if (!store.tombstone(uuid))
			return false;
		done.emplace_back("tombstone " + uuid, "");
	}
	if (o.markSynced) {
		const int rows = store.markSynced();
		if (rows < 0)
			return false;
		done.emplace_back("synced " + std::to_string(rows), "rows");
	}
	return true;
}

void readyMark(const Options &o)
{
	if (o.ready.empty())
		return;
	FILE *f = fopen(o.ready.c_str(), "w");
	if (f)
		fclose(f);
}

// One sync run: the lock (when asked) around all writes, held for the chosen time.
bool runOnce(SyncSimStore &store, const Options &o)
{
	if (!store.begin()) {
		++busy;
		printf("sync-sim: busy: the app held the lock\n");
		return false;
	}
	if (o.lock > 0)
		printf("sync-sim: lock held for %.1f s\n", o.lock);
	fflush(stdout);
	readyMark(o);
	std::vector<std::pair<std::string, std::string>> done;
	bool ok = syncWrites(store, o, done);
	if (o.lock > 0)
		sleepFor(o.lock);
	ok = ok && store.commit();
	if (!ok) {
		store.rollback();
		return false;
	}
	for (const auto &d : done) {
		say(d.first.substr(0, d.first.find(' ')).c_str(), d.first.substr(d.first.find(' ') + 1), d.second);
		++writes;
	}
	if (!done.empty())
		vconf_set_int("db/memo/data-change", 1);
	return true;
}

// Writes of its own for a while: mostly changes of the memos it added, each write its own transaction
// that holds the lock a little, as an upload in pieces would.
void runContinuous(SyncSimStore &store, const Options &o)
{
	std::vector<std::string> own;
	readyMark(o);
	const double end = now() + o.continuous;
	for (unsigned round = 0; !stopRequested && now() < end; ++round) {
		const bool adding = own.empty() || round % 3 == 0;
		const std::string text = textFor(o, adding ? "added" : "changed");
		const std::string target = adding ? "" : own[round % own.size()];
		if (!store.begin()) {
			++busy;
			printf("sync-sim: busy: the app held the lock\n");
			continue;
		}
		const std::string uuid = adding ? store.addMemo(text) : (store.changeMemo(target, text) ? target : "");
		sleepFor(o.holdMs / 1000.0);
		if (uuid.empty() || !store.commit()) {
			store.rollback();
			++busy;
			continue;
		}
		if (adding)
			own.push_back(uuid);
		say(adding ? "added" : "changed", uuid, text);
		++writes;
		vconf_set_int("db/memo/data-change", 1);
		sleepFor(o.intervalMs / 1000.0);
	}
}

void stopCb(int)
{
	stopRequested = 1;
}
} // namespace

int main(int argc, char **argv)
{
	Options o;
	if (!parse(argc, argv, o)) {
		usage(stderr);
		return 2;
	}
	// The service is of the memo package: its preference store and data folder are the app's.
	setenv("TIZEN_APP_ID", "com.veltron.memo", 0);
	if (o.db.empty()) {
		char *data = app_get_data_path();
		o.db = std::string(data ? data : "") + "memo.db";
		free(data);
	}
	signal(SIGTERM, stopCb);
	signal(SIGINT, stopCb);

	SyncSimStore store;
	if (access(o.db.c_str(), F_OK) != 0 || !store.open(o.db)) {
		fprintf(stderr, "sync-sim: no memo.db at %s (start the app once first)\n", o.db.c_str());
		return 1;
	}
	if (o.state) {
		preference_set_int("MEMO_SVC_PROCESSING", o.state);
		printf("sync-sim: state %s\n", o.state == 1 ? "restore" : "backup");
	}
	bool ok = true;
	if (o.continuous > 0)
		runContinuous(store, o);
	else
		ok = runOnce(store, o);

	if (o.trigger >= 0 || writes > 0) {
		int trigger = o.trigger;
		if (trigger < 0) {
			int current = 0;
			preference_get_int("CLOUD_TRIGGERING", &current);
			trigger = current == 1 ? 0 : 1;
		}
		preference_set_int("CLOUD_TRIGGERING", trigger);
	}
	if (o.state) {
		preference_set_int("MEMO_SVC_PROCESSING", 0);
		printf("sync-sim: state idle\n");
	}
	printf("sync-sim: done writes=%d busy=%d\n", writes, busy);
	return ok ? 0 : 1;
}
