// The image_util backend: JPEG decode, downscale and encode, buffer sizes, and rotation and scaling of
// raw pixel buffers.
#include "TestEnv.h"

#include <gtest/gtest.h>
#include <image_util.h>

#include <cmath>
#include <cstdlib>
#include <string>
#include <vector>

namespace
{
using Pixels = std::vector<unsigned char>;
const image_util_colorspace_e RGB = IMAGE_UTIL_COLORSPACE_RGB888, RGBA = IMAGE_UTIL_COLORSPACE_RGBA8888;

// A smooth two-way gradient with a diagonal band (detail a codec must keep), or one flat colour.
Pixels picture(int w, int h, int flatRgb = -1)
{
	Pixels rgb(static_cast<size_t>(w) * h * 3);
	for (int y = 0; y < h; y++)
		for (int x = 0; x < w; x++) {
			unsigned char *p = &rgb[(static_cast<size_t>(y) * w + x) * 3];
			p[0] = flatRgb >= 0 ? flatRgb >> 16 : 255 * x / (w - 1);
			p[1] = flatRgb >= 0 ? (flatRgb >> 8) & 255 : 255 * y / (h - 1);
			p[2] = flatRgb >= 0 ? flatRgb & 255 : std::abs(x - y) < 8 ? 255 : 40;
		}
	return rgb;
}

// One decode: the result code, the pixels and their size.
struct Decoded {
	int rc;
	Pixels pixels;
	int w = 0, h = 0;
};

Decoded decode(const std::string &path, image_util_colorspace_e cs = RGB, int scale = -1)
{
	unsigned char *out = nullptr;
	int w = 0, h = 0;
	unsigned int size = 0;
	int rc = scale < 0 ? image_util_decode_jpeg(path.c_str(), cs, &out, &w, &h, &size)
	                   : image_util_decode_jpeg_with_downscale(path.c_str(), cs, static_cast<image_util_scale_e>(scale),
	                                                           &out, &w, &h, &size);
	Decoded d{rc, out ? Pixels(out, out + size) : Pixels(), w, h};
	free(out);
	return d;
}

class ImageUtilCodec : public ::testing::Test
{
protected:
	void SetUp() override { dir = memo_test::makeTempDir("codec"); }
	std::string write(const std::string &name, const Pixels &rgb, int w, int h, int quality = 90)
	{
		std::string p = dir + "/" + name;
		EXPECT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_encode_jpeg(rgb.data(), w, h, RGB, quality, p.c_str()));
		return p;
	}
	std::string dir;
};

TEST_F(ImageUtilCodec, RoundTripKeepsThePicture)
{
	Pixels rgb = picture(320, 200);
	Decoded d = decode(write("g.jpg", rgb, 320, 200));
	ASSERT_EQ(IMAGE_UTIL_ERROR_NONE, d.rc);
	EXPECT_EQ(320, d.w);
	EXPECT_EQ(200, d.h);
	ASSERT_EQ(rgb.size(), d.pixels.size());
	double se = 0;
	for (size_t i = 0; i < rgb.size(); i++)
		se += (rgb[i] - d.pixels[i]) * (rgb[i] - d.pixels[i]);
	EXPECT_GT(10 * std::log10(255.0 * 255.0 / (se / rgb.size())), 30.0) << "PSNR in dB";
}

// Each four-byte colourspace puts the channels in its own order.
TEST_F(ImageUtilCodec, ChannelOrderFollowsTheColorspace)
{
	std::string p = write("orange.jpg", picture(16, 16, 0xfa780a), 16, 16, 100);
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
		Decoded d = decode(p, c.cs);
		ASSERT_EQ(16u * 16u * 4u, d.pixels.size());
		const unsigned char *px = &d.pixels[(8 * 16 + 8) * 4];
		EXPECT_NEAR(250, px[c.r], 4);
		EXPECT_NEAR(120, px[c.g], 4);
		EXPECT_NEAR(10, px[c.b], 4);
		EXPECT_EQ(255, c.a >= 0 ? px[c.a] : 255);
	}
}

TEST_F(ImageUtilCodec, DownscaleRoundsEachSideUp)
{
	std::string p = write("odd.jpg", picture(101, 51, 0x00c800), 101, 51);
	const int sizes[][2] = {{101, 51}, {51, 26}, {26, 13}, {13, 7}};
	for (int scale = IMAGE_UTIL_DOWNSCALE_1_1; scale <= IMAGE_UTIL_DOWNSCALE_1_8; ++scale) {
		SCOPED_TRACE(scale);
		Decoded d = decode(p, RGB, scale);
		ASSERT_EQ(IMAGE_UTIL_ERROR_NONE, d.rc);
		EXPECT_EQ(sizes[scale][0], d.w);
		EXPECT_EQ(sizes[scale][1], d.h);
		ASSERT_EQ(static_cast<size_t>(d.w * d.h * 3), d.pixels.size());
		EXPECT_NEAR(200, d.pixels[(d.h / 2 * d.w + d.w / 2) * 3 + 1], 6);
	}
}

TEST_F(ImageUtilCodec, DecodeAndEncodeFailures)
{
	EXPECT_EQ(IMAGE_UTIL_ERROR_NO_SUCH_FILE, decode(dir + "/none.jpg").rc);
	std::string text = dir + "/text.jpg", cut = dir + "/cut.jpg";
	ASSERT_EQ(0, memo_test::runCommand("echo 'plain text' > '" + text + "'"));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT, decode(text).rc);
	ASSERT_EQ(0, memo_test::runCommand("printf '\\377\\330\\377\\340\\000' > '" + cut + "'"));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_OPERATION, decode(cut).rc);

	Pixels rgb = picture(8, 8, 0x090909);
	std::string good = write("good.jpg", rgb, 8, 8), before = memo_test::readFile(good);
	Decoded planar = decode(good, IMAGE_UTIL_COLORSPACE_I420);
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT, planar.rc);
	EXPECT_TRUE(planar.pixels.empty());

	// A refused encode keeps the old file and leaves no temporary one behind.
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER, image_util_encode_jpeg(rgb.data(), 8, 8, RGB, 0, good.c_str()));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT,
	          image_util_encode_jpeg(rgb.data(), 8, 8, IMAGE_UTIL_COLORSPACE_NV12, 90, good.c_str()));
	EXPECT_EQ(before, memo_test::readFile(good));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NO_SUCH_FILE,
	          image_util_encode_jpeg(rgb.data(), 8, 8, RGB, 90, (dir + "/no/dir/x.jpg").c_str()));
	std::string listing;
	memo_test::runCommand("ls '" + dir + "'", &listing);
	EXPECT_EQ("cut.jpg\ngood.jpg\ntext.jpg\n", listing);
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
	unsigned int size = 0;
	for (const auto &c : cases) {
		EXPECT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_calculate_buffer_size(5, 3, c.cs, &size));
		EXPECT_EQ(c.bytes, size) << c.cs;
	}
	// Too large for the size type.
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_calculate_buffer_size(65536, 65536, IMAGE_UTIL_COLORSPACE_ARGB8888, &size));
}

// One pixel of bpp bytes per letter, every byte set to the letter.
Pixels letters(const char *s, int bpp)
{
	Pixels p;
	for (; *s; s++)
		p.insert(p.end(), bpp, static_cast<unsigned char>(*s));
	return p;
}

// Source 3 x 2:  a b c / d e f
TEST(ImageUtilRotate, TurnsClockwiseAndMirrors)
{
	struct {
		image_util_rotation_e r;
		int w, h;
		const char *expect;
	} cases[] = {
	    {IMAGE_UTIL_ROTATION_NONE, 3, 2, "abcdef"},      {IMAGE_UTIL_ROTATION_90, 2, 3, "daebfc"},
	    {IMAGE_UTIL_ROTATION_180, 3, 2, "fedcba"},       {IMAGE_UTIL_ROTATION_270, 2, 3, "cfbead"},
	    {IMAGE_UTIL_ROTATION_FLIP_HORZ, 3, 2, "cbafed"}, {IMAGE_UTIL_ROTATION_FLIP_VERT, 3, 2, "defabc"},
	};
	for (int bpp : {3, 4})
		for (const auto &c : cases) {
			SCOPED_TRACE(testing::Message() << c.r << " at " << bpp << " bytes");
			Pixels src = letters("abcdef", bpp), out(src.size());
			int w = 0, h = 0;
			EXPECT_EQ(IMAGE_UTIL_ERROR_NONE,
			          image_util_rotate(out.data(), &w, &h, c.r, src.data(), 3, 2, bpp == 3 ? RGB : RGBA));
			EXPECT_EQ(letters(c.expect, bpp), out);
			EXPECT_EQ(c.w, w);
			EXPECT_EQ(c.h, h);
		}

	Pixels src = letters("abcd", 3), out(src.size());
	int w = 0, h = 0;
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_rotate(out.data(), &w, &h, static_cast<image_util_rotation_e>(6), src.data(), 2, 2, RGB));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT, image_util_rotate(out.data(), &w, &h, IMAGE_UTIL_ROTATION_90,
	                                                                   src.data(), 2, 2, IMAGE_UTIL_COLORSPACE_YV12));
}

Pixels resize(const Pixels &src, int sw, int sh, int dw, int dh, int bpp = 3)
{
	Pixels out(static_cast<size_t>(dw) * dh * bpp);
	int w = dw, h = dh;
	EXPECT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_resize(out.data(), &w, &h, src.data(), sw, sh, bpp == 3 ? RGB : RGBA));
	EXPECT_EQ(dw, w);
	EXPECT_EQ(dh, h);
	return out;
}

TEST(ImageUtilResize, FlatStaysFlatShrinkingAveragesEnlargingBlends)
{
	Pixels flat(97 * 13 * 4);
	for (size_t i = 0; i < flat.size(); i++)
		flat[i] = i % 4 == 3 ? 255 : 10 + 90 * (i % 4);
	for (auto size : {std::make_pair(5, 3), std::make_pair(97, 13), std::make_pair(300, 40)}) {
		Pixels out = resize(flat, 97, 13, size.first, size.second, 4);
		for (size_t i = 0; i < out.size(); i++)
			ASSERT_EQ(i % 4 == 3 ? 255 : 10 + 90 * (i % 4), out[i]) << i;
	}

	// A fine checkerboard: picking single source pixels would give stripes of black and white.
	const int w = 400, h = 300;
	Pixels checker(static_cast<size_t>(w) * h * 3);
	for (size_t i = 0; i < checker.size(); i++)
		checker[i] = ((i / 3 % w) + (i / 3 / w)) % 2 ? 255 : 0;
	for (unsigned char v : resize(checker, w, h, 57, 43))
		ASSERT_NEAR(128, v, 12);

	Pixels out = resize({0, 0, 0, 240, 240, 240}, 2, 1, 8, 1);
	EXPECT_EQ(0, out[0]);
	EXPECT_EQ(240, out[7 * 3]);
	for (int x = 1; x < 8; x++)
		EXPECT_LE(out[(x - 1) * 3], out[x * 3]);
	EXPECT_GT(out[3 * 3], 0);
	EXPECT_LT(out[4 * 3], 240);

	int one = 1;
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT,
	          image_util_resize(out.data(), &one, &one, out.data(), 2, 1, IMAGE_UTIL_COLORSPACE_RGB565));
}
} // namespace
