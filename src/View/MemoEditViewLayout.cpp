// The edit view's contents: the colour and the scroller with the box control, the title bar, taps on the
// empty area, the switch from reading to editing, and what the box control reports.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>

#include <WNaviframeController.h>
#include <WUiTimer.h>

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

using app_assist::WUiTimer;

// A release this far or farther from its press, on either axis, was a drag.
static const int TAP_MOVE_LIMIT = 21;
// The naviframe item style of the page's title bar (theme group "elm/naviframe/item/memo_edit/default").
static const char *const TITLE_BAR_STYLE = "memo_edit";

int MemoEditView::__findPaletteIndex(int red, int green, int blue, int alpha) const
{
	for (int i = 0; i < PALETTE_SIZE; i++) {
		if (__palette[i][0] == red && __palette[i][1] == green && __palette[i][2] == blue && __palette[i][3] == alpha)
			return i;
	}
	return 0;
}

void MemoEditView::__createContentsLayout(Evas_Object *parent)
{
	if (!parent) {
		MEMO_LOGE("Parent is null");
		return;
	}
	elm_object_part_content_unset(parent, "edit_view_contents");
	elm_object_part_content_unset(parent, "changeable_bg");
	if (__scroller) {
		evas_object_event_callback_del_full(__scroller, EVAS_CALLBACK_MOUSE_DOWN, __scrollerMouseDownCb, this);
		evas_object_event_callback_del_full(__scroller, EVAS_CALLBACK_MOUSE_UP, __scrollerMouseUpCb, this);
		// The box control inside goes with it.
		evas_object_del(__scroller);
		__scroller = nullptr;
		__boxControl = nullptr;
	}
	if (__bgObject) {
		evas_object_del(__bgObject);
		__bgObject = nullptr;
	}

	if (MemoUtil::isQuickMemoFeatureEnabled()) {
		Evas_Object *bg = elm_bg_add(parent);
		int rgba[4] = {__palette[0][0], __palette[0][1], __palette[0][2], __palette[0][3]};
		__colorIndex = 0;
		if (__info) {
			__info->getBgColorRgba(&rgba[0], &rgba[1], &rgba[2], &rgba[3]);
			__colorIndex = __findPaletteIndex(rgba[0], rgba[1], rgba[2], rgba[3]);
		}
		// A colour that is no palette row shows as it is.
		elm_bg_color_set(bg, rgba[0], rgba[1], rgba[2]);
		evas_object_show(bg);
		elm_object_part_content_set(parent, "changeable_bg", bg);
		__bgObject = bg;
	}

	Evas_Object *scroller = elm_scroller_add(parent);
	elm_object_style_set(scroller, "effect");
	elm_scroller_bounce_set(scroller, EINA_FALSE, EINA_TRUE);
	elm_scroller_policy_set(scroller, ELM_SCROLLER_POLICY_OFF, ELM_SCROLLER_POLICY_AUTO);
	evas_object_size_hint_weight_set(scroller, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(scroller, EVAS_HINT_FILL, EVAS_HINT_FILL);
	elm_object_part_content_set(parent, "edit_view_contents", scroller);
	evas_object_event_callback_add(scroller, EVAS_CALLBACK_MOUSE_DOWN, __scrollerMouseDownCb, this);
	evas_object_event_callback_add(scroller, EVAS_CALLBACK_MOUSE_UP, __scrollerMouseUpCb, this);
	__scroller = scroller;

	MemoBoxControl *control = new MemoBoxControl(__info, __mode, __UUID);
	if (control->create(scroller, nullptr)) {
		__boxControl = control;
		control->getSignal().addListener([this](const char *signal, void *data) { __onBoxSignal(signal, data); },
		                                 control->getEvasObj());
	} else {
		MEMO_LOGE("box control can not be made");
		control->destroy();
	}

	if (__mode == MODE_VIEW)
		WUiTimer::addIdler(
		    [scroller](void *) {
			    elm_scroller_page_show(scroller, 0, 0);
			    return false;
		    },
		    nullptr, scroller);
	evas_object_show(scroller);
}

// What the box composes now stands for "unchanged": tags and attributes come back from the editor in its
// own spelling, which may differ from what was stored.
void MemoEditView::__takeBaseline()
{
	if (!__boxControl || !__info)
		return;
	char *content = __boxControl->getTodoListXmlN();
	char *title = __boxControl->getTitleTextN();
	__info->setTizenXmlContent(content ? content : "");
	if (title && *title)
		__info->setTitle(title);
	free(content);
	free(title);
}

void MemoEditView::__scrollerMouseDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	Evas_Event_Mouse_Down *ev = static_cast<Evas_Event_Mouse_Down *>(eventInfo);
	if (!self || !ev)
		return;
	self->__downX = ev->canvas.x;
	self->__downY = ev->canvas.y;
}

void MemoEditView::__scrollerMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)obj;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	Evas_Event_Mouse_Up *ev = static_cast<Evas_Event_Mouse_Up *>(eventInfo);
	if (self && ev)
		self->__onScrollerMouseUp(ev->canvas.x, ev->canvas.y);
}

void MemoEditView::__onScrollerMouseUp(int x, int y)
{
	if (!__boxControl)
		return;
	bool closedSelector = false;
	if (__mode != MODE_VIEW && __colorSelector) {
		// The colour selector closes on any tap below the title's top, on the text or not.
		MemoBoxItem *title = __boxControl->getTitleItem();
		Evas_Coord titleY = 0;
		if (title && title->getLayout())
			evas_object_geometry_get(title->getLayout(), nullptr, &titleY, nullptr, nullptr);
		if (titleY < y) {
			__closeColorSelector(true);
			closedSelector = true;
		}
	}
	if (!closedSelector) {
		MemoBoxItem *last = __boxControl->getLastItem();
		if (last && last->getLayout()) {
			Evas_Coord lastY = 0, lastH = 0;
			evas_object_geometry_get(last->getLayout(), nullptr, &lastY, nullptr, &lastH);
			if (y < lastY + lastH)
				return; // on the text: the item handles it
		}
		if (abs(x - __downX) >= TAP_MOVE_LIMIT || abs(y - __downY) >= TAP_MOVE_LIMIT)
			return;
		MemoUtil::playTapFeedback();
		if (__mode == MODE_VIEW) {
			__changeToUpdateMode();
			return;
		}
	}
	__focusEntry(true);
}

void MemoEditView::__focusEntry(bool showKeypad)
{
	MemoBoxItem *item = __boxControl ? __boxControl->getFocusedItem() : nullptr;
	Evas_Object *entry = item ? item->getEntry() : nullptr;
	if (!entry)
		return;
	elm_object_focus_set(entry, EINA_TRUE);
	if (showKeypad)
		elm_entry_input_panel_show(entry);
}

void MemoEditView::__changeToUpdateMode()
{
	if (__mode != MODE_VIEW)
		return;
	__mode = MODE_UPDATE;
	MEMO_LOGD("read view turned into an edit");
	elm_object_signal_emit(getEvasObj(), "change,edit", "elm");
	__createContentsLayout(getEvasObj());
	__createTitleBar();
	__updateRotationSignal();
	if (!__player && !__recorder && !MemoUtil::isRecorderBusy() && !MemoUtil::isPowerSavingMode())
		__updateAudioBtnStatus(true);
	else
		__updateAudioBtnStatus(false);
	if (__player) {
		// The player of an edit has its delete button.
		__destroyPlayer();
		__createPlayer(true);
	}
}

void MemoEditView::__createTitleBar()
{
	Elm_Object_Item *naviItem = getNaviItem();
	if (!naviItem) {
		MEMO_LOGE("naviItem is NULL");
		return;
	}
	for (Evas_Object **button : {&__cancelBtn, &__doneBtn}) {
		if (!*button)
			continue;
		evas_object_event_callback_del_full(*button, EVAS_CALLBACK_DEL, __titleBtnDelCb, this);
		evas_object_del(*button);
		*button = nullptr;
	}
	elm_naviframe_item_style_set(naviItem, TITLE_BAR_STYLE);
	elm_naviframe_item_title_enabled_set(naviItem, EINA_TRUE, EINA_FALSE);
	// Reading, the naviframe's back button may show; editing, Cancel takes its place.
	elm_object_item_signal_emit(naviItem, __mode == MODE_VIEW ? "memo,title,view" : "memo,title,edit", "app");
	if (__mode == MODE_VIEW)
		return;
	const char *title = __mode == MODE_UPDATE ? "IDS_MEMO_HEADER_EDIT_ABB2" : "IDS_MEMO_HEADER_CREATE_M_COMPOSE_ABB";
	elm_object_item_domain_translatable_part_text_set(naviItem, "elm.text.title", "memo-sub", title);

	Evas_Object *naviframe = getNaviframeController() ? getNaviframeController()->getEvasObj() : getEvasObj();
	__cancelBtn = elm_button_add(naviframe);
	elm_object_style_set(__cancelBtn, "naviframe/title_left");
	elm_object_domain_translatable_text_set(__cancelBtn, "memo-sub", "IDS_MEMO_ACBUTTON_CANCEL_ABB2");
	evas_object_smart_callback_add(__cancelBtn, "clicked", __cancelBtnCb, this);
	evas_object_event_callback_add(__cancelBtn, EVAS_CALLBACK_DEL, __titleBtnDelCb, this);
	elm_object_item_part_content_set(naviItem, "title_left_btn", __cancelBtn);

	__doneBtn = elm_button_add(naviframe);
	elm_object_style_set(__doneBtn, "naviframe/title_right");
	elm_object_domain_translatable_text_set(__doneBtn, "memo-sub", "IDS_MEMO_ACBUTTON_DONE_ABB2");
	evas_object_smart_callback_add(__doneBtn, "clicked", __doneBtnCb, this);
	evas_object_event_callback_add(__doneBtn, EVAS_CALLBACK_DEL, __titleBtnDelCb, this);
	elm_object_item_part_content_set(naviItem, "title_right_btn", __doneBtn);

	// Done waits for content on a new memo; an edit may be saved as it stands.
	__updateDoneBtnStatus(__mode == MODE_UPDATE);
}

void MemoEditView::__updateDoneBtnStatus(bool enable)
{
	if (!__doneBtn) {
		MEMO_LOGE("Done button is null");
		return;
	}
	if (elm_object_disabled_get(__doneBtn) == (Eina_Bool)enable)
		elm_object_disabled_set(__doneBtn, !enable);
}

void MemoEditView::__updateAudioBtnStatus(bool enable)
{
	if (!__audioBtn) {
		MEMO_LOGE("Audio button is null");
		return;
	}
	if (elm_object_disabled_get(__audioBtn) == (Eina_Bool)enable)
		elm_object_disabled_set(__audioBtn, !enable);
}

void MemoEditView::__onBoxSignal(const char *signal, void *data)
{
	(void)data;
	if (!signal)
		return;
	if (!strcmp(signal, "action,done,enable")) {
		__updateDoneBtnStatus(true);
	} else if (!strcmp(signal, "action,done,disable")) {
		// With no recorder at all this deliberately changes nothing: Done once lit stays lit.
		if ((!__player || __isPlayerDeleted) && __recorder && !__isRecording())
			__updateDoneBtnStatus(false);
	} else if (!strcmp(signal, "action,mode,change")) {
		if (__mode == MODE_VIEW)
			WUiTimer::addIdler(
			    [this](void *) {
				    __changeToUpdateMode();
				    return false;
			    },
			    nullptr, getEvasObj());
	} else if (!strcmp(signal, "action,image,selected")) {
		__onImageSelected(static_cast<const char *>(data));
	} else if (!strcmp(signal, "action,imagepopup,show")) {
		__showProcessingPopup();
	} else if (!strcmp(signal, "action,imagepopup,hide")) {
		if (__processingPopup)
			evas_object_del(__processingPopup);
	}
}

// While an item shrinks a picture: a progress popup at the foot of the page.
void MemoEditView::__showProcessingPopup()
{
	if (__processingPopup)
		return;
	Evas_Object *popup = elm_popup_add(getEvasObj());
	elm_popup_align_set(popup, ELM_NOTIFY_ALIGN_FILL, 1.0);
	Evas_Object *layout = elm_layout_add(popup);
	elm_layout_file_set(layout, MemoUtil::getEdjePath(), "processing_view_layout");
	elm_object_domain_translatable_part_text_set(layout, "elm.text", "memo-sub", "IDS_MEMO_TPOP_INSERTING_IMAGE_ING");
	Evas_Object *progress = elm_progressbar_add(layout);
	elm_object_style_set(progress, "process_medium");
	evas_object_size_hint_align_set(progress, EVAS_HINT_FILL, 0.5);
	elm_progressbar_pulse_set(progress, EINA_TRUE);
	elm_progressbar_pulse(progress, EINA_TRUE);
	evas_object_show(progress);
	elm_object_part_content_set(layout, "processing", progress);
	elm_object_content_set(popup, layout);
	evas_object_event_callback_add(popup, EVAS_CALLBACK_DEL, __processingPopupDelCb, this);
	evas_object_show(popup);
	__processingPopup = popup;
}

void MemoEditView::__processingPopupDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)eventInfo;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (self && self->__processingPopup == obj)
		self->__processingPopup = nullptr;
}

void MemoEditView::__titleBtnDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo)
{
	(void)e;
	(void)eventInfo;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self)
		return;
	if (self->__cancelBtn == obj)
		self->__cancelBtn = nullptr;
	if (self->__doneBtn == obj)
		self->__doneBtn = nullptr;
}

void MemoEditView::__releaseOutsideObjects()
{
	if (__cancelBtn) {
		evas_object_event_callback_del_full(__cancelBtn, EVAS_CALLBACK_DEL, __titleBtnDelCb, this);
		evas_object_smart_callback_del_full(__cancelBtn, "clicked", __cancelBtnCb, this);
		__cancelBtn = nullptr;
	}
	if (__doneBtn) {
		evas_object_event_callback_del_full(__doneBtn, EVAS_CALLBACK_DEL, __titleBtnDelCb, this);
		evas_object_smart_callback_del_full(__doneBtn, "clicked", __doneBtnCb, this);
		__doneBtn = nullptr;
	}
	if (__processingPopup) {
		evas_object_event_callback_del_full(__processingPopup, EVAS_CALLBACK_DEL, __processingPopupDelCb, this);
		evas_object_del(__processingPopup);
		__processingPopup = nullptr;
	}
}
