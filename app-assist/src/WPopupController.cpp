// A popup with title, text and buttons, closed by its buttons, the back key, or its view.
#include "WPopupController.h"

#include <efl_extension.h>

#include "WApp.h"
#include "WDefine.h"
#include "WWindowController.h"

namespace app_assist
{

static const int MAX_BUTTONS = 3;
static const char *BUTTON_PARTS[MAX_BUTTONS] = {"button1", "button2", "button3"};

WPopupController::WPopupController() : __hasTitle(false), __hasContent(false), __selfShowJob(nullptr)
{
	__selfShowJob = ecore_job_add(__selfShowJobCb, this);
}

WPopupController::~WPopupController()
{
	if (__selfShowJob)
		ecore_job_del(__selfShowJob);
	__selfShowJob = nullptr;
}

const char *WPopupController::getClassName() const
{
	return "WPopupController";
}

void WPopupController::setTextTranslatable(const char *textDomain)
{
	__domain = textDomain ? textDomain : "";
}

void WPopupController::setTitle(const char *title)
{
	__hasTitle = title != nullptr;
	__title = title ? title : "";
	if (getEvasObj())
		__setText(getEvasObj(), "title,text", __title);
}

void WPopupController::setContent(const char *content)
{
	__hasContent = content != nullptr;
	__content = content ? content : "";
	if (getEvasObj())
		__setText(getEvasObj(), nullptr, __content);
}

bool WPopupController::addButton(const char *buttonText, std::function<void(bool *)> buttonFunc)
{
	if ((int)__buttons.size() >= MAX_BUTTONS) {
		WERROR("A popup has at most %d buttons", MAX_BUTTONS);
		return false;
	}
	std::unique_ptr<__Button> button(new __Button());
	button->popup = this;
	button->text = buttonText ? buttonText : "";
	button->func = std::move(buttonFunc);
	button->obj = nullptr;
	__buttons.push_back(std::move(button));
	if (getEvasObj())
		__addButtonObj(getEvasObj(), __buttons.back().get(), (int)__buttons.size() - 1);
	return true;
}

void WPopupController::setOnAddProperties(std::function<void(Evas_Object *)> addPropertiesFunc)
{
	__addPropertiesFunc = std::move(addPropertiesFunc);
}

Evas_Object *WPopupController::onCreateView(Evas_Object *parent, void *)
{
	Evas_Object *win = parent ? elm_object_top_widget_get(parent) : nullptr;
	Evas_Object *popup = elm_popup_add(win ? win : parent);
	if (!popup) {
		WERROR("elm_popup_add failed");
		return nullptr;
	}
	elm_popup_align_set(popup, ELM_NOTIFY_ALIGN_FILL, 1.0);
	evas_object_size_hint_weight_set(popup, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	if (__hasTitle)
		__setText(popup, "title,text", __title);
	if (__hasContent)
		__setText(popup, nullptr, __content);
	// The popup object is not kept yet: the buttons go on it directly.
	for (size_t i = 0; i < __buttons.size(); ++i)
		__addButtonObj(popup, __buttons[i].get(), (int)i);
	eext_object_event_callback_add(popup, EEXT_CALLBACK_BACK, __backKeyCb, this);
	if (__addPropertiesFunc)
		__addPropertiesFunc(popup);
	evas_object_show(popup);
	return popup;
}

void WPopupController::onDestroy()
{
	for (auto &button : __buttons)
		button->obj = nullptr;
}

void WPopupController::__setText(Evas_Object *obj, const char *part, const std::string &text)
{
	if (__domain.empty())
		elm_object_part_text_set(obj, part, text.c_str());
	else
		elm_object_domain_translatable_part_text_set(obj, part, __domain.c_str(), text.c_str());
}

void WPopupController::__addButtonObj(Evas_Object *popup, __Button *button, int index)
{
	button->obj = elm_button_add(popup);
	elm_object_style_set(button->obj, "popup");
	__setText(button->obj, nullptr, button->text);
	evas_object_smart_callback_add(button->obj, "clicked", __buttonClickedCb, button);
	elm_object_part_content_set(popup, BUTTON_PARTS[index], button->obj);
}

void WPopupController::__buttonClickedCb(void *data, Evas_Object *, void *)
{
	__Button *button = static_cast<__Button *>(data);
	WPopupController *self = button->popup;
	WViewControllerWeakPtr alive = self->getWeakPtr();
	// A copy: the function may end the popup, and the button record with it.
	std::function<void(bool *)> func = button->func;
	bool close = false;
	if (func)
		func(&close);
	if (close && !alive.expired())
		self->destroy();
}

void WPopupController::__backKeyCb(void *data, Evas_Object *, void *)
{
	static_cast<WPopupController *>(data)->destroy();
}

// Nobody created the popup in the event that made it: show it on the application's window.
void WPopupController::__selfShowJobCb(void *data)
{
	WPopupController *self = static_cast<WPopupController *>(data);
	self->__selfShowJob = nullptr;
	if (self->getEvasObj())
		return;
	WApp *app = WApp::getInstance();
	WWindowController *windowController = app ? app->getWindowController() : nullptr;
	Evas_Object *win = windowController ? windowController->getEvasObj() : nullptr;
	if (!win) {
		WERROR("A popup was neither created nor attached, and there is no window to show it on");
		return;
	}
	if (!self->create(win, nullptr)) {
		WERROR("The popup could not be created");
		self->destroy();
	}
}

} // namespace app_assist
