// Preference store: types, errors, odd key names, and files that other processes can read.
#include <app_common.h>
#include <app_preference.h>
#include <gtest/gtest.h>

#include <climits>
#include <cstdlib>
#include <set>
#include <string>

#include "TestEnv.h"

namespace
{
class PreferenceStore : public testing::Test
{
protected:
	void SetUp() override { ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove_all()); }
};

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

bool collectKeyCb(const char *key, void *data)
{
	static_cast<std::set<std::string> *>(data)->insert(key);
	return true;
}
} // namespace

TEST_F(PreferenceStore, ValuesKeepTheirTypeMissingKeysAndRemoval)
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

TEST_F(PreferenceStore, OddKeyNamesAreDistinctKeys)
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

TEST_F(PreferenceStore, ValuesLiveInTheDataFolderAndReachOtherProcesses)
{
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_string("QUICK_MEMO_ADD_DATA", "here"));
	char *data = app_get_data_path();
	ASSERT_NE(nullptr, data);
	std::string file = std::string(data) + ".pref/QUICK_MEMO_ADD_DATA";
	free(data);
	EXPECT_EQ("string\nhere", memo_test::readFile(file));

	std::string writer = memo_test::helperPath("test_writer");
	ASSERT_EQ(0, memo_test::runCommand(writer + " pref-string QUICK_MEMO_ADD_DATA 'from there'"));
	EXPECT_EQ("from there", getString("QUICK_MEMO_ADD_DATA"));
	ASSERT_EQ(0, memo_test::runCommand(writer + " pref-remove QUICK_MEMO_ADD_DATA"));
	EXPECT_FALSE(exists("QUICK_MEMO_ADD_DATA"));
}
