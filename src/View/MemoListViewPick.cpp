// The list's answer to a pick request (the reply is shared with the search view).
#include "View/MemoListView.h"

#include "List/MemoGridItem.h"
#include "View/MemoPickReply.h"

void MemoListView::__sendPickResult(MemoGridItem *item)
{
	memoSendPickReply(item ? item->getDocInfo() : nullptr, __pickRequest);
}
