// The attach panel: one per conformant, the categories a desktop offers, picks capped by the count in the
// extra data, visibility, and a conformant that goes first.
#include <Elementary.h>
#include <attach_panel.h>

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
struct Pick {
	int calls = 0;
	attach_panel_content_category_e category = (attach_panel_content_category_e)0;
	std::vector<std::string> selected, paths;
};

std::vector<std::string> arrayOf(app_control_h result, const char *key)
{
	char **values = nullptr;
	int n = 0;
	std::vector<std::string> out;
	app_control_get_extra_data_array(result, key, &values, &n);
	for (int i = 0; i < n; i++) {
		out.push_back(values[i]);
		free(values[i]);
	}
	free(values);
	return out;
}

void resultCb(attach_panel_h, attach_panel_content_category_e category, app_control_h result, app_control_result_e code,
              void *data)
{
	Pick *pick = static_cast<Pick *>(data);
	pick->calls += code == APP_CONTROL_RESULT_SUCCEEDED;
	pick->category = category;
	pick->selected = arrayOf(result, APP_CONTROL_DATA_SELECTED);
	pick->paths = arrayOf(result, APP_CONTROL_DATA_PATH);
}

bool isVisible(attach_panel_h panel)
{
	bool visible = false;
	attach_panel_get_visibility(panel, &visible);
	return visible;
}
} // namespace

TEST(AttachPanel, PicksReachTheCallbackCappedByTheExtraDataOnePanelPerConformant)
{
	Evas_Object *win = memo_test::addShownWindow("attach-panel");
	Evas_Object *conformant = elm_conformant_add(win);
	evas_object_resize(conformant, 480, 800);
	attach_panel_h panel = nullptr, second = nullptr;
	ASSERT_EQ(ATTACH_PANEL_ERROR_NONE, attach_panel_create(conformant, &panel));
	EXPECT_EQ(ATTACH_PANEL_ERROR_ALREADY_EXISTS, attach_panel_create(conformant, &second));
	EXPECT_EQ(ATTACH_PANEL_ERROR_UNSUPPORTED_CONTENT_CATEGORY,
	          attach_panel_add_content_category(panel, ATTACH_PANEL_CONTENT_CATEGORY_CAMERA, nullptr));
	bundle *room = bundle_create();
	bundle_add_str(room, APP_CONTROL_DATA_TOTAL_COUNT, "2");
	EXPECT_EQ(ATTACH_PANEL_ERROR_NONE,
	          attach_panel_add_content_category(panel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, room));
	EXPECT_EQ(ATTACH_PANEL_ERROR_ALREADY_EXISTS,
	          attach_panel_add_content_category(panel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, room));
	bundle_free(room);

	// The docked selector shows and hides with the panel.
	attach_panel_show(panel);
	EXPECT_TRUE(isVisible(panel));
	attach_panel_hide(panel);
	EXPECT_FALSE(isVisible(panel));

	// A pick comes after the call, capped by the room the app gave.
	Pick pick;
	attach_panel_set_result_cb(panel, resultCb, &pick);
	setenv("TIZEN_ATTACH_PANEL_AUTOSELECT", "/p/a.jpg:/p/b.png:/p/c.jpg", 1);
	attach_panel_show(panel);
	EXPECT_EQ(0, pick.calls);
	ASSERT_TRUE(memo_test::pump(2.0, [&] { return pick.calls == 1; }));
	EXPECT_EQ(ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, pick.category);
	EXPECT_EQ((std::vector<std::string>{"/p/a.jpg", "/p/b.png"}), pick.selected);
	EXPECT_EQ(pick.selected, pick.paths);
	room = bundle_create();
	bundle_add_str(room, "max-count", "1");
	attach_panel_set_extra_data(panel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, room);
	bundle_free(room);
	attach_panel_show(panel);
	ASSERT_TRUE(memo_test::pump(2.0, [&] { return pick.calls == 2; }));
	EXPECT_EQ((std::vector<std::string>{"/p/a.jpg"}), pick.selected);
	unsetenv("TIZEN_ATTACH_PANEL_AUTOSELECT");

	// The window may close first: the panel stays usable to its end.
	evas_object_del(conformant);
	EXPECT_EQ(ATTACH_PANEL_ERROR_ALREADY_DESTROYED, attach_panel_show(panel));
	EXPECT_EQ(ATTACH_PANEL_ERROR_NONE, attach_panel_destroy(panel));
	evas_object_del(win);
}
