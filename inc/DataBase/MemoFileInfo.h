#ifndef INC_DATABASE_MEMOFILEINFO_H
#define INC_DATABASE_MEMOFILEINFO_H

#include <string>

// One attachment row of the `file` table in memory (an image or the voice recording).
// Plain carrier between MemoDbMgr and the views; it never touches the database.
// String setters refuse null with an error line and keep the old value; they return
// true on success. String getters return character data valid while the record lives.
class MemoFileInfo
{
public:
	MemoFileInfo();
	virtual ~MemoFileInfo();

	bool setFileUUID(const char *uuid);
	bool setIsDirty(int isDirty);     // refuses anything but 0 and 1
	bool setIsDeleted(int isDeleted); // refuses anything but 0 and 1
	bool setAccountType(const char *accountType);
	bool setAccountName(const char *accountName);
	bool setSync1(unsigned long long sync1);
	bool setSync2(const char *sync2);
	bool setIsNeedUpsync(int isNeedUpsync); // refuses anything but 0 and 1
	bool setMemoUUID(const char *memoUUID);
	bool setMimeType(const char *mimeType);
	bool setDisplayName(const char *displayName);
	bool setSize(long long size); // refuses a negative size
	bool setOrientation(int orientation);
	bool setData(const char *data);
	// Stores the real location and derives `data` from the file's stem as
	// "/app_attach/<last but one char>/<last char>/<stem>.blob", replacing any data set before.
	bool setPath(const char *path);

	const char *getFileUUID() const { return __fileUUID.c_str(); }
	int getIsDirty() const { return __isDirty; }
	int getIsDeleted() const { return __isDeleted; }
	const char *getAccountType() const { return __accountType.c_str(); }
	const char *getAccountName() const { return __accountName.c_str(); }
	unsigned long long getSync1() const { return __sync1; }
	const char *getSync2() const { return __sync2.c_str(); }
	int getIsNeedUpsync() const { return __isNeedUpsync; }
	const char *getMemoUUID() const { return __memoUUID.c_str(); }
	const char *getMimeType() const { return __mimeType.c_str(); }
	const char *getDisplayName() const { return __displayName.c_str(); }
	long long getSize() const { return __size; }
	int getOrientation() const { return __orientation; }
	const char *getData() const { return __data.c_str(); }
	const char *getPath() const { return __path.c_str(); }

private:
	std::string __fileUUID;
	int __isDirty;
	int __isDeleted;
	std::string __accountType;
	std::string __accountName;
	unsigned long long __sync1;
	std::string __sync2;
	int __isNeedUpsync;
	std::string __memoUUID;
	std::string __mimeType;
	std::string __displayName;
	long long __size;
	int __orientation;
	std::string __data;
	std::string __path;
};

#endif
