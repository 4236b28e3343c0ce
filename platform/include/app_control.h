#ifndef __TIZEN_APPFW_APP_CONTROL_H__
#define __TIZEN_APPFW_APP_CONTROL_H__

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct app_control_s *app_control_h;

typedef enum {
	APP_CONTROL_ERROR_NONE = TIZEN_ERROR_NONE,
	APP_CONTROL_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	APP_CONTROL_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	APP_CONTROL_ERROR_APP_NOT_FOUND = TIZEN_ERROR_APPLICATION | 0x21,
	APP_CONTROL_ERROR_KEY_NOT_FOUND = TIZEN_ERROR_KEY_NOT_AVAILABLE,
	APP_CONTROL_ERROR_KEY_REJECTED = TIZEN_ERROR_KEY_REJECTED,
	APP_CONTROL_ERROR_INVALID_DATA_TYPE = TIZEN_ERROR_APPLICATION | 0x22,
	APP_CONTROL_ERROR_LAUNCH_REJECTED = TIZEN_ERROR_APPLICATION | 0x23,
	APP_CONTROL_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
	APP_CONTROL_ERROR_LAUNCH_FAILED = TIZEN_ERROR_APPLICATION | 0x24,
	APP_CONTROL_ERROR_TIMED_OUT = TIZEN_ERROR_TIMED_OUT,
	APP_CONTROL_ERROR_IO_ERROR = TIZEN_ERROR_IO_ERROR,
} app_control_error_e;

typedef enum {
	APP_CONTROL_RESULT_APP_STARTED = 1,
	APP_CONTROL_RESULT_SUCCEEDED = 0,
	APP_CONTROL_RESULT_FAILED = -1,
	APP_CONTROL_RESULT_CANCELED = -2,
} app_control_result_e;

typedef enum {
	APP_CONTROL_LAUNCH_MODE_SINGLE = 0,
	APP_CONTROL_LAUNCH_MODE_GROUP,
} app_control_launch_mode_e;

#define APP_CONTROL_OPERATION_MAIN "http://tizen.org/appcontrol/operation/main"
#define APP_CONTROL_OPERATION_DEFAULT "http://tizen.org/appcontrol/operation/default"
#define APP_CONTROL_OPERATION_EDIT "http://tizen.org/appcontrol/operation/edit"
#define APP_CONTROL_OPERATION_VIEW "http://tizen.org/appcontrol/operation/view"
#define APP_CONTROL_OPERATION_PICK "http://tizen.org/appcontrol/operation/pick"
#define APP_CONTROL_OPERATION_CREATE_CONTENT "http://tizen.org/appcontrol/operation/create_content"
#define APP_CONTROL_OPERATION_CALL "http://tizen.org/appcontrol/operation/call"
#define APP_CONTROL_OPERATION_SEND "http://tizen.org/appcontrol/operation/send"
#define APP_CONTROL_OPERATION_SEND_TEXT "http://tizen.org/appcontrol/operation/send_text"
#define APP_CONTROL_OPERATION_SHARE "http://tizen.org/appcontrol/operation/share"
#define APP_CONTROL_OPERATION_MULTI_SHARE "http://tizen.org/appcontrol/operation/multi_share"
#define APP_CONTROL_OPERATION_SHARE_TEXT "http://tizen.org/appcontrol/operation/share_text"
#define APP_CONTROL_OPERATION_DIAL "http://tizen.org/appcontrol/operation/dial"
#define APP_CONTROL_OPERATION_SEARCH "http://tizen.org/appcontrol/operation/search"
#define APP_CONTROL_OPERATION_DOWNLOAD "http://tizen.org/appcontrol/operation/download"
#define APP_CONTROL_OPERATION_PRINT "http://tizen.org/appcontrol/operation/print"
#define APP_CONTROL_OPERATION_COMPOSE "http://tizen.org/appcontrol/operation/compose"
#define APP_CONTROL_OPERATION_ADD "http://tizen.org/appcontrol/operation/add"
#define APP_CONTROL_OPERATION_IMAGE_CAPTURE "http://tizen.org/appcontrol/operation/image_capture"
#define APP_CONTROL_OPERATION_VIDEO_CAPTURE "http://tizen.org/appcontrol/operation/video_capture"
#define APP_CONTROL_OPERATION_SETTING "http://tizen.org/appcontrol/operation/setting"
#define APP_CONTROL_OPERATION_SETTING_BT_ENABLE "http://tizen.org/appcontrol/operation/setting/bt_enable"
#define APP_CONTROL_OPERATION_SETTING_BT_VISIBILITY "http://tizen.org/appcontrol/operation/setting/bt_visibility"
#define APP_CONTROL_OPERATION_SETTING_LOCATION "http://tizen.org/appcontrol/operation/setting/location"
#define APP_CONTROL_OPERATION_SETTING_NFC "http://tizen.org/appcontrol/operation/setting/nfc"
#define APP_CONTROL_OPERATION_SETTING_WIFI "http://tizen.org/appcontrol/operation/setting/wifi"

#define APP_CONTROL_DATA_SUBJECT "http://tizen.org/appcontrol/data/subject"
#define APP_CONTROL_DATA_TO "http://tizen.org/appcontrol/data/to"
#define APP_CONTROL_DATA_CC "http://tizen.org/appcontrol/data/cc"
#define APP_CONTROL_DATA_BCC "http://tizen.org/appcontrol/data/bcc"
#define APP_CONTROL_DATA_TEXT "http://tizen.org/appcontrol/data/text"
#define APP_CONTROL_DATA_TITLE "http://tizen.org/appcontrol/data/title"
#define APP_CONTROL_DATA_SELECTED "http://tizen.org/appcontrol/data/selected"
#define APP_CONTROL_DATA_PATH "http://tizen.org/appcontrol/data/path"
#define APP_CONTROL_DATA_SELECTION_MODE "http://tizen.org/appcontrol/data/selection_mode"
#define APP_CONTROL_DATA_EMAIL "http://tizen.org/appcontrol/data/email"
#define APP_CONTROL_DATA_PHONE "http://tizen.org/appcontrol/data/phone"
#define APP_CONTROL_DATA_URL "http://tizen.org/appcontrol/data/url"
#define APP_CONTROL_DATA_ID "http://tizen.org/appcontrol/data/id"
#define APP_CONTROL_DATA_TYPE "http://tizen.org/appcontrol/data/type"
#define APP_CONTROL_DATA_TOTAL_COUNT "http://tizen.org/appcontrol/data/total_count"
#define APP_CONTROL_DATA_TOTAL_SIZE "http://tizen.org/appcontrol/data/total_size"
#define APP_CONTROL_DATA_NAME "http://tizen.org/appcontrol/data/name"

/* Called on the requester's main loop with the callee's reply (or an empty one with CANCELED when the callee
   ended without replying). Both handles live for the call only. */
typedef void (*app_control_reply_cb)(app_control_h request, app_control_h reply, app_control_result_e result,
                                     void *user_data);
/* Called once per extra data key; return false to stop. */
typedef bool (*app_control_extra_data_cb)(app_control_h app_control, const char *key, void *user_data);
/* Called once per registered application that can take the request; return false to stop. */
typedef bool (*app_control_app_matched_cb)(app_control_h app_control, const char *appid, void *user_data);

/* Handle life: create an empty request (operation unset), destroy it, or deep-copy it into *clone. */
int app_control_create(app_control_h *app_control);
int app_control_destroy(app_control_h app_control);
int app_control_clone(app_control_h *clone, app_control_h app_control);

/* Scalar fields. Setters copy the text (NULL clears it); getters return a malloc'ed copy the caller frees,
   or NULL in *out when the field is unset. */
int app_control_set_operation(app_control_h app_control, const char *operation);
int app_control_get_operation(app_control_h app_control, char **operation);
int app_control_set_uri(app_control_h app_control, const char *uri);
int app_control_get_uri(app_control_h app_control, char **uri);
int app_control_set_mime(app_control_h app_control, const char *mime);
int app_control_get_mime(app_control_h app_control, char **mime);
int app_control_set_category(app_control_h app_control, const char *category);
int app_control_get_category(app_control_h app_control, char **category);
int app_control_set_app_id(app_control_h app_control, const char *app_id);
int app_control_get_app_id(app_control_h app_control, char **app_id);
int app_control_set_launch_mode(app_control_h app_control, app_control_launch_mode_e mode);
int app_control_get_launch_mode(app_control_h app_control, app_control_launch_mode_e *mode);

/* Extra data: a key holds either one string or an array of strings. Adding replaces an existing key.
   Keys reserved by the platform give KEY_REJECTED; a missing key KEY_NOT_FOUND; reading a key with the
   wrong getter INVALID_DATA_TYPE. Returned strings and arrays are malloc'ed: free each element, then the array. */
int app_control_add_extra_data(app_control_h app_control, const char *key, const char *value);
int app_control_add_extra_data_array(app_control_h app_control, const char *key, const char *value[], int length);
int app_control_remove_extra_data(app_control_h app_control, const char *key);
int app_control_get_extra_data(app_control_h app_control, const char *key, char **value);
int app_control_get_extra_data_array(app_control_h app_control, const char *key, char ***value, int *length);
int app_control_is_extra_data_array(app_control_h app_control, const char *key, bool *array);
int app_control_foreach_extra_data(app_control_h app_control, app_control_extra_data_cb callback, void *user_data);
int app_control_foreach_app_matched(app_control_h app_control, app_control_app_matched_cb callback, void *user_data);

/* Launch requests. send_launch_request starts the target when it is not running (APP_NOT_FOUND when no
   registered app has the id); the reply, if a callback is given, comes later on the main loop.
   send_terminate_request ends an app this process launched in group mode.
   reply_to_launch_request answers a received request (APP_STARTED is not a valid result). */
int app_control_send_launch_request(app_control_h app_control, app_control_reply_cb callback, void *user_data);
int app_control_send_terminate_request(app_control_h app_control);
int app_control_reply_to_launch_request(app_control_h reply, app_control_h request, app_control_result_e result);

/* Received requests: the id of the app that sent it (malloc'ed) and whether it waits for a reply. */
int app_control_get_caller(app_control_h app_control, char **id);
int app_control_is_reply_requested(app_control_h app_control, bool *requested);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_CONTROL_H__ */
