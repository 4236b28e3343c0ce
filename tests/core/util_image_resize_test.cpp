// Shrinking pictures: JPEG through the decoder (MemoUtil::resizeImageJpg), any format through a buffer
// canvas (MemoUtil::resizeImage) and PNG without a canvas (MemoUtil::resizeImagePng).
#include "Util/MemoUtil.h"
#include "util_image_fixture.h"

#include <Ecore_File.h>

using namespace image_fixture;

namespace
{
using Resize = ImageTest;

TEST_F(Resize, JpegLongerSideTakesTheLargerValue)
{
	struct {
		int srcW, srcH, w, h;
		float scale;
		int outW, outH;
		bool inPlace;
	} cases[] = {
	    {1600, 1200, 652, 488, 0.41f, 652, 488, false}, // decoded at 1/2
	    {1200, 1600, 652, 488, 0.2f, 488, 652, false},  // portrait, decoded at 1/4
	    {800, 800, 300, 200, 0.1f, 200, 300, false},    // square: the values swap
	    {1200, 900, 200, 320, 1.0f, 320, 200, true},    // the source replaced
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(std::to_string(c.srcW) + "x" + std::to_string(c.srcH));
		std::string src = path("src.jpg"), dst = c.inPlace ? src : path("dst.jpg");
		writeJpeg(src, c.srcW, c.srcH, quadrants(c.srcW, c.srcH));
		ASSERT_TRUE(MemoUtil::resizeImageJpg(src.c_str(), dst.c_str(), c.w, c.h, c.scale));
		Picture pic = readImage(dst);
		EXPECT_EQ(c.outW, pic.w);
		EXPECT_EQ(c.outH, pic.h);
		expectQuadrants(pic);
	}

	// Only a missing or undecodable source fails; a target that cannot be written is logged, not reported.
	std::string dst = path("none.jpg"), png = path("real.png");
	writePng(png, 64, 48, quadrants(64, 48));
	EXPECT_FALSE(MemoUtil::resizeImageJpg(path("missing.jpg").c_str(), dst.c_str(), 64, 48));
	EXPECT_FALSE(MemoUtil::resizeImageJpg(png.c_str(), dst.c_str(), 32, 24));
	EXPECT_FALSE(ecore_file_exists(dst.c_str()));
	EXPECT_TRUE(MemoUtil::resizeImageJpg(path("src.jpg").c_str(), path("no/such/dir/x.jpg").c_str(), 32, 24));
}

// Mode 0 fits the height and centres, 1 takes the picture's proportion at the given height, 2 stretches,
// 3 crops thumbnails (the top of a tall picture, the middle of a wide one). The editor calls from workers.
TEST_F(Resize, CanvasModes)
{
	std::string wide = path("wide.png"), tall = path("tall.png"), green = path("green.jpg");
	std::string tallThumb = path("tall-thumb.png"), wideThumb = path("wide-thumb.jpg");
	writePng(wide, 1000, 500, quadrants(1000, 500));
	writePng(tall, 100, 400, quadrants(100, 400));
	writeJpeg(green, 1000, 500, [](int, int) { return GREEN; });
	writePng(tallThumb, 500, 1000, [](int, int y) { return y < 48 ? RED : y < 952 ? GREEN : BLUE; });
	writeJpeg(wideThumb, 1000, 496, [](int x, int) { return x < 96 ? RED : x < 904 ? GREEN : BLUE; });
	const std::vector<std::tuple<int, int, uint32_t>> none;
	struct {
		std::string src, dst;
		int w, h, mode, outW, outH;
		std::vector<std::tuple<int, int, uint32_t>> probes; // none: the four quadrants
	} cases[] = {
	    {wide, path("out.png"), 123, 300, 1, 600, 300, none},
	    {tall, path("out.jpg"), 400, 100, 2, 400, 100, none},
	    {wide, wide, 400, 200, 1, 400, 200, none},
	    {green, path("fitted.png"), 800, 200, 0, 800, 200, {{100, 100, 0}, {400, 100, GREEN}, {700, 100, 0}}},
	    {tallThumb, path("t1.jpg"), 322, 263, 3, 322, 263, {{161, 2, RED}, {161, 260, GREEN}}},
	    {wideThumb, path("t2.jpg"), 322, 184, 3, 322, 184, {{2, 92, RED}, {161, 92, GREEN}, {319, 92, BLUE}}},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.dst);
		bool done = false;
		runInWorker([&] { done = MemoUtil::resizeImage(c.src.c_str(), c.dst.c_str(), c.w, c.h, c.mode); });
		ASSERT_TRUE(done);
		Picture pic = readImage(c.dst);
		ASSERT_EQ(c.outW, pic.w);
		ASSERT_EQ(c.outH, pic.h);
		if (c.probes.empty())
			expectQuadrants(pic);
		for (auto [x, y, colour] : c.probes)
			EXPECT_TRUE(near(colour, pic.at(x, y))) << x << "," << y << ": " << std::hex << pic.at(x, y);
	}

	// Only a missing canvas fails: an unreadable source or a width of 0 saves a transparent picture
	// (sizes below 1 become 1), and a failed save is logged.
	for (auto [src, mode, w, h, outW, outH] :
	     {std::make_tuple(path("missing.png"), 1, 100, 100, 1, 100),
	      std::make_tuple(path("missing.png"), 3, 322, 263, 322, 263), std::make_tuple(wide, 2, 0, 30, 1, 30)}) {
		EXPECT_TRUE(MemoUtil::resizeImage(src.c_str(), path("empty.png").c_str(), w, h, mode));
		Picture pic = readImage(path("empty.png"));
		EXPECT_EQ(outW, pic.w);
		EXPECT_EQ(outH, pic.h);
		EXPECT_TRUE(std::all_of(pic.px.begin(), pic.px.end(), [](uint32_t p) { return p == 0; })) << mode;
	}
	EXPECT_TRUE(MemoUtil::resizeImage(wide.c_str(), path("no/such/dir/x.png").c_str(), 20, 10, 2));
}

// The editor's worker shrinks PNG pictures without the canvas and must give the file the canvas gave:
// the same header (size, depth, colour type, significant bits) and pixels within two levels (the
// roundings differ), for palette, grey and partly transparent pictures, also in place.
TEST_F(Resize, PngWithoutCanvasGivesTheCanvasResult)
{
	const ColorFn photo = [seed = 7u](int x, int y) mutable {
		seed = seed * 1103515245u + 12345u;
		const uint32_t alpha = y < 100 ? 0xff : 255 - (y - 100) * 2;
		return (alpha << 24) | ((40 + x / 4 + (seed >> 16) % 24) << 16) | ((60 + y / 3) << 8) | (seed >> 20 & 0xff);
	};
	using PngCase = std::tuple<png_uint_32, int, int, bool>;
	for (auto [format, w, h, inPlace] :
	     {PngCase{PNG_FORMAT_RGBA, 139, 97, false}, PngCase{PNG_FORMAT_GRAY, 300, 200, false},
	      PngCase{PNG_FORMAT_RGBA_COLORMAP, 100, 80, false}, PngCase{PNG_FORMAT_RGBA, 64, 46, true}}) {
		SCOPED_TRACE(format);
		std::string src = path("src.png"), canvas = path("canvas.png"), mine = inPlace ? src : path("mine.png");
		writePng(src, 600, 227, format & PNG_FORMAT_FLAG_COLORMAP ? quadrants(600, 227) : photo, format);
		ASSERT_TRUE(MemoUtil::resizeImage(src.c_str(), canvas.c_str(), w, h, 2));
		bool done = false;
		runInWorker([&] { done = MemoUtil::resizeImagePng(src.c_str(), mine.c_str(), w, h); });
		ASSERT_TRUE(done);
		EXPECT_EQ(memo_test::readFile(canvas).substr(0, 49), memo_test::readFile(mine).substr(0, 49));
		Picture a = readImage(canvas), b = readImage(mine);
		ASSERT_EQ(a.px.size(), b.px.size());
		int worst = 0;
		for (size_t i = 0; i < a.px.size(); i++)
			for (int shift = 0; shift < 32; shift += 8)
				worst = std::max(worst, std::abs(int(a.px[i] >> shift & 0xff) - int(b.px[i] >> shift & 0xff)));
		EXPECT_LE(worst, 2);
	}

	// Not a PNG: false and no target, so that the worker falls back on the canvas.
	std::string jpeg = path("photo.png"), none = path("none.png");
	writeJpeg(jpeg, 64, 48, quadrants(64, 48));
	EXPECT_FALSE(MemoUtil::resizeImagePng(jpeg.c_str(), none.c_str(), 32, 24));
	EXPECT_FALSE(MemoUtil::resizeImagePng(path("missing.png").c_str(), none.c_str(), 32, 24));
	EXPECT_FALSE(ecore_file_exists(none.c_str()));
}
} // namespace
