// Lifetime of a view controller: its Evas object owns it.
#include "WViewController.h"

#include "WApp.h"
#include "WDefine.h"
#include "WWindowController.h"

namespace app_assist
{

WViewController::WViewController() : __obj(nullptr)
{
	// The no-op deleter: the controller's life is tied to its object, the pointer only feeds weak pointers.
	__selfPtr = std::shared_ptr<WViewController>(this, [](WViewController *) {});
}

WViewController::~WViewController()
{
	__selfPtr.reset();
	destroyPopup();
	if (__obj) {
		Evas_Object *obj = __obj;
		__obj = nullptr;
		evas_object_event_callback_del_full(obj, EVAS_CALLBACK_DEL, __objDelCb, this);
		evas_object_del(obj);
	}
}

const char *WViewController::getClassName() const
{
	return __name.empty() ? "WViewController" : __name.c_str();
}

bool WViewController::create(Evas_Object *parent, void *param)
{
	if (__obj) {
		WERROR("%s is created already", getClassName());
		return false;
	}
	Evas_Object *obj = onCreateView(parent, param);
	if (!obj) {
		WERROR("onCreateView of %s returned null", getClassName());
		return false;
	}
	__obj = obj;
	evas_object_event_callback_add(__obj, EVAS_CALLBACK_DEL, __objDelCb, this);
	onCreated();
	return true;
}

void WViewController::destroy()
{
	if (!canDestroy())
		return;
	if (__obj)
		evas_object_del(__obj);
	else
		delete this;
}

bool WViewController::canDestroy() const
{
	return true;
}

void WViewController::onCreated() {}

void WViewController::onDestroy() {}

Evas_Object *WViewController::getEvasObj() const
{
	return __obj;
}

const char *WViewController::getName() const
{
	return __name.c_str();
}

void WViewController::setName(const char *name)
{
	__name = name ? name : "";
}

WWindowController *WViewController::getWindowController() const
{
	WApp *app = WApp::getInstance();
	return app ? app->getWindowController() : nullptr;
}

WViewControllerWeakPtr WViewController::getWeakPtr() const
{
	return __selfPtr;
}

bool WViewController::attachPopup(WViewController *popup)
{
	if (!popup) {
		WERROR("popup is null");
		return false;
	}
	if (popup == this) {
		WERROR("a view cannot be its own popup");
		return false;
	}
	if (getPopup() != popup)
		destroyPopup();
	if (!popup->getEvasObj()) {
		Evas_Object *parent = __obj ? elm_object_top_widget_get(__obj) : nullptr;
		if (!parent) {
			WApp *app = WApp::getInstance();
			WWindowController *win = app ? app->getWindowController() : nullptr;
			parent = win ? win->getEvasObj() : nullptr;
		}
		if (!parent || !popup->create(parent, nullptr)) {
			WERROR("popup of %s could not be created", getClassName());
			popup->destroy();
			return false;
		}
	}
	__popup = popup->getWeakPtr();
	return true;
}

void WViewController::destroyPopup()
{
	std::shared_ptr<WViewController> popup = __popup.lock();
	__popup.reset();
	if (popup)
		popup->destroy();
}

WViewController *WViewController::getPopup() const
{
	return __popup.lock().get();
}

void WViewController::__objDelCb(void *data, Evas *, Evas_Object *, void *)
{
	WViewController *self = static_cast<WViewController *>(data);
	self->destroyPopup();
	self->onDestroy();
	self->__obj = nullptr;
	delete self;
}

} // namespace app_assist
