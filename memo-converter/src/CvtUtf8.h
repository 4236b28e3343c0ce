#ifndef MEMO_CONVERTER_SRC_CVTUTF8_H
#define MEMO_CONVERTER_SRC_CVTUTF8_H

#include <string>

// Returns `in` as valid UTF-8: every invalid sequence becomes U+FFFD and NUL bytes are dropped.
// With `forXml`, characters that XML 1.0 cannot carry (C0 controls other than tab, newline and
// carriage return; U+FFFE, U+FFFF) become U+FFFD as well.
std::string cvtValidUtf8(const std::string &in, bool forXml);

// Appends the UTF-8 form of code point `cp` (which must be a valid scalar value) to `out`.
void cvtAppendCodePoint(std::string &out, unsigned long cp);

#endif
