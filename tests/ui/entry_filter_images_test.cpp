// The entry filter's image steps: tags fitted to this display, files taken into the memo's folder, and
// large pictures shrunk on workers while the insertion waits.
#include <gtest/gtest.h>

#include <Ecore_File.h>

#include <cstdio>

#include "Util/MemoUtil.h"
#include "support/FakeBoxOwner.h"
#include "support/UiTestSupport.h"

using namespace memo_ui_test;

namespace
{
class EntryFilterImagesTest : public UiFixture
{
protected:
	void SetUp() override
	{
		UiFixture::SetUp();
		owner = new FakeBoxOwner(box, "filter-memo");
		item = owner->addItem(MEMO_BOX_ITEM_TEXT);
		folder = std::string(MemoUtil::getDataPath()) + "media/filter-memo/";
		elsewhere = std::string(MemoUtil::getDataPath()) + "media/other-memo/";
		ecore_file_mkpath(elsewhere.c_str());
		// This display's width for text items: what a tag of a missing file is given.
		item->insertText("<item size=1x1 vsize=full href=file:///nowhere/p.png></item>");
		sscanf(text().c_str(), "<item size=%dx%d", &width, &defaultHeight);
		elm_entry_entry_set(item->getEntry(), "");
		owner->calls.clear();
	}
	void TearDown() override
	{
		delete owner;
		UiFixture::TearDown();
	}

	std::string text() const
	{
		const char *t = elm_entry_entry_get(item->getEntry());
		return t ? t : "";
	}

	static std::string pathOf(const std::string &markup)
	{
		const size_t at = markup.find("href=file://");
		if (at == std::string::npos)
			return "";
		const size_t start = at + strlen("href=file://");
		return markup.substr(start, markup.find('>', start) - start);
	}

	// The tag this display gives a picture of pictureW x pictureH at `path`.
	std::string fittedTag(const std::string &path, int pictureW, int pictureH) const
	{
		char tag[512];
		snprintf(tag, sizeof(tag), "<item size=%dx%d vsize=full href=file://%s></item>", width,
		         pictureH * width / pictureW + 40, path.c_str());
		return tag;
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

	FakeBoxOwner *owner = nullptr;
	MemoBoxItem *item = nullptr;
	std::string folder, elsewhere;
	int width = 0, defaultHeight = 0;
};
} // namespace

TEST_F(EntryFilterImagesTest, SizedTagsAreFittedAndTakenIntoTheMemo)
{
	const std::string source = elsewhere + "photo.png";
	ASSERT_TRUE(writePicture(source, 200, 100));
	item->insertText(fittedTag(source, 200, 100).c_str());
	const std::string path = pathOf(text());
	ASSERT_EQ(0u, path.find(folder)) << text();
	EXPECT_TRUE(eina_str_has_extension(path.c_str(), ".png"));
	EXPECT_TRUE(ecore_file_exists(path.c_str()));
	EXPECT_TRUE(ecore_file_exists(source.c_str()));
	EXPECT_EQ(0, owner->count("popup:"));

	// A tag already at home keeps its file; a width of another display is fitted to this one.
	elm_entry_entry_set(item->getEntry(), "");
	item->insertText(("<item size=100x90 vsize=full href=file://" + path + "></item>").c_str());
	EXPECT_EQ(fittedTag(path, 200, 100), text());
}

TEST_F(EntryFilterImagesTest, APasteOfTheFixedSizeIsRebuiltWhenItsFileExists)
{
	const std::string source = elsewhere + "pasted.jpg";
	ASSERT_TRUE(writePicture(source, 300, 200));
	item->insertText(("a<item absize=240x180 href=file://" + source + "></item>b").c_str());
	const std::string path = pathOf(text());
	ASSERT_EQ(0u, path.find(folder)) << text();
	EXPECT_TRUE(eina_str_has_extension(path.c_str(), ".jpg"));
	EXPECT_EQ("a" + fittedTag(path, 300, 200) + "b", text());

	elm_entry_entry_set(item->getEntry(), "");
	item->insertText("<item absize=240x180 href=file:///nowhere/gone.jpg></item>");
	EXPECT_EQ("<item absize=240x180 href=file:///nowhere/gone.jpg></item>", text());
}

TEST_F(EntryFilterImagesTest, LargePicturesAreShrunkOnWorkers)
{
	// A sized tag from elsewhere enters at once; its worker shrinks the copy behind the scenes.
	const std::string big = elsewhere + "big.jpg";
	ASSERT_TRUE(writePicture(big, 1000, 800));
	item->insertText(fittedTag(big, 1000, 800).c_str());
	const std::string copy = pathOf(text());
	ASSERT_EQ(0u, copy.find(folder)) << text();
	EXPECT_EQ(0, owner->count("popup:"));
	int w = 0, h = 0;
	ASSERT_TRUE(waitFor([&] { return pictureSize(copy, &w, &h) && w * h <= 320000; }, 20.0));

	// Text with a pasted large picture waits for its worker; the popup covers the wait.
	const std::string source = elsewhere + "large.jpg";
	ASSERT_TRUE(writePicture(source, 1200, 900));
	elm_entry_entry_set(item->getEntry(), "");
	item->insertText(("hello<item absize=240x180 href=file://" + source + "></item>").c_str());
	EXPECT_EQ("", text());
	ASSERT_EQ(1, owner->count("popup:1"));
	EXPECT_EQ(0, owner->count("popup:0"));
	ASSERT_TRUE(waitFor([&] { return !text().empty(); }, 20.0));
	EXPECT_EQ(0u, text().find("hello<item size="));
	EXPECT_EQ(1, owner->count("popup:0"));
	// The picture in the memo's folder has been shrunk below the insertion limit; the original is untouched.
	ASSERT_TRUE(pictureSize(pathOf(text()), &w, &h));
	EXPECT_LE(w * h, 320000);
	ASSERT_TRUE(pictureSize(source, &w, &h));
	EXPECT_EQ(1200, w);
}

TEST_F(EntryFilterImagesTest, AnItemDeletedDuringTheWaitIsLeftAlone)
{
	const std::string source = elsewhere + "gone.jpg";
	ASSERT_TRUE(writePicture(source, 1200, 900));
	item->insertText(("x<item absize=240x180 href=file://" + source + "></item>").c_str());
	ASSERT_EQ(1, owner->count("popup:1"));
	owner->removeItem(item);
	item = nullptr;
	runFor(2.0);
	EXPECT_EQ(0, owner->count("popup:0"));
}
