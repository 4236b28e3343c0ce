#include "Box/MemoTodoListDocument.h"

#include "MemoLog.h"
#include "Util/MemoUtil.h"

#include <cstdlib>
#include <cstring>
#include <libxml/xmlwriter.h>

MemoTodoListWriter::MemoTodoListWriter() : __buffer(nullptr), __writer(nullptr), __failed(false)
{
	__buffer = xmlBufferCreate();
	if (__buffer)
		__writer = xmlNewTextWriterMemory(__buffer, 0);
	if (!__writer) {
		MEMO_LOGE("xmlNewTextWriterMemory failed");
		__failed = true;
		return;
	}
	xmlTextWriterSetIndent(__writer, 1);
	xmlTextWriterSetIndentString(__writer, BAD_CAST "");
	if (xmlTextWriterStartDocument(__writer, nullptr, "UTF-8", nullptr) < 0 ||
	    xmlTextWriterStartElement(__writer, BAD_CAST "todolist") < 0) {
		MEMO_LOGE("xmlTextWriter start failed");
		__failed = true;
	}
}

MemoTodoListWriter::~MemoTodoListWriter()
{
	if (__writer)
		xmlFreeTextWriter(__writer);
	if (__buffer)
		xmlBufferFree(__buffer);
}

bool MemoTodoListWriter::addItem(_MemoBoxItemType type, bool checked, const char *contentMarkup)
{
	if (__failed || !__writer)
		return false;
	const bool isCheck = memoBoxItemIsCheck(type);
	const char *state = isCheck && checked ? "true" : "false";
	// A control character would make the whole document unreadable: the memo would reopen empty.
	char *content = MemoUtil::stripControlCharsN(contentMarkup ? contentMarkup : "");
	if (!content) {
		MEMO_LOGE("out of memory");
		__failed = true;
		return false;
	}
	const bool written =
	    xmlTextWriterStartElement(__writer, BAD_CAST "todolist_item") >= 0 &&
	    xmlTextWriterWriteAttribute(__writer, BAD_CAST "todo_item_type", BAD_CAST(isCheck ? "1" : "0")) >= 0 &&
	    xmlTextWriterWriteAttribute(__writer, BAD_CAST "todo_item_state", BAD_CAST state) >= 0 &&
	    xmlTextWriterWriteAttribute(__writer, BAD_CAST "todo_item_content", BAD_CAST content) >= 0 &&
	    xmlTextWriterEndElement(__writer) >= 0;
	free(content);
	if (!written) {
		MEMO_LOGE("xmlTextWriter item failed");
		__failed = true;
		return false;
	}
	return true;
}

char *MemoTodoListWriter::finishN()
{
	// An empty result would store an empty body over the memo: a failed write gives none at all.
	if (__failed || !__writer) {
		MEMO_LOGE("todolist document not written");
		return nullptr;
	}
	const bool ended = xmlTextWriterEndElement(__writer) >= 0 && xmlTextWriterEndDocument(__writer) >= 0;
	// The writer flushes into the buffer when freed.
	xmlFreeTextWriter(__writer);
	__writer = nullptr;
	if (!ended) {
		MEMO_LOGE("xmlTextWriter end failed");
		return nullptr;
	}
	char *result = static_cast<char *>(calloc(MEMO_TODOLIST_BUFFER_SIZE, 1));
	if (!result) {
		MEMO_LOGE("out of memory");
		return nullptr;
	}
	const char *text = reinterpret_cast<const char *>(xmlBufferContent(__buffer));
	// With no item the root is self-closed, "<todolist>" is not found, and the body stores nothing.
	const char *root = text ? strstr(text, "<todolist>") : nullptr;
	if (root)
		strncpy(result, root, MEMO_TODOLIST_BUFFER_SIZE - 1);
	return result;
}

char *memoComposeTodoListXmlN(const std::vector<MemoTodoListItem> &items)
{
	MemoTodoListWriter writer;
	for (const MemoTodoListItem &item : items) {
		if (!item.content.empty() && !writer.addItem(item.type, item.checked, item.content.c_str()))
			break;
	}
	return writer.finishN();
}
