// Preference change callbacks: writes by this and by a second process, unset, and re-entrant callbacks.
#include <app_preference.h>
#include <gtest/gtest.h>

#include <Ecore.h>

#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
// "<key>=<value>" for each call.
using Seen = std::vector<std::string>;

void recordCb(const char *key, void *data)
{
	int v = -1;
	preference_get_int(key, &v);
	static_cast<Seen *>(data)->push_back(std::string(key) + "=" + std::to_string(v));
}

class PreferenceNotify : public testing::Test
{
protected:
	void SetUp() override
	{
		ecore_init();
		ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove_all());
	}
	void TearDown() override { ecore_shutdown(); }

	static void otherProcessSets(const char *key, int value)
	{
		std::string cmd = memo_test::helperPath("test_writer") + " pref-int " + key + " " + std::to_string(value);
		ASSERT_EQ(0, memo_test::runCommand(cmd));
	}
	static bool waitFor(const Seen &seen, size_t count)
	{
		return memo_test::pump(5, [&] { return seen.size() >= count; });
	}
};
} // namespace

// The watch of the keys is shared with vconf, whose tests cover same-value writes and other keys; here
// what preference adds: a key must exist, a second callback replaces the first, removal calls nothing.
TEST_F(PreferenceNotify, WritesOfEitherProcessReachTheOneCallbackUntilUnset)
{
	Seen first, seen;
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_set_changed_cb("MEMO_SVC_PROCESSING", recordCb, &seen));
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_unset_changed_cb("MEMO_SVC_PROCESSING"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("MEMO_SVC_PROCESSING", 0));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("CLOUD_TRIGGERING", 0));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_changed_cb("MEMO_SVC_PROCESSING", recordCb, &first));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_changed_cb("MEMO_SVC_PROCESSING", recordCb, &seen));
	otherProcessSets("MEMO_SVC_PROCESSING", 2);
	ASSERT_TRUE(waitFor(seen, 1));
	// A removal calls nothing, and the callback is still there when the key comes back.
	ASSERT_EQ(0, memo_test::runCommand(memo_test::helperPath("test_writer") + " pref-remove MEMO_SVC_PROCESSING"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("MEMO_SVC_PROCESSING", 3));
	ASSERT_TRUE(waitFor(seen, 2));

	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("MEMO_SVC_PROCESSING"));
	EXPECT_NE(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("MEMO_SVC_PROCESSING"));
	// Notices come in order: the one of the later key marks that the unset key was passed over.
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_changed_cb("CLOUD_TRIGGERING", recordCb, &seen));
	otherProcessSets("MEMO_SVC_PROCESSING", 1);
	otherProcessSets("CLOUD_TRIGGERING", 5);
	ASSERT_TRUE(waitFor(seen, 3));
	EXPECT_EQ((Seen{"MEMO_SVC_PROCESSING=2", "MEMO_SVC_PROCESSING=3", "CLOUD_TRIGGERING=5"}), seen);
	EXPECT_TRUE(first.empty());
	EXPECT_EQ(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("CLOUD_TRIGGERING"));
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
	otherProcessSets("other", 9);
	ASSERT_TRUE(memo_test::pump(5, [] { return !gOther.empty() && gOther.back() == "other=9"; }));
	EXPECT_EQ(1, gSelfRemovingCalls);
	EXPECT_EQ(PREFERENCE_ERROR_NONE, preference_unset_changed_cb("other"));
}
