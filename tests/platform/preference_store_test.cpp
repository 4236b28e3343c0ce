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

std::string getString(const char *key, int *rc = nullptr)
{
	char *value = nullptr;
	int r = preference_get_string(key, &value);
	if (rc)
		*rc = r;
	std::string s = value ? value : "<null>";
	free(value);
	return s;
}

bool collectKeyCb(const char *key, void *data)
{
	static_cast<std::set<std::string> *>(data)->insert(key);
	return true;
}

bool stopAtFirstCb(const char *, void *data)
{
	++*static_cast<int *>(data);
	return false;
}
} // namespace

TEST_F(PreferenceStore, ValuesKeepTheirTypeAndTheGetterChecksIt)
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

	// Reading as another type is refused and leaves the output alone.
	i = 77;
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_int("s", &i));
	EXPECT_EQ(77, i);
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_boolean("i", &b));
	int rc = 0;
	getString("i", &rc);
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, rc);

	// A setter replaces a value of another type.
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("s", 5));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_get_int("s", &i));
	EXPECT_EQ(5, i);
}

TEST_F(PreferenceStore, MissingKeysAndNullArguments)
{
	int i = 0;
	bool b = true;
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_get_int("absent", &i));
	EXPECT_EQ(static_cast<int>(0xfef00030), PREFERENCE_ERROR_NO_KEY);
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, preference_remove("absent"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_is_existing("absent", &b));
	EXPECT_FALSE(b);

	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_set_int(nullptr, 1));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_set_int("", 1));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_set_string("k", nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_int("k", nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_string(nullptr, nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_boolean(nullptr, &b));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_get_double("k", nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_is_existing(nullptr, &b));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_is_existing("k", nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_remove(nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_foreach_item(nullptr, nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_set_changed_cb(nullptr, nullptr, nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_unset_changed_cb(nullptr));
	EXPECT_EQ(PREFERENCE_ERROR_INVALID_PARAMETER, preference_set_int(std::string(300, 'x').c_str(), 1));
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
	int calls = 0;
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_foreach_item(stopAtFirstCb, &calls));
	EXPECT_EQ(1, calls);
}

TEST_F(PreferenceStore, RemoveAndRemoveAll)
{
	bool existing = false;
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_int("x", 1));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_set_string("y", "v"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_is_existing("x", &existing));
	EXPECT_TRUE(existing);
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove("x"));
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_is_existing("x", &existing));
	EXPECT_FALSE(existing);
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_remove_all());
	ASSERT_EQ(PREFERENCE_ERROR_NONE, preference_is_existing("y", &existing));
	EXPECT_FALSE(existing);
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
	int rc = 0;
	getString("QUICK_MEMO_ADD_DATA", &rc);
	EXPECT_EQ(PREFERENCE_ERROR_NO_KEY, rc);
}
