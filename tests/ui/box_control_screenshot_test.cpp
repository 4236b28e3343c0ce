// A full editor body rendered on the buffer engine: a title, two text blocks, three check lines (one
// ticked) and two pictures. The picture is saved under the test's temporary root; with
// MEMO_UPDATE_SCREENSHOTS=1 it also replaces docs/images/editor.png in the source tree.
#include <gtest/gtest.h>

#include <Ecore_Evas.h>
#include <Ecore_File.h>

#include <cmath>
#include <cstdint>
#include <cstdlib>

#include "TestEnv.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

namespace
{
// A small landscape: sky, sun and two hills, so the screenshot shows a picture and not a test card.
bool writeLandscape(const std::string &path, int w, int h, uint32_t sky, uint32_t hills)
{
	Ecore_Evas *ee = ecore_evas_buffer_new(1, 1);
	if (!ee)
		return false;
	Evas_Object *img = evas_object_image_add(ecore_evas_get(ee));
	evas_object_image_size_set(img, w, h);
	uint32_t *px = static_cast<uint32_t *>(evas_object_image_data_get(img, EINA_TRUE));
	const int stride = evas_object_image_stride_get(img) / 4;
	for (int y = 0; y < h; y++) {
		for (int x = 0; x < w; x++) {
			const double fy = static_cast<double>(y) / h, fx = static_cast<double>(x) / w;
			const double ridge1 = 0.62 + 0.08 * std::sin(fx * 5.0);
			const double ridge2 = 0.75 + 0.06 * std::sin(fx * 9.0 + 1.0);
			const double sun = std::hypot(fx - 0.72, (fy - 0.3) * h / w);
			uint32_t r = ((sky >> 16) & 0xff) + static_cast<uint32_t>(60 * fy);
			uint32_t g = ((sky >> 8) & 0xff) + static_cast<uint32_t>(40 * fy);
			uint32_t b = sky & 0xff;
			if (sun < 0.07) {
				r = 255, g = 236, b = 170;
			}
			if (fy > ridge1) {
				r = (hills >> 16) & 0xff, g = (hills >> 8) & 0xff, b = hills & 0xff;
			}
			if (fy > ridge2) {
				r = r * 3 / 4, g = g * 3 / 4, b = b * 3 / 4;
			}
			px[y * stride + x] = 0xff000000u | (std::min(r, 255u) << 16) | (std::min(g, 255u) << 8) | std::min(b, 255u);
		}
	}
	evas_object_image_data_set(img, px);
	const Eina_Bool ok = evas_object_image_save(img, path.c_str(), nullptr, "quality=92");
	ecore_evas_free(ee);
	return ok;
}

std::string escaped(const std::string &markup)
{
	std::string out;
	for (char c : markup)
		out += c == '<' ? "&lt;" : c == '>' ? "&gt;" : std::string(1, c);
	return out;
}

class BoxControlScreenshotTest : public BoxControlFixture
{
};
} // namespace

TEST_F(BoxControlScreenshotTest, EditorWithEveryKindOfContent)
{
	const std::string lake = mediaDir() + "lake.jpg";
	const std::string dusk = mediaDir() + "dusk.jpg";
	ASSERT_TRUE(writeLandscape(lake, 1200, 520, 0x7fb6e0, 0x3f7a4a));
	ASSERT_TRUE(writeLandscape(dusk, 1200, 520, 0xb06a8a, 0x4a3b5e));
	// The desktop's scale 1.0: text items show pictures 628 wide, 520 * 628 / 1200 + 40 = 312 high.
	const std::string lakeTag = "<item size=628x312 vsize=full href=file://" + lake + "></item><br/>";
	const std::string duskTag = "<item size=628x312 vsize=full href=file://" + dusk + "></item><br/>";

	MemoDocInfo doc;
	doc.setTitle("Weekend at the lake");
	doc.setIsFavorite(1);
	doc.setTizenXmlContent(
	    todoList(todoItem(0, false, escaped("We leave on Friday at six &amp;amp; meet at the pier.<br/>" + lakeTag)) +
	             todoItem(1, true, "Sleeping bags") + todoItem(1, false, "Camera batteries") +
	             todoItem(1, false, "Sunscreen") +
	             todoItem(0, false, escaped("Last year's sunset from the dock:<br/>" + duskTag)))
	        .c_str());
	makeControl(&doc, MODE_UPDATE);
	ASSERT_EQ(5u, items().size());
	EXPECT_TRUE(items()[1]->getCheckStatus());
	runFor(0.5);
	render();

	const std::string shot = memo_test::tempRoot() + "/editor.png";
	ASSERT_TRUE(screenshot(shot));
	// A blank canvas compresses to almost nothing; a real editor does not.
	EXPECT_GT(memo_test::readFile(shot).size(), 20000u);

	const char *update = getenv("MEMO_UPDATE_SCREENSHOTS");
	if (update && !strcmp(update, "1")) {
		const std::string target = std::string(TEST_SOURCE_DIR) + "/docs/images/editor.png";
		ecore_file_mkpath((std::string(TEST_SOURCE_DIR) + "/docs/images").c_str());
		EXPECT_TRUE(ecore_file_cp(shot.c_str(), target.c_str()));
	}
}
