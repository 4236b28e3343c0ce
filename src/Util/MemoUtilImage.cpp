// Image helpers of MemoUtil: admission and target size of pictures, JPEG shrinking on
// image_util, Evas rendering for other formats and thumbnails, EXIF orientation.
#include "Util/MemoUtil.h"

#include "MemoLog.h"

#include <Ecore.h>
#include <Ecore_Evas.h>
#include <Ecore_File.h>
#include <Eina.h>
#include <Evas.h>
#include <image_util.h>
#include <libexif/exif-data.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace
{
// Pixel counts at or above these are refused outright.
const int JPEG_PIXEL_LIMIT = 225000000;
const int OTHER_PIXEL_LIMIT = 9000000;
// A picture is shrunk when a side or its pixel count goes above these.
const int SIDE_LIMIT = 4000;
const int PIXEL_LIMIT = 320000;
const int SCALE_STEPS = 98;
const int JPEG_QUALITY = 100;
const int PROBE_CANVAS_SIZE = 100;

enum CropMode { CROP_FIT_HEIGHT = 0, CROP_CANVAS_TO_IMAGE = 1, CROP_STRETCH = 2, CROP_TO_BOX = 3 };

// The product in 32 signed bits, wrapping as the admission test always has.
int32_t product32(int width, int height)
{
	return static_cast<int32_t>(static_cast<uint32_t>(static_cast<int64_t>(width) * height));
}

bool isJpegName(const char *path)
{
	const char *name = ecore_file_file_get(path);
	return name && (eina_str_has_extension(name, ".jpg") || eina_str_has_extension(name, ".jpeg"));
}

bool fitsLimits(float width, float height)
{
	return width < SIDE_LIMIT && height < SIDE_LIMIT && width * height < static_cast<float>(PIXEL_LIMIT);
}

image_util_scale_e downscaleForScale(float scale)
{
	if (scale < 0.125f)
		return IMAGE_UTIL_DOWNSCALE_1_8;
	if (scale < 0.25f)
		return IMAGE_UTIL_DOWNSCALE_1_4;
	if (scale < 0.5f)
		return IMAGE_UTIL_DOWNSCALE_1_2;
	return IMAGE_UTIL_DOWNSCALE_1_1;
}

// Evas is not thread-safe: canvas work from a worker runs on the main loop while the worker waits.
void runOnMainLoop(Ecore_Data_Cb work, void *data)
{
	if (eina_main_loop_is())
		work(data);
	else
		ecore_main_loop_thread_safe_call_sync(work, data);
}

struct ProbeJob {
	const char *path;
	int width;
	int height;
	int error;
};

// Reads the picture's header through a small buffer canvas.
void *probeImageCb(void *data)
{
	ProbeJob *job = static_cast<ProbeJob *>(data);
	ecore_evas_init();
	Ecore_Evas *ee = ecore_evas_buffer_new(PROBE_CANVAS_SIZE, PROBE_CANVAS_SIZE);
	if (!ee) {
		MEMO_LOGE("ecore_evas_buffer_new failed");
		job->error = EVAS_LOAD_ERROR_GENERIC;
	} else {
		Evas_Object *img = evas_object_image_filled_add(ecore_evas_get(ee));
		evas_object_image_file_set(img, job->path, nullptr);
		job->error = evas_object_image_load_error_get(img);
		evas_object_image_size_get(img, &job->width, &job->height);
		ecore_evas_free(ee);
	}
	ecore_evas_shutdown();
	return nullptr;
}

struct RenderJob {
	const char *srcPath;
	const char *dstPath;
	int width;
	int height;
	int cropMode;
	bool result;
};

// Copies the part of src that has the box's proportions into a new filled image: the top rows of
// a tall picture, the middle columns of a wide one.
Evas_Object *cropToBox(Evas *evas, Evas_Object *src, int width, int height)
{
	int iw = 0, ih = 0;
	evas_object_image_size_get(src, &iw, &ih);
	int cw, ch, left;
	if (static_cast<float>(iw) / ih <= static_cast<float>(width) / height) {
		cw = iw;
		ch = static_cast<int>(static_cast<float>(iw) * height / width);
		left = 0;
	} else {
		ch = ih;
		cw = static_cast<int>(static_cast<float>(ih) * width / height);
		left = (iw - cw) / 2;
	}
	if (cw <= 0 || ch <= 0)
		return nullptr;
	const unsigned char *in = static_cast<const unsigned char *>(evas_object_image_data_get(src, EINA_FALSE));
	if (!in)
		return nullptr;
	Evas_Object *crop = evas_object_image_filled_add(evas);
	evas_object_image_size_set(crop, cw, ch);
	evas_object_image_alpha_set(crop, evas_object_image_alpha_get(src));
	evas_object_image_fill_set(crop, 0, 0, cw, ch);
	unsigned char *out = static_cast<unsigned char *>(evas_object_image_data_get(crop, EINA_TRUE));
	if (!out) {
		evas_object_del(crop);
		return nullptr;
	}
	const int inStride = evas_object_image_stride_get(src);
	const int outStride = evas_object_image_stride_get(crop);
	for (int y = 0; y < ch; y++)
		memcpy(out + static_cast<size_t>(y) * outStride, in + static_cast<size_t>(y) * inStride + left * 4,
		       static_cast<size_t>(cw) * 4);
	evas_object_image_data_set(crop, out);
	return crop;
}

// Loads the source onto the canvas and places it for the crop mode; may widen *width (mode 1). Null when
// there is nothing to draw: a source that cannot be read still gets its (empty) canvas rendered.
Evas_Object *placeImage(Evas *evas, RenderJob *job, int *width, int *x, int *drawnWidth)
{
	Evas_Object *img = evas_object_image_filled_add(evas);
	evas_object_image_file_set(img, job->srcPath, nullptr);
	int iw = 0, ih = 0;
	evas_object_image_size_get(img, &iw, &ih);
	const int err = evas_object_image_load_error_get(img);
	if (err != EVAS_LOAD_ERROR_NONE)
		MEMO_LOGE("cannot load %s: %d", job->srcPath ? job->srcPath : "(null)", err);
	const int height = job->height;
	*x = 0;
	*drawnWidth = 0;
	if (job->cropMode == CROP_TO_BOX) {
		evas_object_image_alpha_set(img, 1);
		Evas_Object *crop = iw > 0 && ih > 0 ? cropToBox(evas, img, *width, height) : nullptr;
		evas_object_del(img);
		*drawnWidth = *width;
		return crop;
	}
	const float ratio = ih > 0 ? static_cast<float>(iw) / ih : 0.0f;
	switch (job->cropMode) {
	case CROP_FIT_HEIGHT:
		*drawnWidth = static_cast<int>(ratio * height);
		*x = (*width - *drawnWidth) / 2;
		break;
	case CROP_CANVAS_TO_IMAGE:
		*width = static_cast<int>(ratio * height);
		*drawnWidth = *width;
		break;
	case CROP_STRETCH:
		*drawnWidth = *width;
		break;
	default:
		break;
	}
	return img;
}

// False only without a canvas or its pixels; the canvas takes sizes below 1 as 1.
bool renderImage(RenderJob *job)
{
	Ecore_Evas *ee = ecore_evas_buffer_new(job->width, job->height);
	if (!ee) {
		MEMO_LOGE("ecore_evas_buffer_new failed");
		return false;
	}
	ecore_evas_manual_render_set(ee, 1);
	// A canvas with alpha is cleared before it is drawn: without it, what the picture leaves uncovered or
	// shows through its own transparency would be whatever the buffer's memory held.
	ecore_evas_alpha_set(ee, EINA_TRUE);
	Evas *evas = ecore_evas_get(ee);
	if (!evas) {
		MEMO_LOGE("ecore_evas_get failed");
		ecore_evas_free(ee);
		return false;
	}
	int width = job->width, x = 0, drawnWidth = 0;
	Evas_Object *img = placeImage(evas, job, &width, &x, &drawnWidth);
	ecore_evas_resize(ee, width, job->height);
	if (img) {
		evas_object_move(img, x, 0);
		evas_object_resize(img, drawnWidth, job->height);
		evas_object_show(img);
	}
	int canvasWidth = 0, canvasHeight = 0;
	ecore_evas_geometry_get(ee, nullptr, nullptr, &canvasWidth, &canvasHeight);

	const void *pixels = ecore_evas_buffer_pixels_get(ee);
	if (!pixels) {
		MEMO_LOGE("ecore_evas_buffer_pixels_get failed");
		ecore_evas_free(ee);
		return false;
	}
	Evas_Object *out = evas_object_image_add(evas);
	evas_object_image_size_set(out, canvasWidth, canvasHeight);
	evas_object_image_data_set(out, const_cast<void *>(pixels));
	evas_object_image_alpha_set(out, 1);
	evas_object_image_colorspace_set(out, EVAS_COLORSPACE_ARGB8888);
	if (!evas_object_image_save(out, job->dstPath, nullptr, nullptr))
		MEMO_LOGE("Resizing failed.");
	ecore_evas_free(ee);
	return true;
}

void *renderImageCb(void *data)
{
	RenderJob *job = static_cast<RenderJob *>(data);
	ecore_evas_init();
	job->result = renderImage(job);
	ecore_evas_shutdown();
	return nullptr;
}
} // namespace

bool MemoUtil::__getcheckImageAvailableResolution(const char *path, int width, int height)
{
	if (!path) {
		MEMO_LOGE("path is null");
		return false;
	}
	if (!ecore_file_exists(path)) {
		MEMO_LOGE("file not exist");
		return false;
	}
	const int limit = isJpegName(path) ? JPEG_PIXEL_LIMIT : OTHER_PIXEL_LIMIT;
	if (product32(width, height) >= limit) {
		MEMO_LOGE("Image resolution is over %d", limit);
		return false;
	}
	return true;
}

bool MemoUtil::getInsertImageSize(const char *path, int *width, int *height, int *error)
{
	return getInsertImageSize(path, width, height, error, nullptr);
}

bool MemoUtil::getInsertImageSize(const char *path, int *width, int *height, int *error, float *scale)
{
	if (!width || !height || !error) {
		MEMO_LOGE("invalid parameter");
		return false;
	}
	if (!path || !ecore_file_exists(path)) {
		MEMO_LOGE("File not exist.");
		return false;
	}
	ProbeJob probe = {path, 0, 0, EVAS_LOAD_ERROR_NONE};
	runOnMainLoop(probeImageCb, &probe);
	*error = probe.error;
	const int w = probe.width, h = probe.height;
	MEMO_LOGI("original image size : %d x %d", w, h);

	if (!__getcheckImageAvailableResolution(path, w, h)) {
		MEMO_LOGI("Do not need to be resized because of unsupported resolution.");
		*error = -1;
		return false;
	}
	if (!(w > SIDE_LIMIT || h > SIDE_LIMIT || product32(w, h) > PIXEL_LIMIT)) {
		MEMO_LOGI("Do not need to be resized.");
		return false;
	}

	// A plain stepped search: the sizes it lands on are what stored memos were made with.
	float s = 0.99f;
	float fw = w * s, fh = h * s;
	if (!fitsLimits(fw, fh)) {
		s = 0.98f;
		int step = 0;
		for (; step < SCALE_STEPS; step++) {
			fw = w * s;
			fh = h * s;
			if (fitsLimits(fw, fh))
				break;
			s = static_cast<float>(static_cast<double>(s) - 0.01);
		}
		if (step == SCALE_STEPS) {
			fw = w * s;
			fh = h * s;
		}
	}
	if (scale)
		*scale = s;
	*width = static_cast<int>(fw);
	*height = static_cast<int>(fh);
	if (*width % 2)
		*width -= 1;
	if (*height % 2)
		*height -= 1;
	MEMO_LOGI("Need to be resized. new image size : %d x %d", *width, *height);
	return true;
}

bool MemoUtil::resizeImageJpg(const char *srcPath, const char *dstPath, int width, int height)
{
	return resizeImageJpg(srcPath, dstPath, width, height, 1.0f);
}

bool MemoUtil::resizeImageJpg(const char *srcPath, const char *dstPath, int width, int height, float scale)
{
	if (!srcPath || !ecore_file_exists(srcPath)) {
		MEMO_LOGE("File is not exists. err = %d", 0);
		return false;
	}
	unsigned char *decoded = nullptr;
	int dw = 0, dh = 0;
	unsigned int size = 0;
	int ret = image_util_decode_jpeg_with_downscale(srcPath, IMAGE_UTIL_COLORSPACE_RGB888, downscaleForScale(scale),
	                                                &decoded, &dw, &dh, &size);
	if (ret != IMAGE_UTIL_ERROR_NONE) {
		MEMO_LOGE("image_util_decode_jpeg is failed ret = %d", ret);
		return false;
	}

	// The larger target value goes to the picture's longer side.
	const int larger = std::max(width, height), smaller = std::min(width, height);
	if (dw > dh) {
		width = larger;
		height = smaller;
	} else if (dh > dw) {
		width = smaller;
		height = larger;
	} else if (width != height) {
		std::swap(width, height);
	}

	size = 0;
	ret = image_util_calculate_buffer_size(width, height, IMAGE_UTIL_COLORSPACE_RGB888, &size);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		MEMO_LOGE("image_util_calculate_buffer_size is failed ret = %d", ret);
	unsigned char *resized = size ? static_cast<unsigned char *>(calloc(1, size)) : nullptr;
	ret = image_util_resize(resized, &width, &height, decoded, dw, dh, IMAGE_UTIL_COLORSPACE_RGB888);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		MEMO_LOGE("image_util_resize is failed ret = %d", ret);

	if (dstPath && !strcmp(srcPath, dstPath))
		ecore_file_remove(srcPath);
	ret = image_util_encode_jpeg(resized, width, height, IMAGE_UTIL_COLORSPACE_RGB888, JPEG_QUALITY, dstPath);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		MEMO_LOGE("image_util_encode_jpeg is failed ret = %d", ret);
	free(decoded);
	free(resized);
	return true;
}

bool MemoUtil::resizeImage(const char *srcPath, const char *dstPath, int width, int height, int cropMode)
{
	RenderJob job = {srcPath, dstPath, width, height, cropMode, false};
	runOnMainLoop(renderImageCb, &job);
	return job.result;
}

int MemoUtil::getOrient(const char *path)
{
	if (!path) {
		MEMO_LOGE("path is null");
		return 0;
	}
	if (!ecore_file_exists(path)) {
		MEMO_LOGE("file not exist");
		return 0;
	}
	ExifData *exif = exif_data_new_from_file(path);
	if (!exif) {
		MEMO_LOGE("exif_data_new_from_file err");
		return 0;
	}
	ExifEntry *entry = nullptr;
	for (int ifd = 0; ifd < EXIF_IFD_COUNT && !entry; ifd++)
		entry = exif_content_get_entry(exif->ifd[ifd], EXIF_TAG_ORIENTATION);
	if (!entry || !entry->data || entry->size < 2) {
		MEMO_LOGE("exif_data_get_entry failed!");
		exif_data_unref(exif);
		return 0;
	}
	int orientation = exif_get_short(entry->data, exif_data_get_byte_order(exif));
	MEMO_LOGI("orientation = %d", orientation);
	exif_data_unref(exif);
	return orientation;
}

int MemoUtil::rotationTypeForOrientation(int orientation)
{
	switch (orientation) {
	case 3:
		return IMAGE_UTIL_ROTATION_180;
	case 6:
		return IMAGE_UTIL_ROTATION_90;
	case 8:
		return IMAGE_UTIL_ROTATION_270;
	default:
		// 1 is upright already; the mirrored orientations are kept as stored.
		return IMAGE_UTIL_ROTATION_NONE;
	}
}

void MemoUtil::rotateImage(const char *path, int orientation)
{
	if (!path) {
		MEMO_LOGE("path is null");
		return;
	}
	if (!ecore_file_exists(path)) {
		MEMO_LOGE("file not exist");
		return;
	}
	if (!eina_str_has_extension(path, ".jpg")) {
		MEMO_LOGE("rotateImage supports only jpeg format");
		return;
	}
	const image_util_rotation_e rotation = static_cast<image_util_rotation_e>(rotationTypeForOrientation(orientation));
	unsigned char *decoded = nullptr;
	int width = 0, height = 0;
	unsigned int size = 0;
	int ret = image_util_decode_jpeg(path, IMAGE_UTIL_COLORSPACE_ARGB8888, &decoded, &width, &height, &size);
	if (ret > 0)
		MEMO_LOGE("decode failed");

	size = 0;
	image_util_calculate_buffer_size(width, height, IMAGE_UTIL_COLORSPACE_ARGB8888, &size);
	unsigned char *turned = static_cast<unsigned char *>(calloc(1, size));
	if (!turned)
		MEMO_LOGE("Calloc failed");
	int newWidth = 0, newHeight = 0;
	ret = image_util_rotate(turned, &newWidth, &newHeight, rotation, decoded, width, height,
	                        IMAGE_UTIL_COLORSPACE_ARGB8888);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		MEMO_LOGE("rotate failed");
	ret = image_util_encode_jpeg(turned, newWidth, newHeight, IMAGE_UTIL_COLORSPACE_ARGB8888, JPEG_QUALITY, path);
	if (ret != IMAGE_UTIL_ERROR_NONE)
		MEMO_LOGE("encode failed");
	free(decoded);
	free(turned);
}
