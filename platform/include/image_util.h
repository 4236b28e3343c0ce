#ifndef __TIZEN_MEDIA_IMAGE_UTIL_H__
#define __TIZEN_MEDIA_IMAGE_UTIL_H__

#include <image_util_type.h>

#ifdef __cplusplus
extern "C" {
#endif

/*
 * Raw image buffers are tightly packed rows, no padding. decode, encode, resize and rotate take
 * the packed 8-bit colourspaces RGB888, ARGB8888, BGRA8888, RGBA8888 and BGRX8888; any other
 * colourspace gives IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT. Null pointers, sizes below 1 and values
 * outside the enumerations give IMAGE_UTIL_ERROR_INVALID_PARAMETER. Every call is safe on any thread.
 */

/* Bytes of a width x height image in the colourspace (any of the enumeration) into *size. */
int image_util_calculate_buffer_size(int width, int height, image_util_colorspace_e colorspace, unsigned int *size);

/*
 * Decodes the JPEG file at path. On success *image_buffer is a new buffer that the caller frees
 * with free(), *width and *height are the picture's size, *size its byte count. A missing file gives
 * IMAGE_UTIL_ERROR_NO_SUCH_FILE, a file that is not a JPEG IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT, a
 * damaged one IMAGE_UTIL_ERROR_INVALID_OPERATION. Failures are logged.
 */
int image_util_decode_jpeg(const char *path, image_util_colorspace_e colorspace, unsigned char **image_buffer,
                           int *width, int *height, unsigned int *size);

/*
 * Like image_util_decode_jpeg, scaled down while decoding by 1/2, 1/4 or 1/8; each side is rounded
 * up (a 101 x 51 picture at 1/2 is 51 x 26). Far cheaper than a full decode followed by a resize.
 */
int image_util_decode_jpeg_with_downscale(const char *path, image_util_colorspace_e colorspace,
                                          image_util_scale_e downscale, unsigned char **image_buffer, int *width,
                                          int *height, unsigned int *size);

/*
 * Encodes width x height pixels of buffer as a baseline JPEG of quality 1 to 100 at path. The file is
 * written under a temporary name and renamed into place, so a failure leaves any old file as it was.
 */
int image_util_encode_jpeg(const unsigned char *buffer, int width, int height, image_util_colorspace_e colorspace,
                           int quality, const char *path);

/*
 * Scales src (src_width x src_height) to *dest_width x *dest_height into dest, which the caller
 * allocates with image_util_calculate_buffer_size. Shrinking averages the covered source pixels, so
 * large reductions do not alias. The packed colourspaces keep the requested size exactly.
 */
int image_util_resize(unsigned char *dest, int *dest_width, int *dest_height, const unsigned char *src, int src_width,
                      int src_height, image_util_colorspace_e colorspace);

/*
 * Turns src clockwise by 90, 180 or 270 degrees, or mirrors it, into dest (allocated by the caller, the
 * same byte count as src). *dest_width and *dest_height receive the new size: swapped for 90 and 270.
 */
int image_util_rotate(unsigned char *dest, int *dest_width, int *dest_height, image_util_rotation_e dest_rotation,
                      const unsigned char *src, int src_width, int src_height, image_util_colorspace_e colorspace);

#ifdef __cplusplus
}
#endif

#endif
