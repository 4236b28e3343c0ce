// The mini controllers on real recorder and player handles: their windows (name, viewer, size in both
// orientations), each button's event, the time parts, the state shown, and the cancel question answered by
// the memo popup companion in its own process.
#include <app_i18n.h>
#include <app_manager.h>
#include <desktop/minicontrol_viewer.h>
#include <vconf.h>

#include <Ecore_Evas.h>

#include <cstdlib>
#include <fstream>
#include <string>
#include <vector>

#include "Recorder/MPlayerLockScreenMiniController.h"
#include "Recorder/MRecorderLockScreenMiniController.h"
#include "Recorder/MRecorderNotiMiniController.h"
#include "Recorder/MplayerNotiMiniController.h"
#include "TestEnv.h"
#include "support/UiTestSupport.h"

namespace
{
const char *const POPUP = "com.veltron.memo-popup";

class MiniControllers : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		setenv("TIZEN_AUDIO_SOURCE", "test", 1);
		setenv("TIZEN_AUDIO_SINK", "fake", 1);
	}

	void SetUp() override
	{
		memo_ui_test::initUi();
		elm_app_base_scale_set(2.6);
		elm_config_scale_set(2.6);
		vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_UNLOCK);
	}

	void TearDown() override
	{
		if (recorder) {
			recorder_cancel(recorder);
			recorder_unprepare(recorder);
			recorder_destroy(recorder);
		}
		if (player)
			player_destroy(player);
		unsetenv("COMPANION_TEST_CLICK");
		elm_config_scale_set(1.0);
	}

	// A recorder in state 3 (recording) on the test source.
	recorder_h startRecorder()
	{
		const std::string path = memo_test::makeTempDir("rec") + "/take.amr";
		EXPECT_EQ(RECORDER_ERROR_NONE, recorder_create_audiorecorder(&recorder));
		recorder_set_filename(recorder, path.c_str());
		EXPECT_EQ(RECORDER_ERROR_NONE, recorder_prepare(recorder));
		EXPECT_EQ(RECORDER_ERROR_NONE, recorder_start(recorder));
		return recorder;
	}

	// A player in state 3 (playing) on ten seconds of silence.
	player_h startPlayer()
	{
		const std::string path = memo_test::makeTempDir("play") + "/silence.wav";
		const uint32_t rate = 8000, bytes = rate * 2 * 10;
		std::ofstream f(path, std::ios::binary);
		auto u32 = [&](uint32_t v) { f.write(reinterpret_cast<const char *>(&v), 4); };
		auto u16 = [&](uint16_t v) { f.write(reinterpret_cast<const char *>(&v), 2); };
		f << "RIFF";
		u32(36 + bytes);
		f << "WAVEfmt ";
		u32(16), u16(1), u16(1), u32(rate), u32(rate * 2), u16(2), u16(16);
		f << "data";
		u32(bytes);
		f << std::string(bytes, '\0');
		f.close();
		EXPECT_EQ(PLAYER_ERROR_NONE, player_create(&player));
		player_set_uri(player, path.c_str());
		EXPECT_EQ(PLAYER_ERROR_NONE, player_prepare(player));
		EXPECT_EQ(PLAYER_ERROR_NONE, player_start(player));
		return player;
	}

	void listen(app_assist::WSignal<void(const char *, const char *)> &signal)
	{
		signal.addListener([this](const char *event, const char *) { events.push_back(event); });
	}

	// Lays the controller's canvas out with its theme signals applied.
	static void settle(Evas_Object *layout)
	{
		Evas *e = evas_object_evas_get(layout);
		for (int i = 0; i < 3; i++) {
			edje_object_message_signal_process(elm_layout_edje_get(layout));
			evas_smart_objects_calculate(e);
			// Events find objects by the clip state a render computes.
			ecore_evas_manual_render(ecore_evas_ecore_evas_get(e));
		}
	}

	static std::string stateOf(Evas_Object *layout, const char *part)
	{
		settle(layout);
		const char *state = edje_object_part_state_get(elm_layout_edje_get(layout), part, nullptr);
		return state ? state : "";
	}

	// A press and release on the middle of the part, in the controller's own window.
	static void tapPart(Evas_Object *layout, const char *part)
	{
		settle(layout);
		Evas_Object *obj = const_cast<Evas_Object *>(edje_object_part_object_get(elm_layout_edje_get(layout), part));
		ASSERT_NE(nullptr, obj) << part;
		int x, y, w, h;
		evas_object_geometry_get(obj, &x, &y, &w, &h);
		Evas *e = evas_object_evas_get(layout);
		static unsigned int ts = 1000;
		evas_event_feed_mouse_move(e, x + w / 2, y + h / 2, ts++, nullptr);
		evas_event_feed_mouse_down(e, 1, EVAS_BUTTON_NONE, ts++, nullptr);
		evas_event_feed_mouse_up(e, 1, EVAS_BUTTON_NONE, ts++, nullptr);
	}

	static void expectSize(Evas_Object *win, int width, int height)
	{
		int w = 0, h = 0;
		evas_object_geometry_get(win, nullptr, nullptr, &w, &h);
		EXPECT_EQ(width, w);
		EXPECT_EQ(height, h);
	}

	static bool popupRunning()
	{
		bool running = false;
		app_manager_is_running(POPUP, &running);
		return running;
	}

	recorder_h recorder = nullptr;
	player_h player = nullptr;
	std::vector<std::string> events;
};

typedef std::vector<std::string> Events;
} // namespace

TEST_F(MiniControllers, RecorderNotificationWindowButtonsTimeAndRotation)
{
	MRecorderNotiMiniController mini(startRecorder());
	EXPECT_EQ(&mini, gRecorderNotiMiniController);
	listen(mini._signal);
	mini.create();
	ASSERT_EQ(mini._win, minicontrol_viewer_window_find("memorecorder_mini_controller"));
	EXPECT_EQ(MINICONTROL_TARGET_VIEWER_QUICK_PANEL, minicontrol_viewer_target_get(mini._win));
	EXPECT_TRUE(evas_object_visible_get(mini._win));
	expectSize(mini._win, 720, 172);
	EXPECT_STREQ(i18n_get_text("IDS_MEMO_BODY_RECORDING_ING_M_AUDIO"),
	             elm_object_part_text_get(mini._layout, "recorder_status_text"));
	EXPECT_EQ("hidden", stateOf(mini._layout, "recorder_resume_btn"));

	// The pause and resume buttons keep their crossed event names.
	tapPart(mini._layout, "recorder_pause_btn");
	recorder_pause(recorder);
	mini.update();
	EXPECT_EQ("hidden", stateOf(mini._layout, "recorder_pause_btn"));
	EXPECT_STREQ(i18n_get_text("IDS_MEMO_BODY_PAUSED_M_STATUS"),
	             elm_object_part_text_get(mini._layout, "recorder_status_text"));
	tapPart(mini._layout, "recorder_resume_btn");
	tapPart(mini._layout, "recorder_stop_btn");
	EXPECT_EQ((Events{"recorder,resumed", "recorder,paused", "recorder,stopped"}), events);

	mini.setTime("59:59");
	EXPECT_STREQ("59:59", elm_object_part_text_get(mini._layout, "recorder_time"));
	mini.setTimeHour("01:00:00");
	EXPECT_STREQ("01:00:00", elm_object_part_text_get(mini._layout, "recorder_time_hour"));
	EXPECT_STREQ("", elm_object_part_text_get(mini._layout, "recorder_time"));

	// Landscape takes the screen's height as width; the same angle again resizes nothing.
	minicontrol_viewer_angle_report(90);
	ASSERT_TRUE(memo_test::pump(3, [&] { return mini._rotation == 90; }));
	expectSize(mini._win, 1280, 172);
	EXPECT_EQ("default", stateOf(mini._layout, "recorder_resume_btn"));
	evas_object_resize(mini._win, 300, 172);
	minicontrol_viewer_angle_report(90);
	memo_test::pumpFor(0.1);
	expectSize(mini._win, 300, 172);

	mini.hide();
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("memorecorder_mini_controller"));
	EXPECT_EQ(nullptr, mini._xEventHandler);
}

TEST_F(MiniControllers, RecorderCancelIsConfirmedByTheMemoPopup)
{
	MRecorderNotiMiniController mini(startRecorder());
	listen(mini._signal);
	mini.create();

	// Refused: the window comes back and the recording goes on.
	setenv("COMPANION_TEST_CLICK", "Keep recording", 1);
	tapPart(mini._layout, "recorder_cancel_btn");
	EXPECT_FALSE(evas_object_visible_get(mini._win));
	ASSERT_NE(nullptr, mini._popupRequest);
	ASSERT_TRUE(memo_test::pump(20, [&] { return evas_object_visible_get(mini._win); }));
	EXPECT_EQ(nullptr, mini._popupRequest);
	EXPECT_TRUE(events.empty());
	ASSERT_TRUE(memo_test::pump(10, [] { return !popupRunning(); }));

	// Closed by the platform: the window stays hidden.
	unsetenv("COMPANION_TEST_CLICK");
	tapPart(mini._layout, "recorder_cancel_btn");
	ASSERT_TRUE(memo_test::pump(10, popupRunning));
	app_control_h end = nullptr;
	app_control_create(&end);
	app_control_set_app_id(end, POPUP);
	app_control_send_terminate_request(end);
	app_control_destroy(end);
	ASSERT_TRUE(memo_test::pump(10, [&] { return !mini._popupRequest && !popupRunning(); }));
	EXPECT_FALSE(evas_object_visible_get(mini._win));
	EXPECT_TRUE(events.empty());

	// The viewer's hide request asks too; confirmed, the recording is cancelled.
	evas_object_show(mini._win);
	setenv("COMPANION_TEST_CLICK", "Discard", 1);
	minicontrol_viewer_event_send(mini._win, MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE, nullptr);
	EXPECT_FALSE(evas_object_visible_get(mini._win));
	ASSERT_TRUE(memo_test::pump(20, [&] { return !events.empty(); }));
	EXPECT_EQ(Events{"recorder,canceled"}, events);
	EXPECT_FALSE(evas_object_visible_get(mini._win));
	memo_test::pump(10, [] { return !popupRunning(); });
}

TEST_F(MiniControllers, RecorderLockScreenShowsWhileLockedWithItsButtons)
{
	MRecorderLockScreenMiniController mini(startRecorder());
	listen(mini._signal);
	mini.create();
	ASSERT_EQ(mini._win, minicontrol_viewer_window_find("memo-minicontrol.LOCKSCREEN"));
	EXPECT_EQ(MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN, minicontrol_viewer_target_get(mini._win));
	int screen = 0;
	elm_win_screen_size_get(mini._win, nullptr, nullptr, &screen, nullptr);
	// Scaled and truncated: 2.6 * 234 / 2.6 falls just short of 234.
	expectSize(mini._win, screen ? screen : 720, static_cast<int>(2.6 * 234 / 2.6));
	EXPECT_FALSE(evas_object_visible_get(mini._win));
	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_LOCK);
	ASSERT_TRUE(memo_test::pump(5, [&] { return evas_object_visible_get(mini._win); }));

	EXPECT_STREQ(i18n_get_text("IDS_MEMO_BODY_RECORDING_ING_M_AUDIO"),
	             elm_object_part_text_get(mini._layout, "recorder_status_text"));
	tapPart(mini._layout, "recorder_pause_btn");
	recorder_pause(recorder);
	mini.update();
	EXPECT_EQ("default", stateOf(mini._layout, "recorder_resume_btn"));
	tapPart(mini._layout, "recorder_resume_btn");
	tapPart(mini._layout, "recorder_left_btn_bg");
	EXPECT_EQ((Events{"recorder,paused", "recorder,paused", "recorder,stopped"}), events);
	mini.setTime("01:02:03");
	EXPECT_STREQ("01:02:03", elm_object_part_text_get(mini._layout, "recorder_time"));

	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_UNLOCK);
	ASSERT_TRUE(memo_test::pump(5, [&] { return !evas_object_visible_get(mini._win); }));
	mini.hide();
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("memo-minicontrol.LOCKSCREEN"));
}

TEST_F(MiniControllers, PlayerControllersToggleCancelAndShowThePosition)
{
	startPlayer();
	{
		MplayerNotiMiniController mini(player);
		listen(mini._signal);
		mini.create();
		EXPECT_EQ(&mini, gPlayerNotiMiniController);
		ASSERT_EQ(mini._win, minicontrol_viewer_window_find("memoplayer_mini_controller"));
		EXPECT_EQ(MINICONTROL_TARGET_VIEWER_QUICK_PANEL, minicontrol_viewer_target_get(mini._win));
		expectSize(mini._win, 720, 172);
		EXPECT_EQ("hidden", stateOf(mini._layout, "play_glyph"));
		tapPart(mini._layout, "recorder_pause_resume_btn");
		tapPart(mini._layout, "recorder_cancel_btn");
		minicontrol_viewer_event_send(mini._win, MINICONTROL_PROVIDER_EVENT_REQUEST_HIDE, nullptr);
		EXPECT_EQ((Events{"player,pausedResumed", "player,canceled", "player,canceled"}), events);
		EXPECT_TRUE(evas_object_visible_get(mini._win));
		mini.setTime("12:34");
		mini.setTimeHour("01:00:00");
		EXPECT_STREQ("01:00:00", elm_object_part_text_get(mini._layout, "player_time_hour"));
		EXPECT_STREQ("", elm_object_part_text_get(mini._layout, "player_time"));
		minicontrol_viewer_angle_report(270);
		ASSERT_TRUE(memo_test::pump(3, [&] { return mini._rotation == 270; }));
		expectSize(mini._win, 1280, 172);
		player_pause(player);
		mini.update();
		EXPECT_EQ("default", stateOf(mini._layout, "play_glyph"));
	}
	EXPECT_EQ(nullptr, gPlayerNotiMiniController);

	events.clear();
	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_LOCK);
	MPlayerLockScreenMiniController lock(player);
	listen(lock._signal);
	lock.create();
	ASSERT_EQ(lock._win, minicontrol_viewer_window_find("memo-minicontrol.LOCKSCREEN"));
	EXPECT_EQ(MINICONTROL_TARGET_VIEWER_STOCK_LOCK_SCREEN, minicontrol_viewer_target_get(lock._win));
	EXPECT_TRUE(evas_object_visible_get(lock._win));
	EXPECT_EQ("default", stateOf(lock._layout, "play_glyph"));
	tapPart(lock._layout, "recorder_pause_play_btn");
	EXPECT_EQ(Events{"player,pausedResumed"}, events);
	lock.setTime("00:07");
	EXPECT_STREQ("00:07", elm_object_part_text_get(lock._layout, "play_time"));
	player_start(player);
	lock.update();
	EXPECT_EQ("hidden", stateOf(lock._layout, "play_glyph"));
}
