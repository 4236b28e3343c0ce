// Page stack: calling order, becoming top again, popOut, the last page's hook, the back key.
#include <algorithm>
#include <string>
#include <vector>

#include "support/AppAssistFixture.h"

using aa_test::LoggingPage;
using Log = std::vector<std::string>;

namespace
{

using NaviframeTest = aa_test::UiTest;

const Log kPushed = {"constructor", "onCreateView", "onCreated", "onPushed"};

TEST_F(NaviframeTest, PushCallsCreateHooksThenOnPushedAndAFailedCreateLeavesTheStack)
{
	int param = 3;
	LoggingPage *page = new LoggingPage("A", &log);
	ASSERT_TRUE(naviframe->push(page, "PageA", &param));
	EXPECT_EQ(entriesOf("A"), kPushed);
	EXPECT_EQ(page->receivedParam, &param);
	EXPECT_STREQ(page->getName(), "PageA");
	EXPECT_EQ(page->getNaviframeController(), naviframe);
	EXPECT_NE(page->getNaviItem(), nullptr);
	EXPECT_TRUE(naviframe->isTopContentViewController(page));

	EXPECT_FALSE(naviframe->push(new LoggingPage("B", &log, true)));
	EXPECT_EQ(entriesOf("B"), (Log{"constructor", "onCreateView", "destructor"}));
	EXPECT_EQ(naviframe->getContentViewCount(), 1);
	EXPECT_EQ(naviframe->getTopContentViewController(), page);
}

TEST_F(NaviframeTest, PoppingThePageAboveMakesTheLowerOneTopAgain)
{
	LoggingPage *a = pushPage("A");
	pushPage("B");
	pressKey("Escape");
	ASSERT_TRUE(waitFor([&] { return hasEntry("B:destructor") && hasEntry("A:onBecomeTop"); }));
	EXPECT_EQ(entriesOf("B"),
	          (Log{"constructor", "onCreateView", "onCreated", "onPushed", "onPop", "onDestroy", "destructor"}));
	EXPECT_EQ(entriesOf("A"), (Log{"constructor", "onCreateView", "onCreated", "onPushed", "onBecomeTop"}));
	EXPECT_EQ(naviframe->getTopContentViewController(), a);

	// A second round, by popOut and by destroying the page: A comes back on top each time.
	for (int round = 2; round <= 3; ++round) {
		LoggingPage *c = pushPage("C");
		if (round == 2) {
			c->popOut();
		} else {
			c->destroy();
			EXPECT_EQ(log.back(), "C:destructor");
		}
		ASSERT_TRUE(waitFor([&] {
			Log aEntries = entriesOf("A");
			return std::count(aEntries.begin(), aEntries.end(), "onBecomeTop") == round;
		}));
		EXPECT_EQ(naviframe->getTopContentViewController(), a);
		EXPECT_EQ(naviframe->getContentViewCount(), 1);
	}
}

TEST_F(NaviframeTest, PopOutOfAPageBelowTheTopRemovesOnlyIt)
{
	pushPage("A");
	LoggingPage *b = pushPage("B");
	LoggingPage *c = pushPage("C");
	b->popOut();
	ASSERT_TRUE(waitFor([&] { return hasEntry("B:destructor"); }));
	settle();
	EXPECT_EQ(naviframe->getTopContentViewController(), c);
	EXPECT_EQ(naviframe->getContentViewCount(), 2);
	EXPECT_FALSE(hasEntry("C:onBecomeTop"));
	EXPECT_FALSE(hasEntry("A:onBecomeTop"));
	Log bEntries = entriesOf("B");
	EXPECT_EQ(Log(bEntries.end() - 3, bEntries.end()), (Log{"onPop", "onDestroy", "destructor"}));
}

TEST_F(NaviframeTest, LastPageHookDecidesWhetherThePopGoesOn)
{
	LoggingPage *a = pushPage("A");
	int hookCalls = 0;
	naviframe->setOnLastItemPop([&](bool *popGoesOn) {
		++hookCalls;
		*popGoesOn = false;
	});
	// Not asked for a page above the last.
	pushPage("B");
	pressKey("Escape");
	ASSERT_TRUE(waitFor([&] { return hasEntry("B:destructor") && hasEntry("A:onBecomeTop"); }));
	EXPECT_EQ(hookCalls, 0);

	pressKey("Escape");
	ASSERT_TRUE(waitFor([&] { return hookCalls == 1; }));
	settle();
	EXPECT_EQ(naviframe->getTopContentViewController(), a);
	EXPECT_FALSE(hasEntry("A:onPop"));

	naviframe->setOnLastItemPop([&](bool *popGoesOn) {
		++hookCalls;
		EXPECT_TRUE(*popGoesOn);
	});
	a->popOut();
	ASSERT_TRUE(waitFor([&] { return hasEntry("A:destructor"); }));
	EXPECT_EQ(hookCalls, 2);
	EXPECT_EQ(naviframe->getTopContentViewController(), nullptr);
	EXPECT_EQ(naviframe->getContentViewCount(), 0);
}

TEST_F(NaviframeTest, WindowTeardownEndsEveryPageAndMoreReachesTheTop)
{
	LoggingPage *a = pushPage("A");
	int moreCalls = 0;
	a->setMoreButton(
	    a->getNaviItem(), [](void *data, Evas_Object *, void *) { ++*static_cast<int *>(data); }, &moreCalls);
	pressKey("Menu");
	EXPECT_EQ(moreCalls, 1);

	pushPage("B");
	delete window;
	window = nullptr;
	for (const char *tag : {"A", "B"}) {
		Log entries = entriesOf(tag);
		ASSERT_GE(entries.size(), 3u);
		EXPECT_EQ(Log(entries.end() - 3, entries.end()), (Log{"onPop", "onDestroy", "destructor"})) << tag;
	}
}

} // namespace
