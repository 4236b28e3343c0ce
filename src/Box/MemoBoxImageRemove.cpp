// Taking image tags out of a box item and listing the pictures it holds.
#include "Box/MemoBoxItem.h"

#include <string>

#include "Box/MemoBoxImageMarkup.h"
#include "MemoLog.h"

bool MemoBoxItem::__eraseImageTag(const char *path, bool (*erase)(std::string &, const char *))
{
	if (!__canEditImage(path))
		return false;
	const char *current = elm_entry_entry_get(__entryObj);
	std::string markup = current ? current : "";
	if (!erase(markup, path)) {
		MEMO_LOGE("Can not find this image");
		return false;
	}
	elm_entry_entry_set(__entryObj, markup.c_str());
	return true;
}

bool MemoBoxItem::removeImageByPath(const char *path)
{
	const int cursor = __entryObj ? elm_entry_cursor_pos_get(__entryObj) : 0;
	if (!__eraseImageTag(path, memoBoxImageEraseByPath))
		return false;
	elm_entry_cursor_pos_set(__entryObj, cursor + 1);
	return true;
}

bool MemoBoxItem::deleteImage(const char *path)
{
	return __eraseImageTag(path, memoBoxImageEraseTag);
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
