#ifndef APP_ASSIST_INCLUDE_WWINDOWCONTROLLER_H
#define APP_ASSIST_INCLUDE_WWINDOWCONTROLLER_H

#include <string>

#include <Elementary.h>

namespace app_assist
{

class WViewController;

// The application window: an elm_win holding a conformant, which holds the base layout. The base layout has
// the swallow parts "elm.swallow.content" (the base view) and "elm.swallow.floatingbutton".
// The window's "delete,request" ends the application (ui_app_exit).
class WWindowController
{
public:
	// Makes and shows the window. A window that cannot be made logs an error; getEvasObj() is then null.
	WWindowController(const char *name, Elm_Win_Type winType);
	// Deletes the window, and with it every view inside.
	virtual ~WWindowController();
	WWindowController(const WWindowController &) = delete;
	WWindowController &operator=(const WWindowController &) = delete;

	// The elm_win, or null.
	virtual Evas_Object *getEvasObj() const;
	// The view controller attached with attachBaseViewController, or null.
	virtual WViewController *getBaseViewController() const;

	// Makes the view the window's content: creates it on the base layout if it has no object yet (with a
	// null param) and swallows it into "elm.swallow.content". Returns false and logs on failure.
	// The view belongs to its Evas object from then on, like every view.
	bool attachBaseViewController(WViewController *viewController);

	// The base layout, whose part "elm.swallow.floatingbutton" takes a floating button.
	Evas_Object *getBaseLayoutEvasObj() const;
	Evas_Object *getConformantEvasObj() const;
	const char *getName() const;

	// The title that the window manager shows; until it is set, the window's name. With a domain, text is a
	// message id of that text domain, translated now and again on every language change.
	void setTitle(const char *text, const char *domain = nullptr);

private:
	static void __deleteRequestCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __winDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __baseViewDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __languageChangedCb(void *data, Evas_Object *obj, void *eventInfo);
	void __applyTitle();

	std::string __name;
	std::string __title;
	std::string __titleDomain;
	Evas_Object *__win;
	Evas_Object *__conformant;
	Evas_Object *__baseLayout;
	WViewController *__baseView;
};

} // namespace app_assist

#endif
