// Desktop backends of the device families: call manager, accounts, storage, product features.
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <vector>

#include <Ecore.h>
#include <account.h>
#include <call-manager.h>
#include <csc_feature.h>
#include <storage.h>
#include <vconf.h>

#include "TestEnv.h"

namespace
{
// "<status>:<number>" for each call.
using CallEvents = std::vector<std::string>;

void callStatusCb(cm_call_status_e status, const char *number, void *data)
{
	static_cast<CallEvents *>(data)->push_back(std::to_string(status) + ":" + (number ? number : "(null)"));
}
} // namespace

TEST(DeviceBackends, CallManagerMapsAndReportsTheCallState)
{
	ecore_init(); // for the change notices
	cm_client_h handle = nullptr, other = nullptr;
	ASSERT_EQ(CM_ERROR_NONE, cm_init(&handle));
	cm_call_status_e status = CM_CALL_STATUS_MAX;
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
	ASSERT_EQ(CM_ERROR_NONE, cm_get_call_status(handle, &status));
	EXPECT_EQ(CM_CALL_STATUS_IDLE, status);

	CallEvents events, otherEvents;
	EXPECT_EQ(CM_ERROR_NOT_REGISTERED, cm_unset_call_status_cb(handle));
	ASSERT_EQ(CM_ERROR_NONE, cm_set_call_status_cb(handle, callStatusCb, &events));
	EXPECT_EQ(CM_ERROR_ALREADY_REGISTERED, cm_set_call_status_cb(handle, callStatusCb, &events));
	vconf_set_str("memory/desktop/call/number", "+4930123");
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_CONNECTING);
	ASSERT_TRUE(memo_test::pump(5.0, [&] { return events.size() == 1; }));
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_VOICE_ACTIVE);
	ASSERT_TRUE(memo_test::pump(5.0, [&] { return events.size() == 2; }));
	EXPECT_EQ((CallEvents{std::to_string(CM_CALL_STATUS_RINGING) + ":+4930123",
	                      std::to_string(CM_CALL_STATUS_OFFHOOK) + ":+4930123"}),
	          events);
	ASSERT_EQ(CM_ERROR_NONE, cm_get_call_status(handle, &status));
	EXPECT_EQ(CM_CALL_STATUS_OFFHOOK, status);

	// A deinitialised client hears nothing more; another one still does.
	ASSERT_EQ(CM_ERROR_NONE, cm_init(&other));
	ASSERT_EQ(CM_ERROR_NONE, cm_set_call_status_cb(other, callStatusCb, &otherEvents));
	EXPECT_EQ(CM_ERROR_NONE, cm_deinit(handle));
	vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF);
	ASSERT_TRUE(memo_test::pump(5.0, [&] { return otherEvents.size() == 1; }));
	EXPECT_EQ(std::to_string(CM_CALL_STATUS_IDLE) + ":+4930123", otherEvents[0]);
	EXPECT_EQ(2u, events.size());
	EXPECT_EQ(CM_ERROR_NONE, cm_unset_call_status_cb(other));
	EXPECT_EQ(CM_ERROR_NONE, cm_deinit(other));
	vconf_unset("memory/desktop/call/number");
}

namespace
{
bool collectCb(account_h account, void *data)
{
	auto *names = static_cast<std::vector<std::string> *>(data);
	char *user = nullptr, *email = nullptr;
	account_get_user_name(account, &user);
	account_get_email_address(account, &email);
	names->push_back(std::string(user) + "/" + email);
	free(user);
	free(email);
	return names->size() < 2;
}
} // namespace

TEST(DeviceBackends, AccountsComeFromTheListKey)
{
	std::vector<std::string> names;
	EXPECT_EQ(ACCOUNT_ERROR_DB_NOT_OPENED, account_query_account_by_package_name(collectCb, "pkg", &names));
	ASSERT_EQ(ACCOUNT_ERROR_NONE, account_connect());
	vconf_unset("db/desktop/account/list");
	EXPECT_EQ(ACCOUNT_ERROR_RECORD_NOT_FOUND, account_query_account_by_package_name(collectCb, "pkg", &names));

	// Iteration stops when the callback answers false; a package name matches whole.
	vconf_set_str("db/desktop/account/list", "pkg|a|a@x;other|b;pkg|c;pkg|d|d@x");
	EXPECT_EQ(ACCOUNT_ERROR_NONE, account_query_account_by_package_name(collectCb, "pkg", &names));
	EXPECT_EQ((std::vector<std::string>{"a/a@x", "c/"}), names);
	EXPECT_EQ(ACCOUNT_ERROR_RECORD_NOT_FOUND, account_query_account_by_package_name(collectCb, "pk", &names));
	EXPECT_EQ(ACCOUNT_ERROR_NONE, account_disconnect());
	EXPECT_EQ(ACCOUNT_ERROR_DB_NOT_OPENED, account_disconnect());
	vconf_unset("db/desktop/account/list");
}

TEST(DeviceBackends, StorageFreeSpaceCanBeOverriddenAndFeaturesHaveDefaults)
{
	const char *key = "db/desktop/storage/internal_free_bytes";
	vconf_unset(key);
	struct statvfs real, full;
	ASSERT_EQ(STORAGE_ERROR_NONE, storage_get_internal_memory_size(&real));
	EXPECT_GT(real.f_blocks, 0u);

	// Beyond the range of an int: the string form.
	vconf_set_str(key, "5000000000");
	ASSERT_EQ(STORAGE_ERROR_NONE, storage_get_internal_memory_size64(&full));
	EXPECT_EQ(5000000000ULL, (unsigned long long)full.f_bsize * full.f_bavail);
	EXPECT_EQ(real.f_blocks, full.f_blocks);
	unsigned long long bytes = 0;
	ASSERT_EQ(STORAGE_ERROR_NONE, storage_get_available_space(STORAGE_TYPE_INTERNAL, &bytes));
	EXPECT_EQ(5000000000ULL, bytes);
	EXPECT_EQ(STORAGE_ERROR_NOT_SUPPORTED, storage_get_available_space(STORAGE_TYPE_EXTERNAL, &bytes));
	// Garbage is ignored: the real figures come back.
	vconf_set_str(key, "lots");
	ASSERT_EQ(STORAGE_ERROR_NONE, storage_get_internal_memory_size(&full));
	EXPECT_EQ(real.f_bsize, full.f_bsize);
	vconf_unset(key);

	// Features other than the quick memo (whose default and key the app's tests check) are off until set.
	const auto seven = static_cast<CscFeatureDefBool>(7);
	EXPECT_EQ(CSC_FEATURE_BOOL_FALSE, csc_feature_get_bool(seven));
	vconf_set_int("db/desktop/csc/feature_7", 1);
	EXPECT_EQ(CSC_FEATURE_BOOL_TRUE, csc_feature_get_bool(seven));
	vconf_unset("db/desktop/csc/feature_7");
}
