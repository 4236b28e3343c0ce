// Admission and target size of pictures for insertion (MemoUtil::getInsertImageSize).
#include "Util/MemoUtil.h"
#include "util_image_fixture.h"

using namespace image_fixture;

namespace
{
using InsertImageSize = ImageTest;

// Pictures that need no shrinking or cannot be had leave the outs alone (-7 here); a refusal for size sets
// the error to -1, a file that cannot be read its load error. The target sizes come from the stepped scale
// search; they are the stored memos' sizes, so exact. Image flows also ask from worker threads.
TEST_F(InsertImageSize, AdmissionAndTargetSizes)
{
	// A small real JPEG whose header claims w x h.
	auto claimedJpeg = [this](const std::string &name, int w, int h) {
		std::string p = path(name);
		writeJpeg(p, 16, 16, [](int, int) { return RED; });
		patchJpegSize(p, w, h);
		return p;
	};
	std::string small = path("small.jpg"), text = path("text.jpg"), square = path("square.png");
	std::string limit = path("limit.png");
	writeJpeg(small, 100, 100, [](int, int) { return GREEN; });
	writeBytes(text, "not an image");
	writePng(square, 3000, 3000, [](int, int) { return BLUE; });
	writePng(limit, 2999, 3000, [](int, int) { return BLUE; });
	const int ANY_LOAD_ERROR = -2, UNTOUCHED = -7;
	struct {
		std::string file;
		bool shrink;
		int error, w, h;
		float scale;
		bool inWorker;
	} cases[] = {
	    {small, false, 0, UNTOUCHED, UNTOUCHED, UNTOUCHED, false},
	    {path("none.jpg"), false, UNTOUCHED, UNTOUCHED, UNTOUCHED, UNTOUCHED, false},
	    {text, false, ANY_LOAD_ERROR, UNTOUCHED, UNTOUCHED, UNTOUCHED, false},
	    {claimedJpeg("huge.jpg", 15000, 15000), false, -1, UNTOUCHED, UNTOUCHED, UNTOUCHED, false},
	    {square, false, -1, UNTOUCHED, UNTOUCHED, UNTOUCHED, false}, // anything but JPEG: below 9 MP
	    {claimedJpeg("jpeg-named.png", 4000, 3000), false, -1, UNTOUCHED, UNTOUCHED, UNTOUCHED, false},
	    {claimedJpeg("a.jpg", 600, 600), true, 0, 564, 564, 0.94f, false},
	    {claimedJpeg("b.jpg", 4000, 3000), true, 0, 640, 480, 0.16f, true},
	    {claimedJpeg("c.jpg", 3000, 4000), true, 0, 480, 640, 0.16f, false},
	    {claimedJpeg("d.jpg", 1000, 500), true, 0, 790, 394, 0.79f, false},
	    {claimedJpeg("e.jpg", 4001, 10), true, 0, 3960, 8, 0.99f, false},
	    {claimedJpeg("f.jpeg", 14999, 15000), true, 0, 448, 450, 0.03f, false},
	    {limit, true, 0, 538, 540, 0.18f, true},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(c.file);
		int w = UNTOUCHED, h = UNTOUCHED, error = UNTOUCHED;
		float scale = UNTOUCHED;
		bool shrink = false;
		auto ask = [&] { shrink = MemoUtil::getInsertImageSize(c.file.c_str(), &w, &h, &error, &scale); };
		if (c.inWorker)
			runInWorker(ask);
		else
			ask();
		EXPECT_EQ(c.shrink, shrink);
		if (c.error == ANY_LOAD_ERROR)
			EXPECT_TRUE(error != 0 && error != -1 && error != UNTOUCHED) << error;
		else
			EXPECT_EQ(c.error, error);
		EXPECT_EQ(c.w, w);
		EXPECT_EQ(c.h, h);
		EXPECT_NEAR(c.scale, scale, 1e-4);
	}
}
} // namespace
