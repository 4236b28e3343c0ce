// The process-wide singletons of the model with real objects: the popup monitor answers for the last popup
// registered, and only while it exists; the broadcast bus (a WSignal, whose emission rules have their own
// tests) drops its listeners and their owner callbacks with destroy.
#include <gtest/gtest.h>

#include <Elementary.h>

#include <string>
#include <vector>

#include <WPopupController.h>

#include "Model/MemoBroadCaster.h"
#include "Model/MemoPopupMonitor.h"
#include "TestEnv.h"

using app_assist::WPopupController;

namespace
{

class BusTest : public ::testing::Test
{
protected:
	void SetUp() override { win = memo_test::addShownWindow("bus-test"); }

	void TearDown() override
	{
		MemoPopupMonitor::destroy();
		MemoBroadCaster::destroy();
		evas_object_del(win);
		memo_test::pumpFor(0.02);
	}

	WPopupController *openPopup(const char *title)
	{
		WPopupController *popup = new WPopupController();
		popup->setTitle(title);
		popup->addButton("OK", [](bool *close) { *close = true; });
		EXPECT_TRUE(popup->create(win, nullptr));
		return popup;
	}

	Evas_Object *win = nullptr;
};

TEST_F(BusTest, onlyTheLastPopupCountsWhileItStandsAndUntilDestroy)
{
	MemoPopupMonitor *monitor = MemoPopupMonitor::getInstance();
	EXPECT_FALSE(monitor->isPopupAlive());
	WPopupController *first = openPopup("first");
	WPopupController *second = openPopup("second");
	monitor->addPopup(first);
	monitor->addPopup(second);
	ASSERT_TRUE(monitor->isPopupAlive());
	EXPECT_EQ(monitor->getPopup(), second);

	// Gone without a word to the monitor, as when the back key or a button closes it. The first one still
	// stands, but the monitor has forgotten it.
	evas_object_del(second->getEvasObj());
	memo_test::pumpFor(0.02);
	EXPECT_NE(first->getEvasObj(), nullptr);
	EXPECT_FALSE(monitor->isPopupAlive());
	EXPECT_EQ(monitor->getPopup(), nullptr);

	monitor->addPopup(first);
	EXPECT_TRUE(monitor->isPopupAlive());
	MemoPopupMonitor::destroy();
	EXPECT_FALSE(MemoPopupMonitor::getInstance()->isPopupAlive());
	first->destroy();
}

TEST_F(BusTest, broadcasterDestroyDropsListenersAndOwnerCallbacks)
{
	Evas_Object *view = evas_object_rectangle_add(evas_object_evas_get(win));
	std::vector<std::string> heard;
	MemoBroadCaster::getInstance().addListener([&](const char *key, void *) { heard.push_back(key); }, view);
	MemoBroadCaster::getInstance().addListener([&](const char *key, void *) { heard.push_back(key); });
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,pause", nullptr);
	EXPECT_EQ(heard.size(), 2u);

	MemoBroadCaster::destroy();
	// The owner's delete callback was taken away with the bus: deleting the view touches nothing freed.
	evas_object_del(view);
	MemoBroadCaster::getInstance().emit("broadcast,language,changed", nullptr);
	EXPECT_EQ(heard.size(), 2u);
	EXPECT_EQ(MemoBroadCaster::getInstance().getListenerCount(), 0u);
}

} // namespace
