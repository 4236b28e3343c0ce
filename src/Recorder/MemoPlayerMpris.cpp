// Playback on the session bus: the desktop's media controls pause, resume and end it as the mini controllers
// do.
#include "Recorder/MemoPlayer.h"

#include <cstring>

#include "Recorder/MemoMprisPlayer.h"

void MemoPlayer::setMediaTitle(const char *title)
{
	__mediaTitle = title ? title : "";
	if (__mpris)
		__mpris->setTitle(__mediaTitle.c_str());
}

void MemoPlayer::__startMpris()
{
	if (__mpris || !__player)
		return;
	__mpris = new MemoMprisPlayer(__player, __mediaTitle.c_str());
	if (!__mpris->create()) {
		delete __mpris;
		__mpris = nullptr;
		return;
	}
	__mpris->_signal.addListener([this](const char *event, const char *) {
		if (!strcmp(event, "player,pausedResumed"))
			__pauseResumeCb(this, nullptr, nullptr, nullptr);
		else if (!strcmp(event, "player,canceled"))
			__playerCompletedCb(this);
		__refreshNotiMini();
		__refreshLockMini();
	});
}

void MemoPlayer::__stopMpris()
{
	delete __mpris;
	__mpris = nullptr;
}

void MemoPlayer::__updateMpris()
{
	if (__mpris)
		__mpris->update();
}
