#ifndef TESTS_COMMON_TESTENV_H
#define TESTS_COMMON_TESTENV_H

#include <functional>
#include <string>

#include <Evas.h>

// Shared test scaffolding. test_main points every platform store at a fresh
// temporary root before any test runs, so no test touches the user's data.
namespace memo_test
{
// The temporary root of this test process, made on first use (removed at exit unless MEMO_TEST_KEEP is set).
const std::string &tempRoot();

// A fresh empty folder under the temporary root.
std::string makeTempDir(const std::string &name);

// Iterates the Ecore main loop until pred() is true or timeoutSec passes; returns pred()'s last value.
bool pump(double timeoutSec, const std::function<bool()> &pred);

// Iterates the main loop for the given time.
void pumpFor(double seconds);

// Elementary up, once per process.
void initElementary();

// Elementary up and a shown 480 x 800 window, returned after its first frame.
Evas_Object *addShownWindow(const char *name);

// Waits for the next frame of a shown window: after the first one its content is visible and takes keys.
bool waitForFrame(Evas_Object *win);

// Path of a helper process built from tests/helpers/<name>.c(pp).
std::string helperPath(const std::string &name);

// Renders the canvas of a buffer-engine window and saves it as PNG; returns false on failure.
bool saveScreenshot(Evas_Object *win, const std::string &pngPath);

// Runs a command through the shell, returns its exit status and (optionally) its standard output.
int runCommand(const std::string &cmd, std::string *out = nullptr);

// Reads a whole file; empty when it cannot be read.
std::string readFile(const std::string &path);

// Runs one statement on a database file and returns the first column of its first row; empty when there is
// none.
std::string queryFirst(const std::string &dbPath, const std::string &sql);

// How often `what` occurs in `text`, overlaps included.
inline size_t countOf(const std::string &text, const std::string &what)
{
	size_t n = 0;
	for (size_t pos = text.find(what); pos != std::string::npos; pos = text.find(what, pos + 1))
		++n;
	return n;
}
} // namespace memo_test

#endif
