// The sync service's statements on memo.db.
#include "SyncSimStore.h"

#include <sqlite3.h>
#include <sys/time.h>
#include <uuid/uuid.h>

#include <cstdio>

#include "MemoCvt.h"

const char *const SyncSimStore::ACCOUNT_NAME = "sync-sim";

namespace
{
unsigned long long nowStamp()
{
	timeval tv;
	gettimeofday(&tv, nullptr);
	return static_cast<unsigned long long>(tv.tv_sec) * 1000;
}

std::string newUuid()
{
	uuid_t value;
	char text[37];
	uuid_generate(value);
	uuid_unparse(value, text);
	return text;
}

std::string escapeXml(const std::string &text)
{
	std::string out;
	for (char c : text) {
		switch (c) {
		case '&':
			out += "&amp;";
			break;
		case '<':
			out += "&lt;";
			break;
		case '>':
			out += "&gt;";
			break;
		case '"':
			out += "&quot;";
			break;
		default:
			out += c;
		}
	}
	return out;
}

// The body forms of a memo whose one text item is `text`.
struct Body {
	explicit Body(const std::string &text)
	    : cvt(MEMO_CVT_SRC_TODOLIST, "<todolist><todolist_item todo_item_type=\"0\" todo_item_state=\"false\" "
	                                 "todo_item_content=\"" +
	                                     escapeXml(text) + "\"/></todolist>")
	{
	}
	MemoCvt cvt;
};
} // namespace

SyncSimStore::~SyncSimStore()
{
	sqlite3_close_v2(__db);
}

bool SyncSimStore::open(const std::string &path)
{
	if (sqlite3_open_v2(path.c_str(), &__db, SQLITE_OPEN_READWRITE, nullptr) != SQLITE_OK) {
		fprintf(stderr, "sync-sim: cannot open %s: %s\n", path.c_str(), sqlite3_errmsg(__db));
		return false;
	}
	sqlite3_busy_timeout(__db, 10000);
	return true;
}

bool SyncSimStore::__exec(char *sql)
{
	char *message = nullptr;
	const int rc = sqlite3_exec(__db, sql, nullptr, nullptr, &message);
	if (rc != SQLITE_OK)
		fprintf(stderr, "sync-sim: %s (%d)\n", message ? message : "failed", rc);
	sqlite3_free(message);
	sqlite3_free(sql);
	return rc == SQLITE_OK;
}

bool SyncSimStore::begin()
{
	return __exec(sqlite3_mprintf("BEGIN IMMEDIATE"));
}

bool SyncSimStore::commit()
{
	return __exec(sqlite3_mprintf("COMMIT"));
}

void SyncSimStore::rollback()
{
	sqlite3_exec(__db, "ROLLBACK", nullptr, nullptr, nullptr);
}

std::string SyncSimStore::addMemo(const std::string &text)
{
	Body body(text);
	const std::string uuid = newUuid();
	const unsigned long long stamp = nowStamp();
	const bool ok = __exec(sqlite3_mprintf(
	    "INSERT INTO memo(UUID,isDirty,isDeleted,accountType,accountName,sync1,sync2,createdAt,lastModifiedAt,title,"
	    "content,tizenXmlContent,xmlContent,display_Content,strippedContent,isSynced,bgColor) VALUES('%q',0,0,"
	    "'com.veltron.account','%q',%llu,'',%llu,%llu,'','%q','%q','%q','%q','%q',1,'255;255;255;255;')",
	    uuid.c_str(), ACCOUNT_NAME, stamp, stamp, stamp, body.cvt.getContent().c_str(),
	    body.cvt.getTizenXmlContent().c_str(), body.cvt.getXmlContent().c_str(), body.cvt.getDisplayContent().c_str(),
	    body.cvt.getStrippedContent().c_str()));
	return ok ? uuid : "";
}

bool SyncSimStore::changeMemo(const std::string &uuid, const std::string &text)
{
	Body body(text);
	return __exec(sqlite3_mprintf("UPDATE memo SET content='%q',tizenXmlContent='%q',xmlContent='%q',"
	                              "display_Content='%q',strippedContent='%q',lastModifiedAt=%llu,isDirty=0,isSynced=1,"
	                              "sync1=%llu WHERE UUID='%q'",
	                              body.cvt.getContent().c_str(), body.cvt.getTizenXmlContent().c_str(),
	                              body.cvt.getXmlContent().c_str(), body.cvt.getDisplayContent().c_str(),
	                              body.cvt.getStrippedContent().c_str(), nowStamp(), nowStamp(), uuid.c_str()));
}

bool SyncSimStore::tombstone(const std::string &uuid)
{
	return __exec(sqlite3_mprintf("UPDATE memo SET isDeleted=1,isDirty=0,lastModifiedAt=%llu WHERE UUID='%q'",
	                              nowStamp(), uuid.c_str())) &&
	       __exec(sqlite3_mprintf("UPDATE file SET isDeleted=1 WHERE memoUUID='%q'", uuid.c_str()));
}

int SyncSimStore::markSynced()
{
	if (!__exec(sqlite3_mprintf("UPDATE memo SET isDirty=0,isSynced=1,sync1=%llu,accountType='com.veltron.account' "
	                            "WHERE isDirty=1 AND isDeleted=0",
	                            nowStamp())))
		return -1;
	const int rows = sqlite3_changes(__db);
	return __exec(sqlite3_mprintf("UPDATE file SET isDirty=0,isNeedUpsync=0 WHERE isDirty=1")) ? rows : -1;
}

std::vector<std::string> SyncSimStore::newestMemos(int n)
{
	std::vector<std::string> uuids;
	char *sql = sqlite3_mprintf("SELECT UUID FROM memo WHERE isDeleted=0 AND isQuick=0 ORDER BY lastModifiedAt DESC, "
	                            "_id DESC LIMIT %d",
	                            n);
	sqlite3_stmt *stmt = nullptr;
	if (sqlite3_prepare_v2(__db, sql, -1, &stmt, nullptr) == SQLITE_OK) {
		while (sqlite3_step(stmt) == SQLITE_ROW)
			uuids.emplace_back(reinterpret_cast<const char *>(sqlite3_column_text(stmt, 0)));
	}
	sqlite3_finalize(stmt);
	sqlite3_free(sql);
	return uuids;
}
