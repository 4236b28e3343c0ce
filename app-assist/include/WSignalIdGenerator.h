#ifndef APP_ASSIST_INCLUDE_WSIGNALIDGENERATOR_H
#define APP_ASSIST_INCLUDE_WSIGNALIDGENERATOR_H

namespace app_assist
{

// Process-wide source of listener ids for every WSignal.
class WSignalIdGenerator
{
public:
	// Returns a fresh id, larger than every id returned before (the first is 1). Main loop only.
	static unsigned int generate();
};

} // namespace app_assist

#endif
