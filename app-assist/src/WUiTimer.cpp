// Timers and idlers running function objects, optionally bound to an owner object.
#include "WUiTimer.h"

#include "WDefine.h"

namespace app_assist
{

WUiTimer::WUiTimer(std::function<bool(void *)> func, void *data, Evas_Object *ownerObj)
    : __func(std::move(func)), __data(data), __owner(ownerObj), __timer(nullptr), __idler(nullptr), __running(false),
      __ended(false)
{
	__selfPtr = std::shared_ptr<WUiTimer>(this, [](WUiTimer *) {});
	if (__owner)
		evas_object_event_callback_add(__owner, EVAS_CALLBACK_DEL, __ownerDelCb, this);
}

WUiTimer::~WUiTimer()
{
	__selfPtr.reset();
	if (__owner)
		evas_object_event_callback_del_full(__owner, EVAS_CALLBACK_DEL, __ownerDelCb, this);
	if (__timer)
		ecore_timer_del(__timer);
	if (__idler)
		ecore_idle_enterer_del(__idler);
}

WUiTimerHandle WUiTimer::addTimer(double seconds, std::function<bool(void *)> timerFunc, void *data,
                                  Evas_Object *ownerObj)
{
	if (!timerFunc) {
		WERROR("timerFunc is empty");
		return WUiTimerHandle();
	}
	WUiTimer *timer = new WUiTimer(std::move(timerFunc), data, ownerObj);
	timer->__timer = ecore_timer_add(seconds < 0.0 ? 0.0 : seconds, __tickCb, timer);
	if (!timer->__timer) {
		WERROR("ecore_timer_add failed");
		delete timer;
		return WUiTimerHandle();
	}
	return timer->__selfPtr;
}

WUiTimerHandle WUiTimer::addIdler(std::function<bool(void *)> idlerFunc, void *data, Evas_Object *ownerObj)
{
	if (!idlerFunc) {
		WERROR("idlerFunc is empty");
		return WUiTimerHandle();
	}
	WUiTimer *idler = new WUiTimer(std::move(idlerFunc), data, ownerObj);
	idler->__idler = ecore_idle_enterer_add(__tickCb, idler);
	if (!idler->__idler) {
		WERROR("ecore_idle_enterer_add failed");
		delete idler;
		return WUiTimerHandle();
	}
	return idler->__selfPtr;
}

void WUiTimer::deleteTimer(const WUiTimerHandle &handle)
{
	std::shared_ptr<WUiTimer> timer = handle.lock();
	if (timer)
		timer->__end();
}

// Ends now, or, from inside its own function, when the function returns.
void WUiTimer::__end()
{
	if (__running) {
		__ended = true;
		return;
	}
	delete this;
}

Eina_Bool WUiTimer::__tickCb(void *data)
{
	WUiTimer *self = static_cast<WUiTimer *>(data);
	// A main loop iterated from inside the function (a blocking call may do that) must not run it again.
	if (self->__running)
		return ECORE_CALLBACK_RENEW;
	self->__running = true;
	bool again = self->__func(self->__data);
	self->__running = false;
	if (again && !self->__ended)
		return ECORE_CALLBACK_RENEW;
	// Returning CANCEL deletes the Ecore handle itself.
	self->__timer = nullptr;
	self->__idler = nullptr;
	delete self;
	return ECORE_CALLBACK_CANCEL;
}

void WUiTimer::__ownerDelCb(void *data, Evas *, Evas_Object *, void *)
{
	WUiTimer *self = static_cast<WUiTimer *>(data);
	self->__owner = nullptr;
	self->__end();
}

} // namespace app_assist
