/* Holds a write lock on a SQLite file for a while, as the sync service would.
   Usage: test_dblock <db path> <seconds, fractions allowed> <ready file>
   Takes the lock, creates <ready file>, sleeps, then commits. Exit status 1 when the lock cannot be had. */
#include <sqlite3.h>
#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

int main(int argc, char **argv)
{
	if (argc != 4) {
		fprintf(stderr, "usage: %s <db> <seconds> <ready file>\n", argv[0]);
		return 2;
	}
	sqlite3 *db = NULL;
	if (sqlite3_open_v2(argv[1], &db, SQLITE_OPEN_READWRITE, NULL) != SQLITE_OK ||
	    sqlite3_exec(db, "BEGIN IMMEDIATE; UPDATE android_metadata SET locale = locale;", NULL, NULL, NULL) !=
	        SQLITE_OK) {
		fprintf(stderr, "lock: %s\n", sqlite3_errmsg(db));
		sqlite3_close(db);
		return 1;
	}
	FILE *ready = fopen(argv[3], "w");
	if (ready)
		fclose(ready);
	usleep((useconds_t)(atof(argv[2]) * 1e6));
	sqlite3_exec(db, "COMMIT", NULL, NULL, NULL);
	sqlite3_close(db);
	return 0;
}
