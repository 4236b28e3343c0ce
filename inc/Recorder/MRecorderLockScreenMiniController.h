#ifndef INC_RECORDER_MRECORDERLOCKSCREENMINICONTROLLER_H
#define INC_RECORDER_MRECORDERLOCKSCREENMINICONTROLLER_H

#include <Evas.h>
#include <recorder.h>

#include "WSignal.h"

// The running recording on the lock screen: stop ("recorder,stopped"), pause and resume (both
// "recorder,paused"), the state and the time. No cancel, no way back into the app.
class MRecorderLockScreenMiniController
{
public:
	explicit MRecorderLockScreenMiniController(recorder_h recorder);
	~MRecorderLockScreenMiniController();

	// Makes the window "memo-minicontrol.LOCKSCREEN" with its layout and shows it.
	void create();
	// Hides and deletes the window.
	void hide();
	// Shows the recorder's state (paused or recording).
	void update();
	// The elapsed time as text, in any format.
	void setTime(const char *text);

	Evas_Object *_layout;
	Evas_Object *_win;
	recorder_h _recorder;
	app_assist::WSignal<void(const char *, const char *)> _signal;

private:
	static void __stopBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
	static void __toggleBtnCb(void *data, Evas *e, Evas_Object *obj, void *event_info);
};

#endif
