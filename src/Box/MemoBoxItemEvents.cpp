// Pointer and text events of a box item: the entry's smart callbacks, taps versus drags, the check
// and the favourite star. Every decision about other items goes to the listener.
#include "Box/MemoBoxItem.h"

#include <app_i18n.h>
#include <feedback.h>
#include <notification_status.h>

#include <cstdlib>

#include "MemoBoxItemPrivate.h"
#include "MemoLog.h"

void MemoBoxItem::__onEntryChangedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	self->__lastCursorPos = elm_entry_cursor_pos_get(obj);
	if (self->__listener)
		self->__listener->onEntryChanged(obj, self);
	if (self->__type == MEMO_BOX_ITEM_FIRST_TEXT && self->__entryObj && isEntryEmpty(self->__entryObj) &&
	    self->__listener)
		self->__listener->onCheckGuideText(self);
}

void MemoBoxItem::__onEntryFocusedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	if (!self->__listener)
		return;
	self->__listener->onFocusChanged(obj, self);
	if (self->__listener)
		self->__listener->onCheckGuideText(self);
}

void MemoBoxItem::__onEntryClickedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	static_cast<MemoBoxItem *>(data)->__lastCursorPos = elm_entry_cursor_pos_get(obj);
}

void MemoBoxItem::__onEntryLongPressedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	static_cast<MemoBoxItem *>(data)->__longPressed = true;
}

void MemoBoxItem::__onEntryMaxLengthCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	if (self->__listener)
		self->__listener->onMaxLengthReached(obj, self);
	notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_CANT_ENTER_MORE_CHARACTERS"));
}

void MemoBoxItem::__onEntryMouseDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	Evas_Event_Mouse_Down *ev = static_cast<Evas_Event_Mouse_Down *>(eventInfo);
	self->__pressX = ev->canvas.x;
	self->__pressY = ev->canvas.y;
}

void MemoBoxItem::__onEntryMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	Evas_Event_Mouse_Up *ev = static_cast<Evas_Event_Mouse_Up *>(eventInfo);

	if (self->__longPressed) {
		self->__longPressed = false;
		return;
	}
	if (self->__ignoreMouseUp) {
		self->__ignoreMouseUp = false;
		return;
	}
	if (abs(ev->canvas.x - self->__pressX) > MEMO_BOX_TAP_MOVE_LIMIT ||
	    abs(ev->canvas.y - self->__pressY) > MEMO_BOX_TAP_MOVE_LIMIT)
		return;

	if (!elm_object_focus_get(obj)) {
		MEMO_LOGI("Item focus changed.");
		Evas_Object *textblock = elm_entry_textblock_get(obj);
		if (textblock) {
			Evas_Coord tx = 0, ty = 0;
			evas_object_geometry_get(textblock, &tx, &ty, nullptr, nullptr);
			evas_textblock_cursor_cluster_coord_set(evas_object_textblock_cursor_get(textblock), ev->canvas.x - tx,
			                                        ev->canvas.y - ty);
		}
	}

	const bool isTitle = self->__type == MEMO_BOX_ITEM_TITLE || self->__type == MEMO_BOX_ITEM_QUICK_TITLE;
	const char *path = isTitle ? nullptr : self->getSelectedImagePath(ev->canvas.x, ev->canvas.y);
	if (isTitle || !path || !self->__isEditable) {
		if (self->__listener)
			self->__listener->onChangeModeRequeted();
		return;
	}

	elm_entry_input_panel_hide(obj);
	if (self->__listener)
		self->__listener->suspendKeypad();
	// The path is copied: the image object that holds it may go before the idler runs.
	self->__addIdler([selected = std::string(path)](void *idlerData) {
		MemoBoxItem *item = static_cast<MemoBoxItem *>(idlerData);
		if (item->__listener)
			item->__listener->onImageSelected(selected.c_str());
		return false;
	});
}

void MemoBoxItem::__onCheckChangedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	if (obj != self->__checkObj)
		return;
	const bool state = elm_check_state_get(obj);
	const int pos = self->__entryObj ? elm_entry_cursor_pos_get(self->__entryObj) : 0;
	self->__pushTextStyle(state);
	if (self->__entryObj)
		elm_entry_cursor_pos_set(self->__entryObj, pos);
}

void MemoBoxItem::__onCheckMouseDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	// No jump to the focused entry while the check is pressed.
	elm_config_focus_autoscroll_mode_set(ELM_FOCUS_AUTOSCROLL_MODE_NONE);
	if (self->__listener)
		self->__listener->suspendKeypad();
}

void MemoBoxItem::__onCheckMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	self->__addIdler([](void *idlerData) {
		MemoBoxItem *item = static_cast<MemoBoxItem *>(idlerData);
		if (item->__listener) {
			item->__listener->resumeKeypad();
			item->__listener->onFocusCurrentItem();
		}
		return false;
	});
	elm_config_focus_autoscroll_mode_set(ELM_FOCUS_AUTOSCROLL_MODE_SHOW);
}

void MemoBoxItem::__onFavoriteMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	if (!self->__favoriteObj)
		return;
	const bool wasOn = elm_check_state_get(self->__favoriteObj);
	elm_object_signal_emit(self->__favoriteObj, wasOn ? "elm,activate,check,off" : "elm,activate,check,on", "elm");
	elm_check_state_set(self->__favoriteObj, !wasOn);
	if (feedback_initialize() == FEEDBACK_ERROR_NONE) {
		feedback_play(FEEDBACK_PATTERN_TAP);
		feedback_deinitialize();
	}
	if (self->__listener)
		self->__listener->onFavoriteChanged(self->__favoriteObj, !wasOn, self);
}
