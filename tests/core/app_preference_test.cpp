// MemoApp and the state it shares with the sync service: first-run preference values, and the broadcasts
// that changes made by another process give. onCreate runs directly on a headless canvas.
#include "app_test_fixture.h"

#include <app_preference.h>

#include "MemoApp.h"

using app_test::BusRecorder;
using app_test::writeFromOtherProcess;

namespace
{

class AppPreferenceTest : public ::testing::Test
{
protected:
	void SetUp() override
	{
		memo_test::initElementary();
		preference_remove_all();
	}

	void TearDown() override { endApp(); }

	void startApp()
	{
		app = new MemoApp();
		ASSERT_TRUE(app->onCreate());
		bus.attach();
	}

	// The app leaves its preference callbacks behind, as a process that ends would; the next test stands for
	// a new process, so they go here.
	void endApp()
	{
		if (!app)
			return;
		app->onTerminate();
		delete app;
		app = nullptr;
		preference_unset_changed_cb("MEMO_SVC_PROCESSING");
		preference_unset_changed_cb("CLOUD_TRIGGERING");
		memo_test::pumpFor(0.02);
	}

	// A change from the other side, and the wait for the broadcast it gives.
	void otherProcessSets(const char *key, int value, size_t expectedCount)
	{
		ASSERT_TRUE(writeFromOtherProcess("pref-int", key, std::to_string(value)));
		ASSERT_TRUE(bus.waitForCount(expectedCount)) << key << " = " << value;
	}

	static int prefInt(const char *key)
	{
		int value = -100;
		EXPECT_EQ(preference_get_int(key, &value), PREFERENCE_ERROR_NONE) << key;
		return value;
	}

	static std::string prefString(const char *key)
	{
		char *value = nullptr;
		EXPECT_EQ(preference_get_string(key, &value), PREFERENCE_ERROR_NONE) << key;
		std::string text = value ? value : "(null)";
		free(value);
		return text;
	}

	MemoApp *app = nullptr;
	BusRecorder bus;
};

TEST_F(AppPreferenceTest, firstRunWritesTheFiveDefaultsSilentlyThenSyncStatesAreBroadcast)
{
	startApp();
	EXPECT_EQ(prefInt("MEMO_SVC_PROCESSING"), 0);
	EXPECT_EQ(prefInt("CLOUD_TRIGGERING"), 0);
	EXPECT_EQ(prefString("QUICK_MEMO_ORIGINAL_DATA"), "");
	EXPECT_EQ(prefString("QUICK_MEMO_ADD_DATA"), "");
	EXPECT_EQ(prefInt("QUICK_MEMO_STATE"), 0);

	// The first thing heard is the other side's change: writing the defaults raised nothing. Then each
	// state of the sync service is told on the bus.
	otherProcessSets("MEMO_SVC_PROCESSING", 1, 1);
	otherProcessSets("MEMO_SVC_PROCESSING", 2, 2);
	otherProcessSets("MEMO_SVC_PROCESSING", 7, 3);
	otherProcessSets("MEMO_SVC_PROCESSING", 0, 4);
	EXPECT_EQ(bus.keys, (std::vector<std::string>{"broadcast,sync,restore", "broadcast,sync,backup",
	                                              "broadcast,sync,idle", "broadcast,sync,idle"}));
}

TEST_F(AppPreferenceTest, cloudTriggeringReachesTheListOrTheBus)
{
	startApp();
	// 2 is ignored. The callbacks read the value as it stands when they run, so the sync state written after
	// it marks the point where the 2 has been seen.
	ASSERT_TRUE(writeFromOtherProcess("pref-int", "CLOUD_TRIGGERING", "2"));
	otherProcessSets("MEMO_SVC_PROCESSING", 7, 1);
	EXPECT_EQ(bus.keys, std::vector<std::string>{"broadcast,sync,idle"});
	bus.keys.clear();

	// No page yet: the bus way.
	otherProcessSets("CLOUD_TRIGGERING", 0, 1);
	EXPECT_EQ(bus.keys, std::vector<std::string>{"broadcast,sync,listupdate"});

	// The list on top reloads at once, with no broadcast.
	int listBecameTop = 0;
	app_test::pushStub(app, "MemoListView", &listBecameTop);
	ASSERT_TRUE(writeFromOtherProcess("pref-int", "CLOUD_TRIGGERING", "1"));
	ASSERT_TRUE(memo_test::pump(5.0, [&] { return listBecameTop == 1; }));

	// Any other page on top hears it on the bus.
	int searchBecameTop = 0;
	app_test::pushStub(app, "MemoSearchView", &searchBecameTop);
	otherProcessSets("CLOUD_TRIGGERING", 1, 2);
	EXPECT_EQ(bus.keys, (std::vector<std::string>{"broadcast,sync,listupdate", "broadcast,sync,listupdate"}));
	EXPECT_EQ(listBecameTop, 1);
	EXPECT_EQ(searchBecameTop, 0);
}

TEST_F(AppPreferenceTest, pauseAndResumeBroadcastAndRefreshTheTopPage)
{
	startApp();
	app->onPause();
	app->onResume();
	EXPECT_EQ(bus.keys, (std::vector<std::string>{"broadcast,memo,app,pause", "broadcast,memo,app,resume"}));

	int listBecameTop = 0, searchBecameTop = 0, editBecameTop = 0;
	app_test::pushStub(app, "MemoListView", &listBecameTop);
	app->onResume();
	EXPECT_EQ(listBecameTop, 1);
	app_test::pushStub(app, "MemoSearchView", &searchBecameTop);
	app->onResume();
	EXPECT_EQ(searchBecameTop, 1);
	app_test::pushStub(app, "MemoEditView", &editBecameTop);
	app->onResume();
	EXPECT_EQ(editBecameTop, 0);
	EXPECT_EQ(bus.countOf("broadcast,memo,app,resume"), 4u);
}

// A later start, here a second app in the same process, keeps the sync state, writes no defaults and has
// the callbacks, not the app that went.
TEST_F(AppPreferenceTest, laterStartKeepsTheStateAndASecondAppInTheSameProcessStartsClean)
{
	startApp();
	endApp();
	EXPECT_EQ(MemoBroadCaster::getInstance().getListenerCount(), 0u);

	preference_remove_all();
	preference_set_int("MEMO_SVC_PROCESSING", 1);
	preference_set_int("CLOUD_TRIGGERING", 1);
	bus = BusRecorder();
	startApp();
	EXPECT_EQ(prefInt("MEMO_SVC_PROCESSING"), 1);
	bool exists = true;
	preference_is_existing("QUICK_MEMO_STATE", &exists);
	EXPECT_FALSE(exists);

	int listBecameTop = 0;
	app_test::pushStub(app, "MemoListView", &listBecameTop);
	ASSERT_TRUE(writeFromOtherProcess("pref-int", "CLOUD_TRIGGERING", "0"));
	ASSERT_TRUE(memo_test::pump(5.0, [&] { return listBecameTop == 1; }));
	otherProcessSets("MEMO_SVC_PROCESSING", 2, 1);
	EXPECT_EQ(bus.keys, std::vector<std::string>{"broadcast,sync,backup"});
}

} // namespace
