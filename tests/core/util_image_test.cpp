// The picture helpers of MemoUtil: admission and target size for insertion (getInsertImageSize), EXIF
// orientation and turning upright in place (getOrient, rotateImage), and shrinking: JPEG through the
// decoder (resizeImageJpg), any format through a buffer canvas (resizeImage), PNG without a canvas
// (resizeImagePng). The pictures are made on the spot from colour functions.
#include "Util/MemoUtil.h"
#include "TestEnv.h"

#include <Ecore.h>
#include <Ecore_Evas.h>
#include <Evas.h>
#include <Ecore_File.h>
#include <gtest/gtest.h>
#include <image_util.h>
#include <libexif/exif-data.h>
#include <png.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <string>
#include <tuple>
#include <vector>

namespace
{
// 0xAARRGGBB colours of test patterns.
const uint32_t RED = 0xffff0000, GREEN = 0xff00ff00, BLUE = 0xff0000ff, YELLOW = 0xffffff00;

using ColorFn = std::function<uint32_t(int x, int y)>;

// The canvas the Evas-side helpers need; one per test suite.
class ImageTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite() { ecore_evas_init(); }
	static void TearDownTestSuite() { ecore_evas_shutdown(); }
	void SetUp() override
	{
		dir = memo_test::makeTempDir(::testing::UnitTest::GetInstance()->current_test_info()->name());
	}
	std::string path(const std::string &name) const { return dir + "/" + name; }
	std::string dir;
};

void writeJpeg(const std::string &path, int w, int h, const ColorFn &color)
{
	std::vector<unsigned char> rgb(static_cast<size_t>(w) * h * 3);
	for (int y = 0; y < h; y++)
		for (int x = 0; x < w; x++) {
			uint32_t c = color(x, y);
			unsigned char *p = &rgb[(static_cast<size_t>(y) * w + x) * 3];
			p[0] = (c >> 16) & 0xff;
			p[1] = (c >> 8) & 0xff;
			p[2] = c & 0xff;
		}
	ASSERT_EQ(IMAGE_UTIL_ERROR_NONE,
	          image_util_encode_jpeg(rgb.data(), w, h, IMAGE_UTIL_COLORSPACE_RGB888, 95, path.c_str()));
}

// Writes a PNG in one of libpng's simple formats: PNG_FORMAT_RGBA, PNG_FORMAT_GRAY (the green channel)
// or PNG_FORMAT_RGBA_COLORMAP (a palette of the colours used, at most 256).
void writePng(const std::string &path, int w, int h, const ColorFn &color, png_uint_32 format = PNG_FORMAT_RGBA)
{
	png_image image = {};
	image.version = PNG_IMAGE_VERSION;
	image.width = w;
	image.height = h;
	image.format = format;
	std::vector<png_byte> px(PNG_IMAGE_SIZE(image)), map;
	for (int i = 0; i < w * h; i++) {
		const uint32_t c = color(i % w, i / w);
		const png_byte rgba[4] = {png_byte(c >> 16), png_byte(c >> 8), png_byte(c), png_byte(c >> 24)};
		if (format & PNG_FORMAT_FLAG_COLORMAP) {
			size_t at = 0;
			while (at < map.size() && !std::equal(rgba, rgba + 4, &map[at]))
				at += 4;
			if (at == map.size())
				map.insert(map.end(), rgba, rgba + 4);
			px[i] = static_cast<png_byte>(at / 4);
		} else if (format == PNG_FORMAT_GRAY)
			px[i] = rgba[1];
		else
			std::copy(rgba, rgba + 4, &px[static_cast<size_t>(i) * 4]);
	}
	image.colormap_entries = static_cast<png_uint_32>(map.size() / 4);
	ASSERT_TRUE(png_image_write_to_file(&image, path.c_str(), 0, px.data(), 0, map.empty() ? nullptr : map.data()))
	    << image.message;
}

struct Picture {
	int w = 0, h = 0;
	std::vector<uint32_t> px; // 0xAARRGGBB
	uint32_t at(int x, int y) const { return px[static_cast<size_t>(y) * w + x]; }
};

// Loads any picture through Evas; an empty Picture when it cannot be read.
Picture readImage(const std::string &path)
{
	Picture pic;
	Ecore_Evas *ee = ecore_evas_buffer_new(1, 1);
	Evas_Object *img = evas_object_image_add(ecore_evas_get(ee));
	evas_object_image_file_set(img, path.c_str(), nullptr);
	evas_object_image_size_get(img, &pic.w, &pic.h);
	const uint32_t *px = static_cast<const uint32_t *>(evas_object_image_data_get(img, EINA_FALSE));
	if (px && pic.w > 0) {
		int stride = evas_object_image_stride_get(img) / 4;
		for (int y = 0; y < pic.h; y++)
			pic.px.insert(pic.px.end(), px + y * stride, px + y * stride + pic.w);
	} else {
		pic.w = pic.h = 0;
	}
	ecore_evas_free(ee);
	return pic;
}

// True when the colours differ by at most tol in each of red, green and blue (lossy files).
bool near(uint32_t a, uint32_t b, int tol = 40)
{
	for (int shift = 0; shift <= 16; shift += 8)
		if (std::abs(static_cast<int>((a >> shift) & 0xff) - static_cast<int>((b >> shift) & 0xff)) > tol)
			return false;
	return true;
}

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
	for (auto [x, y, colour] : {std::make_tuple(qx, qy, RED), std::make_tuple(3 * qx, qy, GREEN),
	                            std::make_tuple(qx, 3 * qy, BLUE), std::make_tuple(3 * qx, 3 * qy, YELLOW)})
		EXPECT_TRUE(near(colour, pic.at(x, y))) << x << "," << y << ": " << std::hex << pic.at(x, y);
}

void writeBytes(const std::string &path, const std::string &bytes)
{
	std::ofstream(path, std::ios::binary) << bytes;
}

// Rewrites the frame header of a JPEG so that it claims w x h; the pixel data stays small.
void patchJpegSize(const std::string &path, int w, int h)
{
	std::string b = memo_test::readFile(path);
	size_t sof = b.find("\xff\xc0", 2);
	ASSERT_NE(std::string::npos, sof) << "no frame header in " << path;
	b.replace(sof + 5, 4, {char(h >> 8), char(h & 0xff), char(w >> 8), char(w & 0xff)});
	writeBytes(path, b);
}

// Puts an APP1 EXIF block holding only the orientation tag, in the given byte order, right
// behind the JPEG's start marker.
void addExifOrientation(const std::string &path, int orientation, ExifByteOrder order = EXIF_BYTE_ORDER_INTEL)
{
	ExifData *exif = exif_data_new();
	exif_data_set_byte_order(exif, order);
	ExifEntry *entry = exif_entry_new();
	exif_content_add_entry(exif->ifd[EXIF_IFD_0], entry);
	exif_entry_initialize(entry, EXIF_TAG_ORIENTATION);
	exif_set_short(entry->data, order, static_cast<ExifShort>(orientation));
	exif_entry_unref(entry);
	unsigned char *data = nullptr;
	unsigned int len = 0;
	exif_data_save_data(exif, &data, &len);
	exif_data_unref(exif);
	ASSERT_NE(nullptr, data);
	std::string jpeg = memo_test::readFile(path);
	std::string app1 = {'\xff', '\xe1', char((len + 2) >> 8), char((len + 2) & 0xff)};
	app1.append(reinterpret_cast<char *>(data), len);
	free(data);
	writeBytes(path, jpeg.substr(0, 2) + app1 + jpeg.substr(2));
}

// Runs fn on an Ecore worker thread and waits for its end: image flows call the helpers from workers.
void runInWorker(std::function<void()> fn)
{
	struct Job {
		std::function<void()> fn;
		bool done;
	} job{std::move(fn), false};
	ecore_thread_run([](void *data, Ecore_Thread *) { static_cast<Job *>(data)->fn(); },
	                 [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; },
	                 [](void *data, Ecore_Thread *) { static_cast<Job *>(data)->done = true; }, &job);
	ASSERT_TRUE(memo_test::pump(10.0, [&] { return job.done; }));
}

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
