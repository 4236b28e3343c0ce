#ifndef MEMO_CONVERTER_INCLUDE_MEMOCVT_H
#define MEMO_CONVERTER_INCLUDE_MEMOCVT_H

#include <string>
#include <vector>

// MemoCvt derives every stored form of a memo body from its todolist document.
//
// Source: a todolist document, as the editor writes it, without XML declaration:
//   <todolist>
//   <todolist_item todo_item_type="0|1" todo_item_state="true|false" todo_item_content="ITEM MARKUP"/>
//   </todolist>
// The attribute value is the item's entry markup ("&amp;" "&lt;" "&gt;" entities, "<br/>" line
// breaks, "<item size=WxH vsize=full href=file://PATH></item>" images), XML-escaped on top.
// Type "0" is a text item, "1" a check item; any other type gives no item. A check item is ticked
// unless its state is exactly "false". A malformed document is read as far as the XML parser can
// recover it, so a cut document gives the items before the cut. A document with a DTD gives no
// items (the editor never writes one).
//
// Stored forms (stable; other programs may read them):
//
// content (getContent): plain UTF-8 text. Items in order, separated by "\n". Line breaks are
//   "\n", entities are decoded, images and format tags leave nothing. A check item is one line
//   that starts with "[ ] " (unticked) or "[x] " (ticked); line breaks inside it become blanks.
//
// xmlContent (getXmlContent): a well-formed UTF-8 XML exchange document:
//   <?xml version="1.0" encoding="UTF-8"?>
//   <memo version="1">
//   <item type="text" checked="false">one<br/>two<image href="/a/b.jpg" width="240" height="180"/></item>
//   <item type="check" checked="true">buy milk</item>
//   </memo>
//   One <item> per item in order; "type" is "text" or "check", "checked" is "true" only for a
//   ticked check item. Its content is text (decoded, escaped by XML rules) mixed with <br/> for a
//   line break and <image href width height/> for a picture (href is a plain absolute path; width
//   and height are the display size, 0 when unknown). No body: "<memo version="1"/>".
//   Invalid UTF-8 and characters XML cannot carry are replaced by U+FFFD.
//
// tizenXmlContent (getTizenXmlContent): the todolist document of the items above, written with
//   the editor's grammar: no declaration, "<todolist>", one self-closed todolist_item per line,
//   "</todolist>" and a newline. Empty items are kept; characters XML cannot carry are left out.
//   No items: the empty string. The empty string for a body with items means that the XML
//   writer failed (logged).
//
// display_Content (getDisplayContent): content for previews. A check item is
//   "<CHECK state=true>" or "<CHECK state=false>", its text on one line, "</CHECK>". A text item is
//   its plain text followed by "\n" when another item follows. Entities are decoded except that
//   "<" and ">" in user text become U+FF1C and U+FF1E, so the markers are the only angle brackets.
//
// strippedContent (getStrippedContent): what a search should match: the plain text of every item,
//   items separated by "\n", line breaks "\n", no markers, no tags, no images.
//
// An empty source gives the empty string for every form except getXmlContent.

struct CvtItem;

// Kinds of source the converter reads. The application only ever uses MEMO_CVT_SRC_TODOLIST.
enum _MemoCvtSrcDbType {
	MEMO_CVT_SRC_TODOLIST = 4,
};

class MemoCvt
{
public:
	// Parses the source at once. An unknown type is logged (error) and read as an empty body;
	// a malformed document is read as far as it goes. Never fails.
	MemoCvt(_MemoCvtSrcDbType type, std::string source);
	virtual ~MemoCvt();

	// Each getter returns its form of the current body by value (see above).
	std::string getContent();
	std::string getXmlContent();
	std::string getTizenXmlContent();
	std::string getDisplayContent();
	std::string getStrippedContent();

	// The quick memo append: `text` is the plain UTF-8 text that was just appended to the source
	// as its last, unescaped text item ("&" may already stand as "&amp;"). The item is rebuilt
	// from `text` so that the body holds it exactly once as a text item, whatever the text held
	// (quotes, angle brackets, line breaks); control characters XML cannot carry are left out.
	// What stood behind the item (the rest of a document that went on after its first root) is
	// not part of the body. When the source holds no such item, the text is appended as a new
	// last item.
	void addQuickMemoItem(std::string text);

private:
	MemoCvt(const MemoCvt &) = delete;
	MemoCvt &operator=(const MemoCvt &) = delete;

	std::string __source;
	std::vector<CvtItem> __items; // the body, in order
};

#endif
