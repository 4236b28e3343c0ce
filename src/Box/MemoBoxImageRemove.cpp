// Taking image tags out of a box item and listing the pictures it holds.
#include "Box/MemoBoxItem.h"

#include <string>

#include "Box/MemoBoxImageMarkup.h"
#include "MemoLog.h"

bool MemoBoxItem::removeImageByPath(const char *path)
{
	if (!path) {
		MEMO_LOGE("path is null.");
		return false;
	}
	if (!__entryObj) {
		MEMO_LOGE("__entryObj is NULL");
		return false;
	}
	const int cursor = elm_entry_cursor_pos_get(__entryObj);
	const char *current = elm_entry_entry_get(__entryObj);
	std::string markup = current ? current : "";
	if (!memoBoxImageEraseByPath(markup, path)) {
		MEMO_LOGE("Can not find this image");
		return false;
	}
	elm_entry_entry_set(__entryObj, markup.c_str());
	elm_entry_cursor_pos_set(__entryObj, cursor + 1);
	return true;
}

bool MemoBoxItem::deleteImage(const char *path)
{
	if (!path) {
		MEMO_LOGE("path is null.");
		return false;
	}
	if (!__entryObj) {
		MEMO_LOGE("__entryObj is NULL");
		return false;
	}
	const char *current = elm_entry_entry_get(__entryObj);
	std::string markup = current ? current : "";
	if (!memoBoxImageEraseTag(markup, path)) {
		MEMO_LOGE("Can not find this image");
		return false;
	}
	elm_entry_entry_set(__entryObj, markup.c_str());
	return true;
}

Eina_List *MemoBoxItem::getImgList()
{
	void *old = nullptr;
	EINA_LIST_FREE(__imgPathList, old)
	free(old);

	const std::vector<std::string> paths = memoBoxImagePaths(__entryObj ? elm_entry_entry_get(__entryObj) : nullptr);
	for (const std::string &path : paths)
		__imgPathList = eina_list_append(__imgPathList, strdup(path.c_str()));
	if (!__imgPathList)
		MEMO_LOGI("There is no image in this box item");
	return __imgPathList;
}
