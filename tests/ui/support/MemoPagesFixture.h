#ifndef TESTS_UI_SUPPORT_MEMOPAGESFIXTURE_H
#define TESTS_UI_SUPPORT_MEMOPAGESFIXTURE_H

// Scaffolding of the tests of the pages that the list opens (search, selection): the app on the buffer
// engine without the quick memo, the more menu chosen by tapping its row, and the page on top with its grid.

#include <string>
#include <vector>

#include <WNaviframeController.h>
#include <vconf.h>

#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridItem.h"
#include "MemoListFixture.h"
#include "View/MemoListView.h"

namespace memo_ui_test
{

class PagesFixture : public ListViewFixture
{
protected:
	void SetUp() override
	{
		ListViewFixture::SetUp();
		vconf_set_int("db/desktop/csc/feature_92", 0);
	}

	template <class View> View *top() { return dynamic_cast<View *>(naviframe()->getTopContentViewController()); }
	// Taps the row `text` of the list's more menu (the rows of the list inside the menu).
	void chooseMoreMenu(const std::string &text)
	{
		pressKey("F2");
		runFor(0.3);
		app_assist::WViewController *menu = listView()->getPopup();
		const Eina_List *l = nullptr;
		void *row = nullptr;
		EINA_LIST_FOREACH(menu ? elm_list_items_get(elm_object_content_get(menu->getEvasObj())) : nullptr, l, row)
		{
			if (text == elm_object_item_text_get(static_cast<Elm_Object_Item *>(row))) {
				centreAndTap(static_cast<Elm_Object_Item *>(row));
				runFor(0.6);
				return;
			}
		}
		FAIL() << "no menu row " << text;
	}
	// The gengrid in the part "contents" of layout, null when something else shows there.
	static Evas_Object *gridIn(Evas_Object *layout)
	{
		Evas_Object *content = layout ? elm_object_part_content_get(layout, "contents") : nullptr;
		const char *type = content ? elm_object_widget_type_get(content) : nullptr;
		return (type && std::string(type).find("Gengrid") != std::string::npos) ? content : nullptr;
	}
	// The titles of the cards of a grid, in order, as plain text.
	static std::vector<std::string> titlesIn(Evas_Object *grid)
	{
		std::vector<std::string> titles;
		for (Elm_Object_Item *it = grid ? elm_gengrid_first_item_get(grid) : nullptr; it;
		     it = elm_gengrid_item_next_get(it)) {
			auto *card = static_cast<MemoGridItem *>(elm_object_item_data_get(it));
			char *title = elm_entry_markup_to_utf8(card->getDocInfo()->getTitle());
			titles.push_back(title ? title : "");
			free(title);
		}
		return titles;
	}
	// Taps the card at index of a grid, scrolled into view first.
	void tapCardIn(Evas_Object *grid, int index)
	{
		Elm_Object_Item *item = elm_gengrid_first_item_get(grid);
		for (int i = 0; item && i < index; ++i)
			item = elm_gengrid_item_next_get(item);
		ASSERT_NE(nullptr, item);
		elm_gengrid_item_show(item, ELM_GENGRID_ITEM_SCROLLTO_IN);
		centreAndTap(item);
		runFor(0.3);
	}
	void centreAndTap(Elm_Object_Item *item)
	{
		render();
		int x = 0, y = 0;
		centreOf(elm_object_item_track(item), &x, &y);
		elm_object_item_untrack(item);
		tap(x, y);
	}
	// A part of the top page's naviframe item.
	Evas_Object *titleContent(const char *part)
	{
		return elm_object_item_part_content_get(naviframe()->getTopContentViewController()->getNaviItem(), part);
	}
};

} // namespace memo_ui_test

#endif
