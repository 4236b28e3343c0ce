#ifndef INC_BOX_MEMOBOXITEM_H
#define INC_BOX_MEMOBOXITEM_H

#include <functional>
#include <string>
#include <vector>

#include <Elementary.h>
#include <WUiTimer.h>

#include "Box/IMemoBoxItemListener.h"
#include "Box/MemoBoxItemType.h"

// One editable block of a memo inside the box of MemoBoxControl: the title, a text block or one
// checklist line. It owns its Evas objects (they die with the outer layout), turns key and pointer
// events into requests to its listener and filters every insertion into its entry.
//
// Files: MemoBoxItem.cpp (state, accessors), MemoBoxItemLayout.cpp (title and body layouts),
// MemoBoxItemEvents.cpp (entry, check and star callbacks), MemoBoxItemKeys.cpp (Return, BackSpace),
// MemoBoxItemMode.cpp (changeMode, split at the cursor), MemoEntryFilter*.cpp (the markup filter),
// MemoBoxImage*.cpp (images inside the entry).
class MemoBoxItem
{
public:
	// `memoUuid` names the memo's media folder (<data>media/<uuid>/); null counts as "".
	MemoBoxItem(_MemoBoxItemType type, const char *memoUuid, bool isEditable);
	// Clears the listener, unhooks the image objects, frees the path list, cancels the last worker.
	// The outer layout is deleted by the owner (it unpacks it from the box first).
	virtual ~MemoBoxItem();

	// Builds the outer layout ("box_item_layout") inside `parent` with the title or body layout in it.
	// `param` is unused. Returns the outer layout (not owned by the caller: it lives in `parent`);
	// null with "Parent is NULL" on a null parent.
	Evas_Object *create(Evas_Object *parent, void *param, IMemoBoxItemListener *listener);

	Evas_Object *getLayout() const { return __layoutObj; }
	Evas_Object *getEntry() const { return __entryObj; }
	Evas_Object *getInnerLayout() const { return __innerLayoutObj; }
	_MemoBoxItemType getType() const { return __type; }

	// Stores the type and tells the inner layout whether it heads the list ("top,item"/"normal,item").
	// Does not rebuild the layout.
	void setType(_MemoBoxItemType type);
	// Inserts markup into the entry (through the entry filter); without an entry sets the title text.
	void insertText(const char *text);

	// Check state of a check item; "check object is NULL" and false/nothing for other items.
	bool getCheckStatus();
	void setCheckStatus(bool state);
	// The favourite star of a normal title; "__favoriteObj is NULL" and false/nothing otherwise.
	bool getFavoriteStatus();
	void setFavoriteStatus(bool state);
	// Shows the body guide text (first text item, editable, empty) or clears it.
	void showGuideText(bool show);

	// Toggles the line at the cursor between text and check, splitting the item where needed.
	void changeMode();
	// The entry's markup without format tags, for the todolist document. New string, caller frees;
	// "" without an entry.
	char *getContentMarkupN();
	// Replaces the entry's character limit by `maxChars` characters (no byte limit).
	void setLimit(int maxChars);
	// True when the entry shows no text, as elm_entry_is_empty says: format tags alone (left behind
	// by deleted text) are empty, a break or a picture is not. Unlike that call it never moves the
	// cursor (which it does when a change notice is still pending). Null counts as empty.
	static bool isEntryEmpty(Evas_Object *entry);
	// The next mouse up on the entry is ignored.
	void setIgnoreMouseUp(bool ignore) { __ignoreMouseUp = ignore; }

	// ---- Images inside the entry (MemoBoxImage*.cpp) ----

	// Loads `path`, builds its tag at the display size and inserts it at the cursor. On a load
	// error: "This file can not insert to entry.", a toast, the file removed, false.
	bool insertImage(const char *path);
	// Inserts the tags of a list of char* paths in one insertion. False on a null or empty list.
	bool insertImages(Eina_List *list);
	// The path of the image object under the canvas point, or null. Not owned.
	const char *getSelectedImagePath(int x, int y);
	// Removes the tag holding `path`, restoring the cursor. False when not found or null.
	bool removeImageByPath(const char *path);
	// Removes the tag holding `path`. False with "Can not find this image" when not found.
	bool deleteImage(const char *path);
	// Rebuilds and returns the list of this item's image paths (owned char*); null when none.
	// The list belongs to the item.
	Eina_List *getImgList();

private:
	MemoBoxItem(const MemoBoxItem &) = delete;
	MemoBoxItem &operator=(const MemoBoxItem &) = delete;

	// A 0.0 s timer and an idler that run `func` with the item as data. They are bound to the outer
	// layout and ended by the destructor, whichever goes first.
	void __addTimer(std::function<bool(void *)> func);
	void __addIdler(std::function<bool(void *)> func);
	static void __onLayoutDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);

	// Layouts (MemoBoxItemLayout.cpp).
	void __createTitleLayout();
	void __createInnerLayout();
	void __setQuickPanelDescription();
	void __pushTextStyle(bool checked);
	static void __titleFilter(void *data, Evas_Object *entry, char **text);
	static void __titleSelectionStartCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __titleSelectionClearedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __titleBackKeyCb(void *data, Evas_Object *obj, void *eventInfo);

	// Callbacks (MemoBoxItemEvents.cpp).
	static void __onEntryChangedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __onEntryFocusedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __onEntryClickedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __onEntryLongPressedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __onEntryMaxLengthCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __onEntryMouseDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __onEntryMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __onCheckChangedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __onCheckMouseDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __onCheckMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __onFavoriteMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);

	// Keys (MemoBoxItemKeys.cpp).
	static void __onEntryActivateCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __onEntryKeyDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	void __onReturnKey();
	void __onCheckReturn();
	void __onBackSpaceKey(Evas_Object *entry);

	// Mode change (MemoBoxItemMode.cpp).
	void __splitAtCursor(std::string &before, std::string &after, bool dropTrailingBreak);
	void __finishModeChange();
	void __handOverToNewItem(const std::string &head);

	// Entry filter (MemoEntryFilter*.cpp).
	static void __entryFilter(void *data, Evas_Object *entry, char **text);
	struct __ResizeRequest;
	struct __ResizeJob;
	void __adoptFixedSizeTags(std::string &text, std::vector<__ResizeRequest> &queue);
	void __adoptImageTags(std::string &text);
	std::string __mediaFolderNameFor(const std::string &path);
	std::string __copyIntoMediaFolder(const std::string &path);
	void __getDisplayWidth(int *width, int *defaultHeight);
	void __queueResizeWorkers(const std::vector<__ResizeRequest> &requests);
	// Starts a worker that shrinks `source` into __resizePath with the __resize* fields.
	__ResizeJob *__startResizeWorker(const std::string &source, bool insertsPendingText);
	void __forgetResizeJob(__ResizeJob *job);
	void __detachResizeJobs();
	static void __resizeWorkerCb(void *data, Ecore_Thread *thread);
	static void __resizeWorkerEndCb(void *data, Ecore_Thread *thread);
	static void __resizeWorkerCancelCb(void *data, Ecore_Thread *thread);

	// Images (MemoBoxImage*.cpp). The display width of an image and the default height, for text
	// kinds and for check kinds, at the current scale.
	static void __getImgSizeTextType(int *width, int *defaultHeight);
	static void __getImgSizeCheckType(int *width, int *defaultHeight);
	// The display size of the picture at `path` in this item: the width of its kind, the height
	// scaled from the picture plus 40, or the default height when the picture cannot be loaded.
	void __getImgDisplaySize(const char *path, int *width, int *height);
	// False with "path is null." or "__entryObj is NULL" when an image operation cannot go ahead.
	bool __canEditImage(const char *path) const;
	// Erases the tag of `path` from the entry's markup with `erase` and sets the rest. False with
	// "Can not find this image" when `erase` finds none.
	bool __eraseImageTag(const char *path, bool (*erase)(std::string &, const char *));
	// Item provider of the entry; `data` is the item.
	static Evas_Object *__onEntryItemProviderCb(void *data, Evas_Object *entry, const char *item);
	// EVAS_CALLBACK_DEL of an image object made by the provider, registered with the item as data.
	static void __onImageObjDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);

	Evas_Object *__layoutObj;
	Evas_Object *__entryObj;
	Evas_Object *__checkObj;
	Evas_Object *__innerLayoutObj;
	Evas_Object *__favoriteObj;
	_MemoBoxItemType __type;
	IMemoBoxItemListener *__listener;
	bool __isEditable;
	Eina_List *__imgPathList;
	Eina_List *__imgObjList;
	Elm_Entry_Filter_Limit_Size __limit;
	int __pressX;
	int __pressY;
	bool __ignoreMouseUp;
	bool __longPressed;
	int __resizeWidth;
	int __resizeHeight;
	float __resizeRatio;
	std::string __resizePath;
	std::string __pendingText;
	int __pendingThreads;
	int __lastCursorPos;
	std::string __memoUuid;
	// The last started worker ("__thread" is a compiler keyword).
	Ecore_Thread *__threadHandle;
	// Workers still running for this item; the destructor detaches them so that their end cannot reach it.
	std::vector<__ResizeJob *> __jobs;
	// Timers and idlers started by the item.
	std::vector<app_assist::WUiTimerHandle> __timers;
	// The bus listener of a quick memo body being read; 0 when none.
	unsigned int __busListenerId;
};

#endif
