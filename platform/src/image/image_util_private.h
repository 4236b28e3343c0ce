/* Helpers shared by the image_util backend files; not part of the platform's API. */
#ifndef PLATFORM_SRC_IMAGE_IMAGE_UTIL_PRIVATE_H
#define PLATFORM_SRC_IMAGE_IMAGE_UTIL_PRIVATE_H

#include <image_util.h>
#include <stddef.h>

/* Bytes per pixel of a packed 8-bit colourspace, or 0 for the planar and 16-bit ones. */
int image_util_packed_bpp(image_util_colorspace_e colorspace);

/* Checks a colourspace for the packed-only operations: NONE, INVALID_PARAMETER or NOT_SUPPORTED_FORMAT. */
int image_util_check_packed(image_util_colorspace_e colorspace);

/* width * height * bpp as size_t, or 0 when a side is not positive or the product does not fit in
   an unsigned int (the size type of the API). */
size_t image_util_packed_size(int width, int height, int bpp);

#endif
