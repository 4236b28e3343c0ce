// Controllers living and dying with their objects: views, popups, menus, timers, gengrid items.
#include <string>
#include <vector>

#include "WGengridItem.h"
#include "WMenuPopupController.h"
#include "WPopupController.h"
#include "WUiTimer.h"
#include "support/AppAssistFixture.h"

using aa_test::LoggingPage;
using app_assist::WGengridItem;
using app_assist::WMenuPopupController;
using app_assist::WPopupController;
using app_assist::WUiTimer;
using app_assist::WViewControllerWeakPtr;
using Log = std::vector<std::string>;

namespace
{

class ViewControllerTest : public aa_test::UiTest
{
protected:
	// A popup with the given buttons, attached to page.
	WPopupController *attachPopup(LoggingPage *page, std::function<void(bool *)> first,
	                              std::function<void(bool *)> second = nullptr)
	{
		WPopupController *popup = new WPopupController();
		popup->setTextTranslatable("app-assist-test");
		popup->setTitle("IDS_TITLE");
		popup->setContent("IDS_TEXT");
		popup->addButton("IDS_CANCEL", first);
		popup->addButton("IDS_OK", second);
		EXPECT_TRUE(page->attachPopup(popup));
		return popup;
	}
	static void click(WPopupController *popup, const char *part)
	{
		evas_object_smart_callback_call(elm_object_part_content_get(popup->getEvasObj(), part), "clicked", nullptr);
	}
	// Opens a menu with the given items on page and selects the item at index.
	WViewControllerWeakPtr selectInMenu(LoggingPage *page,
	                                    std::vector<std::pair<const char *, std::function<void()>>> items, int index)
	{
		WMenuPopupController *menu = new WMenuPopupController();
		EXPECT_TRUE(menu->createMenu(window->getEvasObj(), naviframe->getEvasObj()));
		for (auto &item : items)
			EXPECT_TRUE(menu->appendItem(item.first, item.second));
		EXPECT_TRUE(menu->showMenu());
		EXPECT_TRUE(page->attachPopup(menu));
		const Eina_List *elmItems = elm_ctxpopup_items_get(menu->getEvasObj());
		EXPECT_EQ(eina_list_count(elmItems), items.size());
		Elm_Object_Item *item = static_cast<Elm_Object_Item *>(eina_list_nth(elmItems, index));
		EXPECT_STREQ(elm_object_item_text_get(item), items[index].first);
		WViewControllerWeakPtr weak = menu->getWeakPtr();
		elm_ctxpopup_item_selected_set(item, EINA_TRUE);
		return weak;
	}
};

TEST_F(ViewControllerTest, ControllerDiesWithItsObjectAndItsWeakPointerEmpties)
{
	LoggingPage *page = pushPage("A");
	WViewControllerWeakPtr weak = page->getWeakPtr();
	ASSERT_EQ(weak.lock().get(), page);
	evas_object_del(page->getEvasObj());
	EXPECT_TRUE(weak.expired());
	EXPECT_EQ(log.back(), "A:destructor");

	// Without an object, destroy deletes the controller.
	log.clear();
	weak = (new LoggingPage("B", &log))->getWeakPtr();
	weak.lock()->destroy();
	EXPECT_TRUE(weak.expired());
	EXPECT_EQ(log, (Log{"B:constructor", "B:destructor"}));
}

TEST_F(ViewControllerTest, PopupClosesWhenItsButtonSaysSoOrWithItsViewAndIsReplacedByTheNext)
{
	LoggingPage *page = pushPage("A");
	int cancelCalls = 0, okCalls = 0;
	WPopupController *popup = attachPopup(
	    page, [&](bool *) { ++cancelCalls; },
	    [&](bool *close) {
		    ++okCalls;
		    *close = true;
	    });
	WViewControllerWeakPtr weak = popup->getWeakPtr();
	EXPECT_EQ(page->getPopup(), popup);
	click(popup, "button1");
	EXPECT_EQ(cancelCalls, 1);
	EXPECT_FALSE(weak.expired());
	click(popup, "button2");
	EXPECT_EQ(okCalls, 1);
	EXPECT_TRUE(weak.expired());
	EXPECT_EQ(page->getPopup(), nullptr);

	// An empty button function leaves the popup open; the next popup replaces it; the view takes the last along.
	popup = attachPopup(page, nullptr);
	weak = popup->getWeakPtr();
	click(popup, "button1");
	EXPECT_FALSE(weak.expired());
	WViewControllerWeakPtr second = attachPopup(page, nullptr)->getWeakPtr();
	EXPECT_TRUE(weak.expired());
	ASSERT_FALSE(second.expired());
	page->destroy();
	EXPECT_TRUE(second.expired());
}

TEST_F(ViewControllerTest, BackKeyClosesThePopupBeforeThePage)
{
	LoggingPage *a = pushPage("A");
	LoggingPage *b = pushPage("B");
	WViewControllerWeakPtr popup = attachPopup(b, nullptr)->getWeakPtr();
	pressKey("Escape");
	EXPECT_TRUE(popup.expired());
	EXPECT_EQ(naviframe->getTopContentViewController(), b);
	pressKey("Escape");
	ASSERT_TRUE(waitFor([&] { return naviframe->getTopContentViewController() == a; }));
}

TEST_F(ViewControllerTest, MenuRunsTheSelectedItemAndClosesEvenWhenTheItemOpensAPopup)
{
	LoggingPage *page = pushPage("A");
	Log picked;
	WViewControllerWeakPtr menu = selectInMenu(
	    page, {{"first", [&] { picked.push_back("first"); }}, {"second", [&] { picked.push_back("second"); }}}, 1);
	ASSERT_TRUE(waitFor([&] { return menu.expired(); }));
	EXPECT_EQ(picked, (Log{"second"}));

	menu = selectInMenu(page, {{"delete", [&] { attachPopup(page, nullptr); }}}, 0);
	ASSERT_TRUE(waitFor([&] { return menu.expired(); }));
	ASSERT_NE(page->getPopup(), nullptr);
	EXPECT_STREQ(page->getPopup()->getClassName(), "WPopupController");
}

TEST_F(ViewControllerTest, TimersAndIdlersEndWithFalseOrWithTheirOwner)
{
	int ticks = 0;
	WUiTimer::addTimer(
	    0.01, [&](void *data) { return ++*static_cast<int *>(data) < 3; }, &ticks);
	ASSERT_TRUE(waitFor([&] { return ticks == 3; }));

	LoggingPage *page = pushPage("A");
	int ownedTicks = 0;
	auto handle = WUiTimer::addTimer(
	    0.01, [&](void *) { return ++ownedTicks > 0; }, nullptr, page->getEvasObj());
	ASSERT_TRUE(waitFor([&] { return ownedTicks >= 1; }));
	page->destroy();
	EXPECT_TRUE(handle.expired());
	int after = ownedTicks;

	// A deleted timer never runs; deleting it again does nothing.
	int runs = 0;
	handle = WUiTimer::addTimer(
	    0.0, [&](void *) { return ++runs > 0; }, nullptr);
	WUiTimer::deleteTimer(handle);
	EXPECT_TRUE(handle.expired());
	WUiTimer::deleteTimer(handle);

	// An idler that deletes its owner runs once and ends cleanly.
	page = pushPage("B");
	int idlerRuns = 0;
	WUiTimer::addIdler(
	    [&](void *) {
		    ++idlerRuns;
		    page->destroy();
		    return true;
	    },
	    nullptr, page->getEvasObj());
	ASSERT_TRUE(waitFor([&] { return idlerRuns == 1; }));
	runFor(0.05);
	EXPECT_EQ(ticks, 3);
	EXPECT_EQ(ownedTicks, after);
	EXPECT_EQ(runs, 0);
	EXPECT_EQ(idlerRuns, 1);
}

struct CountingItem : WGengridItem {
	explicit CountingItem(int *alive) : __alive(alive) { ++*__alive; }
	~CountingItem() override { --*__alive; }
	int *__alive;
};

TEST_F(ViewControllerTest, GengridItemsDieWithTheirGengridItems)
{
	Evas_Object *grid = elm_gengrid_add(window->getEvasObj());
	int alive = 0;
	for (int i = 0; i < 3; ++i) {
		CountingItem *item = new CountingItem(&alive);
		Elm_Gengrid_Item_Class *itemClass = item->getItemClassNew();
		item->setElmObjectItem(elm_gengrid_item_append(grid, itemClass, item, nullptr, nullptr));
		elm_gengrid_item_class_free(itemClass);
		EXPECT_NE(item->getElmObjectItem(), nullptr);
	}
	EXPECT_EQ(alive, 3);
	elm_object_item_del(elm_gengrid_first_item_get(grid));
	EXPECT_EQ(alive, 2);
	evas_object_del(grid);
	EXPECT_EQ(alive, 0);
}

} // namespace
