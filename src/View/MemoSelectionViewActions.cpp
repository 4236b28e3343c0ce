// The selection view's actions: delete the ticked memos, or state the whole hidden set at once.
#include "View/MemoSelectionView.h"

#include <cstdlib>
#include <cstring>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridControl.h"
#include "List/MemoItemList.h"

// Flag i belongs to row i of a fresh read in the grid's order; each removal decides soft or outright itself.
void MemoSelectionView::__deleteChosen()
{
	MemoDbMgr *db = MemoDbMgr::getInstance();
	MemoItemList *list = __readListN();
	const int *flags = __grid->getCheckStates();
	const int count = list->getCount();
	for (int row = 0; flags && row < count && row < __grid->getItemCount(); ++row)
		if (flags[row] == 1)
			db->removeMemo(list->getItem(row)->getMemoUUID());
	delete list;
	if (__isTop())
		popOut();
}

// Ticked memos are hidden and every other normal memo is shown: an empty choice unhides them all.
void MemoSelectionView::__setHiddenChosen()
{
	MemoDbMgr *db = MemoDbMgr::getInstance();
	MemoItemList *list = db->getAllNormalMemoListN();
	const int *flags = __grid->getCheckStates();
	const int count = list->getCount();
	char **hidden = static_cast<char **>(calloc(static_cast<size_t>(count) + 1, sizeof(char *)));
	char **shown = static_cast<char **>(calloc(static_cast<size_t>(count) + 1, sizeof(char *)));
	int hiddenCount = 0;
	int shownCount = 0;
	for (int row = 0; row < count; ++row) {
		char *uuid = strdup(list->getItem(row)->getMemoUUID());
		if (flags && row < __grid->getItemCount() && flags[row] == 1)
			hidden[hiddenCount++] = uuid;
		else
			shown[shownCount++] = uuid;
	}
	db->setHiddenMemos(hidden, hiddenCount);
	db->setUnhiddenMemos(shown, shownCount);
	for (int i = 0; i < hiddenCount; ++i)
		free(hidden[i]);
	for (int i = 0; i < shownCount; ++i)
		free(shown[i]);
	free(hidden);
	free(shown);
	delete list;
	if (__isTop())
		popOut();
}
