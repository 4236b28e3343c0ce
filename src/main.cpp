// The memo application's entry: one MemoApp for the life of the process.
#include "MemoApp.h"

int main(int argc, char *argv[])
{
	MemoApp app;
	return app.start(argc, argv);
}
