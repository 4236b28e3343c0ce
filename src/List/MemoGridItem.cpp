// A memo card: its item class, the text callback and the dispatch of the content callback.
#include "List/MemoGridItem.h"

#include <cstdlib>
#include <cstring>
#include <initializer_list>

#include <efl_assist_theme.h>

#include "DataBase/MemoDocInfo.h"
#include "MemoApp.h"
#include "MemoGridItemPrivate.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
const int TEXT_BUFFER_SIZE = 4096;
const int LAYOUT_CODE_COUNT = 12;

// Theme group of each layout code; landscape appends "_land".
const char *const PORTRAIT_GROUPS[LAYOUT_CODE_COUNT] = {
    "memo_text",        "memo_title",       "memo_title_text",
    "memo_image",       "memo_title_image", "memo_voice",
    "memo_title_voice", "memo_body_voice",  "memo_title_body_voice",
    "memo_check",       "memo_title_check", "memo_twoline_title_voice"};
const char *const LANDSCAPE_GROUPS[LAYOUT_CODE_COUNT] = {
    "memo_text_land",        "memo_title_land",       "memo_title_text_land",
    "memo_image_land",       "memo_title_image_land", "memo_voice_land",
    "memo_title_voice_land", "memo_body_voice_land",  "memo_title_body_voice_land",
    "memo_check_land",       "memo_title_check_land", "memo_twoline_title_voice_land"};
} // namespace

int memoGridScaled(int size)
{
	return static_cast<int>(size * elm_config_scale_get() / elm_app_base_scale_get());
}

MemoGridColor memoGridColorOf(Evas_Object *grid, const char *code)
{
	MemoGridColor color = {0, 0, 0, 255};
	if (grid)
		ea_theme_object_color_get(grid, code, &color.r, &color.g, &color.b, &color.a, nullptr, nullptr, nullptr,
		                          nullptr, nullptr, nullptr, nullptr, nullptr);
	return color;
}

void memoGridPaint(Evas_Object *obj, const MemoGridColor &color)
{
	evas_object_color_set(obj, color.r * color.a / 255, color.g * color.a / 255, color.b * color.a / 255, color.a);
}

bool memoGridCodeIn(int code, std::initializer_list<int> codes)
{
	for (int c : codes)
		if (c == code)
			return true;
	return false;
}

MemoGridItem::MemoGridItem(int itemType, MemoDocInfo *docInfo)
    : __row(-1), __checkStates(nullptr), __keyword(nullptr), __grid(nullptr), __itemType(itemType), __docInfo(docInfo),
      __viewKind(-1), __labelWidth(241), __titleWidth(282), __useFlatColor(false), __linesParsed(false)
{
	if (!docInfo) {
		MEMO_LOGE("__docInfo is NULL");
		return;
	}
	__title = docInfo->getTitle();
	__uuid = docInfo->getMemoUUID();
	__displayContent = docInfo->getDisplayContent();
}

MemoGridItem::~MemoGridItem()
{
	free(__keyword);
}

Elm_Gengrid_Item_Class *MemoGridItem::getItemClassNew()
{
	Elm_Gengrid_Item_Class *itemClass = WGengridItem::getItemClassNew();
	if (!itemClass)
		return nullptr;
	int code = (__itemType >= 0 && __itemType < LAYOUT_CODE_COUNT) ? __itemType : 0;
	if (gIsPortrait) {
		itemClass->item_style = PORTRAIT_GROUPS[code];
		__labelWidth = 241;
		__titleWidth = 282;
	} else {
		itemClass->item_style = LANDSCAPE_GROUPS[code];
		__labelWidth = 297;
		__titleWidth = 338;
	}
	itemClass->func.text_get = __textGetCb;
	itemClass->func.content_get = __contentGetCb;
	return itemClass;
}

void MemoGridItem::setItemType(int itemType)
{
	__itemType = itemType;
}

void MemoGridItem::setViewKind(int viewKind)
{
	__viewKind = viewKind;
}

void MemoGridItem::setRow(int row, int *checkStates)
{
	__row = row;
	__checkStates = checkStates;
}

void MemoGridItem::rebind(MemoDocInfo *docInfo, int row, int *checkStates)
{
	__docInfo = docInfo;
	setRow(row, checkStates);
}

void MemoGridItem::setKeyword(const char *keyword, Evas_Object *grid)
{
	free(__keyword);
	__keyword = keyword ? strdup(keyword) : nullptr;
	__grid = grid;
}

MemoDocInfo *MemoGridItem::getDocInfo()
{
	if (!__docInfo)
		MEMO_LOGE("__docInfo is NULL");
	return __docInfo;
}

char *MemoGridItem::__textGetCb(void *data, Evas_Object *obj, const char *part)
{
	MemoGridItem *self = static_cast<MemoGridItem *>(data);
	if (!self || !part)
		return nullptr;
	return self->__getTextN(obj, part);
}

Evas_Object *MemoGridItem::__contentGetCb(void *data, Evas_Object *obj, const char *part)
{
	MemoGridItem *self = static_cast<MemoGridItem *>(data);
	if (!self || !part)
		return nullptr;
	return self->__getContent(obj, part);
}

std::string MemoGridItem::__highlight(Evas_Object *grid, const char *plainValue, const char *plainKeyword)
{
	char *value = elm_entry_utf8_to_markup(plainValue ? plainValue : "");
	std::string markup = value ? value : "";
	free(value);
	if (!plainKeyword || !*plainKeyword)
		return markup;
	char *keyword = elm_entry_utf8_to_markup(plainKeyword);
	std::string keywordMarkup = keyword ? keyword : "";
	free(keyword);
	Evas_Object *colorSource = __grid ? __grid : grid;
	return memoGridHighlight(markup, keywordMarkup, memoGridColorOf(colorSource, "ATO005"),
	                         memoGridColorOf(colorSource, "ATO001D"));
}

char *MemoGridItem::__getTextN(Evas_Object *grid, const char *part)
{
	std::string text;
	if (!strcmp(part, "title") && memoGridCodeIn(__itemType, {1, 2, 4, 6, 8, 10, 11})) {
		char *title = elm_entry_markup_to_utf8(__title.c_str());
		char *keyword = __keyword ? elm_entry_markup_to_utf8(__keyword) : nullptr;
		text = __highlight(grid, title, keyword);
		free(title);
		free(keyword);
	} else if (!strcmp(part, "text") && memoGridCodeIn(__itemType, {0, 2, 7, 8})) {
		text = __highlight(grid, __displayContent.c_str(), __keyword);
	} else {
		return nullptr;
	}
	return strdup(memoGridCut(text, TEXT_BUFFER_SIZE).c_str());
}

// Signals and colours that follow the record, given to the card on every content request.
void MemoGridItem::__emitRecordSignals(Evas_Object *grid)
{
	(void)grid;
	Elm_Object_Item *item = getElmObjectItem();
	if (!item || !__docInfo)
		return;
	if (MemoUtil::isQuickMemoFeatureEnabled()) {
		// The card's own theme object is the one that holds its surface.
		Evas_Object *surface = elm_object_item_part_content_get(item, "card.bg");
		Evas_Object *card = surface ? evas_object_smart_parent_get(surface) : nullptr;
		if (card) {
			int r = 0, g = 0, b = 0, a = 0;
			__docInfo->getBgColorRgba(&r, &g, &b, &a);
			for (const char *code : {"AO001", "AO001S", "AO002"})
				edje_object_color_class_set(card, code, r, g, b, a, r, g, b, a, r, g, b, a);
		}
	}
	if (__docInfo->getIsFavorite()) {
		elm_object_item_signal_emit(item, "set,favorite,mask", "elm");
		elm_object_item_signal_emit(item, "set,favorite", "elm");
		elm_object_item_signal_emit(item, "set,voice", "elm");
	} else {
		elm_object_item_signal_emit(item, "unset,special,mask", "elm");
		elm_object_item_signal_emit(item, "unset,favorite", "elm");
		elm_object_item_signal_emit(item, "unset,voice", "elm");
	}
	if (__docInfo->getIsQuick()) {
		elm_object_item_signal_emit(item, "set,quickmemo,mask", "elm");
		elm_object_item_signal_emit(item, "set,quickmemo", "elm");
		elm_object_item_signal_emit(item, "set,voice", "elm");
	}
}

Evas_Object *MemoGridItem::__getContent(Evas_Object *grid, const char *part)
{
	__emitRecordSignals(grid);
	if (!strcmp(part, "card.bg"))
		return __createSurface(grid);
	if (!strcmp(part, "selection_swallow_check"))
		return (__viewKind == 1 || __viewKind == 3) ? __createSelectionCheck(grid) : nullptr;
	if (!strcmp(part, "voice.image.effect") || !strcmp(part, "voice.image"))
		return __createVoiceMark(grid, part);
	if (!strncmp(part, "hidden.icon", strlen("hidden.icon")) || !strncmp(part, "voice.hidden.icon", 17))
		return __createHiddenMark(grid, part);
	if (!strcmp(part, "image_swallow"))
		return memoGridCodeIn(__itemType, {3, 4, 5, 6}) ? __createThumbnail(grid) : nullptr;
	if (!strcmp(part, "one_checklist_swallow") || !strncmp(part, "check_swallow_line_", 19))
		return __createCheckPart(grid, part);
	return nullptr;
}
