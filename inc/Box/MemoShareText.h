#ifndef INC_BOX_MEMOSHARETEXT_H
#define INC_BOX_MEMOSHARETEXT_H

#include <string>

// Share texts are made from display text (with "<CHECK state=...>" markers) by one of two marker
// tables. The tables differ on purpose: the edit view writes "[  ]" / "[v]", the list and search
// views "[ ]" / "[V]"; both end a check line with "\n".

// `display` with the edit view's table applied.
std::string memoApplyEditShareMarkers(const std::string &display);

// `display` with the list and search views' table applied.
std::string memoApplyListShareMarkers(const std::string &display);

// The edit view's text share: the title and "\n" when the title is not empty; then the display
// text of `document` through the converter when it is not empty, else `displayContent`; cut to
// 40959 bytes; the edit table; elm_entry_markup_to_utf8 (with "&" escaped first, so that a
// plain ampersand survives it); every no-break space removed.
// Null arguments count as empty.
std::string memoComposeEditShareText(const char *title, const char *document, const char *displayContent);

// The text of a pick reply from the list or search view: the title and "\n" when the title is
// not empty, then `displayContent` only when `document` (tizenXmlContent) is not empty, with the
// list table applied. Null arguments count as empty.
std::string memoComposePickText(const char *title, const char *document, const char *displayContent);

#endif
