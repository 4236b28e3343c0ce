#ifndef INC_BOX_MEMOTODOLISTDOCUMENT_H
#define INC_BOX_MEMOTODOLISTDOCUMENT_H

#include "Box/MemoBoxItemType.h"

#include <string>
#include <vector>

// The todolist document, the stored master form of a memo body (column tizenXmlContent):
//   <todolist>
//   <todolist_item todo_item_type="0" todo_item_state="false" todo_item_content="..."/>
//   </todolist>
// No declaration, one self-closed item per line, a newline at the end. Type "1" is a check item
// whose state is "true" or "false"; type "0" a text item, always "false". The content is the
// item's saved markup, XML-escaped. An empty body is stored as the empty string.

// One body item as the document carries it.
struct MemoTodoListItem {
	_MemoBoxItemType type = MEMO_BOX_ITEM_TEXT;
	bool checked = false;
	std::string content; // saved markup (writer input) or the unescaped attribute (reader output)
};

// Longest stored document plus its terminator; longer documents are cut to one byte less.
const size_t MEMO_TODOLIST_BUFFER_SIZE = 40960;

// Writes a document item by item with the libxml2 memory writer, for MemoBoxControl::getTodoListXmlN.
// The caller skips items whose entry is empty and adds the others in list order.
class MemoTodoListWriter
{
public:
	MemoTodoListWriter();
	~MemoTodoListWriter();

	// Adds one item: check kinds write type "1" and their state, every other kind "0" and
	// "false". `contentMarkup` is the item's saved markup; null counts as empty; control characters
	// that XML cannot carry are left out. False if the writer failed (logged).
	bool addItem(_MemoBoxItemType type, bool checked, const char *contentMarkup);

	// Ends the document and returns it from "<todolist>" on, cut to 40959 bytes; the empty string
	// when no item was added. Null when the writer failed at any step (logged), so that a caller
	// never stores an empty body in place of a memo. The caller frees it. Call once.
	char *finishN();

private:
	MemoTodoListWriter(const MemoTodoListWriter &) = delete;
	MemoTodoListWriter &operator=(const MemoTodoListWriter &) = delete;

	struct _xmlBuffer *__buffer;
	struct _xmlTextWriter *__writer;
	bool __failed;
};

// Writes `items` in order, skipping those with empty content. Null when the writer failed (logged);
// the caller frees it.
char *memoComposeTodoListXmlN(const std::vector<MemoTodoListItem> &items);

// Reads a document for MemoBoxControl::__composeBoxItemFromXml with the libxml2 text reader
// (whole string, no URL, no encoding, no options). Items are appended to `items` in document
// order. An item's kind depends on how many body items exist when it is made: `existingCount`
// body items before the document plus those read so far; with none, "0" gives FIRST_TEXT and
// "1" FIRST_CHECK, else TEXT and CHECK; any other type (or none) gives no item. A check item is
// ticked unless its state is exactly "false". A read error after the first node ends the read
// and keeps what was read. If the first node cannot be read, logs (error)
// "xmlTextReaderRead failed.", appends one empty item of kind FIRST_TEXT and returns false.
bool memoParseTodoListXml(const char *xml, std::vector<MemoTodoListItem> &items, size_t existingCount = 0);

#endif
