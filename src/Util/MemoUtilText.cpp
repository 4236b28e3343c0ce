// Text from outside and from the keyboard, made fit for the stored document: XML 1.0 cannot carry
// most control characters, and a document holding one cannot be read back, so the memo would reopen
// empty.
#include "Util/MemoUtil.h"

#include <cstdlib>
#include <cstring>

namespace
{
// Length of the UTF-8 sequence at s (with its code point in *cp), 0 when it is not valid UTF-8.
size_t sequenceAt(const unsigned char *s, unsigned long *cp)
{
	const unsigned char c = s[0];
	size_t len = 1;
	unsigned long min = 0;
	if (c < 0x80) {
		*cp = c;
		return 1;
	} else if ((c & 0xE0) == 0xC0) {
		len = 2, *cp = c & 0x1F, min = 0x80;
	} else if ((c & 0xF0) == 0xE0) {
		len = 3, *cp = c & 0x0F, min = 0x800;
	} else if ((c & 0xF8) == 0xF0) {
		len = 4, *cp = c & 0x07, min = 0x10000;
	} else {
		return 0;
	}
	for (size_t k = 1; k < len; ++k) {
		if ((s[k] & 0xC0) != 0x80)
			return 0;
		*cp = (*cp << 6) | (s[k] & 0x3F);
	}
	if (*cp < min || *cp > 0x10FFFF || (*cp >= 0xD800 && *cp <= 0xDFFF))
		return 0;
	return len;
}

bool isStorable(unsigned long cp)
{
	if (cp < 0x20)
		return cp == '\t' || cp == '\n';
	return cp != 0xFFFE && cp != 0xFFFF;
}
} // namespace

char *MemoUtil::stripControlCharsN(const char *text)
{
	if (!text)
		return nullptr;
	const size_t size = strlen(text);
	char *out = static_cast<char *>(malloc(size + 1));
	if (!out)
		return nullptr;
	const unsigned char *in = reinterpret_cast<const unsigned char *>(text);
	size_t o = 0;
	for (size_t i = 0; i < size;) {
		unsigned long cp = 0;
		const size_t len = sequenceAt(in + i, &cp);
		if (len == 0) {
			++i;
			continue;
		}
		if (cp == '\r') {
			// A line end of another system: CR LF and a lone CR become one newline.
			out[o++] = '\n';
			i += in[i + 1] == '\n' ? 2 : 1;
			continue;
		}
		if (isStorable(cp)) {
			memcpy(out + o, in + i, len);
			o += len;
		}
		i += len;
	}
	out[o] = '\0';
	return out;
}
