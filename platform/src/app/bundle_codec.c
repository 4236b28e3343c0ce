/* Byte-level helpers of the bundle text form. */
#include "bundle_codec.h"

#include <stdlib.h>
#include <string.h>

void bundle_writer_init(bundle_writer_s *w)
{
	memset(w, 0, sizeof(*w));
}

static void writer_put(bundle_writer_s *w, const void *bytes, size_t len)
{
	if (w->failed)
		return;
	if (w->size + len > w->capacity) {
		size_t cap = w->capacity ? w->capacity : 256;
		while (cap < w->size + len)
			cap *= 2;
		unsigned char *data = realloc(w->data, cap);
		if (!data) {
			w->failed = true;
			return;
		}
		w->data = data;
		w->capacity = cap;
	}
	if (len)
		memcpy(w->data + w->size, bytes, len);
	w->size += len;
}

void bundle_writer_u32(bundle_writer_s *w, uint32_t v)
{
	unsigned char b[4] = {(unsigned char)v, (unsigned char)(v >> 8), (unsigned char)(v >> 16),
	                      (unsigned char)(v >> 24)};
	writer_put(w, b, 4);
}

void bundle_writer_blob(bundle_writer_s *w, const void *bytes, size_t len)
{
	bundle_writer_u32(w, (uint32_t)len);
	writer_put(w, bytes, len);
}

bool bundle_reader_u32(bundle_reader_s *r, uint32_t *v)
{
	if (r->size - r->pos < 4)
		return false;
	const unsigned char *b = r->data + r->pos;
	*v = (uint32_t)b[0] | (uint32_t)b[1] << 8 | (uint32_t)b[2] << 16 | (uint32_t)b[3] << 24;
	r->pos += 4;
	return true;
}

bool bundle_reader_blob(bundle_reader_s *r, const void **bytes, size_t *len)
{
	uint32_t n = 0;
	if (!bundle_reader_u32(r, &n) || r->size - r->pos < n)
		return false;
	*bytes = r->data + r->pos;
	*len = n;
	r->pos += n;
	return true;
}

static const char B64[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";

char *bundle_base64_encode(const unsigned char *data, size_t size)
{
	char *out = malloc((size + 2) / 3 * 4 + 1);
	if (!out)
		return NULL;
	size_t o = 0;
	for (size_t i = 0; i < size; i += 3) {
		uint32_t v = (uint32_t)data[i] << 16;
		if (i + 1 < size)
			v |= (uint32_t)data[i + 1] << 8;
		if (i + 2 < size)
			v |= data[i + 2];
		out[o++] = B64[(v >> 18) & 63];
		out[o++] = B64[(v >> 12) & 63];
		out[o++] = i + 1 < size ? B64[(v >> 6) & 63] : '=';
		out[o++] = i + 2 < size ? B64[v & 63] : '=';
	}
	out[o] = '\0';
	return out;
}

static int b64_value(char c)
{
	const char *p = c ? strchr(B64, c) : NULL;
	return p ? (int)(p - B64) : -1;
}

unsigned char *bundle_base64_decode(const char *text, size_t len, size_t *out_size)
{
	/* Tolerate a trailing NUL counted in len. */
	while (len && text[len - 1] == '\0')
		len--;
	if (len % 4)
		return NULL;
	unsigned char *out = malloc(len / 4 * 3 + 1);
	if (!out)
		return NULL;
	size_t o = 0;
	for (size_t i = 0; i < len; i += 4) {
		int pad = (text[i + 3] == '=') + (text[i + 2] == '=');
		bool last = i + 4 == len;
		int a = b64_value(text[i]), b = b64_value(text[i + 1]);
		int c = pad >= 2 ? 0 : b64_value(text[i + 2]);
		int d = pad >= 1 ? 0 : b64_value(text[i + 3]);
		if (a < 0 || b < 0 || c < 0 || d < 0 || (pad && !last) || (pad == 1 && text[i + 2] == '=')) {
			free(out);
			return NULL;
		}
		uint32_t v = (uint32_t)a << 18 | (uint32_t)b << 12 | (uint32_t)c << 6 | (uint32_t)d;
		out[o++] = (unsigned char)(v >> 16);
		if (pad < 2)
			out[o++] = (unsigned char)(v >> 8);
		if (pad < 1)
			out[o++] = (unsigned char)v;
	}
	*out_size = o;
	return out;
}
