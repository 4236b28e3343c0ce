// Return and BackSpace. Return on a check line starts the next check line (or leaves the list on an
// empty line); Return in the title moves to the body. BackSpace at the very start of an item turns a
// check line into text or asks the owner to merge the item into its neighbour.
#include "Box/MemoBoxItem.h"

#include <cstring>

#include "MemoBoxItemPrivate.h"
#include "MemoLog.h"

namespace
{
// Timer body after a mode change has rebuilt the item: the cursor to the end, the focus back.
bool focusAtEnd(void *data)
{
	Evas_Object *entry = static_cast<MemoBoxItem *>(data)->getEntry();
	if (entry) {
		elm_entry_cursor_end_set(entry);
		elm_object_focus_set(entry, EINA_TRUE);
	}
	return false;
}
} // namespace

void MemoBoxItem::__onEntryActivateCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	// A multi-line entry reports Return through its key-down event, after it has typed the break.
	if (!elm_entry_single_line_get(obj))
		return;
	static_cast<MemoBoxItem *>(data)->__onReturnKey();
}

void MemoBoxItem::__onReturnKey()
{
	if (memoBoxItemIsCheck(__type))
		__onCheckReturn();
	else if (__type == MEMO_BOX_ITEM_TITLE && __listener)
		__listener->onAddRequested(__entryObj, MEMO_BOX_ITEM_TITLE, nullptr, this);
	// Text blocks keep their line breaks.
}

void MemoBoxItem::__onCheckReturn()
{
	Evas_Object *entry = __entryObj;
	const char *text = elm_entry_entry_get(entry);
	if (text && !strcmp(text, MEMO_BOX_LINE_BREAK)) {
		// Return on an empty check line leaves the list.
		elm_entry_entry_set(entry, nullptr);
		changeMode();
		__addTimer(focusAtEnd);
		return;
	}

	std::string before, after;
	__splitAtCursor(before, after, true);
	elm_entry_entry_set(entry, before.c_str());
	elm_entry_input_panel_enabled_set(entry, EINA_FALSE);
	elm_object_focus_set(entry, EINA_FALSE);
	elm_entry_cursor_end_set(entry);
	if (memoBoxStartsWith(after, MEMO_BOX_LINE_BREAK))
		after.erase(0, strlen(MEMO_BOX_LINE_BREAK));
	if (__listener)
		__listener->onAddRequested(entry, MEMO_BOX_ITEM_CHECK, after.c_str(), this);
}

void MemoBoxItem::__onEntryKeyDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	Evas_Event_Key_Down *ev = static_cast<Evas_Event_Key_Down *>(eventInfo);
	// A memo being read takes no editing keys.
	if (!ev || !ev->keyname || !self->__isEditable)
		return;
	// The entry has handled the key already: a Return has typed its break.
	if (!strcmp(ev->keyname, "Return") || !strcmp(ev->keyname, "KP_Enter")) {
		self->__onReturnKey();
		return;
	}
	if (!strcmp(ev->keyname, "BackSpace"))
		self->__onBackSpaceKey(obj);
}

void MemoBoxItem::__onBackSpaceKey(Evas_Object *entry)
{
	const int pos = elm_entry_cursor_pos_get(entry);
	// Only a press that finds the cursor at 0 where the previous one left it acts: the press that
	// deleted the last character before the cursor does not also remove the item.
	if (pos != 0 || __lastCursorPos != 0) {
		__lastCursorPos = pos;
		return;
	}

	if (memoBoxItemIsCheck(__type)) {
		if (!isEntryEmpty(entry)) {
			changeMode();
			__addTimer([](void *data) {
				MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
				if (self->__entryObj) {
					elm_entry_cursor_begin_set(self->__entryObj);
					self->__lastCursorPos = 0;
					elm_object_focus_set(self->__entryObj, EINA_TRUE);
				}
				return false;
			});
		} else {
			evas_object_event_callback_del_full(entry, EVAS_CALLBACK_KEY_DOWN, __onEntryKeyDownCb, this);
			changeMode();
			__addTimer(focusAtEnd);
		}
		__lastCursorPos = pos;
		return;
	}

	// The callback stays off also when the owner refuses, as for its only text item.
	evas_object_event_callback_del_full(entry, EVAS_CALLBACK_KEY_DOWN, __onEntryKeyDownCb, this);
	if (__listener)
		__listener->onUnpackRequested(entry, this);
	// The owner may have deleted this item: nothing of it is touched any more.
}
