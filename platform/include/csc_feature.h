#ifndef __CSC_FEATURE_H__
#define __CSC_FEATURE_H__

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	CSC_FEATURE_BOOL_FALSE = 0,
	CSC_FEATURE_BOOL_TRUE = 1,
} CscFeatureBool;

/* The product features that the apps here ask about, by their number. */
typedef enum {
	CSC_FEATURE_DEF_BOOL_MEMO_QUICK_MEMO = 92, /* the pinned quick memo; on by default */
} CscFeatureDefBool;

/* The feature's value for this product. On the desktop the int vconf key "db/desktop/csc/feature_<number>"
   (0 or 1), when set, decides; otherwise the documented default of the feature (FALSE for an unknown one). */
CscFeatureBool csc_feature_get_bool(CscFeatureDefBool def);

#ifdef __cplusplus
}
#endif

#endif /* __CSC_FEATURE_H__ */
