// Where the hidden memos lead on to the search and the selection of memos.
#include "View/MemoHiddenRoutes.h"

#include <WNaviframeController.h>

#include "MemoLog.h"

bool memoHiddenPushListPage(app_assist::WNaviframeController *naviframe, MemoHiddenListPage page, int mode)
{
	if (!naviframe) {
		MEMO_LOGE("Naviframe is NULL");
		return false;
	}
	// WAITING FOR MemoSelectionView AND MemoSearchView: the one place that pushes them for the hidden memos.
	MEMO_LOGI("hidden memos: %s (mode %d) asked for; that view is not part of the app yet",
	          page == MemoHiddenListPage::SELECTION ? "MemoSelectionView" : "MemoSearchView", mode);
	return false;
}
