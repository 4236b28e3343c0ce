// Recording and playing on the main loop: a 10 s recording of the test tone (the same pipeline as the
// microphone's from the converter on) with the status callback running, then its playback preparation.
//
// Printed per run: the time each blocking call holds the main loop (recorder prepare, start, commit,
// player prepare with the discoverer's duration), the time from the start to the first status
// callback, and the longest main-loop iteration while recording (wall clock and the main thread's
// processor time in its busiest iteration). Goal: no iteration over 16 ms.
//
//   build-x/bench/bench_media [runs]      (default 3)
#include <Ecore.h>
#include <player.h>
#include <recorder.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <time.h>

#include "BenchEnv.h"
#include "LoopIterations.h"

using namespace memo_bench;

namespace
{
const double RECORD_SEC = 10.0;

struct Result {
	double prepareMs = 0, startMs = 0, firstStatusMs = -1, commitMs = 0, playerPrepareMs = 0;
	double longestMs = 0, longestCpuMs = 0;
	unsigned long long recordedMs = 0;
};

// One recording, watched from inside the main loop.
struct Run {
	Result r;
	recorder_h rec = nullptr;
	double startedAt = -1;
	LoopIterations *loop = nullptr; // counts while recording

	static void statusCb(unsigned long long elapsed, unsigned long long, void *data)
	{
		Run *self = static_cast<Run *>(data);
		if (self->r.firstStatusMs < 0)
			self->r.firstStatusMs = (ecore_time_get() - self->startedAt) * 1000.0;
		self->r.recordedMs = elapsed;
	}

	static Eina_Bool startCb(void *data)
	{
		Run *self = static_cast<Run *>(data);
		self->startedAt = ecore_time_get();
		if (recorder_start(self->rec) != RECORDER_ERROR_NONE) {
			fprintf(stderr, "recorder_start failed\n");
			ecore_main_loop_quit();
			return ECORE_CALLBACK_CANCEL;
		}
		self->r.startMs = (ecore_time_get() - self->startedAt) * 1000.0;
		self->loop->counting = true;
		ecore_timer_add(RECORD_SEC, endCb, self);
		return ECORE_CALLBACK_CANCEL;
	}

	static Eina_Bool endCb(void *data)
	{
		static_cast<Run *>(data)->loop->counting = false;
		ecore_main_loop_quit();
		return ECORE_CALLBACK_CANCEL;
	}

	bool go(const std::string &path)
	{
		if (recorder_create_audiorecorder(&rec) != RECORDER_ERROR_NONE)
			return false;
		recorder_set_filename(rec, path.c_str());
		recorder_set_recording_status_cb(rec, statusCb, this);
		double t = ecore_time_get();
		bool ok = recorder_prepare(rec) == RECORDER_ERROR_NONE;
		r.prepareMs = (ecore_time_get() - t) * 1000.0;
		if (ok) {
			{
				LoopIterations iterations;
				loop = &iterations;
				ecore_timer_add(0.1, startCb, this);
				ecore_main_loop_begin();
				r.longestMs = iterations.longestMs;
				r.longestCpuMs = iterations.longestCpuMs;
				loop = nullptr;
			}
			t = ecore_time_get();
			ok = recorder_commit(rec) == RECORDER_ERROR_NONE;
			r.commitMs = (ecore_time_get() - t) * 1000.0;
			recorder_unprepare(rec);
		}
		recorder_destroy(rec);
		player_h player = nullptr;
		if (ok && player_create(&player) == PLAYER_ERROR_NONE) {
			player_set_uri(player, path.c_str());
			t = ecore_time_get();
			ok = player_prepare(player) == PLAYER_ERROR_NONE;
			r.playerPrepareMs = (ecore_time_get() - t) * 1000.0;
			player_destroy(player);
		}
		return ok;
	}
};
} // namespace

int main(int argc, char **argv)
{
	const int runs = argc > 1 ? std::max(1, atoi(argv[1])) : 3;
	const std::string root = setUpPrivateRoot("media");
	if (root.empty())
		return 1;
	setenv("TIZEN_AUDIO_SOURCE", "test", 0);
	setenv("TIZEN_AUDIO_SINK", "fake", 0);
	ecore_init();
	printf("| run | prepare | start | first status | longest iteration | most CPU | commit | player prepare |\n");
	printf("|---|---|---|---|---|---|---|---|\n");
	double longest = 0, longestCpu = 0;
	int failed = 0;
	for (int i = 0; i < runs; i++) {
		Run run;
		if (!run.go(root + "/take" + std::to_string(i) + ".amr")) {
			failed++;
			continue;
		}
		const Result &r = run.r;
		printf("| %d | %.1f ms | %.1f ms | %.0f ms | %.1f ms | %.1f ms | %.1f ms | %.1f ms |\n", i + 1, r.prepareMs,
		       r.startMs, r.firstStatusMs, r.longestMs, r.longestCpuMs, r.commitMs, r.playerPrepareMs);
		longest = std::max(longest, r.longestMs);
		longestCpu = std::max(longestCpu, r.longestCpuMs);
	}
	printf("longest main-loop iteration while recording %.1f ms wall clock, %.1f ms processor time (goal 16 ms: %s)\n",
	       longest, longestCpu, longest <= 16.0 ? "met" : "missed");
	ecore_shutdown();
	std::string cmd = "rm -rf '" + root + "'";
	if (system(cmd.c_str()) != 0)
		fprintf(stderr, "could not remove %s\n", root.c_str());
	return failed ? 1 : 0;
}
