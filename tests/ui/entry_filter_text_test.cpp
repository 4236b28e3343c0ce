// The entry filter's text steps: foreign tags, breaks, the budget, tag repair, forbidden sources and the
// image count. Insertions go through a real entry.
#include <gtest/gtest.h>

#include <app_i18n.h>

#include <cstdio>

#include "TestEnv.h"
#include "support/FakeBoxOwner.h"
#include "support/UiTestSupport.h"

using namespace memo_ui_test;

namespace
{
class EntryFilterTextTest : public UiFixture
{
protected:
	void SetUp() override
	{
		UiFixture::SetUp();
		owner = new FakeBoxOwner(box);
		item = owner->addItem(MEMO_BOX_ITEM_TEXT);
		// The size that a tag of a missing file gets here, so that the expected texts match it.
		const std::string probe = insert("<item size=1x1 vsize=full href=file:///nowhere/p.png></item>");
		sscanf(probe.c_str(), "<item size=%dx%d", &width, &height);
		owner->calls.clear();
		clearToasts();
	}
	void TearDown() override
	{
		delete owner;
		UiFixture::TearDown();
	}

	std::string insert(const std::string &markup)
	{
		elm_entry_entry_set(item->getEntry(), "");
		item->insertText(markup.c_str());
		const char *t = elm_entry_entry_get(item->getEntry());
		return t ? t : "";
	}

	static int tagCount(const std::string &markup) { return static_cast<int>(memo_test::countOf(markup, "<item")); }

	// A tag whose file does not exist, so that no copy or size work gets in the way of the counting.
	std::string ghostTag(int i) const
	{
		char tag[256];
		snprintf(tag, sizeof(tag), "<item size=%dx%d vsize=full href=file:///nowhere/%d.png></item>", width, height, i);
		return tag;
	}
	std::string ghostOpen(const char *href) const
	{
		char tag[256];
		snprintf(tag, sizeof(tag), "<item size=%dx%d vsize=full href=%s", width, height, href);
		return tag;
	}

	static std::string limitToast()
	{
		char text[256];
		snprintf(text, sizeof(text), i18n_get_text("IDS_MEMO_TPOP_CANT_INSERT_MORE_THAN_PD_IMAGES"), 10);
		return text;
	}

	FakeBoxOwner *owner = nullptr;
	MemoBoxItem *item = nullptr;
	int width = 0, height = 0;
};
} // namespace

TEST_F(EntryFilterTextTest, PastedTextLosesFormatNoBreakSpacesAndControlCharacters)
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
}

TEST_F(EntryFilterTextTest, ReturnAfterAPictureKeepsItInPlace)
{
	// The split of a line puts pictures back where no-break spaces stand; a pasted one must not be there.
	MemoBoxItem *check = owner->addItem(MEMO_BOX_ITEM_CHECK);
	check->insertText(("a&nbsp;b" + ghostTag(1)).c_str());
	const std::string line = elm_entry_entry_get(check->getEntry());
	focus(check->getEntry());
	elm_entry_cursor_end_set(check->getEntry());
	pressKey("Return", "\r");
	runFor(0.05);
	EXPECT_EQ(line, elm_entry_entry_get(check->getEntry()));
	EXPECT_EQ(0u, line.find("ab<item size="));
	EXPECT_EQ(1, owner->count("add:1:"));
}

TEST_F(EntryFilterTextTest, NoBudgetNothingEntersAndTypingCountsNoImages)
{
	insert("");
	focus(item->getEntry());
	typeText("kept");
	EXPECT_EQ(0, owner->count("count"));
	EXPECT_EQ(0, toastCount());
	item->setLimit(0);
	item->insertText("more");
	EXPECT_STREQ("kept", elm_entry_entry_get(item->getEntry()));
	ASSERT_EQ(1, toastCount());
	EXPECT_EQ(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"), toastAt(0));
	EXPECT_EQ(0, owner->count("count"));
}

TEST_F(EntryFilterTextTest, TagsAreMendedAndForbiddenSourcesGoOnlyInFront)
{
	ASSERT_GT(width, 1);
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
}

TEST_F(EntryFilterTextTest, ImageCountLimits)
{
	std::string twelve;
	for (int i = 0; i < 12; i++)
		twelve += ghostTag(i);
	// A memo with no images takes eleven, one toast for the rest.
	owner->imageCount = -1;
	const std::string kept = insert(twelve);
	EXPECT_EQ(11, tagCount(kept));
	EXPECT_NE(std::string::npos, kept.find("/nowhere/10.png"));
	EXPECT_EQ(std::string::npos, kept.find("/nowhere/11.png"));
	ASSERT_EQ(1, toastCount());
	EXPECT_EQ(limitToast(), toastAt(0));
	// A memo with one stops at ten in all.
	owner->imageCount = 1;
	EXPECT_EQ(9, tagCount(insert(twelve)));
	EXPECT_EQ(2, toastCount());
	// A full memo takes none, with a toast for each refusal.
	owner->imageCount = 10;
	EXPECT_EQ("ab", insert("a" + ghostTag(1) + ghostTag(2) + "b"));
	EXPECT_EQ(4, toastCount());
}
