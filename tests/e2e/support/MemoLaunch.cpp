#include "MemoLaunch.h"

#include <sqlite3.h>

#include "TestEnv.h"

namespace memo_test
{
MemoLaunch::MemoLaunch(const std::string &env, const std::string &dataRoot, const std::string &launcher)
    : root(dataRoot.empty() ? makeTempDir("memo-launch") : dataRoot),
      __env(dataRoot.empty() ? env + " TIZEN_APP_ROOT='" + root + "' " : env + " "), __launcher(launcher)
{
}

int MemoLaunch::run(const std::string &cmd, std::string *out) const
{
	return runCommand(__env + cmd, out);
}

int MemoLaunch::send(const std::string &args, std::string *out) const
{
	return run("'" + __launcher + "' -s com.veltron.memo " + args + " 2>/dev/null", out);
}

std::string MemoLaunch::start(const std::string &args, std::string *out)
{
	__logStart = readFile(root + "/data/dlog.log").size();
	if (args.empty() || args[0] == '-')
		send(args, out);
	else
		run(args + " >/dev/null 2>&1 &");
	const std::string mark = "first page: ";
	if (!waitForLog(mark))
		return "";
	const std::string text = log();
	const size_t at = text.find(mark) + mark.size();
	return text.substr(at, text.find('\n', at) - at);
}

bool MemoLaunch::waitForLog(const std::string &text) const
{
	return pump(20.0, [&] { return log().find(text) != std::string::npos; });
}

MemoLaunch::~MemoLaunch()
{
	end();
}

bool MemoLaunch::end() const
{
	return send("-k com.veltron.memo >/dev/null") == 0 && waitForLog("> ~MemoApp");
}

std::string MemoLaunch::log() const
{
	const std::string all = readFile(root + "/data/dlog.log");
	return all.size() > __logStart ? all.substr(__logStart) : std::string();
}

std::string MemoLaunch::query(const std::string &sql) const
{
	std::string result;
	sqlite3 *db = nullptr;
	sqlite3_stmt *stmt = nullptr;
	if (sqlite3_open_v2((root + "/data/memo.db").c_str(), &db, SQLITE_OPEN_READONLY, nullptr) == SQLITE_OK &&
	    sqlite3_prepare_v2(db, sql.c_str(), -1, &stmt, nullptr) == SQLITE_OK && sqlite3_step(stmt) == SQLITE_ROW &&
	    sqlite3_column_text(stmt, 0))
		result = reinterpret_cast<const char *>(sqlite3_column_text(stmt, 0));
	sqlite3_finalize(stmt);
	sqlite3_close(db);
	return result;
}
} // namespace memo_test
