// The popup monitor with real popups: it answers for the last popup registered, and only while it exists.
#include <gtest/gtest.h>

#include <Elementary.h>

#include <WPopupController.h>

#include "Model/MemoPopupMonitor.h"
#include "TestEnv.h"

using app_assist::WPopupController;

namespace
{

class PopupMonitorTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		static char arg0[] = "popup-monitor-test";
		static char *argv[] = {arg0, nullptr};
		elm_init(1, argv);
	}

	void SetUp() override
	{
		win = elm_win_add(nullptr, "popup-monitor-test", ELM_WIN_BASIC);
		ASSERT_NE(win, nullptr);
		evas_object_resize(win, 480, 800);
		evas_object_show(win);
	}

	void TearDown() override
	{
		MemoPopupMonitor::destroy();
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

TEST_F(PopupMonitorTest, nothingTrackedAndNullInputChangeNothing)
{
	MemoPopupMonitor *monitor = MemoPopupMonitor::getInstance();
	EXPECT_FALSE(monitor->isPopupAlive());
	EXPECT_EQ(monitor->getPopup(), nullptr);

	WPopupController *popup = openPopup("first");
	monitor->addPopup(popup);
	monitor->addPopup(nullptr);
	EXPECT_TRUE(monitor->isPopupAlive());
	EXPECT_EQ(monitor->getPopup(), popup);
	popup->destroy();
}

TEST_F(PopupMonitorTest, popupClosedOnItsOwnIsNotAlive)
{
	MemoPopupMonitor *monitor = MemoPopupMonitor::getInstance();
	WPopupController *popup = openPopup("closes by itself");
	monitor->addPopup(popup);
	ASSERT_TRUE(monitor->isPopupAlive());

	// Gone without a word to the monitor, as when the back key or a button closes it.
	evas_object_del(popup->getEvasObj());
	memo_test::pumpFor(0.02);

	EXPECT_FALSE(monitor->isPopupAlive());
	EXPECT_EQ(monitor->getPopup(), nullptr);
}

TEST_F(PopupMonitorTest, twoPopupsInTurnOnlyTheLastCounts)
{
	MemoPopupMonitor *monitor = MemoPopupMonitor::getInstance();
	WPopupController *first = openPopup("first");
	WPopupController *second = openPopup("second");
	monitor->addPopup(first);
	monitor->addPopup(second);
	EXPECT_EQ(monitor->getPopup(), second);

	second->destroy();
	memo_test::pumpFor(0.02);
	// The first one still stands, but the monitor has forgotten it.
	EXPECT_NE(first->getEvasObj(), nullptr);
	EXPECT_FALSE(monitor->isPopupAlive());
	EXPECT_EQ(monitor->getPopup(), nullptr);

	monitor->addPopup(first);
	EXPECT_TRUE(monitor->isPopupAlive());
	first->destroy();
	memo_test::pumpFor(0.02);
	EXPECT_FALSE(monitor->isPopupAlive());
}

TEST_F(PopupMonitorTest, destroyForgetsThePopup)
{
	WPopupController *popup = openPopup("kept");
	MemoPopupMonitor::getInstance()->addPopup(popup);
	MemoPopupMonitor::destroy();
	EXPECT_FALSE(MemoPopupMonitor::getInstance()->isPopupAlive());
	popup->destroy();
}

} // namespace
