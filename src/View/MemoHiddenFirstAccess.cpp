// The first use of hidden mode.
#include "View/MemoHiddenFirstAccess.h"

#include <Edje.h>
#include <efl_assist_theme.h>
#include <efl_extension.h>

#include <WNaviframeController.h>

#include "MemoLog.h"
#include "View/MemoHiddenPasswordView.h"
#include "View/MemoHiddenTitle.h"
#include "View/MemoListView.h"
#include "MemoViewParts.h"

namespace
{
// The set-up button wears the brand colour: each colour class of the plain button takes its brand twin.
const char *const COLOR_REPLACEMENTS[][2] = {{"W011", "W171"}, {"W011P", "W171P"}, {"W011D", "W171D"}};

void __replaceButtonColors(Evas_Object *button)
{
	Evas_Object *edje = elm_layout_edje_get(button);
	for (const auto &replacement : COLOR_REPLACEMENTS) {
		int r = 0, g = 0, b = 0, a = 0;
		if (edje && ea_theme_object_color_get(button, replacement[1], &r, &g, &b, &a, nullptr, nullptr, nullptr,
		                                      nullptr, nullptr, nullptr, nullptr, nullptr))
			edje_object_color_class_set(edje, replacement[0], r, g, b, a, 0, 0, 0, 0, 0, 0, 0, 0);
	}
}
} // namespace

MemoHiddenFirstAccess::MemoHiddenFirstAccess(MemoListView *parent) : __parent(parent) {}

const char *MemoHiddenFirstAccess::getClassName() const
{
	return "MemoHiddenFirstAccess";
}

Evas_Object *MemoHiddenFirstAccess::onCreateView(Evas_Object *parent, void *param)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	if (__parent) {
		__parent->__hideFloatingButton();
		__parent->__isTopView = false;
	}
	Evas_Object *layout = nullptr;
	if (!memoViewPageLayoutAdd(parent, "hidden.mode.first", &layout))
		MEMO_LOGE("group hidden.mode.first not found");
	elm_object_domain_translatable_part_text_set(layout, "welcome_head", "memo-sub",
	                                             "IDS_MEMO_HEADER_USING_HIDDEN_MODE_ABB");
	elm_object_domain_translatable_part_text_set(
	    layout, "welcome_body", "memo-sub",
	    "IDS_MEMO_BODY_YOU_CAN_HIDE_PERSONAL_MEMOS_SO_THEY_WILL_ONLY_BE_SHOWN_AFTER_YOU_ENTER_A_PIN");
	Evas_Object *button = elm_button_add(layout);
	elm_object_style_set(button, "bottom");
	__replaceButtonColors(button);
	elm_object_domain_translatable_text_set(button, "memo-sub", "IDS_MEMO_BUTTON_SET_UP");
	evas_object_smart_callback_add(button, "clicked", __startBtnCb, this);
	elm_object_part_content_set(layout, "start_button", button);
	eext_object_event_callback_add(layout, EEXT_CALLBACK_BACK, __backBtnCb, this);
	evas_object_show(layout);
	return layout;
}

void MemoHiddenFirstAccess::onPushed(Elm_Object_Item *naviItem)
{
	memoHiddenTitleSet(naviItem, "IDS_MEMO_HEADER_HIDDEN_MODE_ABB", __backBtnCb, this);
}

bool MemoHiddenFirstAccess::__isTop()
{
	app_assist::WNaviframeController *naviframe = getNaviframeController();
	return naviframe && naviframe->isTopContentViewController(this);
}

void MemoHiddenFirstAccess::__startBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoHiddenFirstAccess *self = static_cast<MemoHiddenFirstAccess *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->getNaviframeController()->push(new MemoHiddenPasswordView(self->__parent));
}

void MemoHiddenFirstAccess::__backBtnCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoHiddenFirstAccess *self = static_cast<MemoHiddenFirstAccess *>(data);
	if (!self || !self->__isTop()) {
		MEMO_LOGE("self is NULL or Top is not Me");
		return;
	}
	self->popOut();
}
