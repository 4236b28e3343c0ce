// The attach panel: one per conformant, the categories a desktop offers, picks capped by the count in the
// extra data, visibility, and the docked file selector.
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
	app_control_result_e code = APP_CONTROL_RESULT_FAILED;
	std::vector<std::string> selected;
	std::vector<std::string> paths;
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
	pick->calls++;
	pick->category = category;
	pick->code = code;
	pick->selected = arrayOf(result, APP_CONTROL_DATA_SELECTED);
	pick->paths = arrayOf(result, APP_CONTROL_DATA_PATH);
}

class AttachPanel : public ::testing::Test
{
protected:
	void SetUp() override
	{
		win = memo_test::addShownWindow("attach-panel");
		conformant = elm_conformant_add(win);
		evas_object_resize(conformant, 480, 800);
		evas_object_show(conformant);
	}
	void TearDown() override
	{
		unsetenv("TIZEN_ATTACH_PANEL_AUTOSELECT");
		evas_object_del(win);
	}

	Evas_Object *win = nullptr;
	Evas_Object *conformant = nullptr;
};
} // namespace

TEST_F(AttachPanel, OnePanelPerConformantOfferingWhatADesktopHas)
{
	attach_panel_h panel = nullptr, second = nullptr;
	ASSERT_EQ(ATTACH_PANEL_ERROR_NONE, attach_panel_create(conformant, &panel));
	EXPECT_EQ(ATTACH_PANEL_ERROR_ALREADY_EXISTS, attach_panel_create(conformant, &second));
	EXPECT_EQ(ATTACH_PANEL_ERROR_INVALID_PARAMETER, attach_panel_create(nullptr, &second));

	EXPECT_EQ(ATTACH_PANEL_ERROR_NONE,
	          attach_panel_add_content_category(panel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, nullptr));
	EXPECT_EQ(ATTACH_PANEL_ERROR_ALREADY_EXISTS,
	          attach_panel_add_content_category(panel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, nullptr));
	EXPECT_EQ(ATTACH_PANEL_ERROR_UNSUPPORTED_CONTENT_CATEGORY,
	          attach_panel_add_content_category(panel, ATTACH_PANEL_CONTENT_CATEGORY_CAMERA, nullptr));
	bundle *extra = bundle_create();
	EXPECT_EQ(ATTACH_PANEL_ERROR_INVALID_PARAMETER,
	          attach_panel_set_extra_data(panel, ATTACH_PANEL_CONTENT_CATEGORY_VIDEO, extra));
	bundle_free(extra);

	// The docked selector shows and hides with the panel.
	bool visible = true;
	attach_panel_get_visibility(panel, &visible);
	EXPECT_FALSE(visible);
	EXPECT_EQ(ATTACH_PANEL_ERROR_NONE, attach_panel_show(panel));
	attach_panel_get_visibility(panel, &visible);
	EXPECT_TRUE(visible);
	attach_panel_hide(panel);
	attach_panel_get_visibility(panel, &visible);
	EXPECT_FALSE(visible);

	// Gone with its panel, the conformant takes a new one.
	EXPECT_EQ(ATTACH_PANEL_ERROR_NONE, attach_panel_destroy(panel));
	ASSERT_EQ(ATTACH_PANEL_ERROR_NONE, attach_panel_create(conformant, &second));
	attach_panel_destroy(second);
}

TEST_F(AttachPanel, APickReachesTheResultCallbackCappedByTheCountOfTheExtraData)
{
	attach_panel_h panel = nullptr;
	ASSERT_EQ(ATTACH_PANEL_ERROR_NONE, attach_panel_create(conformant, &panel));
	bundle *room = bundle_create();
	bundle_add_str(room, APP_CONTROL_DATA_TOTAL_COUNT, "2");
	attach_panel_add_content_category(panel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, room);
	bundle_free(room);
	Pick pick;
	attach_panel_set_result_cb(panel, resultCb, &pick);
	setenv("TIZEN_ATTACH_PANEL_AUTOSELECT", "/p/a.jpg:/p/b.png:/p/c.jpg", 1);

	attach_panel_show(panel);
	EXPECT_EQ(0, pick.calls); // the pick comes after the call
	ASSERT_TRUE(memo_test::pump(2.0, [&] { return pick.calls == 1; }));
	EXPECT_EQ(ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, pick.category);
	EXPECT_EQ(APP_CONTROL_RESULT_SUCCEEDED, pick.code);
	EXPECT_EQ((std::vector<std::string>{"/p/a.jpg", "/p/b.png"}), pick.selected);
	EXPECT_EQ(pick.selected, pick.paths);

	// New room, and no callback once it is unset.
	room = bundle_create();
	bundle_add_str(room, "max-count", "1");
	attach_panel_set_extra_data(panel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, room);
	bundle_free(room);
	attach_panel_show(panel);
	ASSERT_TRUE(memo_test::pump(2.0, [&] { return pick.calls == 2; }));
	EXPECT_EQ((std::vector<std::string>{"/p/a.jpg"}), pick.selected);
	attach_panel_unset_result_cb(panel);
	attach_panel_show(panel);
	memo_test::pumpFor(0.1);
	EXPECT_EQ(2, pick.calls);
	attach_panel_destroy(panel);
}
