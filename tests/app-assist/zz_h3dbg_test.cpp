#include "support/AppAssistFixture.h"
#include "TestEnv.h"
#include "WMenuPopupController.h"
using namespace app_assist;
class Dbg : public aa_test::UiTest { protected: std::vector<std::string> log; };
TEST_F(Dbg, X) {
	aa_test::LoggingPage *page = new aa_test::LoggingPage("A", &log); naviframe->push(page);
	WMenuPopupController *menu = new WMenuPopupController();
	ASSERT_TRUE(menu->createMenu(window->getEvasObj(), naviframe->getEvasObj()));
	int picked = 0;
	menu->appendItem("first", [&] { picked++; });
	menu->showMenu();
	page->attachPopup(menu);
	WViewControllerWeakPtr weak = menu->getWeakPtr();
	runFor(0.5);
	Elm_Object_Item *item = (Elm_Object_Item *)eina_list_data_get(elm_ctxpopup_items_get(menu->getEvasObj()));
	elm_ctxpopup_item_selected_set(item, EINA_TRUE);
	printf("picked after select_set %d\n", picked);
	runFor(1.0);
	printf("picked %d expired %d\n", picked, (int)weak.expired());
	if (!weak.expired()) { evas_object_smart_callback_call(menu->getEvasObj(), "dismissed", nullptr); printf("expired after dismissed %d\n", (int)weak.expired()); }
}
