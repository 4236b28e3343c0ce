// The quick memo row (pinned, collects text from other applications) and the PIN row.
#include "DataBase/MemoDbMgr.h"

#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>

#include <Ecore_File.h>
#include <app_common.h>
#include <app_i18n.h>
#include <sqlite3.h>

#include "DataBase/MemoDocInfo.h"
#include "MemoCvt.h"
#include "MemoDbSupport.h"
#include "MemoLog.h"
#include "MemoSqlStmt.h"
#include "Util/MemoUtil.h"

#define MEMO_QUICK_MEMO_BG_COLOR "252;191;169;255;"
#define MEMO_TODOLIST_END "</todolist>"
#define MEMO_EMPTY_TODOLIST "<todolist></todolist>"

// isDirty is named twice; SQLite takes the first value, so the row starts clean.
#define MEMO_SQL_INSERT_QUICK_MEMO                                                                                     \
	"INSERT INTO memo(UUID,isDirty,isDeleted,createdAt,lastModifiedAt,title,content,tizenXmlContent,xmlContent,"       \
	"display_Content,strippedContent,isFavorite,isHidden,isQuick,isDirty,bgColor)VALUES('%q',%d,%d,%llu, %llu, "       \
	"'%q', '%q','%q','%q','%q','%q',%d,%d,%d,%d,'%q')"
#define MEMO_SQL_UPDATE_QUICK_TEXT                                                                                     \
	"UPDATE memo SET xmlContent='%q', tizenXmlContent='%q', content = '%q',strippedContent = '%q', display_Content "   \
	"= '%q', lastModifiedAt = %llu, isDirty = %d WHERE UUID = '%q'"
#define MEMO_SQL_INIT_QUICK_MEMO                                                                                       \
	"UPDATE memo SET isDirty=1, lastModifiedAt=%llu, content='%q', display_Content='%q', strippedContent='%q', "       \
	"xmlContent='%q', tizenXmlContent='%q', _data='%q' WHERE _id=1"

bool MemoDbMgr::__createQuickMemo()
{
	const char *title = i18n_get_text("IDS_MEMO_HEADER_SYNCED_QUICK_MEMO");
	char *uuid = nullptr;
	if (!MemoUtil::createUUIDN(&uuid))
		return false;

	char *dataPath = app_get_data_path();
	if (!dataPath) {
		MEMO_LOGE("Failed to get resource path=NULL!!!");
	} else {
		std::string media = std::string(dataPath) + "media/" + uuid;
		if (!ecore_file_is_dir(media.c_str()))
			ecore_file_mkpath(media.c_str());
		free(dataPath);
	}

	unsigned long long now = memoDbTimeStamp();
	int ret = excuteSql(MEMO_SQL_INSERT_QUICK_MEMO, uuid, 0, 0, now, now, title ? title : "", "", "", "", "", "", 0, 0,
	                    1, 1, MEMO_QUICK_MEMO_BG_COLOR);
	free(uuid);
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	return true;
}

bool MemoDbMgr::addQuickMemo(const char *text)
{
	if (!text) {
		MEMO_LOGE("input is NULL");
		return false;
	}
	int count = 0;
	{
		MemoSqlStmt stmt(__createSqliteStmt("SELECT count(*) FROM memo WHERE isDeleted = 0 AND  isQuick = 1"));
		int ret = stmt ? stmt.step() : SQLITE_ERROR;
		if (ret != SQLITE_ROW) {
			MEMO_LOGE("ERROR(%d).", ret);
			return false;
		}
		count = stmt.integer(0);
	}
	// No quick memo row (feature off, or removed): the text is dropped.
	if (count != 1) {
		MEMO_LOGE("Quick Memo Count Error(%d).", count);
		return false;
	}

	std::unique_ptr<MemoDocInfo> info(new MemoDocInfo());
	{
		MemoSqlStmt stmt(
		    __createSqliteStmt("SELECT UUID, tizenXmlContent FROM memo WHERE isDeleted = 0 AND isQuick = 1 "));
		if (stmt && stmt.step() == SQLITE_ROW) {
			info->setMemoUUID(stmt.text(0));
			info->setTizenXmlContent(stmt.text(1));
		}
	}

	// Text from other applications may hold control characters, which would leave a document that
	// cannot be read back: the memo would open empty.
	std::unique_ptr<char, decltype(&free)> storable(MemoUtil::stripControlCharsN(text), free);
	if (!storable) {
		MEMO_LOGE("out of memory");
		return false;
	}
	// The text becomes the last unchecked item; it goes in unescaped, as the converter expects.
	std::string item =
	    std::string("<todolist_item todo_item_type=\"0\" todo_item_state=\"false\" todo_item_content=\"") +
	    storable.get() + "\"/></todolist>";
	std::string document = info->getTizenXmlContent();
	if (document.empty()) {
		MEMO_LOGE("Quick Memo is Empty");
		document = MEMO_EMPTY_TODOLIST;
	}
	size_t end = document.find(MEMO_TODOLIST_END);
	if (end == std::string::npos) {
		document = MEMO_EMPTY_TODOLIST;
		end = document.find(MEMO_TODOLIST_END);
	}
	document.replace(end, strlen(MEMO_TODOLIST_END), item);

	MemoCvt converter(static_cast<_MemoCvtSrcDbType>(4), document);
	converter.addQuickMemoItem(storable.get());
	// The body now holds at least the new item, so an empty document means that writing it failed:
	// storing it would empty the quick memo.
	const std::string written = converter.getTizenXmlContent();
	if (written.empty()) {
		MEMO_LOGE("Quick memo document not written; the stored memo is kept.");
		return false;
	}
	info->setTizenXmlContent(written.c_str());
	info->setAndroidXmlContent(converter.getXmlContent().c_str());
	info->setContent(converter.getContent().c_str());
	info->setDisplayContent(converter.getDisplayContent().c_str());
	info->setStrippedContent(converter.getStrippedContent().c_str());
	info->setLastModifiedAt(memoDbTimeStamp());

	// Nothing to tell the caller if this fails: the launch request is answered either way.
	excuteSql(MEMO_SQL_UPDATE_QUICK_TEXT, info->getAndroidXmlContent(), info->getTizenXmlContent(), info->getContent(),
	          info->getStrippedContent(), info->getDisplayContent(), info->getLastModifiedAt(), 1, info->getMemoUUID());
	return true;
}

bool MemoDbMgr::initQuickMemo()
{
	// By _id, not isQuick: the quick memo is the first row ever written.
	int ret = excuteSql(MEMO_SQL_INIT_QUICK_MEMO, memoDbTimeStamp(), "", "", "", "", "", "");
	if (ret != SQLITE_OK) {
		MEMO_LOGE("ERROR(%d).", ret);
		return false;
	}
	return true;
}

bool MemoDbMgr::getHiddenMemoPassword(char *buffer)
{
	MemoSqlStmt stmt(__createSqliteStmt("SELECT hiddenPass FROM password"));
	if (!stmt)
		return false;
	int ret = stmt.step();
	if (ret == SQLITE_ROW) {
		const char *pin = stmt.text(0);
		if (pin && *pin && buffer) {
			strcpy(buffer, pin);
			return true;
		}
	}
	// An unset PIN lands here too, with the code of a row.
	MEMO_LOGE("ERROR(%d).", ret);
	return false;
}

bool MemoDbMgr::setHiddenMemoPassword(const char *text)
{
	if (!text) {
		MEMO_LOGE("Hidden Memo password is NULL");
		return false;
	}
	bool exists = false;
	{
		MemoSqlStmt stmt(__createSqliteStmt("SELECT hiddenPass FROM password"));
		exists = stmt && stmt.step() == SQLITE_ROW;
	}
	if (exists) {
		int ret = excuteSql("UPDATE password SET hiddenPass = '%q'", text);
		if (ret != SQLITE_OK) {
			MEMO_LOGE("ERROR(%d).", ret);
			return false;
		}
	} else if (excuteSql("INSERT INTO password(hiddenPass) VALUES('%q')", text) != SQLITE_OK) {
		MEMO_LOGE("password can`t be created");
		return false;
	}
	return true;
}
