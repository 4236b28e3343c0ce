// Shrinking pictures: JPEG through the decoder (MemoUtil::resizeImageJpg) and any format
// through a buffer canvas (MemoUtil::resizeImage).
#include "Util/MemoUtil.h"
#include "util_image_fixture.h"

#include <Ecore.h>
#include <Ecore_File.h>

using namespace image_fixture;

namespace
{
// Quadrants: red, green / blue, yellow.
ColorFn quadrants(int w, int h)
{
	return [w, h](int x, int y) {
		if (y < h / 2)
			return x < w / 2 ? RED : GREEN;
		return x < w / 2 ? BLUE : YELLOW;
	};
}

void expectQuadrants(const Picture &pic)
{
	ASSERT_GT(pic.w, 0);
	int qx = pic.w / 4, qy = pic.h / 4;
	EXPECT_TRUE(near(RED, pic.at(qx, qy))) << std::hex << pic.at(qx, qy);
	EXPECT_TRUE(near(GREEN, pic.at(3 * qx, qy))) << std::hex << pic.at(3 * qx, qy);
	EXPECT_TRUE(near(BLUE, pic.at(qx, 3 * qy))) << std::hex << pic.at(qx, 3 * qy);
	EXPECT_TRUE(near(YELLOW, pic.at(3 * qx, 3 * qy))) << std::hex << pic.at(3 * qx, 3 * qy);
}

class ResizeJpg : public ImageTest
{
};

TEST_F(ResizeJpg, LongerSideTakesTheLargerValue)
{
	struct {
		int srcW, srcH, w, h;
		float scale;
		int outW, outH;
	} cases[] = {
	    {1600, 1200, 652, 488, 0.41f, 652, 488}, // decoded at 1/2
	    {1200, 1600, 652, 488, 0.2f, 488, 652},  // portrait, decoded at 1/4
	    {800, 800, 300, 200, 0.1f, 200, 300},    // square: the values swap
	    {640, 480, 200, 320, 1.0f, 320, 200},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(std::to_string(c.srcW) + "x" + std::to_string(c.srcH));
		std::string src = path("src.jpg"), dst = path("dst.jpg");
		writeJpeg(src, c.srcW, c.srcH, quadrants(c.srcW, c.srcH));
		ASSERT_TRUE(MemoUtil::resizeImageJpg(src.c_str(), dst.c_str(), c.w, c.h, c.scale));
		Picture pic = readImage(dst);
		EXPECT_EQ(c.outW, pic.w);
		EXPECT_EQ(c.outH, pic.h);
		expectQuadrants(pic);
	}
}

TEST_F(ResizeJpg, ReplacesTheSourceInPlace)
{
	std::string p = path("photo.jpg");
	writeJpeg(p, 1200, 900, quadrants(1200, 900));
	ASSERT_TRUE(MemoUtil::resizeImageJpg(p.c_str(), p.c_str(), 640, 480));
	Picture pic = readImage(p);
	EXPECT_EQ(640, pic.w);
	EXPECT_EQ(480, pic.h);
	expectQuadrants(pic);
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

class ResizeImage : public ImageTest
{
};

TEST_F(ResizeImage, CanvasTakesThePictureWidthInMode1)
{
	std::string src = path("pic.png"), dst = path("out.png");
	writeEvasImage(src, 1000, 500, quadrants(1000, 500));
	// The given width is replaced by the picture's proportion at the given height.
	ASSERT_TRUE(MemoUtil::resizeImage(src.c_str(), dst.c_str(), 123, 300, 1));
	Picture pic = readImage(dst);
	EXPECT_EQ(600, pic.w);
	EXPECT_EQ(300, pic.h);
	expectQuadrants(pic);
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

TEST_F(ResizeImage, Mode2Stretches)
{
	std::string src = path("pic.png"), dst = path("out.jpg");
	writeEvasImage(src, 100, 400, quadrants(100, 400));
	ASSERT_TRUE(MemoUtil::resizeImage(src.c_str(), dst.c_str(), 400, 100, 2));
	Picture pic = readImage(dst);
	EXPECT_EQ(400, pic.w);
	EXPECT_EQ(100, pic.h);
	expectQuadrants(pic);
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

TEST_F(ResizeImage, UnloadableSourceRendersNothing)
{
	std::string dst = path("out.png");
	EXPECT_FALSE(MemoUtil::resizeImage(path("missing.png").c_str(), dst.c_str(), 100, 100, 1));
	EXPECT_FALSE(ecore_file_exists(dst.c_str()));
}

// The editor shrinks non-JPEG pictures on a worker thread.
TEST_F(ResizeImage, WorksFromAWorkerThread)
{
	struct Job {
		std::string src, dst;
		bool result = false, done = false;
	} job;
	job.src = path("pic.png");
	job.dst = job.src;
	writeEvasImage(job.src, 1000, 500, quadrants(1000, 500));
	ecore_thread_run(
	    [](void *data, Ecore_Thread *) {
		    Job *j = static_cast<Job *>(data);
		    j->result = MemoUtil::resizeImage(j->src.c_str(), j->dst.c_str(), 400, 200, 1);
	    },
	    [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; },
	    [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; }, &job);
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return job.done; }));
	EXPECT_TRUE(job.result);
	Picture pic = readImage(job.dst);
	EXPECT_EQ(400, pic.w);
	EXPECT_EQ(200, pic.h);
	expectQuadrants(pic);
}
} // namespace
