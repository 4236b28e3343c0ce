// The naviframe and its page stack: push, pop hooks, back key, and telling a page that it is on top again.
#include "WNaviframeController.h"

#include <app.h>
#include <efl_extension.h>

#include "WContentViewController.h"
#include "WDefine.h"

namespace app_assist
{

WNaviframeController::WNaviframeController() : __topCheckJob(nullptr), __popCbRan(false) {}

WNaviframeController::~WNaviframeController()
{
	__detachPages();
}

const char *WNaviframeController::getClassName() const
{
	return "WNaviframeController";
}

Evas_Object *WNaviframeController::onCreateView(Evas_Object *parent, void *)
{
	Evas_Object *naviframe = elm_naviframe_add(parent);
	if (!naviframe) {
		WERROR("elm_naviframe_add failed");
		return nullptr;
	}
	evas_object_size_hint_weight_set(naviframe, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(naviframe, EVAS_HINT_FILL, EVAS_HINT_FILL);
	eext_object_event_callback_add(naviframe, EEXT_CALLBACK_BACK, __backKeyCb, this);
	evas_object_smart_callback_add(naviframe, "transition,finished", __transitionFinishedCb, this);
	evas_object_show(naviframe);
	return naviframe;
}

void WNaviframeController::onDestroy()
{
	__detachPages();
}

// The pages go after this controller: cut their way back to it.
void WNaviframeController::__detachPages()
{
	if (__topCheckJob)
		ecore_job_del(__topCheckJob);
	__topCheckJob = nullptr;
	for (WContentViewController *view : __pages)
		view->__naviframe = nullptr;
	__pages.clear();
}

bool WNaviframeController::push(WContentViewController *view, const char *viewName, void *viewParam)
{
	if (!view) {
		WERROR("view is null");
		return false;
	}
	if (view->__naviframe || view->getEvasObj()) {
		WERROR("%s is created already", view->getClassName());
		return false;
	}
	Evas_Object *naviframe = getEvasObj();
	if (!naviframe) {
		WERROR("The naviframe is not created");
		view->destroy();
		return false;
	}
	if (viewName)
		view->setName(viewName);
	view->__naviframe = this;
	view->onSetContainerProperties(this, naviframe);
	if (!view->create(naviframe, viewParam)) {
		WERROR("%s could not be created", view->getClassName());
		view->__naviframe = nullptr;
		view->destroy();
		return false;
	}
	Elm_Object_Item *prevTop = elm_naviframe_top_item_get(naviframe);
	Elm_Object_Item *item = view->onPushToNaviframe(naviframe);
	if (!item) {
		WERROR("%s could not be pushed", view->getClassName());
		view->__naviframe = nullptr;
		view->destroy();
		return false;
	}
	view->__naviItem = item;
	__pages.push_back(view);
	elm_object_item_data_set(item, view);
	elm_naviframe_item_pop_cb_set(item, __itemPopCb, view);
	evas_object_event_callback_priority_add(view->getEvasObj(), EVAS_CALLBACK_DEL, EVAS_CALLBACK_PRIORITY_BEFORE,
	                                        WContentViewController::__pageDelCb, view);
	if (prevTop) {
		WContentViewController *prev = static_cast<WContentViewController *>(elm_object_item_data_get(prevTop));
		if (prev)
			prev->__covered = true;
	}
	view->onPushed(item);
	return true;
}

WContentViewController *WNaviframeController::getTopContentViewController() const
{
	Evas_Object *naviframe = getEvasObj();
	if (!naviframe)
		return nullptr;
	Elm_Object_Item *top = elm_naviframe_top_item_get(naviframe);
	return top ? static_cast<WContentViewController *>(elm_object_item_data_get(top)) : nullptr;
}

bool WNaviframeController::isTopContentViewController(const WContentViewController *view) const
{
	return view && getTopContentViewController() == view;
}

void WNaviframeController::setOnLastItemPop(std::function<void(bool *)> lastItemPopCb)
{
	__lastItemPopCb = std::move(lastItemPopCb);
}

int WNaviframeController::getContentViewCount() const
{
	Evas_Object *naviframe = getEvasObj();
	if (!naviframe)
		return 0;
	Eina_List *items = elm_naviframe_items_get(naviframe);
	int count = (int)eina_list_count(items);
	eina_list_free(items);
	return count;
}

void WNaviframeController::__backKeyCb(void *data, Evas_Object *, void *)
{
	WNaviframeController *self = static_cast<WNaviframeController *>(data);
	WContentViewController *top = self->getTopContentViewController();
	if (!top) {
		WINFO("Back key with no page");
		return;
	}
	top->popOut();
}

// The naviframe refuses a pop while a transition runs: such a pop is kept until the transition ends.
void WNaviframeController::__popTop(WContentViewController *view)
{
	WViewControllerWeakPtr viewAlive = view->getWeakPtr();
	__popCbRan = false;
	Elm_Object_Item *popped = elm_naviframe_item_pop(getEvasObj());
	if (popped || __popCbRan || viewAlive.expired())
		return;
	WINFO("%s pops when the transition ends", view->getClassName());
	view->__popPending = true;
}

void WNaviframeController::__transitionFinishedCb(void *, Evas_Object *obj, void *)
{
	WContentViewController *pending = nullptr;
	Eina_List *items = elm_naviframe_items_get(obj);
	void *item;
	EINA_LIST_FREE(items, item)
	{
		WContentViewController *view =
		    static_cast<WContentViewController *>(elm_object_item_data_get(static_cast<Elm_Object_Item *>(item)));
		if (!pending && view && view->__popPending)
			pending = view;
	}
	if (!pending)
		return;
	pending->__popPending = false;
	pending->popOut();
}

// Decides whether the pop of a page goes on; the last page asks the hook.
Eina_Bool WNaviframeController::__itemPopCb(void *data, Elm_Object_Item *item)
{
	WContentViewController *view = static_cast<WContentViewController *>(data);
	WNaviframeController *self = view ? view->__naviframe : nullptr;
	if (!self)
		return EINA_TRUE;
	self->__popCbRan = true;
	if (elm_naviframe_bottom_item_get(self->getEvasObj()) == item) {
		if (!self->__lastItemPopCb) {
			WINFO("Last page popped with no hook: the application ends");
			ui_app_exit();
			return EINA_FALSE;
		}
		WViewControllerWeakPtr viewAlive = view->getWeakPtr();
		std::function<void(bool *)> hook = self->__lastItemPopCb;
		bool popGoesOn = true;
		hook(&popGoesOn);
		if (!popGoesOn || viewAlive.expired())
			return EINA_FALSE;
	}
	view->__popped = true;
	view->__naviItem = nullptr;
	elm_object_item_data_set(item, nullptr);
	view->onPop();
	self->__scheduleTopCheck();
	return EINA_TRUE;
}

// item is the page's naviframe item when it is still on the stack: its object went without a pop, so the item is
// left without a page and goes too, once the current event is over.
void WNaviframeController::__onPageLeft(WContentViewController *view, Elm_Object_Item *item)
{
	for (auto it = __pages.begin(); it != __pages.end(); ++it) {
		if (*it == view) {
			__pages.erase(it);
			break;
		}
	}
	if (item && !efl_invalidating_get(item) && !efl_invalidated_get(item)) {
		elm_object_item_data_set(item, nullptr);
		elm_naviframe_item_pop_cb_set(item, nullptr, nullptr);
	}
	__scheduleTopCheck();
}

// The stack changed in the current event: once it is over, a page back on top hears it.
void WNaviframeController::__scheduleTopCheck()
{
	if (!__topCheckJob)
		__topCheckJob = ecore_job_add(__topCheckJobCb, this);
}

void WNaviframeController::__topCheckJobCb(void *data)
{
	WNaviframeController *self = static_cast<WNaviframeController *>(data);
	self->__topCheckJob = nullptr;
	// Items whose page went without a pop.
	Eina_List *items = elm_naviframe_items_get(self->getEvasObj());
	void *item;
	EINA_LIST_FREE(items, item)
	{
		if (!elm_object_item_data_get(static_cast<Elm_Object_Item *>(item)))
			elm_object_item_del(static_cast<Elm_Object_Item *>(item));
	}
	WContentViewController *top = self->getTopContentViewController();
	if (top && top->__covered) {
		top->__covered = false;
		top->onBecomeTop();
	}
}

} // namespace app_assist
