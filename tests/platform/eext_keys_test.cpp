// Hardware key routing: which object takes back and more, and survival of deletion inside a callback.
#include <efl_extension.h>
#include <gtest/gtest.h>

#include "TestEnv.h"

#include <cstdint>
#include <string>
#include <vector>

namespace
{
using Hits = std::vector<std::string>;

// Who heard which key: the name for back, "<name>+more" for more.
struct Tag {
	Hits *hits;
	const char *name;
};

void recordCb(void *data, Evas_Object *, void *event_info)
{
	auto *tag = static_cast<Tag *>(data);
	intptr_t type = reinterpret_cast<intptr_t>(event_info);
	tag->hits->push_back(tag->name + std::string(type == EEXT_CALLBACK_BACK   ? ""
	                                             : type == EEXT_CALLBACK_MORE ? "+more"
	                                                                          : "+?"));
}

void deleteSelfCb(void *data, Evas_Object *obj, void *event_info)
{
	recordCb(data, obj, event_info);
	evas_object_del(obj);
}

void unregisterSelfCb(void *data, Evas_Object *obj, void *event_info)
{
	recordCb(data, obj, event_info);
	eext_object_event_callback_del(obj, EEXT_CALLBACK_BACK, unregisterSelfCb);
}

void clearPointerCb(void *data, Evas *, Evas_Object *, void *)
{
	*static_cast<Evas_Object **>(data) = nullptr;
}

class EextKeys : public ::testing::Test
{
protected:
	void SetUp() override
	{
		win = memo_test::addShownWindow("eext-test");
		evas = evas_object_evas_get(win);
		nf = elm_naviframe_add(win);
		evas_object_size_hint_weight_set(nf, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
		elm_win_resize_object_add(win, nf);
		evas_object_show(nf);
	}

	void TearDown() override { evas_object_del(win); }

	void press(const char *key)
	{
		evas_event_feed_key_down(evas, key, key, key, nullptr, 0, nullptr);
		evas_event_feed_key_up(evas, key, key, key, nullptr, 0, nullptr);
	}

	Evas_Object *addPopup(Evas_Object **clearedOnDelete = nullptr)
	{
		Evas_Object *popup = elm_popup_add(win);
		evas_object_show(popup);
		if (clearedOnDelete) {
			*clearedOnDelete = popup;
			evas_object_event_callback_add(popup, EVAS_CALLBACK_DEL, clearPointerCb, clearedOnDelete);
		}
		return popup;
	}

	Evas_Object *win = nullptr, *nf = nullptr;
	Evas *evas = nullptr;
	Hits hits;
	Tag nfTag{&hits, "naviframe"};
};

TEST_F(EextKeys, BackAndMoreKeysReachTheTopmostHandlerOnReleaseWhichMayDeleteItself)
{
	eext_object_event_callback_add(nf, EEXT_CALLBACK_BACK, recordCb, &nfTag);
	eext_object_event_callback_add(nf, EEXT_CALLBACK_MORE, recordCb, &nfTag);
	Evas_Object *popup = addPopup();
	Tag popupTag{&hits, "popup"};
	eext_object_event_callback_add(popup, EEXT_CALLBACK_BACK, recordCb, &popupTag);

	press("Escape");
	press("Return");
	EXPECT_EQ(Hits{"popup"}, hits);
	evas_object_hide(popup);
	press("XF86Back");
	// Only key release counts.
	evas_event_feed_key_down(evas, "XF86Stop", "XF86Stop", "", nullptr, 0, nullptr);
	EXPECT_EQ(2u, hits.size());
	evas_event_feed_key_up(evas, "XF86Stop", "XF86Stop", "", nullptr, 0, nullptr);
	for (const char *key : {"Menu", "F2", "XF86Menu"})
		press(key);
	EXPECT_EQ((Hits{"popup", "naviframe", "naviframe", "naviframe+more", "naviframe+more", "naviframe+more"}), hits);

	EXPECT_EQ(&nfTag, eext_object_event_callback_del(nf, EEXT_CALLBACK_MORE, recordCb));
	press("Menu");
	EXPECT_EQ(6u, hits.size());

	// Deleting the object inside its callback is safe; the handlers behind on it are not called.
	Evas_Object *doomed = nullptr;
	addPopup(&doomed);
	Tag first{&hits, "first"}, second{&hits, "second"};
	eext_object_event_callback_add(doomed, EEXT_CALLBACK_BACK, deleteSelfCb, &first);
	eext_object_event_callback_add(doomed, EEXT_CALLBACK_BACK, recordCb, &second);
	hits.clear();
	press("Escape");
	EXPECT_EQ(nullptr, doomed);
	press("Escape");
	EXPECT_EQ((Hits{"first", "naviframe"}), hits);
}

TEST_F(EextKeys, HigherLayerThenDeepestObjectWins)
{
	Evas_Object *low = evas_object_rectangle_add(evas);
	evas_object_layer_set(low, 5);
	evas_object_show(low);
	Evas_Object *high = evas_object_rectangle_add(evas);
	evas_object_show(high);
	evas_object_layer_set(high, 10);
	evas_object_raise(low);
	Tag lowTag{&hits, "low"}, highTag{&hits, "high"};
	eext_object_event_callback_add(low, EEXT_CALLBACK_BACK, recordCb, &lowTag);
	eext_object_event_callback_add(high, EEXT_CALLBACK_BACK, unregisterSelfCb, &highTag);
	press("Escape");
	EXPECT_EQ(Hits{"high"}, hits);
	evas_object_del(low);

	// A view registers on its layout; a field inside it takes the key first while it holds a handler.
	Evas_Object *layout = elm_box_add(win);
	elm_win_resize_object_add(win, layout);
	evas_object_show(layout);
	Evas_Object *entry = elm_entry_add(layout);
	elm_box_pack_end(layout, entry);
	evas_object_show(entry);
	Tag layoutTag{&hits, "layout"}, entryTag{&hits, "entry"};
	eext_object_event_callback_add(layout, EEXT_CALLBACK_BACK, recordCb, &layoutTag);
	eext_object_event_callback_add(entry, EEXT_CALLBACK_BACK, unregisterSelfCb, &entryTag);
	press("Escape");
	press("Escape");
	EXPECT_EQ((Hits{"high", "entry", "layout"}), hits);
}

TEST_F(EextKeys, ToolkitBindingsNeverSeeTheKeysAndStockHandlersPopAndDelete)
{
	// Elementary binds Escape on a focused naviframe to a pop of its own: the press must pop nothing
	// beyond what the handler does.
	ecore_evas_focus_set(ecore_evas_ecore_evas_get(evas), EINA_TRUE);
	Evas_Object *button = elm_button_add(nf);
	elm_naviframe_item_push(nf, "one", nullptr, nullptr, elm_button_add(nf), nullptr);
	bool pushed = false;
	evas_object_smart_callback_add(
	    nf, "transition,finished", [](void *data, Evas_Object *, void *) { *static_cast<bool *>(data) = true; },
	    &pushed);
	elm_naviframe_item_push(nf, "two", nullptr, nullptr, button, nullptr);
	ASSERT_TRUE(memo_test::pump(5.0, [&] { return pushed && elm_win_focus_get(win); }));
	elm_object_focus_set(button, EINA_TRUE);
	ASSERT_TRUE(memo_test::pump(5.0, [this] { return elm_object_focused_object_get(win) != nullptr; }));
	eext_object_event_callback_add(nf, EEXT_CALLBACK_BACK, recordCb, &nfTag);
	press("Escape");
	EXPECT_EQ(Hits{"naviframe"}, hits);
	EXPECT_NE(elm_naviframe_bottom_item_get(nf), elm_naviframe_top_item_get(nf));

	// The stock handlers: the pop finishes after its transition, the popup goes at once.
	eext_object_event_callback_del(nf, EEXT_CALLBACK_BACK, recordCb);
	eext_object_event_callback_add(nf, EEXT_CALLBACK_BACK, eext_naviframe_back_cb, nullptr);
	press("Escape");
	EXPECT_TRUE(
	    memo_test::pump(5.0, [this] { return elm_naviframe_bottom_item_get(nf) == elm_naviframe_top_item_get(nf); }));
	Evas_Object *popup = nullptr;
	addPopup(&popup);
	eext_object_event_callback_add(popup, EEXT_CALLBACK_BACK, eext_popup_back_cb, nullptr);
	press("Escape");
	EXPECT_EQ(nullptr, popup);
}

TEST_F(EextKeys, FloatingButtonBothSidesAllowsOnlyLeftAndRight)
{
	Evas_Object *fb = eext_floatingbutton_add(win);
	ASSERT_NE(nullptr, fb);
	Evas_Object *button = elm_button_add(fb);
	elm_object_part_content_set(fb, "button1", button);
	EXPECT_EQ(EEXT_FLOATINGBUTTON_RIGHT, eext_floatingbutton_pos_get(fb));

	EXPECT_TRUE(eext_floatingbutton_pos_set(fb, EEXT_FLOATINGBUTTON_CENTER));
	eext_floatingbutton_mode_set(fb, EEXT_FLOATINGBUTTON_MODE_BOTH_SIDES);
	EXPECT_EQ(EEXT_FLOATINGBUTTON_RIGHT, eext_floatingbutton_pos_get(fb));
	EXPECT_FALSE(eext_floatingbutton_pos_set(fb, EEXT_FLOATINGBUTTON_CENTER));

	// The stop really moves the button: left sits left of right.
	evas_object_resize(fb, 480, 800);
	evas_object_show(fb);
	Evas_Coord x[2];
	for (int i = 0; i < 2; ++i) {
		EXPECT_TRUE(eext_floatingbutton_pos_set(fb, i ? EEXT_FLOATINGBUTTON_RIGHT : EEXT_FLOATINGBUTTON_LEFT));
		edje_object_message_signal_process(elm_layout_edje_get(fb));
		edje_object_calc_force(elm_layout_edje_get(fb));
		evas_object_geometry_get(button, &x[i], nullptr, nullptr, nullptr);
	}
	EXPECT_LT(x[0], x[1]);
}
} // namespace
