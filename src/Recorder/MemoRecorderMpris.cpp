// The take on the session bus: the desktop's media controls pause, resume and stop it as the mini controllers
// do.
#include "Recorder/MemoRecorder.h"

#include <cstring>

#include "Recorder/MRecorderLockScreenMiniController.h"
#include "Recorder/MRecorderNotiMiniController.h"
#include "Recorder/MemoMprisPlayer.h"

void MemoRecorder::setMediaTitle(const char *title)
{
	__mediaTitle = title ? title : "";
	if (__mpris)
		__mpris->setTitle(__mediaTitle.c_str());
}

void MemoRecorder::__startMpris()
{
	if (__mpris || !__recorder)
		return;
	__mpris = new MemoMprisPlayer(__recorder, __mediaTitle.c_str());
	if (!__mpris->create()) {
		delete __mpris;
		__mpris = nullptr;
		return;
	}
	__mpris->_signal.addListener([this](const char *event, const char *) {
		if (!strcmp(event, "recorder,paused"))
			__pauseResumeCb(this, nullptr, nullptr, nullptr);
		else if (!strcmp(event, "recorder,stopped"))
			recorderStopCb(this, nullptr, nullptr, nullptr);
		__refreshNotiMini();
		__refreshLockMini();
	});
}

void MemoRecorder::__stopMpris()
{
	delete __mpris;
	__mpris = nullptr;
}

void MemoRecorder::__updateMpris()
{
	if (__mpris) {
		__mpris->setPosition(static_cast<unsigned long long>(__elapsedMs));
		__mpris->update();
	}
}
