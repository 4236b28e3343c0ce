#ifndef SRC_DATABASE_MEMOLISTROWS_H
#define SRC_DATABASE_MEMOLISTROWS_H

// The rows of a list read, kept so that reads of the same statement that follow while the database has not
// changed (the screens read the whole list several times in one step) build their records from them instead
// of running the statement again. The records, and every line their setters log, are the same either way.

#include <memory>
#include <string>
#include <vector>

#include "DataBase/MemoText.h"
#include "MemoSqlStmt.h"

// One column value of a row: its text (null for SQL NULL) and its integer value, as the statement gives them.
// An integer's text is made when it is first asked for (the list reads ask for none).
struct MemoListValue {
	long long integer;
	mutable MemoText text;
	bool isInteger;
};

class MemoListRows
{
public:
	// Reads the rest of the statement's rows.
	explicit MemoListRows(MemoSqlStmt &stmt, int columns);
	int count() const { return static_cast<int>(__rows.size() / static_cast<size_t>(__columns)); }
	// What the texts of the rows are borrowed from: a record holding them keeps it.
	std::shared_ptr<const MemoTextArena> texts() const { return __texts; }
	const MemoListValue &at(int row, int column) const
	{
		return __rows[static_cast<size_t>(row) * static_cast<size_t>(__columns) + static_cast<size_t>(column)];
	}

	// The kept rows of sql when nothing has changed in the database since they were read, else null.
	static std::shared_ptr<const MemoListRows> find(sqlite3 *db, const char *sql);
	// Keeps rows as those of sql until the database changes or the main loop next goes idle.
	static void keep(sqlite3 *db, const char *sql, std::shared_ptr<const MemoListRows> rows);
	// Forgets the kept rows.
	static void forget();

private:
	int __columns;
	std::shared_ptr<MemoTextArena> __texts;
	std::vector<MemoListValue> __rows;
};

// The column readers of __fillRecord over kept rows, named as those of MemoSqlStmt.
class MemoListRowReader
{
public:
	MemoListRowReader(const MemoListRows &rows, int row) : __rows(rows), __row(row) {}
	const MemoText &text(int column)
	{
		const MemoListValue &value = __rows.at(__row, column);
		if (value.isInteger && value.text.isNull())
			value.text = MemoText(std::to_string(value.integer).c_str());
		return value.text;
	}
	int integer(int column) { return static_cast<int>(__rows.at(__row, column).integer); }
	unsigned long long u64(int column) { return static_cast<unsigned long long>(__rows.at(__row, column).integer); }

private:
	const MemoListRows &__rows;
	int __row;
};

#endif
