// Shrinking PNG pictures without a canvas, so that a worker thread can do all of it: libpng decodes,
// an area average scales the premultiplied pixels (what the canvas's smooth scaler does when it
// shrinks), and libpng writes the file the way the canvas's saver does.
#include "Util/MemoUtil.h"

#include "MemoLog.h"

#include <Ecore_File.h>
#include <png.h>

#include <algorithm>
#include <cmath>
#include <csetjmp>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <vector>

namespace
{
// The canvas's saver writes at the strongest compression.
const int PNG_COMPRESSION = 9;
// Pictures other than JPEG are admitted below this many pixels (getInsertImageSize); larger ones are not
// decoded at all, whatever their header claims.
const uint64_t PIXEL_LIMIT = 9000000;

// Straight or premultiplied RGBA, 4 bytes a pixel, rows packed.
struct Rgba {
	int width;
	int height;
	unsigned char *bytes;
};

void pngErrorCb(png_structp png, png_const_charp message)
{
	MEMO_LOGE("libpng: %s", message);
	png_longjmp(png, 1);
}

void pngWarningCb(png_structp png, png_const_charp message)
{
	(void)png;
	MEMO_LOGI("libpng: %s", message);
}

unsigned char *allocRgba(png_uint_32 width, png_uint_32 height)
{
	if (width == 0 || height == 0 || width > SIZE_MAX / 4 / height)
		return nullptr;
	return static_cast<unsigned char *>(malloc(static_cast<size_t>(width) * height * 4));
}

// Any PNG (palette, grey, 16 bits, interlaced) as 8-bit RGBA, opaque where it has no alpha; false for
// other content. libpng leaves through longjmp on errors, so nothing here has a destructor.
bool decodePng(FILE *file, Rgba *out)
{
	unsigned char signature[8] = {};
	if (fread(signature, 1, sizeof(signature), file) != sizeof(signature) ||
	    png_sig_cmp(signature, 0, sizeof(signature)) != 0)
		return false;
	png_structp png = png_create_read_struct(PNG_LIBPNG_VER_STRING, nullptr, pngErrorCb, pngWarningCb);
	png_infop info = png ? png_create_info_struct(png) : nullptr;
	unsigned char *volatile bytes = nullptr;
	png_bytep *volatile rows = nullptr;
	if (!info || setjmp(png_jmpbuf(png))) {
		png_destroy_read_struct(png ? &png : nullptr, info ? &info : nullptr, nullptr);
		free(bytes);
		free(rows);
		return false;
	}
	png_init_io(png, file);
	png_set_sig_bytes(png, sizeof(signature));
	png_read_info(png, info);
	png_set_expand(png);
	png_set_strip_16(png);
	png_set_gray_to_rgb(png);
	png_set_filler(png, 0xff, PNG_FILLER_AFTER);
	png_set_interlace_handling(png);
	png_read_update_info(png, info);
	const png_uint_32 width = png_get_image_width(png, info), height = png_get_image_height(png, info);
	if (static_cast<uint64_t>(width) * height >= PIXEL_LIMIT)
		png_error(png, "too many pixels");
	bytes = allocRgba(width, height);
	rows = static_cast<png_bytep *>(malloc(sizeof(png_bytep) * height));
	if (!bytes || !rows || png_get_rowbytes(png, info) != static_cast<size_t>(width) * 4)
		png_error(png, "cannot hold the picture");
	for (png_uint_32 y = 0; y < height; y++)
		rows[y] = bytes + static_cast<size_t>(y) * width * 4;
	png_read_image(png, rows);
	png_read_end(png, nullptr);
	png_destroy_read_struct(&png, &info, nullptr);
	free(rows);
	*out = {static_cast<int>(width), static_cast<int>(height), bytes};
	return true;
}

// 8-bit RGBA with an sBIT of 8 for every channel, as the canvas's saver writes it.
bool encodePng(FILE *file, const Rgba &in)
{
	png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, pngErrorCb, pngWarningCb);
	png_infop info = png ? png_create_info_struct(png) : nullptr;
	if (!info || setjmp(png_jmpbuf(png))) {
		png_destroy_write_struct(png ? &png : nullptr, info ? &info : nullptr);
		return false;
	}
	png_init_io(png, file);
	png_set_compression_level(png, PNG_COMPRESSION);
	png_set_IHDR(png, info, in.width, in.height, 8, PNG_COLOR_TYPE_RGB_ALPHA, PNG_INTERLACE_NONE,
	             PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
	png_color_8 bits = {8, 8, 8, 0, 8};
	png_set_sBIT(png, info, &bits);
	png_write_info(png, info);
	for (int y = 0; y < in.height; y++)
		png_write_row(png, in.bytes + static_cast<size_t>(y) * in.width * 4);
	png_write_end(png, info);
	png_destroy_write_struct(&png, &info);
	return true;
}

// The canvas keeps pixels premultiplied, with these roundings.
void premultiply(Rgba &image)
{
	unsigned char *p = image.bytes;
	for (size_t i = 0, n = static_cast<size_t>(image.width) * image.height; i < n; i++, p += 4) {
		const unsigned int a = p[3] + 1u;
		for (int c = 0; c < 3; c++)
			p[c] = static_cast<unsigned char>((p[c] * a) >> 8);
	}
}

void unpremultiply(Rgba &image)
{
	unsigned char *p = image.bytes;
	for (size_t i = 0, n = static_cast<size_t>(image.width) * image.height; i < n; i++, p += 4) {
		const unsigned int a = p[3];
		if (a == 0 || a == 255)
			continue;
		for (int c = 0; c < 3; c++)
			p[c] = static_cast<unsigned char>(std::min(255u, p[c] * 255u / a));
	}
}

// The source pixels that an output pixel covers along one axis, each with its share of the pixel.
struct Taps {
	int stride;
	std::vector<int> first;
	std::vector<int> count;
	std::vector<float> weight; // stride entries for each output pixel
};

Taps makeTaps(int source, int target)
{
	const double ratio = static_cast<double>(source) / target;
	Taps taps;
	taps.stride = static_cast<int>(std::ceil(ratio)) + 1;
	taps.first.resize(target);
	taps.count.resize(target);
	taps.weight.assign(static_cast<size_t>(target) * taps.stride, 0.0f);
	for (int i = 0; i < target; i++) {
		const double from = i * ratio, to = std::min<double>(source, (i + 1) * ratio);
		const int first = std::min(source - 1, static_cast<int>(from));
		int n = 0;
		for (int s = first; s < to && n < taps.stride; s++) {
			const double share = std::min<double>(s + 1, to) - std::max<double>(s, from);
			taps.weight[static_cast<size_t>(i) * taps.stride + n++] = static_cast<float>(share / ratio);
		}
		taps.first[i] = first;
		taps.count[i] = std::max(n, 1);
		if (n == 0)
			taps.weight[static_cast<size_t>(i) * taps.stride] = 1.0f;
	}
	return taps;
}

// Scales in.bytes into out (out.width x out.height already set and allocated): rows first, then columns.
void areaAverage(const Rgba &in, Rgba &out)
{
	const Taps across = makeTaps(in.width, out.width), down = makeTaps(in.height, out.height);
	const size_t outRow = static_cast<size_t>(out.width) * 4;
	std::vector<float> row(outRow), sum(outRow);
	for (int y = 0; y < out.height; y++) {
		std::fill(sum.begin(), sum.end(), 0.0f);
		for (int k = 0; k < down.count[y]; k++) {
			const unsigned char *src = in.bytes + static_cast<size_t>(down.first[y] + k) * in.width * 4;
			std::fill(row.begin(), row.end(), 0.0f);
			for (int x = 0; x < out.width; x++) {
				const float *w = &across.weight[static_cast<size_t>(x) * across.stride];
				const unsigned char *p = src + static_cast<size_t>(across.first[x]) * 4;
				float *r = &row[static_cast<size_t>(x) * 4];
				for (int t = 0; t < across.count[x]; t++, p += 4)
					for (int c = 0; c < 4; c++)
						r[c] += w[t] * p[c];
			}
			const float share = down.weight[static_cast<size_t>(y) * down.stride + k];
			for (size_t i = 0; i < outRow; i++)
				sum[i] += share * row[i];
		}
		unsigned char *dst = out.bytes + static_cast<size_t>(y) * outRow;
		for (size_t i = 0; i < outRow; i++)
			dst[i] = static_cast<unsigned char>(std::min(255.0f, std::max(0.0f, std::round(sum[i]))));
	}
}
} // namespace

bool MemoUtil::resizeImagePng(const char *srcPath, const char *dstPath, int width, int height)
{
	if (!srcPath || !dstPath || !ecore_file_exists(srcPath)) {
		MEMO_LOGE("File is not exists.");
		return false;
	}
	if (width <= 0 || height <= 0) {
		MEMO_LOGE("invalid size %d x %d", width, height);
		return false;
	}
	FILE *file = fopen(srcPath, "rb");
	Rgba source = {0, 0, nullptr};
	const bool decoded = file && decodePng(file, &source);
	if (file)
		fclose(file);
	if (!decoded) {
		MEMO_LOGE("cannot decode %s as PNG", srcPath);
		return false;
	}

	premultiply(source);
	Rgba target = {width, height, allocRgba(width, height)};
	if (!target.bytes) {
		MEMO_LOGE("cannot hold %d x %d", width, height);
		free(source.bytes);
		return false;
	}
	areaAverage(source, target);
	free(source.bytes);
	unpremultiply(target);

	// The source has been read whole, so the target may replace it.
	FILE *out = fopen(dstPath, "wb");
	bool saved = out && encodePng(out, target);
	if (out && fclose(out) != 0)
		saved = false;
	if (!saved) {
		MEMO_LOGE("Resizing failed.");
		if (out)
			ecore_file_remove(dstPath);
	}
	free(target.bytes);
	return true;
}
