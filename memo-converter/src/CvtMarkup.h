#ifndef MEMO_CONVERTER_SRC_CVTMARKUP_H
#define MEMO_CONVERTER_SRC_CVTMARKUP_H

#include <string>
#include <vector>

// A piece of an item's entry markup, as the derived forms need it.
struct CvtRun {
	enum Kind { TEXT, BREAK, IMAGE };
	Kind kind = TEXT;
	std::string text; // TEXT: decoded text; IMAGE: the file path
	int width = 0;    // IMAGE only: display size from the tag, 0 when absent
	int height = 0;
};

// Splits entry markup into text, line breaks and images in one pass. Entities are decoded
// (unknown ones stay as written), "<br>", "<ps>" and raw newlines are breaks, "<tab>" is a tab,
// an "<item ... href=...>" tag is an image and every other tag is dropped. A "<" without a
// closing ">" is text. Never fails.
std::vector<CvtRun> cvtParseMarkup(const std::string &markup);

// The plain text of `runs`: breaks become `lineBreak`, images leave nothing.
std::string cvtPlainText(const std::vector<CvtRun> &runs, const char *lineBreak);

// Entry markup for plain text that came from outside: "<" and ">" become entities, an "&" stays
// when it already starts an entity and becomes "&amp;" otherwise, line ends become "<br/>", tabs
// "<tab/>", and no-break spaces are dropped as the entry's filter would drop them.
std::string cvtPlainToMarkup(const std::string &text);

#endif
