/* Colourspace facts: buffer sizes and which colourspaces the pixel operations handle. */
#include "image_util_private.h"

#include <dlog.h>
#include <limits.h>

int image_util_packed_bpp(image_util_colorspace_e colorspace)
{
	switch (colorspace) {
	case IMAGE_UTIL_COLORSPACE_RGB888:
		return 3;
	case IMAGE_UTIL_COLORSPACE_ARGB8888:
	case IMAGE_UTIL_COLORSPACE_BGRA8888:
	case IMAGE_UTIL_COLORSPACE_RGBA8888:
	case IMAGE_UTIL_COLORSPACE_BGRX8888:
		return 4;
	default:
		return 0;
	}
}

static int valid_colorspace(image_util_colorspace_e colorspace)
{
	return (int)colorspace >= IMAGE_UTIL_COLORSPACE_YV12 && (int)colorspace <= IMAGE_UTIL_COLORSPACE_NV61;
}

int image_util_check_packed(image_util_colorspace_e colorspace)
{
	if (!valid_colorspace(colorspace)) {
		LOGE("invalid colorspace %d", (int)colorspace);
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	if (!image_util_packed_bpp(colorspace)) {
		LOGE("colorspace %d is not supported here", (int)colorspace);
		return IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT;
	}
	return IMAGE_UTIL_ERROR_NONE;
}

size_t image_util_packed_size(int width, int height, int bpp)
{
	if (width <= 0 || height <= 0 || bpp <= 0)
		return 0;
	unsigned long long bytes = (unsigned long long)width * (unsigned long long)height * (unsigned long long)bpp;
	if (bytes > UINT_MAX)
		return 0;
	return (size_t)bytes;
}

int image_util_calculate_buffer_size(int width, int height, image_util_colorspace_e colorspace, unsigned int *size)
{
	if (!size || width <= 0 || height <= 0 || !valid_colorspace(colorspace)) {
		LOGE("invalid parameter");
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	unsigned long long w = (unsigned long long)width;
	unsigned long long h = (unsigned long long)height;
	/* Chroma planes of the subsampled formats cover odd sides with a last half-filled sample. */
	unsigned long long cw = (w + 1) / 2;
	unsigned long long ch = (h + 1) / 2;
	unsigned long long bytes;
	switch (colorspace) {
	case IMAGE_UTIL_COLORSPACE_YV12:
	case IMAGE_UTIL_COLORSPACE_I420:
	case IMAGE_UTIL_COLORSPACE_NV12:
	case IMAGE_UTIL_COLORSPACE_NV21:
		bytes = w * h + 2 * cw * ch;
		break;
	case IMAGE_UTIL_COLORSPACE_YUV422:
	case IMAGE_UTIL_COLORSPACE_NV16:
	case IMAGE_UTIL_COLORSPACE_NV61:
		bytes = w * h + 2 * cw * h;
		break;
	case IMAGE_UTIL_COLORSPACE_UYVY:
	case IMAGE_UTIL_COLORSPACE_YUYV:
		bytes = 2 * cw * 2 * h;
		break;
	case IMAGE_UTIL_COLORSPACE_RGB565:
		bytes = w * h * 2;
		break;
	default:
		bytes = w * h * (unsigned long long)image_util_packed_bpp(colorspace);
		break;
	}
	if (bytes > UINT_MAX) {
		LOGE("%d x %d is too large", width, height);
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	*size = (unsigned int)bytes;
	return IMAGE_UTIL_ERROR_NONE;
}
