// The more key's menu: a context popup at the foot of the window that closes on selection.
#include "WMenuPopupController.h"

#include <efl_extension.h>

#include "WDefine.h"

namespace app_assist
{

WMenuPopupController::WMenuPopupController() : __win(nullptr), __inItemCallback(false), __deleteJob(nullptr) {}

WMenuPopupController::~WMenuPopupController()
{
	if (__deleteJob)
		ecore_job_del(__deleteJob);
	__deleteJob = nullptr;
}

void WMenuPopupController::destroy()
{
	if (!__inItemCallback) {
		WViewController::destroy();
		return;
	}
	// The context popup must not go while its own item callback runs.
	if (getEvasObj())
		evas_object_hide(getEvasObj());
	if (!__deleteJob)
		__deleteJob = ecore_job_add(__deleteJobCb, this);
}

void WMenuPopupController::__deleteJobCb(void *data)
{
	WMenuPopupController *self = static_cast<WMenuPopupController *>(data);
	self->__deleteJob = nullptr;
	self->destroy();
}

const char *WMenuPopupController::getClassName() const
{
	return "WMenuPopupController";
}

bool WMenuPopupController::createMenu(Evas_Object *win, Evas_Object *naviframe)
{
	if (!win || !naviframe) {
		WERROR("win or naviframe is null");
		return false;
	}
	if (getEvasObj()) {
		WERROR("The menu exists already");
		return false;
	}
	__win = win;
	return create(naviframe, nullptr);
}

bool WMenuPopupController::appendItem(const char *text, std::function<void()> itemFunc)
{
	Evas_Object *ctxpopup = getEvasObj();
	if (!ctxpopup) {
		WERROR("createMenu first");
		return false;
	}
	std::unique_ptr<__Item> item(new __Item());
	item->menu = this;
	item->func = std::move(itemFunc);
	if (!elm_ctxpopup_item_append(ctxpopup, text, nullptr, __itemSelectedCb, item.get())) {
		WERROR("elm_ctxpopup_item_append failed");
		return false;
	}
	__items.push_back(std::move(item));
	return true;
}

bool WMenuPopupController::showMenu()
{
	if (!getEvasObj()) {
		WERROR("createMenu first");
		return false;
	}
	__move();
	evas_object_show(getEvasObj());
	return true;
}

Evas_Object *WMenuPopupController::onCreateView(Evas_Object *parent, void *)
{
	Evas_Object *ctxpopup = elm_ctxpopup_add(parent);
	if (!ctxpopup) {
		WERROR("elm_ctxpopup_add failed");
		return nullptr;
	}
	elm_ctxpopup_auto_hide_disabled_set(ctxpopup, EINA_TRUE);
	elm_ctxpopup_direction_priority_set(ctxpopup, ELM_CTXPOPUP_DIRECTION_UP, ELM_CTXPOPUP_DIRECTION_UNKNOWN,
	                                    ELM_CTXPOPUP_DIRECTION_UNKNOWN, ELM_CTXPOPUP_DIRECTION_UNKNOWN);
	evas_object_smart_callback_add(ctxpopup, "dismissed", __dismissedCb, this);
	eext_object_event_callback_add(ctxpopup, EEXT_CALLBACK_BACK, __keyCb, this);
	eext_object_event_callback_add(ctxpopup, EEXT_CALLBACK_MORE, __keyCb, this);
	if (__win)
		evas_object_event_callback_add(__win, EVAS_CALLBACK_RESIZE, __winResizeCb, this);
	return ctxpopup;
}

void WMenuPopupController::onDestroy()
{
	if (__win)
		evas_object_event_callback_del_full(__win, EVAS_CALLBACK_RESIZE, __winResizeCb, this);
	__win = nullptr;
}

// Bottom centre of the window, opening upwards.
void WMenuPopupController::__move()
{
	if (!__win || !getEvasObj())
		return;
	Evas_Coord w = 0, h = 0;
	evas_object_geometry_get(__win, nullptr, nullptr, &w, &h);
	evas_object_move(getEvasObj(), w / 2, h);
}

void WMenuPopupController::__itemSelectedCb(void *data, Evas_Object *, void *)
{
	__Item *item = static_cast<__Item *>(data);
	WMenuPopupController *self = item->menu;
	WViewControllerWeakPtr alive = self->getWeakPtr();
	// A copy: should the function end the menu's object, the item record goes with it.
	std::function<void()> func = item->func;
	self->__inItemCallback = true;
	self->destroy();
	if (func)
		func();
	if (!alive.expired())
		self->__inItemCallback = false;
}

void WMenuPopupController::__dismissedCb(void *data, Evas_Object *, void *)
{
	static_cast<WMenuPopupController *>(data)->destroy();
}

void WMenuPopupController::__keyCb(void *data, Evas_Object *, void *)
{
	static_cast<WMenuPopupController *>(data)->destroy();
}

void WMenuPopupController::__winResizeCb(void *data, Evas *, Evas_Object *, void *)
{
	static_cast<WMenuPopupController *>(data)->__move();
}

} // namespace app_assist
