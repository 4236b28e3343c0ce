#include "DataBase/MemoFileInfo.h"

#include <cstdlib>
#include <cstring>

#include <Ecore_File.h>

#include "MemoLog.h"

MemoFileInfo::MemoFileInfo() : __isDirty(0), __isDeleted(0), __sync1(0), __isNeedUpsync(0), __size(0), __orientation(0)
{
}

MemoFileInfo::~MemoFileInfo() {}

// A flag column holds 0 or 1; a negative value fails the test too, as unsigned.
static bool __isFlag(int value)
{
	return static_cast<unsigned int>(value) <= 1;
}

bool MemoFileInfo::setFileUUID(const char *uuid)
{
	if (!uuid) {
		MEMO_LOGE("uuid is NULL");
		return false;
	}
	__fileUUID = uuid;
	return true;
}

bool MemoFileInfo::setIsDirty(int isDirty)
{
	if (!__isFlag(isDirty)) {
		MEMO_LOGE("isDirty is Wrong Value");
		return false;
	}
	__isDirty = isDirty;
	return true;
}

bool MemoFileInfo::setIsDeleted(int isDeleted)
{
	if (!__isFlag(isDeleted)) {
		MEMO_LOGE("isDeleted is Wrong Value");
		return false;
	}
	__isDeleted = isDeleted;
	return true;
}

bool MemoFileInfo::setAccountType(const char *accountType)
{
	if (!accountType) {
		MEMO_LOGE("accountType is NULL");
		return false;
	}
	__accountType = accountType;
	return true;
}

bool MemoFileInfo::setAccountName(const char *accountName)
{
	if (!accountName) {
		MEMO_LOGE("accountName is NULL");
		return false;
	}
	__accountName = accountName;
	return true;
}

bool MemoFileInfo::setSync1(unsigned long long sync1)
{
	__sync1 = sync1;
	return true;
}

bool MemoFileInfo::setSync2(const char *sync2)
{
	if (!sync2) {
		MEMO_LOGE("sync2 is NULL");
		return false;
	}
	__sync2 = sync2;
	return true;
}

bool MemoFileInfo::setIsNeedUpsync(int isNeedUpsync)
{
	if (!__isFlag(isNeedUpsync)) {
		MEMO_LOGE("isNeedUpsync is Wrong Value");
		return false;
	}
	__isNeedUpsync = isNeedUpsync;
	return true;
}

bool MemoFileInfo::setMemoUUID(const char *memoUUID)
{
	if (!memoUUID) {
		MEMO_LOGE("memoUUID is NULL");
		return false;
	}
	__memoUUID = memoUUID;
	return true;
}

bool MemoFileInfo::setMimeType(const char *mimeType)
{
	if (!mimeType) {
		MEMO_LOGE("mimeType is NULL");
		return false;
	}
	__mimeType = mimeType;
	return true;
}

bool MemoFileInfo::setDisplayName(const char *displayName)
{
	if (!displayName) {
		MEMO_LOGE("displayName is NULL");
		return false;
	}
	__displayName = displayName;
	return true;
}

bool MemoFileInfo::setSize(long long size)
{
	if (size < 0) {
		MEMO_LOGE("size is Wrong Value");
		return false;
	}
	__size = size;
	return true;
}

bool MemoFileInfo::setOrientation(int orientation)
{
	__orientation = orientation;
	return true;
}

bool MemoFileInfo::setData(const char *data)
{
	if (!data) {
		MEMO_LOGE("data is NULL");
		return false;
	}
	__data = data;
	return true;
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
