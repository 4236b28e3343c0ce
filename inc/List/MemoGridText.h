#ifndef INC_LIST_MEMOGRIDTEXT_H
#define INC_LIST_MEMOGRIDTEXT_H

#include <string>
#include <vector>

// The widget-free text work of a memo card: the lines of a preview and the keyword highlight.

// Kinds of a preview line.
enum MemoGridLineKind {
	MEMO_GRID_LINE_UNTICKED = 0,
	MEMO_GRID_LINE_TICKED = 1,
	MEMO_GRID_LINE_PLAIN = 2,
};

struct MemoGridLine {
	int kind;
	std::string text; // plain UTF-8, as it stands in the display content
};

// Splits display content into preview lines. "<CHECK state=true>" and "<CHECK state=false>" open a
// ticked or unticked line that "</CHECK>" closes; other text forms plain lines, each ended by a "<br/>"
// or a newline. A "<br/>" right behind "</CHECK>" gives one empty plain line. Null gives no lines.
std::vector<MemoGridLine> memoGridParseLines(const char *displayContent);

// An RGBA colour of a colour class.
struct MemoGridColor {
	int r, g, b, a;
};

// The highlighted form of `markup` for `keyword` (markup as well): each ASCII case-insensitive match is
// wrapped in "<color=#rrggbbaa>" of `match` and "</color>", every stretch between matches in the tag of
// `other`; with no match the whole text takes `other`. A match that would cut a tag ("<br/>") or an
// entity is skipped. An empty keyword gives `markup` unchanged.
std::string memoGridHighlight(const std::string &markup, const std::string &keyword, const MemoGridColor &match,
                              const MemoGridColor &other);

// `text` cut to fit a buffer of `size` bytes with its terminator, not leaving half a UTF-8 character,
// entity or tag at the end.
std::string memoGridCut(const std::string &text, size_t size);

#endif
