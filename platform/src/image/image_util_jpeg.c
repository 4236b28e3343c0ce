/* JPEG decode (optionally scaled down by the decoder) and encode, on the TurboJPEG API. */
#include "image_util_private.h"

#include <dlog.h>
#include <errno.h>
#include <fcntl.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <turbojpeg.h>
#include <unistd.h>

static int pixel_format(image_util_colorspace_e colorspace)
{
	switch (colorspace) {
	case IMAGE_UTIL_COLORSPACE_RGB888:
		return TJPF_RGB;
	case IMAGE_UTIL_COLORSPACE_ARGB8888:
		return TJPF_ARGB;
	case IMAGE_UTIL_COLORSPACE_BGRA8888:
		return TJPF_BGRA;
	case IMAGE_UTIL_COLORSPACE_RGBA8888:
		return TJPF_RGBA;
	default:
		return TJPF_BGRX;
	}
}

static int errno_to_error(int err)
{
	if (err == ENOENT || err == ENOTDIR)
		return IMAGE_UTIL_ERROR_NO_SUCH_FILE;
	if (err == EACCES || err == EPERM)
		return IMAGE_UTIL_ERROR_PERMISSION_DENIED;
	return IMAGE_UTIL_ERROR_INVALID_OPERATION;
}

/* Reads the whole file into a new buffer. */
static int read_file(const char *path, unsigned char **data, size_t *len)
{
	FILE *f = fopen(path, "rb");
	if (!f) {
		int err = errno;
		LOGE("cannot open %s: %s", path, strerror(err));
		return errno_to_error(err);
	}
	struct stat st;
	if (fstat(fileno(f), &st) != 0 || !S_ISREG(st.st_mode) || st.st_size <= 0) {
		LOGE("%s is not a readable image file", path);
		fclose(f);
		return IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT;
	}
	unsigned char *buf = malloc((size_t)st.st_size);
	if (!buf) {
		fclose(f);
		return IMAGE_UTIL_ERROR_OUT_OF_MEMORY;
	}
	size_t got = fread(buf, 1, (size_t)st.st_size, f);
	fclose(f);
	if (got != (size_t)st.st_size) {
		LOGE("short read of %s", path);
		free(buf);
		return IMAGE_UTIL_ERROR_INVALID_OPERATION;
	}
	*data = buf;
	*len = got;
	return IMAGE_UTIL_ERROR_NONE;
}

static int scale_denominator(image_util_scale_e downscale)
{
	switch (downscale) {
	case IMAGE_UTIL_DOWNSCALE_1_1:
		return 1;
	case IMAGE_UTIL_DOWNSCALE_1_2:
		return 2;
	case IMAGE_UTIL_DOWNSCALE_1_4:
		return 4;
	case IMAGE_UTIL_DOWNSCALE_1_8:
		return 8;
	}
	return 0;
}

/* Decodes jpeg/len at 1/denom into a new packed buffer. */
static int decode_memory(const unsigned char *jpeg, size_t len, const char *path, image_util_colorspace_e colorspace,
                         int denom, unsigned char **out, int *out_w, int *out_h, unsigned int *out_size)
{
	if (len < 2 || jpeg[0] != 0xFF || jpeg[1] != 0xD8) {
		LOGE("%s is not a JPEG file", path);
		return IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT;
	}
	tjhandle tj = tjInitDecompress();
	if (!tj)
		return IMAGE_UTIL_ERROR_OUT_OF_MEMORY;
	int ret = IMAGE_UTIL_ERROR_NONE;
	unsigned char *pixels = NULL;
	int w = 0, h = 0, subsamp = 0, jpeg_cs = 0;
	if (tjDecompressHeader3(tj, jpeg, (unsigned long)len, &w, &h, &subsamp, &jpeg_cs) != 0) {
		LOGE("bad JPEG header in %s: %s", path, tjGetErrorStr2(tj));
		ret = IMAGE_UTIL_ERROR_INVALID_OPERATION;
		goto out;
	}
	tjscalingfactor factor = {1, denom};
	int sw = TJSCALED(w, factor);
	int sh = TJSCALED(h, factor);
	int bpp = image_util_packed_bpp(colorspace);
	size_t bytes = image_util_packed_size(sw, sh, bpp);
	if (!bytes) {
		LOGE("%s: %d x %d is too large to decode", path, sw, sh);
		ret = IMAGE_UTIL_ERROR_INVALID_OPERATION;
		goto out;
	}
	pixels = malloc(bytes);
	if (!pixels) {
		ret = IMAGE_UTIL_ERROR_OUT_OF_MEMORY;
		goto out;
	}
	/* A damaged tail is a warning: the rows decoded so far are kept, as camera apps expect. */
	if (tjDecompress2(tj, jpeg, (unsigned long)len, pixels, sw, sw * bpp, sh, pixel_format(colorspace), 0) != 0 &&
	    tjGetErrorCode(tj) != TJERR_WARNING) {
		LOGE("cannot decode %s: %s", path, tjGetErrorStr2(tj));
		free(pixels);
		pixels = NULL;
		ret = IMAGE_UTIL_ERROR_INVALID_OPERATION;
		goto out;
	}
	*out = pixels;
	*out_w = sw;
	*out_h = sh;
	if (out_size)
		*out_size = (unsigned int)bytes;
out:
	tjDestroy(tj);
	return ret;
}

int image_util_decode_jpeg_with_downscale(const char *path, image_util_colorspace_e colorspace,
                                          image_util_scale_e downscale, unsigned char **image_buffer, int *width,
                                          int *height, unsigned int *size)
{
	if (!path || !image_buffer || !width || !height || !size) {
		LOGE("invalid parameter");
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	int denom = scale_denominator(downscale);
	if (!denom) {
		LOGE("invalid downscale %d", (int)downscale);
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	int ret = image_util_check_packed(colorspace);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		return ret;
	unsigned char *jpeg = NULL;
	size_t len = 0;
	ret = read_file(path, &jpeg, &len);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		return ret;
	ret = decode_memory(jpeg, len, path, colorspace, denom, image_buffer, width, height, size);
	free(jpeg);
	return ret;
}

int image_util_decode_jpeg(const char *path, image_util_colorspace_e colorspace, unsigned char **image_buffer,
                           int *width, int *height, unsigned int *size)
{
	return image_util_decode_jpeg_with_downscale(path, colorspace, IMAGE_UTIL_DOWNSCALE_1_1, image_buffer, width,
	                                             height, size);
}

/* Writes data to path through a temporary file in the same folder and a rename. */
static int write_file_atomic(const char *path, const unsigned char *data, size_t len)
{
	size_t plen = strlen(path);
	char *tmp = malloc(plen + 16);
	if (!tmp)
		return IMAGE_UTIL_ERROR_OUT_OF_MEMORY;
	snprintf(tmp, plen + 16, "%s.tmp-XXXXXX", path);
	int fd = mkstemp(tmp);
	if (fd < 0) {
		int err = errno;
		LOGE("cannot create a file beside %s: %s", path, strerror(err));
		free(tmp);
		return errno_to_error(err);
	}
	int ret = IMAGE_UTIL_ERROR_NONE;
	size_t done = 0;
	while (done < len) {
		ssize_t n = write(fd, data + done, len - done);
		if (n < 0 && errno == EINTR)
			continue;
		if (n <= 0) {
			LOGE("cannot write %s: %s", tmp, strerror(errno));
			ret = IMAGE_UTIL_ERROR_INVALID_OPERATION;
			break;
		}
		done += (size_t)n;
	}
	if (ret == IMAGE_UTIL_ERROR_NONE && fchmod(fd, 0644) != 0)
		LOGE("cannot set the mode of %s", tmp);
	if (close(fd) != 0 && ret == IMAGE_UTIL_ERROR_NONE)
		ret = IMAGE_UTIL_ERROR_INVALID_OPERATION;
	if (ret == IMAGE_UTIL_ERROR_NONE && rename(tmp, path) != 0) {
		int err = errno;
		LOGE("cannot rename %s to %s: %s", tmp, path, strerror(err));
		ret = errno_to_error(err);
	}
	if (ret != IMAGE_UTIL_ERROR_NONE)
		unlink(tmp);
	free(tmp);
	return ret;
}

int image_util_encode_jpeg(const unsigned char *buffer, int width, int height, image_util_colorspace_e colorspace,
                           int quality, const char *path)
{
	if (!buffer || !path || width <= 0 || height <= 0 || quality < 1 || quality > 100) {
		LOGE("invalid parameter");
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	int ret = image_util_check_packed(colorspace);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		return ret;
	int bpp = image_util_packed_bpp(colorspace);
	if (!image_util_packed_size(width, height, bpp)) {
		LOGE("%d x %d is too large to encode", width, height);
		return IMAGE_UTIL_ERROR_INVALID_PARAMETER;
	}
	tjhandle tj = tjInitCompress();
	if (!tj)
		return IMAGE_UTIL_ERROR_OUT_OF_MEMORY;
	unsigned char *jpeg = NULL;
	unsigned long len = 0;
	if (tjCompress2(tj, buffer, width, width * bpp, height, pixel_format(colorspace), &jpeg, &len, TJSAMP_420, quality,
	                0) != 0) {
		LOGE("cannot encode %s: %s", path, tjGetErrorStr2(tj));
		ret = IMAGE_UTIL_ERROR_INVALID_OPERATION;
	} else {
		ret = write_file_atomic(path, jpeg, len);
	}
	tjFree(jpeg);
	tjDestroy(tj);
	return ret;
}
