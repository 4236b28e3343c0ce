#ifndef __TIZEN_APPFW_APP_INFO_H__
#define __TIZEN_APPFW_APP_INFO_H__

#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

/* A registered application (its registry entry). */
typedef struct app_info_s *app_info_h;

int app_info_destroy(app_info_h app_info);
int app_info_clone(app_info_h *clone, app_info_h app_info);
/* Fields of the registry entry, malloc'ed (caller frees). A missing icon or label gives an empty string. */
int app_info_get_app_id(app_info_h app_info, char **app_id);
int app_info_get_exec(app_info_h app_info, char **exec);
int app_info_get_label(app_info_h app_info, char **label);
int app_info_get_icon(app_info_h app_info, char **path);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_APPFW_APP_INFO_H__ */
