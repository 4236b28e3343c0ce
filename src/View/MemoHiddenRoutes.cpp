// Where the hidden memos lead on to the search and the selection of memos.
#include "View/MemoHiddenRoutes.h"

#include <WNaviframeController.h>

#include "MemoLog.h"
#include "View/MemoSearchView.h"
#include "View/MemoSelectionView.h"

bool memoHiddenPushListPage(app_assist::WNaviframeController *naviframe, MemoHiddenListPage page, int mode)
{
	if (!naviframe) {
		MEMO_LOGE("Naviframe is NULL");
		return false;
	}
	if (page == MemoHiddenListPage::SELECTION)
		return naviframe->push(new MemoSelectionView(mode));
	MemoSearchView *search = new MemoSearchView();
	// The search reads the grid mode when it is created.
	search->gridMode = mode;
	return naviframe->push(search);
}
