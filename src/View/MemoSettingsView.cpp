// The settings page and its row for hidden mode.
#include "View/MemoSettingsView.h"

#include <cstring>

#include <app_i18n.h>
#include <efl_extension.h>

#include <WNaviframeController.h>

#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"
#include "View/MemoHiddenFirstAccess.h"
#include "View/MemoHiddenPasswordView.h"
#include "View/MemoHiddenTitle.h"
#include "View/MemoListView.h"
#include "MemoViewParts.h"

MemoSettingsView::MemoSettingsView(MemoListView *parent)
    : __parent(parent), __genlist(nullptr), __row(nullptr), __rowTextId("IDS_MEMO_TMBODY_HIDDEN_MODE"), __clickCount(0),
      __backCount(0), __isFromSettings(true)
{
}

const char *MemoSettingsView::getClassName() const
{
	return "MemoSettingsView";
}

Evas_Object *MemoSettingsView::onCreateView(Evas_Object *parent, void *param)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	Evas_Object *layout = nullptr;
	if (!memoViewPageLayoutAdd(parent, "memo.settings", &layout))
		MEMO_LOGE("group memo.settings not found");
	__genlist = elm_genlist_add(layout);
	elm_genlist_mode_set(__genlist, ELM_LIST_COMPRESS);
	static Elm_Genlist_Item_Class rowClass = [] {
		Elm_Genlist_Item_Class itemClass = {};
		itemClass.version = ELM_GENLIST_ITEM_CLASS_VERSION;
		itemClass.item_style = "default";
		itemClass.func.text_get = __rowTextCb;
		return itemClass;
	}();
	__row = elm_genlist_item_append(__genlist, &rowClass, this, nullptr, ELM_GENLIST_ITEM_NONE, __rowClickedCb, this);
	elm_object_part_content_set(layout, "contents", __genlist);
	eext_object_event_callback_add(layout, EEXT_CALLBACK_BACK, __backBtnCb, this);
	evas_object_show(layout);
	return layout;
}

void MemoSettingsView::onPushed(Elm_Object_Item *naviItem)
{
	memoHiddenTitleSet(naviItem, "IDS_MEMO_OPT_SETTINGS", __backBtnCb, this);
}

char *MemoSettingsView::__rowTextCb(void *data, Evas_Object *obj, const char *part)
{
	(void)obj;
	MemoSettingsView *self = static_cast<MemoSettingsView *>(data);
	if (!self || strcmp(part, "elm.text"))
		return nullptr;
	return strdup(i18n_get_text(self->__rowTextId));
}

void MemoSettingsView::__setRowText(const char *textId)
{
	__rowTextId = textId;
	if (__row)
		elm_genlist_item_update(__row);
}

bool MemoSettingsView::__isTop()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}

void MemoSettingsView::__rowClickedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	elm_genlist_item_selected_set(static_cast<Elm_Object_Item *>(eventInfo), EINA_FALSE);
	MemoSettingsView *self = static_cast<MemoSettingsView *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	app_assist::WNaviframeController *naviframe = self->getNaviframeController();
	if (!naviframe) {
		MEMO_LOGE("Naviframe is NULL");
		return;
	}
	char stored[MemoHiddenPasswordView::PIN_DIGEST_BUFFER_SIZE] = {};
	self->__clickCount++;
	switch (self->__clickCount) {
	case 1:
		if (!MemoDbMgr::getInstance()->getHiddenMemoPassword(stored)) {
			self->__setRowText("IDS_MEMO_TMBODY_SET_PIN");
		} else {
			self->__clickCount++;
			self->__setRowText("IDS_MEMO_TMBODY_CHANGE_PIN");
		}
		break;
	case 2:
		if (self->__parent)
			self->__parent->__isTopView = false;
		naviframe->push(new MemoHiddenFirstAccess(self->__parent));
		self->__clickCount = 1;
		break;
	default: {
		if (self->__parent)
			self->__parent->__hideFloatingButton();
		MemoHiddenPasswordView *pinView = new MemoHiddenPasswordView(self->__parent);
		pinView->setChangePin(true);
		pinView->setFromSettings(self->__isFromSettings);
		naviframe->push(pinView);
		self->__clickCount = 2;
		break;
	}
	}
}

void MemoSettingsView::__backBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoSettingsView *self = static_cast<MemoSettingsView *>(data);
	if (!self) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	if (self->__clickCount == 0) {
		if (self->__isTop())
			self->popOut();
		return;
	}
	self->__clickCount = 0;
	self->__backCount++;
	self->__setRowText("IDS_MEMO_TMBODY_HIDDEN_MODE");
	if (self->__backCount >= 2 && self->__isTop())
		self->popOut();
}
