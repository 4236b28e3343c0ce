#ifndef TESTS_E2E_SUPPORT_MEMOLAUNCH_H
#define TESTS_E2E_SUPPORT_MEMOLAUNCH_H

#include <string>

namespace memo_test
{
// The class name of the page a plain start shows.
#if __has_include("View/MemoListView.h")
const char *const LIST_PAGE = "MemoListView";
#else
const char *const LIST_PAGE = "MemoEditView"; // a new memo stands in for the list until it lands
#endif

// The memo app driven as other programs drive it: launch requests through app_launcher, its data under a
// private folder, what it did read from its log and its memo.db.
class MemoLaunch
{
public:
	// env goes in front of every command (assignments or an `env ...` call); root is the app's data root,
	// a fresh private one when empty.
	explicit MemoLaunch(const std::string &env = "", const std::string &root = "",
	                    const std::string &launcher = TEST_BIN_DIR "/app_launcher");
	// Ends the app if it still runs.
	~MemoLaunch();
	// Runs a command with the app's environment; its exit status, its standard output in *out.
	int run(const std::string &cmd, std::string *out = nullptr) const;
	// Sends a request (app_launcher arguments after "-s com.veltron.memo").
	int send(const std::string &args, std::string *out = nullptr) const;
	// Starts the app by the command (a request when it begins with "-") and returns the class name of its
	// first page, empty when none came.
	std::string start(const std::string &args, std::string *out = nullptr);
	// Waits until the log since the last start holds the text.
	bool waitForLog(const std::string &text) const;
	// Asks the app to end and waits until it has; false when it was not running.
	bool end() const;
	// The log since the last start.
	std::string log() const;
	// First column of the first row of a query on memo.db; empty when there is none.
	std::string query(const std::string &sql) const;

	const std::string root;

private:
	std::string __env;
	std::string __launcher;
	size_t __logStart = 0;
};
} // namespace memo_test

#endif
