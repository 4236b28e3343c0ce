// Listener ids shared by every WSignal of the process.
#include "WSignalIdGenerator.h"

namespace app_assist
{

unsigned int WSignalIdGenerator::generate()
{
	static unsigned int lastId = 0;
	return ++lastId;
}

} // namespace app_assist
