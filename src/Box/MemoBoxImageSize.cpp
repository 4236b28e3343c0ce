// Display sizes and tags of the images inside box items.
#include "Box/MemoBoxImageSize.h"

#include <cstdio>

#include <Elementary.h>

#include "Box/MemoBoxItem.h"
#include "MemoLog.h"

namespace
{
struct ImageSizeRow {
	int atScale18;
	int atScale38;
	int atOtherScale;
	int defaultHeight;
};

const ImageSizeRow TEXT_SIZES = {603, 653, 628, 428};
const ImageSizeRow CHECK_SIZES = {506, 560, 521, 392};

void pickSize(const ImageSizeRow &row, double scale, int *width, int *defaultHeight)
{
	int w = row.atOtherScale;
	if (scale == 1.8)
		w = row.atScale18;
	else if (scale == 3.8)
		w = row.atScale38;
	if (width)
		*width = w;
	if (defaultHeight)
		*defaultHeight = row.defaultHeight;
}
} // namespace

void memoBoxImageTextSize(double scale, int *width, int *defaultHeight)
{
	pickSize(TEXT_SIZES, scale, width, defaultHeight);
}

void memoBoxImageCheckSize(double scale, int *width, int *defaultHeight)
{
	pickSize(CHECK_SIZES, scale, width, defaultHeight);
}

int memoBoxImageTagHeight(int pictureWidth, int pictureHeight, int width, int defaultHeight)
{
	if (pictureWidth <= 0 || pictureHeight <= 0)
		return defaultHeight;
	const long long height = static_cast<long long>(pictureHeight) * width / pictureWidth;
	return static_cast<int>(height) + MEMO_BOX_IMAGE_EXTRA_HEIGHT;
}

std::string memoBoxImageTag(int width, int height, const char *path, bool leadingBreak)
{
	char tag[2048];
	snprintf(tag, sizeof(tag), leadingBreak ? MEMO_BOX_IMAGE_TAG_BREAK_FORMAT : MEMO_BOX_IMAGE_TAG_FORMAT, width,
			 height, path ? path : "");
	return tag;
}

bool memoBoxImageProbe(Evas *evas, const char *path, int *width, int *height, int *loadError)
{
	if (!evas || !path) {
		if (loadError)
			*loadError = EVAS_LOAD_ERROR_GENERIC;
		return false;
	}
	Evas_Object *probe = evas_object_image_add(evas);
	evas_object_image_file_set(probe, path, nullptr);
	const Evas_Load_Error error = evas_object_image_load_error_get(probe);
	int w = 0, h = 0;
	if (error == EVAS_LOAD_ERROR_NONE)
		evas_object_image_size_get(probe, &w, &h);
	evas_object_del(probe);
	if (loadError)
		*loadError = error;
	if (error != EVAS_LOAD_ERROR_NONE || w <= 0 || h <= 0)
		return false;
	if (width)
		*width = w;
	if (height)
		*height = h;
	return true;
}

void MemoBoxItem::__getImgSizeTextType(int *width, int *defaultHeight)
{
	memoBoxImageTextSize(elm_config_scale_get(), width, defaultHeight);
}

void MemoBoxItem::__getImgSizeCheckType(int *width, int *defaultHeight)
{
	memoBoxImageCheckSize(elm_config_scale_get(), width, defaultHeight);
}

void MemoBoxItem::__getImgDisplaySize(const char *path, int *width, int *height)
{
	int w = 0, defaultHeight = 0;
	if (memoBoxItemIsCheck(__type))
		__getImgSizeCheckType(&w, &defaultHeight);
	else
		__getImgSizeTextType(&w, &defaultHeight);

	Evas_Object *anchor = __entryObj ? __entryObj : __layoutObj;
	int pictureWidth = 0, pictureHeight = 0;
	if (!anchor || !memoBoxImageProbe(evas_object_evas_get(anchor), path, &pictureWidth, &pictureHeight, nullptr))
		MEMO_LOGI("picture size unknown, default height: %s", path ? path : "(null)");
	if (width)
		*width = w;
	if (height)
		*height = memoBoxImageTagHeight(pictureWidth, pictureHeight, w, defaultHeight);
}
