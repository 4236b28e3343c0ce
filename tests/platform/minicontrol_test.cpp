// Minicontrol windows: real windows placed by their viewer, the lock screen's seen only while locked, viewer
// events (hide request, rotation) reaching the provider.
#include <Ecore_X.h>
#include <Elementary.h>
#include <desktop/minicontrol_viewer.h>
#include <minicontrol-provider.h>
#include <vconf.h>

#include <gtest/gtest.h>

#include <vector>

#include "TestEnv.h"

namespace
{
std::vector<int> gEvents;
std::vector<long> gAngles;

void eventCb(minicontrol_viewer_event_e event, bundle *)
{
	gEvents.push_back(event);
}

Eina_Bool clientMessageCb(void *, int, void *event)
{
	auto *ev = static_cast<Ecore_X_Event_Client_Message *>(event);
	if (ev->message_type == ECORE_X_ATOM_E_ILLUME_ROTATE_ROOT_ANGLE)
		gAngles.push_back(ev->data.l[0]);
	return ECORE_CALLBACK_PASS_ON;
}

class Minicontrol : public ::testing::Test
{
protected:
	void SetUp() override
	{
		memo_test::initElementary();
		gEvents.clear();
		gAngles.clear();
		vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_UNLOCK);
	}
};
} // namespace

TEST_F(Minicontrol, PanelWindowIsDockedAtTheTopAndHidesOnRequest)
{
	EXPECT_EQ(nullptr, minicontrol_create_window("", MINICONTROL_TARGET_VIEWER_QUICK_PANEL, eventCb));
	EXPECT_EQ(MINICONTROL_ERROR_INVALID_PARAMETER, get_last_result());
	Evas_Object *win = minicontrol_create_window("test_panel", MINICONTROL_TARGET_VIEWER_QUICK_PANEL, eventCb);
	ASSERT_NE(nullptr, win);
	EXPECT_EQ(win, minicontrol_viewer_window_find("test_panel"));
	EXPECT_EQ(MINICONTROL_TARGET_VIEWER_QUICK_PANEL, minicontrol_viewer_target_get(win));
	EXPECT_STREQ("test_panel", elm_win_title_get(win));
	EXPECT_TRUE(elm_win_borderless_get(win));
	EXPECT_FALSE(evas_object_visible_get(win));

	evas_object_resize(win, 200, 60);
	evas_object_show(win);
	EXPECT_TRUE(evas_object_visible_get(win));
	int x = -1, y = -1, sx = 0, sw = 0;
	evas_object_geometry_get(win, &x, &y, nullptr, nullptr);
	elm_win_screen_size_get(win, &sx, nullptr, &sw, nullptr);
	EXPECT_EQ(0, y);
	EXPECT_EQ(sw > 200 ? sx + (sw - 200) / 2 : sx, x);

	EXPECT_EQ(MINICONTROL_ERROR_NONE, minicontrol_send_event(win, MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE, nullptr));
	EXPECT_FALSE(evas_object_visible_get(win));
	Evas_Object *plain = elm_win_add(nullptr, "plain", ELM_WIN_BASIC);
	EXPECT_EQ(MINICONTROL_ERROR_INVALID_PARAMETER,
	          minicontrol_send_event(plain, MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE, nullptr));
	EXPECT_EQ(MINICONTROL_ERROR_INVALID_PARAMETER, minicontrol_viewer_event_send(plain, 100, nullptr));
	evas_object_del(plain);

	// The user closing it is the viewer's hide request.
	evas_object_smart_callback_call(win, "delete,request", nullptr);
	EXPECT_EQ(std::vector<int>{MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE}, gEvents);
	evas_object_del(win);
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("test_panel"));
}

TEST_F(Minicontrol, LockScreenWindowShowsOnlyWhileLocked)
{
	Evas_Object *win =
	    minicontrol_create_window("test.LOCKSCREEN", MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN, nullptr);
	ASSERT_NE(nullptr, win);
	evas_object_resize(win, 200, 90);
	evas_object_show(win);
	EXPECT_TRUE(minicontrol_viewer_shown_by_provider(win));
	EXPECT_FALSE(evas_object_visible_get(win));

	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_LOCK);
	ASSERT_TRUE(memo_test::pump(5, [&] { return evas_object_visible_get(win); }));
	int y = -1, sy = 0, sh = 0;
	evas_object_geometry_get(win, nullptr, &y, nullptr, nullptr);
	elm_win_screen_size_get(win, nullptr, &sy, nullptr, &sh);
	EXPECT_EQ(sh > 90 ? sy + sh - 90 : sy, y);

	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_UNLOCK);
	ASSERT_TRUE(memo_test::pump(5, [&] { return !evas_object_visible_get(win); }));
	EXPECT_TRUE(minicontrol_viewer_shown_by_provider(win));

	// Hidden by the provider, it stays hidden when the screen locks again.
	EXPECT_EQ(MINICONTROL_ERROR_NONE, minicontrol_send_event(win, MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE, nullptr));
	EXPECT_FALSE(minicontrol_viewer_shown_by_provider(win));
	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_LOCK);
	memo_test::pumpFor(0.3);
	EXPECT_FALSE(evas_object_visible_get(win));
	evas_object_show(win);
	EXPECT_TRUE(evas_object_visible_get(win));
	evas_object_del(win);
}

TEST_F(Minicontrol, RotationReachesProvidersAsClientMessageAndReport)
{
	Evas_Object *win = minicontrol_create_window("test_rotation", MINICONTROL_TARGET_VIEWER_QUICK_PANEL, eventCb);
	ASSERT_NE(nullptr, win);
	Ecore_Event_Handler *handler = ecore_event_handler_add(ECORE_X_EVENT_CLIENT_MESSAGE, clientMessageCb, nullptr);
	ASSERT_NE(nullptr, handler);

	minicontrol_viewer_angle_report(90);
	EXPECT_EQ(std::vector<int>{MINICONTROL_VIEWER_EVENT_REPORT_ANGLE}, gEvents);
	ASSERT_TRUE(memo_test::pump(2, [] { return !gAngles.empty(); }));
	EXPECT_EQ(90, gAngles[0]);

	// The device's rotation key is what turns the viewers.
	vconf_set_int("memory/desktop/rotation", 270);
	ASSERT_TRUE(memo_test::pump(5, [] { return gAngles.size() >= 2; }));
	EXPECT_EQ(270, gAngles[1]);
	vconf_set_int("memory/desktop/rotation", 0);
	ASSERT_TRUE(memo_test::pump(5, [] { return gAngles.size() >= 3; }));

	ecore_event_handler_del(handler);
	evas_object_del(win);
}
