// Pictures made on the spot for the image helper tests: JPEG and PNG files from a colour
// function, EXIF orientation tags, header-only size patches, and pixel read-back.
#ifndef TESTS_CORE_UTIL_IMAGE_FIXTURE_H
#define TESTS_CORE_UTIL_IMAGE_FIXTURE_H

#include "TestEnv.h"

#include <Ecore.h>
#include <Ecore_Evas.h>
#include <Evas.h>
#include <gtest/gtest.h>
#include <image_util.h>
#include <libexif/exif-data.h>
#include <png.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <string>
#include <tuple>
#include <vector>

namespace image_fixture
{
// 0xAARRGGBB colours of test patterns.
const uint32_t RED = 0xffff0000, GREEN = 0xff00ff00, BLUE = 0xff0000ff, YELLOW = 0xffffff00;

using ColorFn = std::function<uint32_t(int x, int y)>;

// The canvas the Evas-side helpers need; one per test suite.
class ImageTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite() { ecore_evas_init(); }
	static void TearDownTestSuite() { ecore_evas_shutdown(); }
	void SetUp() override
	{
		dir = memo_test::makeTempDir(::testing::UnitTest::GetInstance()->current_test_info()->name());
	}
	std::string path(const std::string &name) const { return dir + "/" + name; }
	std::string dir;
};

inline void writeJpeg(const std::string &path, int w, int h, const ColorFn &color)
{
	std::vector<unsigned char> rgb(static_cast<size_t>(w) * h * 3);
	for (int y = 0; y < h; y++)
		for (int x = 0; x < w; x++) {
			uint32_t c = color(x, y);
			unsigned char *p = &rgb[(static_cast<size_t>(y) * w + x) * 3];
			p[0] = (c >> 16) & 0xff;
			p[1] = (c >> 8) & 0xff;
			p[2] = c & 0xff;
		}
	ASSERT_EQ(IMAGE_UTIL_ERROR_NONE,
	          image_util_encode_jpeg(rgb.data(), w, h, IMAGE_UTIL_COLORSPACE_RGB888, 95, path.c_str()));
}

// Writes a PNG in one of libpng's simple formats: PNG_FORMAT_RGBA, PNG_FORMAT_GRAY (the green channel)
// or PNG_FORMAT_RGBA_COLORMAP (a palette of the colours used, at most 256).
inline void writePng(const std::string &path, int w, int h, const ColorFn &color, png_uint_32 format = PNG_FORMAT_RGBA)
{
	png_image image = {};
	image.version = PNG_IMAGE_VERSION;
	image.width = w;
	image.height = h;
	image.format = format;
	std::vector<png_byte> px(PNG_IMAGE_SIZE(image)), map;
	for (int i = 0; i < w * h; i++) {
		const uint32_t c = color(i % w, i / w);
		const png_byte rgba[4] = {png_byte(c >> 16), png_byte(c >> 8), png_byte(c), png_byte(c >> 24)};
		if (format & PNG_FORMAT_FLAG_COLORMAP) {
			size_t at = 0;
			while (at < map.size() && !std::equal(rgba, rgba + 4, &map[at]))
				at += 4;
			if (at == map.size())
				map.insert(map.end(), rgba, rgba + 4);
			px[i] = static_cast<png_byte>(at / 4);
		} else if (format == PNG_FORMAT_GRAY)
			px[i] = rgba[1];
		else
			std::copy(rgba, rgba + 4, &px[static_cast<size_t>(i) * 4]);
	}
	image.colormap_entries = static_cast<png_uint_32>(map.size() / 4);
	ASSERT_TRUE(png_image_write_to_file(&image, path.c_str(), 0, px.data(), 0, map.empty() ? nullptr : map.data()))
	    << image.message;
}

struct Picture {
	int w = 0, h = 0;
	std::vector<uint32_t> px; // 0xAARRGGBB
	uint32_t at(int x, int y) const { return px[static_cast<size_t>(y) * w + x]; }
};

// Loads any picture through Evas; an empty Picture when it cannot be read.
inline Picture readImage(const std::string &path)
{
	Picture pic;
	Ecore_Evas *ee = ecore_evas_buffer_new(1, 1);
	Evas_Object *img = evas_object_image_add(ecore_evas_get(ee));
	evas_object_image_file_set(img, path.c_str(), nullptr);
	evas_object_image_size_get(img, &pic.w, &pic.h);
	const uint32_t *px = static_cast<const uint32_t *>(evas_object_image_data_get(img, EINA_FALSE));
	if (px && pic.w > 0) {
		int stride = evas_object_image_stride_get(img) / 4;
		for (int y = 0; y < pic.h; y++)
			pic.px.insert(pic.px.end(), px + y * stride, px + y * stride + pic.w);
	} else {
		pic.w = pic.h = 0;
	}
	ecore_evas_free(ee);
	return pic;
}

// True when the colours differ by at most tol in each of red, green and blue (lossy files).
inline bool near(uint32_t a, uint32_t b, int tol = 40)
{
	for (int shift = 0; shift <= 16; shift += 8)
		if (std::abs(static_cast<int>((a >> shift) & 0xff) - static_cast<int>((b >> shift) & 0xff)) > tol)
			return false;
	return true;
}

// Quadrants: red, green / blue, yellow.
inline ColorFn quadrants(int w, int h)
{
	return [w, h](int x, int y) {
		if (y < h / 2)
			return x < w / 2 ? RED : GREEN;
		return x < w / 2 ? BLUE : YELLOW;
	};
}

inline void expectQuadrants(const Picture &pic)
{
	ASSERT_GT(pic.w, 0);
	int qx = pic.w / 4, qy = pic.h / 4;
	for (auto [x, y, colour] : {std::make_tuple(qx, qy, RED), std::make_tuple(3 * qx, qy, GREEN),
	                            std::make_tuple(qx, 3 * qy, BLUE), std::make_tuple(3 * qx, 3 * qy, YELLOW)})
		EXPECT_TRUE(near(colour, pic.at(x, y))) << x << "," << y << ": " << std::hex << pic.at(x, y);
}

inline void writeBytes(const std::string &path, const std::string &bytes)
{
	std::ofstream(path, std::ios::binary) << bytes;
}

// Rewrites the frame header of a JPEG so that it claims w x h; the pixel data stays small.
inline void patchJpegSize(const std::string &path, int w, int h)
{
	std::string b = memo_test::readFile(path);
	size_t sof = b.find("\xff\xc0", 2);
	ASSERT_NE(std::string::npos, sof) << "no frame header in " << path;
	b.replace(sof + 5, 4, {char(h >> 8), char(h & 0xff), char(w >> 8), char(w & 0xff)});
	writeBytes(path, b);
}

// Puts an APP1 EXIF block holding only the orientation tag, in the given byte order, right
// behind the JPEG's start marker.
inline void addExifOrientation(const std::string &path, int orientation, ExifByteOrder order = EXIF_BYTE_ORDER_INTEL)
{
	ExifData *exif = exif_data_new();
	exif_data_set_byte_order(exif, order);
	ExifEntry *entry = exif_entry_new();
	exif_content_add_entry(exif->ifd[EXIF_IFD_0], entry);
	exif_entry_initialize(entry, EXIF_TAG_ORIENTATION);
	exif_set_short(entry->data, order, static_cast<ExifShort>(orientation));
	exif_entry_unref(entry);
	unsigned char *data = nullptr;
	unsigned int len = 0;
	exif_data_save_data(exif, &data, &len);
	exif_data_unref(exif);
	ASSERT_NE(nullptr, data);
	std::string jpeg = memo_test::readFile(path);
	std::string app1 = {'\xff', '\xe1', char((len + 2) >> 8), char((len + 2) & 0xff)};
	app1.append(reinterpret_cast<char *>(data), len);
	free(data);
	writeBytes(path, jpeg.substr(0, 2) + app1 + jpeg.substr(2));
}

// Runs fn on an Ecore worker thread and waits for its end: image flows call the helpers from workers.
inline void runInWorker(std::function<void()> fn)
{
	struct Job {
		std::function<void()> fn;
		bool done;
	} job{std::move(fn), false};
	ecore_thread_run([](void *data, Ecore_Thread *) { static_cast<Job *>(data)->fn(); },
	                 [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; },
	                 [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; }, &job);
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return job.done; }));
}
} // namespace image_fixture

#endif
