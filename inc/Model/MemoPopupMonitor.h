#ifndef INC_MODEL_MEMOPOPUPMONITOR_H
#define INC_MODEL_MEMOPOPUPMONITOR_H

#include <WViewController.h>

// Knows the one popup opened last anywhere in the process, without owning it, so that no view opens a popup
// over another. Views register each popup they create. Main loop only.
class MemoPopupMonitor
{
public:
	// The singleton, built on first use.
	static MemoPopupMonitor *getInstance();
	// Deletes the singleton; a later getInstance starts with no popup.
	static void destroy();

	virtual ~MemoPopupMonitor();

	// Tracks popup in place of the previous one. A null popup logs "Input is null" and changes nothing.
	void addPopup(app_assist::WViewController *popup);
	// True while the tracked popup still exists; false when none was tracked or it has gone.
	bool isPopupAlive();
	// The tracked popup while it exists, else null. Not owned by the caller.
	app_assist::WViewController *getPopup();

private:
	MemoPopupMonitor();
	MemoPopupMonitor(const MemoPopupMonitor &) = delete;
	MemoPopupMonitor &operator=(const MemoPopupMonitor &) = delete;

	app_assist::WViewControllerWeakPtr __popupWeakPtr;
	app_assist::WViewController *__popup;

	static MemoPopupMonitor *__instance;
};

#endif
