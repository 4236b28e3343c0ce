/* Byte-level helpers of the bundle text form: a growing writer, a bounded reader, base64. */
#ifndef PLATFORM_SRC_APP_BUNDLE_CODEC_H
#define PLATFORM_SRC_APP_BUNDLE_CODEC_H

#include <stdbool.h>
#include <stddef.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

#define BUNDLE_CODEC_MAGIC 0x42444c31u /* "BDL1" */

typedef struct {
	unsigned char *data;
	size_t size;
	size_t capacity;
	bool failed; /* an allocation failed; the content is incomplete */
} bundle_writer_s;

typedef struct {
	const unsigned char *data;
	size_t size;
	size_t pos;
} bundle_reader_s;

void bundle_writer_init(bundle_writer_s *w);
/* Little-endian 32-bit number. */
void bundle_writer_u32(bundle_writer_s *w, uint32_t v);
/* Length, then the bytes. */
void bundle_writer_blob(bundle_writer_s *w, const void *bytes, size_t len);

bool bundle_reader_u32(bundle_reader_s *r, uint32_t *v);
/* Points *bytes into the reader's data; false when the length runs past the end. */
bool bundle_reader_blob(bundle_reader_s *r, const void **bytes, size_t *len);

/* NUL-terminated base64 text (malloc'ed) or NULL. */
char *bundle_base64_encode(const unsigned char *data, size_t size);
/* Decoded bytes (malloc'ed) or NULL on a character outside the alphabet or a bad length. */
unsigned char *bundle_base64_decode(const char *text, size_t len, size_t *out_size);

#ifdef __cplusplus
}
#endif

#endif /* PLATFORM_SRC_APP_BUNDLE_CODEC_H */
