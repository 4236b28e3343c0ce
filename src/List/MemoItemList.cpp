#include "List/MemoItemList.h"

#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"

MemoItemList::MemoItemList() : __list(nullptr) {}

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
	__list = eina_list_append(__list, item);
}

MemoDocInfo *MemoItemList::getItem(int index)
{
	if (!__list) {
		MEMO_LOGE("__list is NULL");
		return nullptr;
	}
	if (index < 0)
		return nullptr;
	return static_cast<MemoDocInfo *>(eina_list_nth(__list, static_cast<unsigned int>(index)));
}

int MemoItemList::getCount()
{
	if (!__list) {
		MEMO_LOGE("__list is NULL");
		return 0;
	}
	return static_cast<int>(eina_list_count(__list));
}

void MemoItemList::__clearList()
{
	if (!__list) {
		MEMO_LOGE("__list is NULL");
		return;
	}
	void *data = nullptr;
	EINA_LIST_FREE(__list, data)
	delete static_cast<MemoDocInfo *>(data);
	__list = nullptr;
}
