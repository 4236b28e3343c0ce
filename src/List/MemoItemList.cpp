#include "List/MemoItemList.h"

#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"

MemoItemList::MemoItemList() {}

MemoItemList::~MemoItemList()
{
	__clearList();
}

void MemoItemList::appendItem(MemoDocInfo *item)
{
	if (!item) {
		MEMO_LOGE("input is NULL");
		return;
	}
	__list.push_back(item);
}

MemoDocInfo *MemoItemList::getItem(int index)
{
	if (__list.empty()) {
		MEMO_LOGE("__list is NULL");
		return nullptr;
	}
	if (index < 0 || static_cast<size_t>(index) >= __list.size())
		return nullptr;
	return __list[static_cast<size_t>(index)];
}

int MemoItemList::getCount()
{
	if (__list.empty()) {
		MEMO_LOGE("__list is NULL");
		return 0;
	}
	return static_cast<int>(__list.size());
}

void MemoItemList::__clearList()
{
	if (__list.empty()) {
		MEMO_LOGE("__list is NULL");
		return;
	}
	for (MemoDocInfo *item : __list)
		delete item;
	__list.clear();
	__list.shrink_to_fit();
}
