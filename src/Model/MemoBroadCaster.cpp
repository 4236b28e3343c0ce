// The broadcast bus: one process-wide signal of string keys.
#include "Model/MemoBroadCaster.h"

MemoBroadCaster *MemoBroadCaster::__instance = nullptr;

MemoBroadCaster::MemoBroadCaster() {}

MemoBroadCaster::~MemoBroadCaster() {}

MemoBroadCaster::Signal &MemoBroadCaster::getInstance()
{
	if (!__instance)
		__instance = new MemoBroadCaster();
	return __instance->__signal;
}

void MemoBroadCaster::destroy()
{
	// Cleared first, so that a listener reached from the signal's teardown cannot see a dying bus.
	MemoBroadCaster *instance = __instance;
	__instance = nullptr;
	delete instance;
}
