#ifndef INC_BOX_MEMOBOXCONTROL_H
#define INC_BOX_MEMOBOXCONTROL_H

#include <string>

#include <Elementary.h>
#include <WSignal.h>
#include <WViewController.h>

#include "Box/IMemoBoxItemListener.h"
#include "Box/MemoBoxItemType.h"

class MemoBoxItem;
class MemoDocInfo;

// The modes of the edit view, which the box control holds too. An item is editable in every mode
// but MODE_VIEW.
enum _MemoEditMode {
	MODE_NEW = 0,
	MODE_UPDATE = 1,
	MODE_VIEW = 2,
	MODE_NEW_EXTERNAL = 3,
};

// The memo body as the editor sees it: a vertical box with the title item on top and the body items
// below it. It owns the items, keeps the head of the body list first-typed, shares one character
// budget of 4096 among all body items (the title has its own), and tells its view what it must know
// through one signal of string keys:
//   "action,done,enable" / "action,done,disable"  (null)  whether Done may be active
//   "action,mode,change"                          (null)  a tap in MODE_VIEW asks for editing
//   "action,image,selected"                 (const char* path)  a tap on an image
//   "action,imagepopup,show" / "...,hide"         (null)  an item's image work started / ended
//
// Files: MemoBoxControl.cpp (building, accessors, keypad), MemoBoxControlDocument.cpp (todolist
// document in and out), MemoBoxControlItems.cpp (adding and removing items, focus and budget),
// MemoBoxControlSignals.cpp (what the items report), MemoBoxControlImages.cpp (images of all items).
class MemoBoxControl : public app_assist::WViewController, public IMemoBoxItemListener
{
public:
	using Signal = app_assist::WSignal<void(const char *, void *)>;

	// `docinfo` is not owned and may be null (a new memo); `mode` is a _MemoEditMode; `memoUuid`
	// names the memo's media folder (null counts as "").
	MemoBoxControl(MemoDocInfo *docinfo, int mode, const char *memoUuid);

	const char *getClassName() const override;

protected:
	// Makes the main vertical box in `parent` (and sets it as the content of a scroller parent).
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	// Fills the box: the title item, then the body from the record's todolist document.
	void onCreated() override;
	// Deletes the title item and every body item with their layouts.
	void onDestroy() override;

public:
	~MemoBoxControl() override;

	// ---- IMemoBoxItemListener (MemoBoxControlItems.cpp, MemoBoxControlSignals.cpp) ----
	void onUnpackRequested(Evas_Object *entry, void *item) override;
	MemoBoxItem *onAddRequested(Evas_Object *entry, _MemoBoxItemType type, const char *text, void *item) override;
	void onFocusChanged(Evas_Object *entry, void *item) override;
	void onFavoriteChanged(Evas_Object *star, bool state, void *item) override;
	// Also called by the view with null arguments, to have the Done state computed again.
	void onEntryChanged(Evas_Object *entry, void *item) override;
	void onMaxLengthReached(Evas_Object *entry, void *item) override;
	void onChangeModeRequeted() override;
	void onImageSelected(const char *path) override;
	int onEntryCheckImageCount() override;
	// In every mode but MODE_VIEW: keeps the input panel of the focused item (the title when it has
	// focus) down until resumeKeypad.
	void suspendKeypad() override;
	void resumeKeypad() override;
	// Gives focus to the current body item's entry.
	void onFocusCurrentItem() override;
	void onImagePopupRequested(bool show) override;
	void onCheckGuideText(void *item) override;

	// The signal described above. Listeners added with an owner object leave with it.
	Signal &getSignal() { return __signal; }

	// The body item that last took focus; the title item; the last body item ("__itemList is NULL."
	// and null when there are none). Owned by the control.
	MemoBoxItem *getFocusedItem() const { return __currentItem; }
	MemoBoxItem *getTitleItem() const { return __titleItem; }
	MemoBoxItem *getLastItem() const;
	// The body items (MemoBoxItem*) in screen order; owned by the control.
	const Eina_List *getItemList() const { return __itemList; }
	int getMode() const { return __mode; }

	// The todolist document of the body items: items whose entry shows no text (format tags alone
	// count as none) are skipped, and a body of empty items gives "". Null when the document could
	// not be written (logged): a save must then fail and leave the stored memo as it was. The
	// caller frees it.
	char *getTodoListXmlN();
	// The title as plain UTF-8, or null when it is empty. The caller frees it.
	char *getTitleTextN();
	// The favourite star of the title item (false for the quick memo).
	bool getFavoriteStatus();

	// Rebuilds and returns the list of the image paths (char*) of every body item, in order; null when
	// there are none. The list is the control's until the next call or freeImageList.
	Eina_List *getImageList();
	void freeImageList();
	// Forwarded to the current item (see MemoBoxItem). False with a log line when there is none.
	bool insertImage(const char *path);
	bool insertImages(Eina_List *list);
	bool deleteImage(const char *path);
	// The image path under the canvas point in the current item, or null ("invalid input." for a
	// negative coordinate). Not owned.
	const char *getSelectedImagePath(int x, int y);

	// Whether the canvas point lies on the title's star, or on the title item at all.
	bool isFavoriteArea(int x, int y);
	bool isTitleArea(int x, int y);

private:
	// Reads a non-empty todolist document into body items at the end of the box.
	void __composeBoxItemFromXml(const char *xml);
	// Makes a body item of `type`, built in the box but not packed; null on failure.
	MemoBoxItem *__createItem(_MemoBoxItemType type);
	// Packs `item` at the end of the box and the list and makes it the current item.
	void __appendItem(MemoBoxItem *item);
	// Whether `item` is the title item or one of the body items (it may have gone meanwhile).
	bool __isLiveItem(const MemoBoxItem *item) const;
	// Gives `item` what the shared body budget leaves it beside the other items of the list.
	void __applyBudget(MemoBoxItem *item);
	bool __areBodyItemsEmpty() const;
	void __emitDoneState(bool allEmpty);
	bool __isEditable() const { return __mode != MODE_VIEW; }

	Eina_List *__itemList;
	MemoBoxItem *__currentItem;
	MemoBoxItem *__titleItem;
	Eina_List *__imagePathList;
	MemoDocInfo *__docinfo;
	int __mode;
	Signal __signal;
	MemoBoxItem *__holdItem;
	std::string __memoUuid;
	bool __isTitleFocused;
	// Set while the items are taken down; their reports are ignored from then on.
	bool __isDestroying;
};

#endif
