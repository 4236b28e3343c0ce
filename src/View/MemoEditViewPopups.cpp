// Leaving the edit view: Cancel and back, the discard question, the storage and delete popups.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <string>

#include <Ecore_File.h>
#include <WNaviframeController.h>
#include <WPopupController.h>
#include <WUiTimer.h>
#include <app_i18n.h>
#include <notification.h>

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "Model/MemoPopupMonitor.h"
#include "Util/MemoUtil.h"
#include "View/MemoStorageFull.h"

using app_assist::WPopupController;
using app_assist::WUiTimer;

// Leaving waits this long after a tap, so that its feedback is seen first.
static const double POP_DELAY = 0.1;

namespace
{
// The page's own popup look (theme style "memo"): the first answer quiet, the second in `answerStyle`.
void styleQuestion(WPopupController *popup, const char *answerStyle)
{
	popup->setOnAddProperties([answerStyle](Evas_Object *obj) {
		elm_object_style_set(obj, "memo");
		Evas_Object *first = elm_object_part_content_get(obj, "button1");
		Evas_Object *second = elm_object_part_content_get(obj, "button2");
		if (first)
			elm_object_style_set(first, "memo_popup/cancel");
		if (second)
			elm_object_style_set(second, answerStyle);
	});
}

void dropKeypad(MemoBoxItem *item)
{
	Evas_Object *entry = item ? item->getEntry() : nullptr;
	if (!entry)
		return;
	elm_entry_input_panel_enabled_set(entry, EINA_FALSE);
	elm_entry_input_panel_hide(entry);
}
} // namespace

bool MemoEditView::__isTop() const
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}

void MemoEditView::__popOutLater(bool removeMedia)
{
	WUiTimer::addTimer(
	    POP_DELAY,
	    [this, removeMedia](void *) {
		    if (removeMedia && __mediaPath)
			    ecore_file_recursive_rm(__mediaPath);
		    if (__isTop())
			    popOut();
		    return false;
	    },
	    nullptr, getEvasObj());
}

void MemoEditView::__cancelBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->__destroyAttachPanel();
	self->__createDiscardPopup();
}

void MemoEditView::__backBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	// Back closes the colour selector first; otherwise it is Cancel.
	if (self->__colorSelector) {
		self->__closeColorSelector(true);
		return;
	}
	__cancelBtnCb(data, obj, eventInfo);
}

void MemoEditView::__createDiscardPopup()
{
	char *content = __boxControl ? __boxControl->getTodoListXmlN() : nullptr;
	char *title = __boxControl ? __boxControl->getTitleTextN() : nullptr;
	const bool empty = (!content || !*content) && (!title || !*title);
	free(content);
	free(title);

	if (!__info && empty && !__isRecording() && !__isRecorderUpdated()) {
		// Nothing was written: the new memo's folder goes, without a question.
		__popOutLater(true);
		return;
	}
	if ((__info && !__isChanged()) || __mode == MODE_VIEW) {
		__popOutLater(false);
		return;
	}

	WPopupController *popup = new WPopupController();
	popup->setTextTranslatable("memo-sub");
	popup->setTitle("IDS_MEMO_HEADER_DISCARD_CHANGES_ABB3");
	popup->setContent("IDS_MEMO_POP_ALL_CHANGES_WILL_BE_DISCARDED_M_CLOSE");
	popup->addButton("IDS_MEMO_BUTTON_CANCEL", [this](bool *close) {
		*close = true;
		__focusEntry(false);
	});
	popup->addButton("IDS_MEMO_BUTTON_DISCARD_M_CLOSE_ABB", [this](bool *close) {
		*close = true;
		__discard();
	});
	styleQuestion(popup, "memo_popup/danger");
	MemoPopupMonitor::getInstance()->addPopup(popup);
	attachPopup(popup);
}

void MemoEditView::__discard()
{
	__isDiscarded = true;
	MemoBoxItem *focused = __boxControl ? __boxControl->getFocusedItem() : nullptr;
	if (focused)
		dropKeypad(focused);
	if (__boxControl && (!__info || !__info->getIsQuick()))
		dropKeypad(__boxControl->getTitleItem());
	// A discarded edit keeps its folder: what it added stays until a later save tidies it.
	if ((__mode == MODE_NEW || __mode == MODE_NEW_EXTERNAL) && __mediaPath)
		ecore_file_recursive_rm(__mediaPath);
	__popOutLater(false);
}

void MemoEditView::__createStorageFullPopup()
{
	WPopupController *popup = memoStorageFullPopupN([this] { __focusEntry(false); });
	if (!popup)
		return;
	styleQuestion(popup, "memo_popup/confirm");
	MemoPopupMonitor::getInstance()->addPopup(popup);
	attachPopup(popup);
}

void MemoEditView::__launchStorageSettings()
{
	memoLaunchStorageSettings();
}

void MemoEditView::__createDeletePopup()
{
	WPopupController *popup = new WPopupController();
	popup->setTextTranslatable("memo-sub");
	popup->setTitle("IDS_MEMO_BUTTON_DELETE");
	if (__info && __info->getIsQuick()) {
		// The line breaks of the text become markup breaks (the replacement runs on the message id).
		std::string text = "IDS_MEMO_POP_THIS_QUICK_MEMO_WILL_BE_DELETED_MSG";
		for (size_t at = text.find('\n'); at != std::string::npos; at = text.find('\n', at))
			text.replace(at, 1, "<br/>");
		popup->setContent(text.c_str());
	} else {
		popup->setContent("IDS_MEMO_POP_THIS_MEMO_WILL_BE_DELETED");
	}
	popup->addButton("IDS_MEMO_BUTTON_CANCEL", [](bool *close) { *close = true; });
	popup->addButton("IDS_MEMO_BUTTON_DELETE", [this](bool *close) {
		MemoDbMgr *db = MemoDbMgr::getInstance();
		if (db)
			db->removeMemo(__UUID);
		*close = true;
		__popOutLater(false);
	});
	styleQuestion(popup, "memo_popup/danger");
	MemoPopupMonitor::getInstance()->addPopup(popup);
	attachPopup(popup);
}
