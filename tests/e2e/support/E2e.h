#ifndef TESTS_E2E_SUPPORT_E2E_H
#define TESTS_E2E_SUPPORT_E2E_H

#include <string>

#include "TestEnv.h"

namespace memo_test
{
// The memo app driven as other programs drive it: launch requests through app_launcher, its data under a
// private folder, what it did read from its log and its memo.db. `env` goes in front of every command; an
// empty `root` makes a private one. The app is ended with the object.
struct MemoLaunch {
	explicit MemoLaunch(const std::string &env = "", const std::string &root = "",
	                    const std::string &launcher = TEST_BIN_DIR "/app_launcher");
	~MemoLaunch() { end(); }
	// Sends a request (app_launcher arguments after "-s com.veltron.memo"); the launcher's exit status.
	int send(const std::string &args, std::string *out = nullptr) const;
	// Starts the app by a request (arguments beginning with "-", or none) or by a command, and returns the
	// class name of its first page; empty when none came.
	std::string start(const std::string &args, std::string *out = nullptr);
	// Waits for the text in the log since the last start.
	bool waitForLog(const std::string &text) const
	{
		return pump(20.0, [&] { return log().find(text) != std::string::npos; });
	}
	// Asks the app to end and waits until it has; false when it was not running.
	bool end() const { return send("-k com.veltron.memo >/dev/null") == 0 && waitForLog("> ~MemoApp"); }
	std::string log() const { return readFile(root + "/data/dlog.log").substr(logStart); }
	std::string query(const std::string &sql) const { return queryFirst(root + "/data/memo.db", sql); }

	const std::string root, env, launcher;
	size_t logStart = 0;
};

// A private X display with a window manager (Xvfb, openbox) for real windows, real key presses and taps
// (xdotool). `ok` is false where a tool is missing; both stop with the object.
struct X11Display {
	X11Display();
	~X11Display();
	// Environment that puts a program's windows on this display.
	std::string env() const;
	int xdotool(const std::string &args) const;

	int display = 0, xvfb = -1, openbox = -1;
	bool ok = false;
};
} // namespace memo_test

#endif
