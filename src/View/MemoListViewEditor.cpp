// The one road from the list to the editor.
#include "View/MemoListView.h"

#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"

// The editor on record read-only (MemoEditView(record, false, false)), or on a new memo for a null record.
// Until the editor is wired here the list stays as it is.
void MemoListView::__pushEditView(MemoDocInfo *record)
{
	MEMO_LOGI("open the editor on %s", record ? record->getMemoUUID() : "a new memo");
	__showFloatingButton();
	__isTopView = true;
}
