// Edit fields, the entry's selection switch and localised date texts.
#include <uxt.h>

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

#include "TestEnv.h"

namespace
{
class UxtWidgets : public ::testing::Test
{
protected:
	void SetUp() override { win = memo_test::addShownWindow("uxt-widgets"); }
	void TearDown() override { evas_object_del(win); }

	Evas_Object *clearButton(Evas_Object *entry)
	{
		Evas_Object *button = elm_object_part_content_get(entry, "elm.swallow.clear");
		return button ? button : elm_object_part_content_get(entry, "end");
	}

	Evas_Object *win = nullptr;
};

TEST_F(UxtWidgets, EditFieldKindsConfigureTheEntryAndTheClearButtonEmptiesIt)
{
	Evas_Object *title = uxt_edit_field_add(win, UXT_EDIT_FIELD_SCROLL_SINGLELINE);
	Evas_Object *password = uxt_edit_field_add(win, UXT_EDIT_FIELD_SCROLL_SINGLELINE_PASSWORD);
	Evas_Object *search = uxt_edit_field_add(win, UXT_EDIT_FIELD_SEARCHBAR);
	Evas_Object *body = uxt_edit_field_add(win, UXT_EDIT_FIELD_MULTILINE);
	ASSERT_TRUE(title && password && search && body);
	EXPECT_TRUE(elm_entry_single_line_get(title));
	EXPECT_TRUE(elm_entry_scrollable_get(title));
	EXPECT_FALSE(elm_entry_password_get(title));
	EXPECT_TRUE(elm_entry_password_get(password));
	EXPECT_EQ(ELM_INPUT_PANEL_RETURN_KEY_TYPE_SEARCH, elm_entry_input_panel_return_key_type_get(search));
	EXPECT_FALSE(elm_entry_single_line_get(body));
	EXPECT_EQ(nullptr, clearButton(body));
	EXPECT_EQ(nullptr, uxt_edit_field_add(win, UXT_EDIT_FIELD_LAST));

	ASSERT_NE(nullptr, clearButton(search));
	elm_entry_entry_set(search, "memo");
	ASSERT_STREQ("memo", elm_entry_entry_get(search));
	evas_object_smart_callback_call(clearButton(search), "clicked", nullptr);
	EXPECT_TRUE(elm_entry_is_empty(search));

	// The drag and auto-scroll switches are flags the desktop only keeps; selection maps to the entry.
	EXPECT_EQ(UXT_ERROR_NONE, uxt_entry_set_selection_enabled(body, EINA_FALSE));
	EXPECT_FALSE(elm_entry_select_allow_get(body));
	EXPECT_EQ(UXT_ERROR_INVALID_PARAMETER, uxt_entry_set_selection_enabled(win, EINA_TRUE)) << "not an entry";
}

std::string dateText(int format, const char *locale, struct tm *time)
{
	char *text = uxt_util_get_date_time_text_by_locale(format, locale, time);
	std::string result = text ? text : "<null>";
	free(text);
	return result;
}

TEST(UxtDateText, TwelveAndTwentyFourHourClocks)
{
	struct tm time = {};
	time.tm_year = 2016 - 1900;
	time.tm_mon = 2;
	time.tm_mday = 7;
	time.tm_hour = 18;
	time.tm_min = 14;
	time.tm_isdst = -1;

	std::string h24 = dateText(0x37, "en_US.UTF-8", &time);
	EXPECT_NE(std::string::npos, h24.find("18:14")) << h24;
	EXPECT_NE(std::string::npos, h24.find("2016")) << h24;

	std::string h12 = dateText(0x77, "en_US.UTF-8", &time);
	EXPECT_NE(std::string::npos, h12.find("6:14")) << h12;
	EXPECT_EQ(std::string::npos, h12.find("18:14")) << h12;
	EXPECT_NE(std::string::npos, h12.find("PM")) << h12;

	// Localised by ICU: Korean marks the afternoon in its own words.
	std::string ko = dateText(0x77, "ko_KR", &time);
	EXPECT_NE(std::string::npos, ko.find("6:14")) << ko;
	EXPECT_NE(std::string::npos, ko.find("\xEC\x98\xA4\xED\x9B\x84")) << ko;
	EXPECT_EQ("<null>", dateText(0x40, "en_US", &time)) << "no such format";
}
} // namespace
