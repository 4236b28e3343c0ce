#ifndef MEMO_CONVERTER_SRC_CVTUTF8_H
#define MEMO_CONVERTER_SRC_CVTUTF8_H

#include <string>

// What becomes of characters that XML 1.0 cannot carry (C0 controls other than tab, newline and
// carriage return; U+FFFE, U+FFFF).
enum CvtXmlChars {
	CVT_XML_KEEP,    // kept: the text is not bound for XML
	CVT_XML_REPLACE, // each becomes U+FFFD
	CVT_XML_DROP,    // each is left out
};

// Returns `in` as valid UTF-8: every invalid sequence becomes U+FFFD and NUL bytes are dropped;
// characters that XML cannot carry are treated as `xmlChars` says.
std::string cvtValidUtf8(const std::string &in, CvtXmlChars xmlChars);

// Appends the UTF-8 form of code point `cp` (which must be a valid scalar value) to `out`.
void cvtAppendCodePoint(std::string &out, unsigned long cp);

#endif
