#ifndef SRC_DATABASE_MEMOSQLSTMT_H
#define SRC_DATABASE_MEMOSQLSTMT_H

#include <sqlite3.h>

// Owns one prepared statement and finalises it when the scope ends, whatever the way out.
class MemoSqlStmt
{
public:
	explicit MemoSqlStmt(sqlite3_stmt *stmt) : __stmt(stmt) {}
	~MemoSqlStmt()
	{
		if (__stmt)
			sqlite3_finalize(__stmt);
	}
	MemoSqlStmt(const MemoSqlStmt &) = delete;
	MemoSqlStmt &operator=(const MemoSqlStmt &) = delete;

	explicit operator bool() const { return __stmt != nullptr; }
	int step() { return sqlite3_step(__stmt); }
	// Column readers of the current row; text is null for SQL NULL.
	const char *text(int column) { return reinterpret_cast<const char *>(sqlite3_column_text(__stmt, column)); }
	int integer(int column) { return sqlite3_column_int(__stmt, column); }
	unsigned long long u64(int column) { return static_cast<unsigned long long>(sqlite3_column_int64(__stmt, column)); }
	int bytes(int column) { return sqlite3_column_bytes(__stmt, column); }
	int type(int column) { return sqlite3_column_type(__stmt, column); }

private:
	sqlite3_stmt *__stmt;
};

#endif
