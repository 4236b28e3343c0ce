#ifndef BENCH_LOOPITERATIONS_H
#define BENCH_LOOPITERATIONS_H

// The main loop's iterations as the benchmarks watch them: from leaving idle to entering it again, in wall
// clock and in the main thread's processor time (which a loaded machine does not inflate).

#include <Ecore.h>
#include <time.h>

#include <algorithm>
#include <functional>

namespace memo_bench
{

inline double threadCpuTime()
{
	timespec ts = {};
	clock_gettime(CLOCK_THREAD_CPUTIME_ID, &ts);
	return ts.tv_sec + ts.tv_nsec / 1e9;
}

// Keeps the longest iteration while `counting` holds; `onIdle` runs as each iteration ends. Whoever makes
// it runs the loop; its handlers go with it.
struct LoopIterations {
	bool counting = false;
	double longestMs = 0, longestCpuMs = 0;
	std::function<void()> onIdle;

	LoopIterations()
	    : __exiter(ecore_idle_exiter_add(__wokeCb, this)), __enterer(ecore_idle_enterer_add(__sleepsCb, this))
	{
	}
	~LoopIterations()
	{
		ecore_idle_enterer_del(__enterer);
		ecore_idle_exiter_del(__exiter);
	}
	LoopIterations(const LoopIterations &) = delete;
	LoopIterations &operator=(const LoopIterations &) = delete;

private:
	static Eina_Bool __wokeCb(void *data)
	{
		LoopIterations *self = static_cast<LoopIterations *>(data);
		self->__awakeSince = ecore_time_get();
		self->__awakeCpuSince = threadCpuTime();
		return ECORE_CALLBACK_RENEW;
	}
	static Eina_Bool __sleepsCb(void *data)
	{
		LoopIterations *self = static_cast<LoopIterations *>(data);
		if (self->onIdle)
			self->onIdle();
		if (self->counting && self->__awakeSince > 0) {
			self->longestMs = std::max(self->longestMs, (ecore_time_get() - self->__awakeSince) * 1000.0);
			self->longestCpuMs = std::max(self->longestCpuMs, (threadCpuTime() - self->__awakeCpuSince) * 1000.0);
		}
		return ECORE_CALLBACK_RENEW;
	}

	Ecore_Idle_Exiter *__exiter;
	Ecore_Idle_Enterer *__enterer;
	double __awakeSince = -1, __awakeCpuSince = 0;
};

} // namespace memo_bench

#endif
