// The objects that stand for image tags in a box item's entry, and finding the one under a point.
#include "Box/MemoBoxItem.h"

#include <Ecore_File.h>

#include <cstdlib>
#include <cstring>

#include "Box/MemoBoxImageSize.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
const char *const FILE_SCHEME = "file://";
const char *const PATH_KEY = "path";

// The "path" data of an image object is its own copy; it goes with the object.
void freePathCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	(void)eventInfo;
	free(data);
}

// The picture, decoded off the main loop at no more than the size it is shown at.
Evas_Object *addPicture(Evas_Object *parent, const char *path, int displayWidth)
{
	Evas_Object *image = evas_object_image_filled_add(evas_object_evas_get(parent));
	evas_object_image_file_set(image, path, nullptr);
	if (evas_object_image_load_error_get(image) != EVAS_LOAD_ERROR_NONE) {
		evas_object_del(image);
		return nullptr;
	}
	int w = 0, h = 0;
	evas_object_image_size_get(image, &w, &h);
	if (w <= 0 || h <= 0) {
		evas_object_del(image);
		return nullptr;
	}
	// Setting a load size after the file reloads the header only; pixels come with the preload.
	if (w > displayWidth)
		evas_object_image_load_size_set(image, displayWidth,
										static_cast<int>(static_cast<long long>(h) * displayWidth / w));
	evas_object_image_preload(image, EINA_FALSE);
	return image;
}
} // namespace

Evas_Object *MemoBoxItem::__onEntryItemProviderCb(void *data, Evas_Object *entry, const char *item)
{
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	if (!self || !item || strncmp(item, FILE_SCHEME, strlen(FILE_SCHEME)) != 0) {
		MEMO_LOGE("can not find item.");
		return nullptr;
	}
	const char *path = item + strlen(FILE_SCHEME);

	int displayWidth = 0, defaultHeight = 0;
	if (memoBoxItemIsCheck(self->__type))
		__getImgSizeCheckType(&displayWidth, &defaultHeight);
	else
		__getImgSizeTextType(&displayWidth, &defaultHeight);

	Evas_Object *layout = elm_layout_add(entry);
	Evas_Object *picture = ecore_file_exists(path) ? addPicture(layout, path, displayWidth) : nullptr;
	if (picture) {
		elm_layout_file_set(layout, MemoUtil::getEdjePath(), "image_layout");
		elm_object_part_content_set(layout, "image.swallow", picture);
		// A ticked line shows its pictures faded, like its struck-through text; decided once, here.
		if (memoBoxItemIsCheck(self->__type) && self->__checkObj && elm_check_state_get(self->__checkObj))
			evas_object_color_set(picture, 100, 100, 100, 100);
		else
			evas_object_color_set(picture, 255, 255, 255, 255);
	} else {
		MEMO_LOGI("picture can not be shown, default image: %s", path);
		elm_layout_file_set(layout, MemoUtil::getEdjePath(), "default_image_layout");
	}
	evas_object_show(layout);

	evas_object_data_set(layout, PATH_KEY, strdup(path));
	evas_object_event_callback_add(layout, EVAS_CALLBACK_DEL, freePathCb, evas_object_data_get(layout, PATH_KEY));
	evas_object_event_callback_add(layout, EVAS_CALLBACK_DEL, __onImageObjDelCb, self);
	self->__imgObjList = eina_list_append(self->__imgObjList, layout);
	return layout;
}

void MemoBoxItem::__onImageObjDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	self->__imgObjList = eina_list_remove(self->__imgObjList, obj);
}

const char *MemoBoxItem::getSelectedImagePath(int x, int y)
{
	if (!__imgObjList) {
		MEMO_LOGE("image list is null");
		return nullptr;
	}
	Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(__imgObjList, l, data) {
		Evas_Object *obj = static_cast<Evas_Object *>(data);
		Evas_Coord ox = 0, oy = 0, ow = 0, oh = 0;
		evas_object_geometry_get(obj, &ox, &oy, &ow, &oh);
		if (x >= ox && x < ox + ow && y >= oy && y < oy + oh)
			return static_cast<const char *>(evas_object_data_get(obj, PATH_KEY));
	}
	return nullptr;
}
