// The images of the whole memo as the box control sees them; most operations act on the current item.
#include "Box/MemoBoxControl.h"

#include <cstring>

#include "Box/MemoBoxImageSize.h"
#include "Box/MemoBoxItem.h"
#include "MemoLog.h"

Eina_List *MemoBoxControl::getImageList()
{
	freeImageList();
	Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(__itemList, l, data) {
		Eina_List *paths = static_cast<MemoBoxItem *>(data)->getImgList();
		Eina_List *p = nullptr;
		void *path = nullptr;
		EINA_LIST_FOREACH(paths, p, path)
		__imagePathList = eina_list_append(__imagePathList, strdup(static_cast<const char *>(path)));
	}
	return __imagePathList;
}

void MemoBoxControl::freeImageList()
{
	void *path = nullptr;
	EINA_LIST_FREE(__imagePathList, path)
	free(path);
}

int MemoBoxControl::onEntryCheckImageCount()
{
	Eina_List *images = getImageList();
	if (!images) {
		MEMO_LOGI("image List is NULL.");
		return -1;
	}
	const int count = static_cast<int>(eina_list_count(images));
	if (count > MEMO_BOX_IMAGE_MAX_COUNT - 1)
		MEMO_LOGI("Maximum number of images(10) reached.");
	return count;
}

bool MemoBoxControl::insertImage(const char *path)
{
	if (!__currentItem) {
		MEMO_LOGE("__currentItem is NULL");
		return false;
	}
	return __currentItem->insertImage(path);
}

bool MemoBoxControl::insertImages(Eina_List *list)
{
	if (!__currentItem) {
		MEMO_LOGE("__currentItem is NULL");
		return false;
	}
	return __currentItem->insertImages(list);
}

bool MemoBoxControl::deleteImage(const char *path)
{
	if (!__currentItem) {
		MEMO_LOGE("__currentItem is NULL");
		return false;
	}
	return __currentItem->deleteImage(path);
}

const char *MemoBoxControl::getSelectedImagePath(int x, int y)
{
	if (x < 0 || y < 0) {
		MEMO_LOGE("invalid input.");
		return nullptr;
	}
	if (!__currentItem) {
		MEMO_LOGE("__currentItem is NULL");
		return nullptr;
	}
	return __currentItem->getSelectedImagePath(x, y);
}
