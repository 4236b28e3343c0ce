// EXIF orientation of pictures and turning them upright in place
// (MemoUtil::getOrient, MemoUtil::rotateImage).
#include "Util/MemoUtil.h"
#include "util_image_fixture.h"

using namespace image_fixture;

namespace
{
// The upright picture: four quadrants of different colours, 64 x 32.
const int UW = 64, UH = 32;
const ColorFn upright = quadrants(UW, UH);

// What a camera stores for the upright picture under this orientation: a stored pixel (x, y) shows, once
// the viewer applies the orientation, where 5 to 8 transpose first, then 2 and 6 mirror across, 4 and 8
// mirror down, 3 and 7 both.
struct Stored {
	int orientation, w, h;
	explicit Stored(int o) : orientation(o), w(o >= 5 ? UH : UW), h(o >= 5 ? UW : UH) {}
	uint32_t operator()(int x, int y) const
	{
		int sw = w, sh = h;
		if (orientation >= 5) {
			std::swap(x, y);
			std::swap(sw, sh);
		}
		const int flips = (orientation - 1) % 4;
		return upright(flips == 1 || flips == 2 ? sw - 1 - x : x, flips >= 2 ? sh - 1 - y : y);
	}
};

// Compares a picture with a colour function at the centre of each 16 x 16 block.
void expectPicture(const Picture &pic, int w, int h, const ColorFn &color)
{
	ASSERT_EQ(w, pic.w);
	ASSERT_EQ(h, pic.h);
	for (int y = 8; y < h; y += 16)
		for (int x = 8; x < w; x += 16)
			EXPECT_TRUE(near(color(x, y), pic.at(x, y)))
			    << "at " << x << "," << y << std::hex << ": " << pic.at(x, y) << " instead of " << color(x, y);
}

using Orientation = ImageTest;

// The flow of the editor: read the tag of the copy (in either byte order), then turn the copy in place.
// Turned orientations come out upright; the mirrored ones (2, 4, 5, 7) stay as stored.
TEST_F(Orientation, EightOrientationsThroughTheEditorFlow)
{
	for (int o = 1; o <= 8; o++) {
		SCOPED_TRACE("orientation " + std::to_string(o));
		Stored stored(o);
		std::string p = path("o" + std::to_string(o) + ".jpg");
		writeJpeg(p, stored.w, stored.h, stored);
		EXPECT_EQ(0, MemoUtil::getOrient(p.c_str()));
		addExifOrientation(p, o, o % 2 ? EXIF_BYTE_ORDER_INTEL : EXIF_BYTE_ORDER_MOTOROLA);

		int orient = MemoUtil::getOrient(p.c_str());
		EXPECT_EQ(o, orient);
		MemoUtil::rotateImage(p.c_str(), orient);

		Picture pic = readImage(p);
		if (o == 1 || o == 3 || o == 6 || o == 8)
			expectPicture(pic, UW, UH, upright);
		else
			expectPicture(pic, stored.w, stored.h, stored);
		// Rewritten without EXIF, so nothing turns it a second time.
		EXPECT_EQ(0, MemoUtil::getOrient(p.c_str()));
	}
}

TEST_F(Orientation, OnlyDecodableJpgNamesAreTurned)
{
	std::string jpeg = path("a.jpeg"), png = path("a.png");
	writeJpeg(jpeg, 64, 32, upright);
	addExifOrientation(jpeg, 6);
	writePng(png, 64, 32, upright);
	for (const std::string &p : {jpeg, png}) {
		const std::string before = memo_test::readFile(p);
		MemoUtil::rotateImage(p.c_str(), 6);
		EXPECT_EQ(before, memo_test::readFile(p)) << p;
	}
	MemoUtil::rotateImage(path("missing.jpg").c_str(), 6);
	EXPECT_EQ(0, MemoUtil::getOrient(path("missing.jpg").c_str()));

	// A damaged file is left alone rather than replaced by an empty picture.
	std::string broken = path("broken.jpg");
	writeBytes(broken, std::string("\xff\xd8\xff\xe0\x00", 5));
	MemoUtil::rotateImage(broken.c_str(), 6);
	EXPECT_EQ(5u, memo_test::readFile(broken).size());
}
} // namespace
