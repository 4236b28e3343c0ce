#include "CvtMarkup.h"

#include "CvtUtf8.h"

#include <cstdlib>
#include <cstring>

namespace
{
// Longest entity we decode, "&#x10FFFF;" and the like, with room to spare.
const size_t ENTITY_MAX = 12;
const int IMAGE_SIZE_MAX = 100000;

bool __isDigit(char c)
{
	return c >= '0' && c <= '9';
}
bool __isHex(char c)
{
	return __isDigit(c) || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F');
}

// Decodes the entity body between "&" and ";" (e.g. "amp", "#38", "#x26"). False if unknown.
bool __decodeEntity(const std::string &name, std::string &out)
{
	static const struct {
		const char *name;
		const char *text;
	} named[] = {{"amp", "&"}, {"lt", "<"}, {"gt", ">"}, {"quot", "\""}, {"apos", "'"}, {"nbsp", "\xC2\xA0"}};
	for (const auto &entity : named) {
		if (name == entity.name) {
			out += entity.text;
			return true;
		}
	}
	if (name.size() < 2 || name[0] != '#')
		return false;
	const bool hex = name[1] == 'x' || name[1] == 'X';
	const size_t start = hex ? 2 : 1;
	if (start >= name.size())
		return false;
	unsigned long cp = 0;
	for (size_t i = start; i < name.size(); ++i) {
		const char c = name[i];
		if (hex ? !__isHex(c) : !__isDigit(c))
			return false;
		const unsigned long digit = __isDigit(c) ? c - '0' : (c | 0x20) - 'a' + 10;
		cp = cp * (hex ? 16 : 10) + digit;
		if (cp > 0x10FFFF)
			return false;
	}
	if (cp == 0 || (cp >= 0xD800 && cp <= 0xDFFF))
		cp = 0xFFFD;
	cvtAppendCodePoint(out, cp);
	return true;
}

// Length of the entity starting at s[i] == '&' including "&" and ";", or 0 if there is none.
size_t __entityLength(const std::string &s, size_t i, std::string *decoded)
{
	// Look only a few bytes ahead, so that a text full of "&" stays linear.
	size_t semi = i + 1;
	while (semi < s.size() && semi - i <= ENTITY_MAX && s[semi] != ';')
		++semi;
	if (semi >= s.size() || s[semi] != ';' || semi == i + 1)
		return 0;
	std::string scratch;
	if (!__decodeEntity(s.substr(i + 1, semi - i - 1), decoded ? *decoded : scratch))
		return 0;
	return semi - i + 1;
}

void __pushText(std::vector<CvtRun> &runs, const std::string &text)
{
	if (text.empty())
		return;
	if (runs.empty() || runs.back().kind != CvtRun::TEXT) {
		runs.emplace_back();
		runs.back().kind = CvtRun::TEXT;
	}
	runs.back().text += text;
}

void __pushBreak(std::vector<CvtRun> &runs)
{
	runs.emplace_back();
	runs.back().kind = CvtRun::BREAK;
}

// Decodes entities of a tag attribute value.
std::string __decodeValue(const std::string &value)
{
	std::string out;
	for (size_t i = 0; i < value.size(); ++i) {
		size_t len = 0;
		if (value[i] == '&')
			len = __entityLength(value, i, &out);
		if (len)
			i += len - 1;
		else
			out += value[i];
	}
	return out;
}

// Value of attribute `key` ("href", "size") in the body of a tag, or false if absent. A quoted
// value runs to its quote; an unquoted href runs to the end of the tag (paths may hold blanks),
// other unquoted values to the next blank.
bool __tagAttribute(const std::string &tag, const char *key, std::string &value)
{
	const size_t keyLen = strlen(key);
	size_t pos = 0;
	while ((pos = tag.find(key, pos)) != std::string::npos) {
		const bool atWordStart = pos == 0 || tag[pos - 1] == ' ';
		if (!atWordStart || tag.compare(pos + keyLen, 1, "=") != 0) {
			pos += keyLen;
			continue;
		}
		size_t start = pos + keyLen + 1;
		size_t end;
		if (start < tag.size() && (tag[start] == '"' || tag[start] == '\'')) {
			end = tag.find(tag[start], start + 1);
			++start;
			if (end == std::string::npos)
				end = tag.size();
		} else if (strcmp(key, "href") == 0) {
			end = tag.size();
			while (end > start && (tag[end - 1] == ' ' || tag[end - 1] == '/'))
				--end;
		} else {
			end = tag.find(' ', start);
			if (end == std::string::npos)
				end = tag.size();
		}
		value = tag.substr(start, end - start);
		return true;
	}
	return false;
}

void __parseSize(const std::string &value, int &width, int &height)
{
	const char *s = value.c_str();
	char *end = nullptr;
	const long w = strtol(s, &end, 10);
	if (end == s || (*end != 'x' && *end != 'X'))
		return;
	const char *hs = end + 1;
	const long h = strtol(hs, &end, 10);
	if (end == hs)
		return;
	if (w > 0 && h > 0 && w <= IMAGE_SIZE_MAX && h <= IMAGE_SIZE_MAX) {
		width = static_cast<int>(w);
		height = static_cast<int>(h);
	}
}

void __pushImage(std::vector<CvtRun> &runs, const std::string &tag)
{
	std::string href;
	if (!__tagAttribute(tag, "href", href))
		return;
	href = __decodeValue(href);
	if (href.compare(0, 7, "file://") == 0)
		href.erase(0, 7);
	CvtRun run;
	run.kind = CvtRun::IMAGE;
	run.text = href;
	std::string size;
	if (__tagAttribute(tag, "size", size) || __tagAttribute(tag, "absize", size))
		__parseSize(size, run.width, run.height);
	runs.push_back(run);
}

// Handles the tag between "<" and ">" (exclusive).
void __pushTag(std::vector<CvtRun> &runs, const std::string &tag)
{
	if (tag.empty() || tag[0] == '/')
		return;
	size_t nameEnd = 0;
	while (nameEnd < tag.size() && tag[nameEnd] != ' ' && tag[nameEnd] != '/' && tag[nameEnd] != '=')
		++nameEnd;
	const std::string name = tag.substr(0, nameEnd);
	if (name == "br" || name == "ps")
		__pushBreak(runs);
	else if (name == "tab")
		__pushText(runs, "\t");
	else if (name == "item")
		__pushImage(runs, tag);
}
} // namespace

std::vector<CvtRun> cvtParseMarkup(const std::string &markup)
{
	std::vector<CvtRun> runs;
	std::string text;
	size_t i = 0;
	while (i < markup.size()) {
		const char c = markup[i];
		if (c == '<') {
			const size_t close = markup.find('>', i + 1);
			if (close == std::string::npos) {
				text.append(markup, i, std::string::npos);
				break;
			}
			__pushText(runs, text);
			text.clear();
			__pushTag(runs, markup.substr(i + 1, close - i - 1));
			i = close + 1;
		} else if (c == '&') {
			const size_t len = __entityLength(markup, i, &text);
			if (len == 0)
				text += c;
			i += len ? len : 1;
		} else if (c == '\n') {
			__pushText(runs, text);
			text.clear();
			__pushBreak(runs);
			++i;
		} else {
			if (c != '\r')
				text += c;
			++i;
		}
	}
	__pushText(runs, text);
	return runs;
}

std::string cvtPlainText(const std::vector<CvtRun> &runs, const char *lineBreak)
{
	std::string out;
	for (const CvtRun &run : runs) {
		if (run.kind == CvtRun::TEXT)
			out += run.text;
		else if (run.kind == CvtRun::BREAK)
			out += lineBreak;
	}
	return out;
}

std::string cvtPlainToMarkup(const std::string &text)
{
	std::string out;
	out.reserve(text.size() + text.size() / 8);
	for (size_t i = 0; i < text.size(); ++i) {
		const char c = text[i];
		switch (c) {
		case '<':
			out += "&lt;";
			break;
		case '>':
			out += "&gt;";
			break;
		case '&':
			out += __entityLength(text, i, nullptr) ? "&" : "&amp;";
			break;
		case '\r':
			out += "<br/>";
			if (i + 1 < text.size() && text[i + 1] == '\n')
				++i;
			break;
		case '\n':
			out += "<br/>";
			break;
		case '\t':
			out += "<tab/>";
			break;
		default:
			if (c == '\xC2' && i + 1 < text.size() && text[i + 1] == '\xA0')
				++i;
			else
				out += c;
		}
	}
	return out;
}
