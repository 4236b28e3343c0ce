// The desktop's media controls: a real test-source recording published on a private session bus, paused,
// resumed and stopped by dbus-send as a desktop shell would, its state and title read back.
#include <gtest/gtest.h>

#include <Ecore.h>
#include <recorder.h>

#include <atomic>
#include <csignal>
#include <cstdlib>
#include <string>
#include <thread>
#include <vector>

#include "Recorder/MemoMprisPlayer.h"
#include "TestEnv.h"

namespace
{
class Mpris : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		ecore_init();
		setenv("TIZEN_AUDIO_SOURCE", "test", 1);
		setenv("TIZEN_AUDIO_SINK", "fake", 1);
		std::string out;
		if (memo_test::runCommand("dbus-daemon --session --fork --print-address=1 --print-pid=1 2>/dev/null", &out) ==
		    0) {
			size_t end = out.find('\n');
			address = out.substr(0, end);
			daemonPid = atoi(out.c_str() + end + 1);
		}
	}
	static void TearDownTestSuite()
	{
		if (daemonPid > 0)
			kill(daemonPid, SIGTERM);
		ecore_shutdown();
	}

	// One call to the published player, made from another process while the main loop runs.
	static std::string call(const std::string &args)
	{
		std::string out;
		std::atomic<bool> done(false);
		std::thread caller([&] {
			memo_test::runCommand("dbus-send --session --print-reply --reply-timeout=5000 "
			                      "--dest=org.mpris.MediaPlayer2.memo /org/mpris/MediaPlayer2 " +
			                          args + " 2>&1",
			                      &out);
			done = true;
		});
		memo_test::pump(10, [&] { return done.load(); });
		caller.join();
		return out;
	}
	static std::string property(const char *name)
	{
		return call(std::string("org.freedesktop.DBus.Properties.Get string:org.mpris.MediaPlayer2.Player string:") +
		            name);
	}
	static bool statusIs(const char *status)
	{
		return property("PlaybackStatus").find(std::string("\"") + status + "\"") != std::string::npos;
	}

	static std::string address;
	static pid_t daemonPid;
};
std::string Mpris::address;
pid_t Mpris::daemonPid = 0;
} // namespace

TEST_F(Mpris, RecordingIsPausedResumedAndStoppedFromTheDesktop)
{
	recorder_h rec = nullptr;
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_create_audiorecorder(&rec));
	recorder_set_filename(rec, (memo_test::makeTempDir("mpris") + "/take.amr").c_str());
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_prepare(rec));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_start(rec));
	{
		unsetenv("DBUS_SESSION_BUS_ADDRESS");
		MemoMprisPlayer none(rec, "Groceries");
		EXPECT_FALSE(none.create());
	}
	if (address.empty()) {
		recorder_cancel(rec);
		recorder_destroy(rec);
		GTEST_SKIP() << "no dbus-daemon";
	}
	setenv("DBUS_SESSION_BUS_ADDRESS", address.c_str(), 1);

	MemoMprisPlayer mpris(rec, "Groceries");
	std::vector<std::string> events;
	// The owner's part: toggle on the request and announce the new state.
	mpris._signal.addListener([&](const char *event, const char *) {
		events.push_back(event);
		recorder_state_e state = RECORDER_STATE_NONE;
		recorder_get_state(rec, &state);
		if (events.back() == "recorder,paused")
			state == RECORDER_STATE_RECORDING ? recorder_pause(rec) : recorder_start(rec);
		mpris.update();
	});
	ASSERT_TRUE(mpris.create());
	ASSERT_TRUE(memo_test::pump(10, [] { return statusIs("Playing"); }));
	EXPECT_NE(std::string::npos, property("Metadata").find("Groceries"));

	call("org.mpris.MediaPlayer2.Player.Pause");
	EXPECT_TRUE(statusIs("Paused"));
	call("org.mpris.MediaPlayer2.Player.Pause"); // already paused: nothing to do
	call("org.mpris.MediaPlayer2.Player.Play");
	EXPECT_TRUE(statusIs("Playing"));
	call("org.mpris.MediaPlayer2.Player.PlayPause");
	EXPECT_TRUE(statusIs("Paused"));
	call("org.mpris.MediaPlayer2.Player.Stop");
	EXPECT_EQ((std::vector<std::string>{"recorder,paused", "recorder,paused", "recorder,paused", "recorder,stopped"}),
	          events);

	recorder_cancel(rec);
	recorder_unprepare(rec);
	recorder_destroy(rec);
}
