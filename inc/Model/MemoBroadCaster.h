#ifndef INC_MODEL_MEMOBROADCASTER_H
#define INC_MODEL_MEMOBROADCASTER_H

#include <WSignal.h>

// The process's bus of surroundings changes: MemoApp emits a key ("broadcast,...") whenever the platform or
// the sync service reports something, and every live view listens for the keys it cares about. The payload
// is always null. Main loop only.
class MemoBroadCaster
{
public:
	using Signal = app_assist::WSignal<void(const char *, void *)>;

	// The bus's signal, building the singleton on first use. Listeners added with an owner Evas object
	// leave with that object.
	static Signal &getInstance();
	// Deletes the singleton with every listener still on it; a later getInstance starts empty.
	static void destroy();

	virtual ~MemoBroadCaster();

private:
	MemoBroadCaster();
	MemoBroadCaster(const MemoBroadCaster &) = delete;
	MemoBroadCaster &operator=(const MemoBroadCaster &) = delete;

	Signal __signal;

	static MemoBroadCaster *__instance;
};

#endif
