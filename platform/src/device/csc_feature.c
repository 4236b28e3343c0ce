/* Product features: a vconf key per feature number, else the desktop default. */
#include <csc_feature.h>

#include <stdio.h>

#include <vconf.h>

static CscFeatureBool __default_of(CscFeatureDefBool def)
{
	switch (def) {
	case CSC_FEATURE_DEF_BOOL_MEMO_QUICK_MEMO:
		return CSC_FEATURE_BOOL_TRUE;
	default:
		return CSC_FEATURE_BOOL_FALSE;
	}
}

CscFeatureBool csc_feature_get_bool(CscFeatureDefBool def)
{
	char key[64];
	snprintf(key, sizeof(key), "db/desktop/csc/feature_%d", (int)def);
	int value = 0;
	if (vconf_get_int(key, &value) == VCONF_OK)
		return value ? CSC_FEATURE_BOOL_TRUE : CSC_FEATURE_BOOL_FALSE;
	return __default_of(def);
}
