/* The result of the last call that reports by get_last_result(), per thread. */
#include <tizen_error.h>

static _Thread_local int __last_result;

int get_last_result(void)
{
	return __last_result;
}

void set_last_result(int err)
{
	__last_result = err;
}
