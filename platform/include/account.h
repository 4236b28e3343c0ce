#ifndef __ACCOUNT_H__
#define __ACCOUNT_H__

#include <stdbool.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	ACCOUNT_ERROR_NONE = TIZEN_ERROR_NONE,
	ACCOUNT_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	ACCOUNT_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	ACCOUNT_ERROR_DUPLICATED = TIZEN_ERROR_ACCOUNT | 0x01,
	ACCOUNT_ERROR_NO_DATA = TIZEN_ERROR_NO_DATA,
	ACCOUNT_ERROR_RECORD_NOT_FOUND = TIZEN_ERROR_ACCOUNT | 0x03,
	ACCOUNT_ERROR_DB_FAILED = TIZEN_ERROR_ACCOUNT | 0x04,
	ACCOUNT_ERROR_DB_NOT_OPENED = TIZEN_ERROR_ACCOUNT | 0x05,
	ACCOUNT_ERROR_QUERY_SYNTAX_ERROR = TIZEN_ERROR_ACCOUNT | 0x06,
	ACCOUNT_ERROR_ITERATOR_END = TIZEN_ERROR_ACCOUNT | 0x07,
	ACCOUNT_ERROR_NOTI_FAILED = TIZEN_ERROR_ACCOUNT | 0x08,
	ACCOUNT_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
	ACCOUNT_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
} account_error_e;

typedef struct account_s *account_h;

/* Called once per account found; return false to stop. The handle is valid during the call only. */
typedef bool (*account_cb)(account_h account, void *user_data);

/* Connects to the account store. On the desktop the store is the vconf string key
   "db/desktop/account/list": accounts separated by ";", each "package_name|user_name|email"
   (user name and email optional). Setting the int key "db/desktop/account/unavailable" to 1 makes
   the service unreachable: connect then fails with ACCOUNT_ERROR_DB_NOT_OPENED. */
int account_connect(void);
int account_disconnect(void);

/* Calls callback for each account of the package, in stored order. ACCOUNT_ERROR_NONE if at least
   one was found, ACCOUNT_ERROR_RECORD_NOT_FOUND if none, ACCOUNT_ERROR_DB_NOT_OPENED without a
   connection. */
int account_query_account_by_package_name(account_cb callback, const char *package_name, void *user_data);

/* Copies of the account's fields (malloc'ed; the caller frees them). */
int account_get_package_name(account_h account, char **package_name);
int account_get_user_name(account_h account, char **user_name);
int account_get_email_address(account_h account, char **email_address);

#ifdef __cplusplus
}
#endif

#endif /* __ACCOUNT_H__ */
