// The audio recorder on real pipelines with the test microphone: states, the AMR file, limits, calls.
#include <recorder.h>
#include <recorder_product.h>

#include <sys/stat.h>
#include <unistd.h>
#include <vector>

#include "media_fixture.h"

namespace
{
struct Seen {
	std::vector<std::string> states; // "<previous>><current>" with "!" when by policy
	std::vector<unsigned long long> elapsed;
	std::vector<recorder_recording_limit_type_e> limits;
};

void stateCb(recorder_state_e previous, recorder_state_e current, bool byPolicy, void *data)
{
	static_cast<Seen *>(data)->states.push_back(std::to_string(previous) + ">" + std::to_string(current) +
	                                            (byPolicy ? "!" : ""));
}

void statusCb(unsigned long long elapsed, unsigned long long, void *data)
{
	static_cast<Seen *>(data)->elapsed.push_back(elapsed);
}

void limitCb(recorder_recording_limit_type_e type, void *data)
{
	static_cast<Seen *>(data)->limits.push_back(type);
}

class Recorder : public MediaTest
{
protected:
	void SetUp() override
	{
		MediaTest::SetUp();
		path = memo_test::makeTempDir("rec") + "/voice.amr";
		ASSERT_EQ(RECORDER_ERROR_NONE, recorder_create_audiorecorder(&rec));
		recorder_set_state_changed_cb(rec, stateCb, &seen);
		recorder_set_recording_status_cb(rec, statusCb, &seen);
		recorder_set_recording_limit_reached_cb(rec, limitCb, &seen);
		ASSERT_EQ(RECORDER_ERROR_NONE, recorder_set_filename(rec, path.c_str()));
	}
	void TearDown() override
	{
		recorder_state_e state = RECORDER_STATE_NONE;
		recorder_get_state(rec, &state);
		if (state == RECORDER_STATE_RECORDING || state == RECORDER_STATE_PAUSED)
			recorder_cancel(rec);
		recorder_unprepare(rec);
		EXPECT_EQ(RECORDER_ERROR_NONE, recorder_destroy(rec));
		MediaTest::TearDown();
	}
	bool recordedAtLeast(unsigned long long ms)
	{
		return memo_test::pump(30, [&] { return !seen.elapsed.empty() && seen.elapsed.back() >= ms; });
	}
	recorder_state_e state()
	{
		recorder_state_e s = RECORDER_STATE_NONE;
		recorder_get_state(rec, &s);
		return s;
	}
	static bool exists(const std::string &p) { return access(p.c_str(), F_OK) == 0; }

	recorder_h rec = nullptr;
	std::string path;
	Seen seen;
};
} // namespace

TEST_F(Recorder, RecordsOneAmrFileAcrossAPauseAndRefusesWrongMoves)
{
	EXPECT_EQ(RECORDER_ERROR_INVALID_STATE, recorder_start(rec));
	EXPECT_EQ(RECORDER_ERROR_INVALID_STATE, recorder_commit(rec));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_prepare(rec));
	EXPECT_EQ(RECORDER_ERROR_INVALID_STATE, recorder_pause(rec));
	EXPECT_EQ(RECORDER_ERROR_INVALID_STATE, recorder_destroy(rec));
	bool busy = true;
	recorder_is_in_recording(0, &busy);
	EXPECT_FALSE(busy);

	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_start(rec));
	EXPECT_EQ(RECORDER_ERROR_INVALID_STATE, recorder_set_filename(rec, "/tmp/other.amr"));
	ASSERT_TRUE(recordedAtLeast(1000));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_pause(rec));
	recorder_is_in_recording(0, &busy);
	EXPECT_TRUE(busy);
	// The time paused is not recorded.
	size_t reports = seen.elapsed.size();
	memo_test::pumpFor(1.0);
	EXPECT_EQ(reports, seen.elapsed.size());
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_start(rec));
	ASSERT_TRUE(recordedAtLeast(2000));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_commit(rec));
	EXPECT_EQ(RECORDER_STATE_READY, state());
	recorder_is_in_recording(0, &busy);
	EXPECT_FALSE(busy);

	for (size_t i = 1; i < seen.elapsed.size(); i++)
		EXPECT_LE(seen.elapsed[i - 1], seen.elapsed[i]);
	EXPECT_EQ("#!AMR\n", memo_test::readFile(path).substr(0, 6));
	double seconds = durationOf(path);
	EXPECT_GT(seconds, 1.8);
	EXPECT_LT(seconds, 2.7);
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.states.size() == 5; }));
	EXPECT_EQ((std::vector<std::string>{"1>2", "2>3", "3>4", "4>3", "3>2"}), seen.states);
}

TEST_F(Recorder, CancelRemovesTheFileAndLimitsEndTheTake)
{
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_prepare(rec));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_start(rec));
	ASSERT_TRUE(recordedAtLeast(300));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_cancel(rec));
	EXPECT_FALSE(exists(path));

	// At the time limit the last report is the limit itself; later sound is dropped.
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_attr_set_time_limit(rec, 1));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_start(rec));
	ASSERT_TRUE(memo_test::pump(10, [&] { return !seen.limits.empty(); }));
	EXPECT_EQ(1000u, seen.elapsed.back());
	EXPECT_EQ(RECORDER_STATE_RECORDING, state());
	memo_test::pumpFor(0.3);
	EXPECT_EQ(1000u, seen.elapsed.back());
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_commit(rec));
	EXPECT_NEAR(1.0, durationOf(path), 0.1);

	// The size limit holds the file within it, header included.
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_attr_set_time_limit(rec, 0));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_attr_set_size_limit(rec, 2));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_start(rec));
	ASSERT_TRUE(memo_test::pump(10, [&] { return seen.limits.size() == 2; }));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_commit(rec));
	EXPECT_EQ(
	    (std::vector<recorder_recording_limit_type_e>{RECORDER_RECORDING_LIMIT_TIME, RECORDER_RECORDING_LIMIT_SIZE}),
	    seen.limits);
	struct stat st;
	ASSERT_EQ(0, stat(path.c_str(), &st));
	EXPECT_LE(st.st_size, 2048);
	EXPECT_GT(st.st_size, 2048 - 32);

	// A folder that does not exist is refused at the start; the recorder stays ready.
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_set_filename(rec, "/nonexistent/voice.amr"));
	EXPECT_NE(RECORDER_ERROR_NONE, recorder_start(rec));
	EXPECT_EQ(RECORDER_STATE_READY, state());
}

TEST_F(Recorder, ACallEndsTheTakeByPolicyAndKeepsIt)
{
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_prepare(rec));
	ASSERT_EQ(RECORDER_ERROR_NONE, recorder_start(rec));
	ASSERT_TRUE(recordedAtLeast(500));
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_CONNECTING);
	ASSERT_TRUE(memo_test::pump(5, [&] { return state() == RECORDER_STATE_READY; }));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.states.size() == 3; }));
	EXPECT_EQ("3>2!", seen.states.back());
	EXPECT_GT(durationOf(path), 0.4);
	// No new take while the call lasts.
	EXPECT_EQ(RECORDER_ERROR_SOUND_POLICY_BY_CALL, recorder_start(rec));
}

TEST_F(Recorder, AMicrophoneThatCannotOpenFailsThePrepare)
{
	setenv("TIZEN_AUDIO_SOURCE", "nosuchsource", 1);
	EXPECT_EQ(RECORDER_ERROR_DEVICE, recorder_prepare(rec));
	setenv("TIZEN_AUDIO_SOURCE", "test", 1);
	EXPECT_EQ(RECORDER_STATE_CREATED, state());
}
