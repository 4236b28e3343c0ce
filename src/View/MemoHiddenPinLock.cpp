// The PIN's lock-out, kept in a preference key so that it outlives the process.
#include "View/MemoHiddenPinLock.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>

#include <Ecore.h>
#include <app_preference.h>

#include "MemoLog.h"

namespace
{
const char LOCK_KEY[] = "HIDDEN_PIN_LOCKOUT";
const int FREE_TRIES = 5;
const double FIRST_LOCK_SEC = 30.0;
const double LONGEST_LOCK_SEC = 3600.0;

std::function<double()> gClock;

double __now()
{
	return gClock ? gClock() : ecore_time_unix_get();
}

struct LockState {
	int wrongCount = 0;
	double lockedUntil = 0.0;
};

LockState __read()
{
	LockState state;
	char *text = nullptr;
	if (preference_get_string(LOCK_KEY, &text) == PREFERENCE_ERROR_NONE && text &&
	    sscanf(text, "%d %lf", &state.wrongCount, &state.lockedUntil) != 2)
		state = LockState();
	free(text);
	return state;
}

void __write(const LockState &state)
{
	char text[64];
	snprintf(text, sizeof(text), "%d %.3f", state.wrongCount, state.lockedUntil);
	if (preference_set_string(LOCK_KEY, text) != PREFERENCE_ERROR_NONE)
		MEMO_LOGE("cannot keep the PIN lock-out");
}

// The wait that the count of wrong PINs earns: 30 s at the fifth, doubled with each further one, an hour at most.
double __lockSeconds(int wrongCount)
{
	if (wrongCount < FREE_TRIES)
		return 0.0;
	const int doublings = wrongCount - FREE_TRIES;
	return doublings >= 7 ? LONGEST_LOCK_SEC : std::fmin(FIRST_LOCK_SEC * (1 << doublings), LONGEST_LOCK_SEC);
}
} // namespace

int MemoHiddenPinLock::getWrongCount()
{
	return __read().wrongCount;
}

int MemoHiddenPinLock::getRemainingSeconds()
{
	const LockState state = __read();
	// A clock set back must not stretch the lock beyond what the count earned.
	const double remaining = std::fmin(state.lockedUntil - __now(), __lockSeconds(state.wrongCount));
	return remaining > 0.0 ? static_cast<int>(std::ceil(remaining)) : 0;
}

int MemoHiddenPinLock::addWrongPin()
{
	LockState state = __read();
	state.wrongCount++;
	const double seconds = __lockSeconds(state.wrongCount);
	if (seconds > 0.0)
		state.lockedUntil = __now() + seconds;
	__write(state);
	MEMO_LOGI("wrong PIN %d in a row%s", state.wrongCount, seconds > 0.0 ? ", tries locked" : "");
	return static_cast<int>(seconds);
}

void MemoHiddenPinLock::clear()
{
	bool exists = false;
	if (preference_is_existing(LOCK_KEY, &exists) == PREFERENCE_ERROR_NONE && exists)
		preference_remove(LOCK_KEY);
}

void MemoHiddenPinLock::setClock(std::function<double()> clock)
{
	gClock = std::move(clock);
}
