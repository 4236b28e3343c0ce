// Image sizes and tag scanning of the box items at their edges, without widgets; the tags themselves
// and their removal are checked on real items.
#include <gtest/gtest.h>

#include "Box/MemoBoxImageMarkup.h"
#include "Box/MemoBoxImageSize.h"

// The scale of 1.8 is checked on real items.
TEST(BoxImageSize, WidthsFollowTheExactScale)
{
	auto expectSize = [](void (*size)(double, int *, int *), double scale, int width, int defaultHeight) {
		int w = 0, h = 0;
		size(scale, &w, &h);
		EXPECT_EQ(width, w) << scale;
		EXPECT_EQ(defaultHeight, h) << scale;
	};
	expectSize(memoBoxImageTextSize, 3.8, 653, 428);
	expectSize(memoBoxImageTextSize, 1.81, 628, 428);
	expectSize(memoBoxImageCheckSize, 3.8, 560, 392);
	expectSize(memoBoxImageCheckSize, 2.6, 521, 392);
}

TEST(BoxImageSize, HeightKeepsTheProportionsPlusRoom)
{
	// Large pictures do not overflow the arithmetic; the box item tests check the usual sizes.
	EXPECT_EQ(603 * 3 / 4 + 40, memoBoxImageTagHeight(40000, 30000, 603, 428));
	EXPECT_EQ(428, memoBoxImageTagHeight(0, 500, 603, 428));
	EXPECT_EQ(428, memoBoxImageTagHeight(1000, -1, 603, 428));
	// A tag with an overlong path is cut at its buffer rather than written past it.
	EXPECT_EQ(2047u, memoBoxImageTag(1, 1, std::string(3000, 'p').c_str(), false).size());
}

TEST(BoxImageMarkup, PathsInOrder)
{
	const std::string markup = "a<br/><item size=603x341 vsize=full href=file:///m/one.jpg></item><br/>"
	                           "b<item size=1x1 href=file:///m/two.png></item>"
	                           "<item size=1x1 href=file:///m/open.png>";
	const std::vector<std::string> paths = memoBoxImagePaths(markup.c_str());
	ASSERT_EQ(2u, paths.size());
	EXPECT_EQ("/m/one.jpg", paths[0]);
	EXPECT_EQ("/m/two.png", paths[1]);
	EXPECT_TRUE(memoBoxImagePaths("plain<br/>text").empty());

	const std::string longTag = "<item size=1x1 href=file://" + std::string(2000, 'x') + "></item>";
	ASSERT_EQ(1u, memoBoxImagePaths(longTag.c_str()).size());
	EXPECT_EQ(1023u, memoBoxImagePaths(longTag.c_str())[0].size());
}
