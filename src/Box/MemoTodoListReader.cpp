#include "Box/MemoTodoListDocument.h"

#include "MemoLog.h"

#include <climits>
#include <cstring>
#include <libxml/xmlreader.h>

namespace
{
// A cut document ends in a parse error by design; the error ends the read and needs no output.
void __ignoreXmlErrorCb(void *, xmlErrorPtr) {}

bool __isNamed(xmlTextReaderPtr reader, const char *name)
{
	const xmlChar *nodeName = xmlTextReaderConstName(reader);
	return nodeName && strcmp(reinterpret_cast<const char *>(nodeName), name) == 0;
}

// Reads the todolist_item under the reader into `items`; other types than "0" and "1" give none.
// `bodyCount` is the number of body items that exist before this one.
void __readItem(xmlTextReaderPtr reader, std::vector<MemoTodoListItem> &items, size_t bodyCount)
{
	xmlChar *type = xmlTextReaderGetAttribute(reader, BAD_CAST "todo_item_type");
	const bool first = bodyCount == 0;
	MemoTodoListItem item;
	bool made = true;
	if (type && xmlStrEqual(type, BAD_CAST "0"))
		item.type = first ? MEMO_BOX_ITEM_FIRST_TEXT : MEMO_BOX_ITEM_TEXT;
	else if (type && xmlStrEqual(type, BAD_CAST "1"))
		item.type = first ? MEMO_BOX_ITEM_FIRST_CHECK : MEMO_BOX_ITEM_CHECK;
	else
		made = false;
	xmlFree(type);
	if (!made)
		return;
	if (memoBoxItemIsCheck(item.type)) {
		xmlChar *state = xmlTextReaderGetAttribute(reader, BAD_CAST "todo_item_state");
		item.checked = !(state && xmlStrEqual(state, BAD_CAST "false"));
		xmlFree(state);
	}
	xmlChar *content = xmlTextReaderGetAttribute(reader, BAD_CAST "todo_item_content");
	if (content)
		item.content = reinterpret_cast<const char *>(content);
	xmlFree(content);
	items.push_back(item);
}
} // namespace

bool memoParseTodoListXml(const char *xml, std::vector<MemoTodoListItem> &items, size_t existingCount)
{
	const size_t start = items.size();
	xmlTextReaderPtr reader = nullptr;
	if (xml && strlen(xml) <= INT_MAX)
		reader = xmlReaderForMemory(xml, static_cast<int>(strlen(xml)), nullptr, nullptr, 0);
	if (reader)
		xmlTextReaderSetStructuredErrorHandler(reader, __ignoreXmlErrorCb, nullptr);
	if (!reader || xmlTextReaderRead(reader) != 1) {
		MEMO_LOGE("xmlTextReaderRead failed.");
		MemoTodoListItem empty;
		empty.type = MEMO_BOX_ITEM_FIRST_TEXT;
		items.push_back(empty);
		if (reader)
			xmlFreeTextReader(reader);
		return false;
	}
	int ret = 1;
	while (ret == 1) {
		// Only the start tag: the closing tag of a written-out item would give it a second time.
		if (xmlTextReaderNodeType(reader) == XML_READER_TYPE_ELEMENT && __isNamed(reader, "todolist_item"))
			__readItem(reader, items, existingCount + items.size() - start);
		ret = xmlTextReaderRead(reader);
	}
	xmlFreeTextReader(reader);
	return true;
}
