// JPEG decode, downscale and encode of the image_util backend.
#include "TestEnv.h"

#include <gtest/gtest.h>
#include <image_util.h>

#include <cmath>
#include <cstdlib>
#include <string>
#include <vector>

namespace
{
// A smooth two-way gradient with a diagonal band: detail a codec must keep.
std::vector<unsigned char> gradient(int w, int h)
{
	std::vector<unsigned char> rgb(static_cast<size_t>(w) * h * 3);
	for (int y = 0; y < h; y++)
		for (int x = 0; x < w; x++) {
			unsigned char *p = &rgb[(static_cast<size_t>(y) * w + x) * 3];
			p[0] = static_cast<unsigned char>(255 * x / (w - 1));
			p[1] = static_cast<unsigned char>(255 * y / (h - 1));
			p[2] = std::abs(x - y) < 8 ? 255 : 40;
		}
	return rgb;
}

std::vector<unsigned char> solid(int w, int h, unsigned char r, unsigned char g, unsigned char b)
{
	std::vector<unsigned char> rgb(static_cast<size_t>(w) * h * 3);
	for (size_t i = 0; i < rgb.size(); i += 3) {
		rgb[i] = r;
		rgb[i + 1] = g;
		rgb[i + 2] = b;
	}
	return rgb;
}

double psnr(const unsigned char *a, const unsigned char *b, size_t n)
{
	double se = 0;
	for (size_t i = 0; i < n; i++)
		se += (a[i] - b[i]) * (a[i] - b[i]);
	return se == 0 ? 99.0 : 10 * std::log10(255.0 * 255.0 / (se / n));
}

class ImageUtilCodec : public ::testing::Test
{
protected:
	void SetUp() override { dir = memo_test::makeTempDir("codec"); }
	std::string path(const std::string &name) { return dir + "/" + name; }
	std::string write(const std::string &name, const std::vector<unsigned char> &rgb, int w, int h, int quality = 90)
	{
		std::string p = path(name);
		EXPECT_EQ(IMAGE_UTIL_ERROR_NONE,
		          image_util_encode_jpeg(rgb.data(), w, h, IMAGE_UTIL_COLORSPACE_RGB888, quality, p.c_str()));
		return p;
	}
	std::string dir;
};

TEST_F(ImageUtilCodec, RoundTripKeepsThePicture)
{
	const int w = 320, h = 200;
	std::vector<unsigned char> rgb = gradient(w, h);
	std::string p = write("g.jpg", rgb, w, h);

	unsigned char *out = nullptr;
	int ow = 0, oh = 0;
	unsigned int size = 0;
	ASSERT_EQ(IMAGE_UTIL_ERROR_NONE,
	          image_util_decode_jpeg(p.c_str(), IMAGE_UTIL_COLORSPACE_RGB888, &out, &ow, &oh, &size));
	EXPECT_EQ(w, ow);
	EXPECT_EQ(h, oh);
	ASSERT_EQ(rgb.size(), size);
	EXPECT_GT(psnr(rgb.data(), out, size), 30.0);
	free(out);
}

// Each four-byte colourspace puts the channels in its own order.
TEST_F(ImageUtilCodec, ChannelOrderFollowsTheColorspace)
{
	std::string p = write("orange.jpg", solid(16, 16, 250, 120, 10), 16, 16, 100);
	struct {
		image_util_colorspace_e cs;
		int r, g, b, a; // byte index of each channel, -1 if absent
	} cases[] = {
	    {IMAGE_UTIL_COLORSPACE_ARGB8888, 1, 2, 3, 0},
	    {IMAGE_UTIL_COLORSPACE_BGRA8888, 2, 1, 0, 3},
	    {IMAGE_UTIL_COLORSPACE_RGBA8888, 0, 1, 2, 3},
	    {IMAGE_UTIL_COLORSPACE_BGRX8888, 2, 1, 0, -1},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.cs);
		unsigned char *out = nullptr;
		int w = 0, h = 0;
		unsigned int size = 0;
		ASSERT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_decode_jpeg(p.c_str(), c.cs, &out, &w, &h, &size));
		ASSERT_EQ(16u * 16u * 4u, size);
		const unsigned char *px = out + (8 * 16 + 8) * 4;
		EXPECT_NEAR(250, px[c.r], 4);
		EXPECT_NEAR(120, px[c.g], 4);
		EXPECT_NEAR(10, px[c.b], 4);
		if (c.a >= 0) {
			EXPECT_EQ(255, px[c.a]);
		}
		free(out);
	}
}

TEST_F(ImageUtilCodec, DownscaleRoundsEachSideUp)
{
	std::string p = write("odd.jpg", solid(101, 51, 0, 200, 0), 101, 51);
	struct {
		image_util_scale_e scale;
		int w, h;
	} cases[] = {
	    {IMAGE_UTIL_DOWNSCALE_1_1, 101, 51},
	    {IMAGE_UTIL_DOWNSCALE_1_2, 51, 26},
	    {IMAGE_UTIL_DOWNSCALE_1_4, 26, 13},
	    {IMAGE_UTIL_DOWNSCALE_1_8, 13, 7},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.scale);
		unsigned char *out = nullptr;
		int w = 0, h = 0;
		unsigned int size = 0;
		ASSERT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_decode_jpeg_with_downscale(p.c_str(), IMAGE_UTIL_COLORSPACE_RGB888,
		                                                                       c.scale, &out, &w, &h, &size));
		EXPECT_EQ(c.w, w);
		EXPECT_EQ(c.h, h);
		EXPECT_EQ(static_cast<unsigned int>(w * h * 3), size);
		EXPECT_NEAR(200, out[(h / 2 * w + w / 2) * 3 + 1], 6);
		free(out);
	}
}

TEST_F(ImageUtilCodec, DecodeFailures)
{
	unsigned char *out = nullptr;
	int w = 0, h = 0;
	unsigned int size = 0;
	const image_util_colorspace_e rgb = IMAGE_UTIL_COLORSPACE_RGB888;
	EXPECT_EQ(IMAGE_UTIL_ERROR_NO_SUCH_FILE,
	          image_util_decode_jpeg(path("none.jpg").c_str(), rgb, &out, &w, &h, &size));

	std::string text = path("text.jpg");
	ASSERT_EQ(0, memo_test::runCommand("echo 'plain text' > '" + text + "'"));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT, image_util_decode_jpeg(text.c_str(), rgb, &out, &w, &h, &size));

	std::string cut = path("cut.jpg");
	ASSERT_EQ(0, memo_test::runCommand("printf '\\377\\330\\377\\340\\000' > '" + cut + "'"));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_OPERATION, image_util_decode_jpeg(cut.c_str(), rgb, &out, &w, &h, &size));

	std::string good = write("good.jpg", solid(8, 8, 1, 2, 3), 8, 8);
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT,
	          image_util_decode_jpeg(good.c_str(), IMAGE_UTIL_COLORSPACE_I420, &out, &w, &h, &size));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_decode_jpeg(good.c_str(), static_cast<image_util_colorspace_e>(99), &out, &w, &h, &size));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_decode_jpeg_with_downscale(good.c_str(), rgb, static_cast<image_util_scale_e>(4), &out, &w, &h,
	                                                &size));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER, image_util_decode_jpeg(nullptr, rgb, &out, &w, &h, &size));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER, image_util_decode_jpeg(good.c_str(), rgb, nullptr, &w, &h, &size));
	EXPECT_EQ(nullptr, out);
}

TEST_F(ImageUtilCodec, FailedEncodeKeepsTheOldFile)
{
	std::vector<unsigned char> rgb = solid(8, 8, 9, 9, 9);
	std::string p = write("keep.jpg", rgb, 8, 8);
	std::string before = memo_test::readFile(p);
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_encode_jpeg(rgb.data(), 8, 8, IMAGE_UTIL_COLORSPACE_RGB888, 0, p.c_str()));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_encode_jpeg(rgb.data(), 0, 8, IMAGE_UTIL_COLORSPACE_RGB888, 90, p.c_str()));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT,
	          image_util_encode_jpeg(rgb.data(), 8, 8, IMAGE_UTIL_COLORSPACE_NV12, 90, p.c_str()));
	EXPECT_EQ(before, memo_test::readFile(p));

	EXPECT_EQ(IMAGE_UTIL_ERROR_NO_SUCH_FILE,
	          image_util_encode_jpeg(rgb.data(), 8, 8, IMAGE_UTIL_COLORSPACE_RGB888, 90, path("no/dir/x.jpg").c_str()));
	// No temporary file is left behind.
	std::string listing;
	memo_test::runCommand("ls '" + dir + "'", &listing);
	EXPECT_EQ("keep.jpg\n", listing);
}

TEST(ImageUtilBufferSize, Colorspaces)
{
	struct {
		image_util_colorspace_e cs;
		unsigned int bytes; // for 5 x 3
	} cases[] = {
	    {IMAGE_UTIL_COLORSPACE_I420, 15 + 2 * 3 * 2},
	    {IMAGE_UTIL_COLORSPACE_NV21, 15 + 2 * 3 * 2},
	    {IMAGE_UTIL_COLORSPACE_YUV422, 15 + 2 * 3 * 3},
	    {IMAGE_UTIL_COLORSPACE_UYVY, 6 * 2 * 3},
	    {IMAGE_UTIL_COLORSPACE_RGB565, 30},
	    {IMAGE_UTIL_COLORSPACE_RGB888, 45},
	    {IMAGE_UTIL_COLORSPACE_ARGB8888, 60},
	    {IMAGE_UTIL_COLORSPACE_BGRX8888, 60},
	};
	for (const auto &c : cases) {
		unsigned int size = 0;
		EXPECT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_calculate_buffer_size(5, 3, c.cs, &size));
		EXPECT_EQ(c.bytes, size) << c.cs;
	}
	unsigned int size = 0;
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_calculate_buffer_size(0, 3, IMAGE_UTIL_COLORSPACE_RGB888, &size));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_calculate_buffer_size(65536, 65536, IMAGE_UTIL_COLORSPACE_ARGB8888, &size));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_calculate_buffer_size(5, 3, IMAGE_UTIL_COLORSPACE_RGB888, nullptr));
}
} // namespace
