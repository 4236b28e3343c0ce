// Shrinking pictures: JPEG through the decoder (MemoUtil::resizeImageJpg) and any format
// through a buffer canvas (MemoUtil::resizeImage).
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
	    {640, 480, 200, 320, 1.0f, 320, 200, false},
	    {1200, 900, 640, 480, 1.0f, 640, 480, true}, // the source replaced
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
}

TEST_F(ResizeJpg, OnlyAMissingOrUndecodableSourceFails)
{
	std::string dst = path("dst.jpg");
	EXPECT_FALSE(MemoUtil::resizeImageJpg(path("missing.jpg").c_str(), dst.c_str(), 64, 48));
	EXPECT_FALSE(MemoUtil::resizeImageJpg(nullptr, dst.c_str(), 64, 48));

	std::string png = path("real.png");
	writeEvasImage(png, 64, 48, quadrants(64, 48));
	EXPECT_FALSE(MemoUtil::resizeImageJpg(png.c_str(), dst.c_str(), 32, 24));
	EXPECT_FALSE(ecore_file_exists(dst.c_str()));

	// A target that cannot be written is logged, not reported.
	std::string src = path("src.jpg");
	writeJpeg(src, 64, 48, quadrants(64, 48));
	EXPECT_TRUE(MemoUtil::resizeImageJpg(src.c_str(), path("no/such/dir/x.jpg").c_str(), 32, 24));
}

using ResizeImage = ImageTest;

// Mode 1 replaces the given width by the picture's proportion at the given height; mode 2 stretches. The
// editor shrinks non-JPEG pictures on a worker thread.
TEST_F(ResizeImage, Mode1KeepsTheProportionMode2Stretches)
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
	EXPECT_FALSE(MemoUtil::resizeImage(path("missing.png").c_str(), path("none.png").c_str(), 100, 100, 1));
	EXPECT_FALSE(ecore_file_exists(path("none.png").c_str()));
}

TEST_F(ResizeImage, Mode0FitsTheHeightAndCentres)
{
	std::string src = path("pic.jpg"), dst = path("out.png");
	writeJpeg(src, 1000, 500, [](int, int) { return GREEN; });
	ASSERT_TRUE(MemoUtil::resizeImage(src.c_str(), dst.c_str(), 800, 200, 0));
	Picture pic = readImage(dst);
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
} // namespace
