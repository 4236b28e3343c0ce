// Preference change callbacks: writes by this and by a second process, unset, and re-entrant callbacks.
#include <app_preference.h>
#include <gtest/gtest.h>

#include <Ecore.h>

#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
struct Seen {
	std::vector<std::string> keys;
	std::vector<int> values;
};

void recordCb(const char *key, void *data)
{
	auto *seen = static_cast<Seen *>(data);
	int v = -1;
	preference_get_int(key, &v);
	seen->keys.push_back(key);
	seen->values.push_back(v);
}

class PreferenceNotify : public testing::Test
{
protected:
	void SetUp() override
	{
		ecore_init();
		ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove_all());
		memo_test::pumpFor(0.05); // drop notices of the cleanup
	}
	void TearDown() override { ecore_shutdown(); }

	static int runWriter(const std::string &args)
	{
		return memo_test::runCommand(memo_test::helperPath("test_writer") + " " + args);
	}
};
} // namespace

TEST_F(PreferenceNotify, WritesOfAnotherProcessReachTheCallbackUntilUnset)
{
	Seen seen;
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("MEMO_SVC_PROCESSING", 0));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("CLOUD_TRIGGERING", 0));
	memo_test::pumpFor(0.05);
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_changed_cb("MEMO_SVC_PROCESSING", recordCb, &seen));

	ASSERT_EQ(0, runWriter("pref-int MEMO_SVC_PROCESSING 2"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.keys.size() == 1; }));
	EXPECT_EQ("MEMO_SVC_PROCESSING", seen.keys[0]);
	EXPECT_EQ(2, seen.values[0]);

	// The same value again still counts as a change; a different key does not reach this callback.
	ASSERT_EQ(0, runWriter("pref-int CLOUD_TRIGGERING 1"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("MEMO_SVC_PROCESSING", 2));
	ASSERT_TRUE(memo_test::pump(5, [&] { return seen.keys.size() == 2; }));
	EXPECT_EQ("MEMO_SVC_PROCESSING", seen.keys[1]);

	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("MEMO_SVC_PROCESSING"));
	ASSERT_EQ(0, runWriter("pref-int MEMO_SVC_PROCESSING 1"));
	memo_test::pumpFor(0.3);
	EXPECT_EQ(2u, seen.keys.size());
	EXPECT_NE(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("MEMO_SVC_PROCESSING"));
}

TEST_F(PreferenceNotify, RegistrationNeedsAnExistingKeyAndASecondOneReplacesTheFirst)
{
	Seen first, second;
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_set_changed_cb("nothing", recordCb, &first));
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_unset_changed_cb("nothing"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("k", 1));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_changed_cb("k", recordCb, &first));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_changed_cb("k", recordCb, &second));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("k", 3));
	ASSERT_TRUE(memo_test::pump(5, [&] { return second.keys.size() == 1; }));
	EXPECT_TRUE(first.keys.empty());

	// A removal calls nothing, and the callback is still there when the key comes back.
	ASSERT_EQ(0, runWriter("pref-remove k"));
	ASSERT_EQ(0, runWriter("pref-int k 4"));
	ASSERT_TRUE(memo_test::pump(5, [&] { return second.keys.size() == 2; }));
	EXPECT_EQ(4, second.values[1]);
	memo_test::pumpFor(0.1);
	EXPECT_EQ(2u, second.keys.size());
	EXPECT_EQ(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("k"));
}

namespace
{
int gSelfRemovingCalls;
Seen gOther;

void unsetSelfCb(const char *key, void *)
{
	++gSelfRemovingCalls;
	// Unsetting itself and registering another key from inside a callback must be safe.
	preference_unset_changed_cb(key);
	preference_set_int("other", 1);
	preference_set_changed_cb("other", recordCb, &gOther);
}
} // namespace

TEST_F(PreferenceNotify, CallbacksMayUnsetThemselves)
{
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("self", 0));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_changed_cb("self", unsetSelfCb, nullptr));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("self", 1));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("self", 2));
	ASSERT_TRUE(memo_test::pump(5, [] { return gSelfRemovingCalls > 0; }));
	ASSERT_EQ(0, runWriter("pref-int other 9"));
	ASSERT_TRUE(memo_test::pump(5, [] { return !gOther.values.empty() && gOther.values.back() == 9; }));
	EXPECT_EQ(1, gSelfRemovingCalls);
	EXPECT_EQ(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("other"));
}
