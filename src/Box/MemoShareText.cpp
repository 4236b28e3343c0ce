#include "Box/MemoShareText.h"

#include "Box/MemoTodoListDocument.h"
#include "MemoCvt.h"

#include <Elementary.h>
#include <cstdlib>

namespace
{
const char CHECK_OFF[] = "<CHECK state=false>";
const char CHECK_ON[] = "<CHECK state=true>";
const char CHECK_END[] = "</CHECK>";
const char NO_BREAK_SPACE[] = "\xC2\xA0";

// Replaces every `from` in `text` by `to`, left to right. The replacements hold no "<" or ">",
// so one pass leaves no marker behind.
void __replaceAll(std::string &text, const std::string &from, const std::string &to)
{
	std::string out;
	size_t pos = 0;
	size_t hit;
	while ((hit = text.find(from, pos)) != std::string::npos) {
		out.append(text, pos, hit - pos);
		out += to;
		pos = hit + from.size();
	}
	out.append(text, pos, std::string::npos);
	text.swap(out);
}

std::string __applyTable(std::string text, const char *off, const char *on)
{
	__replaceAll(text, CHECK_OFF, off);
	__replaceAll(text, CHECK_ON, on);
	__replaceAll(text, CHECK_END, "\n");
	return text;
}

bool __isEmpty(const char *s)
{
	return !s || !*s;
}
} // namespace

std::string memoApplyEditShareMarkers(const std::string &display)
{
	return __applyTable(display, "[  ]", "[v]");
}

std::string memoApplyListShareMarkers(const std::string &display)
{
	return __applyTable(display, "[ ]", "[V]");
}

std::string memoComposeEditShareText(const char *title, const char *document, const char *displayContent)
{
	std::string text;
	if (!__isEmpty(title)) {
		text += title;
		text += "\n";
	}
	if (!__isEmpty(document)) {
		MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, document);
		text += cvt.getDisplayContent();
	} else if (!__isEmpty(displayContent)) {
		text += displayContent;
	}
	if (text.size() > MEMO_TODOLIST_BUFFER_SIZE - 1)
		text.resize(MEMO_TODOLIST_BUFFER_SIZE - 1);
	text = memoApplyEditShareMarkers(text);
	// Display text is plain text with entities decoded, and the markup conversion would cut it
	// at a bare "&": escape ampersands so that they come through as they stand.
	__replaceAll(text, "&", "&amp;");
	char *plain = elm_entry_markup_to_utf8(text.c_str());
	if (plain) {
		text = plain;
		free(plain);
	}
	__replaceAll(text, NO_BREAK_SPACE, "");
	return text;
}

std::string memoComposePickText(const char *title, const char *document, const char *displayContent)
{
	std::string text;
	if (!__isEmpty(title)) {
		text += title;
		text += "\n";
	}
	if (!__isEmpty(document) && displayContent)
		text += displayContent;
	return memoApplyListShareMarkers(text);
}
