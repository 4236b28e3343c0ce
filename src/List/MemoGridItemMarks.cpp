// The parts of a card that are objects of their own: the surface in the memo's colour, the selection check,
// the voice and hidden marks, and the thumbnail.
#include "List/MemoGridItem.h"

#include <cstdlib>
#include <cstring>

#include <Ecore_File.h>
#include <uxt_theme.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoGridItemPrivate.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
// The check of a selection grid takes the app's colours in place of the widget's.
const char *const CHECK_COLOR_REPLACEMENTS[][2] = {
    {"W013L1", "AO030L3"},   {"W013L1E1", "AO030L3E1"}, {"W013L1D", "AO030L3D"},   {"W013L1E1D", "AO030L3E1D"},
    {"W013L2", "AO030L4"},   {"W013L2D", "AO030L4D"},   {"W013L2E1", "AO030L4E1"}, {"W013L2E1D", "AO030L4E1D"},
    {"W013L1i", "AO030L3i"}, {"W013L1iD", "AO030L3iD"}};

void __checkChangedCb(void *data, Evas_Object *obj, void *)
{
	int *state = static_cast<int *>(data);
	if (state)
		*state = elm_check_state_get(obj) ? 1 : 0;
}

Evas_Object *__layoutOf(Evas_Object *parent, const char *group)
{
	Evas_Object *layout = elm_layout_add(parent);
	if (!elm_layout_file_set(layout, MemoUtil::getEdjePath(), group))
		MEMO_LOGE("group %s not found", group);
	return layout;
}
} // namespace

// The card draws its surface itself; the part holds an empty object, which also tells the other parts'
// requests which theme object is the card's (its smart parent once swallowed).
Evas_Object *MemoGridItem::__createSurface(Evas_Object *grid)
{
	Evas_Object *anchor = evas_object_rectangle_add(evas_object_evas_get(grid));
	evas_object_color_set(anchor, 0, 0, 0, 0);
	return anchor;
}

Evas_Object *MemoGridItem::__createSelectionCheck(Evas_Object *grid)
{
	Evas_Object *check = elm_check_add(grid);
	elm_object_style_set(check, "memo_select");
	// A tap on the check is a tap on the card, which the selection view counts.
	elm_object_signal_emit(check, "elm,event,pass,enabled", "elm");
	for (const auto &replacement : CHECK_COLOR_REPLACEMENTS)
		uxt_theme_object_replace_color(check, replacement[0], replacement[1]);
	int *state = (__checkStates && __row >= 0) ? &__checkStates[__row] : nullptr;
	elm_check_state_set(check, state && *state == 1);
	evas_object_smart_callback_add(check, "changed", __checkChangedCb, state);
	evas_object_propagate_events_set(check, EINA_FALSE);
	return check;
}

// An icon of the images folder, sized in base-scale units and painted in a colour class, or in the memo's
// own colour.
Evas_Object *MemoGridItem::__createIcon(Evas_Object *grid, const char *image, int size, const char *colorCode,
                                        bool recordColor)
{
	Evas_Object *icon = elm_image_add(grid);
	char *path = MemoUtil::getImageResourcePathN(image);
	if (!path || !elm_image_file_set(icon, path, nullptr))
		MEMO_LOGE("icon %s not loaded", image);
	free(path);
	elm_image_aspect_fixed_set(icon, EINA_FALSE);
	const int pixels = memoGridScaled(size);
	evas_object_size_hint_min_set(icon, pixels, pixels);
	evas_object_size_hint_max_set(icon, pixels, pixels);
	if (recordColor && __docInfo) {
		MemoGridColor color = {0, 0, 0, 255};
		__docInfo->getBgColorRgba(&color.r, &color.g, &color.b, &color.a);
		memoGridPaint(icon, color);
	} else {
		memoGridPaint(icon, memoGridColorOf(grid, colorCode));
	}
	return icon;
}

Evas_Object *MemoGridItem::__createVoiceMark(Evas_Object *grid, const char *part)
{
	if (!__docInfo)
		return nullptr;
	const bool effect = !strcmp(part, "voice.image.effect");
	Elm_Object_Item *item = getElmObjectItem();
	if (__docInfo->getIsHidden()) {
		if (item)
			elm_object_item_signal_emit(item, "change,icon,size", "elm");
		return effect ? __createIcon(grid, "icon_hiddenmode_ef.png", 40, "AO001", false)
		              : __createIcon(grid, "icon_hiddenmode.png", 40, "AO005", false);
	}
	// A favourite or the quick memo draws its voice mark in the theme ("set,voice").
	if (__docInfo->getIsFavorite() || __docInfo->getIsQuick())
		return nullptr;
	if (!effect)
		return __createIcon(grid, "icon_memo_voice.png", 48, "AO005", false);
	return __createIcon(grid, "icon_memo_voice_ef.png", 48, "AO001", MemoUtil::isQuickMemoFeatureEnabled());
}

Evas_Object *MemoGridItem::__createHiddenMark(Evas_Object *grid, const char *part)
{
	if (!__docInfo || !__docInfo->getIsHidden())
		return nullptr;
	if (__viewKind != 1 && __viewKind != 2 && __viewKind != 3 && __viewKind != 5)
		return nullptr;
	const bool background = strstr(part, ".bg") != nullptr;
	const bool voice = *__docInfo->getVrfileUUID() != '\0';
	Elm_Object_Item *item = getElmObjectItem();
	if (voice && item)
		elm_object_item_signal_emit(item, "change,icon,size", "elm");
	if (background) {
		if (!voice)
			return __createIcon(grid, "icon_hiddenmode_ef.png", 40, "AO001", false);
		const bool featureOn = MemoUtil::isQuickMemoFeatureEnabled();
		return __createIcon(grid, "icon_memo_voice_ef.png", 48, __docInfo->getIsFavorite() ? "AO001S" : "AO001",
		                    featureOn);
	}
	return voice ? __createIcon(grid, "icon_memo_voice.png", 48, "AO005", false)
	             : __createIcon(grid, "icon_hiddenmode.png", 40, "AO005", false);
}

bool MemoGridItem::__hasThumbnail()
{
	char *path = nullptr;
	bool found = MemoDbMgr::getInstance()->getMemoThumbnailImageN(__uuid.c_str(), &path);
	free(path);
	return found;
}

// The memo's thumbnail; a missing or unreadable file shows the small default picture.
Evas_Object *MemoGridItem::__createThumbnail(Evas_Object *grid)
{
	char *path = nullptr;
	if (!MemoDbMgr::getInstance()->getMemoThumbnailImageN(__uuid.c_str(), &path) || !path) {
		free(path);
		return nullptr;
	}
	Evas_Object *image = nullptr;
	if (ecore_file_exists(path)) {
		image = elm_image_add(grid);
		bool loaded = elm_image_file_set(image, path, nullptr) &&
		              evas_object_image_load_error_get(elm_image_object_get(image)) == EVAS_LOAD_ERROR_NONE;
		if (loaded) {
			elm_image_aspect_fixed_set(image, EINA_FALSE);
		} else {
			evas_object_del(image);
			image = nullptr;
		}
	}
	free(path);
	return image ? image : __layoutOf(grid, "default_image_layout_small");
}
