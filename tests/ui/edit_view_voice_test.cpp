// Voice memos in the editor, on real pipelines (the test tone for the microphone, a fake sink that plays in
// real time): recording, the one-second rule, calls and limits, the time text, playing, deleting, and the
// indicator.
#include <app_i18n.h>
#include <desktop/minicontrol_viewer.h>
#include <message_port.h>

#include "../platform/media_fixture.h"
#include "DataBase/MemoFileInfo.h"
#include "Recorder/MPlayerLockScreenMiniController.h"
#include "Recorder/MRecorderLockScreenMiniController.h"
#include "Recorder/MRecorderNotiMiniController.h"
#include "Recorder/MemoPlayer.h"
#include "Recorder/MemoRecorder.h"
#include "Recorder/MplayerNotiMiniController.h"
#include "box_control_fixture.h"
#include "support/EditViewAppsFixture.h"

using namespace memo_ui_test;

// What the platform would call, driven by the tests.
struct MemoRecorderTestAccess {
	static int elapsed(MemoRecorder *r) { return r->__elapsedMs; }
	static void status(MemoRecorder *r, unsigned long long ms) { MemoRecorder::__recordingStatusCb(ms, 0, r); }
	static void setTimeLimit(int seconds) { MemoRecorder::__timeLimitSeconds = seconds; }
	static MRecorderNotiMiniController *notiMini(MemoRecorder *r) { return r->__notiMini; }
	static MRecorderLockScreenMiniController *lockMini(MemoRecorder *r) { return r->__lockMini; }
};
struct MemoPlayerTestAccess {
	static player_state_e state(MemoPlayer *p) { return p->__getState(); }
	static MplayerNotiMiniController *notiMini(MemoPlayer *p) { return p->__notiMini; }
	static MPlayerLockScreenMiniController *lockMini(MemoPlayer *p) { return p->__lockMini; }
	// A drag of the slider to `value`, let go there.
	static void drag(MemoPlayer *p, double value)
	{
		Evas_Object *slider = elm_object_part_content_get(p->getEvasObj(), "recorder_slider");
		MemoPlayer::__sliderDragStartCb(p, slider, nullptr);
		elm_slider_value_set(slider, value);
		MemoPlayer::__sliderChangedCb(p, slider, nullptr);
		MemoPlayer::__sliderDragStopCb(p, slider, nullptr);
	}
};

namespace
{
// The discoverer and the platform recorder of the media tests.
struct MediaFiles : MediaTest {
	using MediaTest::durationOf;
	using MediaTest::record;
};

class EditViewVoice : public EditViewAppsFixture
{
protected:
	void SetUp() override
	{
		setenv("TIZEN_AUDIO_SOURCE", "test", 1);
		setenv("TIZEN_AUDIO_SINK", "fake", 1);
		EditViewAppsFixture::SetUp();
		vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
		desktop_toast_log_clear();
	}
	void TearDown() override
	{
		vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
		MemoRecorderTestAccess::setTimeLimit(3600);
		EditViewAppsFixture::TearDown();
	}

	MemoRecorder *recorder() { return MemoEditViewTestAccess::recorder(view); }
	MemoPlayer *player() { return MemoEditViewTestAccess::player(view); }
	void tapPart(app_assist::WViewController *panel, const char *part)
	{
		render();
		tapObject(
		    const_cast<Evas_Object *>(edje_object_part_object_get(elm_layout_edje_get(panel->getEvasObj()), part)));
	}
	std::string text(app_assist::WViewController *panel, const char *part)
	{
		const char *t = elm_object_part_text_get(panel->getEvasObj(), part);
		return t ? t : "";
	}
	bool toasted(const char *id)
	{
		for (int i = 0; i < desktop_toast_log_count(); i++)
			if (!strcmp(desktop_toast_log_get(i), i18n_get_text(id)))
				return true;
		return false;
	}
	bool recordRowOffered()
	{
		std::vector<std::string> rows = openMenu();
		pressKey("Escape");
		settle(0.2);
		return std::find(rows.begin(), rows.end(), i18n_get_text("IDS_MEMO_OPT_RECORD_AUDIO_ABB2")) != rows.end();
	}
	// Opens the recorder from the menu and taps record.
	void startRecording()
	{
		openMenu();
		chooseMenu(i18n_get_text("IDS_MEMO_OPT_RECORD_AUDIO_ABB2"));
		ASSERT_NE(recorder(), nullptr);
		tapPart(recorder(), "recorder_start_btn");
		ASSERT_TRUE(waitFor([] { return MemoUtil::isRecorderBusy(); }));
	}
	void recordUntil(int ms)
	{
		ASSERT_TRUE(waitFor([&] { return MemoRecorderTestAccess::elapsed(recorder()) >= ms; }, 10.0));
	}
	// The .amr files of the memo's media folder.
	std::vector<std::string> voiceFiles()
	{
		std::vector<std::string> files;
		Eina_List *names = ecore_file_ls(mediaDir(MemoEditViewTestAccess::uuid(view)).c_str());
		void *name = nullptr;
		EINA_LIST_FREE(names, name)
		{
			if (strstr(static_cast<char *>(name), ".amr"))
				files.push_back(mediaDir(MemoEditViewTestAccess::uuid(view)) + static_cast<char *>(name));
			free(name);
		}
		return files;
	}
	// At most one voice panel shows in the page.
	int livePanels()
	{
		int live = 0;
		for (app_assist::WViewController *panel : {static_cast<app_assist::WViewController *>(recorder()),
		                                           static_cast<app_assist::WViewController *>(player())})
			live += panel && evas_object_visible_get(panel->getEvasObj());
		return live;
	}

	// Opens a stored memo whose recording of the given length is in its media folder.
	void openStoredVoiceMemo(const char *memo, const char *vr, int ms)
	{
		const std::string file = mediaDir(memo) + vr + ".amr";
		ecore_file_mkpath(mediaDir(memo).c_str());
		ASSERT_TRUE(MediaFiles::record(file, ms));
		MemoDocInfo stored;
		stored.setMemoUUID(memo);
		stored.setTitle("Song");
		stored.setTizenXmlContent(todoList(todoItem(0, false, "hum")).c_str());
		stored.setVrfileUUID(vr);
		ASSERT_TRUE(MemoDbMgr::getInstance()->addMemo(&stored));
		MemoFileInfo row;
		row.setFileUUID(vr);
		row.setMemoUUID(memo);
		row.setPath(file.c_str());
		ASSERT_TRUE(MemoDbMgr::getInstance()->addNewFile(&row));
		records.emplace_back(MemoDbMgr::getInstance()->getOneMemoN(memo));
		view = openRecord(records.back().get());
	}

	MemoEditView *view = nullptr;
};
} // namespace

TEST_F(EditViewVoice, RecordedTakeIsAnAmrFileAndAVoiceRowAtDone)
{
	view = openNew();
	typeInto(items(view)[1], "with a voice");
	EXPECT_TRUE(recordRowOffered());
	startRecording();
	EXPECT_EQ(1, livePanels());
	recordUntil(2000);
	tapPart(recorder(), "recorder_stop_btn");
	ASSERT_TRUE(waitFor([this] { return player() != nullptr; }));
	EXPECT_EQ(1, livePanels());
	EXPECT_FALSE(MemoUtil::isRecorderBusy());
	EXPECT_FALSE(recordRowOffered()); // the memo holds one recording

	ASSERT_EQ(1u, voiceFiles().size());
	EXPECT_EQ("#!AMR\n", memo_test::readFile(voiceFiles()[0]).substr(0, 6));
	EXPECT_NEAR(2.0, MediaFiles::durationOf(voiceFiles()[0]), 0.3);
	EXPECT_EQ("00:02", text(player(), "recorder_totalTime"));

	const std::string file = voiceFiles()[0], folder = mediaDir(MemoEditViewTestAccess::uuid(view));
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	const std::string vr = query("SELECT vrfileUUID FROM memo WHERE isQuick = 0");
	EXPECT_EQ(file, folder + vr + ".amr");
	EXPECT_EQ("audio/amr", query("SELECT mime_type FROM file WHERE UUID = '" + vr + "'"));
}

TEST_F(EditViewVoice, ShortTakesAreDroppedAndPausesJoinInOneFile)
{
	view = openNew();
	typeInto(items(view)[1], "short");
	startRecording();
	tapPart(recorder(), "recorder_stop_btn");
	ASSERT_TRUE(waitFor([this] { return !MemoUtil::isRecorderBusy(); }));
	settle(0.2);
	EXPECT_TRUE(toasted("IDS_MEMO_TPOP_RECORDING_CANCELLED_RECORDING_TOO_SHORT_M_VOICE"));
	EXPECT_TRUE(voiceFiles().empty());
	EXPECT_EQ(0, livePanels());
	EXPECT_TRUE(recordRowOffered());

	// Done under a second: nothing kept, and the editor stays.
	startRecording();
	pressDone(view);
	settle(0.5);
	EXPECT_TRUE(isTop(view));
	EXPECT_TRUE(voiceFiles().empty());

	// Discarding a take of a second or more asks first, while the take runs on.
	startRecording();
	recordUntil(1000);
	tapPart(recorder(), "recorder_cancel_btn");
	settle(0.3);
	ASSERT_TRUE(MemoPopupMonitor::getInstance()->isPopupAlive());
	EXPECT_TRUE(MemoUtil::isRecorderBusy());
	tapObject(popupButton(2));
	settle(0.2);
	EXPECT_FALSE(MemoUtil::isRecorderBusy());
	EXPECT_TRUE(voiceFiles().empty());
	EXPECT_EQ(0, livePanels());

	startRecording();
	recordUntil(1000);
	tapPart(recorder(), "recorder_pause_resume_btn");
	settle(0.2);
	const int paused = MemoRecorderTestAccess::elapsed(recorder());
	settle(0.8);
	EXPECT_EQ(paused, MemoRecorderTestAccess::elapsed(recorder()));
	tapPart(recorder(), "recorder_pause_resume_btn");
	recordUntil(2000);
	tapPart(recorder(), "recorder_stop_btn");
	ASSERT_TRUE(waitFor([this] { return player() != nullptr; }));
	ASSERT_EQ(1u, voiceFiles().size());
	EXPECT_NEAR(2.0, MediaFiles::durationOf(voiceFiles()[0]), 0.3);
	pressDone(view); // still there after the refused one
	EXPECT_TRUE(waitFor([this] { return lastPagePopped; }));
}

TEST_F(EditViewVoice, CallsAndLimitsEndATakeAndKeepIt)
{
	view = openNew();
	typeInto(items(view)[1], "call");
	startRecording();
	recordUntil(1200);
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_ACTIVE);
	ASSERT_TRUE(waitFor([this] { return player() != nullptr; }));
	EXPECT_TRUE(toasted("IDS_MEMO_TPOP_RECORDING_SAVED"));
	EXPECT_EQ(1u, voiceFiles().size());

	// No recording is offered during a call.
	view = openNew();
	EXPECT_FALSE(recordRowOffered());
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
	settle(0.2);

	// A take reaching its limit is saved.
	desktop_toast_log_clear();
	MemoRecorderTestAccess::setTimeLimit(1);
	startRecording();
	ASSERT_TRUE(waitFor([this] { return player() != nullptr; }, 5.0));
	EXPECT_TRUE(toasted("IDS_MEMO_TPOP_RECORDING_SAVED"));
	ASSERT_EQ(1u, voiceFiles().size());
	EXPECT_NEAR(1.0, MediaFiles::durationOf(voiceFiles()[0]), 0.3);
}

TEST_F(EditViewVoice, TimeTextTakesHoursFromSixtyMinutes)
{
	view = openNew();
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_RECORD_AUDIO_ABB2"));
	EXPECT_EQ("00:00", text(recorder(), "recorder_time"));
	MemoRecorderTestAccess::status(recorder(), 3599999);
	EXPECT_EQ("59:59", text(recorder(), "recorder_time"));
	MemoRecorderTestAccess::status(recorder(), 3600000);
	EXPECT_EQ("01:00:00", text(recorder(), "recorder_time"));
}

TEST_F(EditViewVoice, EndingTheAppSavesTheTake)
{
	view = openNew();
	startRecording();
	recordUntil(1200);
	const std::string folder = mediaDir(MemoEditViewTestAccess::uuid(view));
	terminated = true;
	app->onTerminate();
	EXPECT_TRUE(toasted("IDS_MEMO_TPOP_RECORDING_SAVED"));
	const std::string vr = query("SELECT vrfileUUID FROM memo WHERE isQuick = 0");
	ASSERT_FALSE(vr.empty());
	EXPECT_TRUE(ecore_file_exists((folder + vr + ".amr").c_str()));
}

TEST_F(EditViewVoice, PlayerPlaysPausesSeeksAndDeletesAtDone)
{
	// A stored memo with a recording of two seconds.
	openStoredVoiceMemo("voice-memo", "voice-file", 2000);
	ASSERT_NE(player(), nullptr);
	EXPECT_FALSE(evas_object_visible_get(
	    edje_object_part_object_get(elm_layout_edje_get(player()->getEvasObj()), "player_cancel_btn")));

	// Played through, it is back at the start.
	tapPart(player(), "player_pause_resume_btn");
	ASSERT_TRUE(waitFor([this] { return MemoPlayerTestAccess::state(player()) == PLAYER_STATE_PLAYING; }));
	EXPECT_TRUE(waitFor([this] { return text(player(), "recorder_sliderTime") == "00:01"; }));
	ASSERT_TRUE(waitFor([this] { return MemoPlayerTestAccess::state(player()) == PLAYER_STATE_READY; }, 5.0));
	EXPECT_EQ("00:00", text(player(), "recorder_sliderTime"));

	// Paused, the time stands; a seek moves it.
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_HEADER_EDIT_ABB2"));
	tapPart(player(), "player_pause_resume_btn");
	ASSERT_TRUE(waitFor([this] { return MemoPlayerTestAccess::state(player()) == PLAYER_STATE_PLAYING; }));
	tapPart(player(), "player_pause_resume_btn");
	EXPECT_EQ(PLAYER_STATE_PAUSED, MemoPlayerTestAccess::state(player()));
	const std::string paused = text(player(), "recorder_sliderTime");
	settle(0.5);
	EXPECT_EQ(paused, text(player(), "recorder_sliderTime"));
	MemoPlayerTestAccess::drag(player(), 0.9);
	EXPECT_EQ("00:01", text(player(), "recorder_sliderTime"));

	// A call pauses playback and its end resumes it.
	MemoPlayerTestAccess::drag(player(), 0.0);
	tapPart(player(), "player_pause_resume_btn");
	ASSERT_EQ(PLAYER_STATE_PLAYING, MemoPlayerTestAccess::state(player()));
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_ACTIVE);
	EXPECT_TRUE(waitFor([this] { return MemoPlayerTestAccess::state(player()) == PLAYER_STATE_PAUSED; }));
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
	EXPECT_TRUE(waitFor([this] { return MemoPlayerTestAccess::state(player()) != PLAYER_STATE_PAUSED; }));

	// Delete asks first; Done then writes the memo without its voice and the file goes.
	tapPart(player(), "player_cancel_btn");
	settle(0.3);
	tapObject(popupButton(2));
	settle(0.3);
	EXPECT_EQ(0, livePanels());
	EXPECT_TRUE(recordRowOffered());
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ("", query("SELECT vrfileUUID FROM memo WHERE UUID = 'voice-memo'"));
	EXPECT_EQ("", query("SELECT UUID FROM file WHERE memoUUID = 'voice-memo'"));
	EXPECT_FALSE(ecore_file_exists((mediaDir("voice-memo") + "voice-file.amr").c_str()));
}

TEST_F(EditViewVoice, IndicatorHearsATakeInTheBackground)
{
	const std::string out = memo_test::makeTempDir("indicator") + "/listener.out";
	memo_test::runCommand(std::string("(TIZEN_APP_ID=com.veltron.indicator '") +
	                      memo_test::helperPath("test_port_listener") + "' voicerecorder_indicator_port 2) > " + out +
	                      " 2>/dev/null &");
	ASSERT_TRUE(waitFor(
	    [] {
		    bool open = false;
		    message_port_check_remote_port("com.veltron.indicator", "voicerecorder_indicator_port", &open);
		    return open;
	    },
	    10.0));
	view = openNew();
	startRecording();
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,pause", nullptr);
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,resume", nullptr);
	ASSERT_TRUE(waitFor([&] { return memo_test::countOf(memo_test::readFile(out), "\n") == 2; }, 10.0));
	const std::string heard = memo_test::readFile(out);
	EXPECT_NE(std::string::npos, heard.find(" voicerecorder_indicator_data=bg_recording_start\n")) << heard;
	EXPECT_NE(std::string::npos, heard.find(" voicerecorder_indicator_data=voicerecorder_none\n")) << heard;
	EXPECT_LT(heard.find("bg_recording_start"), heard.find("voicerecorder_none"));
}

TEST_F(EditViewVoice, MiniControllersRunTheTakeWhileTheAppIsInTheBackground)
{
	view = openNew();
	startRecording();
	recordUntil(1200);
	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_LOCK);
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,pause", nullptr);
	MRecorderNotiMiniController *noti = MemoRecorderTestAccess::notiMini(recorder());
	MRecorderLockScreenMiniController *lock = MemoRecorderTestAccess::lockMini(recorder());
	ASSERT_TRUE(noti && lock);
	EXPECT_TRUE(evas_object_visible_get(minicontrol_viewer_window_find("memorecorder_mini_controller")));
	ASSERT_TRUE(waitFor([&] { return evas_object_visible_get(lock->_win); }));

	// A press in the notification panel pauses the take; the lock screen's controller follows.
	noti->_signal.emit("recorder,resumed", nullptr);
	recorder_state_e state = RECORDER_STATE_NONE;
	recorder_get_state(noti->_recorder, &state);
	EXPECT_EQ(RECORDER_STATE_PAUSED, state);
	EXPECT_STREQ(i18n_get_text("IDS_MEMO_BODY_PAUSED_M_STATUS"),
	             elm_object_part_text_get(lock->_layout, "recorder_status_text"));
	lock->_signal.emit("recorder,paused", nullptr);
	recorder_get_state(noti->_recorder, &state);
	EXPECT_EQ(RECORDER_STATE_RECORDING, state);
	EXPECT_STREQ(i18n_get_text("IDS_MEMO_BODY_RECORDING_ING_M_AUDIO"),
	             elm_object_part_text_get(noti->_layout, "recorder_status_text"));
	MemoRecorderTestAccess::status(recorder(), 3600000);
	EXPECT_STREQ("01:00:00", elm_object_part_text_get(noti->_layout, "recorder_time_hour"));
	EXPECT_STREQ("01:00:00", elm_object_part_text_get(lock->_layout, "recorder_time"));

	// Back in the app: both go.
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,resume", nullptr);
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("memorecorder_mini_controller"));
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("memo-minicontrol.LOCKSCREEN"));

	// Stopped from the notification panel, the take is kept and the controllers go.
	MemoBroadCaster::getInstance().emit("broadcast,memo,app,pause", nullptr);
	MemoRecorderTestAccess::notiMini(recorder())->_signal.emit("recorder,stopped", nullptr);
	ASSERT_TRUE(waitFor([this] { return player() != nullptr; }));
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("memorecorder_mini_controller"));
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("memo-minicontrol.LOCKSCREEN"));
	EXPECT_EQ(1u, voiceFiles().size());
	vconf_set_int(VCONFKEY_IDLE_LOCK_STATE, VCONFKEY_IDLE_UNLOCK);
}

TEST_F(EditViewVoice, PlaybackInTheBackgroundIsPausedAndEndedFromOutside)
{
	openStoredVoiceMemo("voice-memo-2", "voice-file-2", 3000);
	ASSERT_NE(player(), nullptr);
	tapPart(player(), "player_pause_resume_btn");
	ASSERT_TRUE(waitFor([this] { return MemoPlayerTestAccess::state(player()) == PLAYER_STATE_PLAYING; }));

	MemoBroadCaster::getInstance().emit("broadcast,memo,app,pause", nullptr);
	MplayerNotiMiniController *noti = MemoPlayerTestAccess::notiMini(player());
	MPlayerLockScreenMiniController *lock = MemoPlayerTestAccess::lockMini(player());
	ASSERT_TRUE(noti && lock);
	EXPECT_EQ(noti->_win, minicontrol_viewer_window_find("memoplayer_mini_controller"));
	EXPECT_TRUE(waitFor([&] { return strcmp(elm_object_part_text_get(lock->_layout, "play_time"), ""); }));
	noti->_signal.emit("player,pausedResumed", nullptr);
	EXPECT_EQ(PLAYER_STATE_PAUSED, MemoPlayerTestAccess::state(player()));
	lock->_signal.emit("player,pausedResumed", nullptr);
	EXPECT_EQ(PLAYER_STATE_PLAYING, MemoPlayerTestAccess::state(player()));

	// Cancelled from the notification panel: playback ends and both controllers go.
	noti->_signal.emit("player,canceled", nullptr);
	ASSERT_TRUE(waitFor([this] { return !MemoPlayerTestAccess::notiMini(player()); }));
	EXPECT_EQ(nullptr, MemoPlayerTestAccess::lockMini(player()));
	EXPECT_EQ(nullptr, minicontrol_viewer_window_find("memoplayer_mini_controller"));
	EXPECT_EQ(PLAYER_STATE_READY, MemoPlayerTestAccess::state(player()));
}
