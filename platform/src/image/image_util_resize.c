/* Scaling of packed 8-bit images: a separable tent filter whose width follows the reduction, so that
   shrinking averages every covered source pixel and enlarging is bilinear. */
#include "image_util_private.h"

#include <dlog.h>
#include <math.h>
#include <stdlib.h>
#include <string.h>

/* The source pixels and weights that make one output pixel along one axis. */
typedef struct {
	int first;
	int count;
	int offset; /* into the shared weight array */
} taps_t;

typedef struct {
	taps_t *taps;
	float *weights;
} filter_t;

static void filter_free(filter_t *f)
{
	free(f->taps);
	free(f->weights);
}

static int filter_make(filter_t *f, int src, int dst)
{
	float ratio = (float)src / (float)dst;
	float support = ratio > 1.0f ? ratio : 1.0f;
	int max_taps = (int)ceilf(support) * 2 + 1;
	f->taps = calloc((size_t)dst, sizeof(taps_t));
	f->weights = calloc((size_t)dst * (size_t)max_taps, sizeof(float));
	if (!f->taps || !f->weights) {
		filter_free(f);
		return 0;
	}
	for (int i = 0; i < dst; i++) {
		float center = ((float)i + 0.5f) * ratio - 0.5f;
		int lo = (int)ceilf(center - support);
		int hi = (int)floorf(center + support);
		if (lo < 0)
			lo = 0;
		if (hi > src - 1)
			hi = src - 1;
		if (hi - lo + 1 > max_taps)
			hi = lo + max_taps - 1;
		taps_t *t = &f->taps[i];
		t->offset = i * max_taps;
		float sum = 0.0f;
		int count = 0;
		for (int x = lo; x <= hi; x++) {
			float w = 1.0f - fabsf((float)x - center) / support;
			if (w < 0.0f)
				w = 0.0f;
			f->weights[t->offset + count++] = w;
			sum += w;
		}
		t->first = lo;
		t->count = count;
		if (sum <= 0.0f) {
			/* Only at the very edge: take the nearest pixel. */
			int nearest = (int)lroundf(center);
			t->first = nearest < 0 ? 0 : (nearest > src - 1 ? src - 1 : nearest);
			t->count = 1;
			f->weights[t->offset] = 1.0f;
			continue;
		}
		for (int k = 0; k < count; k++)
			f->weights[t->offset + k] /= sum;
	}
	return 1;
}

static unsigned char clamp_byte(float v)
{
	if (v <= 0.0f)
		return 0;
	if (v >= 255.0f)
		return 255;
	return (unsigned char)(v + 0.5f);
}

/* Rows of src (sw wide) into rows of dst (dw wide). */
static void scale_rows(unsigned char *dst, int dw, const unsigned char *src, int sw, int rows, int bpp,
                       const filter_t *f)
{
	for (int y = 0; y < rows; y++) {
		const unsigned char *in = src + (size_t)y * (size_t)sw * (size_t)bpp;
		unsigned char *out = dst + (size_t)y * (size_t)dw * (size_t)bpp;
		for (int x = 0; x < dw; x++) {
			const taps_t *t = &f->taps[x];
			const float *w = f->weights + t->offset;
			float acc[4] = {0, 0, 0, 0};
			for (int k = 0; k < t->count; k++) {
				const unsigned char *p = in + (size_t)(t->first + k) * (size_t)bpp;
				for (int c = 0; c < bpp; c++)
					acc[c] += w[k] * (float)p[c];
			}
			for (int c = 0; c < bpp; c++)
				out[(size_t)x * (size_t)bpp + (size_t)c] = clamp_byte(acc[c]);
		}
	}
}

/* Columns of src (sh high) into columns of dst (dh high); both are width pixels wide. */
static int scale_columns(unsigned char *dst, int dh, const unsigned char *src, int width, int bpp, const filter_t *f)
{
	size_t stride = (size_t)width * (size_t)bpp;
	float *acc = malloc(stride * sizeof(float));
	if (!acc)
		return 0;
	for (int y = 0; y < dh; y++) {
		const taps_t *t = &f->taps[y];
		const float *w = f->weights + t->offset;
		memset(acc, 0, stride * sizeof(float));
		for (int k = 0; k < t->count; k++) {
			const unsigned char *in = src + (size_t)(t->first + k) * stride;
			for (size_t i = 0; i < stride; i++)
				acc[i] += w[k] * (float)in[i];
		}
		unsigned char *out = dst + (size_t)y * stride;
		for (size_t i = 0; i < stride; i++)
			out[i] = clamp_byte(acc[i]);
	}
	free(acc);
	return 1;
}

int image_util_resize(unsigned char *dest, int *dest_width, int *dest_height, const unsigned char *src, int src_width,
                      int src_height, image_util_colorspace_e colorspace)
{
	if (!dest || !dest_width || !dest_height || !src || src_width <= 0 || src_height <= 0 || *dest_width <= 0 ||
	    *dest_height <= 0) {
		LOGE("invalid parameter");
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	int ret = image_util_check_packed(colorspace);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		return ret;
	int bpp = image_util_packed_bpp(colorspace);
	int dw = *dest_width;
	int dh = *dest_height;
	size_t mid_bytes = image_util_packed_size(dw, src_height, bpp);
	if (!mid_bytes || !image_util_packed_size(dw, dh, bpp) || !image_util_packed_size(src_width, src_height, bpp)) {
		LOGE("sizes too large: %d x %d to %d x %d", src_width, src_height, dw, dh);
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	filter_t fx = {0}, fy = {0};
	unsigned char *mid = malloc(mid_bytes);
	if (!mid || !filter_make(&fx, src_width, dw) || !filter_make(&fy, src_height, dh)) {
		free(mid);
		filter_free(&fx);
		filter_free(&fy);
		LOGE("out of memory");
		return IMAGE_UTIL_ERROR_OUT_OF_MEMORY;
	}
	scale_rows(mid, dw, src, src_width, src_height, bpp, &fx);
	if (!scale_columns(dest, dh, mid, dw, bpp, &fy)) {
		LOGE("out of memory");
		ret = IMAGE_UTIL_ERROR_OUT_OF_MEMORY;
	}
	free(mid);
	filter_free(&fx);
	filter_free(&fy);
	return ret;
}
