// The text steps of the body entry filter, widget-free: foreign tags, breaks and blanks, image tag repair,
// forbidden sources and the image limit. The order of the steps matters, and some outcomes that look
// like slips are kept on purpose: a forbidden source behind a good image survives, and a memo with no
// image takes eleven pasted images while one with images stops at ten in all.
#include <app_i18n.h>
#include <notification_status.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "MemoEntryFilterTags.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
void replaceAll(std::string &text, const std::string &from, const std::string &to)
{
	size_t pos = 0;
	while ((pos = text.find(from, pos)) != std::string::npos) {
		text.replace(pos, from.size(), to);
		pos += to.size();
	}
}

const int MEMO_MAX_IMAGES = 10;

bool isForeignTag(const std::string &text, size_t at)
{
	const char c = text[at + 1];
	if (c == 'f' || c == 'c' || c == 'a' || c == '+' || c == 'l')
		return true;
	if (c != '/')
		return false;
	const char d = text[at + 2];
	return d == 'f' || d == 'c' || d == 'a' || d == 'l' || d == '>';
}

// Step 2: font, colour, align and link tags go; breaks and images stay.
std::string stripForeignTags(const std::string &text)
{
	std::string out;
	out.reserve(text.size());
	size_t i = 0;
	const size_t len = text.size();
	while (i < len) {
		if (text[i] == '<') {
			if (len - i - 1 < 2)
				break;
			if (isForeignTag(text, i)) {
				const size_t close = text.find('>', i);
				i = close == std::string::npos ? len : close + 1;
				continue;
			}
		}
		out += text[i++];
	}
	return out;
}

// Step 4: every image tag ends in "></item>".
void closeItemTags(std::string &text)
{
	size_t pos = 0;
	while ((pos = text.find("<item", pos)) != std::string::npos) {
		const size_t close = text.find('>', pos);
		if (close == std::string::npos) {
			MEMO_LOGE("Cannot find item close string.");
			return;
		}
		if (text.compare(close, strlen(MEMO_ITEM_CLOSE), MEMO_ITEM_CLOSE) != 0)
			text.replace(close, 1, MEMO_ITEM_CLOSE);
		pos = close + strlen(MEMO_ITEM_CLOSE);
	}
}

// Step 5: between an image and the next one (or the end) no "</item>" may stand.
void dropStrayCloses(std::string &text)
{
	size_t pos = 0;
	while ((pos = text.find("<item", pos)) != std::string::npos) {
		size_t end = memoFilterTagEnd(text, pos);
		size_t next = text.find("<item", end);
		size_t stray;
		while ((stray = text.find("</item>", end)) != std::string::npos && stray < next) {
			text.erase(stray, strlen("</item>"));
			next -= strlen("</item>");
		}
		pos = end;
	}
}

// Step 6: leading tags from a forbidden source go; the walk stops at the first tag without it.
void dropForbiddenLeadingTags(std::string &text, const char *pattern)
{
	size_t pos = text.find("<item");
	while (pos != std::string::npos) {
		const size_t end = memoFilterTagEnd(text, pos);
		if (text.substr(pos, end - pos).find(pattern) == std::string::npos)
			return;
		text.erase(pos, end - pos);
		pos = text.find("<item", pos);
	}
}

void postImageLimitToast()
{
	char message[256];
	snprintf(message, sizeof(message), i18n_get_text("IDS_MEMO_TPOP_CANT_INSERT_MORE_THAN_PD_IMAGES"), MEMO_MAX_IMAGES);
	notification_status_message_post(message);
}

// Step 7: at most ten images in the memo, counted as the owner reports them.
void limitImageCount(std::string &text, int existing)
{
	if (existing >= MEMO_MAX_IMAGES) {
		size_t pos = 0;
		while ((pos = text.find("<item", pos)) != std::string::npos) {
			const size_t end = memoFilterTagEnd(text, pos);
			if (text.substr(pos, end - pos).find("file://") == std::string::npos) {
				pos = end;
				continue;
			}
			text.erase(pos, end - pos);
			postImageLimitToast();
		}
		return;
	}

	int counter = existing + 1;
	bool over = false;
	size_t pos = 0;
	while ((pos = text.find("<item", pos)) != std::string::npos) {
		const size_t end = memoFilterTagEnd(text, pos);
		if (text.substr(pos, end - pos).find("href") == std::string::npos) {
			MEMO_LOGI("Weird Data");
			text.erase(pos, end - pos);
			continue;
		}
		if (counter <= MEMO_MAX_IMAGES) {
			++counter;
			pos = end;
			continue;
		}
		MEMO_LOGI("Exsit + New Image Count is Over 10");
		text.erase(pos, end - pos);
		over = true;
	}
	if (over)
		postImageLimitToast();
}
} // namespace

size_t memoFilterTagEnd(const std::string &text, size_t tagStart)
{
	const size_t close = text.find("</item>", tagStart);
	if (close != std::string::npos)
		return close + strlen("</item>");
	const size_t gt = text.find('>', tagStart);
	return gt == std::string::npos ? text.size() : gt + 1;
}

std::string memoEntryFilterMarkup(const char *text, const std::function<int()> &imageCount)
{
	// Typed and pasted text alike: a control character would leave a document that cannot be read.
	char *storable = MemoUtil::stripControlCharsN(text);
	std::string work = stripForeignTags(storable ? storable : text);
	free(storable);
	replaceAll(work, "\n", "<br/>");
	// The no-break space stands for a picture when an item is split, in any of its forms.
	for (const char *nbsp : {"\xC2\xA0", "&nbsp;", "&#160;", "&#xA0;", "&#xa0;"})
		replaceAll(work, nbsp, "");
	closeItemTags(work);
	dropStrayCloses(work);
	dropForbiddenLeadingTags(work, "href=http");
	dropForbiddenLeadingTags(work, "href=data");
	dropForbiddenLeadingTags(work, "href=quot;&quot;");
	if (work.find("<item") != std::string::npos)
		limitImageCount(work, imageCount());
	return work;
}

std::string memoFilterTagPath(const std::string &tag)
{
	const size_t href = tag.find(MEMO_ITEM_HREF_FILE);
	if (href == std::string::npos)
		return "";
	const size_t start = href + strlen(MEMO_ITEM_HREF_FILE);
	const size_t end = tag.find_first_of(" >", start);
	return tag.substr(start, end == std::string::npos ? std::string::npos : end - start);
}

void memoFilterTagSetPath(std::string &tag, const std::string &path)
{
	const size_t href = tag.find(MEMO_ITEM_HREF_FILE);
	if (href == std::string::npos)
		return;
	const size_t start = href + strlen(MEMO_ITEM_HREF_FILE);
	size_t end = tag.find_first_of(" >", start);
	if (end == std::string::npos)
		end = tag.size();
	tag.replace(start, end - start, path);
}

bool memoFilterTagSize(const std::string &tag, int *width, int *height)
{
	const size_t at = tag.find("size=");
	if (at == std::string::npos)
		return false;
	return sscanf(tag.c_str() + at, "size=%dx%d", width, height) == 2;
}

void memoFilterTagSetSize(std::string &tag, int width, int height)
{
	const size_t at = tag.find("size=");
	if (at == std::string::npos)
		return;
	const size_t start = at + strlen("size=");
	size_t end = tag.find_first_of(" >", start);
	if (end == std::string::npos)
		end = tag.size();
	char size[64];
	snprintf(size, sizeof(size), "%dx%d", width, height);
	tag.replace(start, end - start, size);
}
