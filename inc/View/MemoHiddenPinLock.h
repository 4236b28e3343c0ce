#ifndef INC_VIEW_MEMOHIDDENPINLOCK_H
#define INC_VIEW_MEMOHIDDENPINLOCK_H

#include <functional>

// The lock-out of the PIN: after five wrong PINs in a row further tries are refused for 30 seconds, and each
// further wrong PIN doubles the wait, up to an hour. The count and the end of the lock live in the package's
// preference key "HIDDEN_PIN_LOCKOUT" as "<wrong PINs in a row> <end of the lock in seconds since the epoch>",
// so that a restart of the app does not lift them. A right PIN clears both.
class MemoHiddenPinLock
{
public:
	// Wrong PINs in a row so far.
	static int getWrongCount();
	// Seconds still to wait before the next try, 0 when tries are taken.
	static int getRemainingSeconds();
	// Counts a wrong PIN; from the fifth in a row on it locks. Returns the seconds of the new lock, 0 for none.
	static int addWrongPin();
	// A right PIN: the count and the lock go.
	static void clear();
	// The clock in seconds since the epoch; tests move it. An empty function restores the wall clock.
	static void setClock(std::function<double()> clock);
};

#endif
