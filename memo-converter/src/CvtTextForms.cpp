#include "CvtTextForms.h"

#include "CvtMarkup.h"
#include "CvtUtf8.h"

namespace
{
// Previews cut the display text at "<" and ">", so user text must not carry them.
std::string __withoutAngles(const std::string &text)
{
	std::string out;
	out.reserve(text.size());
	for (char c : text) {
		if (c == '<')
			out += "\xEF\xBC\x9C"; // U+FF1C FULLWIDTH LESS-THAN SIGN
		else if (c == '>')
			out += "\xEF\xBC\x9E"; // U+FF1E FULLWIDTH GREATER-THAN SIGN
		else
			out += c;
	}
	return out;
}

// A check item is one line: its inner breaks read as blanks.
std::string __checkLine(const CvtItem &item)
{
	return cvtPlainText(cvtParseMarkup(item.markup), " ");
}

std::string __itemText(const CvtItem &item)
{
	return cvtPlainText(cvtParseMarkup(item.markup), "\n");
}
} // namespace

std::string cvtContentText(const CvtItemList &items)
{
	std::string out;
	for (size_t i = 0; i < items.size(); ++i) {
		const CvtItem &item = items[i];
		if (i > 0)
			out += '\n';
		if (item.isCheck)
			out += (item.checked ? "[x] " : "[ ] ") + __checkLine(item);
		else
			out += __itemText(item);
	}
	return cvtValidUtf8(out, CVT_XML_KEEP);
}

std::string cvtDisplayText(const CvtItemList &items)
{
	std::string out;
	for (size_t i = 0; i < items.size(); ++i) {
		const CvtItem &item = items[i];
		if (item.isCheck) {
			out += item.checked ? "<CHECK state=true>" : "<CHECK state=false>";
			out += __withoutAngles(__checkLine(item));
			out += "</CHECK>";
		} else {
			out += __withoutAngles(__itemText(item));
			if (i + 1 < items.size())
				out += '\n';
		}
	}
	return cvtValidUtf8(out, CVT_XML_KEEP);
}

std::string cvtStrippedText(const CvtItemList &items)
{
	std::string out;
	for (size_t i = 0; i < items.size(); ++i) {
		if (i > 0)
			out += '\n';
		out += __itemText(items[i]);
	}
	return cvtValidUtf8(out, CVT_XML_KEEP);
}
