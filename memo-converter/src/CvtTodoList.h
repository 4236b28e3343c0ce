#ifndef MEMO_CONVERTER_SRC_CVTTODOLIST_H
#define MEMO_CONVERTER_SRC_CVTTODOLIST_H

#include "CvtItem.h"

#include <string>

// Reads the items of a todolist document. Type "0" is text, "1" check, anything else (or none)
// gives no item; a check is ticked unless its state is exactly "false"; a missing content is
// empty. A malformed document is read in the parser's recovery mode, which keeps what came
// before the fault. A document with a DTD is refused whole (logged), as the editor never writes one.
CvtItemList cvtReadTodoList(const std::string &document);

// Writes `items` as a todolist document in the editor's layout: no declaration, "<todolist>",
// one self-closed item per line, "</todolist>\n". Empty items are kept. No items: "".
std::string cvtWriteTodoList(const CvtItemList &items);

#endif
