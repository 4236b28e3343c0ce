#ifndef INC_DATABASE_MEMODOCINFO_H
#define INC_DATABASE_MEMODOCINFO_H

#include <memory>
#include <string>

#include "DataBase/MemoFileInfo.h"
#include "DataBase/MemoText.h"

// A memo holds at most ten images and one voice recording.
#define MEMO_MAX_FILE_COUNT 11

// The default card colour, "red;green;blue;alpha;".
#define MEMO_DEFAULT_BG_COLOR "228;235;235;255;"

// One memo (a row of the `memo` table) in memory, with its attachments inline.
// Plain carrier between MemoDbMgr and the views; it never touches the database.
// Setters return true on success; a refused value logs an error line and keeps the
// old value (setPhoneNum refuses null silently). String getters return character data
// valid while the record lives.
class MemoDocInfo
{
public:
	MemoDocInfo();
	virtual ~MemoDocInfo();
	MemoDocInfo(const MemoDocInfo &other);
	MemoDocInfo &operator=(const MemoDocInfo &other);

	// Stores the UUID; returns false in every case (no caller reads it).
	bool setMemoUUID(const char *uuid) { return setMemoUUID(MemoText(uuid)); }
	bool setIsDirty(int isDirty);     // refuses anything but 0 and 1
	bool setIsDeleted(int isDeleted); // refuses anything but 0 and 1
	bool setAccountType(const char *accountType) { return setAccountType(MemoText(accountType)); }
	bool setAccountName(const char *accountName) { return setAccountName(MemoText(accountName)); }
	bool setSync1(unsigned long long sync1);
	bool setSync2(const char *sync2) { return setSync2(MemoText(sync2)); }
	bool setIsNeedUpsync(int isNeedUpsync); // refuses anything but 0 and 1
	bool setCreatedAt(unsigned long long createdAt);
	bool setLastModifiedAt(unsigned long long lastModifiedAt);
	bool setCategoryUUID(const char *categoryUUID) { return setCategoryUUID(MemoText(categoryUUID)); }
	bool setTitle(const char *title) { return setTitle(MemoText(title)); }
	bool setContent(const char *content) { return setContent(MemoText(content)); }
	bool setTizenXmlContent(const char *tizenXmlContent) { return setTizenXmlContent(MemoText(tizenXmlContent)); }
	bool setAndroidXmlContent(const char *androidXmlContent)
	{
		return setAndroidXmlContent(MemoText(androidXmlContent));
	}
	bool setDisplayContent(const char *displayContent) { return setDisplayContent(MemoText(displayContent)); }
	bool setVrfileUUID(const char *vrfileUUID) { return setVrfileUUID(MemoText(vrfileUUID)); }
	bool setStrippedContent(const char *strippedContent) { return setStrippedContent(MemoText(strippedContent)); }
	bool setData(const char *data) { return setData(MemoText(data)); }
	bool setPhoneNum(const char *phoneNum) { return setPhoneNum(MemoText(phoneNum)); }
	bool setIsFavorite(int isFavorite);
	bool setIsHidden(int isHidden);
	bool setIsQuick(int isQuick);
	bool setFileCount(int fileCount); // refuses a negative count

	// Stores the colour text and parses it into the four ints. A text that is not
	// 16 characters long and does not hold exactly four ";" is replaced by the default
	// first. Returns false, keeping the ints parsed so far, when a ";" is missing.
	// A field that is no number throws std::invalid_argument from std::stoi.
	bool setBgColor(const char *bgColor) { return setBgColor(MemoText(bgColor)); }
	// Stores the four ints and rebuilds the colour text from them.
	bool setBgColorRgba(int red, int green, int blue, int alpha);
	// Copies the first getFileCount() entries of source into the record's files
	// (call setFileCount first); each entry's data is re-derived from its path.
	void copyFileInfos(const MemoFileInfo *source);

	// Returns the UUID; a record that has none gets a new one here (so asking writes).
	// Keeps the texts that the setters below may borrow from (the rows of a list read), for the record's life.
	// A record keeps one such arena: call this first.
	void keepTexts(std::shared_ptr<const MemoTextArena> texts) { __texts = std::move(texts); }
	// The rows the record was read from (null for a record made otherwise): records of equal rows are equal.
	const std::shared_ptr<const MemoTextArena> &getTexts() const { return __texts; }
	// The same setters for a text that the record may share with other records (a null text is refused as a
	// null pointer is). A borrowed text must come from the arena the record keeps.
	bool setMemoUUID(const MemoText &memoUUID);
	bool setAccountType(const MemoText &accountType);
	bool setAccountName(const MemoText &accountName);
	bool setSync2(const MemoText &sync2);
	bool setCategoryUUID(const MemoText &categoryUUID);
	bool setTitle(const MemoText &title);
	bool setContent(const MemoText &content);
	bool setTizenXmlContent(const MemoText &tizenXmlContent);
	bool setAndroidXmlContent(const MemoText &androidXmlContent);
	bool setDisplayContent(const MemoText &displayContent);
	bool setVrfileUUID(const MemoText &vrfileUUID);
	bool setStrippedContent(const MemoText &strippedContent);
	bool setData(const MemoText &data);
	bool setPhoneNum(const MemoText &phoneNum);
	bool setBgColor(const MemoText &bgColor);

	const char *getMemoUUID();
	int getIsDirty() const { return __isDirty; }
	int getIsDeleted() const { return __isDeleted; }
	const char *getAccountType() const { return __accountType.c_str(); }
	const char *getAccountName() const { return __accountName.c_str(); }
	unsigned long long getSync1() const { return __sync1; }
	const char *getSync2() const { return __sync2.c_str(); }
	int getIsNeedUpsync() const { return __isNeedUpsync; }
	unsigned long long getCreatedAt() const { return __createdAt; }
	unsigned long long getLastModifiedAt() const { return __lastModifiedAt; }
	const char *getCategoryUUID() const { return __categoryUUID.c_str(); }
	const char *getTitle() const { return __title.c_str(); }
	const char *getContent() const { return __content.c_str(); }
	const char *getAndroidXmlContent() const { return __androidXmlContent.c_str(); }
	const char *getTizenXmlContent() const { return __tizenXmlContent.c_str(); }
	const char *getDisplayContent() const { return __displayContent.c_str(); }
	const char *getVrfileUUID() const { return __vrfileUUID.c_str(); }
	const char *getStrippedContent() const { return __strippedContent.c_str(); }
	const char *getData() const { return __data.c_str(); }
	const char *getPhoneNum() const { return __phoneNum.c_str(); }
	int getIsFavorite() const { return __isFavorite; }
	int getIsHidden() const { return __isHidden; }
	int getIsQuick() const { return __isQuick; }
	int getFileCount() const { return __fileCount; }
	// The array of MEMO_MAX_FILE_COUNT entries; the used ones are the first getFileCount(). It is made on
	// first use, so that the records of a list, whose files are never read, stay small.
	MemoFileInfo *getFiles();
	const MemoFileInfo *getFiles() const;
	const char *getBgColor() const { return __bgColor.c_str(); }
	// Writes the four colour ints through the out arguments (null ones are skipped).
	void getBgColorRgba(int *red, int *green, int *blue, int *alpha) const;

private:
	std::shared_ptr<const MemoTextArena> __texts; // first: the fields below may borrow from it
	MemoText __memoUUID;
	int __isDirty;
	int __isDeleted;
	MemoText __accountType;
	MemoText __accountName;
	unsigned long long __sync1;
	MemoText __sync2;
	int __isNeedUpsync;
	unsigned long long __createdAt;
	unsigned long long __lastModifiedAt;
	MemoText __categoryUUID;
	MemoText __title;
	MemoText __content;
	MemoText __androidXmlContent;
	MemoText __tizenXmlContent;
	MemoText __displayContent;
	MemoText __vrfileUUID;
	MemoText __strippedContent;
	MemoText __data;
	MemoText __phoneNum;
	int __isFavorite;
	int __isHidden;
	int __isQuick;
	int __fileCount;
	mutable std::unique_ptr<MemoFileInfo[]> __files;
	int __bgRed;
	int __bgGreen;
	int __bgBlue;
	int __bgAlpha;
	MemoText __bgColor;
	int __changed;
};

#endif
