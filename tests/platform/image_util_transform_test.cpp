// Rotation and scaling of raw pixel buffers in the image_util backend.
#include <gtest/gtest.h>
#include <image_util.h>

#include <vector>

namespace
{
using Pixels = std::vector<unsigned char>;
const image_util_colorspace_e RGB = IMAGE_UTIL_COLORSPACE_RGB888;

// One RGB pixel per letter, all three channels set to the letter.
Pixels letters(const char *s)
{
	Pixels p;
	for (; *s; s++)
		p.insert(p.end(), 3, static_cast<unsigned char>(*s));
	return p;
}

Pixels rotate(const Pixels &src, int w, int h, image_util_rotation_e r, int *ow, int *oh)
{
	Pixels out(src.size());
	EXPECT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_rotate(out.data(), ow, oh, r, src.data(), w, h, RGB));
	return out;
}

// Source 3 x 2:  a b c / d e f
TEST(ImageUtilRotate, TurnsClockwiseAndMirrors)
{
	const Pixels src = letters("abcdef");
	struct {
		image_util_rotation_e r;
		int w, h;
		const char *expect;
	} cases[] = {
	    {IMAGE_UTIL_ROTATION_NONE, 3, 2, "abcdef"},      {IMAGE_UTIL_ROTATION_90, 2, 3, "daebfc"},
	    {IMAGE_UTIL_ROTATION_180, 3, 2, "fedcba"},       {IMAGE_UTIL_ROTATION_270, 2, 3, "cfbead"},
	    {IMAGE_UTIL_ROTATION_FLIP_HORZ, 3, 2, "cbafed"}, {IMAGE_UTIL_ROTATION_FLIP_VERT, 3, 2, "defabc"},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.r);
		int w = 0, h = 0;
		EXPECT_EQ(letters(c.expect), rotate(src, 3, 2, c.r, &w, &h));
		EXPECT_EQ(c.w, w);
		EXPECT_EQ(c.h, h);
	}
}

TEST(ImageUtilRotate, FourQuarterTurnsGiveTheOriginal)
{
	Pixels img(7 * 5 * 4);
	for (size_t i = 0; i < img.size(); i++)
		img[i] = static_cast<unsigned char>(i * 37);
	Pixels cur = img;
	int w = 7, h = 5;
	for (int i = 0; i < 4; i++) {
		Pixels out(cur.size());
		int ow = 0, oh = 0;
		ASSERT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_rotate(out.data(), &ow, &oh, IMAGE_UTIL_ROTATION_90, cur.data(), w,
		                                                   h, IMAGE_UTIL_COLORSPACE_BGRA8888));
		cur = out;
		w = ow;
		h = oh;
	}
	EXPECT_EQ(7, w);
	EXPECT_EQ(img, cur);
}

TEST(ImageUtilRotate, RejectsBadArguments)
{
	Pixels src = letters("abcd"), out(src.size());
	int w = 0, h = 0;
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_rotate(out.data(), &w, &h, static_cast<image_util_rotation_e>(6), src.data(), 2, 2, RGB));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER,
	          image_util_rotate(nullptr, &w, &h, IMAGE_UTIL_ROTATION_90, src.data(), 2, 2, RGB));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT, image_util_rotate(out.data(), &w, &h, IMAGE_UTIL_ROTATION_90,
	                                                                   src.data(), 2, 2, IMAGE_UTIL_COLORSPACE_YV12));
}

Pixels resize(const Pixels &src, int sw, int sh, int dw, int dh, int bpp = 3)
{
	Pixels out(static_cast<size_t>(dw) * dh * bpp);
	int w = dw, h = dh;
	EXPECT_EQ(IMAGE_UTIL_ERROR_NONE, image_util_resize(out.data(), &w, &h, src.data(), sw, sh,
	                                                   bpp == 3 ? RGB : IMAGE_UTIL_COLORSPACE_RGBA8888));
	EXPECT_EQ(dw, w);
	EXPECT_EQ(dh, h);
	return out;
}

TEST(ImageUtilResize, FlatColourStaysFlat)
{
	Pixels src(97 * 13 * 4);
	for (size_t i = 0; i < src.size(); i += 4) {
		src[i] = 10;
		src[i + 1] = 100;
		src[i + 2] = 200;
		src[i + 3] = 255;
	}
	for (auto size : {std::make_pair(5, 3), std::make_pair(97, 13), std::make_pair(300, 40)}) {
		Pixels out = resize(src, 97, 13, size.first, size.second, 4);
		for (size_t i = 0; i < out.size(); i += 4) {
			ASSERT_EQ(10, out[i]);
			ASSERT_EQ(100, out[i + 1]);
			ASSERT_EQ(200, out[i + 2]);
			ASSERT_EQ(255, out[i + 3]);
		}
	}
}

// Picking single source pixels would give stripes of black and white here.
TEST(ImageUtilResize, ShrinkingAveragesFineDetail)
{
	const int w = 400, h = 300;
	Pixels src(static_cast<size_t>(w) * h * 3);
	for (int y = 0; y < h; y++)
		for (int x = 0; x < w; x++)
			for (int c = 0; c < 3; c++)
				src[(static_cast<size_t>(y) * w + x) * 3 + c] = ((x + y) % 2) ? 255 : 0;
	Pixels out = resize(src, w, h, 57, 43);
	for (unsigned char v : out)
		ASSERT_NEAR(128, v, 12);
}

TEST(ImageUtilResize, EnlargingBlendsNeighbours)
{
	Pixels src = {0, 0, 0, 240, 240, 240};
	Pixels out = resize(src, 2, 1, 8, 1);
	EXPECT_EQ(0, out[0]);
	EXPECT_EQ(240, out[7 * 3]);
	for (int x = 1; x < 8; x++)
		EXPECT_LE(out[(x - 1) * 3], out[x * 3]);
	EXPECT_GT(out[3 * 3], 0);
	EXPECT_LT(out[4 * 3], 240);
}

TEST(ImageUtilResize, RejectsBadArguments)
{
	Pixels src = letters("abcd"), out(64);
	int w = 2, h = 2, zero = 0;
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER, image_util_resize(out.data(), &zero, &h, src.data(), 2, 2, RGB));
	EXPECT_EQ(IMAGE_UTIL_ERROR_INVALID_PARAMETER, image_util_resize(out.data(), &w, &h, nullptr, 2, 2, RGB));
	EXPECT_EQ(IMAGE_UTIL_ERROR_NOT_SUPPORTED_FORMAT,
	          image_util_resize(out.data(), &w, &h, src.data(), 2, 2, IMAGE_UTIL_COLORSPACE_RGB565));
}
} // namespace
