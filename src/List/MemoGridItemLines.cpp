// The check lines of a card: one layout per line count, or single lines of an image and a label each.
#include "List/MemoGridItem.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "MemoGridItemPrivate.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

namespace
{
const size_t LABEL_BUFFER_SIZE = 200;
const int CHECK_IMAGE_SIZE = 31;
const int TABLE_PADDING = 10;
const int PLAIN_LABEL_HEIGHT = 43;
const int CHECK_LABEL_HEIGHT = 47;
// What a check line object keeps of how it was made (evas object data).
const char LINE_LIMIT_KEY[] = "memo.lines";
const char LINE_LABEL_KEY[] = "memo.label";
const char LINE_INDEX_KEY[] = "memo.line";

const char PLAIN_STYLE[] = "<font_size=32 color=#000000 font=Font2:style=Regular align=left color_class=ATO004 "
                           "text_class=ATO004>%s</font_size>";
const char UNTICKED_STYLE[] =
    "<font_size=32 align=left color=#1A1A1A color_class=ATO003 text_class=ATO003>%s</font_size>";
const char TICKED_STYLE[] = "<strikethrough=on strikethrough_color=#00000050 font_size=32 align=left "
                            "color_class=ATO002 text_class=ATO002>%s</strikethrough>";

// Parts of the count groups for lines 0 to 3: the check image, the text of an unticked line, of a ticked
// line, and of a plain line.
struct LineParts {
	const char *image, *text, *struck, *plain;
};
const LineParts COUNT_GROUP_LINES[4] = {
    {"checkbox_image2_second", "text_2_c_second", "text_strikethrough_check_second", "text_2"},
    {"checkbox_image2", "text_2_c", "text_strikethrough_check", "text_2_under_check"},
    {"checkbox_image2_3", "text_2_c_3", "text_strikethrough_check_3", "text_3_under_check"},
    {"checkbox_image2_4", "text_2_c_4", "text_strikethrough_check_4", "text_4_under_check"}};
const LineParts ONE_LINE_GROUP = {"checkbox_image", "text", "text_strikethrough", "text"};

Evas_Object *__checkImage(Evas_Object *parent, const char *image, const char *colorCode)
{
	Evas_Object *icon = elm_image_add(parent);
	char *path = MemoUtil::getImageResourcePathN(image);
	if (!path || !elm_image_file_set(icon, path, nullptr))
		MEMO_LOGE("image %s not loaded", image);
	free(path);
	elm_image_aspect_fixed_set(icon, EINA_FALSE);
	const int size = memoGridScaled(CHECK_IMAGE_SIZE);
	evas_object_size_hint_min_set(icon, size, size);
	evas_object_size_hint_max_set(icon, size, size);
	evas_object_size_hint_align_set(icon, 0.0, 0.5);
	memoGridPaint(icon, memoGridColorOf(parent, colorCode));
	evas_object_show(icon);
	return icon;
}

Evas_Object *__strokeImage(Evas_Object *parent, const char *colorCode)
{
	return __checkImage(parent, "icon_memo_edit_box_stroke.png", colorCode);
}

Evas_Object *__tickImage(Evas_Object *parent)
{
	return __checkImage(parent, "icon_memo_edit_check.png", "AO004");
}

// A label text formatted into the label buffer, so that a long line is cut there.
std::string __styled(const char *style, const std::string &markup)
{
	char buffer[LABEL_BUFFER_SIZE * 2 + 4096];
	snprintf(buffer, sizeof(buffer), style, markup.c_str());
	return memoGridCut(buffer, LABEL_BUFFER_SIZE);
}
} // namespace

const std::vector<MemoGridLine> &MemoGridItem::__getLines()
{
	if (!__linesParsed) {
		__lines = memoGridParseLines(__displayContent.c_str());
		__linesParsed = true;
	}
	return __lines;
}

std::string MemoGridItem::__lineMarkup(Evas_Object *grid, const MemoGridLine &line)
{
	return __highlight(grid, line.text.c_str(), __keyword);
}

Evas_Object *MemoGridItem::__createCheckPart(Evas_Object *grid, const char *part)
{
	const bool voiceCode = __itemType == 5 || __itemType == 6;
	if (!voiceCode && __itemType != 9 && __itemType != 10)
		return nullptr;
	// A picture goes before the check lines on a voice card.
	if (voiceCode && __hasThumbnail())
		return nullptr;
	const int count = static_cast<int>(__getLines().size());
	const bool grouped = count == 1 || (!voiceCode && (count == 2 || count == 3 || __itemType == 9));
	if (!strcmp(part, "one_checklist_swallow")) {
		if (!grouped)
			return nullptr;
		if (count == 1)
			return __createCountGroup(grid, "memo_one_checkist", 1);
		if (count == 2)
			return __createCountGroup(grid, "memo_two_checkist", 2);
		if (count == 3)
			return __createCountGroup(grid, "memo_three_checkist", 3);
		return __createCountGroup(grid, "memo_four_checkist", 4);
	}
	if (grouped || __itemType == 9)
		return nullptr;
	int index = -1;
	if (!strcmp(part, "check_swallow_line_one"))
		index = 0;
	else if (!strcmp(part, "check_swallow_line_two"))
		index = 1;
	else if (!strcmp(part, "check_swallow_line_three") && __itemType != 6)
		index = 2;
	if (index < 0 || index >= count)
		return nullptr;
	return __createSingleLine(grid, index);
}

Evas_Object *MemoGridItem::__createCountGroup(Evas_Object *grid, const char *group, int lineLimit)
{
	Evas_Object *layout = elm_layout_add(grid);
	if (!elm_layout_file_set(layout, MemoUtil::getEdjePath(), group))
		MEMO_LOGE("group %s not found", group);
	const std::vector<MemoGridLine> &lines = __getLines();
	for (int i = 0; i < lineLimit && i < static_cast<int>(lines.size()); ++i) {
		const LineParts &parts = lineLimit == 1 ? ONE_LINE_GROUP : COUNT_GROUP_LINES[i];
		const int kind = lines[static_cast<size_t>(i)].kind;
		if (kind == MEMO_GRID_LINE_UNTICKED)
			elm_object_part_content_set(layout, parts.image, __strokeImage(layout, "AO003L1"));
		else if (kind != MEMO_GRID_LINE_PLAIN)
			elm_object_part_content_set(layout, parts.image, __tickImage(layout));
	}
	__setLineTexts(layout, grid, lineLimit);
	evas_object_data_set(layout, LINE_LIMIT_KEY, reinterpret_cast<void *>(static_cast<intptr_t>(lineLimit)));
	return layout;
}

void MemoGridItem::__setLineTexts(Evas_Object *layout, Evas_Object *grid, int lineLimit)
{
	const std::vector<MemoGridLine> &lines = __getLines();
	for (int i = 0; i < lineLimit && i < static_cast<int>(lines.size()); ++i) {
		const LineParts &parts = lineLimit == 1 ? ONE_LINE_GROUP : COUNT_GROUP_LINES[i];
		const MemoGridLine &line = lines[static_cast<size_t>(i)];
		const char *part = line.kind == MEMO_GRID_LINE_PLAIN      ? parts.plain
		                   : line.kind == MEMO_GRID_LINE_UNTICKED ? parts.text
		                                                          : parts.struck;
		elm_object_part_text_set(layout, part, __lineMarkup(grid, line).c_str());
	}
}

std::string MemoGridItem::__singleLineText(int kind, const std::string &markup)
{
	if (kind == MEMO_GRID_LINE_PLAIN)
		return __styled(PLAIN_STYLE, markup);
	return __styled(kind == MEMO_GRID_LINE_UNTICKED ? UNTICKED_STYLE : TICKED_STYLE, markup);
}

// The check line objects keep what they were made of (the line limit of a count group, the index and the
// label of a single line), so that a new keyword changes their texts alone.
void MemoGridItem::refreshHighlight()
{
	Elm_Object_Item *item = getElmObjectItem();
	if (!item)
		return;
	elm_gengrid_item_fields_update(item, "*", ELM_GENGRID_ITEM_FIELD_TEXT);
	Evas_Object *grid = elm_object_item_widget_get(item);
	Evas_Object *group = elm_object_item_part_content_get(item, "one_checklist_swallow");
	if (group && evas_object_data_get(group, LINE_LIMIT_KEY))
		__setLineTexts(group, grid,
		               static_cast<int>(reinterpret_cast<intptr_t>(evas_object_data_get(group, LINE_LIMIT_KEY))));
	const std::vector<MemoGridLine> &lines = __getLines();
	for (const char *part : {"check_swallow_line_one", "check_swallow_line_two", "check_swallow_line_three"}) {
		Evas_Object *table = elm_object_item_part_content_get(item, part);
		Evas_Object *label = table ? static_cast<Evas_Object *>(evas_object_data_get(table, LINE_LABEL_KEY)) : nullptr;
		const int index =
		    table ? static_cast<int>(reinterpret_cast<intptr_t>(evas_object_data_get(table, LINE_INDEX_KEY))) : -1;
		if (!label || index < 0 || index >= static_cast<int>(lines.size()))
			continue;
		const MemoGridLine &line = lines[static_cast<size_t>(index)];
		elm_object_text_set(label, __singleLineText(line.kind, __lineMarkup(grid, line)).c_str());
	}
}

Evas_Object *MemoGridItem::__createSingleLine(Evas_Object *grid, int index)
{
	const std::vector<MemoGridLine> &lines = __getLines();
	Elm_Object_Item *item = getElmObjectItem();
	if (index == 0 && item) {
		const size_t clamped = lines.size() > 4 ? 4 : lines.size();
		bool allChecks = true;
		for (size_t i = 0; i < clamped; ++i)
			allChecks = allChecks && lines[i].kind != MEMO_GRID_LINE_PLAIN;
		elm_object_item_signal_emit(item, allChecks ? "pad,enable,1" : "pad,disable,1", "elm");
		elm_object_item_signal_emit(item, allChecks ? "pad,enable,2" : "pad,disable,2", "elm");
		for (const char *signal : {"check,enable,1", "check,enable,2", "check,enable,3"})
			elm_object_item_signal_emit(item, signal, "elm");
	}
	const MemoGridLine &line = lines[static_cast<size_t>(index)];
	Evas_Object *table = elm_table_add(grid);
	elm_table_homogeneous_set(table, EINA_FALSE);
	elm_table_padding_set(table, memoGridScaled(TABLE_PADDING), 0);

	Evas_Object *label = elm_label_add(table);
	// Font sizes of the label styles are base-scale units, like every size of the layouts.
	elm_object_scale_set(label, 1.0 / elm_app_base_scale_get());
	elm_label_ellipsis_set(label, EINA_TRUE);
	evas_object_size_hint_weight_set(label, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(label, EVAS_HINT_FILL, 0.5);
	// The label sizes itself to its text; a cell of the line's size holds it to that size instead.
	Evas_Object *cell = evas_object_rectangle_add(evas_object_evas_get(table));
	evas_object_color_set(cell, 0, 0, 0, 0);
	const std::string markup = __lineMarkup(grid, line);
	int width = __labelWidth, height = CHECK_LABEL_HEIGHT;
	elm_object_text_set(label, __singleLineText(line.kind, markup).c_str());
	evas_object_data_set(table, LINE_LABEL_KEY, label);
	evas_object_data_set(table, LINE_INDEX_KEY, reinterpret_cast<void *>(static_cast<intptr_t>(index)));
	if (line.kind == MEMO_GRID_LINE_PLAIN) {
		char signal[32];
		snprintf(signal, sizeof(signal), "text,enable,%d", index + 1);
		if (item)
			elm_object_item_signal_emit(item, signal, "elm");
		width = __titleWidth;
		height = PLAIN_LABEL_HEIGHT;
		elm_table_pack(table, cell, 0, 0, 1, 1);
		elm_table_pack(table, label, 0, 0, 1, 1);
	} else {
		if (line.kind == MEMO_GRID_LINE_UNTICKED) {
			elm_table_pack(table, __strokeImage(table, "AO003L1"), 0, 0, 1, 1);
			elm_table_pack(table, __strokeImage(table, "AO003"), 0, 0, 1, 1);
		} else {
			elm_table_pack(table, __tickImage(table), 0, 0, 1, 1);
		}
		elm_table_pack(table, cell, 1, 0, 1, 1);
		elm_table_pack(table, label, 1, 0, 1, 1);
	}
	evas_object_size_hint_min_set(cell, memoGridScaled(width), memoGridScaled(height));
	evas_object_size_hint_max_set(cell, memoGridScaled(width), memoGridScaled(height));
	evas_object_show(label);
	return table;
}
