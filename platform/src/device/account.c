/* The account store of the desktop: a vconf key lists the signed-in accounts, so that a
   sign-in can be simulated (and undone) with vconftool while apps run. */
#include <account.h>

#include <stdlib.h>
#include <string.h>

#include <vconf.h>

#define ACCOUNT_LIST_KEY "db/desktop/account/list"
#define ACCOUNT_UNAVAILABLE_KEY "db/desktop/account/unavailable"

struct account_s {
	const char *package_name;
	const char *user_name;
	const char *email;
};

static int __connections;

int account_connect(void)
{
	int unavailable = 0;
	if (vconf_get_int(ACCOUNT_UNAVAILABLE_KEY, &unavailable) == VCONF_OK && unavailable)
		return ACCOUNT_ERROR_DB_NOT_OPENED;
	__connections++;
	return ACCOUNT_ERROR_NONE;
}

int account_disconnect(void)
{
	if (__connections <= 0)
		return ACCOUNT_ERROR_DB_NOT_OPENED;
	__connections--;
	return ACCOUNT_ERROR_NONE;
}

/* Splits "package|user|email" in place; missing fields are "". */
static void __parse_entry(char *entry, struct account_s *account)
{
	const char *fields[3] = {entry, "", ""};
	char *rest = entry;
	for (int i = 1; i < 3 && rest; i++) {
		char *bar = strchr(rest, '|');
		if (!bar)
			break;
		*bar = '\0';
		fields[i] = rest = bar + 1;
	}
	account->package_name = fields[0];
	account->user_name = fields[1];
	account->email = fields[2];
}

int account_query_account_by_package_name(account_cb callback, const char *package_name, void *user_data)
{
	if (!callback || !package_name)
		return ACCOUNT_ERROR_INVALID_PARAMETER;
	if (__connections <= 0)
		return ACCOUNT_ERROR_DB_NOT_OPENED;

	char *list = vconf_get_str(ACCOUNT_LIST_KEY);
	if (!list)
		return ACCOUNT_ERROR_RECORD_NOT_FOUND;
	int found = 0;
	char *save = NULL;
	for (char *entry = strtok_r(list, ";", &save); entry; entry = strtok_r(NULL, ";", &save)) {
		struct account_s account;
		__parse_entry(entry, &account);
		if (strcmp(account.package_name, package_name) != 0)
			continue;
		found++;
		if (!callback(&account, user_data))
			break;
	}
	free(list);
	return found ? ACCOUNT_ERROR_NONE : ACCOUNT_ERROR_RECORD_NOT_FOUND;
}

static int __copy_field(account_h account, const char *field, char **out)
{
	if (!account || !out)
		return ACCOUNT_ERROR_INVALID_PARAMETER;
	*out = strdup(field);
	return *out ? ACCOUNT_ERROR_NONE : ACCOUNT_ERROR_OUT_OF_MEMORY;
}

int account_get_package_name(account_h account, char **package_name)
{
	return __copy_field(account, account ? account->package_name : "", package_name);
}

int account_get_user_name(account_h account, char **user_name)
{
	return __copy_field(account, account ? account->user_name : "", user_name);
}

int account_get_email_address(account_h account, char **email_address)
{
	return __copy_field(account, account ? account->email : "", email_address);
}
