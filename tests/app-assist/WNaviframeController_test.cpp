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

TEST_F(NaviframeTest, PushCallsCreateHooksThenOnPushedWithTheParam)
{
	int param = 3;
	LoggingPage *page = new LoggingPage("A", &log);
	ASSERT_TRUE(naviframe->push(page, "PageA", &param));
	EXPECT_EQ(entriesOf("A"), (Log{"constructor", "onCreateView", "onCreated", "onPushed"}));
	EXPECT_EQ(page->receivedParam, &param);
	EXPECT_STREQ(page->getName(), "PageA");
	EXPECT_EQ(page->getNaviframeController(), naviframe);
	EXPECT_NE(page->getNaviItem(), nullptr);
	EXPECT_TRUE(naviframe->isTopContentViewController(page));
	EXPECT_EQ(naviframe->getContentViewCount(), 1);
}

TEST_F(NaviframeTest, FailedCreateLeavesTheStackAsItWas)
{
	LoggingPage *bottom = pushPage("A");
	EXPECT_FALSE(naviframe->push(new LoggingPage("B", &log, true)));
	EXPECT_EQ(entriesOf("B"), (Log{"constructor", "onCreateView", "destructor"}));
	EXPECT_EQ(naviframe->getContentViewCount(), 1);
	EXPECT_EQ(naviframe->getTopContentViewController(), bottom);
}

TEST_F(NaviframeTest, PoppingThePageAboveMakesTheLowerOneTopAgain)
{
	LoggingPage *a = pushPage("A");
	LoggingPage *b = pushPage("B");
	EXPECT_EQ(naviframe->getTopContentViewController(), b);
	pressKey("Escape");
	ASSERT_TRUE(waitFor([&] { return hasEntry("B:destructor") && hasEntry("A:onBecomeTop"); }));
	EXPECT_EQ(entriesOf("B"),
	          (Log{"constructor", "onCreateView", "onCreated", "onPushed", "onPop", "onDestroy", "destructor"}));
	EXPECT_EQ(entriesOf("A"), (Log{"constructor", "onCreateView", "onCreated", "onPushed", "onBecomeTop"}));
	EXPECT_EQ(naviframe->getTopContentViewController(), a);

	// A second round: a page pushed and popped again brings A back on top once more.
	pushPage("C");
	naviframe->getTopContentViewController()->popOut();
	ASSERT_TRUE(waitFor([&] { return hasEntry("C:destructor"); }));
	runFor(0.05);
	Log aEntries = entriesOf("A");
	EXPECT_EQ(std::count(aEntries.begin(), aEntries.end(), "onBecomeTop"), 2);
}

TEST_F(NaviframeTest, PopOutOfAPageBelowTheTopRemovesOnlyIt)
{
	pushPage("A");
	LoggingPage *b = pushPage("B");
	LoggingPage *c = pushPage("C");
	b->popOut();
	ASSERT_TRUE(waitFor([&] { return hasEntry("B:destructor"); }));
	runFor(0.05);
	EXPECT_EQ(naviframe->getTopContentViewController(), c);
	EXPECT_EQ(naviframe->getContentViewCount(), 2);
	EXPECT_FALSE(hasEntry("C:onBecomeTop"));
	EXPECT_FALSE(hasEntry("A:onBecomeTop"));
	Log bEntries = entriesOf("B");
	EXPECT_EQ(Log(bEntries.end() - 3, bEntries.end()), (Log{"onPop", "onDestroy", "destructor"}));
}

TEST_F(NaviframeTest, DestroyingAPageObjectTakesItsItemAlong)
{
	LoggingPage *a = pushPage("A");
	pushPage("B");
	naviframe->getTopContentViewController()->destroy();
	EXPECT_EQ(entriesOf("B").back(), "destructor");
	ASSERT_TRUE(waitFor([&] { return hasEntry("A:onBecomeTop"); }));
	EXPECT_EQ(naviframe->getTopContentViewController(), a);
	EXPECT_EQ(naviframe->getContentViewCount(), 1);
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
	runFor(0.3);
	EXPECT_EQ(hookCalls, 1);
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

TEST_F(NaviframeTest, WindowTeardownEndsEveryPage)
{
	pushPage("A");
	pushPage("B");
	delete window;
	window = nullptr;
	for (const char *tag : {"A", "B"}) {
		Log entries = entriesOf(tag);
		ASSERT_GE(entries.size(), 3u);
		EXPECT_EQ(Log(entries.end() - 3, entries.end()), (Log{"onPop", "onDestroy", "destructor"})) << tag;
	}
}

TEST_F(NaviframeTest, MoreKeyReachesTheTopPage)
{
	LoggingPage *a = pushPage("A");
	int moreCalls = 0;
	a->setMoreButton(
	    a->getNaviItem(), [](void *data, Evas_Object *, void *) { ++*static_cast<int *>(data); }, &moreCalls);
	pressKey("Menu");
	EXPECT_EQ(moreCalls, 1);
	EXPECT_EQ(naviframe->getTopContentViewController(), a);
}

} // namespace
