// Inserting pictures into a box item's entry as item tags sized for this display.
#include "Box/MemoBoxItem.h"

#include <Ecore_File.h>
#include <app_i18n.h>
#include <notification_status.h>

#include <string>

#include "Box/MemoBoxImageSize.h"
#include "MemoLog.h"

namespace
{
// Whether the cursor stands away from the line's left edge, so that a tag needs a break in front. The
// cursor's x is taken from where the text starts, not from the entry's padded edge.
bool cursorPastLeftEdge(Evas_Object *entry)
{
	Evas_Coord cursorX = 0, entryX = 0, textX = 0;
	elm_entry_cursor_geometry_get(entry, &cursorX, nullptr, nullptr, nullptr);
	evas_object_geometry_get(entry, &entryX, nullptr, nullptr, nullptr);
	Evas_Object *textblock = elm_entry_textblock_get(entry);
	if (textblock)
		evas_object_geometry_get(textblock, &textX, nullptr, nullptr, nullptr);
	else
		textX = entryX;
	return cursorX - (textX - entryX) > 10 * elm_config_scale_get() / elm_app_base_scale_get();
}
} // namespace

bool MemoBoxItem::__canEditImage(const char *path) const
{
	if (!path) {
		MEMO_LOGE("path is null.");
		return false;
	}
	if (!__entryObj) {
		MEMO_LOGE("__entryObj is NULL");
		return false;
	}
	return true;
}

bool MemoBoxItem::insertImage(const char *path)
{
	if (!__canEditImage(path))
		return false;
	int pictureWidth = 0, pictureHeight = 0;
	if (!memoBoxImageProbe(evas_object_evas_get(__entryObj), path, &pictureWidth, &pictureHeight, nullptr)) {
		MEMO_LOGE("This file can not insert to entry.");
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_RESOLUTION_NOT_SUPPORTED_BY_MEMO"));
		ecore_file_recursive_rm(path);
		return false;
	}
	int width = 0, defaultHeight = 0;
	if (memoBoxItemIsCheck(__type))
		__getImgSizeCheckType(&width, &defaultHeight);
	else
		__getImgSizeTextType(&width, &defaultHeight);
	const int height = memoBoxImageTagHeight(pictureWidth, pictureHeight, width, defaultHeight);
	const std::string tag = memoBoxImageTag(width, height, path, cursorPastLeftEdge(__entryObj));

	if (__isEditable)
		elm_object_focus_set(__entryObj, EINA_TRUE);
	elm_entry_entry_insert(__entryObj, tag.c_str());
	return true;
}

bool MemoBoxItem::insertImages(Eina_List *list)
{
	if (!list) {
		MEMO_LOGE("insertList is NULL");
		return false;
	}
	if (eina_list_count(list) == 0) {
		MEMO_LOGE("List count is NULL");
		return false;
	}
	if (!__entryObj) {
		MEMO_LOGE("__entryObj is NULL");
		return false;
	}
	// Unlike insertImage, a picture that cannot be read still gets its tag (at the default height).
	std::string tags = cursorPastLeftEdge(__entryObj) ? "<br/>" : "";
	Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(list, l, data)
	{
		const char *path = static_cast<const char *>(data);
		if (!path)
			continue;
		int width = 0, height = 0;
		__getImgDisplaySize(path, &width, &height);
		tags += memoBoxImageTag(width, height, path, false);
	}
	if (__isEditable)
		elm_object_focus_set(__entryObj, EINA_TRUE);
	elm_entry_entry_insert(__entryObj, tags.c_str());
	return true;
}
