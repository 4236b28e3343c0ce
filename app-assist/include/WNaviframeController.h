#ifndef APP_ASSIST_INCLUDE_WNAVIFRAMECONTROLLER_H
#define APP_ASSIST_INCLUDE_WNAVIFRAMECONTROLLER_H

#include <functional>
#include <vector>

#include "WViewController.h"

namespace app_assist
{

class WContentViewController;

// The naviframe and its stack of WContentViewController pages. The back key pops the top page. Popping the
// last page asks the hook of setOnLastItemPop(); with no hook the application ends and the page stays.
class WNaviframeController : public WViewController
{
public:
	WNaviframeController();
	const char *getClassName() const override;

	// Creates view on the naviframe (viewParam reaches its onCreateView; viewName, when not null, becomes its
	// name), pushes it and calls its onPushed(). The view belongs to its object from then on. On failure the
	// stack is left as it was, the view is deleted and false is returned (with a log line).
	bool push(WContentViewController *view, const char *viewName = nullptr, void *viewParam = nullptr);
	// The page on top, or null with an empty stack (or before create()).
	WContentViewController *getTopContentViewController() const;
	// Whether view is the page on top.
	bool isTopContentViewController(const WContentViewController *view) const;
	// Sets the hook called when the last page is about to be popped. The hook gets a flag that is true; the
	// pop goes on only if the flag is still true when the hook returns. An empty function removes the hook.
	void setOnLastItemPop(std::function<void(bool *)> lastItemPopCb);
	// Number of pages on the stack.
	int getContentViewCount() const;

protected:
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~WNaviframeController() override;

private:
	friend class WContentViewController;
	static void __backKeyCb(void *data, Evas_Object *obj, void *eventInfo);
	static Eina_Bool __itemPopCb(void *data, Elm_Object_Item *item);
	static void __topCheckJobCb(void *data);
	static void __transitionFinishedCb(void *data, Evas_Object *obj, void *eventInfo);
	void __popTop(WContentViewController *view);
	void __onPageLeft(WContentViewController *view, Elm_Object_Item *item);
	void __scheduleTopCheck();
	void __detachPages();

	std::function<void(bool *)> __lastItemPopCb;
	// Every page that still points back here, those in a pop transition included.
	std::vector<WContentViewController *> __pages;
	Ecore_Job *__topCheckJob;
	bool __popCbRan;
};

} // namespace app_assist

#endif
