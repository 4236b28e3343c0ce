// The PIN view's page: its layout and four entries, the raw key handler, the back key.
#include "View/MemoHiddenPasswordView.h"

#include <cstring>

#include <efl_extension.h>

#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"
#include "View/MemoHiddenPinLock.h"
#include "View/MemoHiddenTitle.h"
#include "MemoViewParts.h"

namespace
{
const char LAYOUT_GROUP[] = "memo.hidden.password";
// Two blanks as the theme has always had them.
const char ENTRY_STYLE[] = "DEFAULT='font_size=40  font_weight=Bold color=#000000 align=center'";
const char *const ENTRY_PARTS[] = {"entry1", "entry2", "entry3", "entry4"};
// Keys that never count towards a PIN, whatever the entry: the device's hardware keys, and the desktop keys
// that stand in for back (Escape, XF86Stop) and more (Menu, F2, XF86Send).
const char *const IGNORED_KEYS[] = {"XF86Back",
                                    "XF86Menu",
                                    "Return",
                                    "XF86PowerOff",
                                    "XF86Home",
                                    "XF86AudioLowerVolume",
                                    "XF86AudioRaiseVolume",
                                    "Cancel",
                                    "Escape",
                                    "XF86Stop",
                                    "Menu",
                                    "F2",
                                    "XF86Send"};
} // namespace

MemoHiddenPasswordView::MemoHiddenPasswordView(MemoListView *parent)
    : __parent(parent), __layout(nullptr), __entries(), __index(0), __isCreateMode(true), __isFirstEntry(true),
      __isChangePin(false), __isResetting(false), __limit(), __firstPin(), __secondPin(), __keyHandler(nullptr),
      __isFromSettings(false), __popOnBecomeTop(false)
{
	__limit.max_char_count = 1;
	__limit.max_byte_count = 0;
}

MemoHiddenPasswordView::~MemoHiddenPasswordView()
{
	if (__keyHandler)
		ecore_event_handler_del(__keyHandler);
}

const char *MemoHiddenPasswordView::getClassName() const
{
	return "MemoHiddenPasswordView";
}

void MemoHiddenPasswordView::setChangePin(bool isChangePin)
{
	__isChangePin = isChangePin;
}

void MemoHiddenPasswordView::setFromSettings(bool isFromSettings)
{
	__isFromSettings = isFromSettings;
}

Evas_Object *MemoHiddenPasswordView::__createEntry(Evas_Object *layout, int number)
{
	Evas_Object *entry = elm_entry_add(layout);
	elm_entry_single_line_set(entry, EINA_TRUE);
	elm_entry_input_panel_layout_set(entry, ELM_INPUT_PANEL_LAYOUT_DATETIME);
	elm_entry_input_panel_layout_variation_set(entry, 1);
	elm_entry_markup_filter_append(entry, elm_entry_filter_limit_size, &__limit);
	elm_entry_text_style_user_push(entry, ENTRY_STYLE);
	elm_entry_input_panel_return_key_disabled_set(entry, EINA_TRUE);
	evas_object_data_set(entry, "pin.index", reinterpret_cast<void *>(static_cast<intptr_t>(number)));
	evas_object_smart_callback_add(entry, "focused", __entryFocusedCb, this);
	elm_object_part_content_set(layout, ENTRY_PARTS[number], entry);
	return entry;
}

Evas_Object *MemoHiddenPasswordView::onCreateView(Evas_Object *parent, void *param)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	char stored[PIN_DIGEST_BUFFER_SIZE] = {};
	if (MemoDbMgr::getInstance()->getHiddenMemoPassword(stored))
		__isCreateMode = false;

	if (!memoViewPageLayoutAdd(parent, LAYOUT_GROUP, &__layout))
		MEMO_LOGE("group %s not found", LAYOUT_GROUP);
	__setBarText(__isCreateMode ? "IDS_MEMO_HEADER_CREATE_PIN" : "IDS_MEMO_HEADER_ENTER_PIN");
	for (int i = 0; i < PIN_LENGTH; i++)
		__entries[i] = __createEntry(__layout, i);

	__keyHandler = ecore_event_handler_add(ECORE_EVENT_KEY_DOWN, __keyboardPressedCb, this);

	Evas_Object *button = elm_button_add(__layout);
	elm_object_style_set(button, "bottom");
	// Every key is a character of the PIN: none may press this button.
	elm_object_focus_allow_set(button, EINA_FALSE);
	elm_object_domain_translatable_text_set(button, "memo-sub", "IDS_MEMO_BUTTON_FORGOTTEN_PIN_ABB");
	evas_object_smart_callback_add(button, "clicked", __forgottenPinCb, this);
	elm_object_part_content_set(__layout, "bottom", button);

	eext_object_event_callback_add(__layout, EEXT_CALLBACK_BACK, __backBtnCb, this);
	if (!__isCreateMode)
		__showLock();
	evas_object_show(__layout);
	return __layout;
}

void MemoHiddenPasswordView::onPushed(Elm_Object_Item *naviItem)
{
	memoHiddenTitleSet(naviItem, "IDS_MEMO_HEADER_HIDDEN_MODE_ABB", __backBtnCb, this);
	__focusEntry(0);
}

void MemoHiddenPasswordView::onBecomeTop()
{
	if (__popOnBecomeTop && __isTop())
		popOut();
}

void MemoHiddenPasswordView::onDestroy()
{
	if (__keyHandler)
		ecore_event_handler_del(__keyHandler);
	__keyHandler = nullptr;
	app_assist::WUiTimer::deleteTimer(__pauseTimer);
	app_assist::WUiTimer::deleteTimer(__lockTimer);
}

bool MemoHiddenPasswordView::__isTop()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}

void MemoHiddenPasswordView::__backBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoHiddenPasswordView *self = static_cast<MemoHiddenPasswordView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->popOut();
}

void MemoHiddenPasswordView::__entryFocusedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)eventInfo;
	MemoHiddenPasswordView *self = static_cast<MemoHiddenPasswordView *>(data);
	if (self)
		self->__index = static_cast<int>(reinterpret_cast<intptr_t>(evas_object_data_get(obj, "pin.index")));
}

Eina_Bool MemoHiddenPasswordView::__keyboardPressedCb(void *data, int type, void *event)
{
	(void)type;
	MemoHiddenPasswordView *self = static_cast<MemoHiddenPasswordView *>(data);
	if (!self) {
		MEMO_LOGE("sefl is NULL");
		return ECORE_CALLBACK_PASS_ON;
	}
	const Ecore_Event_Key *key = static_cast<const Ecore_Event_Key *>(event);
	// Keys typed while another page covers this one are not this page's.
	if (key && key->keyname && self->__isTop())
		self->__onKey(key->keyname);
	return ECORE_CALLBACK_PASS_ON;
}

void MemoHiddenPasswordView::__onKey(const char *keyName)
{
	for (const char *ignored : IGNORED_KEYS)
		if (!strcmp(keyName, ignored))
			return;
	if (!strcmp(keyName, "BackSpace")) {
		if (__index == 0)
			return;
		// The previous character goes: its entry takes the focus again, emptied. The focus callback sets the
		// index as well, but not while the window is without focus.
		const int previous = __index - 1;
		elm_object_text_set(__entries[previous], "");
		__focusEntry(previous);
		elm_entry_cursor_next(__entries[previous]);
		__index = previous;
		return;
	}
	if (!__isCreateMode && __showLock()) {
		// The entry took the key as typed text before this handler saw it.
		if (__index >= 0 && __index < PIN_LENGTH)
			elm_object_text_set(__entries[__index], "");
		return;
	}
	if (__index < 0 || __index >= PIN_LENGTH)
		__index = 0;
	// Any key counts, by the first letter of its name.
	(__isFirstEntry ? __firstPin : __secondPin)[__index] = keyName[0];
	elm_object_text_set(__entries[__index], "*");
	if (__index == PIN_LENGTH - 1) {
		__onFourthKey();
		return;
	}
	const int next = __index + 1;
	__focusEntry(next);
	__index = next;
}

void MemoHiddenPasswordView::__setBarText(const char *textId)
{
	if (__layout)
		elm_object_domain_translatable_part_text_set(__layout, "pin.bar.text", "memo-sub", textId);
}

void MemoHiddenPasswordView::__clearEntries()
{
	for (Evas_Object *entry : __entries)
		if (entry)
			elm_object_text_set(entry, "");
	__index = 0;
	__focusEntry(0);
}

void MemoHiddenPasswordView::__focusEntry(int index)
{
	if (index >= 0 && index < PIN_LENGTH && __entries[index])
		elm_object_focus_set(__entries[index], EINA_TRUE);
}
