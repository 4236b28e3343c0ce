// changeMode: the line at the cursor goes between text and check, and a text item is split where the
// line begins and ends. The split works on plain text, because cursor positions count characters while
// the entry holds markup, and puts the image tags back afterwards.
#include "Box/MemoBoxItem.h"

#include <cstring>
#include <vector>

#include "MemoBoxItemPrivate.h"
#include "MemoLog.h"

namespace
{
const char *const NBSP = "\xC2\xA0";
// What the entry's markup-to-text conversion writes for an image.
const char *const OBJECT_REPLACEMENT = "\xEF\xBF\xBC";
const size_t BREAK_LEN = sizeof(MEMO_BOX_LINE_BREAK) - 1;

std::vector<std::string> collectImageTags(const std::string &markup)
{
	std::vector<std::string> tags;
	size_t pos = 0;
	while ((pos = markup.find("<item size=", pos)) != std::string::npos) {
		size_t end = markup.find("></item>", pos);
		if (end == std::string::npos)
			break;
		end += strlen("></item>");
		tags.push_back(markup.substr(pos, end - pos));
		pos = end;
	}
	return tags;
}

std::string toMarkup(const std::string &plain)
{
	char *markup = elm_entry_utf8_to_markup(plain.c_str());
	std::string out = markup ? markup : "";
	free(markup);
	return out;
}

// Puts the next tags of `tags` where `markup` holds a no-break space, as a character or as its entity.
void restoreImageTags(std::string &markup, const std::vector<std::string> &tags, size_t &next)
{
	size_t pos = 0;
	while (next < tags.size()) {
		size_t entity = markup.find("&nbsp;", pos);
		size_t raw = markup.find(NBSP, pos);
		size_t at = std::min(entity, raw);
		if (at == std::string::npos)
			return;
		const size_t len = at == entity ? strlen("&nbsp;") : strlen(NBSP);
		markup.replace(at, len, tags[next]);
		pos = at + tags[next].size();
		++next;
	}
}
} // namespace

void MemoBoxItem::__splitAtCursor(std::string &before, std::string &after, bool dropTrailingBreak)
{
	before.clear();
	after.clear();
	if (!__entryObj)
		return;
	const char *text = elm_entry_entry_get(__entryObj);
	const std::string markup = text ? text : "";
	const std::vector<std::string> tags = collectImageTags(markup);

	char *plainN = elm_entry_markup_to_utf8(markup.c_str());
	std::string plain = plainN ? plainN : "";
	free(plainN);
	memoBoxReplaceAll(plain, OBJECT_REPLACEMENT, NBSP);

	int length = 0;
	Eina_Unicode *codes = eina_unicode_utf8_to_unicode(plain.c_str(), &length);
	int cursor = elm_entry_cursor_pos_get(__entryObj);
	if (cursor < 0)
		cursor = 0;
	if (cursor > length)
		cursor = length;
	char *left = codes ? eina_unicode_unicode_to_utf8_range(codes, cursor, nullptr) : nullptr;
	char *right = codes ? eina_unicode_unicode_to_utf8_range(codes + cursor, length - cursor, nullptr) : nullptr;
	std::string leftText = left ? left : "";
	std::string rightText = right ? right : "";
	free(left);
	free(right);
	free(codes);

	if (dropTrailingBreak && !leftText.empty() && leftText.back() == '\n')
		leftText.pop_back();

	before = toMarkup(leftText);
	after = toMarkup(rightText);

	if (!tags.empty()) {
		size_t next = 0;
		restoreImageTags(before, tags, next);
		restoreImageTags(after, tags, next);
	}

	if (dropTrailingBreak && memoBoxEndsWith(before, MEMO_BOX_LINE_BREAK))
		before.erase(before.size() - BREAK_LEN);
}

void MemoBoxItem::__finishModeChange()
{
	elm_object_focus_set(__entryObj, EINA_TRUE);
	elm_entry_cursor_end_set(__entryObj);
}

// The text item keeps `head` and lets go of the focus: the new item behind it takes over.
void MemoBoxItem::__handOverToNewItem(const std::string &head)
{
	elm_entry_entry_set(__entryObj, head.c_str());
	elm_entry_input_panel_enabled_set(__entryObj, EINA_FALSE);
	elm_object_focus_set(__entryObj, EINA_FALSE);
	elm_entry_cursor_end_set(__entryObj);
}

void MemoBoxItem::changeMode()
{
	if (!__entryObj) {
		MEMO_LOGE("__entryObj is NULL");
		return;
	}
	const char *current = elm_entry_entry_get(__entryObj);
	const std::string copy = current ? current : "";

	if (memoBoxItemIsCheck(__type)) {
		__type = __type == MEMO_BOX_ITEM_FIRST_CHECK ? MEMO_BOX_ITEM_FIRST_TEXT : MEMO_BOX_ITEM_TEXT;
		__createInnerLayout();
		elm_entry_entry_insert(__entryObj, copy.c_str());
		__finishModeChange();
		return;
	}
	if (__type != MEMO_BOX_ITEM_TEXT && __type != MEMO_BOX_ITEM_FIRST_TEXT && __type != MEMO_BOX_ITEM_QUICK_TEXT) {
		MEMO_LOGE("A title has no mode");
		return;
	}

	std::string before, after;
	__splitAtCursor(before, after, false);
	const _MemoBoxItemType checkType =
	    __type == MEMO_BOX_ITEM_FIRST_TEXT ? MEMO_BOX_ITEM_FIRST_CHECK : MEMO_BOX_ITEM_CHECK;
	const size_t breakInAfter = after.find(MEMO_BOX_LINE_BREAK);

	if (before.empty()) {
		__type = checkType;
		__createInnerLayout();
		if (breakInAfter == std::string::npos) {
			elm_entry_entry_insert(__entryObj, after.c_str());
			__finishModeChange();
		} else if (breakInAfter + BREAK_LEN == after.size()) {
			elm_entry_entry_insert(__entryObj, after.c_str());
			elm_object_focus_set(__entryObj, EINA_TRUE);
			elm_entry_cursor_pos_set(__entryObj, 0);
		} else {
			const std::string rest = after.substr(breakInAfter + BREAK_LEN);
			if (__listener)
				__listener->onAddRequested(__entryObj, MEMO_BOX_ITEM_TEXT, rest.c_str(), this);
			elm_entry_entry_insert(__entryObj, after.substr(0, breakInAfter).c_str());
			__finishModeChange();
		}
		return;
	}

	if (after.empty()) {
		const size_t lastBreak = before.rfind(MEMO_BOX_LINE_BREAK);
		if (lastBreak == std::string::npos) {
			__type = checkType;
			__createInnerLayout();
			elm_entry_entry_insert(__entryObj, copy.c_str());
			__finishModeChange();
			return;
		}
		const std::string tail = before.substr(lastBreak + BREAK_LEN);
		__handOverToNewItem(before.substr(0, lastBreak));
		if (__listener)
			__listener->onAddRequested(__entryObj, MEMO_BOX_ITEM_CHECK, tail.c_str(), this);
		return;
	}

	if (memoBoxEndsWith(before, MEMO_BOX_LINE_BREAK))
		before.erase(before.size() - BREAK_LEN);
	__handOverToNewItem(before);
	if (memoBoxStartsWith(after, MEMO_BOX_LINE_BREAK))
		after.erase(0, BREAK_LEN);
	const size_t firstBreak = after.find(MEMO_BOX_LINE_BREAK);
	if (firstBreak == std::string::npos) {
		if (__listener)
			__listener->onAddRequested(__entryObj, MEMO_BOX_ITEM_CHECK, after.c_str(), this);
		return;
	}
	if (!__listener)
		return;
	const std::string first = after.substr(0, firstBreak);
	const std::string rest = after.substr(firstBreak + BREAK_LEN);
	MemoBoxItem *checkItem = __listener->onAddRequested(__entryObj, MEMO_BOX_ITEM_CHECK, first.c_str(), this);
	if (!checkItem)
		return;
	MemoBoxItem *textItem =
	    __listener->onAddRequested(checkItem->getEntry(), MEMO_BOX_ITEM_TEXT, rest.c_str(), checkItem);
	if (!textItem)
		return;
	// Each timer belongs to the item it touches, so that neither can reach a deleted item.
	textItem->__addTimer([](void *data) {
		MemoBoxItem *text = static_cast<MemoBoxItem *>(data);
		if (text->getEntry())
			elm_entry_input_panel_enabled_set(text->getEntry(), EINA_TRUE);
		return false;
	});
	checkItem->__addTimer([](void *data) {
		MemoBoxItem *check = static_cast<MemoBoxItem *>(data);
		if (check->getEntry())
			elm_object_focus_set(check->getEntry(), EINA_TRUE);
		return false;
	});
}
