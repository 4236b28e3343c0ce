#ifndef INC_LIST_MEMOGRIDITEM_H
#define INC_LIST_MEMOGRIDITEM_H

#include <string>
#include <vector>

#include <Elementary.h>

#include <WGengridItem.h>

#include "List/MemoGridText.h"

class MemoDocInfo;

// One memo card of a MemoGridControl: supplies the gengrid's text and content callbacks and draws the card
// from the record alone (title, display content, one thumbnail query). It never opens the editor and never
// writes to the store. The gengrid owns the item; the record must outlive it.
class MemoGridItem : public app_assist::WGengridItem
{
public:
	// Reads the record's title, UUID and display content at once.
	MemoGridItem(int itemType, MemoDocInfo *docInfo);
	~MemoGridItem() override;

	// A new item class of the card's theme group (with "_land" in landscape), carrying the text, content and
	// delete callbacks; the caller frees it after appending. Also sets the preview widths of the orientation.
	Elm_Gengrid_Item_Class *getItemClassNew() override;

	void setItemType(int itemType);
	// The grid mode of the owner: 0 search, 1 and 3 selection, 2 hidden, 5 search inside hidden, -1 the list.
	void setViewKind(int viewKind);
	// The row and the owner's check array (one int per row, not owned) of a selection grid.
	void setRow(int row, int *checkStates);
	// The same card for another record of equal content (the grid's reload of unchanged rows).
	void rebind(MemoDocInfo *docInfo, int row, int *checkStates);
	// The search text to highlight (copied; null or empty for none) and the gengrid whose colours it takes.
	void setKeyword(const char *keyword, Evas_Object *grid);
	// A realized card shows the keyword set since it was drawn: its texts and the texts of its check lines
	// change in place, as drawing it again would leave them.
	void refreshHighlight();

	// The record; logs "__docInfo is NULL" when there is none.
	MemoDocInfo *getDocInfo();
	// The row of a card of a full update, -1 for a search result.
	int getRow() const { return __row; }
	int getItemType() const { return __itemType; }

	// The gengrid's callbacks (public so that the item class can name them).
	static char *__textGetCb(void *data, Evas_Object *obj, const char *part);
	static Evas_Object *__contentGetCb(void *data, Evas_Object *obj, const char *part);

private:
	void __emitRecordSignals(Evas_Object *grid);
	char *__getTextN(Evas_Object *grid, const char *part);
	Evas_Object *__getContent(Evas_Object *grid, const char *part);
	std::string __highlight(Evas_Object *grid, const char *plainValue, const char *plainKeyword);

	// MemoGridItemMarks.cpp: the card's surface, the selection check, voice and hidden marks, the thumbnail.
	Evas_Object *__createSurface(Evas_Object *grid);
	Evas_Object *__createSelectionCheck(Evas_Object *grid);
	Evas_Object *__createVoiceMark(Evas_Object *grid, const char *part);
	Evas_Object *__createHiddenMark(Evas_Object *grid, const char *part);
	Evas_Object *__createThumbnail(Evas_Object *grid);
	Evas_Object *__createIcon(Evas_Object *grid, const char *image, int size, const char *colorCode, bool recordColor);
	bool __hasThumbnail();

	// MemoGridItemLines.cpp: the check lines.
	Evas_Object *__createCheckPart(Evas_Object *grid, const char *part);
	Evas_Object *__createCountGroup(Evas_Object *grid, const char *group, int lineLimit);
	Evas_Object *__createSingleLine(Evas_Object *grid, int index);
	void __setLineTexts(Evas_Object *layout, Evas_Object *grid, int lineLimit);
	static std::string __singleLineText(int kind, const std::string &markup);
	// The preview lines of the display content, parsed on first use.
	const std::vector<MemoGridLine> &__getLines();
	std::string __lineMarkup(Evas_Object *grid, const MemoGridLine &line);

	int __row;
	int *__checkStates;
	char *__keyword;
	Evas_Object *__grid;
	int __itemType;
	MemoDocInfo *__docInfo;
	std::string __title;
	std::string __uuid;
	std::string __displayContent;
	int __viewKind;
	int __labelWidth;
	int __titleWidth;
	bool __useFlatColor;
	bool __linesParsed;
	std::vector<MemoGridLine> __lines;
};

#endif
