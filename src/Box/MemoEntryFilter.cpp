// The markup filter of every body entry. The order of the steps matters, and some outcomes that look
// like slips are kept on purpose: a forbidden source behind a good image survives, and a memo with no
// image takes eleven pasted images while one with images stops at ten in all.
#include "Box/MemoBoxItem.h"

#include <app_i18n.h>
#include <notification_status.h>

#include <cstdio>
#include <cstring>

#include "MemoBoxItemPrivate.h"
#include "MemoEntryFilterTags.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
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

void MemoBoxItem::__entryFilter(void *data, Evas_Object *entry, char **text)
{
	(void)entry;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	if (!self || !text || !*text)
		return;

	if (self->__limit.max_char_count <= 0) {
		MEMO_LOGI("No characters left in this memo.");
		free(*text);
		*text = nullptr;
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"));
		return;
	}

	// Typed and pasted text alike: a control character would leave a document that cannot be read.
	char *storable = MemoUtil::stripControlCharsN(*text);
	std::string work = stripForeignTags(storable ? storable : *text);
	free(storable);
	memoBoxReplaceAll(work, "\n", MEMO_BOX_LINE_BREAK);
	// The no-break space stands for a picture when an item is split, in any of its forms.
	for (const char *nbsp : {"\xC2\xA0", "&nbsp;", "&#160;", "&#xA0;", "&#xa0;"})
		memoBoxReplaceAll(work, nbsp, "");
	closeItemTags(work);
	dropStrayCloses(work);
	dropForbiddenLeadingTags(work, "href=http");
	dropForbiddenLeadingTags(work, "href=data");
	dropForbiddenLeadingTags(work, "href=quot;&quot;");
	if (work.find("<item") != std::string::npos)
		limitImageCount(work, self->__listener ? self->__listener->onEntryCheckImageCount() : -1);

	std::vector<__ResizeRequest> queue;
	self->__adoptFixedSizeTags(work, queue);
	self->__adoptImageTags(work);

	free(*text);
	*text = nullptr;
	if (queue.empty()) {
		*text = strdup(work.c_str());
		return;
	}
	// Appended rather than replaced: a second insertion that arrives while the first still waits
	// for its workers would otherwise drop the first one's text.
	self->__pendingText += work;
	self->__queueResizeWorkers(queue);
}
