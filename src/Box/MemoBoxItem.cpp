// State and small operations of a box item; layouts, events, keys, mode change, filter and images
// live in the neighbouring MemoBoxItem*.cpp, MemoEntryFilter*.cpp and MemoBoxImage*.cpp files.
#include "Box/MemoBoxItem.h"

#include <app_i18n.h>

#include <algorithm>

#include "MemoBoxItemPrivate.h"
#include "Box/MemoContentMarkup.h"
#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Util/MemoUtil.h"

MemoBoxItem::MemoBoxItem(_MemoBoxItemType type, const char *memoUuid, bool isEditable)
    : __layoutObj(nullptr), __entryObj(nullptr), __checkObj(nullptr), __innerLayoutObj(nullptr), __favoriteObj(nullptr),
      __type(type), __listener(nullptr), __isEditable(isEditable), __imgPathList(nullptr), __imgObjList(nullptr),
      __limit(), __pressX(0), __pressY(0), __ignoreMouseUp(false), __longPressed(false), __resizeWidth(0),
      __resizeHeight(0), __resizeRatio(1.0f), __pendingThreads(0), __lastCursorPos(0),
      __memoUuid(memoUuid ? memoUuid : ""), __threadHandle(nullptr), __busListenerId(0)
{
	__limit.max_char_count = MEMO_BOX_BODY_CHAR_LIMIT;
	__limit.max_byte_count = 0;
}

MemoBoxItem::~MemoBoxItem()
{
	__listener = nullptr;
	for (const app_assist::WUiTimerHandle &timer : __timers)
		app_assist::WUiTimer::deleteTimer(timer);
	__timers.clear();

	Eina_List *l = nullptr;
	void *obj = nullptr;
	EINA_LIST_FOREACH(__imgObjList, l, obj)
	evas_object_event_callback_del_full(static_cast<Evas_Object *>(obj), EVAS_CALLBACK_DEL, __onImageObjDelCb, this);
	__imgObjList = eina_list_free(__imgObjList);

	void *path = nullptr;
	EINA_LIST_FREE(__imgPathList, path)
	free(path);

	__detachResizeJobs();

	// An owner may delete its items before their layouts. The widgets that call back into the item
	// go now, so that no focus move or key reaches it later; the empty outer layout stays the owner's.
	if (__layoutObj) {
		evas_object_event_callback_del_full(__layoutObj, EVAS_CALLBACK_DEL, __onLayoutDelCb, this);
		if (__busListenerId)
			MemoBroadCaster::getInstance().removeListener(__busListenerId);
		if (__innerLayoutObj) {
			elm_object_part_content_unset(__layoutObj, "content");
			evas_object_del(__innerLayoutObj);
		}
	}
}

Evas_Object *MemoBoxItem::create(Evas_Object *parent, void *param, IMemoBoxItemListener *listener)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("Parent is NULL");
		return nullptr;
	}
	Evas_Object *layout = elm_layout_add(parent);
	if (!layout || !elm_layout_file_set(layout, MemoUtil::getEdjePath(), "box_item_layout")) {
		MEMO_LOGE("box_item_layout can not be loaded");
		if (layout)
			evas_object_del(layout);
		return nullptr;
	}
	evas_object_size_hint_weight_set(layout, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(layout, EVAS_HINT_FILL, 0.0);
	evas_object_show(layout);
	__layoutObj = layout;
	__listener = listener;
	evas_object_event_callback_add(layout, EVAS_CALLBACK_DEL, __onLayoutDelCb, this);

	if (__type == MEMO_BOX_ITEM_TITLE || __type == MEMO_BOX_ITEM_QUICK_TITLE)
		__createTitleLayout();
	else
		__createInnerLayout();
	return __layoutObj;
}

void MemoBoxItem::setType(_MemoBoxItemType type)
{
	__type = type;
	switch (type) {
	case MEMO_BOX_ITEM_FIRST_TEXT:
		elm_object_signal_emit(__innerLayoutObj, "top,item", "elm");
		if (__listener)
			__listener->onCheckGuideText(this);
		break;
	case MEMO_BOX_ITEM_FIRST_CHECK:
	case MEMO_BOX_ITEM_QUICK_TEXT:
		elm_object_signal_emit(__innerLayoutObj, "top,item", "elm");
		break;
	case MEMO_BOX_ITEM_TEXT:
	case MEMO_BOX_ITEM_CHECK:
		elm_object_signal_emit(__innerLayoutObj, "normal,item", "elm");
		break;
	default:
		break;
	}
}

void MemoBoxItem::insertText(const char *text)
{
	if (!__entryObj) {
		if (!__innerLayoutObj)
			return;
		if (__type == MEMO_BOX_ITEM_QUICK_TITLE)
			elm_object_domain_translatable_part_text_set(__innerLayoutObj, "title", MEMO_SUB_DOMAIN,
			                                             "IDS_MEMO_HEADER_QUICK_MEMO");
		else
			elm_object_part_text_set(__innerLayoutObj, "title", text);
		return;
	}
	elm_entry_entry_insert(__entryObj, text);
	if (__type == MEMO_BOX_ITEM_FIRST_TEXT) {
		__addIdler([](void *data) {
			MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
			if (self->__entryObj) {
				elm_object_focus_set(self->__entryObj, EINA_TRUE);
				elm_entry_cursor_end_set(self->__entryObj);
			}
			return false;
		});
	}
}

bool MemoBoxItem::getCheckStatus()
{
	if (!__checkObj) {
		MEMO_LOGE("check object is NULL");
		return false;
	}
	return elm_check_state_get(__checkObj);
}

void MemoBoxItem::setCheckStatus(bool state)
{
	if (!__checkObj) {
		MEMO_LOGE("check object is NULL");
		return;
	}
	elm_check_state_set(__checkObj, state);
	__pushTextStyle(state);
}

bool MemoBoxItem::getFavoriteStatus()
{
	if (!__favoriteObj) {
		MEMO_LOGE("__favoriteObj is NULL");
		return false;
	}
	return elm_check_state_get(__favoriteObj);
}

void MemoBoxItem::setFavoriteStatus(bool state)
{
	if (!__favoriteObj) {
		MEMO_LOGE("__favoriteObj is NULL");
		return;
	}
	elm_check_state_set(__favoriteObj, state);
}

void MemoBoxItem::showGuideText(bool show)
{
	if (!__entryObj) {
		MEMO_LOGE("__entryObj is NULL");
		return;
	}
	if (__type == MEMO_BOX_ITEM_FIRST_TEXT && __isEditable && isEntryEmpty(__entryObj) && show)
		elm_object_domain_translatable_part_text_set(__entryObj, "elm.guide", MEMO_SUB_DOMAIN, "IDS_MEMO_BODY_MEMO");
	else
		elm_object_domain_translatable_part_text_set(__entryObj, "elm.guide", nullptr, "");
}

char *MemoBoxItem::getContentMarkupN()
{
	if (!__entryObj)
		return strdup("");
	return memoSavedMarkupN(elm_entry_entry_get(__entryObj));
}

void MemoBoxItem::setLimit(int maxChars)
{
	__limit.max_char_count = maxChars;
	__limit.max_byte_count = 0;
	if (!__entryObj)
		return;
	elm_entry_markup_filter_remove(__entryObj, elm_entry_filter_limit_size, &__limit);
	elm_entry_markup_filter_append(__entryObj, elm_entry_filter_limit_size, &__limit);
}

bool MemoBoxItem::isEntryEmpty(Evas_Object *entry)
{
	const char *markup = entry ? elm_entry_entry_get(entry) : nullptr;
	if (!markup || !*markup)
		return true;
	// Format tags left behind by deleted text show nothing; breaks, tabs and pictures come out as
	// characters of their own.
	char *plain = elm_entry_markup_to_utf8(markup);
	const bool empty = !plain || !*plain;
	free(plain);
	return empty;
}

void MemoBoxItem::__onLayoutDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	(void)eventInfo;
	MemoBoxItem *self = static_cast<MemoBoxItem *>(data);
	// Everything inside goes with it; the bus drops its listener by itself.
	self->__layoutObj = nullptr;
	self->__innerLayoutObj = nullptr;
	self->__entryObj = nullptr;
	self->__checkObj = nullptr;
	self->__favoriteObj = nullptr;
	self->__busListenerId = 0;
}

void MemoBoxItem::__addTimer(std::function<bool(void *)> func)
{
	__timers.erase(std::remove_if(__timers.begin(), __timers.end(),
	                              [](const app_assist::WUiTimerHandle &timer) { return timer.expired(); }),
	               __timers.end());
	__timers.push_back(app_assist::WUiTimer::addTimer(0.0, std::move(func), this, __layoutObj));
}

void MemoBoxItem::__addIdler(std::function<bool(void *)> func)
{
	__timers.erase(std::remove_if(__timers.begin(), __timers.end(),
	                              [](const app_assist::WUiTimerHandle &timer) { return timer.expired(); }),
	               __timers.end());
	__timers.push_back(app_assist::WUiTimer::addIdler(std::move(func), this, __layoutObj));
}
