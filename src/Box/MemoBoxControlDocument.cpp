// The box control and the todolist document: body items from a stored document, and back.
#include "Box/MemoBoxControl.h"

#include <vector>

#include "Box/MemoBoxItem.h"
#include "Box/MemoTodoListDocument.h"
#include "MemoLog.h"

void MemoBoxControl::__composeBoxItemFromXml(const char *xml)
{
	std::vector<MemoTodoListItem> parsed;
	memoParseTodoListXml(xml, parsed, eina_list_count(__itemList));
	for (const MemoTodoListItem &entry : parsed) {
		MemoBoxItem *item = __createItem(entry.type);
		if (!item)
			continue;
		// The tick comes first, so that the text and its pictures take the ticked look.
		if (memoBoxItemIsCheck(entry.type) && entry.checked)
			item->setCheckStatus(true);
		// Through the entry filter, like typed text: image sizes fit this display, limits apply.
		item->insertText(entry.content.c_str());
		__appendItem(item);
		if (item->getEntry())
			elm_entry_cursor_end_set(item->getEntry());
	}
}

char *MemoBoxControl::getTodoListXmlN()
{
	MemoTodoListWriter writer;
	Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(__itemList, l, data)
	{
		MemoBoxItem *item = static_cast<MemoBoxItem *>(data);
		if (!item->getEntry() || MemoBoxItem::isEntryEmpty(item->getEntry()))
			continue;
		const _MemoBoxItemType type = item->getType();
		const bool checked = memoBoxItemIsCheck(type) && item->getCheckStatus();
		char *markup = item->getContentMarkupN();
		const bool added = writer.addItem(type, checked, markup);
		free(markup);
		if (!added)
			break;
	}
	return writer.finishN();
}
