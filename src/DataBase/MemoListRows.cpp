#include "MemoListRows.h"

#include <cstring>

#include <Ecore.h>

namespace
{
// What the rows were read at: the statement, the database's version as other connections left it, and the
// changes this connection has made.
struct Kept {
	std::string sql;
	long long dataVersion = -1;
	long long ownChanges = -1;
	std::shared_ptr<const MemoListRows> rows;
	Ecore_Idle_Enterer *dropper = nullptr;
};

Kept gKept;

long long __dataVersion(sqlite3 *db)
{
	sqlite3_stmt *stmt = nullptr;
	long long version = -1;
	if (sqlite3_prepare_v2(db, "PRAGMA data_version", -1, &stmt, nullptr) == SQLITE_OK &&
	    sqlite3_step(stmt) == SQLITE_ROW)
		version = sqlite3_column_int64(stmt, 0);
	sqlite3_finalize(stmt);
	return version;
}

// A text's integer as SQLite reads it: leading blanks, a sign and digits, else 0. Only a text that may start a
// number is handed to SQLite.
long long __integerOf(MemoSqlStmt &stmt, int column, const char *text)
{
	if (!text || !*text || !strchr(" \t\n\v\f\r+-0123456789", *text))
		return 0;
	return static_cast<long long>(stmt.u64(column));
}

Eina_Bool __dropCb(void *)
{
	gKept.dropper = nullptr;
	MemoListRows::forget();
	return ECORE_CALLBACK_CANCEL;
}
} // namespace

MemoListRows::MemoListRows(MemoSqlStmt &stmt, int columns)
    : __columns(columns), __texts(std::make_shared<MemoTextArena>())
{
	while (stmt.step() == SQLITE_ROW) {
		for (int c = 0; c < columns; ++c) {
			const int type = stmt.type(c);
			if (type == SQLITE_INTEGER) {
				__rows.push_back({static_cast<long long>(stmt.u64(c)), MemoText(), true});
			} else if (type == SQLITE_NULL) {
				__rows.push_back({0, MemoText(), false});
			} else {
				// The text first: the integer reading of a text leaves it as it was.
				const char *text = stmt.text(c);
				MemoText value = __texts->add(text);
				__rows.push_back({__integerOf(stmt, c, text), std::move(value), false});
			}
		}
	}
}

std::shared_ptr<const MemoListRows> MemoListRows::find(sqlite3 *db, const char *sql)
{
	if (!gKept.rows || gKept.sql != sql)
		return nullptr;
	if (gKept.ownChanges != sqlite3_total_changes64(db) || gKept.dataVersion != __dataVersion(db)) {
		forget();
		return nullptr;
	}
	return gKept.rows;
}

void MemoListRows::keep(sqlite3 *db, const char *sql, std::shared_ptr<const MemoListRows> rows)
{
	gKept.sql = sql;
	gKept.dataVersion = __dataVersion(db);
	gKept.ownChanges = sqlite3_total_changes64(db);
	gKept.rows = std::move(rows);
	// The rows serve one step of the program; an idle main loop has finished it.
	if (!gKept.dropper)
		gKept.dropper = ecore_idle_enterer_add(__dropCb, nullptr);
}

void MemoListRows::forget()
{
	gKept.rows.reset();
	gKept.sql.clear();
}
