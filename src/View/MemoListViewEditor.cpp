// The one road from the list to the editor.
#include "View/MemoListView.h"

#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "View/MemoEditView.h"

// The editor on the record read-only, or on a new memo for a null record. The editor does not own the record
// it is given, and the grid's records may be reloaded while it is open (a rotation), so it gets a fresh copy
// that the list keeps until it is on top again.
void MemoListView::__pushEditView(MemoDocInfo *record)
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	if (!naviframe) {
		MEMO_LOGE("no naviframe to open the editor on");
		return;
	}
	delete __openedRecord;
	__openedRecord = nullptr;
	if (record) {
		__openedRecord = MemoDbMgr::getInstance()->getOneMemoN(record->getMemoUUID());
		if (!__openedRecord) {
			MEMO_LOGE("the memo %s is gone", record->getMemoUUID());
			__showFloatingButton();
			__isTopView = true;
			return;
		}
	}
	naviframe->push(new MemoEditView(__openedRecord, false, false));
}
