#ifndef APP_ASSIST_INCLUDE_WVIEWCONTROLLER_H
#define APP_ASSIST_INCLUDE_WVIEWCONTROLLER_H

#include <memory>
#include <string>

#include <Elementary.h>

namespace app_assist
{

class WWindowController;
class WViewController;

// A weak reference to a view controller: lock() gives the controller while it lives, null after.
using WViewControllerWeakPtr = std::weak_ptr<WViewController>;

// A controller of one Evas object tree. create() builds the object through onCreateView(); from then on the
// object owns the controller: deleting the object calls onDestroy() and deletes the controller.
// Allocate controllers with new and end them with destroy(), never with delete.
class WViewController
{
public:
	WViewController();

	// The class name; by default the name given with setName(), else "WViewController".
	virtual const char *getClassName() const;
	// Calls onCreateView(parent, param), keeps the returned object, then calls onCreated(). Returns false and
	// logs when the view already exists or onCreateView() returns null; the controller then still belongs to
	// the caller.
	virtual bool create(Evas_Object *parent, void *param);
	// Deletes the Evas object, which calls onDestroy() and deletes the controller. A controller without an
	// object is deleted at once. Nothing happens while canDestroy() is false.
	virtual void destroy();
	// Whether destroy() may go ahead. Default: true.
	virtual bool canDestroy() const;

protected:
	// Builds and returns the view's Evas object on parent; null fails create().
	virtual Evas_Object *onCreateView(Evas_Object *parent, void *param) = 0;
	// Called once the object is kept. Default: nothing.
	virtual void onCreated();
	// Called while the object is being deleted, before the controller is. Default: nothing.
	virtual void onDestroy();

public:
	// Deletes the object without onDestroy() if it still exists; prefer destroy().
	virtual ~WViewController();
	WViewController(const WViewController &) = delete;
	WViewController &operator=(const WViewController &) = delete;

	// The view's Evas object, or null before create() (and during onCreateView()).
	Evas_Object *getEvasObj() const;
	// The name given with setName(), "" when none.
	const char *getName() const;
	// Copies the name; null clears it.
	void setName(const char *name);
	// The application's window controller (WApp::getInstance()), or null.
	WWindowController *getWindowController() const;
	// A weak pointer that empties when this controller is deleted.
	WViewControllerWeakPtr getWeakPtr() const;

	// Keeps popup as this view's one popup: a previous popup is destroyed, and the popup is destroyed with this
	// view. A popup that has no object yet is created on this view's window. Returns false and logs on a null
	// popup or a failed create (the popup is then deleted).
	bool attachPopup(WViewController *popup);
	// Destroys the attached popup if it still lives.
	void destroyPopup();
	// The attached popup while it lives, else null.
	WViewController *getPopup() const;

private:
	static void __objDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);

	Evas_Object *__obj;
	std::string __name;
	std::shared_ptr<WViewController> __selfPtr;
	WViewControllerWeakPtr __popup;
};

} // namespace app_assist

#endif
