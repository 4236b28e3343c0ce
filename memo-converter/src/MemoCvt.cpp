#include "MemoCvt.h"

#include "CvtExchangeXml.h"
#include "CvtItem.h"
#include "CvtLog.h"
#include "CvtMarkup.h"
#include "CvtTextForms.h"
#include "CvtTodoList.h"
#include "CvtUtf8.h"

namespace
{
// What the quick memo append writes around its text, unescaped.
const char QUICK_ITEM_HEAD[] = "<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"";
const char QUICK_ITEM_TAIL[] = "\"/></todolist>";
} // namespace

MemoCvt::MemoCvt(_MemoCvtSrcDbType type, std::string source) : __source(std::move(source))
{
	if (type != MEMO_CVT_SRC_TODOLIST) {
		CVT_LOGE("unsupported source type %d", static_cast<int>(type));
		__source.clear();
		return;
	}
	__items = cvtReadTodoList(__source);
}

MemoCvt::~MemoCvt() {}

std::string MemoCvt::getContent()
{
	return cvtContentText(__items);
}

std::string MemoCvt::getXmlContent()
{
	return cvtExchangeXml(__items);
}

std::string MemoCvt::getTizenXmlContent()
{
	return cvtWriteTodoList(__items);
}

std::string MemoCvt::getDisplayContent()
{
	return cvtDisplayText(__items);
}

std::string MemoCvt::getStrippedContent()
{
	return cvtStrippedText(__items);
}

void MemoCvt::addQuickMemoItem(std::string text)
{
	// The appended item carries the text unescaped, so it may have cut the read short or come
	// back changed: read the document as it was before the append and add the text properly. The
	// append took the place of the first "</todolist>", which need not end the document, so the
	// item is looked for wherever it stands; what stood behind that root was never part of the body.
	const std::string appended = QUICK_ITEM_HEAD + text + QUICK_ITEM_TAIL;
	const size_t pos = __source.find(appended);
	if (pos != std::string::npos)
		__items = cvtReadTodoList(__source.substr(0, pos) + "</todolist>");
	CvtItem item;
	// Control characters would make the stored document unreadable.
	item.markup = cvtPlainToMarkup(cvtValidUtf8(text, CVT_XML_DROP));
	__items.push_back(item);
	CVT_LOGI("quick memo item added, %zu items", __items.size());
}
