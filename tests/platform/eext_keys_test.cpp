// Hardware key routing: which object takes back and more, and survival of deletion inside a callback.
#include <efl_extension.h>
#include <gtest/gtest.h>

#include "TestEnv.h"

#include <cstdint>
#include <string>
#include <vector>

namespace
{
struct Hits {
	std::vector<std::string> names;
	std::vector<intptr_t> types;
};

struct Tag {
	Hits *hits;
	const char *name;
};

void recordCb(void *data, Evas_Object *, void *event_info)
{
	auto *tag = static_cast<Tag *>(data);
	tag->hits->names.push_back(tag->name);
	tag->hits->types.push_back(reinterpret_cast<intptr_t>(event_info));
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
	static void SetUpTestSuite() { elm_init(0, nullptr); }

	void SetUp() override
	{
		win = elm_win_add(nullptr, "eext-test", ELM_WIN_BASIC);
		evas_object_resize(win, 480, 800);
		evas_object_show(win);
		evas = evas_object_evas_get(win);
		// The window shows its content on the first render; keys come after that.
		Evas_Object *probe = evas_object_rectangle_add(evas);
		elm_win_resize_object_add(win, probe);
		evas_object_show(probe);
		ASSERT_TRUE(memo_test::pump(5.0, [probe] { return shownWithParents(probe); }));
		evas_object_del(probe);
	}

	static bool shownWithParents(Evas_Object *obj)
	{
		for (Evas_Object *o = obj; o; o = evas_object_smart_parent_get(o)) {
			if (!evas_object_visible_get(o))
				return false;
		}
		return true;
	}

	void TearDown() override { evas_object_del(win); }

	void press(const char *key)
	{
		evas_event_feed_key_down(evas, key, key, key, nullptr, 0, nullptr);
		evas_event_feed_key_up(evas, key, key, key, nullptr, 0, nullptr);
	}

	Evas_Object *addNaviframe()
	{
		Evas_Object *nf = elm_naviframe_add(win);
		evas_object_size_hint_weight_set(nf, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
		elm_win_resize_object_add(win, nf);
		evas_object_show(nf);
		return nf;
	}

	Evas_Object *win = nullptr;
	Evas *evas = nullptr;
	Hits hits;
};

TEST_F(EextKeys, PopupOverNaviframeTakesBackAloneThenNaviframeGetsIt)
{
	Evas_Object *nf = addNaviframe();
	Tag nfTag{&hits, "naviframe"};
	eext_object_event_callback_add(nf, EEXT_CALLBACK_BACK, recordCb, &nfTag);

	Evas_Object *popup = elm_popup_add(win);
	elm_object_text_set(popup, "hello");
	evas_object_show(popup);
	Tag popupTag{&hits, "popup"};
	eext_object_event_callback_add(popup, EEXT_CALLBACK_BACK, recordCb, &popupTag);

	press("Escape");
	ASSERT_EQ(std::vector<std::string>{"popup"}, hits.names);
	EXPECT_EQ(EEXT_CALLBACK_BACK, hits.types[0]);

	evas_object_hide(popup);
	press("XF86Back");
	EXPECT_EQ((std::vector<std::string>{"popup", "naviframe"}), hits.names);

	// Only key release counts.
	evas_event_feed_key_down(evas, "XF86Stop", "XF86Stop", "", nullptr, 0, nullptr);
	EXPECT_EQ(2u, hits.names.size());
	evas_event_feed_key_up(evas, "XF86Stop", "XF86Stop", "", nullptr, 0, nullptr);
	EXPECT_EQ(3u, hits.names.size());
}

TEST_F(EextKeys, MoreIsNotBack)
{
	Evas_Object *nf = addNaviframe();
	Tag moreTag{&hits, "more"};
	eext_object_event_callback_add(nf, EEXT_CALLBACK_MORE, recordCb, &moreTag);

	press("Escape");
	press("Return");
	EXPECT_TRUE(hits.names.empty());

	press("Menu");
	press("F2");
	press("XF86Menu");
	ASSERT_EQ(3u, hits.names.size());
	EXPECT_EQ(EEXT_CALLBACK_MORE, hits.types[2]);

	EXPECT_EQ(&moreTag, eext_object_event_callback_del(nf, EEXT_CALLBACK_MORE, recordCb));
	press("Menu");
	EXPECT_EQ(3u, hits.names.size());
}

TEST_F(EextKeys, HigherLayerWinsOverStacking)
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
	eext_object_event_callback_add(high, EEXT_CALLBACK_BACK, recordCb, &highTag);

	press("Escape");
	EXPECT_EQ(std::vector<std::string>{"high"}, hits.names);
}

TEST_F(EextKeys, DeepestObjectWinsOverItsContainer)
{
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
	EXPECT_EQ((std::vector<std::string>{"entry", "layout"}), hits.names);
}

TEST_F(EextKeys, DeletingTheObjectInsideItsCallbackIsSafe)
{
	Evas_Object *nf = addNaviframe();
	Tag nfTag{&hits, "naviframe"};
	eext_object_event_callback_add(nf, EEXT_CALLBACK_BACK, recordCb, &nfTag);

	Evas_Object *popup = elm_popup_add(win);
	evas_object_show(popup);
	evas_object_event_callback_add(popup, EVAS_CALLBACK_DEL, clearPointerCb, &popup);
	Tag first{&hits, "first"}, second{&hits, "second"};
	eext_object_event_callback_add(popup, EEXT_CALLBACK_BACK, deleteSelfCb, &first);
	eext_object_event_callback_add(popup, EEXT_CALLBACK_BACK, recordCb, &second);

	press("Escape");
	EXPECT_EQ(nullptr, popup);
	EXPECT_EQ(std::vector<std::string>{"first"}, hits.names);
	press("Escape");
	EXPECT_EQ((std::vector<std::string>{"first", "naviframe"}), hits.names);
}

TEST_F(EextKeys, StockHandlersPopAndDelete)
{
	Evas_Object *nf = addNaviframe();
	elm_naviframe_item_push(nf, "one", nullptr, nullptr, elm_label_add(nf), nullptr);
	bool pushed = false;
	evas_object_smart_callback_add(
	    nf, "transition,finished", [](void *data, Evas_Object *, void *) { *static_cast<bool *>(data) = true; },
	    &pushed);
	elm_naviframe_item_push(nf, "two", nullptr, nullptr, elm_label_add(nf), nullptr);
	ASSERT_TRUE(memo_test::pump(5.0, [&pushed] { return pushed; }));
	eext_object_event_callback_add(nf, EEXT_CALLBACK_BACK, eext_naviframe_back_cb, nullptr);
	press("Escape");
	// The pop finishes after its transition.
	EXPECT_TRUE(
	    memo_test::pump(5.0, [nf] { return elm_naviframe_bottom_item_get(nf) == elm_naviframe_top_item_get(nf); }));

	Evas_Object *popup = elm_popup_add(win);
	evas_object_show(popup);
	evas_object_event_callback_add(popup, EVAS_CALLBACK_DEL, clearPointerCb, &popup);
	eext_object_event_callback_add(popup, EEXT_CALLBACK_BACK, eext_popup_back_cb, nullptr);
	press("Escape");
	EXPECT_EQ(nullptr, popup);
}

TEST_F(EextKeys, ToolkitBindingsNeverSeeTheKeys)
{
	// Elementary binds Escape on a focused naviframe to a pop of its own: the press must pop nothing
	// beyond what the handler does.
	ecore_evas_focus_set(ecore_evas_ecore_evas_get(evas), EINA_TRUE);
	Evas_Object *nf = addNaviframe();
	Evas_Object *button = elm_button_add(nf);
	elm_naviframe_item_push(nf, "one", nullptr, nullptr, elm_button_add(nf), nullptr);
	elm_naviframe_item_push(nf, "two", nullptr, nullptr, button, nullptr);
	ASSERT_TRUE(memo_test::pump(5.0, [this] { return elm_win_focus_get(win); }));
	elm_object_focus_set(button, EINA_TRUE);
	memo_test::pumpFor(0.3);
	Tag nfTag{&hits, "naviframe"};
	eext_object_event_callback_add(nf, EEXT_CALLBACK_BACK, recordCb, &nfTag);

	press("Escape");
	memo_test::pumpFor(0.3);
	EXPECT_EQ(std::vector<std::string>{"naviframe"}, hits.names);
	EXPECT_NE(elm_naviframe_bottom_item_get(nf), elm_naviframe_top_item_get(nf));
}

TEST_F(EextKeys, NullArgumentsAreRejected)
{
	eext_object_event_callback_add(nullptr, EEXT_CALLBACK_BACK, recordCb, nullptr);
	eext_object_event_callback_add(win, EEXT_CALLBACK_LAST, recordCb, nullptr);
	eext_object_event_callback_add(win, EEXT_CALLBACK_BACK, nullptr, nullptr);
	EXPECT_EQ(nullptr, eext_object_event_callback_del(nullptr, EEXT_CALLBACK_BACK, recordCb));
	EXPECT_EQ(nullptr, eext_object_event_callback_del(win, EEXT_CALLBACK_BACK, recordCb));
	press("Escape");
	EXPECT_TRUE(hits.names.empty());
	EXPECT_EQ(nullptr, eext_floatingbutton_add(nullptr));
	EXPECT_FALSE(eext_floatingbutton_pos_set(win, EEXT_FLOATINGBUTTON_LEFT));
}

TEST_F(EextKeys, FloatingButtonBothSidesAllowsOnlyLeftAndRight)
{
	Evas_Object *fb = eext_floatingbutton_add(win);
	ASSERT_NE(nullptr, fb);
	Evas_Object *button = elm_button_add(fb);
	elm_object_part_content_set(fb, "button1", button);
	EXPECT_EQ(button, elm_object_part_content_get(fb, "button1"));
	EXPECT_EQ(EEXT_FLOATINGBUTTON_RIGHT, eext_floatingbutton_pos_get(fb));

	EXPECT_TRUE(eext_floatingbutton_pos_set(fb, EEXT_FLOATINGBUTTON_CENTER));
	eext_floatingbutton_mode_set(fb, EEXT_FLOATINGBUTTON_MODE_BOTH_SIDES);
	EXPECT_EQ(EEXT_FLOATINGBUTTON_RIGHT, eext_floatingbutton_pos_get(fb));
	EXPECT_FALSE(eext_floatingbutton_pos_set(fb, EEXT_FLOATINGBUTTON_CENTER));
	EXPECT_TRUE(eext_floatingbutton_pos_set(fb, EEXT_FLOATINGBUTTON_LEFT));

	// The stop really moves the button: left sits left of right.
	evas_object_resize(fb, 480, 800);
	evas_object_show(fb);
	edje_object_message_signal_process(elm_layout_edje_get(fb));
	edje_object_calc_force(elm_layout_edje_get(fb));
	Evas_Coord leftX;
	evas_object_geometry_get(button, &leftX, nullptr, nullptr, nullptr);
	EXPECT_TRUE(eext_floatingbutton_pos_set(fb, EEXT_FLOATINGBUTTON_RIGHT));
	edje_object_calc_force(elm_layout_edje_get(fb));
	Evas_Coord rightX;
	evas_object_geometry_get(button, &rightX, nullptr, nullptr, nullptr);
	EXPECT_LT(leftX, rightX);
}
} // namespace
