// Admission and target size of pictures for insertion (MemoUtil::getInsertImageSize).
#include "Util/MemoUtil.h"
#include "util_image_fixture.h"

#include <Ecore.h>

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

TEST_F(InsertImageSize, SmallPictureNeedsNoShrinkingAndKeepsOuts)
{
	std::string p = path("small.jpg");
	writeJpeg(p, 100, 100, [](int, int) { return GREEN; });
	Result r = ask(p);
	EXPECT_FALSE(r.shrink);
	EXPECT_EQ(0, r.error);
	EXPECT_EQ(-7, r.w);
	EXPECT_EQ(-7, r.h);
	EXPECT_EQ(-7.0f, r.scale);
}

TEST_F(InsertImageSize, MissingFileTouchesNothing)
{
	Result r = ask(path("none.jpg"));
	EXPECT_FALSE(r.shrink);
	EXPECT_EQ(-7, r.error);
	EXPECT_EQ(-7, r.w);
}

TEST_F(InsertImageSize, UnreadableFileReportsTheLoadError)
{
	std::string p = path("text.jpg");
	writeBytes(p, {'n', 'o', 't', ' ', 'a', 'n', ' ', 'i', 'm', 'a', 'g', 'e'});
	Result r = ask(p);
	EXPECT_FALSE(r.shrink);
	EXPECT_NE(0, r.error);
	EXPECT_NE(-1, r.error);
}

// The sizes come from the stepped scale search; they are the stored memos' sizes, so exact.
TEST_F(InsertImageSize, LargePicturesShrinkToEvenSizes)
{
	struct {
		int w, h, outW, outH;
		float scale;
	} cases[] = {
	    {600, 600, 564, 564, 0.94f},  {4000, 3000, 640, 480, 0.16f}, {3000, 4000, 480, 640, 0.16f},
	    {1000, 500, 790, 394, 0.79f}, {4001, 10, 3960, 8, 0.99f},
	};
	for (const auto &c : cases) {
		SCOPED_TRACE(std::to_string(c.w) + "x" + std::to_string(c.h));
		Result r = ask(claimedJpeg("p.jpg", c.w, c.h));
		EXPECT_TRUE(r.shrink);
		EXPECT_EQ(0, r.error);
		EXPECT_EQ(c.outW, r.w);
		EXPECT_EQ(c.outH, r.h);
		EXPECT_NEAR(c.scale, r.scale, 1e-4);
		EXPECT_LT(r.w * r.h, 320000);
	}
}

TEST_F(InsertImageSize, JpegLimitIsBelow225MegaPixels)
{
	Result refused = ask(claimedJpeg("huge.jpg", 15000, 15000));
	EXPECT_FALSE(refused.shrink);
	EXPECT_EQ(-1, refused.error);
	EXPECT_EQ(-7, refused.w);

	Result passed = ask(claimedJpeg("big.jpeg", 14999, 15000));
	EXPECT_TRUE(passed.shrink);
	EXPECT_EQ(0, passed.error);
	EXPECT_EQ(448, passed.w);
	EXPECT_EQ(450, passed.h);
}

TEST_F(InsertImageSize, OtherFormatsAreLimitedBelowNineMegaPixels)
{
	std::string png = path("square.png");
	writeEvasImage(png, 3000, 3000, [](int, int) { return BLUE; });
	EXPECT_EQ(-1, ask(png).error);

	writeEvasImage(png, 2999, 3000, [](int, int) { return BLUE; });
	Result r = ask(png);
	EXPECT_TRUE(r.shrink);
	EXPECT_EQ(538, r.w);
	EXPECT_EQ(540, r.h);

	// The limit follows the name, not the content.
	EXPECT_EQ(-1, ask(claimedJpeg("jpeg-named.png", 4000, 3000)).error);
}

// Image flows ask from worker threads while the main loop runs.
TEST_F(InsertImageSize, WorksFromAWorkerThread)
{
	struct Job {
		std::string path;
		bool shrink = false, done = false;
		int w = 0, h = 0, error = -7;
	} job;
	job.path = claimedJpeg("worker.jpg", 4000, 3000);
	ecore_thread_run(
	    [](void *data, Ecore_Thread *) {
		    Job *j = static_cast<Job *>(data);
		    j->shrink = MemoUtil::getInsertImageSize(j->path.c_str(), &j->w, &j->h, &j->error);
	    },
	    [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; },
	    [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; }, &job);
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return job.done; }));
	EXPECT_TRUE(job.shrink);
	EXPECT_EQ(0, job.error);
	EXPECT_EQ(640, job.w);
	EXPECT_EQ(480, job.h);
}
} // namespace
