/* Quarter turns and mirrors of packed 8-bit images. */
#include "image_util_private.h"

#include <dlog.h>
#include <string.h>

int image_util_rotate(unsigned char *dest, int *dest_width, int *dest_height, image_util_rotation_e dest_rotation,
                      const unsigned char *src, int src_width, int src_height, image_util_colorspace_e colorspace)
{
	if (!dest || !dest_width || !dest_height || !src || src_width <= 0 || src_height <= 0 ||
	    (int)dest_rotation < IMAGE_UTIL_ROTATION_NONE || (int)dest_rotation > IMAGE_UTIL_ROTATION_FLIP_VERT) {
		LOGE("invalid parameter");
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	int ret = image_util_check_packed(colorspace);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		return ret;
	const int bpp = image_util_packed_bpp(colorspace);
	const size_t bytes = image_util_packed_size(src_width, src_height, bpp);
	if (!bytes) {
		LOGE("%d x %d is too large", src_width, src_height);
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	const int w = src_width, h = src_height;
	const int turned = dest_rotation == IMAGE_UTIL_ROTATION_90 || dest_rotation == IMAGE_UTIL_ROTATION_270;
	const int dw = turned ? h : w;
	const int dh = turned ? w : h;
	if (dest_rotation == IMAGE_UTIL_ROTATION_NONE) {
		memcpy(dest, src, bytes);
	} else {
		for (int y = 0; y < dh; y++) {
			unsigned char *out = dest + (size_t)y * (size_t)dw * (size_t)bpp;
			for (int x = 0; x < dw; x++) {
				/* The source pixel that lands on (x, y), turning clockwise. */
				int sx, sy;
				switch (dest_rotation) {
				case IMAGE_UTIL_ROTATION_90:
					sx = y;
					sy = h - 1 - x;
					break;
				case IMAGE_UTIL_ROTATION_180:
					sx = w - 1 - x;
					sy = h - 1 - y;
					break;
				case IMAGE_UTIL_ROTATION_270:
					sx = w - 1 - y;
					sy = x;
					break;
				case IMAGE_UTIL_ROTATION_FLIP_HORZ:
					sx = w - 1 - x;
					sy = y;
					break;
				default:
					sx = x;
					sy = h - 1 - y;
					break;
				}
				memcpy(out + (size_t)x * (size_t)bpp, src + ((size_t)sy * (size_t)w + (size_t)sx) * (size_t)bpp,
				       (size_t)bpp);
			}
		}
	}
	*dest_width = dw;
	*dest_height = dh;
	return IMAGE_UTIL_ERROR_NONE;
}
