// Theme tables: colour and text classes from the table files, per-object colours, and re-applying on key changes.
#include <efl_assist.h>
#include <uxt_theme.h>
#include <vconf.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
const std::string kColorTable = TEST_SOURCE_DIR "/tests/platform/data/uxt_color_table.xml";
const std::string kFontTable = TEST_SOURCE_DIR "/tests/platform/data/uxt_font_table.xml";

struct Rgba {
	int r = -1, g = -1, b = -1, a = -1;
};

Rgba globalColor(const char *code)
{
	Rgba c;
	int o[8];
	if (!edje_color_class_get(code, &c.r, &c.g, &c.b, &c.a, &o[0], &o[1], &o[2], &o[3], &o[4], &o[5], &o[6], &o[7]))
		return Rgba();
	return c;
}

void changedCb(void *event_info, void *data)
{
	static_cast<std::vector<intptr_t> *>(data)->push_back(reinterpret_cast<intptr_t>(event_info));
}

class UxtTheme : public ::testing::Test
{
protected:
	void SetUp() override
	{
		memo_test::initElementary();
		vconf_set_int(VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT, 0);
		vconf_set_int(VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_SIZE, 1);
		colors = uxt_theme_add_color_table(kColorTable.c_str());
		fonts = uxt_theme_add_font_table(kFontTable.c_str());
		ASSERT_NE(nullptr, colors);
		ASSERT_NE(nullptr, fonts);
	}

	void TearDown() override
	{
		uxt_theme_delete_changed_callback(UXT_THEME_CHANGED_TYPE_COLOR, changedCb);
		uxt_theme_delete_changed_callback(UXT_THEME_CHANGED_TYPE_FONT, changedCb);
		uxt_theme_set_changeable_ui_enabled(EINA_FALSE);
		uxt_theme_delete_color_table(colors);
		uxt_theme_delete_font_table(fonts);
	}

	Uxt_Theme_Color_Table *colors = nullptr;
	Uxt_Theme_Font_Table *fonts = nullptr;
	std::vector<intptr_t> changes;
};

TEST_F(UxtTheme, ColorTableSetsColourClassesThatObjectsReportBack)
{
	ASSERT_EQ(UXT_ERROR_NONE, uxt_theme_set_color_table(colors));
	Rgba light = globalColor("UXT_TEST_B011");
	EXPECT_EQ(250, light.r);
	EXPECT_EQ(255, light.a);

	Evas_Object *win = memo_test::addShownWindow("uxt-test");
	Evas_Object *layout = elm_layout_add(win);
	elm_layout_theme_set(layout, "layout", "application", "default");
	int r, g, b, a, r2, g2, b2, a2, r3, g3, b3, a3;
	ASSERT_TRUE(
	    ea_theme_object_color_get(layout, "UXT_TEST_T022", &r, &g, &b, &a, &r2, &g2, &b2, &a2, &r3, &g3, &b3, &a3));
	EXPECT_EQ((std::vector<int>{10, 20, 30, 200, 1, 2, 3, 4, 5, 6, 7, 8}),
	          (std::vector<int>{r, g, b, a, r2, g2, b2, a2, r3, g3, b3, a3}));
	// An unknown class is not found.
	EXPECT_FALSE(ea_theme_object_color_get(layout, "UXT_TEST_NONE", &r, &g, &b, &a, nullptr, nullptr, nullptr, nullptr,
	                                       nullptr, nullptr, nullptr, nullptr));
	// An entry without a red channel is skipped.
	EXPECT_EQ(-1, globalColor("UXT_TEST_BROKEN").r);

	// Replacing a colour on one object leaves the process-wide class alone.
	ASSERT_EQ(UXT_ERROR_NONE, uxt_theme_object_replace_color(layout, "UXT_TEST_B011", "UXT_TEST_T022"));
	ASSERT_TRUE(ea_theme_object_color_get(layout, "UXT_TEST_B011", &r, &g, &b, &a, nullptr, nullptr, nullptr, nullptr,
	                                      nullptr, nullptr, nullptr, nullptr));
	EXPECT_EQ(10, r);
	EXPECT_EQ(250, globalColor("UXT_TEST_B011").r);
	evas_object_del(win);

	// Missing table files, and tables of the other kind, are refused.
	EXPECT_EQ(nullptr, uxt_theme_add_color_table("/nonexistent/table.xml"));
	EXPECT_EQ(nullptr, uxt_theme_add_color_table(kFontTable.c_str()));
	EXPECT_EQ(nullptr, uxt_theme_add_font_table(kColorTable.c_str()));
}

TEST_F(UxtTheme, KeyChangesReapplyTheTablesAndFireTheirCallbacksUntilRemoved)
{
	ASSERT_EQ(UXT_ERROR_NONE, uxt_theme_set_changeable_ui_enabled(EINA_TRUE));
	ASSERT_EQ(UXT_ERROR_NONE, uxt_theme_set_color_table(colors));
	ASSERT_EQ(UXT_ERROR_NONE, uxt_theme_set_font_table(fonts));
	for (auto type : {UXT_THEME_CHANGED_TYPE_COLOR, UXT_THEME_CHANGED_TYPE_FONT})
		ASSERT_EQ(UXT_ERROR_NONE, uxt_theme_add_changed_callback(type, changedCb, &changes));
	EXPECT_EQ(250, globalColor("UXT_TEST_B011").r);
	const char *font = nullptr;
	Evas_Font_Size size = 0;
	ASSERT_TRUE(edje_text_class_get("UXT_TEST_T011", &font, &size));
	EXPECT_STREQ("Sans:style=Bold", font);
	EXPECT_EQ(40, size);
	EXPECT_FALSE(edje_text_class_get("UXT_TEST_NOSIZE", &font, &size));

	vconf_set_int(VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT, 1);
	ASSERT_TRUE(memo_test::pump(5.0, [this] { return changes.size() == 1; }));
	EXPECT_EQ(UXT_THEME_CHANGED_TYPE_COLOR, changes[0]);
	Rgba dark = globalColor("UXT_TEST_B011");
	EXPECT_EQ(20, dark.r);
	EXPECT_EQ(255, dark.a);
	vconf_set_int(VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_SIZE, 3);
	ASSERT_TRUE(memo_test::pump(5.0, [this] { return changes.size() == 2; }));
	EXPECT_EQ(UXT_THEME_CHANGED_TYPE_FONT, changes[1]);
	ASSERT_TRUE(edje_text_class_get("UXT_TEST_T011", &font, &size));
	EXPECT_EQ(60, size);
	ASSERT_TRUE(edje_text_class_get("UXT_TEST_T012", &font, &size));
	EXPECT_STREQ("Serif:style=Regular", font);
	EXPECT_EQ(30, size);

	// Once removed, a callback hears nothing more.
	ASSERT_EQ(UXT_ERROR_NONE, uxt_theme_delete_changed_callback(UXT_THEME_CHANGED_TYPE_COLOR, changedCb));
	EXPECT_EQ(UXT_ERROR_NO_DATA, uxt_theme_delete_changed_callback(UXT_THEME_CHANGED_TYPE_COLOR, changedCb));
	vconf_set_int(VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT, 0);
	ASSERT_TRUE(memo_test::pump(5.0, [] { return globalColor("UXT_TEST_B011").r == 250; }));
	EXPECT_EQ(2u, changes.size());
}
} // namespace
