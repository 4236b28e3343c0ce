// The entry filter on a real entry: foreign tags, breaks, the budget, tag repair, forbidden sources and
// the image count; then tags fitted to this display, files taken into the memo's folder, and large
// pictures shrunk on workers while the insertion waits.
#include <gtest/gtest.h>

#include <Ecore_File.h>
#include <app_i18n.h>

#include <cstdio>

#include "TestEnv.h"
#include "box_control_fixture.h"

using namespace memo_ui_test;

namespace
{
class EntryFilterTest : public BoxControlFixture
{
protected:
	void SetUp() override
	{
		BoxControlFixture::SetUp();
		makeControl(nullptr, MODE_NEW);
		target = items()[0];
		elsewhere = std::string(MemoUtil::getDataPath()) + "media/other-memo/";
		ecore_file_mkpath(elsewhere.c_str());
	}

	// The body becomes an empty first item, the target, and one holding `pictures` tags.
	void withPicturesElsewhere(int pictures)
	{
		std::string tags;
		for (int i = 0; i < pictures; i++)
			tags += ghostTag(100 + i);
		withBody(todoItem(0, false, "") + todoItem(0, false, tags));
		target = items()[0];
	}

	std::string shown() const { return text(target); }
	// The entry's text after `markup` was inserted into the emptied entry.
	std::string insert(const std::string &markup)
	{
		elm_entry_entry_set(target->getEntry(), "");
		target->insertText(markup.c_str());
		return shown();
	}

	// A tag whose file does not exist, so that no copy or size work gets in the way of the counting.
	std::string ghostTag(int i) const
	{
		return ghostOpen(("file:///nowhere/" + std::to_string(i) + ".png").c_str()) + "></item>";
	}
	std::string ghostOpen(const char *href) const
	{
		return "<item size=" + std::to_string(width) + "x" + std::to_string(height) + " vsize=full href=" + href;
	}
	// The tag this display gives a picture of pictureW x pictureH at `path`.
	std::string fittedTag(const std::string &path, int pictureW, int pictureH) const
	{
		return "<item size=" + std::to_string(width) + "x" + std::to_string(pictureH * width / pictureW + 40) +
		       " vsize=full href=file://" + path + "></item>";
	}
	static std::string pathOf(const std::string &markup)
	{
		const size_t at = markup.find("href=file://");
		if (at == std::string::npos)
			return "";
		const size_t start = at + strlen("href=file://");
		return markup.substr(start, markup.find('>', start) - start);
	}
	bool pictureSize(const std::string &path, int *w, int *h)
	{
		Evas_Object *img = evas_object_image_add(evas());
		evas_object_image_file_set(img, path.c_str(), nullptr);
		evas_object_image_size_get(img, w, h);
		const bool ok = evas_object_image_load_error_get(img) == EVAS_LOAD_ERROR_NONE;
		evas_object_del(img);
		return ok;
	}

	MemoBoxItem *target = nullptr;
	std::string elsewhere;
	// A text line's picture width at the test scale, and the height of a tag whose file is missing.
	const int width = 628, height = 428;
};
} // namespace

TEST_F(EntryFilterTest, PastedTextLosesFormatNoBreakSpacesAndControlCharactersAndNeedsBudget)
{
	EXPECT_EQ("one<br/>two<br/>three", insert("one\ntwo\nthree"));
	EXPECT_EQ("big red<br/>left", insert("<font_size=40>big</font_size> <color=#ff0000>red</color><br/>"
	                                     "<align=left>left</align>"));
	EXPECT_EQ("linked", insert("<link>linked</link>"));
	EXPECT_EQ("plain", insert("<+ font=Sans>plain</>"));
	// Tags the filter does not know stay for the entry to judge.
	EXPECT_EQ("x<tab/>y", insert("x<tab/>y"));
	EXPECT_EQ("abcde", insert("a\xC2\xA0"
	                          "b&nbsp;c&#160;d&#xa0;e"));
	EXPECT_EQ("ab<br/>c", insert("a\x01"
	                             "b\r\nc\x1b"));

	// Without budget nothing enters, and a toast says so.
	insert("");
	focus(target->getEntry());
	typeText("kept");
	target->setLimit(0);
	target->insertText("more");
	EXPECT_EQ("kept", shown());
	ASSERT_EQ(1, desktop_toast_log_count());
	EXPECT_STREQ(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"), desktop_toast_log_get(0));
}

TEST_F(EntryFilterTest, TagsAreMendedForbiddenSourcesGoOnlyInFrontAndTheCountIsLimited)
{
	const std::string base = ghostOpen("file:///nowhere/a.png");
	EXPECT_EQ(base + "></item>x", insert(base + ">x"));
	EXPECT_EQ(base + "></item>x", insert(base + "></item></item>x"));
	EXPECT_EQ(base + "></item>xy", insert(base + "></item>x</item>y</item>"));
	EXPECT_EQ("ab", insert("a<item size=10x10 vsize=full></item>b"));

	const std::string web = ghostOpen("http://example.org/a.png") + "></item>";
	const std::string data = ghostOpen("data:image/png;base64,AAAA") + "></item>";
	const std::string good = ghostTag(1);
	EXPECT_EQ("a" + good + "b", insert("a" + web + data + good + "b"));
	// Behind a good tag the walk has stopped: this one survives the step.
	EXPECT_EQ(good + web, insert(good + web));

	// The limit of ten pictures, against the count of the memo's other items.
	std::string twelve;
	for (int i = 0; i < 12; i++)
		twelve += ghostTag(i);
	char limitToast[256];
	snprintf(limitToast, sizeof(limitToast), i18n_get_text("IDS_MEMO_TPOP_CANT_INSERT_MORE_THAN_PD_IMAGES"), 10);
	// A memo with no images takes eleven, one toast for the rest.
	const std::string kept = insert(twelve);
	EXPECT_EQ(11u, memo_test::countOf(kept, "<item"));
	EXPECT_NE(std::string::npos, kept.find("/nowhere/10.png"));
	EXPECT_EQ(std::string::npos, kept.find("/nowhere/11.png"));
	ASSERT_EQ(1, desktop_toast_log_count());
	EXPECT_STREQ(limitToast, desktop_toast_log_get(0));
	// A memo with one stops at ten in all.
	withPicturesElsewhere(1);
	EXPECT_EQ(9u, memo_test::countOf(insert(twelve), "<item"));
	EXPECT_EQ(1, desktop_toast_log_count());
	// A full memo takes none, with a toast for each refusal.
	withPicturesElsewhere(10);
	EXPECT_EQ("ab", insert("a" + ghostTag(1) + ghostTag(2) + "b"));
	EXPECT_EQ(2, desktop_toast_log_count());
}

TEST_F(EntryFilterTest, PicturesFromElsewhereAreTakenIntoTheMemoAndFitted)
{
	const std::string source = elsewhere + "photo.png";
	ASSERT_TRUE(writePicture(source, 200, 100));
	const std::string path = pathOf(insert(fittedTag(source, 200, 100)));
	ASSERT_EQ(0u, path.find(mediaDir())) << shown();
	EXPECT_TRUE(eina_str_has_extension(path.c_str(), ".png"));
	EXPECT_TRUE(ecore_file_exists(path.c_str()));
	EXPECT_TRUE(ecore_file_exists(source.c_str()));
	EXPECT_EQ(0, countKey("action,imagepopup,show"));
	// A tag already at home keeps its file; a width of another display is fitted to this one.
	EXPECT_EQ(fittedTag(path, 200, 100), insert("<item size=100x90 vsize=full href=file://" + path + "></item>"));

	// A paste of the fixed size is rebuilt when its file exists.
	const std::string pasted = elsewhere + "pasted.jpg";
	ASSERT_TRUE(writePicture(pasted, 300, 200));
	const std::string copy = pathOf(insert("a<item absize=240x180 href=file://" + pasted + "></item>b"));
	ASSERT_EQ(0u, copy.find(mediaDir())) << shown();
	EXPECT_TRUE(eina_str_has_extension(copy.c_str(), ".jpg"));
	EXPECT_EQ("a" + fittedTag(copy, 300, 200) + "b", shown());
	const std::string gone = "<item absize=240x180 href=file:///nowhere/gone.jpg></item>";
	EXPECT_EQ(gone, insert(gone));
}

TEST_F(EntryFilterTest, LargePicturesAreShrunkOnWorkers)
{
	// A sized tag from elsewhere enters at once; its worker shrinks the copy behind the scenes (a PNG:
	// shrunk without the canvas).
	const std::string big = elsewhere + "big.png";
	ASSERT_TRUE(writePicture(big, 1000, 800));
	const std::string copy = pathOf(insert(fittedTag(big, 1000, 800)));
	ASSERT_EQ(0u, copy.find(mediaDir())) << shown();
	EXPECT_EQ(0, countKey("action,imagepopup,show"));
	int w = 0, h = 0;
	ASSERT_TRUE(waitFor([&] { return pictureSize(copy, &w, &h) && w * h <= 320000; }, 20.0));

	// Text with a pasted large picture waits for its worker; the popup covers the wait.
	const std::string source = elsewhere + "large.jpg";
	ASSERT_TRUE(writePicture(source, 1200, 900));
	EXPECT_EQ("", insert("hello<item absize=240x180 href=file://" + source + "></item>"));
	ASSERT_EQ(1, countKey("action,imagepopup,show"));
	EXPECT_EQ(0, countKey("action,imagepopup,hide"));
	ASSERT_TRUE(waitFor([&] { return !shown().empty(); }, 20.0));
	EXPECT_EQ(0u, shown().find("hello<item size="));
	EXPECT_EQ(1, countKey("action,imagepopup,hide"));
	// The picture in the memo's folder has been shrunk below the insertion limit; the original is untouched.
	ASSERT_TRUE(pictureSize(pathOf(shown()), &w, &h));
	EXPECT_LE(w * h, 320000);
	ASSERT_TRUE(pictureSize(source, &w, &h));
	EXPECT_EQ(1200, w);

	// An editor closed during the wait leaves the worker's end alone.
	insert("x<item absize=240x180 href=file://" + source + "></item>");
	ASSERT_EQ(2, countKey("action,imagepopup,show"));
	UiFixture::TearDown();
	ASSERT_TRUE(waitFor([] { return ecore_thread_active_get() == 0; }, 20.0));
	runFor(0.05);
	EXPECT_EQ(1, countKey("action,imagepopup,hide"));
}
