// Device state: calls, storage, the sync account, power saving, product features.
#include "Util/MemoUtil.h"

#include <cstdlib>
#include <cstring>

#include <account.h>
#include <call-manager.h>
#include <csc_feature.h>
#include <storage.h>
#include <vconf.h>

#include "MemoLog.h"

// Below this much free internal storage (105 MiB) nothing new is saved.
#define MEMO_MIN_FREE_BYTES 110100480.0
#define MEMO_SYNC_ACCOUNT_PACKAGE "com.veltron.veltronaccount"
#define MEMO_PSMODE_KEY "db/setting/psmode"
#define MEMO_SALES_CODE_KEY "db/csc/salescode"

int MemoUtil::isPowerSavingMode()
{
	int value = 0;
	vconf_get_int(MEMO_PSMODE_KEY, &value);
	return value == 2 ? 1 : value;
}

static bool __accountFoundCb(account_h account, void *userData)
{
	(void)userData;
	if (!account) {
		MEMO_LOGE("----------------------- account is NULL");
		return false;
	}
	return true;
}

bool MemoUtil::checkVeltronAccountLogIn()
{
	int ret = account_connect();
	if (ret != 0) {
		MEMO_LOGE("----------------------- error[%d]", ret);
		return false;
	}
	// A query that finds an account succeeds; one that finds none fails with its own code.
	int query = account_query_account_by_package_name(__accountFoundCb, MEMO_SYNC_ACCOUNT_PACKAGE, nullptr);
	ret = account_disconnect();
	if (ret != 0) {
		MEMO_LOGE("----------------------- error[%d]", ret);
		return false;
	}
	return query == 0;
}

bool MemoUtil::getCallStatus()
{
	cm_client_h handle = nullptr;
	cm_call_status_e status = CM_CALL_STATUS_IDLE;
	cm_init(&handle);
	cm_get_call_status(handle, &status);
	if (!handle)
		MEMO_LOGE("cm handler is NULL");
	else
		cm_deinit(handle);
	return status != 0;
}

bool MemoUtil::getMemorySpaceStatusGet()
{
	struct statvfs record;
	memset(&record, 0, sizeof(record));
	int ret = storage_get_internal_memory_size(&record);
	if (ret < 0) {
		MEMO_LOGE("storage_get_internal_memory_size() fail : %d", ret);
		return false;
	}
	double avail = static_cast<double>(record.f_bsize) * static_cast<double>(record.f_bavail);
	if (avail > MEMO_MIN_FREE_BYTES)
		return true;
	double total = static_cast<double>(record.f_frsize) * static_cast<double>(record.f_blocks);
	MEMO_LOGE("total : %lf, avail : %lf", total, avail);
	return false;
}

bool MemoUtil::isQuickMemoFeatureEnabled()
{
	return csc_feature_get_bool(CSC_FEATURE_DEF_BOOL_MEMO_QUICK_MEMO) == 1;
}

bool MemoUtil::isSalesCodeKTC()
{
	char *code = vconf_get_str(MEMO_SALES_CODE_KEY);
	if (!code)
		return false;
	bool ktc = strcmp(code, "KTC") == 0;
	free(code);
	return ktc;
}
