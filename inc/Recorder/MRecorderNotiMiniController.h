#ifndef INC_RECORDER_MRECORDERNOTIMINICONTROLLER_H
#define INC_RECORDER_MRECORDERNOTIMINICONTROLLER_H

#include <Ecore.h>
#include <Evas.h>
#include <app_control.h>
#include <minicontrol-provider.h>
#include <recorder.h>

#include "WSignal.h"

// The running recording in the notification panel: pause or resume, stop, cancel (after the memo popup's
// confirmation) and a title that brings the app back. It owns no audio: it reads the state of the owner's
// recorder and reports presses through _signal, every event with a null second argument:
// "recorder,stopped", "recorder,paused" (resume button), "recorder,resumed" (pause button) and
// "recorder,canceled". The owner toggles on either of the pause and resume events.
class MRecorderNotiMiniController
{
public:
	explicit MRecorderNotiMiniController(recorder_h recorder);
	~MRecorderNotiMiniController();

	// Makes the window "memorecorder_mini_controller" with its layout and shows it.
	void create();
	// Hides and deletes the window and drops the rotation handler.
	void hide();
	// Deletes the window and the handler and ends a pending cancel popup.
	void destroy();
	// Shows the recorder's state (paused or recording) in the layout.
	void update();
	// The elapsed time as text: below one hour, and from one hour on.
	void setTime(const char *text);
	void setTimeHour(const char *text);

	Evas_Object *_layout;
	Evas_Object *_win;
	int _rotation;
	recorder_h _recorder;
	app_control_h _popupRequest;
	Ecore_Event_Handler *_xEventHandler;
	app_assist::WSignal<void(const char *, const char *)> _signal;

	void _registerXEvent();
	static Eina_Bool _clientMessageCb(void *data, int type, void *event);
	static void _titleButtonCliked(void *data, Evas_Object *obj, const char *emission, const char *source);
	void _requestCancelPopup();

private:
	void __addCancelButton();
	void __addTitle();
	void __addStopButton();
	void __addResumeButton();
	void __addPauseButton();
	void __cancel();
	static void __windowEventCb(minicontrol_viewer_event_e event, bundle *arg);
	static void __cancelBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
	static void __stopBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
	static void __resumeBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
	static void __pauseBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
	static void __popupReplyCb(app_control_h request, app_control_h reply, app_control_result_e result,
	                           void *user_data);
};

// The controller of the latest construction, for the window's event callback, which gets no user data.
extern MRecorderNotiMiniController *gRecorderNotiMiniController;

#endif
