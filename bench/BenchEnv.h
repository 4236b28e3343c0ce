#ifndef BENCH_BENCHENV_H
#define BENCH_BENCHENV_H

// The surroundings every benchmark runs in, as the tests do: a private root for every store (the
// user's memos are never touched), the app's resources from the build tree, a headless canvas, and
// a log that keeps to errors so that it stays out of the timings.

#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <string>

namespace memo_bench
{

inline void setDir(const char *var, const std::string &path)
{
	mkdir(path.c_str(), 0700);
	setenv(var, path.c_str(), 1);
}

// Makes "/tmp/memo-bench-<name>-XXXXXX" and points the environment at it; returns the folder, or ""
// (with a message) when it cannot be made. The caller removes it.
inline std::string setUpPrivateRoot(const char *name)
{
	std::string tmpl = std::string("/tmp/memo-bench-") + name + "-XXXXXX";
	if (!mkdtemp(&tmpl[0])) {
		perror("mkdtemp");
		return "";
	}
	setDir("HOME", tmpl + "/home");
	setDir("XDG_DATA_HOME", tmpl + "/xdg-data");
	setDir("XDG_CONFIG_HOME", tmpl + "/xdg-config");
	setDir("XDG_RUNTIME_DIR", tmpl + "/xdg-runtime");
	setDir("TIZEN_APP_ROOT", tmpl + "/app");
	setDir("TIZEN_VCONF_DIR", tmpl + "/vconf");
	setenv("TIZEN_APP_ID", "com.veltron.memo", 1);
	if (!getenv("TIZEN_APP_RES_DIR")) {
		// <build>/bench/bench_<name> -> <build>/app/res/
		char exe[4096] = {};
		const ssize_t len = readlink("/proc/self/exe", exe, sizeof(exe) - 1);
		if (len > 0) {
			std::string dir(exe, static_cast<size_t>(len));
			dir = dir.substr(0, dir.rfind('/'));
			dir = dir.substr(0, dir.rfind('/'));
			setenv("TIZEN_APP_RES_DIR", (dir + "/app/res/").c_str(), 1);
		}
	}
	setenv("ELM_ENGINE", "buffer", 1);
	setenv("ELM_DISPLAY", "buffer", 1);
	setenv("ECORE_EVAS_ENGINE", "buffer", 1);
	setenv("ECORE_NO_SYSTEM_MODULES", "1", 1);
	setenv("EINA_LOG_BACKTRACE", "0", 1);
	setenv("DLOG_LEVEL", "6", 1); // errors only
	unsetenv("DISPLAY");
	unsetenv("WAYLAND_DISPLAY");
	return tmpl;
}

// Path of a helper program of the tests: <build>/bench/bench_<name> -> <build>/tests/helpers/<helper>.
inline std::string helperPath(const char *helper)
{
	char exe[4096] = {};
	const ssize_t len = readlink("/proc/self/exe", exe, sizeof(exe) - 1);
	std::string dir(exe, len > 0 ? static_cast<size_t>(len) : 0);
	dir = dir.substr(0, dir.rfind('/'));
	dir = dir.substr(0, dir.rfind('/'));
	return dir + "/tests/helpers/" + helper;
}

} // namespace memo_bench

#endif
