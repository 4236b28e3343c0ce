// Cold start of the real memo binary, whole process, from exec to the first rendered frame of its list
// (buffer engine, ECORE_NO_SYSTEM_MODULES=1), with 0, 1,000 and 10,000 memos in the store, beside a bare
// Elementary window with a naviframe. Both end on their first frame (first_frame_exit preloaded); the time
// is read around fork and wait, the peak memory from the child's resource usage. Each case runs several
// times and the median is printed with the best and the worst.
#include "BenchEnv.h"

#include <sys/resource.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

namespace
{
const int RUNS = 7;

struct Sample {
	double ms;
	double cpuMs;
	long peakKiB;
};

std::string gBuild;

double now()
{
	timespec t;
	clock_gettime(CLOCK_MONOTONIC, &t);
	return t.tv_sec * 1000.0 + t.tv_nsec / 1e6;
}

// Runs program under the preload with the environment of root; false when it did not end on its frame.
bool runOnce(const std::string &program, const std::string &root, Sample *sample)
{
	fflush(stdout);
	const double start = now();
	pid_t child = fork();
	if (child == 0) {
		setenv("TIZEN_APP_ROOT", (root + "/app").c_str(), 1);
		setenv("TIZEN_VCONF_DIR", (root + "/vconf").c_str(), 1);
		setenv("XDG_RUNTIME_DIR", root.c_str(), 1);
		setenv("LD_PRELOAD", (gBuild + "/bench/libfirst_frame_exit.so").c_str(), 1);
		if (!freopen("/dev/null", "w", stderr) || !freopen("/dev/null", "w", stdout))
			_exit(3);
		execl(program.c_str(), program.c_str(), static_cast<char *>(nullptr));
		_exit(4);
	}
	int status = 0;
	rusage usage = {};
	if (wait4(child, &status, 0, &usage) != child)
		return false;
	sample->ms = now() - start;
	sample->cpuMs = (usage.ru_utime.tv_sec + usage.ru_stime.tv_sec) * 1000.0 +
	                (usage.ru_utime.tv_usec + usage.ru_stime.tv_usec) / 1000.0;
	sample->peakKiB = usage.ru_maxrss;
	return WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

// The median, best and worst of the runs, as "median ms (best-worst), peak MiB".
struct Summary {
	double ms, best, worst, cpuMs, peakMiB;
};

bool measure(const std::string &program, const std::string &root, Summary *out)
{
	std::vector<Sample> samples;
	for (int i = 0; i < RUNS; ++i) {
		Sample sample;
		if (!runOnce(program, root, &sample))
			return false;
		samples.push_back(sample);
	}
	std::sort(samples.begin(), samples.end(), [](const Sample &a, const Sample &b) { return a.ms < b.ms; });
	std::vector<long> peaks;
	std::vector<double> cpu;
	for (const Sample &s : samples) {
		peaks.push_back(s.peakKiB);
		cpu.push_back(s.cpuMs);
	}
	std::sort(peaks.begin(), peaks.end());
	std::sort(cpu.begin(), cpu.end());
	*out = {samples[RUNS / 2].ms, samples.front().ms, samples.back().ms, cpu[RUNS / 2], peaks[RUNS / 2] / 1024.0};
	return true;
}

void print(const char *name, const Summary &s, const Summary *reference)
{
	printf("%-24s %7.1f ms (%6.1f - %6.1f)  cpu %7.1f ms  %6.1f MiB", name, s.ms, s.best, s.worst, s.cpuMs, s.peakMiB);
	if (reference)
		printf("  x%.2f time, x%.2f cpu, x%.2f memory", s.ms / reference->ms, s.cpuMs / reference->cpuMs,
		       s.peakMiB / reference->peakMiB);
	printf("\n");
}
} // namespace

int main()
{
	const std::string root = memo_bench::setUpPrivateRoot("coldstart");
	if (root.empty())
		return 1;
	// The processes log as the app does, every line.
	unsetenv("DLOG_LEVEL");
	const std::string seed = memo_bench::helperPath("memo_seed");
	gBuild = seed.substr(0, seed.rfind("/tests/"));
	const std::string memo = gBuild + "/app/bin/memo";

	Summary bare;
	if (!measure(gBuild + "/bench/bench_bare_window", root + "/bare", &bare)) {
		fprintf(stderr, "the bare window did not reach its first frame\n");
		return 1;
	}
	printf("Cold start to the first frame: wall time, median of %d runs (best - worst); CPU time and peak "
	       "memory, medians\n",
	       RUNS);
	print("bare window + naviframe", bare, nullptr);
	int rc = 0;
	for (int count : {0, 1000, 10000}) {
		const std::string store = root + "/memos-" + std::to_string(count);
		std::string fill = "TIZEN_APP_ROOT='" + store + "/app' TIZEN_VCONF_DIR='" + store + "/vconf' '" + seed +
		                   "' fill " + std::to_string(count) + " >/dev/null 2>&1";
		Summary app;
		if (system(fill.c_str()) != 0 || !measure(memo, store, &app)) {
			fprintf(stderr, "memo with %d memos did not reach its first frame\n", count);
			rc = 1;
			continue;
		}
		const std::string name = "memo, " + std::to_string(count) + " memos";
		print(name.c_str(), app, &bare);
	}
	system(("rm -rf '" + root + "'").c_str());
	return rc;
}
