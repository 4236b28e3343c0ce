// Rotation and scaling of raw pixel buffers in the image_util backend.
#include <gtest/gtest.h>
#include <image_util.h>

#include <vector>

namespace
{
using Pixels = std::vector<unsigned char>;
const image_util_colorspace_e RGB = IMAGE_UTIL_COLORSPACE_RGB888, RGBA = IMAGE_UTIL_COLORSPACE_RGBA8888;

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
