#ifndef BENCH_BENCHPHOTO_H
#define BENCH_BENCHPHOTO_H

// The pictures the image benchmarks work on: a camera JPEG and large PNG files of the same kind.

#include <Ecore_Evas.h>
#include <Evas.h>
#include <image_util.h>

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace memo_bench
{

// A 12-megapixel camera shot.
const int PHOTO_W = 4000, PHOTO_H = 3000;

// One pixel of a photo-like picture of w x h as 0xRRGGBB: smooth light with noise that `seed` drives, so
// that it compresses like a camera shot.
inline uint32_t photoPixel(int x, int y, int w, int h, unsigned int &seed)
{
	seed = seed * 1103515245u + 12345u;
	const uint32_t noise = (seed >> 16) % 24;
	const uint32_t r = 40 + 180 * x / w + noise;
	const uint32_t g = 60 + 150 * y / h + noise;
	const uint32_t b = 120 + ((x / 50 + y / 50) % 2) * 60 + noise / 2;
	return (r << 16) | (g << 8) | b;
}

// Writes the camera shot as a JPEG to `path`. False when the encoder fails.
inline bool makePhoto(const std::string &path, unsigned int seed)
{
	std::vector<unsigned char> rgb(static_cast<size_t>(PHOTO_W) * PHOTO_H * 3);
	for (int y = 0; y < PHOTO_H; y++)
		for (int x = 0; x < PHOTO_W; x++) {
			unsigned char *p = &rgb[(static_cast<size_t>(y) * PHOTO_W + x) * 3];
			const uint32_t c = photoPixel(x, y, PHOTO_W, PHOTO_H, seed);
			p[0] = static_cast<unsigned char>(c >> 16);
			p[1] = static_cast<unsigned char>(c >> 8);
			p[2] = static_cast<unsigned char>(c);
		}
	return image_util_encode_jpeg(rgb.data(), PHOTO_W, PHOTO_H, IMAGE_UTIL_COLORSPACE_RGB888, 92, path.c_str()) ==
	       IMAGE_UTIL_ERROR_NONE;
}

// Writes a photo-like opaque PNG of side x side to `path` (fast compression: only the pixels matter).
// Needs Ecore_Evas initialised. False when it cannot be saved.
inline bool makePhotoPng(const std::string &path, int side, unsigned int seed)
{
	Ecore_Evas *ee = ecore_evas_buffer_new(1, 1);
	if (!ee)
		return false;
	Evas_Object *img = evas_object_image_add(ecore_evas_get(ee));
	evas_object_image_size_set(img, side, side);
	uint32_t *px = static_cast<uint32_t *>(evas_object_image_data_get(img, EINA_TRUE));
	bool ok = px != nullptr;
	if (ok) {
		const int stride = evas_object_image_stride_get(img) / 4;
		for (int y = 0; y < side; y++)
			for (int x = 0; x < side; x++)
				px[static_cast<size_t>(y) * stride + x] = 0xff000000u | photoPixel(x, y, side, side, seed);
		evas_object_image_data_set(img, px);
		ok = evas_object_image_save(img, path.c_str(), nullptr, "compress=1");
	}
	ecore_evas_free(ee);
	return ok;
}

} // namespace memo_bench

#endif
