#ifndef TESTS_CONVERTER_TODOLIST_FIXTURE_H
#define TESTS_CONVERTER_TODOLIST_FIXTURE_H

// Building and reading todolist documents in the converter tests.
#include "Box/MemoTodoListDocument.h"

#include <cstdlib>
#include <string>
#include <vector>

namespace todolist_test
{
inline MemoTodoListItem item(_MemoBoxItemType type, bool checked, const std::string &content)
{
	MemoTodoListItem i;
	i.type = type;
	i.checked = checked;
	i.content = content;
	return i;
}

inline std::string compose(const std::vector<MemoTodoListItem> &items)
{
	char *xml = memoComposeTodoListXmlN(items);
	std::string result = xml;
	free(xml);
	return result;
}

inline std::vector<MemoTodoListItem> parse(const std::string &xml, bool *ok = nullptr, size_t existing = 0)
{
	std::vector<MemoTodoListItem> items;
	const bool result = memoParseTodoListXml(xml.c_str(), items, existing);
	if (ok)
		*ok = result;
	return items;
}
} // namespace todolist_test

#endif
