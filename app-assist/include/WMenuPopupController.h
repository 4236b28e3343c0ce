#ifndef APP_ASSIST_INCLUDE_WMENUPOPUPCONTROLLER_H
#define APP_ASSIST_INCLUDE_WMENUPOPUPCONTROLLER_H

#include <functional>
#include <memory>
#include <vector>

#include "WViewController.h"

namespace app_assist
{

// The menu of the hardware "more" key: a context popup at the bottom of the window with items in append
// order. Selecting an item closes the menu and runs the item's function; the back and more keys close it.
// Usage: createMenu(), appendItem()..., showMenu(), then the view's attachPopup(menu).
class WMenuPopupController : public WViewController
{
public:
	WMenuPopupController();
	const char *getClassName() const override;
	// Deletes the menu; from inside an item's function the deletion waits until the item's callback is over.
	void destroy() override;

	// Creates the context popup on naviframe (placed relative to win). Returns false and logs on a null
	// argument or when the menu exists already.
	bool createMenu(Evas_Object *win, Evas_Object *naviframe);
	// Appends an item with a plain text; itemFunc (may be empty) runs when it is selected. False before
	// createMenu().
	bool appendItem(const char *text, std::function<void()> itemFunc);
	// Shows the menu at the bottom centre of the window. False before createMenu().
	bool showMenu();

protected:
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~WMenuPopupController() override;

private:
	struct __Item {
		WMenuPopupController *menu;
		std::function<void()> func;
	};

	static void __itemSelectedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __dismissedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __keyCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __winResizeCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __deleteJobCb(void *data);
	void __move();

	Evas_Object *__win;
	bool __inItemCallback;
	Ecore_Job *__deleteJob;
	std::vector<std::unique_ptr<__Item>> __items;
};

} // namespace app_assist

#endif
