/* What a share request carries, for the share targets: subject, text and files. */
#ifndef COMPANIONS_COMMON_SHARE_CONTENT_H
#define COMPANIONS_COMMON_SHARE_CONTENT_H

#include <app_control.h>
#include <stdbool.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct {
	char *subject; /* /appcontrol/data/subject, or NULL */
	char *text;    /* /appcontrol/data/text, or NULL */
	char **paths;  /* /appcontrol/data/path, or the file of the uri */
	int count;
} share_content_s;

/* Reads the request; false when it carries neither text nor files. */
bool share_content_read(app_control_h request, share_content_s *content);
void share_content_clear(share_content_s *content);
/* The subject, else the first line of the text (at most max_len bytes, whole characters), else NULL
   (malloc'ed). */
char *share_content_title_new(const share_content_s *content, int max_len);
/* The text, the subject in front when the text does not begin with it, then one "file://" URI per line
   (malloc'ed). */
char *share_content_clip_text_new(const share_content_s *content);

#ifdef __cplusplus
}
#endif

#endif /* COMPANIONS_COMMON_SHARE_CONTENT_H */
