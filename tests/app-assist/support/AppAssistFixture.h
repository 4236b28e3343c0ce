#ifndef TESTS_APP_ASSIST_SUPPORT_APPASSISTFIXTURE_H
#define TESTS_APP_ASSIST_SUPPORT_APPASSISTFIXTURE_H

#include <string>
#include <vector>

#include <Elementary.h>
#include <gtest/gtest.h>

#include "WContentViewController.h"
#include "WNaviframeController.h"
#include "WWindowController.h"

namespace aa_test
{

// Elementary up once per process; every test gets a fresh window with a naviframe as its base view.
class UiTest : public ::testing::Test
{
protected:
	void SetUp() override;
	void TearDown() override;

	// Feeds a key press and release to the window's canvas, then lets the main loop run the handlers.
	void pressKey(const char *keyName);
	// Runs the main loop (idlers included, which plain iteration skips) until pred() holds, at most 3 s;
	// returns pred().
	bool waitFor(const std::function<bool()> &pred);
	// Runs the main loop for the given time.
	void runFor(double seconds);

	app_assist::WWindowController *window = nullptr;
	app_assist::WNaviframeController *naviframe = nullptr;
};

// A page that writes "<name>:<operation>" to a shared log for each framework call it gets.
class LoggingPage : public app_assist::WContentViewController
{
public:
	LoggingPage(const std::string &tag, std::vector<std::string> *log, bool failCreate = false);
	~LoggingPage() override;
	const char *getClassName() const override { return "LoggingPage"; }

	void onPushed(Elm_Object_Item *naviItem) override;
	void onPop() override;
	void onBecomeTop() override;

	void *receivedParam = nullptr;

protected:
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onCreated() override;
	void onDestroy() override;

private:
	std::string __tag;
	std::vector<std::string> *__log;
	bool __failCreate;
};

} // namespace aa_test

#endif
