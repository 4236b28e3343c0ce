#include "ui/eext_events_keys.h"

#include <string.h>

/* Back: the phone's back key and the desktop's Escape. More: the menu keys and F2 for keyboards without one. */
static const char *const __backKeys[] = {"XF86Back", "XF86Stop", "Escape", NULL};
static const char *const __moreKeys[] = {"XF86Menu", "XF86Send", "Menu", "F2", NULL};
static const char *const __allKeys[] = {"XF86Back", "XF86Stop", "Escape", "XF86Menu", "XF86Send", "Menu", "F2", NULL};

const char *const *eext_key_names(void)
{
	return __allKeys;
}

static Eina_Bool __inList(const char *const *list, const char *keyname)
{
	for (; *list; list++) {
		if (!strcmp(*list, keyname))
			return EINA_TRUE;
	}
	return EINA_FALSE;
}

Eina_Bool eext_key_type_get(const char *keyname, Eext_Callback_Type *type)
{
	if (!keyname || !type)
		return EINA_FALSE;
	if (__inList(__backKeys, keyname)) {
		*type = EEXT_CALLBACK_BACK;
		return EINA_TRUE;
	}
	if (__inList(__moreKeys, keyname)) {
		*type = EEXT_CALLBACK_MORE;
		return EINA_TRUE;
	}
	return EINA_FALSE;
}
