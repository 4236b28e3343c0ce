// Fuzz target: arbitrary bytes as a stored todolist document, as quick memo text, and as entry
// markup. Besides not crashing, every document the code writes must be well-formed, and the
// editor's document must survive its own round trip.
// fuzz-sources: memo-converter/src/*.cpp src/Box/MemoTodoListReader.cpp src/Box/MemoTodoListWriter.cpp
// fuzz-sources: src/Box/MemoContentMarkup.cpp src/Util/MemoUtilText.cpp
// fuzz-pkgs: libxml-2.0
#include "Box/MemoContentMarkup.h"
#include "Box/MemoTodoListDocument.h"
#include "MemoCvt.h"

#include <libxml/parser.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

namespace
{
void __ignoreXmlErrorCb(void *, xmlErrorPtr) {}

void requireWellFormed(const std::string &xml)
{
	if (xml.empty())
		return;
	xmlDocPtr doc = xmlReadMemory(xml.data(), static_cast<int>(xml.size()), nullptr, nullptr,
	                              XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING);
	if (!doc)
		abort();
	xmlFreeDoc(doc);
}

void requireUtf8(const std::string &text)
{
	if (text.find('\0') != std::string::npos || !xmlCheckUTF8(reinterpret_cast<const xmlChar *>(text.c_str())))
		abort();
}

void exerciseConverter(const std::string &source)
{
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, source);
	requireUtf8(cvt.getContent());
	requireUtf8(cvt.getDisplayContent());
	requireUtf8(cvt.getStrippedContent());
	requireWellFormed(cvt.getXmlContent());
	requireWellFormed(cvt.getTizenXmlContent());
}

// The quick memo append as the store builds it, with the second half of the input as text.
void exerciseQuickMemo(const std::string &stored, const std::string &text)
{
	std::string doc = stored;
	if (doc.find("</todolist>") == std::string::npos)
		doc = "<todolist></todolist>";
	doc.replace(doc.find("</todolist>"), 11,
	            "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"" + text +
	                "\"/></todolist>");
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, doc);
	cvt.addQuickMemoItem(text);
	const std::string tizen = cvt.getTizenXmlContent();
	requireWellFormed(tizen);
	std::vector<MemoTodoListItem> items;
	if (!memoParseTodoListXml(tizen.c_str(), items))
		abort();
	requireWellFormed(cvt.getXmlContent());
	requireUtf8(cvt.getDisplayContent());
}

// What the editor reads it writes again, and reading that gives the same items.
void exerciseEditorDocument(const char *text)
{
	std::vector<MemoTodoListItem> items;
	memoParseTodoListXml(text, items);
	char *written = memoComposeTodoListXmlN(items);
	if (!written)
		return;
	const size_t length = strlen(written);
	if (length > 0 && length < MEMO_TODOLIST_BUFFER_SIZE - 1) {
		requireWellFormed(written);
		std::vector<MemoTodoListItem> kept;
		for (const MemoTodoListItem &item : items) {
			if (!item.content.empty())
				kept.push_back(item);
		}
		std::vector<MemoTodoListItem> again;
		memoParseTodoListXml(written, again);
		if (again.size() != kept.size())
			abort();
		for (size_t i = 0; i < kept.size(); ++i) {
			if (again[i].content != kept[i].content || again[i].checked != kept[i].checked ||
			    memoBoxItemIsCheck(again[i].type) != memoBoxItemIsCheck(kept[i].type))
				abort();
		}
	}
	free(written);
}
} // namespace

extern "C" int LLVMFuzzerInitialize(int *, char ***)
{
	xmlInitParser();
	xmlSetStructuredErrorFunc(nullptr, __ignoreXmlErrorCb);
	return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size)
{
	const std::string bytes(reinterpret_cast<const char *>(data), size);
	exerciseConverter(bytes);
	exerciseQuickMemo(bytes.substr(0, size / 2), bytes.substr(size / 2));

	const std::string text = bytes.c_str(); // up to the first NUL, as C strings arrive
	exerciseEditorDocument(text.c_str());
	free(memoSavedMarkupN(text.c_str()));
	return 0;
}
