// The preference store: types, errors, odd key names, files that other processes read and write; change
// callbacks for writes of this and a second process, unset, and re-entrant callbacks.
#include <app_common.h>
#include <app_preference.h>
#include <gtest/gtest.h>

#include <Ecore.h>

#include <climits>
#include <cstdlib>
#include <set>
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

// The string value, or "<error code>" when the read fails.
std::string getString(const char *key)
{
	char *value = nullptr;
	int rc = preference_get_string(key, &value);
	std::string s = rc == PREFERENCE_ERROR_NONE ? value : "<" + std::to_string(rc) + ">";
	free(value);
	return s;
}

bool exists(const char *key)
{
	bool b = false;
	EXPECT_EQ(PREFERENCE_ERROR_NONE, preference_is_existing(key, &b));
	return b;
}

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

bool collectKeyCb(const char *key, void *data)
{
	static_cast<std::set<std::string> *>(data)->insert(key);
	return true;
}

class Preference : public testing::Test
{
protected:
	void SetUp() override
	{
		ecore_init();
		ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove_all());
	}
	void TearDown() override { ecore_shutdown(); }

	// Runs the writer process with `args`, e.g. "pref-int KEY 1".
	static void otherProcess(const std::string &args)
	{
		ASSERT_EQ(0, memo_test::runCommand(memo_test::helperPath("test_writer") + " " + args)) << args;
	}
	static void otherProcessSets(const char *key, int value)
	{
		otherProcess("pref-int " + std::string(key) + " " + std::to_string(value));
	}
	static bool waitFor(const Seen &seen, size_t count)
	{
		return memo_test::pump(5, [&] { return seen.size() >= count; });
	}
};
} // namespace

TEST_F(Preference, ValuesKeepTheirTypeMissingKeysAndRemoval)
{
	int i = 0;
	double d = 0;
	bool b = false;
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("i", INT_MIN));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_get_int("i", &i));
	EXPECT_EQ(INT_MIN, i);
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_double("d", 0.1));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_get_double("d", &d));
	EXPECT_EQ(0.1, d);
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_boolean("b", true));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_get_boolean("b", &b));
	EXPECT_TRUE(b);
	const char *text = "two\nlines, \xc3\xbc and a trailing newline\n";
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_string("s", text));
	EXPECT_EQ(text, getString("s"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_string("empty", ""));
	EXPECT_EQ("", getString("empty"));

	// Reading as another type is refused and leaves the output alone; a setter replaces the type.
	i = 77;
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_int("s", &i));
	EXPECT_EQ(77, i);
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_boolean("i", &b));
	EXPECT_EQ("<" + std::to_string(PREFERENCE_ERROR_INVALID_PARAMETER) + ">", getString("i"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("s", 5));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_get_int("s", &i));
	EXPECT_EQ(5, i);

	// Missing keys, bad names and removal.
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_get_int("absent", &i));
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_remove("absent"));
	EXPECT_FALSE(exists("absent"));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_set_int("", 1));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_set_int(std::string(300, 'x').c_str(), 1));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove("s"));
	EXPECT_FALSE(exists("s"));
	EXPECT_TRUE(exists("i"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove_all());
	EXPECT_FALSE(exists("i"));
}

TEST_F(Preference, OddKeyNamesAreDistinctKeys)
{
	const std::set<std::string> keys = {"a/b", "a%2Fb", ".hidden",          "..", ".", "with space",
	                                    "A",   "a",     "\xc3\xa9t\xc3\xa9"};
	int n = 0;
	for (const std::string &k : keys)
		ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int(k.c_str(), ++n)) << k;
	n = 0;
	for (const std::string &k : keys) {
		int v = 0;
		ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_get_int(k.c_str(), &v)) << k;
		EXPECT_EQ(++n, v) << k;
	}
	std::set<std::string> listed;
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_foreach_item(collectKeyCb, &listed));
	EXPECT_EQ(keys, listed);
	// Iteration stops when the callback answers false.
	int calls = 0;
	auto stopAtFirstCb = [](const char *, void *data) { return ++*static_cast<int *>(data) < 0; };
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_foreach_item(stopAtFirstCb, &calls));
	EXPECT_EQ(1, calls);
}

TEST_F(Preference, ValuesLiveInTheDataFolderAndReachOtherProcesses)
{
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_string("QUICK_MEMO_ADD_DATA", "here"));
	char *data = app_get_data_path();
	ASSERT_NE(nullptr, data);
	std::string file = std::string(data) + ".pref/QUICK_MEMO_ADD_DATA";
	free(data);
	EXPECT_EQ("string\nhere", memo_test::readFile(file));

	otherProcess("pref-string QUICK_MEMO_ADD_DATA 'from there'");
	EXPECT_EQ("from there", getString("QUICK_MEMO_ADD_DATA"));
	otherProcess("pref-remove QUICK_MEMO_ADD_DATA");
	EXPECT_FALSE(exists("QUICK_MEMO_ADD_DATA"));
}

// The watch of the keys is shared with vconf, whose tests cover same-value writes and other keys; here
// what preference adds: a key must exist, a second callback replaces the first, removal calls nothing.
TEST_F(Preference, WritesOfEitherProcessReachTheOneCallbackUntilUnset)
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
	otherProcess("pref-remove MEMO_SVC_PROCESSING");
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

TEST_F(Preference, CallbacksMayUnsetThemselves)
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
