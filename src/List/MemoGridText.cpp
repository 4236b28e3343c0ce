// Preview lines and keyword highlight of a memo card; no widgets.
#include "List/MemoGridText.h"

#include <cstdio>
#include <cstring>

namespace
{
const char BREAK_TAG[] = "<br/>";
const char CHECK_ON_TOKEN[] = "CHECK state=true";
const char CHECK_OFF_TOKEN[] = "CHECK state=false";
const char CHECK_END_TOKEN[] = "/CHECK";

struct Span {
	size_t begin, end; // [begin, end)
};

// Tags and entities of markup: a match may hold one whole, never cut one.
std::vector<Span> __protectedSpans(const std::string &markup)
{
	std::vector<Span> spans;
	for (size_t i = 0; i < markup.size(); ++i) {
		char closer = markup[i] == '<' ? '>' : (markup[i] == '&' ? ';' : '\0');
		if (!closer)
			continue;
		size_t end = markup.find(closer, i);
		if (end == std::string::npos)
			break;
		spans.push_back({i, end + 1});
		i = end;
	}
	return spans;
}

bool __cutsSpan(const std::vector<Span> &spans, size_t begin, size_t end)
{
	for (const Span &span : spans) {
		bool overlaps = span.begin < end && span.end > begin;
		bool holds = begin <= span.begin && end >= span.end;
		if (overlaps && !holds)
			return true;
	}
	return false;
}

bool __matchesAt(const std::string &text, size_t at, const std::string &lowerKeyword)
{
	for (size_t k = 0; k < lowerKeyword.size(); ++k) {
		char c = text[at + k];
		if (c >= 'A' && c <= 'Z')
			c = static_cast<char>(c - 'A' + 'a');
		if (c != lowerKeyword[k])
			return false;
	}
	return true;
}

void __appendColored(std::string &out, const MemoGridColor &color, const std::string &text)
{
	char tag[32];
	snprintf(tag, sizeof(tag), "<color=#%.2x%.2x%.2x%.2x>", color.r & 0xff, color.g & 0xff, color.b & 0xff,
	         color.a & 0xff);
	out += tag;
	out += text;
	out += "</color>";
}

void __pushLine(std::vector<MemoGridLine> &lines, int kind, std::string &text)
{
	lines.push_back({kind, text});
	text.clear();
}
} // namespace

std::vector<MemoGridLine> memoGridParseLines(const char *displayContent)
{
	std::vector<MemoGridLine> lines;
	if (!displayContent)
		return lines;
	std::string plain, check;
	bool inCheck = false;
	int checkKind = MEMO_GRID_LINE_UNTICKED;
	const char *p = displayContent;
	while (*p) {
		bool isBreak = !strncmp(p, BREAK_TAG, sizeof(BREAK_TAG) - 1);
		if (isBreak || *p == '\n') {
			// A check line holds no break of its own; a break ends the plain line in progress.
			if (!inCheck)
				__pushLine(lines, MEMO_GRID_LINE_PLAIN, plain);
			p += isBreak ? sizeof(BREAK_TAG) - 1 : 1;
			continue;
		}
		const char *close = *p == '<' ? strchr(p, '>') : nullptr;
		if (!close) {
			(inCheck ? check : plain) += *p++;
			continue;
		}
		std::string token(p + 1, close);
		if (token == CHECK_ON_TOKEN || token == CHECK_OFF_TOKEN) {
			if (!plain.empty())
				__pushLine(lines, MEMO_GRID_LINE_PLAIN, plain);
			inCheck = true;
			checkKind = token == CHECK_ON_TOKEN ? MEMO_GRID_LINE_TICKED : MEMO_GRID_LINE_UNTICKED;
			check.clear();
		} else if (token == CHECK_END_TOKEN) {
			if (inCheck)
				__pushLine(lines, checkKind, check);
			inCheck = false;
		} else {
			(inCheck ? check : plain).append(p, close + 1);
		}
		p = close + 1;
	}
	if (inCheck)
		__pushLine(lines, checkKind, check);
	else if (!plain.empty())
		__pushLine(lines, MEMO_GRID_LINE_PLAIN, plain);
	return lines;
}

std::string memoGridHighlight(const std::string &markup, const std::string &keyword, const MemoGridColor &match,
                              const MemoGridColor &other)
{
	if (keyword.empty())
		return markup;
	std::string lowerKeyword = keyword;
	for (char &c : lowerKeyword)
		if (c >= 'A' && c <= 'Z')
			c = static_cast<char>(c - 'A' + 'a');
	const std::vector<Span> spans = __protectedSpans(markup);
	std::string out;
	size_t done = 0;
	bool matched = false;
	for (size_t at = 0; at + keyword.size() <= markup.size();) {
		if (!__matchesAt(markup, at, lowerKeyword) || __cutsSpan(spans, at, at + keyword.size())) {
			++at;
			continue;
		}
		if (at > done)
			__appendColored(out, other, markup.substr(done, at - done));
		__appendColored(out, match, markup.substr(at, keyword.size()));
		matched = true;
		at += keyword.size();
		done = at;
	}
	if (done < markup.size() || !matched)
		__appendColored(out, other, markup.substr(done));
	return out;
}

std::string memoGridCut(const std::string &text, size_t size)
{
	if (size == 0)
		return "";
	if (text.size() < size)
		return text;
	std::string cut = text.substr(0, size - 1);
	// Half a UTF-8 character: drop its lead and continuation bytes.
	size_t end = cut.size();
	size_t lead = end;
	while (lead > 0 && (static_cast<unsigned char>(cut[lead - 1]) & 0xC0) == 0x80)
		--lead;
	if (lead > 0 && (static_cast<unsigned char>(cut[lead - 1]) & 0x80)) {
		unsigned char c = static_cast<unsigned char>(cut[lead - 1]);
		size_t need = (c & 0xE0) == 0xC0 ? 2 : (c & 0xF0) == 0xE0 ? 3 : 4;
		if (end - (lead - 1) < need)
			cut.resize(lead - 1);
	}
	// Half an entity or tag.
	size_t open = cut.find_last_of("<&");
	if (open != std::string::npos && cut.find_first_of(">;", open) == std::string::npos)
		cut.resize(open);
	return cut;
}
