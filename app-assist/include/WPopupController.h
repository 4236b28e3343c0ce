#ifndef APP_ASSIST_INCLUDE_WPOPUPCONTROLLER_H
#define APP_ASSIST_INCLUDE_WPOPUPCONTROLLER_H

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "WViewController.h"

namespace app_assist
{

// One elm_popup with a title, a text and up to three buttons. Set it up, then hand it to a view with
// WViewController::attachPopup(), which creates and shows it; the popup is then destroyed with the view, by
// the back key, or by a button whose function sets its flag to true.
// A popup that nobody has created by the end of the current main loop event shows itself on the
// application's window.
class WPopupController : public WViewController
{
public:
	WPopupController();
	const char *getClassName() const override;

	// Texts given from now on are message ids of textDomain, translated (and re-translated on a language
	// change) by Elementary. Null means plain texts.
	void setTextTranslatable(const char *textDomain);
	// The title, or null for none.
	void setTitle(const char *title);
	// The text of the popup's body, or null for none.
	void setContent(const char *content);
	// Adds a button, in order (at most three: more logs and returns false). On a click buttonFunc (may be
	// empty) gets a flag that is false; setting it to true closes the popup.
	bool addButton(const char *buttonText, std::function<void(bool *)> buttonFunc);
	// Called with the popup object when it is built, to add content or callbacks.
	void setOnAddProperties(std::function<void(Evas_Object *)> addPropertiesFunc);

protected:
	// Builds the popup on the top window of parent; param is not used.
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~WPopupController() override;

private:
	struct __Button {
		WPopupController *popup;
		std::string text;
		std::function<void(bool *)> func;
		Evas_Object *obj;
	};

	static void __buttonClickedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __backKeyCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __selfShowJobCb(void *data);
	void __setText(Evas_Object *obj, const char *part, const std::string &text);
	void __addButtonObj(Evas_Object *popup, __Button *button, int index);

	std::string __domain;
	std::string __title;
	std::string __content;
	bool __hasTitle;
	bool __hasContent;
	std::vector<std::unique_ptr<__Button>> __buttons;
	std::function<void(Evas_Object *)> __addPropertiesFunc;
	Ecore_Job *__selfShowJob;
};

} // namespace app_assist

#endif
