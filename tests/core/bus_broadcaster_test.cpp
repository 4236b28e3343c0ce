// The broadcast bus as views use it: one process-wide signal, keys in order of registration, listeners that
// leave with their view, and a bus that starts empty again after destroy.
#include <gtest/gtest.h>

#include <Elementary.h>

#include <string>
#include <vector>

#include "Model/MemoBroadCaster.h"
#include "TestEnv.h"

namespace
{

class BroadCasterTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		static char arg0[] = "bus-test";
		static char *argv[] = {arg0, nullptr};
		elm_init(1, argv);
	}

	void SetUp() override
	{
		win = elm_win_add(nullptr, "bus-test", ELM_WIN_BASIC);
		ASSERT_NE(win, nullptr);
	}

	void TearDown() override
	{
		MemoBroadCaster::destroy();
		evas_object_del(win);
	}

	Evas_Object *win = nullptr;
	std::vector<std::string> heard;
};

TEST_F(BroadCasterTest, deliversEveryKeyInOrderOfRegistration)
{
	MemoBroadCaster::getInstance().addListener(
	    [this](const char *key, void *) { heard.push_back(std::string("a:") + key); });
	MemoBroadCaster::getInstance().addListener([this](const char *key, void *payload) {
		EXPECT_EQ(payload, nullptr);
		heard.push_back(std::string("b:") + key);
	});
	EXPECT_EQ(&MemoBroadCaster::getInstance(), &MemoBroadCaster::getInstance());

	MemoBroadCaster::getInstance().emit("broadcast,memo,app,pause", nullptr);
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,resume", nullptr);

	EXPECT_EQ(heard, (std::vector<std::string>{"a:broadcast,memo,app,pause", "b:broadcast,memo,app,pause",
	                                           "a:broadcast,memo,app,resume", "b:broadcast,memo,app,resume"}));
}

TEST_F(BroadCasterTest, listenerLeavesWithItsView)
{
	Evas_Object *view = evas_object_rectangle_add(evas_object_evas_get(win));
	MemoBroadCaster::getInstance().addListener([this](const char *key, void *) { heard.push_back(key); }, view);
	MemoBroadCaster::getInstance().emit("broadcast,orientation,changed", nullptr);
	evas_object_del(view);
	MemoBroadCaster::getInstance().emit("broadcast,orientation,changed", nullptr);

	EXPECT_EQ(heard.size(), 1u);
	EXPECT_EQ(MemoBroadCaster::getInstance().getListenerCount(), 0u);
}

TEST_F(BroadCasterTest, destroyDropsEveryListenerAndTheirOwnerCallbacks)
{
	Evas_Object *view = evas_object_rectangle_add(evas_object_evas_get(win));
	MemoBroadCaster::getInstance().addListener([this](const char *key, void *) { heard.push_back(key); }, view);
	MemoBroadCaster::getInstance().addListener([this](const char *key, void *) { heard.push_back(key); });

	MemoBroadCaster::destroy();
	// The owner's delete callback was taken away with the bus: deleting the view touches nothing freed.
	evas_object_del(view);
	MemoBroadCaster::getInstance().emit("broadcast,language,changed", nullptr);

	EXPECT_TRUE(heard.empty());
	EXPECT_EQ(MemoBroadCaster::getInstance().getListenerCount(), 0u);
}

} // namespace
