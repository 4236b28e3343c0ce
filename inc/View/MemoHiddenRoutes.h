#ifndef INC_VIEW_MEMOHIDDENROUTES_H
#define INC_VIEW_MEMOHIDDENROUTES_H

namespace app_assist
{
class WNaviframeController;
}

// The pages of the memo grid that the hidden memos lead on to.
enum class MemoHiddenListPage {
	SELECTION, // MemoSelectionView: mode 1 chooses the hidden memos, mode 4 deletes in hidden mode
	SEARCH,    // MemoSearchView: grid mode 5 searches every memo
};

// Pushes the page in the mode on the naviframe; false (logged) when it could not be pushed.
bool memoHiddenPushListPage(app_assist::WNaviframeController *naviframe, MemoHiddenListPage page, int mode);

#endif
