#include "CvtUtf8.h"

namespace
{
const char REPLACEMENT[] = "\xEF\xBF\xBD";

// Length of the valid UTF-8 sequence at s[i], 0 when it is not valid. Stores its code point.
size_t __sequenceAt(const std::string &s, size_t i, unsigned long &cp)
{
	const unsigned char c = static_cast<unsigned char>(s[i]);
	size_t len;
	unsigned long min;
	if (c < 0x80) {
		cp = c;
		return 1;
	} else if ((c & 0xE0) == 0xC0) {
		len = 2, cp = c & 0x1F, min = 0x80;
	} else if ((c & 0xF0) == 0xE0) {
		len = 3, cp = c & 0x0F, min = 0x800;
	} else if ((c & 0xF8) == 0xF0) {
		len = 4, cp = c & 0x07, min = 0x10000;
	} else {
		return 0;
	}
	if (i + len > s.size())
		return 0;
	for (size_t k = 1; k < len; ++k) {
		const unsigned char cc = static_cast<unsigned char>(s[i + k]);
		if ((cc & 0xC0) != 0x80)
			return 0;
		cp = (cp << 6) | (cc & 0x3F);
	}
	if (cp < min || cp > 0x10FFFF || (cp >= 0xD800 && cp <= 0xDFFF))
		return 0;
	return len;
}

bool __xmlAllows(unsigned long cp)
{
	if (cp < 0x20)
		return cp == 0x09 || cp == 0x0A || cp == 0x0D;
	return cp != 0xFFFE && cp != 0xFFFF;
}
} // namespace

std::string cvtValidUtf8(const std::string &in, CvtXmlChars xmlChars)
{
	std::string out;
	out.reserve(in.size());
	size_t i = 0;
	while (i < in.size()) {
		unsigned long cp = 0;
		const size_t len = __sequenceAt(in, i, cp);
		if (len == 0) {
			out += REPLACEMENT;
			++i;
			continue;
		}
		if (cp == 0) {
			++i;
			continue;
		}
		if (xmlChars == CVT_XML_KEEP || __xmlAllows(cp))
			out.append(in, i, len);
		else if (xmlChars == CVT_XML_REPLACE)
			out += REPLACEMENT;
		i += len;
	}
	return out;
}

void cvtAppendCodePoint(std::string &out, unsigned long cp)
{
	if (cp < 0x80) {
		out += static_cast<char>(cp);
	} else if (cp < 0x800) {
		out += static_cast<char>(0xC0 | (cp >> 6));
		out += static_cast<char>(0x80 | (cp & 0x3F));
	} else if (cp < 0x10000) {
		out += static_cast<char>(0xE0 | (cp >> 12));
		out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
		out += static_cast<char>(0x80 | (cp & 0x3F));
	} else {
		out += static_cast<char>(0xF0 | (cp >> 18));
		out += static_cast<char>(0x80 | ((cp >> 12) & 0x3F));
		out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
		out += static_cast<char>(0x80 | (cp & 0x3F));
	}
}
