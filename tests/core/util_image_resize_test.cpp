// Shrinking pictures: JPEG through the decoder (MemoUtil::resizeImageJpg), PNG without a canvas
// (MemoUtil::resizeImagePng) and any format through a buffer canvas (MemoUtil::resizeImage).
#include "Util/MemoUtil.h"
#include "util_image_fixture.h"

#include <Ecore_File.h>

using namespace image_fixture;

namespace
{
using ResizeJpg = ImageTest;

TEST_F(ResizeJpg, LongerSideTakesTheLargerValue)
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
	std::string dst = path("dst.jpg"), png = path("real.png");
	ecore_file_remove(dst.c_str());
	writeEvasImage(png, 64, 48, quadrants(64, 48));
	EXPECT_FALSE(MemoUtil::resizeImageJpg(path("missing.jpg").c_str(), dst.c_str(), 64, 48));
	EXPECT_FALSE(MemoUtil::resizeImageJpg(nullptr, dst.c_str(), 64, 48));
	EXPECT_FALSE(MemoUtil::resizeImageJpg(png.c_str(), dst.c_str(), 32, 24));
	EXPECT_FALSE(ecore_file_exists(dst.c_str()));
	EXPECT_TRUE(MemoUtil::resizeImageJpg(path("src.jpg").c_str(), path("no/such/dir/x.jpg").c_str(), 32, 24));
}

using ResizeImage = ImageTest;

// Mode 0 fits the height and centres, 1 takes the picture's proportion at the given height, 2 stretches.
// The editor calls from a worker thread.
TEST_F(ResizeImage, Modes0To2)
{
	std::string wide = path("wide.png"), tall = path("tall.png");
	writeEvasImage(wide, 1000, 500, quadrants(1000, 500));
	writeEvasImage(tall, 100, 400, quadrants(100, 400));
	struct {
		std::string src, dst;
		int w, h, mode, outW, outH;
	} cases[] = {
	    {wide, path("out.png"), 123, 300, 1, 600, 300},
	    {tall, path("out.jpg"), 400, 100, 2, 400, 100},
	    {wide, wide, 400, 200, 1, 400, 200},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.dst);
		bool done = false;
		runInWorker([&] { done = MemoUtil::resizeImage(c.src.c_str(), c.dst.c_str(), c.w, c.h, c.mode); });
		ASSERT_TRUE(done);
		Picture pic = readImage(c.dst);
		EXPECT_EQ(c.outW, pic.w);
		EXPECT_EQ(c.outH, pic.h);
		expectQuadrants(pic);
	}

	std::string green = path("green.jpg"), fitted = path("fitted.png");
	writeJpeg(green, 1000, 500, [](int, int) { return GREEN; });
	ASSERT_TRUE(MemoUtil::resizeImage(green.c_str(), fitted.c_str(), 800, 200, 0));
	Picture pic = readImage(fitted);
	ASSERT_EQ(800, pic.w);
	EXPECT_FALSE(near(GREEN, pic.at(100, 100)));
	EXPECT_TRUE(near(GREEN, pic.at(400, 100)));
	EXPECT_FALSE(near(GREEN, pic.at(700, 100)));
}

// Thumbnails: a tall picture keeps its top, a wide one its middle.
TEST_F(ResizeImage, Mode3CropsToTheBox)
{
	std::string tall = path("tall.png"), wide = path("wide.jpg");
	std::string thumbTall = path("thumb-tall.jpg"), thumbWide = path("thumb-wide.jpg");
	writeEvasImage(tall, 500, 1000, [](int, int y) { return y < 48 ? RED : y < 952 ? GREEN : BLUE; });
	writeJpeg(wide, 1000, 496, [](int x, int) { return x < 96 ? RED : x < 904 ? GREEN : BLUE; });

	ASSERT_TRUE(MemoUtil::resizeImage(tall.c_str(), thumbTall.c_str(), 322, 263, 3));
	Picture t = readImage(thumbTall);
	ASSERT_EQ(322, t.w);
	ASSERT_EQ(263, t.h);
	EXPECT_TRUE(near(RED, t.at(161, 2))) << std::hex << t.at(161, 2);
	EXPECT_TRUE(near(GREEN, t.at(161, 260))) << std::hex << t.at(161, 260);

	ASSERT_TRUE(MemoUtil::resizeImage(wide.c_str(), thumbWide.c_str(), 322, 184, 3));
	Picture w = readImage(thumbWide);
	ASSERT_EQ(322, w.w);
	ASSERT_EQ(184, w.h);
	EXPECT_TRUE(near(RED, w.at(2, 92))) << std::hex << w.at(2, 92);
	EXPECT_TRUE(near(GREEN, w.at(161, 92))) << std::hex << w.at(161, 92);
	EXPECT_TRUE(near(BLUE, w.at(319, 92))) << std::hex << w.at(319, 92);
}

// Whatever the source, a rendered canvas is a result: an unreadable source or a width of 0 saves a
// transparent picture (sizes below 1 become 1), and a failed save is logged.
TEST_F(ResizeImage, OnlyAMissingCanvasFails)
{
	std::string src = path("src.png"), missing = path("missing.png");
	writeEvasImage(src, 40, 20, quadrants(40, 20));
	struct {
		std::string src, dst;
		int w, h, mode, outW, outH;
	} cases[] = {
	    {missing, path("m1.png"), 100, 100, 1, 1, 100},
	    {missing, path("m3.png"), 322, 263, 3, 322, 263},
	    {src, path("zero.png"), 0, 30, 2, 1, 30},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.dst);
		EXPECT_TRUE(MemoUtil::resizeImage(c.src.c_str(), c.dst.c_str(), c.w, c.h, c.mode));
		Picture pic = readImage(c.dst);
		EXPECT_EQ(c.outW, pic.w);
		EXPECT_EQ(c.outH, pic.h);
		EXPECT_TRUE(std::all_of(pic.px.begin(), pic.px.end(), [](uint32_t p) { return p == 0; }));
	}
	EXPECT_TRUE(MemoUtil::resizeImage(src.c_str(), path("no/such/dir/x.png").c_str(), 20, 10, 2));
}

using ResizePng = ImageTest;

// The editor's worker shrinks PNG pictures without the canvas and must give the file the canvas gave:
// the same header (size, depth, colour type, significant bits) and pixels within two levels (the
// roundings differ), for palette, grey and partly transparent pictures, also in place.
TEST_F(ResizePng, GivesTheCanvasResult)
{
	const ColorFn photo = [seed = 7u](int x, int y) mutable {
		seed = seed * 1103515245u + 12345u;
		const uint32_t alpha = y < 100 ? 0xff : 255 - (y - 100) * 2;
		return (alpha << 24) | ((40 + x / 4 + (seed >> 16) % 24) << 16) | ((60 + y / 3) << 8) | (seed >> 20 & 0xff);
	};
	struct {
		png_uint_32 format;
		int w, h;
		bool inPlace;
	} cases[] = {
	    {PNG_FORMAT_RGBA, 139, 97, false},
	    {PNG_FORMAT_GRAY, 300, 200, false},
	    {PNG_FORMAT_RGBA_COLORMAP, 100, 80, false},
	    {PNG_FORMAT_RGBA, 64, 46, true},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.format);
		std::string src = path("src.png"), canvas = path("canvas.png"), mine = c.inPlace ? src : path("mine.png");
		writePng(src, 600, 227, c.format, c.format & PNG_FORMAT_FLAG_COLORMAP ? quadrants(600, 227) : photo);
		ASSERT_TRUE(MemoUtil::resizeImage(src.c_str(), canvas.c_str(), c.w, c.h, 2));
		bool done = false;
		runInWorker([&] { done = MemoUtil::resizeImagePng(src.c_str(), mine.c_str(), c.w, c.h); });
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
