#ifndef INC_BOX_IMEMOBOXITEMLISTENER_H
#define INC_BOX_IMEMOBOXITEMLISTENER_H

#include <Evas.h>

#include "Box/MemoBoxItemType.h"

class MemoBoxItem;

// What a box item asks of its owner (MemoBoxControl). An item decides nothing that concerns other
// items: it turns keys and taps into these requests. `item` is always the asking MemoBoxItem*.
class IMemoBoxItemListener
{
public:
	// BackSpace at the start of an item that should go: remove `item`, merging its text into a neighbour.
	virtual void onUnpackRequested(Evas_Object *entry, void *item) = 0;
	// Return or changeMode asks for a new item of `type` behind `item`, holding `text` (may be null).
	// MEMO_BOX_ITEM_TITLE means Next was pressed at the title. Returns the new item (owned by the
	// listener), or null.
	virtual MemoBoxItem *onAddRequested(Evas_Object *entry, _MemoBoxItemType type, const char *text, void *item) = 0;
	// The entry of `item` took focus.
	virtual void onFocusChanged(Evas_Object *entry, void *item) = 0;
	// The star of the title item was toggled to `state`.
	virtual void onFavoriteChanged(Evas_Object *star, bool state, void *item) = 0;
	// The entry's text or composition text changed.
	virtual void onEntryChanged(Evas_Object *entry, void *item) = 0;
	// The entry's character limit refused input.
	virtual void onMaxLengthReached(Evas_Object *entry, void *item) = 0;
	// A tap that selected no image.
	virtual void onChangeModeRequeted() = 0;
	// A tap on the image at `path`.
	virtual void onImageSelected(const char *path) = 0;
	// Number of images in the whole memo, -1 when it has none.
	virtual int onEntryCheckImageCount() = 0;
	// Keep the input panel down while a check or an image is being touched.
	virtual void suspendKeypad() = 0;
	virtual void resumeKeypad() = 0;
	// Focus the owner's current item again.
	virtual void onFocusCurrentItem() = 0;
	// Image work of an item has started (true) or ended (false).
	virtual void onImagePopupRequested(bool show) = 0;
	// The guide text of `item` may have to change.
	virtual void onCheckGuideText(void *item) = 0;

	virtual ~IMemoBoxItemListener() {}
};

#endif
