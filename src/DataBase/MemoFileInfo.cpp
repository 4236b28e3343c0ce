#include "DataBase/MemoFileInfo.h"

#include <cstdlib>
#include <cstring>

#include <Ecore_File.h>

#include "MemoLog.h"
#include "MemoRecordField.h"

MemoFileInfo::MemoFileInfo() : __isDirty(0), __isDeleted(0), __sync1(0), __isNeedUpsync(0), __size(0), __orientation(0)
{
}

MemoFileInfo::~MemoFileInfo() {}

bool MemoFileInfo::setFileUUID(const char *uuid)
{
	MEMO_RECORD_SET(uuid, __fileUUID, uuid, "uuid is NULL");
}

bool MemoFileInfo::setIsDirty(int isDirty)
{
	MEMO_RECORD_SET(memoRecordIsFlag(isDirty), __isDirty, isDirty, "isDirty is Wrong Value");
}

bool MemoFileInfo::setIsDeleted(int isDeleted)
{
	MEMO_RECORD_SET(memoRecordIsFlag(isDeleted), __isDeleted, isDeleted, "isDeleted is Wrong Value");
}

bool MemoFileInfo::setAccountType(const char *accountType)
{
	MEMO_RECORD_SET(accountType, __accountType, accountType, "accountType is NULL");
}

bool MemoFileInfo::setAccountName(const char *accountName)
{
	MEMO_RECORD_SET(accountName, __accountName, accountName, "accountName is NULL");
}

bool MemoFileInfo::setSync1(unsigned long long sync1)
{
	__sync1 = sync1;
	return true;
}

bool MemoFileInfo::setSync2(const char *sync2)
{
	MEMO_RECORD_SET(sync2, __sync2, sync2, "sync2 is NULL");
}

bool MemoFileInfo::setIsNeedUpsync(int isNeedUpsync)
{
	MEMO_RECORD_SET(memoRecordIsFlag(isNeedUpsync), __isNeedUpsync, isNeedUpsync, "isNeedUpsync is Wrong Value");
}

bool MemoFileInfo::setMemoUUID(const char *memoUUID)
{
	MEMO_RECORD_SET(memoUUID, __memoUUID, memoUUID, "memoUUID is NULL");
}

bool MemoFileInfo::setMimeType(const char *mimeType)
{
	MEMO_RECORD_SET(mimeType, __mimeType, mimeType, "mimeType is NULL");
}

bool MemoFileInfo::setDisplayName(const char *displayName)
{
	MEMO_RECORD_SET(displayName, __displayName, displayName, "displayName is NULL");
}

bool MemoFileInfo::setSize(long long size)
{
	MEMO_RECORD_SET(size >= 0, __size, size, "size is Wrong Value");
}

bool MemoFileInfo::setOrientation(int orientation)
{
	__orientation = orientation;
	return true;
}

bool MemoFileInfo::setData(const char *data)
{
	MEMO_RECORD_SET(data, __data, data, "data is NULL");
}

bool MemoFileInfo::setPath(const char *path)
{
	if (!path) {
		MEMO_LOGE("path is NULL");
		return false;
	}
	__path = path;

	// The sync side knows attachments by a virtual blob path made from the file's stem.
	char *stem = ecore_file_strip_ext(ecore_file_file_get(path));
	if (!stem)
		return true;
	size_t len = strlen(stem);
	if (len >= 2) {
		char data[1024];
		memset(data, 0, sizeof(data));
		snprintf(data, sizeof(data), "/app_attach/%c/%c/%s.blob", stem[len - 2], stem[len - 1], stem);
		setData(data);
	}
	free(stem);
	return true;
}
