#ifndef TESTS_APP_ASSIST_SUPPORT_APPASSISTFIXTURE_H
#define TESTS_APP_ASSIST_SUPPORT_APPASSISTFIXTURE_H

#include <string>
#include <vector>

#include <Elementary.h>
#include <gtest/gtest.h>

#include "TestEnv.h"
#include "WContentViewController.h"
#include "WNaviframeController.h"
#include "WWindowController.h"

namespace aa_test
{
class LoggingPage;

// Every test gets a fresh window with a naviframe as its base view.
class UiTest : public ::testing::Test
{
protected:
	void SetUp() override;
	void TearDown() override;

	// Feeds a key press and release to the window's canvas.
	void pressKey(const char *keyName);
	// Runs the main loop until pred() holds, at most 3 s; returns pred().
	bool waitFor(const std::function<bool()> &pred);
	// Runs the main loop until the jobs queued so far have run.
	void settle();
	// Runs the main loop for the given time (to see that something does not happen).
	void runFor(double seconds) { memo_test::pumpFor(seconds); }
	// Pushes a new LoggingPage that writes to log.
	LoggingPage *pushPage(const char *tag);
	// The log entries of one page, in order, without the "<tag>:" prefix.
	std::vector<std::string> entriesOf(const std::string &tag) const;
	bool hasEntry(const std::string &line) const;

	std::vector<std::string> log;
	app_assist::WWindowController *window = nullptr;
	app_assist::WNaviframeController *naviframe = nullptr;
};

// A page that writes "<name>:<operation>" to a shared log for each framework call it gets.
class LoggingPage : public app_assist::WContentViewController
{
public:
	LoggingPage(const std::string &tag, std::vector<std::string> *log, bool failCreate = false)
	    : __tag(tag), __log(log), __failCreate(failCreate)
	{
		__note("constructor");
	}
	~LoggingPage() override { __note("destructor"); }
	const char *getClassName() const override { return "LoggingPage"; }

	void onPushed(Elm_Object_Item *naviItem) override { __note(naviItem == getNaviItem() ? "onPushed" : "onPushed?"); }
	void onPop() override { __note("onPop"); }
	void onBecomeTop() override { __note("onBecomeTop"); }

	void *receivedParam = nullptr;

protected:
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onCreated() override { __note("onCreated"); }
	void onDestroy() override { __note("onDestroy"); }

private:
	void __note(const char *operation) { __log->push_back(__tag + ":" + operation); }

	std::string __tag;
	std::vector<std::string> *__log;
	bool __failCreate;
};

} // namespace aa_test

#endif
