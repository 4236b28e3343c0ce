#ifndef TESTS_CORE_APP_TEST_FIXTURE_H
#define TESTS_CORE_APP_TEST_FIXTURE_H

// Scaffolding of the application tests: pages that stand in for the real views by their class name, a
// recorder of the broadcast bus, and writes from a second process.

#include <gtest/gtest.h>

#include <Elementary.h>

#include <string>
#include <vector>

#include <WApp.h>
#include <WContentViewController.h>
#include <WNaviframeController.h>
#include <WWindowController.h>

#include "Model/MemoBroadCaster.h"
#include "TestEnv.h"

namespace app_test
{

// A page that answers to the class name it was pushed with and counts its onBecomeTop calls.
class StubPage : public app_assist::WContentViewController
{
public:
	explicit StubPage(int *becomeTopCount) : __becomeTopCount(becomeTopCount) {}
	void onBecomeTop() override { ++*__becomeTopCount; }

protected:
	Evas_Object *onCreateView(Evas_Object *parent, void *) override
	{
		Evas_Object *bg = elm_bg_add(parent);
		elm_bg_color_set(bg, 255, 255, 255);
		return bg;
	}

private:
	int *__becomeTopCount;
};

// The naviframe of the running application, or null.
inline app_assist::WNaviframeController *naviframeOf(app_assist::WApp *app)
{
	app_assist::WWindowController *window = app ? app->getWindowController() : nullptr;
	return window ? dynamic_cast<app_assist::WNaviframeController *>(window->getBaseViewController()) : nullptr;
}

// Pushes a stub page named className; the count follows its onBecomeTop calls.
inline void pushStub(app_assist::WApp *app, const char *className, int *becomeTopCount)
{
	app_assist::WNaviframeController *naviframe = naviframeOf(app);
	ASSERT_NE(naviframe, nullptr);
	ASSERT_TRUE(naviframe->push(new StubPage(becomeTopCount), className));
}

// Everything said on the bus from attach() on.
struct BusRecorder {
	std::vector<std::string> keys;

	void attach()
	{
		MemoBroadCaster::getInstance().addListener([this](const char *key, void *) { keys.push_back(key); });
	}
	bool waitForCount(size_t count)
	{
		return memo_test::pump(5.0, [&] { return keys.size() >= count; });
	}
	size_t countOf(const std::string &key) const
	{
		size_t n = 0;
		for (const std::string &k : keys)
			n += (k == key);
		return n;
	}
};

// Runs the shared writer process: kind is pref-int, pref-string, vconf-int or vconf-str.
inline bool writeFromOtherProcess(const std::string &kind, const std::string &key, const std::string &value)
{
	std::string cmd = memo_test::helperPath("test_writer") + " " + kind + " '" + key + "' '" + value + "'";
	return memo_test::runCommand(cmd) == 0;
}

} // namespace app_test

#endif
