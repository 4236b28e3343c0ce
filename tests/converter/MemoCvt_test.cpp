// The converter's stored forms, the quick memo append, and its behaviour on bad input.
#include "Box/MemoTodoListDocument.h"
#include "MemoCvt.h"

#include <gtest/gtest.h>
#include <libxml/parser.h>
#include <libxml/tree.h>

#include <cstdlib>
#include <string>
#include <vector>

namespace
{
MemoTodoListItem item(_MemoBoxItemType type, bool checked, const std::string &content)
{
	MemoTodoListItem i;
	i.type = type;
	i.checked = checked;
	i.content = content;
	return i;
}

std::string compose(const std::vector<MemoTodoListItem> &items)
{
	char *xml = memoComposeTodoListXmlN(items);
	std::string result = xml;
	free(xml);
	return result;
}

std::vector<MemoTodoListItem> readBack(const std::string &xml)
{
	std::vector<MemoTodoListItem> items;
	if (!xml.empty())
		memoParseTodoListXml(xml.c_str(), items);
	return items;
}

size_t countOf(const std::string &text, const std::string &what)
{
	size_t n = 0;
	for (size_t pos = text.find(what); pos != std::string::npos; pos = text.find(what, pos + 1))
		++n;
	return n;
}

// Strict parse: null when the document is not well-formed.
xmlDocPtr strictParse(const std::string &xml)
{
	return xmlReadMemory(xml.data(), static_cast<int>(xml.size()), nullptr, nullptr,
	                     XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING);
}

bool isValidUtf8(const std::string &s)
{
	return xmlCheckUTF8(reinterpret_cast<const unsigned char *>(s.c_str())) && s.find('\0') == std::string::npos;
}

// The quick memo append as the store runs it against the stored document.
std::string quickDocument(std::string stored, const std::string &text)
{
	if (stored.find("</todolist>") == std::string::npos)
		stored = "<todolist></todolist>";
	const size_t end = stored.find("</todolist>");
	return stored.replace(end, 11,
	                      "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"" + text +
	                          "\"/></todolist>");
}

std::string quickAppend(const std::string &stored, const std::string &text, std::string *display = nullptr)
{
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, quickDocument(stored, text));
	cvt.addQuickMemoItem(text);
	if (display)
		*display = cvt.getDisplayContent();
	return cvt.getTizenXmlContent();
}

const std::string MIXED = compose({
    item(MEMO_BOX_ITEM_FIRST_TEXT, false,
         "Tom &amp; Jerry &lt;3<br/>line2<br/><item size=240x180 vsize=full href=file:///m/a b.jpg></item><br/>tail"),
    item(MEMO_BOX_ITEM_CHECK, true, "milk &amp; eggs"),
    item(MEMO_BOX_ITEM_CHECK, false, "bread<br/>butter"),
    item(MEMO_BOX_ITEM_TEXT, false, "bye"),
});
} // namespace

TEST(MemoCvtForms, TextFormsOfMixedMemo)
{
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, MIXED);
	EXPECT_EQ("Tom & Jerry \xEF\xBC\x9C"
	          "3\nline2\n\ntail\n<CHECK state=true>milk & eggs</CHECK><CHECK state=false>bread butter</CHECK>bye",
	          cvt.getDisplayContent());
	EXPECT_EQ("Tom & Jerry <3\nline2\n\ntail\nmilk & eggs\nbread\nbutter\nbye", cvt.getStrippedContent());
	EXPECT_EQ("Tom & Jerry <3\nline2\n\ntail\n[x] milk & eggs\n[ ] bread butter\nbye", cvt.getContent());
	// The document of an unchanged body is the editor's own document, byte for byte.
	EXPECT_EQ(MIXED, cvt.getTizenXmlContent());
}

TEST(MemoCvtForms, ExchangeDocumentKeepsTypesStatesAndImages)
{
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, MIXED);
	const std::string xml = cvt.getXmlContent();
	xmlDocPtr doc = strictParse(xml);
	ASSERT_NE(nullptr, doc) << xml;
	xmlNodePtr root = xmlDocGetRootElement(doc);
	ASSERT_STREQ("memo", reinterpret_cast<const char *>(root->name));
	std::vector<std::string> kinds;
	for (xmlNodePtr n = root->children; n; n = n->next) {
		if (n->type != XML_ELEMENT_NODE)
			continue;
		xmlChar *type = xmlGetProp(n, BAD_CAST "type");
		xmlChar *checked = xmlGetProp(n, BAD_CAST "checked");
		kinds.push_back(std::string((char *)type) + "/" + (char *)checked);
		xmlFree(type);
		xmlFree(checked);
	}
	EXPECT_EQ((std::vector<std::string>{"text/false", "check/true", "check/false", "text/false"}), kinds);
	xmlNodePtr first = xmlFirstElementChild(root);
	xmlChar *text = xmlNodeGetContent(first);
	EXPECT_STREQ("Tom & Jerry <3line2tail", reinterpret_cast<char *>(text));
	xmlFree(text);
	int breaks = 0;
	for (xmlNodePtr n = first->children; n; n = n->next) {
		if (n->type == XML_ELEMENT_NODE && xmlStrEqual(n->name, BAD_CAST "br"))
			++breaks;
		if (n->type == XML_ELEMENT_NODE && xmlStrEqual(n->name, BAD_CAST "image")) {
			xmlChar *href = xmlGetProp(n, BAD_CAST "href");
			xmlChar *width = xmlGetProp(n, BAD_CAST "width");
			EXPECT_STREQ("/m/a b.jpg", reinterpret_cast<char *>(href));
			EXPECT_STREQ("240", reinterpret_cast<char *>(width));
			xmlFree(href);
			xmlFree(width);
		}
	}
	EXPECT_EQ(3, breaks);
	xmlFreeDoc(doc);
}

TEST(MemoCvtForms, EmptySource)
{
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, "");
	EXPECT_EQ("", cvt.getContent());
	EXPECT_EQ("", cvt.getDisplayContent());
	EXPECT_EQ("", cvt.getStrippedContent());
	EXPECT_EQ("", cvt.getTizenXmlContent());
	xmlDocPtr doc = strictParse(cvt.getXmlContent());
	EXPECT_NE(nullptr, doc);
	xmlFreeDoc(doc);
	// A root without items is an empty body too.
	EXPECT_EQ("", MemoCvt(MEMO_CVT_SRC_TODOLIST, "<todolist></todolist>").getDisplayContent());
}

TEST(MemoCvtQuickMemo, AppendWithQuoteAngleBracketsAndBreak)
{
	const std::string text = "say \"hi\" &amp; <b>\nnext";
	std::string display;
	const std::string first = quickAppend("", text, &display);
	EXPECT_EQ("say \"hi\" & \xEF\xBC\x9C"
	          "b\xEF\xBC\x9E\nnext",
	          display);
	std::vector<MemoTodoListItem> items = readBack(first);
	ASSERT_EQ(1u, items.size());
	EXPECT_EQ(MEMO_BOX_ITEM_FIRST_TEXT, items[0].type);
	EXPECT_EQ("say \"hi\" &amp; &lt;b&gt;<br/>next", items[0].content);

	// A second text lands behind the first, and each text is there once.
	const std::string second = quickAppend(first, "two & \"more\"");
	items = readBack(second);
	ASSERT_EQ(2u, items.size());
	EXPECT_EQ("two &amp; \"more\"", items[1].content);
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, second);
	EXPECT_EQ(1u, countOf(cvt.getStrippedContent(), "say \"hi\""));
	EXPECT_EQ(1u, countOf(cvt.getStrippedContent(), "two & \"more\""));
}

TEST(MemoCvtQuickMemo, StoredDocumentEdgeCases)
{
	// Earlier items, check states included, survive the append.
	const std::string stored =
	    compose({item(MEMO_BOX_ITEM_FIRST_CHECK, true, "a"), item(MEMO_BOX_ITEM_TEXT, false, "b")});
	std::vector<MemoTodoListItem> items = readBack(quickAppend(stored, "c"));
	ASSERT_EQ(3u, items.size());
	EXPECT_TRUE(items[0].checked);
	EXPECT_EQ("c", items[2].content);

	// Text without a closing root is replaced by the new item alone.
	items = readBack(quickAppend("old text", "new"));
	ASSERT_EQ(1u, items.size());
	EXPECT_EQ("new", items[0].content);

	// An empty text adds an empty item.
	items = readBack(quickAppend(stored, ""));
	ASSERT_EQ(3u, items.size());
	EXPECT_EQ("", items[2].content);

	// A source that does not end with the appended item still gets the text once, at the end.
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, stored);
	cvt.addQuickMemoItem("z");
	items = readBack(cvt.getTizenXmlContent());
	ASSERT_EQ(3u, items.size());
	EXPECT_EQ("z", items[2].content);
}

TEST(MemoCvtRobustness, CutDocumentKeepsLeadingItems)
{
	std::vector<MemoTodoListItem> items;
	for (int i = 0; i < 60; ++i)
		items.push_back(item(MEMO_BOX_ITEM_CHECK, i % 2, "n" + std::to_string(i) + " " + std::string(1000, 'y')));
	const std::string cut = compose(items);
	ASSERT_EQ(40959u, cut.size());
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, cut);
	const std::string display = cvt.getDisplayContent();
	EXPECT_NE(std::string::npos, display.find("<CHECK state=true>n1 y"));
	EXPECT_NE(std::string::npos, display.find("n30 y"));
	EXPECT_EQ(std::string::npos, display.find("n59 y"));
	xmlDocPtr doc = strictParse(cvt.getXmlContent());
	EXPECT_NE(nullptr, doc);
	xmlFreeDoc(doc);
}

TEST(MemoCvtRobustness, MalformedInputGivesValidForms)
{
	const std::vector<std::string> inputs = {
	    "<todolist",
	    "<<<>>>&&&;;",
	    "\xff\xfe\x00x",
	    std::string("<todolist>\n<todolist_item todo_item_type=\"0\" todo_item_content=\"a\0b\"/>", 60),
	    "<!DOCTYPE t [<!ENTITY a \"aaaaaaaaaa\"><!ENTITY b \"&a;&a;&a;&a;\">]><todolist/>",
	    "<todolist><todolist_item todo_item_type=\"1\" todo_item_state=\"false\" "
	    "todo_item_content=\"\xff\xc3 &#1; &amp;#0; &amp;#xD800; &lt;item href=&lt;br\"/></todolist>",
	    "<todolist><todolist_item todo_item_type=\"0\" todo_item_content=\"say \"hi\"\"/></todolist>",
	    "<todolist>" + std::string(300, '<') + "</todolist>",
	};
	for (const std::string &input : inputs) {
		MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, input);
		EXPECT_TRUE(isValidUtf8(cvt.getDisplayContent())) << input;
		EXPECT_TRUE(isValidUtf8(cvt.getStrippedContent())) << input;
		EXPECT_TRUE(isValidUtf8(cvt.getContent())) << input;
		xmlDocPtr doc = strictParse(cvt.getXmlContent());
		EXPECT_NE(nullptr, doc) << input;
		xmlFreeDoc(doc);
		const std::string tizen = cvt.getTizenXmlContent();
		if (!tizen.empty()) {
			doc = strictParse(tizen);
			EXPECT_NE(nullptr, doc) << input;
			xmlFreeDoc(doc);
		}
	}
}

TEST(MemoCvtRobustness, HugeItem)
{
	// Bigger than the editor ever stores, so made by hand.
	const std::string big(2 * 1024 * 1024, 'w');
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, "<todolist><todolist_item todo_item_type=\"0\" todo_item_content=\"" + big +
	                                       "&amp;amp;&lt;br/&gt;\"/></todolist>");
	const std::string stripped = cvt.getStrippedContent();
	EXPECT_EQ(big.size() + 2, stripped.size());
	EXPECT_TRUE(stripped == big + "&\n");
	EXPECT_EQ(big.size() + 2, cvt.getContent().size());
	EXPECT_GT(cvt.getTizenXmlContent().size(), big.size());
}
