/* Share requests read into subject, text and files. */
#define _GNU_SOURCE
#include "share_content.h"

#include "companion.h"

#include <Eina.h>
#include <stdlib.h>
#include <string.h>

bool share_content_read(app_control_h request, share_content_s *content)
{
	memset(content, 0, sizeof(*content));
	content->subject = companion_extra_get(request, COMPANION_KEY_SUBJECT);
	content->text = companion_extra_get(request, COMPANION_KEY_TEXT);
	content->paths = companion_extra_paths_get(request, COMPANION_KEY_PATH, &content->count);
	if (!content->count) {
		char *uri = NULL;
		app_control_get_uri(request, &uri);
		char *path = companion_path_from_uri(uri);
		free(uri);
		if (path && (content->paths = malloc(sizeof(char *)))) {
			content->paths[0] = path;
			content->count = 1;
		} else {
			free(path);
		}
	}
	return (content->text && *content->text) || content->count > 0 || (content->subject && *content->subject);
}

void share_content_clear(share_content_s *content)
{
	free(content->subject);
	free(content->text);
	companion_strings_free(content->paths, content->count);
	memset(content, 0, sizeof(*content));
}

char *share_content_title_new(const share_content_s *content, int max_len)
{
	const char *from = content->subject && *content->subject ? content->subject : content->text;
	if (!from)
		return NULL;
	while (*from == '\n' || *from == ' ')
		from++;
	int len = (int)strcspn(from, "\n");
	if (len > max_len) {
		len = max_len;
		while (len > 0 && ((unsigned char)from[len] & 0xC0) == 0x80)
			len--; /* not in the middle of a character */
	}
	while (len > 0 && from[len - 1] == ' ')
		len--;
	return len > 0 ? strndup(from, len) : NULL;
}

/* "file://" and the path with every byte outside the unreserved set and "/" written as %XX. */
static void uri_append(Eina_Strbuf *buf, const char *path)
{
	eina_strbuf_append(buf, "file://");
	for (const unsigned char *p = (const unsigned char *)path; *p; p++) {
		if ((*p >= 'a' && *p <= 'z') || (*p >= 'A' && *p <= 'Z') || (*p >= '0' && *p <= '9') || strchr("/-._~", *p))
			eina_strbuf_append_char(buf, (char)*p);
		else
			eina_strbuf_append_printf(buf, "%%%02X", *p);
	}
}

char *share_content_clip_text_new(const share_content_s *content)
{
	Eina_Strbuf *buf = eina_strbuf_new();
	const char *text = content->text ? content->text : "";
	if (content->subject && *content->subject && strncmp(text, content->subject, strlen(content->subject))) {
		eina_strbuf_append(buf, content->subject);
		eina_strbuf_append_char(buf, '\n');
	}
	eina_strbuf_append(buf, text);
	for (int i = 0; i < content->count; i++) {
		if (eina_strbuf_length_get(buf) && eina_strbuf_string_get(buf)[eina_strbuf_length_get(buf) - 1] != '\n')
			eina_strbuf_append_char(buf, '\n');
		uri_append(buf, content->paths[i]);
	}
	return eina_strbuf_release(buf);
}
