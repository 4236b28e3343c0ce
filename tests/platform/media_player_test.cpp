// The player on real pipelines with a recorded AMR file and the test speakers: states, the end of the
// file, position and seeking, interruptions by a call and by the earjack.
#include <player.h>

#include <vector>

#include "media_fixture.h"

namespace
{
struct Seen {
	int completed = 0;
	int seeks = 0;
	std::vector<player_interrupted_code_e> interruptions;
};

class Player : public MediaTest
{
protected:
	static void SetUpTestSuite()
	{
		MediaTest::SetUpTestSuite();
		file = memo_test::makeTempDir("play") + "/voice.amr";
		ASSERT_TRUE(record(file, 2000));
	}
	void SetUp() override
	{
		MediaTest::SetUp();
		vconf_set_int(VCONFKEY_SYSMAN_EARJACK, VCONFKEY_SYSMAN_EARJACK_REMOVED);
		ASSERT_EQ(PLAYER_ERROR_NONE, player_create(&player));
		player_set_completed_cb(
		    player, [](void *d) { static_cast<Seen *>(d)->completed++; }, &seen);
		player_set_interrupted_cb(
		    player, [](player_interrupted_code_e c, void *d) { static_cast<Seen *>(d)->interruptions.push_back(c); },
		    &seen);
	}
	void TearDown() override
	{
		EXPECT_EQ(PLAYER_ERROR_NONE, player_destroy(player));
		MediaTest::TearDown();
	}
	player_state_e state()
	{
		player_state_e s = PLAYER_STATE_NONE;
		player_get_state(player, &s);
		return s;
	}
	int position()
	{
		int ms = -1;
		player_get_play_position(player, &ms);
		return ms;
	}
	void prepare()
	{
		ASSERT_EQ(PLAYER_ERROR_NONE, player_set_uri(player, file.c_str()));
		ASSERT_EQ(PLAYER_ERROR_NONE, player_prepare(player));
	}

	static std::string file;
	player_h player = nullptr;
	Seen seen;
};
std::string Player::file;
} // namespace

TEST_F(Player, PlaysToTheEndPausesAndSeeks)
{
	EXPECT_EQ(PLAYER_ERROR_INVALID_STATE, player_start(player));
	prepare();
	int duration = 0;
	ASSERT_EQ(PLAYER_ERROR_NONE, player_get_duration(player, &duration));
	EXPECT_GT(duration, 1800);
	EXPECT_LT(duration, 2700);
	EXPECT_NEAR(durationOf(file) * 1000, duration, 20);
	EXPECT_EQ(PLAYER_ERROR_INVALID_STATE, player_pause(player));

	ASSERT_EQ(PLAYER_ERROR_NONE, player_start(player));
	ASSERT_TRUE(memo_test::pump(10, [&] { return position() >= 500; }));
	ASSERT_EQ(PLAYER_ERROR_NONE, player_pause(player));
	int paused = position();
	memo_test::pumpFor(0.3);
	EXPECT_EQ(paused, position());

	ASSERT_EQ(PLAYER_ERROR_NONE, player_set_play_position(
	                                 player, 1500, true, [](void *d) { static_cast<Seen *>(d)->seeks++; }, &seen));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.seeks == 1; }));
	EXPECT_NEAR(1500, position(), 100);
	ASSERT_EQ(PLAYER_ERROR_NONE, player_start(player));
	ASSERT_TRUE(memo_test::pump(10, [&] { return seen.completed == 1; }));
	// The end leaves the player playing until it is stopped, and is told once.
	EXPECT_EQ(PLAYER_STATE_PLAYING, state());
	memo_test::pumpFor(0.3);
	EXPECT_EQ(1, seen.completed);
	ASSERT_EQ(PLAYER_ERROR_NONE, player_stop(player));
	EXPECT_EQ(PLAYER_STATE_READY, state());
	ASSERT_TRUE(memo_test::pump(5, [&] { return position() == 0; }));

	// From the start again, all the way.
	ASSERT_EQ(PLAYER_ERROR_NONE, player_start(player));
	ASSERT_TRUE(memo_test::pump(10, [&] { return seen.completed == 2; }));
}

TEST_F(Player, ACallPausesUntilItEndsAndTheEarjackPausesForGood)
{
	prepare();
	ASSERT_EQ(PLAYER_ERROR_NONE, player_start(player));
	ASSERT_TRUE(memo_test::pump(10, [&] { return position() > 0; }));
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_ACTIVE);
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.interruptions.size() == 1; }));
	EXPECT_EQ(PLAYER_STATE_PAUSED, state());
	EXPECT_EQ(PLAYER_ERROR_SOUND_POLICY, player_start(player));
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.interruptions.size() == 2; }));
	EXPECT_EQ((std::vector<player_interrupted_code_e>{PLAYER_INTERRUPTED_BY_CALL, PLAYER_INTERRUPTED_COMPLETED}),
	          seen.interruptions);

	vconf_set_int(VCONFKEY_SYSMAN_EARJACK, VCONFKEY_SYSMAN_EARJACK_3WIRE);
	ASSERT_EQ(PLAYER_ERROR_NONE, player_start(player));
	memo_test::pumpFor(0.2);
	vconf_set_int(VCONFKEY_SYSMAN_EARJACK, VCONFKEY_SYSMAN_EARJACK_REMOVED);
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.interruptions.size() == 3; }));
	EXPECT_EQ(PLAYER_INTERRUPTED_BY_EARJACK_UNPLUG, seen.interruptions.back());
	EXPECT_EQ(PLAYER_STATE_PAUSED, state());
}

TEST_F(Player, FilesThatCannotPlayFailThePrepare)
{
	ASSERT_EQ(PLAYER_ERROR_NONE, player_set_uri(player, (file + ".missing").c_str()));
	EXPECT_EQ(PLAYER_ERROR_NO_SUCH_FILE, player_prepare(player));
	EXPECT_EQ(PLAYER_STATE_IDLE, state());

	std::string text = memo_test::makeTempDir("play") + "/note.amr";
	ASSERT_EQ(0, memo_test::runCommand("echo 'not a sound' > " + text));
	ASSERT_EQ(PLAYER_ERROR_NONE, player_set_uri(player, text.c_str()));
	EXPECT_EQ(PLAYER_ERROR_NOT_SUPPORTED_FILE, player_prepare(player));
}
