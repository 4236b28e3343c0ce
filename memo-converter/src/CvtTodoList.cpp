#include "CvtTodoList.h"

#include "CvtLog.h"
#include "CvtUtf8.h"

#include <climits>
#include <cstring>
#include <libxml/parser.h>
#include <libxml/tree.h>
#include <libxml/xmlwriter.h>

namespace
{
// Parse errors are expected (cut documents, the quick memo's unescaped text); the parser
// recovers what it can and nothing should reach stderr.
void __ignoreXmlErrorCb(void *, xmlErrorPtr) {}

std::string __itemAttribute(xmlNodePtr node, const char *name, bool *present)
{
	xmlChar *value = xmlGetProp(node, BAD_CAST name);
	if (present)
		*present = value != nullptr;
	if (!value)
		return std::string();
	std::string result(reinterpret_cast<const char *>(value));
	xmlFree(value);
	return result;
}

void __readItem(xmlNodePtr node, CvtItemList &items)
{
	const std::string type = __itemAttribute(node, "todo_item_type", nullptr);
	CvtItem item;
	if (type == "1")
		item.isCheck = true;
	else if (type != "0")
		return;
	if (item.isCheck) {
		bool hasState = false;
		const std::string state = __itemAttribute(node, "todo_item_state", &hasState);
		item.checked = hasState && state != "false";
	}
	item.markup = __itemAttribute(node, "todo_item_content", nullptr);
	items.push_back(item);
}

bool __isItem(xmlNodePtr node)
{
	return node->type == XML_ELEMENT_NODE && xmlStrEqual(node->name, BAD_CAST "todolist_item");
}

// Visits the tree in document order without recursion, whatever its depth.
void __collectItems(xmlNodePtr root, CvtItemList &items)
{
	xmlNodePtr node = root;
	while (node) {
		if (__isItem(node))
			__readItem(node, items);
		if (node->children && node->type == XML_ELEMENT_NODE) {
			node = node->children;
			continue;
		}
		while (node && !node->next && node != root)
			node = node->parent;
		if (!node || node == root)
			break;
		node = node->next;
	}
}
} // namespace

CvtItemList cvtReadTodoList(const std::string &document)
{
	CvtItemList items;
	if (document.empty())
		return items;
	if (document.find("<!DOCTYPE") != std::string::npos) {
		CVT_LOGE("document with a DTD refused");
		return items;
	}
	if (document.size() > INT_MAX) {
		CVT_LOGE("document too large (%zu bytes)", document.size());
		return items;
	}
	xmlParserCtxtPtr context = xmlNewParserCtxt();
	if (!context) {
		CVT_LOGE("xmlNewParserCtxt failed");
		return items;
	}
	if (context->sax)
		context->sax->serror = __ignoreXmlErrorCb;
	xmlDocPtr doc = xmlCtxtReadMemory(context, document.data(), static_cast<int>(document.size()), nullptr, "UTF-8",
	                                  XML_PARSE_RECOVER | XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING);
	if (!context->wellFormed)
		CVT_LOGI("document is not well-formed, reading what can be recovered");
	if (doc) {
		__collectItems(xmlDocGetRootElement(doc), items);
		xmlFreeDoc(doc);
	}
	xmlFreeParserCtxt(context);
	return items;
}

std::string cvtWriteTodoList(const CvtItemList &items)
{
	if (items.empty())
		return std::string();
	xmlBufferPtr buffer = xmlBufferCreate();
	if (!buffer) {
		CVT_LOGE("xmlBufferCreate failed");
		return std::string();
	}
	xmlTextWriterPtr writer = xmlNewTextWriterMemory(buffer, 0);
	if (!writer) {
		CVT_LOGE("xmlNewTextWriterMemory failed");
		xmlBufferFree(buffer);
		return std::string();
	}
	xmlTextWriterSetIndent(writer, 1);
	xmlTextWriterSetIndentString(writer, BAD_CAST "");
	int rc = xmlTextWriterStartDocument(writer, nullptr, "UTF-8", nullptr);
	if (rc >= 0)
		rc = xmlTextWriterStartElement(writer, BAD_CAST "todolist");
	for (size_t i = 0; rc >= 0 && i < items.size(); ++i) {
		const CvtItem &item = items[i];
		// Left out rather than replaced: the stored document keeps what the editor can show.
		const std::string content = cvtValidUtf8(item.markup, CVT_XML_DROP);
		rc = xmlTextWriterStartElement(writer, BAD_CAST "todolist_item");
		if (rc >= 0)
			rc = xmlTextWriterWriteAttribute(writer, BAD_CAST "todo_item_type", BAD_CAST(item.isCheck ? "1" : "0"));
		if (rc >= 0)
			rc = xmlTextWriterWriteAttribute(writer, BAD_CAST "todo_item_state",
			                                 BAD_CAST(item.isCheck && item.checked ? "true" : "false"));
		if (rc >= 0)
			rc = xmlTextWriterWriteAttribute(writer, BAD_CAST "todo_item_content", BAD_CAST content.c_str());
		if (rc >= 0)
			rc = xmlTextWriterEndElement(writer);
	}
	if (rc >= 0)
		rc = xmlTextWriterEndElement(writer);
	if (rc >= 0)
		rc = xmlTextWriterEndDocument(writer);
	xmlFreeTextWriter(writer);
	std::string result;
	if (rc < 0) {
		CVT_LOGE("todolist writer failed (%d)", rc);
	} else {
		const char *text = reinterpret_cast<const char *>(xmlBufferContent(buffer));
		const char *root = text ? strstr(text, "<todolist>") : nullptr;
		if (root)
			result = root;
	}
	xmlBufferFree(buffer);
	return result;
}
