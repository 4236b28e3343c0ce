#ifndef BENCH_BENCHPHOTO_H
#define BENCH_BENCHPHOTO_H

// The camera picture the image benchmarks work on.

#include <image_util.h>

#include <cstddef>
#include <string>
#include <vector>

namespace memo_bench
{

// A 12-megapixel camera shot.
const int PHOTO_W = 4000, PHOTO_H = 3000;

// Writes a photo-like JPEG to `path`: smooth light with noise from `seed`, so that it compresses like a
// camera shot. False when the encoder fails.
inline bool makePhoto(const std::string &path, unsigned int seed)
{
	std::vector<unsigned char> rgb(static_cast<size_t>(PHOTO_W) * PHOTO_H * 3);
	for (int y = 0; y < PHOTO_H; y++)
		for (int x = 0; x < PHOTO_W; x++) {
			unsigned char *p = &rgb[(static_cast<size_t>(y) * PHOTO_W + x) * 3];
			seed = seed * 1103515245u + 12345u;
			const int noise = static_cast<int>((seed >> 16) % 24);
			p[0] = static_cast<unsigned char>(40 + 180 * x / PHOTO_W + noise);
			p[1] = static_cast<unsigned char>(60 + 150 * y / PHOTO_H + noise);
			p[2] = static_cast<unsigned char>(120 + ((x / 50 + y / 50) % 2) * 60 + noise / 2);
		}
	return image_util_encode_jpeg(rgb.data(), PHOTO_W, PHOTO_H, IMAGE_UTIL_COLORSPACE_RGB888, 92, path.c_str()) ==
	       IMAGE_UTIL_ERROR_NONE;
}

} // namespace memo_bench

#endif
