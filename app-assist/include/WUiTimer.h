#ifndef APP_ASSIST_INCLUDE_WUITIMER_H
#define APP_ASSIST_INCLUDE_WUITIMER_H

#include <functional>
#include <memory>

#include <Elementary.h>

namespace app_assist
{

class WUiTimer;

// A weak handle of a timer or idler: empty once it has ended.
using WUiTimerHandle = std::weak_ptr<WUiTimer>;

// Timers and idlers that run a function object on the main loop. The function gets the data given at the
// start and returns true to run again, false to end. With an owner Evas object the timer ends when that
// object is deleted, without a further call. Ending is safe from inside the function.
class WUiTimer
{
public:
	// Runs timerFunc every seconds (0.0: after the current event) until it returns false. Returns a handle;
	// an empty function object logs and returns an empty handle.
	static WUiTimerHandle addTimer(double seconds, std::function<bool(void *)> timerFunc, void *data,
	                               Evas_Object *ownerObj = nullptr);
	// Runs idlerFunc once the main loop has handled the current events (and on each further pass while it
	// returns true). An Ecore idle enterer rather than an idler, so that it also runs under
	// ecore_main_loop_iterate(), which skips idlers.
	static WUiTimerHandle addIdler(std::function<bool(void *)> idlerFunc, void *data, Evas_Object *ownerObj = nullptr);
	// Ends the timer or idler of handle; nothing happens when it has ended already.
	static void deleteTimer(const WUiTimerHandle &handle);

	~WUiTimer();
	WUiTimer(const WUiTimer &) = delete;
	WUiTimer &operator=(const WUiTimer &) = delete;

private:
	WUiTimer(std::function<bool(void *)> func, void *data, Evas_Object *ownerObj);
	static Eina_Bool __tickCb(void *data);
	static void __ownerDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	void __end();

	std::function<bool(void *)> __func;
	void *__data;
	Evas_Object *__owner;
	Ecore_Timer *__timer;
	Ecore_Idle_Enterer *__idler;
	bool __running;
	bool __ended;
	std::shared_ptr<WUiTimer> __selfPtr;
};

} // namespace app_assist

#endif
