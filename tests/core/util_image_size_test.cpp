// Admission and target size of pictures for insertion (MemoUtil::getInsertImageSize).
#include "Util/MemoUtil.h"
#include "util_image_fixture.h"

using namespace image_fixture;

namespace
{
class InsertImageSize : public ImageTest
{
protected:
	// A small real JPEG whose header claims w x h, named as given.
	std::string claimedJpeg(const std::string &name, int w, int h)
	{
		std::string p = path(name);
		writeJpeg(p, 16, 16, [](int, int) { return RED; });
		patchJpegSize(p, w, h);
		return p;
	}

	struct Result {
		bool shrink;
		int w, h, error;
		float scale;
	};
	Result ask(const std::string &p)
	{
		Result r = {false, -7, -7, -7, -7.0f};
		r.shrink = MemoUtil::getInsertImageSize(p.c_str(), &r.w, &r.h, &r.error, &r.scale);
		return r;
	}
};

// Pictures that need no shrinking or cannot be had leave the outs alone; a refusal for size is -1, a file
// that cannot be read reports the load error.
TEST_F(InsertImageSize, RefusalsAndSmallPicturesKeepTheOuts)
{
	std::string small = path("small.jpg"), text = path("text.jpg");
	writeJpeg(small, 100, 100, [](int, int) { return GREEN; });
	writeBytes(text, "not an image");
	std::string png = path("square.png");
	writeEvasImage(png, 3000, 3000, [](int, int) { return BLUE; });
	struct {
		std::string file;
		int error;
	} cases[] = {
	    {small, 0},
	    {path("none.jpg"), -7},
	    {text, -2},                                      // any load error but -1
	    {claimedJpeg("huge.jpg", 15000, 15000), -1},     // JPEG: below 225 megapixels
	    {png, -1},                                       // anything else: below 9 megapixels
	    {claimedJpeg("jpeg-named.png", 4000, 3000), -1}, // the limit follows the name, not the content
	};
	for (const auto &c : cases) {
		Result r = ask(c.file);
		EXPECT_FALSE(r.shrink) << c.file;
		if (c.error == -2)
			EXPECT_TRUE(r.error != 0 && r.error != -1 && r.error != -7) << r.error;
		else
			EXPECT_EQ(c.error, r.error) << c.file;
		EXPECT_EQ(-7, r.w);
		EXPECT_EQ(-7, r.h);
		EXPECT_EQ(-7.0f, r.scale);
	}
}

// The sizes come from the stepped scale search; they are the stored memos' sizes, so exact.
TEST_F(InsertImageSize, LargePicturesShrinkToEvenSizes)
{
	std::string png = path("limit.png");
	writeEvasImage(png, 2999, 3000, [](int, int) { return BLUE; });
	struct {
		std::string file;
		int outW, outH;
		float scale;
	} cases[] = {
	    {claimedJpeg("a.jpg", 600, 600), 564, 564, 0.94f},
	    {claimedJpeg("b.jpg", 4000, 3000), 640, 480, 0.16f},
	    {claimedJpeg("c.jpg", 3000, 4000), 480, 640, 0.16f},
	    {claimedJpeg("d.jpg", 1000, 500), 790, 394, 0.79f},
	    {claimedJpeg("e.jpg", 4001, 10), 3960, 8, 0.99f},
	    {claimedJpeg("f.jpeg", 14999, 15000), 448, 450, -1},
	    {png, 538, 540, -1},
	};
	for (const auto &c : cases) {
		Result r = ask(c.file);
		EXPECT_TRUE(r.shrink) << c.file;
		EXPECT_EQ(0, r.error);
		EXPECT_EQ(c.outW, r.w) << c.file;
		EXPECT_EQ(c.outH, r.h) << c.file;
		if (c.scale > 0) {
			EXPECT_NEAR(c.scale, r.scale, 1e-4) << c.file;
		}
		EXPECT_LT(r.w * r.h, 320000);
	}
}

// Image flows ask from worker threads while the main loop runs.
TEST_F(InsertImageSize, WorksFromAWorkerThread)
{
	std::string file = claimedJpeg("worker.jpg", 4000, 3000);
	Result r = {false, 0, 0, -7, 0};
	runInWorker([&] { r.shrink = MemoUtil::getInsertImageSize(file.c_str(), &r.w, &r.h, &r.error); });
	EXPECT_TRUE(r.shrink);
	EXPECT_EQ(0, r.error);
	EXPECT_EQ(640, r.w);
	EXPECT_EQ(480, r.h);
}
} // namespace
